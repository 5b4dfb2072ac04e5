#pragma once

#include <cstdint>

#include <velkcore/Geometry.h>
#include <velkcore/RefCountedObject.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::pictel {

// A figure list in user units, made by a supplier and consumed by a surface.
// A path built only through the integer overloads is "whole-numbered": the
// backend then draws it on pixel edges without the half-pixel shift.
class PathInterface : public virtual velkcore::RefCountedObject {
 public:
  ~PathInterface() override = default;

  virtual void MoveTo(const velkcore::PointT<std::int32_t>& point);
  virtual void MoveTo(const velkcore::PointT<float>& point) = 0;
  virtual void LineTo(const velkcore::PointT<std::int32_t>& point);
  virtual void LineTo(const velkcore::PointT<float>& point) = 0;
  virtual void BezierTo(const velkcore::PointT<std::int32_t>& control1,
                        const velkcore::PointT<std::int32_t>& control2,
                        const velkcore::PointT<std::int32_t>& end);
  // Two control points, then the end point.
  virtual void BezierTo(const velkcore::PointT<float>& control1,
                        const velkcore::PointT<float>& control2,
                        const velkcore::PointT<float>& end) = 0;
  virtual void AddRect(const velkcore::RectT<std::int32_t>& rect);
  // A closed rectangle figure.
  virtual void AddRect(const velkcore::RectT<float>& rect) = 0;
  // A circular arc joined to the current figure; angles in degrees, clockwise on
  // screen (y grows downwards). Radius 0 degenerates to LineTo(centre).
  virtual void AddArc(const velkcore::PointT<float>& centre, float radius, float startAngle,
                      float sweepAngle) = 0;
  // Closes the current figure.
  virtual void Close() = 0;

  bool IsWholeNumbered() const { return wholeNumbered_; }

 protected:
  // Float overloads of implementations call this: their geometry may fall between pixels.
  void ClearWholeNumbered() { wholeNumbered_ = false; }

 private:
  bool wholeNumbered_ = true;
};

}  // namespace velkui::pictel
