#pragma once

#include <string>
#include <vector>

#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>

namespace gallery {

// Drawing conveniences for the pages that paint by hand: shapes, gradients
// and text in the theme's font, on one surface.
class Painter {
 public:
  Painter(const velkui::pictel::SupplierInterface& supplier,
          velkui::pictel::SurfaceInterface& surface)
      : supplier_(supplier), surface_(surface) {}
  // One paint of one node.
  explicit Painter(velkui::pictel::Pictel* context)
      : Painter(*context->GetSupplier(), *context->GetSurface()) {}

  using Color = velkui::pictel::ColorRGBA;
  using Rect = velkcore::RectT<float>;
  using Point = velkcore::PointT<float>;

  void Fill(const Rect& r, const Color& color);
  void FillRound(const Rect& r, float radius, const Color& color);
  void StrokeRound(const Rect& r, float radius, const Color& color, float width = 1);
  // Top to bottom; rounded when `radius` > 0.
  void Gradient(const Rect& r, const Color& top, const Color& bottom, float radius = 0);
  void Line(Point a, Point b, const Color& color, float width = 1);
  void Polygon(const std::vector<Point>& points, const Color& color);
  void Text(const std::u16string& text, Point at, const Color& color, float size, bool bold = false,
            velkui::pictel::TextAlignment alignment = velkui::pictel::TextAlignment::kStart);
  // Text wrapped to `width` from `topLeft`; returns its height.
  float Paragraph(const std::u16string& text, Point topLeft, float width, const Color& color,
                  float size);
  // A soft shadow under a window: a few widening, fading layers.
  void Shadow(const Rect& r);
  // `image`'s pixels inside `source` (image coordinates), drawn with their top-left at `at`.
  void Crop(const velkui::pictel::ImageInterface& image, const Rect& source, Point at);

  static std::u16string FontFamily();

 private:
  velkui::pictel::FontP Font(float size, bool bold) const;

  const velkui::pictel::SupplierInterface& supplier_;
  velkui::pictel::SurfaceInterface& surface_;
};

}  // namespace gallery
