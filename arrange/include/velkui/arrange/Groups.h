#pragma once

#include <velkui/arrange/AbstractArrangeableGroup.h>

namespace velkui::arrange {

namespace impl {

// The candidates of each group kind for one combination of child candidates:
// Row: one row; Column: one column; Flipping: a row and a column; HorizontalWrapping: for
// k = 1..n, k children per line, lines stacked in a column; VerticalWrapping: k per column,
// columns side by side; AutoLayout: both wrappings.
void BuildArrangementsOfType(GroupArrangementType type, AbstractArrangeableGroup& group,
                             const AbstractArrangeableGroup::Combination& combination,
                             ArrangementSet& set);
int CandidatesPerCombinationOfType(GroupArrangementType type, int childCount);

template <GroupArrangementType kType>
class FixedGroup : public AbstractArrangeableGroup {
 public:
  using AbstractArrangeableGroup::AbstractArrangeableGroup;
  static constexpr GroupArrangementType kArrangementType = kType;

 protected:
  void BuildArrangements(const Combination& combination, ArrangementSet& set) override {
    BuildArrangementsOfType(kType, *this, combination, set);
  }
  int CandidatesPerCombination(int childCount) const override {
    return CandidatesPerCombinationOfType(kType, childCount);
  }
};

}  // namespace impl

class Row : public impl::FixedGroup<GroupArrangementType::Row> {
 public:
  using FixedGroup::FixedGroup;
};

class Column : public impl::FixedGroup<GroupArrangementType::Column> {
 public:
  using FixedGroup::FixedGroup;
};

class Flipping : public impl::FixedGroup<GroupArrangementType::Flipping> {
 public:
  using FixedGroup::FixedGroup;
};

class HorizontalWrapping : public impl::FixedGroup<GroupArrangementType::HorizontalWrapping> {
 public:
  using FixedGroup::FixedGroup;
};

class VerticalWrapping : public impl::FixedGroup<GroupArrangementType::VerticalWrapping> {
 public:
  using FixedGroup::FixedGroup;
};

class AutoLayout : public impl::FixedGroup<GroupArrangementType::AutoLayout> {
 public:
  using FixedGroup::FixedGroup;
};

}  // namespace velkui::arrange
