#include <velkui/layout/Alignments.h>

#include <cmath>
#include <utility>

namespace velkui::layout {

namespace {

// Centres a length inside [start, start + available) when it is shorter; whole-numbered.
void Centre(float length, float& start, float& available) {
  if (!(length < available)) return;
  start = std::floor(start + available / 2 - length / 2);
  available = std::ceil(length);
}

}  // namespace

AlignHorizontallyCentered::AlignHorizontallyCentered(SmartLayoutP decorated)
    : LayoutDecorator({0, 0}, std::move(decorated)) {}

void AlignHorizontallyCentered::SetLocation(const RectF& rect) {
  RectF placed = rect;
  Centre(GetDecoratedObject()->GetInitialSize().x, placed.left, placed.width);
  GetDecoratedObject()->SetLocation(placed);
}

AlignVerticallyCentered::AlignVerticallyCentered(SmartLayoutP decorated)
    : LayoutDecorator({0, 0}, std::move(decorated)) {}

void AlignVerticallyCentered::SetLocation(const RectF& rect) {
  RectF placed = rect;
  Centre(GetDecoratedObject()->GetInitialSize().y, placed.top, placed.height);
  GetDecoratedObject()->SetLocation(placed);
}

}  // namespace velkui::layout
