#include <velkui/layout/SmartLayout.h>

#include <cmath>

#include <velkcore/Error.h>

namespace velkui::layout {

namespace {

void RequireSize(const PointF& size) {
  velkcore::RequireInput(std::isfinite(size.x) && std::isfinite(size.y) && size.x >= 0 &&
                         size.y >= 0);
}

}  // namespace

SmartLayout::SmartLayout(const PointF& initialSize) : initialSize_(initialSize) {
  RequireSize(initialSize);
}

SmartLayout::~SmartLayout() = default;

PointF SmartLayout::GetInitialSize() const {
  return initialSize_;
}

void SmartLayout::SetInitialSize(const PointF& size) {
  RequireSize(size);
  initialSize_ = size;
}

EmptyLayout::EmptyLayout() : SmartLayout({0, 0}) {}

void EmptyLayout::SetLocation(const RectF& /*rect*/) {}

const SmartLayoutP& EmptyLayout::GetSharedPtr() {
  static const SmartLayoutP shared(new EmptyLayout());
  return shared;
}

}  // namespace velkui::layout
