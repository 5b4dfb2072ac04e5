#include "GallerySections.h"

#include <cmath>
#include <cstdint>
#include <numbers>
#include <vector>

#include <velkui/pictel/ColorConversion.h>
#include <velkui/pictel/Gradients.h>
#include <velkui/pictel/ImageIO.h>
#include <velkui/pictel/PathShapes.h>
#include <velkui/pictel/PixelSwizzle.h>

namespace gallery {

using namespace velkui::pictel;
using velkcore::MatrixT;

namespace {

constexpr ColorRGBA kNavy{0.12f, 0.20f, 0.42f, 1};

PointT<float> At(const RectT<float>& area, float x, float y) {
  return {area.left + x, area.top + y};
}

RectT<float> Offset(const RectT<float>& area, float x, float y, float width, float height) {
  return {area.left + x, area.top + y, width, height};
}

PointT<std::int32_t> Whole(const RectT<float>& area, float x, float y) {
  return {static_cast<std::int32_t>(std::lround(area.left + x)),
          static_cast<std::int32_t>(std::lround(area.top + y))};
}

void Checkerboard(GalleryCanvas& canvas, const RectT<float>& rect) {
  canvas.Surface().PaintRect({0.82f, 0.84f, 0.87f, 1}, rect);
  constexpr float kSquare = 8;
  for (float y = 0; y < rect.height; y += kSquare) {
    for (float x = 0; x < rect.width; x += kSquare) {
      if (static_cast<int>(x / kSquare + y / kSquare) % 2 == 0) continue;
      canvas.Surface().PaintRect({0.95f, 0.96f, 0.97f, 1},
                                 {rect.left + x, rect.top + y, std::min(kSquare, rect.width - x),
                                  std::min(kSquare, rect.height - y)});
    }
  }
}

PathP Star(GalleryCanvas& canvas, const PointT<float>& centre, float radius) {
  PathP star = canvas.NewPath();
  for (int k = 0; k < 5; ++k) {
    const double angle = (-90.0 + k * 144.0) * std::numbers::pi / 180.0;
    const PointT<float> p{centre.x + radius * static_cast<float>(std::cos(angle)),
                          centre.y + radius * static_cast<float>(std::sin(angle))};
    if (k == 0) {
      star->MoveTo(p);
    } else {
      star->LineTo(p);
    }
  }
  star->Close();
  return star;
}

PathP Circle(GalleryCanvas& canvas, const PointT<float>& centre, float radius) {
  PathP circle;
  velkui::GetEllipsePath(&canvas.Supplier(),
                         {centre.x - radius, centre.y - radius, 2 * radius, 2 * radius}, &circle);
  return circle;
}

}  // namespace

void DrawShapes(GalleryCanvas& canvas, const RectT<float>& area) {
  canvas.Surface().PaintRect(GalleryCanvas::kAccent, Offset(area, 0, 0, 84, 64));
  PathP rounded;
  velkui::GetRoundedRectPath(&canvas.Supplier(), Offset(area, 104, 0, 104, 64), 16, &rounded);
  canvas.Fill(rounded, {0.18f, 0.62f, 0.42f, 1});
  PathP ellipse;
  velkui::GetEllipsePath(&canvas.Supplier(), Offset(area, 228, 0, 116, 64), &ellipse);
  canvas.Fill(ellipse, {0.96f, 0.66f, 0.16f, 1});
  canvas.Label(u"rectangle", At(area, 42, 82), TextAlignment::kCenter);
  canvas.Label(u"rounded rectangle", At(area, 156, 82), TextAlignment::kCenter);
  canvas.Label(u"ellipse", At(area, 286, 82), TextAlignment::kCenter);

  // Translucent discs: colours mix where they overlap.
  const ColorRGBA discs[3] = {
      {0.95f, 0.2f, 0.3f, 0.55f}, {0.2f, 0.75f, 0.35f, 0.55f}, {0.2f, 0.4f, 0.95f, 0.55f}};
  const PointT<float> centres[3] = {At(area, 58, 142), At(area, 108, 142), At(area, 83, 184)};
  for (int i = 0; i < 3; ++i) canvas.Fill(Circle(canvas, centres[i], 40), discs[i]);
  canvas.Label(u"alpha blending", At(area, 83, 246), TextAlignment::kCenter);

  // A heart of two cubic curves.
  const PointT<float> c = At(area, 262, 170);
  PathP heart = canvas.NewPath();
  heart->MoveTo(PointT<float>{c.x, c.y + 48});
  heart->BezierTo(PointT<float>{c.x - 78, c.y - 4}, PointT<float>{c.x - 36, c.y - 66},
                  PointT<float>{c.x, c.y - 26});
  heart->BezierTo(PointT<float>{c.x + 36, c.y - 66}, PointT<float>{c.x + 78, c.y - 4},
                  PointT<float>{c.x, c.y + 48});
  heart->Close();
  canvas.Fill(heart, {0.86f, 0.18f, 0.36f, 1});
  canvas.Label(u"B\u00E9zier curves", At(area, 262, 246), TextAlignment::kCenter);

  canvas.Fill(Star(canvas, At(area, 83, 300), 40), kNavy, FillType::kEvenOdd);
  canvas.Fill(Star(canvas, At(area, 262, 300), 40), kNavy, FillType::kWinding);
  canvas.Label(u"even-odd rule", At(area, 83, 356), TextAlignment::kCenter);
  canvas.Label(u"winding rule", At(area, 262, 356), TextAlignment::kCenter);
}

void DrawStrokes(GalleryCanvas& canvas, const RectT<float>& area) {
  const LineCapType caps[3] = {LineCapType::kFlat, LineCapType::kRound, LineCapType::kSquare};
  const char16_t* capNames[3] = {u"flat cap", u"round cap", u"square cap"};
  canvas.Guide(At(area, 30, 0), At(area, 30, 92));
  canvas.Guide(At(area, 150, 0), At(area, 150, 92));
  for (int i = 0; i < 3; ++i) {
    PenP pen = canvas.NewPen(kNavy, 14);
    pen->SetLineCap(caps[i]);
    PathP line = canvas.NewPath();
    const float y = 16.0f + i * 30.0f;
    line->MoveTo(At(area, 30, y));
    line->LineTo(At(area, 150, y));
    canvas.Stroke(line, pen);
    canvas.Label(capNames[i], At(area, 180, y + 4));
  }

  const LineJoinType joins[3] = {LineJoinType::kMiter, LineJoinType::kBevel, LineJoinType::kRound};
  const char16_t* joinNames[3] = {u"miter join", u"bevel join", u"round join"};
  for (int i = 0; i < 3; ++i) {
    PenP pen = canvas.NewPen({0.80f, 0.25f, 0.20f, 1}, 12);
    pen->SetLineJoin(joins[i]);
    PathP chevron = canvas.NewPath();
    const float x = 20.0f + i * 116.0f;
    chevron->MoveTo(At(area, x, 178));
    chevron->LineTo(At(area, x + 38, 118));
    chevron->LineTo(At(area, x + 76, 178));
    canvas.Stroke(chevron, pen);
    canvas.Label(joinNames[i], At(area, x + 38, 200), TextAlignment::kCenter);
  }

  struct Dash {
    std::vector<float> pattern;
    LineCapType cap;
    float width;
    const char16_t* name;
  };
  const Dash dashes[3] = {{{4, 2}, LineCapType::kFlat, 3, u"dashes 4-2"},
                          {{0, 2.5f}, LineCapType::kRound, 4, u"dots (round caps)"},
                          {{6, 2, 1, 2}, LineCapType::kFlat, 3, u"dash-dot"}};
  for (int i = 0; i < 3; ++i) {
    PenP pen = canvas.NewPen({0.25f, 0.28f, 0.34f, 1}, dashes[i].width);
    pen->SetLineCap(dashes[i].cap);
    pen->SetDashArray(dashes[i].pattern.data(),
                      static_cast<std::int32_t>(dashes[i].pattern.size()));
    PathP line = canvas.NewPath();
    const float y = 232.0f + i * 22.0f;
    line->MoveTo(At(area, 4, y));
    line->LineTo(At(area, 190, y));
    canvas.Stroke(line, pen);
    canvas.Label(dashes[i].name, At(area, 206, y + 4));
  }

  // Whole-numbered one-unit outlines land on whole pixels.
  PenP hairline = canvas.NewPen(GalleryCanvas::kInk, 1);
  for (int i = 0; i < 4; ++i) {
    PathP box = canvas.NewPath();
    const PointT<std::int32_t> corner = Whole(area, 4.0f + i * 6.0f, 300.0f + i * 6.0f);
    box->AddRect(RectT<std::int32_t>{corner.x, corner.y, 70 - i * 12, 46 - i * 12});
    canvas.Stroke(box, hairline);
  }
  canvas.Label(u"crisp 1-pixel outlines", At(area, 88, 328));
  PathP wave = canvas.NewPath();
  wave->MoveTo(At(area, 236, 326));
  wave->BezierTo(At(area, 266, 286), At(area, 290, 366), At(area, 340, 316));
  PenP wavePen = canvas.NewPen(GalleryCanvas::kAccent, 3);
  wavePen->SetLineCap(LineCapType::kRound);
  canvas.Stroke(wave, wavePen);
}

void DrawGradientsAndColour(GalleryCanvas& canvas, const RectT<float>& area) {
  // A hue bar built from colour stops.
  std::vector<std::pair<float, ColorRGBA>> stops;
  for (int i = 0; i <= 6; ++i) {
    stops.emplace_back(i / 6.0f, HSBtoRGB<float>(i * 60.0f, 0.85f, 0.95f, 1));
  }
  const LinearShaderP hues(canvas.Supplier(), At(area, 0, 0), At(area, area.width, 0), stops);
  PathP bar;
  velkui::GetRoundedRectPath(&canvas.Supplier(), Offset(area, 0, 0, area.width, 30), 8, &bar);
  canvas.Surface().ShadePath(*hues, *bar, FillType::kWinding);

  // A sphere: a radial gradient centred off the middle.
  const ColorRGBA ball[3] = {{1, 1, 1, 1}, GalleryCanvas::kAccent, {0.06f, 0.12f, 0.3f, 1}};
  const float ballStops[3] = {0, 0.45f, 1};
  const auto sphere =
      canvas.Supplier().CreateRadialShader(At(area, 48, 88), 92, ball, ballStops, 3);
  canvas.Surface().ShadePath(*sphere, *Circle(canvas, At(area, 68, 110), 56), FillType::kWinding);

  // A button body through the gradient helper, with a centred label.
  const RectT<float> button = Offset(area, 150, 62, 190, 40);
  PathP body;
  velkui::GetRoundedRectPath(&canvas.Supplier(), button, 8, &body);
  velkui::utils::HandleGradient(&canvas.GetPictel(), body, {0, button.top},
                                {0, button.top + button.height}, ColorRGBA{0.36f, 0.62f, 0.98f, 1},
                                ColorRGBA{0.12f, 0.38f, 0.80f, 1});
  canvas.Stroke(body, canvas.NewPen({0.08f, 0.26f, 0.6f, 1}, 1));
  BrushP white(canvas.Supplier(), {1, 1, 1, 1});
  canvas.Surface().DrawString(
      *white, *canvas.BoldFont(), u"Gradient button",
      {button.left + button.width / 2, velkui::GetFontBaseline(canvas.BoldFont(), button)},
      TextAlignment::kCenter, TextTruncation::kNone, 0);

  // Text painted with a gradient brush.
  const LinearShaderP warm(canvas.Supplier(), At(area, 150, 0), At(area, 340, 0),
                           ColorRGBA{0.98f, 0.55f, 0.1f, 1}, ColorRGBA{0.85f, 0.15f, 0.55f, 1});
  FontP large(canvas.Supplier(), u"DejaVu Sans", u"Bold", 34);
  canvas.Surface().DrawString(*AsBrush(*warm), *large, u"Gradient", At(area, 150, 156),
                              TextAlignment::kStart, TextTruncation::kNone, 0);

  // A hue ring from HSBtoRGB, slice by slice.
  const PointT<float> centre = At(area, 72, 278);
  for (int degrees = 0; degrees < 360; degrees += 6) {
    PathP slice = canvas.NewPath();
    slice->AddArc(centre, 62, static_cast<float>(degrees), 6.5f);
    slice->AddArc(centre, 34, static_cast<float>(degrees) + 6.5f, -6.5f);
    slice->Close();
    canvas.Fill(slice, HSBtoRGB<float>(static_cast<float>(degrees) + 90.0f, 0.9f, 0.95f, 1));
  }
  canvas.Label(u"HSB", {centre.x, centre.y + 4}, TextAlignment::kCenter);

  // Saturation across, brightness down, at one hue.
  for (int row = 0; row < 4; ++row) {
    for (int column = 0; column < 6; ++column) {
      const float saturation = (column + 1) / 6.0f;
      const float brightness = 1.0f - row * 0.22f;
      canvas.Surface().PaintRect(
          HSBtoRGB<double>(212.0, saturation, brightness, 1.0f),
          Offset(area, 166.0f + column * 29.0f, 220.0f + row * 26.0f, 26, 23));
    }
  }
  canvas.Label(u"saturation \u2192, brightness \u2193", At(area, 166, 340));
}

void DrawTypography(GalleryCanvas& canvas, const RectT<float>& area) {
  BrushP ink(canvas.Supplier(), GalleryCanvas::kInk);
  SurfaceInterface& surface = canvas.Surface();
  const float middle = std::round(area.width / 2);
  canvas.Guide(At(area, middle, 0), At(area, middle, 72));
  const struct {
    const char16_t* text;
    TextAlignment alignment;
  } aligned[3] = {{u"starts at the guide", TextAlignment::kStart},
                  {u"centred on the guide", TextAlignment::kCenter},
                  {u"ends at the guide", TextAlignment::kEnd}};
  for (int i = 0; i < 3; ++i) {
    surface.DrawString(*ink, *canvas.BodyFont(), aligned[i].text, At(area, middle, 16.0f + i * 24),
                       aligned[i].alignment, TextTruncation::kNone, 0);
  }

  const char16_t* path = u"/media/Projects/Summer Trailer/final_mix_v3.wav";
  const struct {
    const char16_t* name;
    TextTruncation mode;
  } modes[4] = {{u"none", TextTruncation::kNone},
                {u"cut", TextTruncation::kEnd},
                {u"end \u2026", TextTruncation::kEndEllipsis},
                {u"path \u2026", TextTruncation::kPathEllipsis}};
  constexpr float kTextLeft = 82;
  constexpr float kMaxWidth = 200;
  surface.PaintRect({0.93f, 0.95f, 0.99f, 1}, Offset(area, kTextLeft - 4, 90, kMaxWidth + 8, 100));
  canvas.Guide(At(area, kTextLeft + kMaxWidth, 86), At(area, kTextLeft + kMaxWidth, 194));
  for (int i = 0; i < 4; ++i) {
    const float y = 108.0f + i * 24;
    canvas.Label(modes[i].name, At(area, 0, y));
    surface.PushStateStack();
    // Untruncated text is clipped to the card so that it does not spill out.
    auto clip = canvas.NewPath();
    clip->AddRect(Offset(area, 0, 0, area.width, area.height));
    surface.Clip(*clip, FillType::kWinding);
    surface.DrawString(*ink, *canvas.BodyFont(), path, At(area, kTextLeft, y),
                       TextAlignment::kStart, modes[i].mode, kMaxWidth);
    surface.PopStateStack();
  }

  PenP underline = canvas.NewPen(GalleryCanvas::kInk, 1);
  const struct {
    const char16_t* text;
    std::int32_t mnemonic;
  } menu[4] = {{u"File", 0}, {u"Edit", 0}, {u"View", 0}, {u"Save As\u2026", 5}};
  float x = 0;
  for (const auto& item : menu) {
    surface.DrawStringWithUnderline(*ink, *canvas.BodyFont(), *underline, item.text,
                                    At(area, x, 222), TextAlignment::kStart, TextTruncation::kNone,
                                    0, item.mnemonic, item.mnemonic);
    x += surface.MeasureStringWidth(*canvas.BodyFont(), item.text, -1) + 22;
  }
  canvas.Label(u"mnemonic underlines", At(area, area.width, 222), TextAlignment::kEnd);

  surface.DrawString(*ink, *canvas.BodyFont(), u"Regular", At(area, 0, 250), TextAlignment::kStart,
                     TextTruncation::kNone, 0);
  surface.DrawString(*ink, *canvas.BoldFont(), u"Bold", At(area, 80, 250), TextAlignment::kStart,
                     TextTruncation::kNone, 0);
  surface.DrawString(*ink, *canvas.ItalicFont(), u"Italic", At(area, 134, 250),
                     TextAlignment::kStart, TextTruncation::kNone, 0);
  surface.DrawString(*ink, *canvas.BodyFont(),
                     u"\u00C9t\u00E9 \u00B7 \u0394\u03B5\u03BB\u03C4\u03B1",
                     At(area, area.width, 250), TextAlignment::kEnd, TextTruncation::kNone, 0);

  const RectT<float> box = Offset(area, 0, 272, area.width, 70);
  PathP frame;
  velkui::GetRoundedRectPath(&canvas.Supplier(), box, 6, &frame);
  canvas.Fill(frame, {0.96f, 0.97f, 0.99f, 1});
  surface.DrawMultiLineString(*ink, *canvas.BodyFont(),
                              u"Multi-line text wraps at word boundaries inside its rectangle "
                              u"and shows only the lines that fit there entirely.",
                              {box.left + 10, box.top + 8, box.width - 20, box.height - 12},
                              TextAlignment::kCenter);
}

namespace {

// A small icon drawn offscreen, encoded as PNG and decoded again.
ImageP MakeDecodedIcon(GalleryCanvas& canvas) {
  const SupplierInterface& supplier = canvas.Supplier();
  SurfaceP icon(supplier, 48, 48, true);
  PathP body;
  velkui::GetRoundedRectPath(&supplier, {2, 2, 44, 44}, 10, &body);
  const LinearShaderP fill(supplier, {0, 2}, {0, 46}, ColorRGBA{0.98f, 0.62f, 0.2f, 1},
                           ColorRGBA{0.86f, 0.2f, 0.36f, 1});
  icon->ShadePath(*fill, *body, FillType::kWinding);
  BrushP white(supplier, {1, 1, 1, 0.92f});
  PathP disc;
  velkui::GetEllipsePath(&supplier, {12, 12, 24, 24}, &disc);
  icon->FillPath(*white, *disc, FillType::kWinding);
  PathP play(supplier);
  play->MoveTo(PointT<float>{21, 17});
  play->LineTo(PointT<float>{31, 24});
  play->LineTo(PointT<float>{21, 31});
  play->Close();
  BrushP accent(supplier, {0.86f, 0.2f, 0.36f, 1});
  icon->FillPath(*accent, *play, FillType::kWinding);
  const std::vector<std::uint8_t> png = EncodeImageAsPNG(*icon->GetSurfaceImage());
  return FileImageP(supplier, png.data(), png.size());
}

// An 8 × 8 pixel-art image over caller memory (straight alpha).
ImageP MakePixelArt(GalleryCanvas& canvas, std::vector<std::uint8_t>& pixels) {
  static constexpr const char* kArt[8] = {"..####..", ".#oooo#.", "#oo##oo#", "#o#oo#o#",
                                          "#o#oo#o#", "#oo##oo#", ".#oooo#.", "..####.."};
  pixels.assign(8 * 8 * 4, 0);
  for (int y = 0; y < 8; ++y) {
    for (int x = 0; x < 8; ++x) {
      std::uint8_t* p = &pixels[static_cast<std::size_t>((y * 8 + x) * 4)];
      if (kArt[y][x] == '#') {
        p[0] = 110, p[1] = 50, p[2] = 30, p[3] = 255;
      } else if (kArt[y][x] == 'o') {
        p[0] = 60, p[1] = 200, p[2] = 250, p[3] = 255;
      }
    }
  }
  return BufferImageP(canvas.Supplier(), 8, 8, 32, PixelLayout::kBGRA, pixels.data());
}

}  // namespace

void DrawImages(GalleryCanvas& canvas, const RectT<float>& area) {
  SurfaceInterface& surface = canvas.Surface();
  const ImageP icon = MakeDecodedIcon(canvas);
  surface.DrawImage(*icon, At(area, 0, 4), 1.0f);
  canvas.Label(u"decoded PNG", At(area, 24, 72), TextAlignment::kCenter);

  std::vector<std::uint8_t> artPixels;
  const ImageP art = MakePixelArt(canvas, artPixels);
  surface.PushStateStack();
  surface.SetInterpolationPolicy(InterpolationPolicy::kNearestNeighbor);
  surface.DrawImage(canvas.Supplier(), *art, Offset(area, 96, 4, 56, 56), nullptr, 1.0f);
  surface.SetInterpolationPolicy(InterpolationPolicy::kHighQuality);
  surface.DrawImage(canvas.Supplier(), *art, Offset(area, 176, 4, 56, 56), nullptr, 1.0f);
  surface.DrawImage(canvas.Supplier(), *icon, Offset(area, 258, 4, 86, 56), nullptr, 1.0f);
  surface.PopStateStack();
  canvas.Label(u"nearest", At(area, 124, 72), TextAlignment::kCenter);
  canvas.Label(u"smooth", At(area, 204, 72), TextAlignment::kCenter);
  canvas.Label(u"stretched", At(area, 301, 72), TextAlignment::kCenter);

  Checkerboard(canvas, Offset(area, 0, 96, area.width, 72));
  const float opacities[4] = {0.25f, 0.5f, 0.75f, 1.0f};
  const char16_t* opacityNames[4] = {u"25 %", u"50 %", u"75 %", u"100 %"};
  for (int i = 0; i < 4; ++i) {
    const float x = 22.0f + i * 84.0f;
    surface.DrawImage(*icon, At(area, x, 108), opacities[i]);
    canvas.Label(opacityNames[i], At(area, x + 24, 186), TextAlignment::kCenter);
  }

  // The same image under rotations and a scale.
  for (int i = 0; i < 5; ++i) {
    surface.PushStateStack();
    const double angle = (i * 18.0 - 36.0) * std::numbers::pi / 180.0;
    const auto c = static_cast<float>(std::cos(angle));
    const auto s = static_cast<float>(std::sin(angle));
    const PointT<float> centre = At(area, 36.0f + i * 68.0f, 258);
    const float scale = 0.8f + i * 0.1f;
    surface.Transform(
        MatrixT<float>{c * scale, s * scale, -s * scale, c * scale, centre.x, centre.y});
    surface.DrawImage(*icon, {-24, -24}, 1.0f);
    surface.PopStateStack();
  }
  canvas.Label(u"drawn under rotated and scaled transforms", At(area, area.width / 2, 330),
               TextAlignment::kCenter);
}

void DrawPixelLayouts(GalleryCanvas& canvas, const RectT<float>& area) {
  const struct {
    PixelLayout layout;
    int bytesPerPixel;
    const char16_t* name;
  } layouts[4] = {{PixelLayout::kBGR, 3, u"1 \u00B7 B,G,R (shadow buffer)"},
                  {PixelLayout::kBGRX, 4, u"3 \u00B7 B,G,R,x (in place)"},
                  {PixelLayout::kBGRA, 4, u"6 \u00B7 B,G,R,A (shadow buffer)"},
                  {PixelLayout::kBGRAPremultiplied, 4, u"7 \u00B7 premultiplied (in place)"}};
  constexpr std::int32_t kTileWidth = 164;
  constexpr std::int32_t kTileHeight = 96;
  const SupplierInterface& supplier = canvas.Supplier();
  FontP font(supplier, u"DejaVu Sans", u"Bold", 15);
  for (int i = 0; i < 4; ++i) {
    const auto& entry = layouts[i];
    const std::int32_t rowBytes = kTileWidth * entry.bytesPerPixel;
    std::vector<std::uint8_t> memory(static_cast<std::size_t>(rowBytes) * kTileHeight, 0);
    {
      // The caller's memory is drawn into through a surface...
      auto tile = supplier.NewBufferSurface(kTileWidth, kTileHeight, rowBytes, entry.layout,
                                            memory.data(), {});
      const LinearShaderP fade(supplier, {0, 0}, {kTileWidth, 0}, ColorRGBA{0.16f, 0.45f, 0.86f, 1},
                               ColorRGBA{0.55f, 0.2f, 0.75f, 0.15f});
      PathP all(supplier);
      all->AddRect(RectT<float>{0, 0, kTileWidth, kTileHeight});
      tile->ShadePath(*fade, *all, FillType::kWinding);
      BrushP light(supplier, {1, 1, 1, 0.65f});
      PathP disc;
      velkui::GetEllipsePath(&supplier, {96, 18, 60, 60}, &disc);
      tile->FillPath(*light, *disc, FillType::kWinding);
      BrushP white(supplier, {1, 1, 1, 1});
      const std::u16string label = u"layout " + std::u16string(1, u"1367"[i]);
      tile->DrawString(*white, *font, label.c_str(), {12, 54}, TextAlignment::kStart,
                       TextTruncation::kNone, 0);
      tile->Flush();
    }
    // ...and shown again as an image over the same bytes.
    const BufferImageP image(supplier, kTileWidth, kTileHeight, rowBytes, entry.layout,
                             memory.data());
    const float x = static_cast<float>((i % 2) * (kTileWidth + 17));
    const float y = static_cast<float>((i / 2) * (kTileHeight + 44));
    Checkerboard(canvas, Offset(area, x, y, kTileWidth, kTileHeight));
    canvas.Surface().DrawImage(*image, At(area, x, y), 1.0f);
    canvas.Label(entry.name, At(area, x, y + kTileHeight + 18));
  }
  BrushP note(supplier, GalleryCanvas::kLabelColor);
  canvas.Surface().DrawMultiLineString(
      *note, *canvas.LabelFont(),
      u"One drawing in four memory layouts, shown again as images over the same bytes. "
      u"Alpha survives only where the layout keeps it.",
      Offset(area, 0, 284, area.width, 60), TextAlignment::kStart);
}

}  // namespace gallery
