#include <velkui/arrange/Groups.h>

#include <algorithm>

#include <velkui/arrange/GroupArrangement.h>

namespace velkui::arrange::impl {

namespace {

using Combination = AbstractArrangeableGroup::Combination;

LineAxis Across(LineAxis axis) {
  return axis == LineAxis::Horizontal ? LineAxis::Vertical : LineAxis::Horizontal;
}

float MinAlong(const IArrangement& a, LineAxis axis) {
  return axis == LineAxis::Horizontal ? a.MinWidth() : a.MinHeight();
}

float MinAcross(const IArrangement& a, LineAxis axis) {
  return MinAlong(a, Across(axis));
}

// Whether a candidate whose (main, cross) minimum is `minimum` along `axis` would be dropped.
bool WouldDrop(const ArrangementSet& set, LineAxis axis, const PointF& minimum) {
  return axis == LineAxis::Horizontal ? set.WouldDrop(minimum.x, minimum.y)
                                      : set.WouldDrop(minimum.y, minimum.x);
}

// All children in one row (or column) that owns the group's margins.
void AddLine(LineAxis axis, AbstractArrangeableGroup& group, const Combination& combination,
             ArrangementSet& set) {
  const LineParameters parameters = ParametersFor(axis, group, true);
  const auto& children = combination.children;
  const PointF minimum = GroupArrangement::LineMinimum(
      children.size(), [&](std::size_t i) { return MinAlong(*children[i], axis); },
      [&](std::size_t i) { return MinAcross(*children[i], axis); }, parameters);
  if (WouldDrop(set, axis, minimum)) return;
  set.AddArrangement(new GroupArrangement(axis, &group, children, combination.separators,
                                          combination.hiddenSeparators, parameters, true));
}

// For k = 1..n: the children k per line along `lineAxis`, the lines stacked across it in an
// arrangement that owns the group's margins. A candidate is only made when the set would keep
// it, which its minimum size (computed exactly as the arrangements compute it) tells.
void AddWrapped(LineAxis lineAxis, AbstractArrangeableGroup& group, const Combination& combination,
                ArrangementSet& set) {
  const LineParameters lineParameters = ParametersFor(lineAxis, group, false);
  const LineAxis stackAxis = Across(lineAxis);
  const LineParameters stackParameters = ParametersFor(stackAxis, group, true);
  const auto& children = combination.children;
  const std::size_t n = children.size();
  std::vector<float> along(n);
  std::vector<float> across(n);
  for (std::size_t i = 0; i < n; ++i) {
    along[i] = MinAlong(*children[i], lineAxis);
    across[i] = MinAcross(*children[i], lineAxis);
  }
  std::vector<float> lineAlong;
  std::vector<float> lineAcross;
  for (std::size_t k = 1; k <= n; ++k) {
    const std::size_t lines = (n + k - 1) / k;
    lineAlong.resize(lines);
    lineAcross.resize(lines);
    for (std::size_t l = 0; l < lines; ++l) {
      const std::size_t start = l * k;
      const PointF m = GroupArrangement::LineMinimum(
          std::min(k, n - start), [&](std::size_t i) { return along[start + i]; },
          [&](std::size_t i) { return across[start + i]; }, lineParameters);
      lineAlong[l] = m.x;
      lineAcross[l] = m.y;
    }
    const PointF stackMinimum = GroupArrangement::LineMinimum(
        lines, [&](std::size_t l) { return lineAcross[l]; },
        [&](std::size_t l) { return lineAlong[l]; }, stackParameters);
    if (WouldDrop(set, stackAxis, stackMinimum)) continue;

    std::vector<IArrangementP> lineArrangements;
    std::vector<ISeparator*> stackSeparators;
    lineArrangements.reserve(lines);
    for (std::size_t l = 0; l < lines; ++l) {
      const std::size_t start = l * k;
      const std::size_t count = std::min(k, n - start);
      std::vector<IArrangementP> lineChildren(
          children.begin() + static_cast<std::ptrdiff_t>(start),
          children.begin() + static_cast<std::ptrdiff_t>(start + count));
      std::vector<ISeparator*> lineSeparators(
          combination.separators.begin() + static_cast<std::ptrdiff_t>(start),
          combination.separators.begin() + static_cast<std::ptrdiff_t>(start + count - 1));
      lineArrangements.push_back(new GroupArrangement(lineAxis, nullptr, std::move(lineChildren),
                                                      std::move(lineSeparators), {}, lineParameters,
                                                      false));
      if (l > 0) stackSeparators.push_back(combination.separators[start - 1]);
    }
    const boost::intrusive_ptr<GroupArrangement> stack(new GroupArrangement(
        stackAxis, &group, std::move(lineArrangements), std::move(stackSeparators),
        combination.hiddenSeparators, stackParameters, true));
    stack->SetHoldsLines();
    set.AddArrangement(stack);
  }
}

}  // namespace

void BuildArrangementsOfType(GroupArrangementType type, AbstractArrangeableGroup& group,
                             const Combination& combination, ArrangementSet& set) {
  switch (type) {
    case GroupArrangementType::Row:
      AddLine(LineAxis::Horizontal, group, combination, set);
      break;
    case GroupArrangementType::Column:
      AddLine(LineAxis::Vertical, group, combination, set);
      break;
    case GroupArrangementType::Flipping:
      AddLine(LineAxis::Horizontal, group, combination, set);
      AddLine(LineAxis::Vertical, group, combination, set);
      break;
    case GroupArrangementType::HorizontalWrapping:
      AddWrapped(LineAxis::Horizontal, group, combination, set);
      break;
    case GroupArrangementType::VerticalWrapping:
      AddWrapped(LineAxis::Vertical, group, combination, set);
      break;
    case GroupArrangementType::AutoLayout:
      AddWrapped(LineAxis::Horizontal, group, combination, set);
      AddWrapped(LineAxis::Vertical, group, combination, set);
      break;
  }
}

int CandidatesPerCombinationOfType(GroupArrangementType type, int childCount) {
  switch (type) {
    case GroupArrangementType::Row:
    case GroupArrangementType::Column:
      return 1;
    case GroupArrangementType::Flipping:
      return 2;
    case GroupArrangementType::HorizontalWrapping:
    case GroupArrangementType::VerticalWrapping:
      return childCount;
    case GroupArrangementType::AutoLayout:
      return 2 * childCount;
  }
  return 1;
}

}  // namespace velkui::arrange::impl
