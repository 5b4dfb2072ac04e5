#include <velkui/arrange/DynamicGroup.h>

#include <velkcore/Error.h>
#include <velkui/arrange/Groups.h>

namespace velkui::arrange {

DynamicGroup::DynamicGroup(IArrangeable* parent, GroupArrangementType type)
    : AbstractArrangeableGroup(parent), type_(type) {
  velkcore::RequireInput(IsValidArrangementType(type));
}

void DynamicGroup::SetArrangementType(GroupArrangementType type, IArrangeable* parent) {
  velkcore::RequireInput(IsValidArrangementType(type));
  if (type == type_ && parent == Parent()) return;
  SetParent(parent);
  type_ = type;
  ReleaseCandidates();
  Invalidate();
}

void DynamicGroup::BuildArrangements(const Combination& combination, impl::ArrangementSet& set) {
  impl::BuildArrangementsOfType(type_, *this, combination, set);
}

int DynamicGroup::CandidatesPerCombination(int childCount) const {
  return impl::CandidatesPerCombinationOfType(type_, childCount);
}

}  // namespace velkui::arrange
