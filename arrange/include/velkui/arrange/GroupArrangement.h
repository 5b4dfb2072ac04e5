#pragma once

#include <cstddef>
#include <limits>
#include <utility>
#include <vector>

#include <velkui/arrange/IArrangement.h>
#include <velkui/arrange/ISeparator.h>

namespace velkui::arrange::impl {

class AbstractArrangeableGroup;

// The values of a group that one row or column uses, read when the arrangement is made. The
// main axis runs along the line (horizontal for a row), the cross axis across it.
struct LineParameters {
  float spacing = 0;
  float mainMarginBefore = 0;
  float mainMarginAfter = 0;
  float crossMarginBefore = 0;
  float crossMarginAfter = 0;
  int mainAlignment = 0;   // 0 start, 1 centre, 2 end
  int crossAlignment = 0;  // likewise

  float MainMargins() const { return mainMarginBefore + mainMarginAfter; }
  float CrossMargins() const { return crossMarginBefore + crossMarginAfter; }
};

enum class LineAxis { Horizontal, Vertical };

// Margins are only the group's when `outer` is set.
LineParameters ParametersFor(LineAxis axis, const AbstractArrangeableGroup& group, bool outer);

// A row or a column of child arrangements. Minimum sizes are computed when it is made (the
// candidate set compares them); best sizes on Compute; the distribution of the main-axis space
// each time it is offered a different size.
class GroupArrangement : public IArrangement {
 public:
  // `group` receives Position and SetDimensions when `outer`; `separators` has one entry per
  // gap (null entries draw nothing); `hiddenSeparators` are collapsed whenever this arranges.
  GroupArrangement(LineAxis axis, AbstractArrangeableGroup* group,
                   std::vector<IArrangementP> children, std::vector<ISeparator*> separators,
                   std::vector<ISeparator*> hiddenSeparators, const LineParameters& parameters,
                   bool outer);

  PointF Arrange(const RectF& rect) override;
  bool HorizontallyExpandable() const override;
  bool VerticallyExpandable() const override;
  float MinWidth() const override { return IsRow() ? minMain_ : minCross_; }
  float MinHeight() const override { return IsRow() ? minCross_ : minMain_; }
  float BestWidth() const override;
  float BestHeight() const override;
  float ExpandedWidth(float available) const override;
  float ExpandedHeight(float available) const override;
  float Overflow(const PointF& size) override;
  float Waste(const PointF& size) override;
  void Compute() override;
  bool IsOuter() const override { return outer_; }

  // The group is going away: stop reporting to it.
  void DetachGroup() { group_ = nullptr; }
  // The separators are going away: stop placing them (in this arrangement and its own lines).
  void DetachSeparators();
  // The children are lines made for this arrangement (a wrapping candidate), not candidates of
  // child groups.
  void SetHoldsLines() { holdsLines_ = true; }
  const std::vector<IArrangementP>& Children() const { return children_; }
  LineAxis Axis() const { return axis_; }

  // Minimum (main, cross) size of a line whose i-th child has minimum main(i) and cross(i):
  // the one formula both the constructor and the builders' early pruning use.
  template <typename MainOf, typename CrossOf>
  static PointF LineMinimum(std::size_t count, MainOf main, CrossOf cross,
                            const LineParameters& parameters) {
    float sumMain = 0;
    float maxCross = 0;
    for (std::size_t i = 0; i < count; ++i) {
      sumMain += main(i);
      const float c = cross(i);
      if (i == 0 || c > maxCross) maxCross = c;
    }
    const float gaps = count > 0 ? static_cast<float>(count - 1) : 0.0f;
    return {sumMain + parameters.spacing * gaps + parameters.MainMargins(),
            maxCross + parameters.CrossMargins()};
  }

 private:
  struct Entry {
    double main = 0;
    float cross = 0;
    bool inPool = false;
  };

  bool IsRow() const { return axis_ == LineAxis::Horizontal; }
  float MinMainOf(const IArrangement& a) const { return IsRow() ? a.MinWidth() : a.MinHeight(); }
  float MinCrossOf(const IArrangement& a) const { return IsRow() ? a.MinHeight() : a.MinWidth(); }
  void EnsureBestSizes() const;
  float ExpandedMain(float available) const;
  float ExpandedCross(float available) const;
  float ExpandedMainOf(const IArrangement& a, float available) const;
  float ExpandedCrossOf(const IArrangement& a, float available) const;
  bool ExpandableMainOf(const IArrangement& a) const;
  PointF ToPoint(double main, double cross) const;
  RectF ToRect(double mainStart, double crossStart, double mainSize, double crossSize) const;

  // The last answer of an expansion query. A parent's distribution and its placing often ask a
  // child the same question; the memo saves the descent to the bottom of a growing subtree.
  struct ExpansionMemo {
    float available = std::numeric_limits<float>::quiet_NaN();
    float result = 0;
  };

  void Distribute(float innerMain, float innerCross);
  void ShareSpace(double& extra, bool growing);
  void PlaceSeparator(std::size_t gap, double mainPosition, double crossPosition, double crossSize);

  LineAxis axis_;
  bool outer_;
  bool holdsLines_ = false;
  bool mainExpandable_ = false;
  bool crossExpandable_ = false;
  mutable bool bestComputed_ = false;
  bool tableComputed_ = false;
  AbstractArrangeableGroup* group_;
  LineParameters parameters_;
  float minMain_ = -1;
  float minCross_ = -1;
  mutable float bestMain_ = -1;
  mutable float bestCross_ = -1;
  mutable ExpansionMemo expandedMainMemo_;
  mutable ExpansionMemo expandedCrossMemo_;
  std::vector<IArrangementP> children_;
  std::vector<ISeparator*> separators_;
  std::vector<ISeparator*> hiddenSeparators_;

  // The distribution for the inner size it was last computed for.
  std::vector<Entry> table_;
  PointF tableSize_{};
  double usedMain_ = 0;
};

class RowArrangement : public GroupArrangement {
 public:
  RowArrangement(AbstractArrangeableGroup* group, std::vector<IArrangementP> children,
                 std::vector<ISeparator*> separators, std::vector<ISeparator*> hiddenSeparators,
                 const LineParameters& parameters, bool outer)
      : GroupArrangement(LineAxis::Horizontal, group, std::move(children), std::move(separators),
                         std::move(hiddenSeparators), parameters, outer) {}
};

class ColumnArrangement : public GroupArrangement {
 public:
  ColumnArrangement(AbstractArrangeableGroup* group, std::vector<IArrangementP> children,
                    std::vector<ISeparator*> separators, std::vector<ISeparator*> hiddenSeparators,
                    const LineParameters& parameters, bool outer)
      : GroupArrangement(LineAxis::Vertical, group, std::move(children), std::move(separators),
                         std::move(hiddenSeparators), parameters, outer) {}
};

}  // namespace velkui::arrange::impl
