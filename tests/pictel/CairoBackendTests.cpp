#include <array>
#include <cstdint>
#include <vector>

#include <gtest/gtest.h>

#include <velkui/pictel/BrushInterface.h>
#include <velkui/pictel/ImageIO.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/OSSurfaceP.h>
#include <velkui/pictel/PathShapes.h>
#include <velkui/pictel/PictelErrors.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/pictel/ScAcquireSurfaceHDC.h>
#include <velkui/pictel/StartupShutdownGdiPlus.h>
#include <velkui/test/PixelProbe.h>
#include <velkui/test/RecordingSupplier.h>

#include "PictelTestSupport.h"

namespace {

using namespace velkui::pictel;
using test::DrawingError;
using test::ErrorNumber;
using velkcore::MatrixT;
using velkcore::PointT;
using velkcore::RectT;
using velkui::test::Pixel;
using velkui::test::PixelProbe;

constexpr Pixel kClear{0, 0, 0, 0};
constexpr Pixel kRed{255, 0, 0, 255};
constexpr Pixel kBlack{0, 0, 0, 255};

class CairoTest : public ::testing::Test {
 protected:
  boost::intrusive_ptr<SupplierInterface> supplier = NewOSSupplier();
  SurfaceP surface{*supplier, 40, 30, true};

