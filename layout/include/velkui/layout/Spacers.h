#pragma once

#include <velkui/layout/StrategicLayoutDecorator.h>

namespace velkui::layout {

// Empty space beside a decorated object. With `keepsExtraSpace` the spacer takes whatever
// space the area has beyond both wanted sizes (pushing the object to the far end); otherwise
// the object takes it. Negative or non-finite sizes raise the contract violation.

class SpacerOnTheLeft : public StrategicLayoutDecorator {
 public:
  SpacerOnTheLeft(SmartLayoutP decorated, float width, bool keepsExtraSpace);
};

class SpacerOnTheRight : public StrategicLayoutDecorator {
 public:
  SpacerOnTheRight(SmartLayoutP decorated, float width, bool keepsExtraSpace);
};

class SpacerOnTheTop : public StrategicLayoutDecorator {
 public:
  SpacerOnTheTop(SmartLayoutP decorated, float height, bool keepsExtraSpace);
};

class SpacerOnTheBottom : public StrategicLayoutDecorator {
 public:
  SpacerOnTheBottom(SmartLayoutP decorated, float height, bool keepsExtraSpace);
};

// `size` of space on every side: a left spacer around a right spacer around a top spacer around
// a bottom spacer around the object. None of them keeps extra space, so the object takes all
// the room inside the margins.
class SpacerOnAllSides : public SpacerOnTheLeft {
 public:
  SpacerOnAllSides(SmartLayoutP decorated, float size);
};

}  // namespace velkui::layout
