#include "CombinationEnumerator.h"

#include <algorithm>

namespace velkui::arrange::impl {

namespace {

float LimitedValue(const IArrangement& a, bool limitHeight) {
  return limitHeight ? a.MinHeight() : a.MinWidth();
}

float OtherValue(const IArrangement& a, bool limitHeight) {
  return limitHeight ? a.MinWidth() : a.MinHeight();
}

}  // namespace

CombinationEnumerator::CombinationEnumerator(AbstractArrangeableGroup& group) : group_(group) {}

void CombinationEnumerator::Run(const Visit& visit) {
  const std::vector<IArrangeable*>& kids = group_.children_;
  const std::vector<ISeparator*>& separators = group_.separators_;
  std::vector<std::size_t> included;
  for (std::size_t i = 0; i < kids.size(); ++i) {
    const ArrangementSet& set = kids[i]->Arrangements();
    if (set.Empty()) continue;
    children_.push_back({&set, {}, {}, {}, {}});
    included.push_back(i);
  }
  if (children_.empty()) return;

  // The separator of a gap is the one before the later child, so leaving a child out shifts
  // no separator; the ones next to left-out children are collapsed.
  std::vector<bool> used(separators.size(), false);
  for (std::size_t j = 1; j < included.size(); ++j) {
    const std::size_t gap = included[j] - 1;
    combination_.separators.push_back(gap < separators.size() ? separators[gap] : nullptr);
    if (gap < used.size()) used[gap] = true;
  }
  for (std::size_t gap = 0; gap < separators.size(); ++gap) {
    if (!used[gap] && separators[gap] != nullptr) {
      combination_.hiddenSeparators.push_back(separators[gap]);
    }
  }
  combination_.children.resize(children_.size());

  const std::size_t count = children_.size();
  const auto perCombination = static_cast<std::size_t>(
      std::max(1, group_.CandidatesPerCombination(static_cast<int>(count))));
  const std::size_t budget = std::max<std::size_t>(2, kWorkBudget / (count * perCombination));
  std::size_t product = 1;
  for (const ChildCandidates& child : children_) {
    product *= child.set->Size();
    if (product > budget) break;
  }
  if (product <= budget) {
    EnumerateAll(visit);
  } else {
    EnumerateByLimits(budget, visit);
  }
}

void CombinationEnumerator::EnumerateAll(const Visit& visit) {
  exhaustive_ = true;
  const std::size_t count = children_.size();
  std::vector<std::size_t> index(count, 0);
  for (;;) {
    for (std::size_t j = 0; j < count; ++j) {
      combination_.children[j] = (*children_[j].set)[index[j]];
    }
    visit(combination_);
    bool advanced = false;
    for (std::size_t j = count; j-- > 0;) {
      if (++index[j] < children_[j].set->Size()) {
        advanced = true;
        break;
      }
      index[j] = 0;
    }
    if (!advanced) return;
  }
}

void CombinationEnumerator::PrepareLimits() {
  for (ChildCandidates& child : children_) {
    const ArrangementSet& set = *child.set;
    for (const bool limitHeight : {true, false}) {
      std::vector<std::size_t>& order = limitHeight ? child.byHeight : child.byWidth;
      std::vector<std::size_t>& bestUpTo = limitHeight ? child.narrowestUpTo : child.shortestUpTo;
      order.resize(set.Size());
      for (std::size_t i = 0; i < set.Size(); ++i) order[i] = i;
      std::stable_sort(order.begin(), order.end(), [&](std::size_t a, std::size_t b) {
        return LimitedValue(*set[a], limitHeight) < LimitedValue(*set[b], limitHeight);
      });
      bestUpTo.resize(order.size());
      for (std::size_t k = 0; k < order.size(); ++k) {
        const bool better = k == 0 || OtherValue(*set[order[k]], limitHeight) <
                                          OtherValue(*set[bestUpTo[k - 1]], limitHeight);
        bestUpTo[k] = better ? order[k] : bestUpTo[k - 1];
      }
    }
  }
}

std::size_t CombinationEnumerator::PickFor(const ChildCandidates& child, bool limitHeight,
                                           float limit) const {
  const ArrangementSet& set = *child.set;
  const std::vector<std::size_t>& order = limitHeight ? child.byHeight : child.byWidth;
  const std::vector<std::size_t>& bestUpTo = limitHeight ? child.narrowestUpTo : child.shortestUpTo;
  const auto end =
      std::upper_bound(order.begin(), order.end(), limit, [&](float value, std::size_t index) {
        return value < LimitedValue(*set[index], limitHeight);
      });
  if (end == order.begin()) return order.front();
  return bestUpTo[static_cast<std::size_t>(end - order.begin()) - 1];
}

void CombinationEnumerator::VisitLimits(bool limitHeight, std::size_t count,
                                        std::vector<std::size_t>& previous, const Visit& visit) {
  std::vector<float> values;
  for (const ChildCandidates& child : children_) {
    for (const IArrangementP& a : *child.set) values.push_back(LimitedValue(*a, limitHeight));
  }
  std::sort(values.begin(), values.end());
  values.erase(std::unique(values.begin(), values.end()), values.end());
  std::vector<float> limits;
  if (values.size() <= count) {
    limits = values;
  } else {
    // Evenly spread, always with the smallest and the largest.
    const std::size_t last = values.size() - 1;
    for (std::size_t i = 0; i < count; ++i) {
      limits.push_back(values[count > 1 ? i * last / (count - 1) : last]);
    }
  }
  std::vector<std::size_t> picks(children_.size());
  for (const float limit : limits) {
    for (std::size_t j = 0; j < children_.size(); ++j)
      picks[j] = PickFor(children_[j], limitHeight, limit);
    if (picks == previous) continue;
    previous = picks;
    for (std::size_t j = 0; j < children_.size(); ++j) {
      combination_.children[j] = (*children_[j].set)[picks[j]];
    }
    visit(combination_);
  }
}

void CombinationEnumerator::EnumerateByLimits(std::size_t combinationBudget, const Visit& visit) {
  exhaustive_ = false;
  PrepareLimits();
  const std::size_t perAxis = std::max<std::size_t>(1, combinationBudget / 2);
  std::vector<std::size_t> previous;
  VisitLimits(true, perAxis, previous, visit);
  VisitLimits(false, perAxis, previous, visit);
}

}  // namespace velkui::arrange::impl
