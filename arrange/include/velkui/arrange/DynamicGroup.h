#pragma once

#include <velkui/arrange/AbstractArrangeableGroup.h>

namespace velkui::arrange {

// A group whose kind can change at run time. Changing the kind drops every candidate; the
// children, separators and parameters stay.
class DynamicGroup : public impl::AbstractArrangeableGroup {
 public:
  // Raises the contract violation for an unknown type.
  DynamicGroup(IArrangeable* parent, GroupArrangementType type);

  // Switches to `type` under `parent`; when either changed, the old candidates are released
  // and the group is invalidated.
  void SetArrangementType(GroupArrangementType type, IArrangeable* parent);
  GroupArrangementType ArrangementType() const { return type_; }

 protected:
  void BuildArrangements(const Combination& combination, impl::ArrangementSet& set) override;
  int CandidatesPerCombination(int childCount) const override;

 private:
  GroupArrangementType type_;
};

}  // namespace velkui::arrange
