#include <velkui/arrange/ArrangementSet.h>

#include <cmath>
#include <limits>
#include <optional>

namespace velkui::arrange::impl {

namespace {

constexpr double kGoldenRatio = 1.618034;

bool Fits(const IArrangement& a, const PointF& size) {
  return size.x >= a.MinWidth() && size.y >= a.MinHeight();
}

// How far the candidate's best proportions are from the golden ratio; a candidate without
// a positive best height counts as infinitely far.
double GoldenDistance(const IArrangement& a) {
  const double height = a.BestHeight();
  if (!(height > 0)) return std::numeric_limits<double>::infinity();
  return std::fabs(a.BestWidth() / height - kGoldenRatio);
}

}  // namespace

std::ptrdiff_t ArrangementSet::FirstComparable(float minWidth, float minHeight) const {
  for (std::size_t i = 0; i < minSizes_.size(); ++i) {
    const MinSize& c = minSizes_[i];
    const bool cCovers = c.width <= minWidth && c.height <= minHeight;
    const bool covered = minWidth <= c.width && minHeight <= c.height;
    if (cCovers || covered) return static_cast<std::ptrdiff_t>(i);
  }
  return -1;
}

bool ArrangementSet::WouldDrop(float minWidth, float minHeight) const {
  const std::ptrdiff_t first = FirstComparable(minWidth, minHeight);
  if (first < 0) return false;
  const MinSize& c = minSizes_[static_cast<std::size_t>(first)];
  return !(minWidth <= c.width && minHeight <= c.height);
}

void ArrangementSet::AddArrangement(const IArrangementP& a) {
  if (!a) return;
  const float width = a->MinWidth();
  const float height = a->MinHeight();
  if (WouldDrop(width, height)) return;
  std::size_t kept = 0;
  for (std::size_t i = 0; i < candidates_.size(); ++i) {
    const bool covered = width <= minSizes_[i].width && height <= minSizes_[i].height;
    if (covered) continue;
    if (kept != i) {
      candidates_[kept] = std::move(candidates_[i]);
      minSizes_[kept] = minSizes_[i];
    }
    ++kept;
  }
  candidates_.resize(kept);
  minSizes_.resize(kept);
  candidates_.push_back(a);
  minSizes_.push_back({width, height});
}

void ArrangementSet::Clear() {
  candidates_.clear();
  minSizes_.clear();
}

IArrangement* ArrangementSet::ChooseFor(const PointF& size) const {
  if (candidates_.empty()) return nullptr;
  IArrangement* best = candidates_.front().get();
  bool bestFits = Fits(*best, size);
  // Metrics of the current best, computed once it is compared.
  std::optional<float> bestOverflow;
  std::optional<float> bestWaste;
  for (std::size_t i = 1; i < candidates_.size(); ++i) {
    IArrangement* candidate = candidates_[i].get();
    const bool fits = Fits(*candidate, size);
    if (!fits && !bestFits) {
      if (!bestOverflow) bestOverflow = best->Overflow(size);
      const float overflow = candidate->Overflow(size);
      if (overflow < *bestOverflow) {
        best = candidate;
        bestOverflow = overflow;
      }
    } else if (fits && !bestFits) {
      best = candidate;
      bestFits = true;
      bestOverflow.reset();
    } else if (fits && bestFits) {
      if (!bestWaste) bestWaste = best->Waste(size);
      const float waste = candidate->Waste(size);
      const bool lessWaste = waste < *bestWaste;
      const bool smallerOnTie =
          waste == *bestWaste &&
          candidate->MinWidth() * candidate->MinHeight() < best->MinWidth() * best->MinHeight();
      if (lessWaste || smallerOnTie) {
        best = candidate;
        bestWaste = waste;
      }
    }
  }
  return best;
}

PointF ArrangementSet::BestSize() const {
  if (candidates_.empty()) return {0, 0};
  const IArrangement* best = candidates_.front().get();
  double bestDistance = GoldenDistance(*best);
  for (std::size_t i = 1; i < candidates_.size(); ++i) {
    const double distance = GoldenDistance(*candidates_[i]);
    if (distance < bestDistance) {
      best = candidates_[i].get();
      bestDistance = distance;
    }
  }
  return {best->MinWidth(), best->MinHeight()};
}

}  // namespace velkui::arrange::impl
