#include <velkui/pictel/PathInterface.h>

namespace velkui::pictel {

namespace {

velkcore::PointT<float> ToFloat(const velkcore::PointT<std::int32_t>& p) {
  return {static_cast<float>(p.x), static_cast<float>(p.y)};
}

}  // namespace

// The integer overloads go through the float ones, which clear the
// whole-numbered mark; integer geometry keeps the mark it had.

void PathInterface::MoveTo(const velkcore::PointT<std::int32_t>& point) {
  const bool whole = wholeNumbered_;
  MoveTo(ToFloat(point));
  wholeNumbered_ = whole;
}

void PathInterface::LineTo(const velkcore::PointT<std::int32_t>& point) {
  const bool whole = wholeNumbered_;
  LineTo(ToFloat(point));
  wholeNumbered_ = whole;
}

void PathInterface::BezierTo(const velkcore::PointT<std::int32_t>& control1,
                             const velkcore::PointT<std::int32_t>& control2,
                             const velkcore::PointT<std::int32_t>& end) {
  const bool whole = wholeNumbered_;
  BezierTo(ToFloat(control1), ToFloat(control2), ToFloat(end));
  wholeNumbered_ = whole;
}

void PathInterface::AddRect(const velkcore::RectT<std::int32_t>& rect) {
  const bool whole = wholeNumbered_;
  AddRect(velkcore::RectT<float>{static_cast<float>(rect.left), static_cast<float>(rect.top),
                                 static_cast<float>(rect.width), static_cast<float>(rect.height)});
  wholeNumbered_ = whole;
}

}  // namespace velkui::pictel
