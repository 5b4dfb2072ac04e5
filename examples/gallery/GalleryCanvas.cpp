#include "GalleryCanvas.h"

#include <velkui/pictel/ImageIO.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PathShapes.h>

namespace gallery {

using namespace velkui::pictel;

namespace {

// The gallery pins its face so that the picture is the same everywhere.
constexpr const char16_t* kFamily = u"DejaVu Sans";

}  // namespace

GalleryCanvas::GalleryCanvas(std::int32_t width, std::int32_t height)
    : supplier_(NewOSSupplier()),
      surface_(*supplier_, width, height, false),
      pictel_(supplier_.get(), surface_.Get()),
      titleFont_(*supplier_, kFamily, u"Bold", 15),
      labelFont_(*supplier_, kFamily, u"", 11),
      bodyFont_(*supplier_, kFamily, u"", 13),
      boldFont_(*supplier_, kFamily, u"Bold", 13),
      italicFont_(*supplier_, kFamily, u"Italic", 13) {}

RectT<float> GalleryCanvas::Card(const RectT<float>& frame, const char16_t* title) {
  // Shadow: a few widening, fading outlines below the card.
  for (int i = 4; i >= 1; --i) {
    PathP shadow;
    const float spread = static_cast<float>(i);
    velkui::GetRoundedRectPath(supplier_.get(),
                               {frame.left - spread + 1, frame.top - spread + 3,
                                frame.width + 2 * spread - 2, frame.height + 2 * spread - 2},
                               10 + spread, &shadow);
    Fill(shadow, {0.1f, 0.15f, 0.25f, 0.035f});
  }
  PathP body;
  velkui::GetRoundedRectPath(supplier_.get(), frame, 10, &body);
  Fill(body, {1, 1, 1, 1});
  BrushP ink(*supplier_, kInk);
  surface_->DrawString(*ink, *titleFont_, title, {frame.left + 18, frame.top + 30},
                       TextAlignment::kStart, TextTruncation::kNone, 0);
  surface_->PaintRect({0.90f, 0.92f, 0.95f, 1},
                      {frame.left + 18, frame.top + 42, frame.width - 36, 1});
  return {frame.left + 18, frame.top + 54, frame.width - 36, frame.height - 68};
}

void GalleryCanvas::Label(const char16_t* text, const PointT<float>& at, TextAlignment alignment,
                          const ColorRGBA& color) {
  BrushP brush(*supplier_, color);
  surface_->DrawString(*brush, *labelFont_, text, at, alignment, TextTruncation::kNone, 0);
}

void GalleryCanvas::Fill(const PathP& path, const ColorRGBA& color, FillType rule) {
  BrushP brush(*supplier_, color);
  surface_->FillPath(*brush, *path, rule);
}

void GalleryCanvas::Stroke(const PathP& path, const PenP& pen) {
  surface_->StrokePath(*pen, *path);
}

void GalleryCanvas::Guide(const PointT<float>& from, const PointT<float>& to) {
  PenP pen = NewPen({0.85f, 0.35f, 0.35f, 0.9f}, 1);
  const float dashes[2] = {3, 3};
  pen->SetDashArray(dashes, 2);
  PathP line = NewPath();
  line->MoveTo(
      PointT<std::int32_t>{static_cast<std::int32_t>(from.x), static_cast<std::int32_t>(from.y)});
  line->LineTo(
      PointT<std::int32_t>{static_cast<std::int32_t>(to.x), static_cast<std::int32_t>(to.y)});
  Stroke(line, pen);
}

void GalleryCanvas::Save(const std::string& file) const {
  surface_->Flush();
  WriteImageToPNGFile(*surface_->GetSurfaceImage(), file);
}

}  // namespace gallery
