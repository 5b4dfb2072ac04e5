#pragma once

#include <cstdint>

#include <velkcore/RefCountedObject.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::pictel {

// Stroke settings. Out-of-range caps and joins raise 26 and 27 and change nothing.
class PenInterface : public virtual velkcore::RefCountedObject {
 public:
  ~PenInterface() override = default;

  virtual void SetWidth(float width) = 0;
  virtual float GetWidth() const = 0;
  virtual void SetMiterLimit(float limit) = 0;
  virtual float GetMiterLimit() const = 0;
  virtual void SetLineJoin(LineJoinType join) = 0;
  virtual LineJoinType GetLineJoin() const = 0;
  // Start, end and dash caps alike.
  virtual void SetLineCap(LineCapType cap) = 0;
  virtual LineCapType GetLineCap() const = 0;
  // Dash and gap lengths in multiples of the pen width; count 0 draws solid.
  virtual void SetDashArray(const float* dashes, std::int32_t count) = 0;
  // Copies up to `count` entries.
  virtual void GetDashArray(float* dashes, std::int32_t count) const = 0;
  virtual std::int32_t GetDashCount() const = 0;
};

}  // namespace velkui::pictel
