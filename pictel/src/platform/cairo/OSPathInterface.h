#pragma once

#include <vector>

#include <velkui/pictel/PathInterface.h>

#include "CairoPointers.h"

namespace velkui::pictel::cairo {

// A path kept as Cairo path data, appended to a context in one call.
class OSPathInterface : public PathInterface {
 public:
  using PathInterface::AddRect;
  using PathInterface::BezierTo;
  using PathInterface::LineTo;
  using PathInterface::MoveTo;

  OSPathInterface();

  void MoveTo(const velkcore::PointT<float>& point) override;
  void LineTo(const velkcore::PointT<float>& point) override;
  void BezierTo(const velkcore::PointT<float>& control1, const velkcore::PointT<float>& control2,
                const velkcore::PointT<float>& end) override;
  void AddRect(const velkcore::RectT<float>& rect) override;
  void AddArc(const velkcore::PointT<float>& centre, float radius, float startAngle,
              float sweepAngle) override;
  void Close() override;

  // Appends the figures to the context's current path (under its matrix).
  void AppendTo(cairo_t* context) const;
  bool IsEmpty() const { return data_.empty(); }
  // Whether some segment moves along x (its thickness then lies in y), or along y.
  bool SpansX() const { return spansX_; }
  bool SpansY() const { return spansY_; }

 private:
  void AddHeader(cairo_path_data_type_t type, int length);
  void AddPoint(double x, double y);
  void AddArcSegment(double cx, double cy, double radius, double from, double to);
  void NoteSegment(double x0, double y0, double x1, double y1);

  std::vector<cairo_path_data_t> data_;
  bool hasCurrentPoint_ = false;
  bool figureOpen_ = false;
  bool spansX_ = false;
  bool spansY_ = false;
  velkcore::PointT<double> current_{};
  velkcore::PointT<double> figureStart_{};
};

}  // namespace velkui::pictel::cairo
