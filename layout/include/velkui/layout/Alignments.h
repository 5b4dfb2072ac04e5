#pragma once

#include <velkui/layout/LayoutDecorator.h>

namespace velkui::layout {

// Centres the decorated object horizontally in the area it is given, at its initial width
// (whole-numbered: the left edge floored, the width rounded up). An object at least as wide
// as the area gets the area unchanged.
class AlignHorizontallyCentered : public LayoutDecorator {
 public:
  explicit AlignHorizontallyCentered(SmartLayoutP decorated);
  void SetLocation(const RectF& rect) override;
};

// The same on heights.
class AlignVerticallyCentered : public LayoutDecorator {
 public:
  explicit AlignVerticallyCentered(SmartLayoutP decorated);
  void SetLocation(const RectF& rect) override;
};

}  // namespace velkui::layout
