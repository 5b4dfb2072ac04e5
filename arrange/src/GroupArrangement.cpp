#include <velkui/arrange/GroupArrangement.h>

#include <algorithm>
#include <cmath>

#include <velkcore/Error.h>
#include <velkui/arrange/AbstractArrangeableGroup.h>

namespace velkui::arrange::impl {

namespace {

constexpr double kSizeTolerance = 0.0001;
constexpr int kMaxDistributionRounds = 10000;

double AlignmentFactor(int alignment) {
  if (alignment == 1) return 0.5;
  if (alignment == 2) return 1.0;
  return 0.0;
}

int ClampedAlignment(int alignment) {
  return alignment >= 0 && alignment <= 2 ? alignment : 0;
}

float RequireFinite(float value) {
  velkcore::RequireInput(std::isfinite(value));
  return value;
}

}  // namespace

LineParameters ParametersFor(LineAxis axis, const AbstractArrangeableGroup& group, bool outer) {
  LineParameters p;
  const int horizontal = ClampedAlignment(static_cast<int>(group.HorizontalAlignment()));
  const int vertical = ClampedAlignment(static_cast<int>(group.VerticalAlignment()));
  if (axis == LineAxis::Horizontal) {
    p.spacing = RequireFinite(group.HorizontalSpacing());
    p.mainAlignment = horizontal;
    p.crossAlignment = vertical;
  } else {
    p.spacing = RequireFinite(group.VerticalSpacing());
    p.mainAlignment = vertical;
    p.crossAlignment = horizontal;
  }
  if (outer) {
    const float left = RequireFinite(group.LeftMargin());
    const float right = RequireFinite(group.RightMargin());
    const float top = RequireFinite(group.TopMargin());
    const float bottom = RequireFinite(group.BottomMargin());
    const bool row = axis == LineAxis::Horizontal;
    p.mainMarginBefore = row ? left : top;
    p.mainMarginAfter = row ? right : bottom;
    p.crossMarginBefore = row ? top : left;
    p.crossMarginAfter = row ? bottom : right;
  }
  return p;
}

GroupArrangement::GroupArrangement(LineAxis axis, AbstractArrangeableGroup* group,
                                   std::vector<IArrangementP> children,
                                   std::vector<ISeparator*> separators,
                                   std::vector<ISeparator*> hiddenSeparators,
                                   const LineParameters& parameters, bool outer)
    : axis_(axis),
      outer_(outer),
      group_(outer ? group : nullptr),
      parameters_(parameters),
      children_(std::move(children)),
      separators_(std::move(separators)),
      hiddenSeparators_(std::move(hiddenSeparators)) {
  separators_.resize(children_.empty() ? 0 : children_.size() - 1, nullptr);
  const PointF minimum = LineMinimum(
      children_.size(), [this](std::size_t i) { return MinMainOf(*children_[i]); },
      [this](std::size_t i) { return MinCrossOf(*children_[i]); }, parameters_);
  minMain_ = minimum.x;
  minCross_ = minimum.y;
  bool regular = parameters_.spacing >= 0;
  for (const IArrangementP& child : children_) {
    regular = regular && child->ExpandsRegularly();
    mainExpandable_ = mainExpandable_ || ExpandableMainOf(*child);
    crossExpandable_ = crossExpandable_ ||
                       (IsRow() ? child->VerticallyExpandable() : child->HorizontallyExpandable());
  }
  SetExpandsRegularly(regular);
}

void GroupArrangement::DetachSeparators() {
  std::fill(separators_.begin(), separators_.end(), nullptr);
  hiddenSeparators_.clear();
  if (!holdsLines_) return;
  // The lines hold this group's separators too.
  for (const IArrangementP& line : children_)
    static_cast<GroupArrangement*>(line.get())->DetachSeparators();
}

bool GroupArrangement::ExpandableMainOf(const IArrangement& a) const {
  return IsRow() ? a.HorizontallyExpandable() : a.VerticallyExpandable();
}

float GroupArrangement::ExpandedMainOf(const IArrangement& a, float available) const {
  return IsRow() ? a.ExpandedWidth(available) : a.ExpandedHeight(available);
}

float GroupArrangement::ExpandedCrossOf(const IArrangement& a, float available) const {
  return IsRow() ? a.ExpandedHeight(available) : a.ExpandedWidth(available);
}

PointF GroupArrangement::ToPoint(double main, double cross) const {
  const auto m = static_cast<float>(main);
  const auto c = static_cast<float>(cross);
  return IsRow() ? PointF{m, c} : PointF{c, m};
}

RectF GroupArrangement::ToRect(double mainStart, double crossStart, double mainSize,
                               double crossSize) const {
  const auto ms = static_cast<float>(mainStart);
  const auto cs = static_cast<float>(crossStart);
  const auto mz = static_cast<float>(mainSize);
  const auto cz = static_cast<float>(crossSize);
  return IsRow() ? RectF{ms, cs, mz, cz} : RectF{cs, ms, cz, mz};
}

bool GroupArrangement::HorizontallyExpandable() const {
  return IsRow() ? mainExpandable_ : crossExpandable_;
}

bool GroupArrangement::VerticallyExpandable() const {
  return IsRow() ? crossExpandable_ : mainExpandable_;
}

void GroupArrangement::Compute() {
  EnsureBestSizes();
}

void GroupArrangement::EnsureBestSizes() const {
  if (bestComputed_) return;
  double sumMain = 0;
  float maxCross = 0;
  for (std::size_t i = 0; i < children_.size(); ++i) {
    const IArrangement& child = *children_[i];
    sumMain += IsRow() ? child.BestWidth() : child.BestHeight();
    const float cross = IsRow() ? child.BestHeight() : child.BestWidth();
    if (i == 0 || cross > maxCross) maxCross = cross;
  }
  const double gaps = children_.empty() ? 0.0 : static_cast<double>(children_.size() - 1);
  bestMain_ = static_cast<float>(sumMain + parameters_.spacing * gaps + parameters_.MainMargins());
  bestCross_ = maxCross + parameters_.CrossMargins();
  bestComputed_ = true;
}

float GroupArrangement::BestWidth() const {
  EnsureBestSizes();
  return IsRow() ? bestMain_ : bestCross_;
}

float GroupArrangement::BestHeight() const {
  EnsureBestSizes();
  return IsRow() ? bestCross_ : bestMain_;
}

float GroupArrangement::ExpandedWidth(float available) const {
  return IsRow() ? ExpandedMain(available) : ExpandedCross(available);
}

float GroupArrangement::ExpandedHeight(float available) const {
  return IsRow() ? ExpandedCross(available) : ExpandedMain(available);
}

float GroupArrangement::ExpandedMain(float available) const {
  // Nothing inside can grow: offered its minimum or more, the line takes exactly its minimum
  // (it follows from the walk below) and the answer needs no descent into the children, which
  // keeps deep trees linear.
  if (!mainExpandable_ && ExpandsRegularly() && available >= minMain_) return minMain_;
  if (expandedMainMemo_.available == available) return expandedMainMemo_.result;
  const double inner = static_cast<double>(available) - parameters_.MainMargins();
  double sum = 0;
  for (const IArrangementP& child : children_) {
    sum += ExpandedMainOf(*child, static_cast<float>(inner - sum));
    if (sum >= inner) break;
  }
  const double gaps = children_.empty() ? 0.0 : static_cast<double>(children_.size() - 1);
  const auto result = static_cast<float>(std::min(sum + parameters_.spacing * gaps, inner) +
                                         parameters_.MainMargins());
  expandedMainMemo_ = {available, result};
  return result;
}

float GroupArrangement::ExpandedCross(float available) const {
  if (!crossExpandable_ && ExpandsRegularly() && available >= minCross_) return minCross_;
  if (expandedCrossMemo_.available == available) return expandedCrossMemo_.result;
  const float inner = available - parameters_.CrossMargins();
  float largest = 0;
  bool first = true;
  for (const IArrangementP& child : children_) {
    const float expanded = ExpandedCrossOf(*child, inner);
    if (first || expanded > largest) largest = expanded;
    first = false;
    if (expanded >= inner) break;
  }
  const float result = largest + parameters_.CrossMargins();
  expandedCrossMemo_ = {available, result};
  return result;
}

void GroupArrangement::Distribute(float innerMain, float innerCross) {
  if (tableComputed_ && std::fabs(innerMain - tableSize_.x) < kSizeTolerance &&
      std::fabs(innerCross - tableSize_.y) < kSizeTolerance) {
    return;
  }
  const std::size_t count = children_.size();
  table_.resize(count);
  double sum = 0;
  for (std::size_t i = 0; i < count; ++i) {
    const IArrangement& child = *children_[i];
    Entry& entry = table_[i];
    entry.main = IsRow() ? child.BestWidth() : child.BestHeight();
    entry.cross = ExpandedCrossOf(child, innerCross);
    sum += entry.main;
  }
  const double gaps = count > 0 ? static_cast<double>(count - 1) : 0.0;
  // Measured from the widths the entries really start at, so that a line offered at least its
  // minimum never ends up longer than what it was offered.
  double extra = static_cast<double>(innerMain) - (sum + parameters_.spacing * gaps);
  if (extra > 0) {
    for (std::size_t i = 0; i < count; ++i) table_[i].inPool = ExpandableMainOf(*children_[i]);
    ShareSpace(extra, true);
  } else if (extra < 0) {
    for (std::size_t i = 0; i < count; ++i) {
      table_[i].inPool = table_[i].main > MinMainOf(*children_[i]);
    }
    ShareSpace(extra, false);
  }
  usedMain_ = static_cast<double>(innerMain) - extra;
  tableSize_ = {innerMain, innerCross};
  tableComputed_ = true;
}

// Hands `extra` (positive: grow the expandable entries; negative: shrink the entries still above
// their minimum) to the pool in proportion to the entries' current lengths. An entry that cannot
// take its share is set to what it can take and leaves the pool; the rest of its share goes to
// the entries after it in the same round.
void GroupArrangement::ShareSpace(double& extra, bool growing) {
  for (int round = 0; round < kMaxDistributionRounds && std::fabs(extra) >= kSizeTolerance;
       ++round) {
    double remainingPool = 0;
    for (const Entry& entry : table_) {
      if (entry.inPool) remainingPool += entry.main;
    }
    if (!(remainingPool > 0)) return;
    double remainingExtra = extra;
    bool changed = false;
    for (std::size_t i = 0; i < table_.size(); ++i) {
      Entry& entry = table_[i];
      if (!entry.inPool) continue;
      if (!(remainingPool > 0)) break;
      const double current = entry.main;
      const double proposal = (remainingPool + remainingExtra) / remainingPool * current;
      remainingPool -= current;
      const IArrangement& child = *children_[i];
      const double minimum = MinMainOf(child);
      double accepted = proposal;
      if (growing) {
        accepted = std::max(
            minimum, static_cast<double>(ExpandedMainOf(child, static_cast<float>(proposal))));
      } else {
        accepted = std::max(minimum, proposal);
      }
      if (static_cast<float>(accepted) != static_cast<float>(proposal)) entry.inPool = false;
      const double change = accepted - current;
      if (change != 0) changed = true;
      remainingExtra -= change;
      entry.main = accepted;
    }
    extra = remainingExtra;
    if (!changed) return;
  }
}

void GroupArrangement::PlaceSeparator(std::size_t gap, double mainPosition, double crossPosition,
                                      double crossSize) {
  ISeparator* separator = separators_[gap];
  if (separator == nullptr) return;
  const double thickness = std::max(0.0f, parameters_.spacing);
  separator->SetSeparatorFrame(!IsRow(), ToRect(mainPosition - thickness, crossPosition, thickness,
                                                std::max(0.0, crossSize)));
}

PointF GroupArrangement::Arrange(const RectF& rect) {
  const double mainStart = IsRow() ? rect.left : rect.top;
  const double crossStart = IsRow() ? rect.top : rect.left;
  const double mainSize = IsRow() ? rect.width : rect.height;
  const double crossSize = IsRow() ? rect.height : rect.width;
  const double innerMainStart = mainStart + parameters_.mainMarginBefore;
  const double innerCrossStart = crossStart + parameters_.crossMarginBefore;
  const double innerMain = mainSize - parameters_.MainMargins();
  const double innerCross = crossSize - parameters_.CrossMargins();

  Distribute(static_cast<float>(innerMain), static_cast<float>(innerCross));
  if (group_ != nullptr) group_->Position({rect.left, rect.top});

  double position =
      innerMainStart + AlignmentFactor(parameters_.mainAlignment) * (innerMain - usedMain_);
  double largestUsedCross = 0;
  double previousCrossPosition = 0;
  double previousUsedCross = 0;
  for (std::size_t i = 0; i < children_.size(); ++i) {
    const Entry& entry = table_[i];
    if (i > 0) position += parameters_.spacing;
    const double crossPosition =
        innerCrossStart + AlignmentFactor(parameters_.crossAlignment) * (innerCross - entry.cross);
    const PointF used =
        children_[i]->Arrange(ToRect(position, crossPosition, entry.main, entry.cross));
    const double usedMain = IsRow() ? used.x : used.y;
    const double usedCross = IsRow() ? used.y : used.x;
    if (i > 0) {
      // The separator spans the shorter neighbour, which lies within the taller one.
      const bool previousShorter = previousUsedCross <= usedCross;
      PlaceSeparator(i - 1, position, previousShorter ? previousCrossPosition : crossPosition,
                     previousShorter ? previousUsedCross : usedCross);
    }
    if (i == 0 || usedCross > largestUsedCross) largestUsedCross = usedCross;
    previousCrossPosition = crossPosition;
    previousUsedCross = usedCross;
    position += usedMain;
  }
  for (ISeparator* hidden : hiddenSeparators_) {
    if (hidden != nullptr) hidden->SetSeparatorFrame(!IsRow(), {rect.left, rect.top, 0, 0});
  }
  const PointF result =
      ToPoint(std::max(innerMain, position - innerMainStart) + parameters_.MainMargins(),
              std::max(innerCross, largestUsedCross) + parameters_.CrossMargins());
  if (group_ != nullptr) group_->SetDimensions(result);
  return result;
}

float GroupArrangement::Overflow(const PointF& size) {
  const double innerMain = (IsRow() ? size.x : size.y) - parameters_.MainMargins();
  const double innerCross = (IsRow() ? size.y : size.x) - parameters_.CrossMargins();
  double overflow = 0;
  double position = 0;
  for (std::size_t i = 0; i < children_.size(); ++i) {
    const IArrangement& child = *children_[i];
    if (i > 0) position += parameters_.spacing;
    const double minMain = MinMainOf(child);
    const double minCross = MinCrossOf(child);
    const double remaining = innerMain - position;
    if (minMain > remaining) overflow += minCross * (minMain - std::max(0.0, remaining));
    overflow += minMain * std::max(0.0, minCross - innerCross);
    position += minMain;
  }
  return static_cast<float>(overflow);
}

float GroupArrangement::Waste(const PointF& size) {
  const double outerMain = IsRow() ? size.x : size.y;
  const double outerCross = IsRow() ? size.y : size.x;
  const double innerMain = outerMain - parameters_.MainMargins();
  const double innerCross = outerCross - parameters_.CrossMargins();
  Distribute(static_cast<float>(innerMain), static_cast<float>(innerCross));
  double waste = 0;
  for (std::size_t i = 0; i < children_.size(); ++i) {
    waste += children_[i]->Waste(ToPoint(table_[i].main, innerCross));
  }
  const double gaps = children_.empty() ? 0.0 : static_cast<double>(children_.size() - 1);
  waste += parameters_.spacing * innerCross * gaps;
  waste += std::max(0.0, innerMain - usedMain_) * innerCross;
  waste += parameters_.CrossMargins() * outerMain + parameters_.MainMargins() * outerCross;
  return static_cast<float>(waste);
}

}  // namespace velkui::arrange::impl
