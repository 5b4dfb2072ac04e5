#include <velkui/layout/Spacers.h>

#include <cmath>
#include <utility>

#include <velkcore/Error.h>

namespace velkui::layout {

namespace {

float CheckedLength(float length) {
  velkcore::RequireInput(std::isfinite(length) && length >= 0);
  return length;
}

ExtraSpaceAlgorithmP ExtraSpaceRule(bool keepsExtraSpace) {
  return keepsExtraSpace ? ExtraSpace_Keep::GetSharedPtr() : ExtraSpace_Pass::GetSharedPtr();
}

}  // namespace

SpacerOnTheLeft::SpacerOnTheLeft(SmartLayoutP decorated, float width, bool keepsExtraSpace)
    : StrategicLayoutDecorator({CheckedLength(width), 0}, std::move(decorated),
                               LayoutPlacement_LeftOfDO::GetSharedPtr(),
                               ExtraSpaceRule(keepsExtraSpace)) {}

SpacerOnTheRight::SpacerOnTheRight(SmartLayoutP decorated, float width, bool keepsExtraSpace)
    : StrategicLayoutDecorator({CheckedLength(width), 0}, std::move(decorated),
                               LayoutPlacement_RightOfDO::GetSharedPtr(),
                               ExtraSpaceRule(keepsExtraSpace)) {}

SpacerOnTheTop::SpacerOnTheTop(SmartLayoutP decorated, float height, bool keepsExtraSpace)
    : StrategicLayoutDecorator({0, CheckedLength(height)}, std::move(decorated),
                               LayoutPlacement_AboveDO::GetSharedPtr(),
                               ExtraSpaceRule(keepsExtraSpace)) {}

SpacerOnTheBottom::SpacerOnTheBottom(SmartLayoutP decorated, float height, bool keepsExtraSpace)
    : StrategicLayoutDecorator({0, CheckedLength(height)}, std::move(decorated),
                               LayoutPlacement_BelowDO::GetSharedPtr(),
                               ExtraSpaceRule(keepsExtraSpace)) {}

SpacerOnAllSides::SpacerOnAllSides(SmartLayoutP decorated, float size)
    : SpacerOnTheLeft(
          new SpacerOnTheRight(
              new SpacerOnTheTop(new SpacerOnTheBottom(std::move(decorated), size, false), size,
                                 false),
              size, false),
          size, false) {}

}  // namespace velkui::layout