  PathP Path() const { return PathP(*supplier); }
  template <typename T>
  PathP RectPath(const RectT<T>& rect) const {
    PathP path(*supplier);
    path->AddRect(rect);
    return path;
  }
  // A whole-numbered straight line.
  PathP Line(PointT<std::int32_t> from, PointT<std::int32_t> to) const {
    PathP path(*supplier);
    path->MoveTo(from);
    path->LineTo(to);
    return path;
  }
  PixelProbe Probe() { return PixelProbe(*surface); }
};

TEST_F(CairoTest, WholeNumberedFillCoversExactlyItsPixels) {
  for (auto policy : {AntiAliasPolicy::kOff, AntiAliasPolicy::kOn, AntiAliasPolicy::kHighQuality}) {
    SurfaceP target(*supplier, 40, 30, true);
    target->SetAntiAliasPolicy(policy);
    target->PaintRect({1, 0, 0, 1}, {5, 5, 10, 8});
    auto path = RectPath(RectT<float>{20, 5, 10, 8});
    BrushP red(*supplier, {1, 0, 0, 1});
    target->FillPath(*red, *path, FillType::kWinding);
    PixelProbe probe(*target);
    EXPECT_EQ(160, probe.Count(kRed, 0, 0, 40, 30)) << static_cast<int>(policy);
    EXPECT_EQ(160, probe.CountVisible()) << static_cast<int>(policy);
    EXPECT_EQ(kRed, probe.At(5, 5));
    EXPECT_EQ(kRed, probe.At(29, 12));
  }
}

TEST_F(CairoTest, FractionalFillIsSmoothedOnlyWithAntiAliasing) {
  surface->PaintRect({0, 0, 0, 1}, {5.5f, 5, 10, 1});
  EXPECT_EQ(128, Probe().At(5, 5).alpha);
  surface->SetAntiAliasPolicy(AntiAliasPolicy::kOff);
  surface->PaintRect({0, 0, 0, 1}, {5.5f, 10, 10, 1});
  const PixelProbe probe = Probe();
  for (int x = 0; x < 40; ++x) {
    const auto alpha = probe.At(x, 10).alpha;
    EXPECT_TRUE(alpha == 0 || alpha == 255) << x;
  }
}

TEST_F(CairoTest, OneUnitStrokeCoversExactlyItsPixelRow) {
  PenP pen(*supplier, {0, 0, 0, 1}, 1.0f);
  for (auto policy : {AntiAliasPolicy::kOff, AntiAliasPolicy::kOn}) {
    SurfaceP target(*supplier, 40, 30, true);
    target->SetAntiAliasPolicy(policy);
    target->StrokePath(*pen, *Line({5, 10}, {25, 10}));
    PixelProbe probe(*target);
    EXPECT_EQ(20, probe.Count(kBlack, 5, 10, 20, 1)) << static_cast<int>(policy);
    EXPECT_EQ(20, probe.CountVisible()) << static_cast<int>(policy);
  }
}

TEST_F(CairoTest, WholeNumberedOutlinesAreCrisp) {
  PenP pen(*supplier, {0, 0, 0, 1}, 1.0f);
  surface->StrokePath(*pen, *RectPath(RectT<std::int32_t>{5, 5, 10, 10}));
  // The outline of a 10-unit square fills the 11 × 11 pixel ring from 5 to 15.
  const PixelProbe probe = Probe();
  EXPECT_EQ(40, probe.Count(kBlack, 0, 0, 40, 30));
  EXPECT_EQ(40, probe.CountVisible());
  EXPECT_EQ(kBlack, probe.At(15, 15));
  // A two-unit line needs no shift: it covers the rows on both sides of y.
  SurfaceP wide(*supplier, 40, 30, true);
  PenP widePen(*supplier, {0, 0, 0, 1}, 2.0f);
  wide->StrokePath(*widePen, *Line({0, 10}, {40, 10}));
  PixelProbe wideProbe(*wide);
  EXPECT_EQ(80, wideProbe.Count(kBlack, 0, 9, 40, 2));
  EXPECT_EQ(80, wideProbe.CountVisible());
}

TEST_F(CairoTest, DashesCapsAndJoinsReachThePixels) {
  PenP pen(*supplier, {0, 0, 0, 1}, 1.0f);
  const float dashes[2] = {2, 3};
  pen->SetDashArray(dashes, 2);
  surface->StrokePath(*pen, *Line({0, 3}, {20, 3}));
  const PixelProbe probe = Probe();
  for (int x = 0; x < 20; ++x) {
    EXPECT_EQ(x % 5 < 2 ? 255 : 0, probe.At(x, 3).alpha) << x;
  }
  // A square cap reaches half the width beyond the end; a flat one does not.
  PenP thick(*supplier, {0, 0, 0, 1}, 4.0f);
  thick->SetLineCap(LineCapType::kSquare);
  surface->StrokePath(*thick, *Line({10, 20}, {20, 20}));
  EXPECT_EQ(255, Probe().At(8, 20).alpha);
  EXPECT_EQ(255, Probe().At(21, 20).alpha);
  EXPECT_EQ(0, Probe().At(7, 20).alpha);
}

TEST_F(CairoTest, InvalidDashPatternsAreRefused) {
  PenP pen(*supplier, {0, 0, 0, 1}, 1.0f);
  const float negative[2] = {2, -1};
  const float zeros[2] = {0, 0};
  EXPECT_THROW(pen->SetDashArray(negative, 2), velkcore::Exception);
  EXPECT_THROW(pen->SetDashArray(zeros, 2), velkcore::Exception);
  EXPECT_THROW(pen->SetDashArray(nullptr, 2), velkcore::Exception);
  EXPECT_EQ(0, pen->GetDashCount());
}

TEST_F(CairoTest, OutOfRangeEnumerationsRaiseTheirErrorsAndChangeNothing) {
  surface->SetAntiAliasPolicy(AntiAliasPolicy::kOff);
  EXPECT_EQ(23, ErrorNumber([&] { surface->SetAntiAliasPolicy(static_cast<AntiAliasPolicy>(3)); }));
  EXPECT_EQ(AntiAliasPolicy::kOff, surface->GetAntiAliasPolicy());
  EXPECT_EQ(24, ErrorNumber([&] {
              surface->SetInterpolationPolicy(static_cast<InterpolationPolicy>(-1));
            }));
  EXPECT_EQ(InterpolationPolicy::kHighQuality, surface->GetInterpolationPolicy());

  auto path = RectPath(RectT<float>{0, 0, 10, 10});
  BrushP brush(*supplier, {1, 0, 0, 1});
  EXPECT_EQ(25, ErrorNumber([&] { surface->FillPath(*brush, *path, static_cast<FillType>(2)); }));
  EXPECT_EQ(25, ErrorNumber([&] { surface->Clip(*path, static_cast<FillType>(7)); }));
  EXPECT_EQ(0, Probe().CountVisible());
  EXPECT_EQ((RectT<std::int32_t>{0, 0, 40, 30}), surface->GetClipBounds());

  PenP pen(*supplier, {0, 0, 0, 1}, 2.0f);
  pen->SetLineCap(LineCapType::kRound);
  pen->SetLineJoin(LineJoinType::kBevel);
  EXPECT_EQ(26, ErrorNumber([&] { pen->SetLineCap(static_cast<LineCapType>(3)); }));
  EXPECT_EQ(27, ErrorNumber([&] { pen->SetLineJoin(static_cast<LineJoinType>(-2)); }));
  EXPECT_EQ(LineCapType::kRound, pen->GetLineCap());
  EXPECT_EQ(LineJoinType::kBevel, pen->GetLineJoin());
}

TEST_F(CairoTest, PopRestoresPoliciesTransformAndClipButNeverTheBottom) {
  surface->PopStateStack();  // nothing saved: nothing happens
  surface->SetAntiAliasPolicy(AntiAliasPolicy::kOn);
  surface->PushStateStack();
  surface->SetAntiAliasPolicy(AntiAliasPolicy::kOff);
  surface->SetInterpolationPolicy(InterpolationPolicy::kNearestNeighbor);
  surface->SetTextDisplayPolicy(TextDisplayPolicy::kGridFitted);
  surface->Transform(MatrixT<float>::Translation(10, 0));
  surface->Clip(*RectPath(RectT<float>{0, 0, 5, 5}), FillType::kWinding);
  EXPECT_EQ((RectT<std::int32_t>{0, 0, 5, 5}), surface->GetClipBounds());
  surface->PopStateStack();
  surface->PopStateStack();
  EXPECT_EQ(AntiAliasPolicy::kOn, surface->GetAntiAliasPolicy());
  EXPECT_EQ(InterpolationPolicy::kHighQuality, surface->GetInterpolationPolicy());
  EXPECT_EQ(TextDisplayPolicy::kAntiAliased, surface->GetTextDisplayPolicy());
  MatrixT<float> matrix;
  surface->GetTransform(&matrix);
  EXPECT_TRUE(matrix.IsIdentity());
  EXPECT_EQ((RectT<std::int32_t>{0, 0, 40, 30}), surface->GetClipBounds());
  surface->PaintRect({1, 0, 0, 1}, {0, 0, 40, 30});
  EXPECT_EQ(1200, Probe().Count(kRed, 0, 0, 40, 30));
}

TEST_F(CairoTest, SingularTransformDrawsNothingUntilPopped) {
  surface->PushStateStack();
  surface->Transform(MatrixT<float>::Scale(0, 1));
  surface->PaintRect({1, 0, 0, 1}, {0, 0, 40, 30});
  MatrixT<float> matrix;
  surface->GetTransform(&matrix);
  EXPECT_EQ(0.0f, matrix.a);
  EXPECT_EQ((RectT<std::int32_t>{0, 0, 0, 0}), surface->GetClipBounds());
  EXPECT_EQ(0, Probe().CountVisible());
  surface->PopStateStack();
  surface->PaintRect({1, 0, 0, 1}, {0, 0, 1, 1});
  EXPECT_EQ(1, Probe().CountVisible());
}

TEST_F(CairoTest, TransformAppliesToUserCoordinatesFirst) {
  surface->Transform(MatrixT<float>::Translation(10, 5));
  surface->Transform(MatrixT<float>::Scale(2, 2));
  surface->PaintRect({1, 0, 0, 1}, {1, 1, 2, 2});  // device 12..16 × 7..11
  const PixelProbe probe = Probe();
  EXPECT_EQ(16, probe.Count(kRed, 12, 7, 4, 4));
  EXPECT_EQ(16, probe.CountVisible());
}

TEST_F(CairoTest, FontsMustReallyExist) {
  EXPECT_NO_THROW(supplier->NewFont(u"DejaVu Sans", u"Bold Italic", 12));
  EXPECT_NO_THROW(supplier->NewFont(u"dejavu sans mono", u"", 12));
  const auto e = DrawingError([&] { supplier->NewFont(u"No Such Family Xyz", u"Bold", 12); });
  ASSERT_TRUE(e);
  EXPECT_EQ(34, e->GetNumber());
  EXPECT_EQ(std::string(kErrorUnableToCreateFontKey), e->GetKey());
  EXPECT_EQ(u"No Such Family Xyz", e->GetReplacements()[0]);
  EXPECT_EQ(u"Bold", e->GetReplacements()[1]);
  EXPECT_EQ(u"Unable to load font \"No Such Family Xyz\" \"Bold\"", e->GetMessage());
  EXPECT_EQ(34, ErrorNumber([&] { supplier->NewFont(u"DejaVu", u"", 12); }));
  EXPECT_EQ(34, ErrorNumber([&] { supplier->NewFont(u"", u"", 12); }));
  EXPECT_FALSE(HasFontFamily(u"No Such Family Xyz"));
  const auto face = GetPlatformUIFontFamily();
  EXPECT_EQ(HasFontFamily(u"Tahoma") ? u"Tahoma" : u"DejaVu Sans", face);
}

TEST_F(CairoTest, TextSitsOnItsBaselineAndFollowsItsAlignment) {
  FontP font(*supplier, u"DejaVu Sans", u"", 20);
  EXPECT_GT(font->GetAscent(), 14.0f);
  EXPECT_GT(font->GetDescent(), 3.0f);
  BrushP black(*supplier, {0, 0, 0, 1});
  SurfaceP target(*supplier, 200, 60, true);
  const float width = target->MeasureStringWidth(*font, u"HHH", -1);
  EXPECT_NEAR(3 * target->MeasureStringWidth(*font, u"H", -1), width, 0.01f);
  target->DrawString(*black, *font, u"HHH", {100, 40}, TextAlignment::kEnd, TextTruncation::kNone,
                     0);
  PixelProbe probe(*target);
  int top = 60, bottom = -1, left = 200, right = -1;
  for (int y = 0; y < 60; ++y) {
    for (int x = 0; x < 200; ++x) {
      if (probe.At(x, y).alpha == 0) continue;
      top = std::min(top, y);
      bottom = std::max(bottom, y);
      left = std::min(left, x);
      right = std::max(right, x);
    }
  }
  EXPECT_EQ(39, bottom);  // "H" stands on the baseline
  EXPECT_NEAR(40 - 0.73 * 20, top, 1.0);
  EXPECT_LE(right, 100);
  EXPECT_GE(right, 96);
  EXPECT_NEAR(100 - width, left, 4.0);
}

TEST_F(CairoTest, MeasuringStopsAtTheEndOfTheText) {
  FontP font(*supplier, u"DejaVu Sans", u"", 12);
  EXPECT_EQ(surface->MeasureStringWidth(*font, u"He", -1),
            surface->MeasureStringWidth(*font, u"Hello", 2));
  EXPECT_EQ(surface->MeasureStringWidth(*font, u"Hello", -1),
            surface->MeasureStringWidth(*font, u"Hello", 500));
  EXPECT_EQ(0.0f, surface->MeasureStringWidth(*font, u"", -1));
  EXPECT_EQ(0.0f, surface->MeasureMultiLineStringHeight(*font, u"", 100, -1));
}

TEST_F(CairoTest, MultiLineTextWrapsAndShowsOnlyWholeLines) {
  FontP font(*supplier, u"DejaVu Sans", u"", 12);
  const char16_t* text = u"one two three four five six";
  const float oneLine = surface->MeasureMultiLineStringHeight(*font, u"one", 1000, -1);
  const float wrapped = surface->MeasureMultiLineStringHeight(*font, text, 60, -1);
  EXPECT_GT(wrapped, 2.5f * oneLine);
  EXPECT_NEAR(oneLine, surface->MeasureMultiLineStringHeight(*font, text, 0, -1), 0.01f);

  BrushP black(*supplier, {0, 0, 0, 1});
  SurfaceP target(*supplier, 80, 100, true);
  target->DrawMultiLineString(*black, *font, text, {0, 0, 60, oneLine * 1.5f},
                              TextAlignment::kStart);
  PixelProbe probe(*target);
  EXPECT_GT(probe.Count(kClear, 0, 0, 80, static_cast<int>(oneLine)), 0);
  EXPECT_GT(probe.CountVisible(), 20);
  EXPECT_EQ(80 * (100 - static_cast<int>(oneLine) - 1),
            probe.Count(kClear, 0, static_cast<int>(oneLine) + 1, 80, 100));
}

TEST_F(CairoTest, GradientsAreShadersAndBrushes) {
  const ColorRGBA colours[2] = {{1, 0, 0, 1}, {0, 0, 1, 1}};
  const float positions[2] = {0, 1};
  auto shader = supplier->CreateLinearShader({0, 0}, {40, 0}, colours, positions, 2);
  surface->ShadePath(*shader, *RectPath(RectT<float>{0, 0, 40, 10}), FillType::kWinding);
  const BrushInterface* asBrush = AsBrush(*shader);
  ASSERT_NE(nullptr, asBrush);
  surface->FillPath(*asBrush, *RectPath(RectT<float>{0, 20, 40, 10}), FillType::kWinding);
  const PixelProbe probe = Probe();
  EXPECT_GT(probe.At(0, 5).red, 240);
  EXPECT_GT(probe.At(39, 5).blue, 240);
  EXPECT_NEAR(128, probe.At(20, 5).red, 8);
  EXPECT_EQ(probe.At(20, 5), probe.At(20, 25));

  auto radial = supplier->CreateRadialShader({20, 15}, 10, colours, positions, 2);
  SurfaceP disc(*supplier, 40, 30, true);
  disc->ShadePath(*radial, *RectPath(RectT<float>{0, 0, 40, 30}), FillType::kWinding);
  PixelProbe discProbe(*disc);
  EXPECT_GT(discProbe.At(20, 15).red, 230);
  EXPECT_GT(discProbe.At(0, 0).blue, 240);
}

TEST_F(CairoTest, WrongKindsOfResourcesAreErrors) {
  boost::intrusive_ptr<velkui::test::RecordingSupplier> recording(
      new velkui::test::RecordingSupplier());
  auto foreignPath = recording->NewPath();
  auto foreignImage = recording->NewBufferImage(2, 2, 8, PixelLayout::kBGRA, nullptr, {});
  BrushP brush(*supplier, {1, 0, 0, 1});
  EXPECT_EQ(30, ErrorNumber([&] { surface->FillPath(*brush, *foreignPath, FillType::kWinding); }));
  EXPECT_EQ(30, ErrorNumber([&] { surface->DrawImage(*foreignImage, {0, 0}, 1.0f); }));
  EXPECT_EQ(30,
            ErrorNumber([&] { supplier->NewImageSurface(foreignImage.get(), false, nullptr); }));
  EXPECT_EQ(30, ErrorNumber([&] { EncodeImageAsPNG(*foreignImage); }));
  OSSurfaceP osSurface;
  EXPECT_EQ(30, ErrorNumber([&] { osSurface.New(recording.get(), nullptr, nullptr); }));
}

TEST_F(CairoTest, PlatformSurfacesNeedTheStartupObject) {
  OSSurfaceP osSurface;
  ASSERT_FALSE(velkui::utility::StartupShutdownGdiPlus::IsStarted());
  EXPECT_EQ(21, ErrorNumber([&] { osSurface.New(supplier.get(), nullptr, nullptr); }));
  {
    velkui::utility::StartupShutdownGdiPlus startup;
    EXPECT_TRUE(velkui::utility::StartupShutdownGdiPlus::IsStarted());
    EXPECT_EQ(31, ErrorNumber([&] { osSurface.New(supplier.get(), nullptr, nullptr); }));
  }
  EXPECT_FALSE(velkui::utility::StartupShutdownGdiPlus::IsStarted());
  EXPECT_FALSE(osSurface);
}

TEST_F(CairoTest, ImpossibleSurfacesAreErrors) {
  EXPECT_EQ(31, ErrorNumber([&] { supplier->NewSurface(-1, 10, true); }));
  EXPECT_EQ(31, ErrorNumber([&] { supplier->NewSurface(100000, 10, true); }));
  SurfaceP empty(*supplier, 0, 0, true);
  empty->PaintRect({1, 0, 0, 1}, {0, 0, 10, 10});
  EXPECT_EQ(0, empty->GetSurfaceImage()->GetWidth());
}

TEST_F(CairoTest, DeviceContextIsLentOnlyByPlatformSurfaces) {
  {
    ScAcquireSurfaceHDC lent(surface.Get());
    EXPECT_NE(nullptr, lent.Get());
  }
  boost::intrusive_ptr<velkui::test::RecordingSupplier> recording(
      new velkui::test::RecordingSupplier());
  SurfaceP foreign(*recording, 10, 10);
  EXPECT_EQ(30, ErrorNumber([&] { ScAcquireSurfaceHDC lent(foreign.Get()); }));
}

}  // namespace
