#include <cstdint>
#include <vector>

#include <gtest/gtest.h>

#include <velkui/pictel/Gradients.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PathShapes.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/test/GoldenImage.h>

namespace {

using namespace velkui::pictel;
using velkcore::MatrixT;
using velkcore::PointT;
using velkcore::RectT;
using velkui::test::GoldenTolerance;
using velkui::test::MatchesGolden;

const char* const kGoldenDirectory = VELKUI_TEST_DATA_DIR "/golden";
// Geometry is deterministic on one set of libraries; text may move by a shade
// between patch releases of the font stack.
constexpr GoldenTolerance kGeometry{2, 0.0};
constexpr GoldenTolerance kText{24, 0.004};

class GoldenTest : public ::testing::Test {
 protected:
  boost::intrusive_ptr<SupplierInterface> supplier = NewOSSupplier();
  SurfaceP surface{*supplier, 160, 120, false};

  ::testing::AssertionResult Matches(const char* name, GoldenTolerance tolerance) {
    return MatchesGolden(*surface->GetSurfaceImage(), kGoldenDirectory, name, tolerance);
  }
  BrushP Brush(const ColorRGBA& color) const { return BrushP(*supplier, color); }
  PenP Pen(const ColorRGBA& color, float width) const { return PenP(*supplier, color, width); }
};

TEST_F(GoldenTest, Fills) {
  surface->PaintRect({0.9f, 0.2f, 0.2f, 1}, {10, 10, 40, 30});
  surface->PaintRect({0.2f, 0.4f, 0.9f, 0.6f}, {30, 25, 40, 30});
  PathP rounded;
  velkui::GetRoundedRectPath(supplier.get(), {80, 10, 70, 40}, 10, &rounded);
  surface->FillPath(*Brush({0.1f, 0.6f, 0.3f, 1}), *rounded, FillType::kWinding);
  PathP ellipse;
  velkui::GetEllipsePath(supplier.get(), {10, 65, 60, 45}, &ellipse);
  surface->FillPath(*Brush({0.95f, 0.7f, 0.1f, 1}), *ellipse, FillType::kWinding);
  // A ring: the inner square is a hole under the even-odd rule only.
  PathP ring(*supplier);
  ring->AddRect(RectT<float>{85, 65, 30, 45});
  ring->AddRect(RectT<float>{93, 75, 14, 25});
  surface->FillPath(*Brush({0.3f, 0.3f, 0.3f, 1}), *ring, FillType::kEvenOdd);
  PathP solid(*supplier);
  solid->AddRect(RectT<float>{120, 65, 30, 45});
  solid->AddRect(RectT<float>{128, 75, 14, 25});
  surface->FillPath(*Brush({0.3f, 0.3f, 0.3f, 1}), *solid, FillType::kWinding);
  EXPECT_TRUE(Matches("fills", kGeometry));
}

TEST_F(GoldenTest, Strokes) {
  const LineCapType caps[] = {LineCapType::kFlat, LineCapType::kRound, LineCapType::kSquare};
  for (int i = 0; i < 3; ++i) {
    PenP pen = Pen({0.1f, 0.1f, 0.4f, 1}, 8);
    pen->SetLineCap(caps[i]);
    PathP line(*supplier);
    line->MoveTo(PointT<float>{15, 15.0f + i * 16});
    line->LineTo(PointT<float>{55, 15.0f + i * 16});
    surface->StrokePath(*pen, *line);
  }
  const LineJoinType joins[] = {LineJoinType::kMiter, LineJoinType::kBevel, LineJoinType::kRound};
  for (int i = 0; i < 3; ++i) {
    PenP pen = Pen({0.6f, 0.1f, 0.1f, 1}, 7);
    pen->SetLineJoin(joins[i]);
    PathP zigzag(*supplier);
    const float x = 75.0f + i * 28;
    zigzag->MoveTo(PointT<float>{x, 50});
    zigzag->LineTo(PointT<float>{x + 10, 12});
    zigzag->LineTo(PointT<float>{x + 20, 50});
    surface->StrokePath(*pen, *zigzag);
  }
  PenP dashed = Pen({0, 0, 0, 1}, 2);
  const float dashes[] = {3, 1, 1, 1};
  dashed->SetDashArray(dashes, 4);
  PathP arc(*supplier);
  arc->AddArc({40, 90}, 22, 180, 270);
  surface->StrokePath(*dashed, *arc);
  // Crisp one-pixel outlines, then a diagonal without anti-aliasing.
  PenP hairline = Pen({0, 0, 0, 1}, 1);
  PathP box(*supplier);
  box->AddRect(RectT<std::int32_t>{80, 70, 30, 30});
  surface->StrokePath(*hairline, *box);
  surface->SetAntiAliasPolicy(AntiAliasPolicy::kOff);
  PathP diagonal(*supplier);
  diagonal->MoveTo(PointT<float>{115, 70});
  diagonal->LineTo(PointT<float>{150, 110});
  surface->StrokePath(*Pen({0, 0.5f, 0, 1}, 3), *diagonal);
  EXPECT_TRUE(Matches("strokes", kGeometry));
}

TEST_F(GoldenTest, Gradients) {
  Pictel pictel(supplier.get(), surface.Get());
  PathP band;
  velkui::GetRoundedRectPath(supplier.get(), {10, 10, 140, 30}, 6, &band);
  const ColorRGBA colours[3] = {
      {0.9f, 0.1f, 0.1f, 1}, {0.95f, 0.85f, 0.1f, 1}, {0.1f, 0.3f, 0.9f, 1}};
  const float positions[3] = {0, 0.4f, 1};
  velkui::utils::HandleGradient(&pictel, band, {10, 0}, {150, 0}, colours, positions, 3);

  const ColorRGBA glow[2] = {{1, 1, 1, 1}, {0.2f, 0.5f, 0.3f, 1}};
  const float ends[2] = {0, 1};
  auto radial = supplier->CreateRadialShader({45, 80}, 30, glow, ends, 2);
  PathP disc;
  velkui::GetEllipsePath(supplier.get(), {15, 50, 60, 60}, &disc);
  surface->ShadePath(*radial, *disc, FillType::kWinding);

  LinearShaderP vertical(*supplier, {0, 50}, {0, 110}, ColorRGBA{0, 0, 0, 0.1f},
                         ColorRGBA{0, 0, 0, 0.9f});
  PathP box(*supplier);
  box->AddRect(RectT<float>{90, 50, 60, 60});
  surface->FillPath(*AsBrush(*vertical), *box, FillType::kWinding);
  EXPECT_TRUE(Matches("gradients", kGeometry));
}

TEST_F(GoldenTest, Text) {
  FontP font(*supplier, u"DejaVu Sans", u"", 12);
  FontP bold(*supplier, u"DejaVu Sans", u"Bold Italic", 12);
  BrushP ink = Brush({0.1f, 0.1f, 0.1f, 1});
  PenP guide = Pen({0.8f, 0.2f, 0.2f, 1}, 1);
  PathP axis(*supplier);
  axis->MoveTo(PointT<std::int32_t>{80, 0});
  axis->LineTo(PointT<std::int32_t>{80, 60});
  surface->StrokePath(*guide, *axis);
  surface->DrawString(*ink, *font, u"Start", {80, 14}, TextAlignment::kStart, TextTruncation::kNone,
                      0);
  surface->DrawString(*ink, *font, u"Centre", {80, 30}, TextAlignment::kCenter,
                      TextTruncation::kNone, 0);
  surface->DrawString(*ink, *bold, u"End", {80, 46}, TextAlignment::kEnd, TextTruncation::kNone, 0);
  const char16_t* longText = u"Velvet media library";
  surface->DrawString(*ink, *font, longText, {4, 62}, TextAlignment::kStart,
                      TextTruncation::kEndEllipsis, 90);
  surface->DrawString(*ink, *font, longText, {4, 76}, TextAlignment::kStart,
                      TextTruncation::kPathEllipsis, 90);
  surface->DrawStringWithUnderline(*ink, *font, *Pen({0.1f, 0.1f, 0.1f, 1}, 1), u"Underline",
                                   {100, 76}, TextAlignment::kStart, TextTruncation::kNone, 0, 0,
                                   4);
  surface->DrawMultiLineString(*ink, *font, u"Wrapped text keeps whole words together",
                               {4, 84, 150, 34}, TextAlignment::kCenter);
  EXPECT_TRUE(Matches("text", kText));
}

TEST_F(GoldenTest, Images) {
  // An 8 × 8 checker of four colours, straight alpha.
  std::vector<std::uint8_t> pixels(8 * 8 * 4);
  for (int y = 0; y < 8; ++y) {
    for (int x = 0; x < 8; ++x) {
      std::uint8_t* p = &pixels[static_cast<std::size_t>((y * 8 + x) * 4)];
      const bool odd = (x + y) % 2 == 1;
      p[0] = static_cast<std::uint8_t>(x * 32);
      p[1] = odd ? 200 : 40;
      p[2] = static_cast<std::uint8_t>(y * 32);
      p[3] = x < 6 ? 255 : 128;
    }
  }
  BufferImageP image(*supplier, 8, 8, 32, PixelLayout::kBGRA, pixels.data());
  surface->DrawImage(*image, {6, 6}, 1.0f);
  surface->SetInterpolationPolicy(InterpolationPolicy::kNearestNeighbor);
  surface->DrawImage(*supplier, *image, {20, 6, 48, 48}, nullptr, 1.0f);
  surface->SetInterpolationPolicy(InterpolationPolicy::kHighQuality);
  surface->DrawImage(*supplier, *image, {76, 6, 48, 48}, nullptr, 1.0f);
  surface->DrawImage(*supplier, *image, {130, 6, 24, 48}, nullptr, 0.5f);
  surface->PushStateStack();
  surface->Transform(MatrixT<float>{0.866f, 0.5f, -0.5f, 0.866f, 60, 58});
  surface->DrawImage(*supplier, *image, {0, 0, 40, 40}, nullptr, 1.0f);
  surface->PopStateStack();
  EXPECT_TRUE(Matches("images", kGeometry));
}

}  // namespace
