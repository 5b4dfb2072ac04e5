#include "OSPathInterface.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include <velkcore/Error.h>

namespace velkui::pictel::cairo {

using velkcore::PointT;

namespace {

void RequireFinite(const PointT<float>& point) {
  velkcore::RequireInput(std::isfinite(point.x) && std::isfinite(point.y));
}

double Radians(double degrees) {
  return degrees * std::numbers::pi / 180.0;
}

}  // namespace

void OSPathInterface::AddHeader(cairo_path_data_type_t type, int length) {
  cairo_path_data_t header;
  header.header.type = type;
  header.header.length = length;
  data_.push_back(header);
}

void OSPathInterface::AddPoint(double x, double y) {
  cairo_path_data_t point;
  point.point.x = x;
  point.point.y = y;
  data_.push_back(point);
}

// Room for a rounded rectangle or an ellipse without growing.
OSPathInterface::OSPathInterface() {
  data_.reserve(32);
}

void OSPathInterface::NoteSegment(double x0, double y0, double x1, double y1) {
  spansX_ = spansX_ || x0 != x1;
  spansY_ = spansY_ || y0 != y1;
}

void OSPathInterface::MoveTo(const PointT<float>& point) {
  RequireFinite(point);
  ClearWholeNumbered();
  AddHeader(CAIRO_PATH_MOVE_TO, 2);
  AddPoint(point.x, point.y);
  current_ = figureStart_ = {point.x, point.y};
  hasCurrentPoint_ = true;
  figureOpen_ = true;
}

void OSPathInterface::LineTo(const PointT<float>& point) {
  RequireFinite(point);
  if (!hasCurrentPoint_) {
    MoveTo(point);
    return;
  }
  ClearWholeNumbered();
  NoteSegment(current_.x, current_.y, point.x, point.y);
  AddHeader(CAIRO_PATH_LINE_TO, 2);
  AddPoint(point.x, point.y);
  current_ = {point.x, point.y};
  figureOpen_ = true;
}

void OSPathInterface::BezierTo(const PointT<float>& control1, const PointT<float>& control2,
                               const PointT<float>& end) {
  RequireFinite(control1);
  RequireFinite(control2);
  RequireFinite(end);
  if (!hasCurrentPoint_) MoveTo(control1);
  ClearWholeNumbered();
  spansX_ = spansY_ = true;
  AddHeader(CAIRO_PATH_CURVE_TO, 4);
  AddPoint(control1.x, control1.y);
  AddPoint(control2.x, control2.y);
  AddPoint(end.x, end.y);
  current_ = {end.x, end.y};
  figureOpen_ = true;
}

void OSPathInterface::AddRect(const velkcore::RectT<float>& rect) {
  const float right = rect.Right();
  const float bottom = rect.Bottom();
  MoveTo(PointT<float>{rect.left, rect.top});
  LineTo(PointT<float>{right, rect.top});
  LineTo(PointT<float>{right, bottom});
  LineTo(PointT<float>{rect.left, bottom});
  Close();
}

// Angles grow clockwise on screen (y points down), as Cairo's do.
void OSPathInterface::AddArc(const PointT<float>& centre, float radius, float startAngle,
                             float sweepAngle) {
  RequireFinite(centre);
  velkcore::RequireInput(std::isfinite(radius) && radius >= 0.0f && std::isfinite(startAngle) &&
                         std::isfinite(sweepAngle));
  if (radius == 0.0f) {
    LineTo(centre);
    return;
  }
  const double sweep = std::clamp(static_cast<double>(sweepAngle), -360.0, 360.0);
  const double from = Radians(startAngle);
  const PointT<float> start{static_cast<float>(centre.x + radius * std::cos(from)),
                            static_cast<float>(centre.y + radius * std::sin(from))};
  if (hasCurrentPoint_) {
    LineTo(start);
  } else {
    MoveTo(start);
  }
  ClearWholeNumbered();
  // At most a quarter turn per Bezier segment keeps the error far below a pixel.
  const int segments = std::max(1, static_cast<int>(std::ceil(std::fabs(sweep) / 90.0)));
  const double step = Radians(sweep) / segments;
  for (int i = 0; i < segments; ++i) {
    AddArcSegment(centre.x, centre.y, radius, from + step * i, from + step * (i + 1));
  }
}

void OSPathInterface::AddArcSegment(double cx, double cy, double radius, double from, double to) {
  const double k = 4.0 / 3.0 * std::tan((to - from) / 4.0) * radius;
  const double x0 = cx + radius * std::cos(from);
  const double y0 = cy + radius * std::sin(from);
  const double x3 = cx + radius * std::cos(to);
  const double y3 = cy + radius * std::sin(to);
  spansX_ = spansY_ = true;
  AddHeader(CAIRO_PATH_CURVE_TO, 4);
  AddPoint(x0 - k * std::sin(from), y0 + k * std::cos(from));
  AddPoint(x3 + k * std::sin(to), y3 - k * std::cos(to));
  AddPoint(x3, y3);
  current_ = {x3, y3};
}

void OSPathInterface::Close() {
  if (!figureOpen_) return;
  NoteSegment(current_.x, current_.y, figureStart_.x, figureStart_.y);
  AddHeader(CAIRO_PATH_CLOSE_PATH, 1);
  current_ = figureStart_;
  figureOpen_ = false;
}

void OSPathInterface::AppendTo(cairo_t* context) const {
  if (data_.empty()) return;
  cairo_path_t path;
  path.status = CAIRO_STATUS_SUCCESS;
  path.data = const_cast<cairo_path_data_t*>(data_.data());
  path.num_data = static_cast<int>(data_.size());
  cairo_append_path(context, &path);
}

}  // namespace velkui::pictel::cairo
