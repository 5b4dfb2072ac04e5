#include "GalleryPainter.h"

#include <velkui/pictel/PathShapes.h>
#include <velkui/ui/Theme.h>

namespace gallery {

namespace pictel = velkui::pictel;

void Painter::Fill(const Rect& r, const Color& color) {
  surface_.PaintRect(color, r);
}

void Painter::FillRound(const Rect& r, float radius, const Color& color) {
  pictel::PathP path;
  velkui::GetRoundedRectPath(&supplier_, r, radius, &path);
  surface_.FillPath(*pictel::BrushP(supplier_, color), *path, pictel::FillType::kWinding);
}

void Painter::StrokeRound(const Rect& r, float radius, const Color& color, float width) {
  pictel::PathP path;
  velkui::GetRoundedRectPath(&supplier_, r, radius, &path);
  surface_.StrokePath(*pictel::PenP(supplier_, color, width), *path);
}

void Painter::Gradient(const Rect& r, const Color& top, const Color& bottom, float radius) {
  const auto shader =
      supplier_.NewLinearShader({r.left, r.top}, {r.left, r.top + r.height}, top, bottom);
  pictel::PathP path;
  if (radius > 0) {
    velkui::GetRoundedRectPath(&supplier_, r, radius, &path);
  } else {
    path = pictel::PathP(supplier_);
    path->AddRect(r);
  }
  surface_.ShadePath(*shader, *path, pictel::FillType::kWinding);
}

void Painter::Line(Point a, Point b, const Color& color, float width) {
  pictel::PathP path(supplier_);
  path->MoveTo(a);
  path->LineTo(b);
  surface_.StrokePath(*pictel::PenP(supplier_, color, width), *path);
}

void Painter::Polygon(const std::vector<Point>& points, const Color& color) {
  pictel::PathP path(supplier_);
  path->MoveTo(points.front());
  for (std::size_t i = 1; i < points.size(); ++i) path->LineTo(points[i]);
  path->Close();
  surface_.FillPath(*pictel::BrushP(supplier_, color), *path, pictel::FillType::kWinding);
}

void Painter::Text(const std::u16string& text, Point at, const Color& color, float size, bool bold,
                   pictel::TextAlignment alignment) {
  surface_.DrawString(*pictel::BrushP(supplier_, color), *Font(size, bold), text.c_str(), at,
                      alignment, pictel::TextTruncation::kEndEllipsis, 2000);
}

float Painter::Paragraph(const std::u16string& text, Point topLeft, float width, const Color& color,
                         float size) {
  const pictel::FontP font = Font(size, false);
  const float height = surface_.MeasureMultiLineStringHeight(
      *font, text.c_str(), width, static_cast<std::int32_t>(text.size()));
  surface_.DrawMultiLineString(*pictel::BrushP(supplier_, color), *font, text.c_str(),
                               {topLeft.x, topLeft.y, width, height + 4},
                               pictel::TextAlignment::kStart);
  return height;
}

void Painter::Shadow(const Rect& r) {
  for (int i = 0; i < 6; ++i) {
    const auto spread = static_cast<float>(i) * 2.0f;
    FillRound({r.left - spread, r.top - spread + 6, r.width + 2 * spread, r.height + 2 * spread},
              4 + spread, {0.02f, 0.04f, 0.10f, 0.07f});
  }
}

void Painter::Crop(const pictel::ImageInterface& image, const Rect& source, Point at) {
  surface_.PushStateStack();
  pictel::PathP clip(supplier_);
  clip->AddRect(Rect{at.x, at.y, source.width, source.height});
  surface_.Clip(*clip, pictel::FillType::kWinding);
  surface_.DrawImage(image, {at.x - source.left, at.y - source.top}, 1.0f);
  surface_.PopStateStack();
}

std::u16string Painter::FontFamily() {
  return velkui::ui::Theme::Get().GetFontName(0);
}

pictel::FontP Painter::Font(float size, bool bold) const {
  return pictel::FontP(supplier_, FontFamily(), bold ? u"Bold" : u"", size);
}

}  // namespace gallery
