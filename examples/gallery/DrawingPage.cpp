// The drawing showcase: the pictel API on one page.
#include <velkui/pictel/PictelHandles.h>

#include "GalleryCanvas.h"
#include "GalleryPage.h"
#include "GallerySections.h"

namespace gallery {
namespace {

using velkui::pictel::BrushP;
using velkui::pictel::TextAlignment;
using velkui::pictel::TextTruncation;

constexpr std::int32_t kWidth = 1240;
constexpr std::int32_t kHeight = 1000;
constexpr float kMargin = 24;
constexpr float kHeader = 76;

void DrawHeader(GalleryCanvas& canvas) {
  auto& surface = canvas.Surface();
  const velkui::pictel::LinearShaderP band(canvas.Supplier(), {0, 0}, {kWidth, 0},
                                           ColorRGBA{0.11f, 0.16f, 0.28f, 1},
                                           ColorRGBA{0.16f, 0.33f, 0.58f, 1});
  auto header = canvas.NewPath();
  header->AddRect(RectT<float>{0, 0, kWidth, kHeader - 12});
  surface.ShadePath(*band, *header, velkui::pictel::FillType::kWinding);
  BrushP white(canvas.Supplier(), {1, 1, 1, 1});
  velkui::pictel::FontP big(canvas.Supplier(), u"DejaVu Sans", u"Bold", 24);
  surface.DrawString(*white, *big, u"velkui \u00B7 pictel gallery", {kMargin, 42},
                     TextAlignment::kStart, TextTruncation::kNone, 0);
  BrushP soft(canvas.Supplier(), {0.78f, 0.85f, 0.95f, 1});
  surface.DrawString(*soft, *canvas.BodyFont(),
                     u"Device-independent drawing on the Cairo and Pango backend",
                     {kWidth - kMargin, 40}, TextAlignment::kEnd, TextTruncation::kNone, 0);
}

boost::intrusive_ptr<velkui::pictel::ImageInterface> RenderDrawingPage() {
  GalleryCanvas canvas(kWidth, kHeight);
  canvas.Surface().PaintRect({0.93f, 0.94f, 0.96f, 1}, {0, 0, kWidth, kHeight});
  DrawHeader(canvas);

  using Section = void (*)(GalleryCanvas&, const RectT<float>&);
  struct Card {
    const char16_t* title;
    Section draw;
  };
  const Card cards[6] = {
      {u"Shapes and fills", DrawShapes},
      {u"Strokes: caps, joins, dashes", DrawStrokes},
      {u"Gradients and colour", DrawGradientsAndColour},
      {u"Text: alignment, truncation, underline", DrawTypography},
      {u"Images: decoding, scaling, opacity", DrawImages},
      {u"Pixel layouts of caller buffers", DrawPixelLayouts},
  };
  const float cardWidth = (kWidth - 4 * kMargin) / 3;
  const float cardHeight = (kHeight - kHeader - 3 * kMargin) / 2;
  for (int i = 0; i < 6; ++i) {
    const RectT<float> frame{
        kMargin + static_cast<float>(i % 3) * (cardWidth + kMargin),
        kHeader + kMargin / 2 + static_cast<float>(i / 3) * (cardHeight + kMargin), cardWidth,
        cardHeight};
    const RectT<float> area = canvas.Card(frame, cards[i].title);
    canvas.Surface().PushStateStack();
    cards[i].draw(canvas, area);
    canvas.Surface().PopStateStack();
  }
  canvas.Surface().Flush();
  return canvas.Surface().GetSurfaceImage();
}

const PageRegistration kDrawingPage{{"", 0, &RenderDrawingPage}};

}  // namespace
}  // namespace gallery
