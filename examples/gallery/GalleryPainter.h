#pragma once

#include <string>
#include <vector>

#include <velkui/pictel/PathShapes.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/Theme.h>

namespace gallery {

// Drawing conveniences for the pages that paint by hand: shapes, gradients
// and text in the theme's font, on one surface.
class Painter {
 public:
  using Color = velkui::pictel::ColorRGBA;
  using Rect = velkcore::RectT<float>;
  using Point = velkcore::PointT<float>;

  Painter(const velkui::pictel::SupplierInterface& supplier,
          velkui::pictel::SurfaceInterface& surface)
      : supplier_(supplier), surface_(surface) {}
  // One paint of one node.
  explicit Painter(velkui::pictel::Pictel* context)
      : Painter(*context->GetSupplier(), *context->GetSurface()) {}

  void Fill(const Rect& r, const Color& color) { surface_.PaintRect(color, r); }
  void FillRound(const Rect& r, float radius, const Color& color) {
    surface_.FillPath(*Brush(color), *RoundedRect(r, radius), kWinding);
  }
  void StrokeRound(const Rect& r, float radius, const Color& color, float width = 1) {
    surface_.StrokePath(*velkui::pictel::PenP(supplier_, color, width), *RoundedRect(r, radius));
  }
  // Top to bottom; rounded when `radius` > 0.
  void Gradient(const Rect& r, const Color& top, const Color& bottom, float radius = 0) {
    const auto shader =
        supplier_.NewLinearShader({r.left, r.top}, {r.left, r.top + r.height}, top, bottom);
    velkui::pictel::PathP path;
    if (radius > 0) {
      path = RoundedRect(r, radius);
    } else {
      path = velkui::pictel::PathP(supplier_);
      path->AddRect(r);
    }
    surface_.ShadePath(*shader, *path, kWinding);
  }
  void Line(Point a, Point b, const Color& color, float width = 1) {
    velkui::pictel::PathP path(supplier_);
    path->MoveTo(a);
    path->LineTo(b);
    surface_.StrokePath(*velkui::pictel::PenP(supplier_, color, width), *path);
  }
  void Polygon(const std::vector<Point>& points, const Color& color) {
    velkui::pictel::PathP path(supplier_);
    path->MoveTo(points.front());
    for (std::size_t i = 1; i < points.size(); ++i) path->LineTo(points[i]);
    path->Close();
    surface_.FillPath(*Brush(color), *path, kWinding);
  }
  void Text(const std::u16string& text, Point at, const Color& color, float size, bool bold = false,
            velkui::pictel::TextAlignment alignment = velkui::pictel::TextAlignment::kStart) {
    surface_.DrawString(*Brush(color), *Font(size, bold), text.c_str(), at, alignment,
                        velkui::pictel::TextTruncation::kEndEllipsis, 2000);
  }
  // Text wrapped to `width` from `topLeft`; returns its height.
  float Paragraph(const std::u16string& text, Point topLeft, float width, const Color& color,
                  float size) {
    const velkui::pictel::FontP font = Font(size, false);
    const float height = surface_.MeasureMultiLineStringHeight(
        *font, text.c_str(), width, static_cast<std::int32_t>(text.size()));
    surface_.DrawMultiLineString(*Brush(color), *font, text.c_str(),
                                 {topLeft.x, topLeft.y, width, height + 4},
                                 velkui::pictel::TextAlignment::kStart);
    return height;
  }
  // A soft shadow under a window: a few widening, fading layers.
  void Shadow(const Rect& r) {
    for (int i = 0; i < 6; ++i) {
      const auto spread = static_cast<float>(i) * 2.0f;
      FillRound({r.left - spread, r.top - spread + 6, r.width + 2 * spread, r.height + 2 * spread},
                4 + spread, {0.02f, 0.04f, 0.10f, 0.07f});
    }
  }
  // `image`'s pixels inside `source` (image coordinates), drawn with their top-left at `at`.
  void Crop(const velkui::pictel::ImageInterface& image, const Rect& source, Point at) {
    surface_.PushStateStack();
    velkui::pictel::PathP clip(supplier_);
    clip->AddRect(Rect{at.x, at.y, source.width, source.height});
    surface_.Clip(*clip, kWinding);
    surface_.DrawImage(image, {at.x - source.left, at.y - source.top}, 1.0f);
    surface_.PopStateStack();
  }

  static std::u16string FontFamily() { return velkui::ui::Theme::Get().GetFontName(0); }

 private:
  static constexpr velkui::pictel::FillType kWinding = velkui::pictel::FillType::kWinding;

  velkui::pictel::FontP Font(float size, bool bold) const {
    return velkui::pictel::FontP(supplier_, FontFamily(), bold ? u"Bold" : u"", size);
  }
  velkui::pictel::BrushP Brush(const Color& color) const {
    return velkui::pictel::BrushP(supplier_, color);
  }
  velkui::pictel::PathP RoundedRect(const Rect& r, float radius) const {
    velkui::pictel::PathP path;
    velkui::GetRoundedRectPath(&supplier_, r, radius, &path);
    return path;
  }

  const velkui::pictel::SupplierInterface& supplier_;
  velkui::pictel::SurfaceInterface& surface_;
};

}  // namespace gallery
