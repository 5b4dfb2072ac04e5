#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <velkui/pictel/ColorManagement.h>
#include <velkui/pictel/Gradients.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PathShapes.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/PictelErrors.h>
#include <velkui/pictel/PictelImageResourceCache.h>
#include <velkui/test/RecordingSupplier.h>

#include "PictelTestSupport.h"

namespace {

using namespace velkui::pictel;
using velkcore::PointT;
using velkcore::RectT;
using velkui::test::RecordingPath;
using velkui::test::RecordingSupplier;
using velkui::test::RecordingSurface;
using Strings = std::vector<std::string>;

class HelperTest : public test::RecordingSurfaceTest {
 protected:
  Pictel pictel{supplier.get(), surface.Get()};

  static std::string Describe(const PathP& path) {
    return dynamic_cast<const RecordingPath&>(*path).Describe();
  }
};

TEST_F(HelperTest, GradientIsShadedWhenTheSupplierHasShaders) {
  PathP path(*supplier);
  path->AddRect(RectT<float>{0, 0, 10, 10});
  velkui::utils::HandleGradient(&pictel, path, {0, 0}, {0, 10}, ColorRGBA{1, 1, 1, 1},
                                ColorRGBA{0, 0, 0, 1});
  EXPECT_EQ(Strings{"ShadePath linear 0,0->0,10 0:(1,1,1,1) 1:(0,0,0,1) R0,0,10,10 rule1"},
            Drawn());
}

TEST_F(HelperTest, GradientFallsBackToOneColourAtTheInterfaceBrightness) {
  supplier->SetShadersEnabled(false);
  PathP path(*supplier);
  path->AddRect(RectT<float>{0, 0, 10, 10});
  const ColorRGBA colours[3] = {{0, 0, 0, 0}, {0.3f, 0.3f, 0.3f, 1}, {1, 0.5f, 0, 1}};
  const float positions[3] = {0, 0.2f, 1};
  velkui::utils::HandleGradient(&pictel, path, {0, 0}, {0, 10}, colours, positions, 3);
  velkui::utils::SetGradientBrightnessFunction([] { return 0.25f; });
  velkui::utils::HandleGradient(&pictel, path, {0, 0}, {0, 10}, colours, positions, 3);
  velkui::utils::SetGradientBrightnessFunction({});
  EXPECT_EQ((Strings{"FillPath solid(0.5,0.25,0,0.5) R0,0,10,10 rule1",
                     "FillPath solid(0.25,0.125,0,0.25) R0,0,10,10 rule1"}),
            Drawn());
}

TEST_F(HelperTest, FontBaselineCentresTheTextAndRoundsHalvesAway) {
  EXPECT_EQ(23.0f, velkui::GetFontBaseline(font, {0, 10, 50, 20}));
  EXPECT_EQ(19.0f, velkui::GetFontBaseline(font, {0, 10, 50, 11}));
  EXPECT_EQ(-22.0f, velkui::GetFontBaseline(font, {0, -30, 50, 11}));
}

TEST_F(HelperTest, RoundedRectanglesLimitTheirRadius) {
  PathP path;
  velkui::GetRoundedRectPath(supplier.get(), {0, 0, 20, 10}, 8, &path);
  EXPECT_EQ("M5,0 A15,5 5 270 90 A15,5 5 0 90 A5,5 5 90 90 A5,5 5 180 90 Z", Describe(path));
  velkui::GetRoundedRectPath(supplier.get(), {0, 0, 20, 10}, 0, &path);
  EXPECT_EQ("R0,0,20,10", Describe(path));
  velkui::GetRoundedRectPath(supplier.get(), {0, 0, 0, 10}, 3, &path);
  EXPECT_EQ("W", Describe(path));
}

TEST_F(HelperTest, FourCornerVariantRoundsOnlyTheChosenCorners) {
  PathP path(*supplier);
  velkui::utils::FormRoundedRect(path, {0, 0, 20, 10}, 4, {true, false, false, true});
  EXPECT_EQ("M4,0 L20,0 L20,10 A4,6 4 90 90 A4,4 4 180 90 Z", Describe(path));
  velkui::utils::FormRect(path, {1, 2, 3, 4});
  EXPECT_EQ("M4,0 L20,0 L20,10 A4,6 4 90 90 A4,4 4 180 90 Z R1,2,3,4", Describe(path));
  PathP none;
  EXPECT_THROW(velkui::utils::FormRect(none, {0, 0, 1, 1}), velkcore::Exception);
}

TEST_F(HelperTest, EllipseIsFourCurvesThroughTheRectangleMidpoints) {
  PathP path;
  velkui::GetEllipsePath(supplier.get(), {0, 0, 40, 20}, &path);
  const auto& segments = dynamic_cast<const RecordingPath&>(*path).GetSegments();
  ASSERT_EQ(6u, segments.size());
  EXPECT_EQ("M40,10", segments[0]);
  EXPECT_NE(std::string::npos, segments[1].find(" 20,20"));
  EXPECT_NE(std::string::npos, segments[2].find(" 0,10"));
  EXPECT_NE(std::string::npos, segments[3].find(" 20,0"));
  EXPECT_NE(std::string::npos, segments[4].find(" 40,10"));
  EXPECT_EQ("Z", segments[5]);
  EXPECT_EQ((RectT<float>{0, 0, 40, 20}), dynamic_cast<const RecordingPath&>(*path).GetBounds());
}

TEST(PathInterface, WholeNumberedMarkSurvivesOnlyIntegerGeometry) {
  RecordingPath path;
  path.MoveTo(PointT<std::int32_t>{1, 2});
  path.LineTo(PointT<std::int32_t>{3, 4});
  path.AddRect(RectT<std::int32_t>{0, 0, 5, 5});
  path.BezierTo(PointT<std::int32_t>{1, 1}, PointT<std::int32_t>{2, 2}, PointT<std::int32_t>{3, 3});
  EXPECT_TRUE(path.IsWholeNumbered());
  path.LineTo(PointT<float>{3, 4});
  EXPECT_FALSE(path.IsWholeNumbered());
  path.LineTo(PointT<std::int32_t>{7, 7});
  EXPECT_FALSE(path.IsWholeNumbered());
}

// A colour that reports the display it was converted for.
class DisplayColour : public AbstractColor {
 public:
  bool IsManaged() const override { return true; }
  ColorRGBA Convert(const ColorDestinationProfile& profile) const override {
    EXPECT_EQ(PixelLayout::kARGB, profile.GetPixelLayout());
    EXPECT_EQ(8, profile.GetDepth());
    const auto display = reinterpret_cast<std::uintptr_t>(profile.GetDisplayID());
    return {static_cast<float>(display), 0, 0, 1};
  }
};

class MonitorTest : public HelperTest {
 protected:
  void SetUp() override {
    SetMonitorEnumerator([] {
      return std::vector<MonitorPiece>{{{0, 0, 100, 100}, reinterpret_cast<void*>(1)},
                                       {{100, 0, 100, 100}, reinterpret_cast<void*>(2)}};
    });
  }
  void TearDown() override { SetMonitorEnumerator({}); }
};

TEST_F(MonitorTest, ColourManagedRectIsPaintedDisplayByDisplay) {
  const boost::intrusive_ptr<AbstractColor> colour(new DisplayColour());
  PaintColorManagedRect(pictel, {90.5f, 10, 20, 5}, {0, 0}, colour);
  PaintColorManagedRect(pictel, {90.5f, 10, 20, 5}, {50, 0}, colour);
  EXPECT_EQ((Strings{"PaintRect (1,0,0,1) [90,10,10,5]", "PaintRect (2,0,0,1) [100,10,11,5]",
                     "PaintRect (2,0,0,1) [90,10,21,5]"}),
            Drawn());
}

TEST_F(MonitorTest, SubdivisionKeepsRectanglesOffEveryDisplay) {
  EXPECT_EQ(2u, SubdivideByMonitor({50, 50, 100, 10}).size());
  const auto offscreen = SubdivideByMonitor({-500, -500, 10, 10});
  ASSERT_EQ(1u, offscreen.size());
  EXPECT_EQ(nullptr, offscreen[0].second);
}

// A managed image that records the pieces it is asked for.
class RecordingManagedImage : public ManagedImage {
 public:
  std::int32_t GetWidth() const override { return 20; }
  std::int32_t GetHeight() const override { return 10; }
  void Convert(const ImageDestinationProfile& profile, void* destination) const override {
    const auto& s = profile.GetSubregion();
    requests.push_back(std::to_string(reinterpret_cast<std::uintptr_t>(profile.GetDisplayID())) +
                       ":" + std::to_string(s.left) + "," + std::to_string(s.top) + "," +
                       std::to_string(s.width) + "," + std::to_string(s.height));
    std::fill_n(static_cast<std::uint8_t*>(destination), s.width * s.height * 4, 0xFF);
  }
  mutable std::vector<std::string> requests;
};

TEST_F(MonitorTest, ColourManagedImageIsConvertedPieceByPiece) {
  boost::intrusive_ptr<RecordingManagedImage> image(new RecordingManagedImage());
  PaintColorManagedImage(pictel, {90, 0, 20, 10}, {0, 0}, image);
  EXPECT_EQ((Strings{"1:0,0,10,10", "2:10,0,10,10"}), image->requests);
  const Strings drawn = Drawn();
  EXPECT_EQ(2, std::count_if(drawn.begin(), drawn.end(), [](const std::string& call) {
              return call.rfind("DrawImage buffer 10x10", 0) == 0;
            }));
}

TEST(ColorManagement, ManagingNeedsAManagedVisualAndACallback) {
  const UnManagedRGBA plain({0.1f, 0.2f, 0.3f, 0.4f});
  EXPECT_EQ((ColorRGBA{0.1f, 0.2f, 0.3f, 0.4f}), plain.Convert(ColorDestinationProfile()));
  RecordingManagedImage managed;
  const OpaqueApplicationData data;
  ColorDestinationProfile profile;
  EXPECT_TRUE(test::RaisesDrawingError([&] { managed.Manage(profile, data, nullptr); }, 36,
                                       kErrorNoColorManagementCallbackKey));
  int calls = 0;
  SetColorManagementCallback(
      [&calls](const ColorDestinationProfile&, const OpaqueApplicationData&, void*) { ++calls; });
  managed.Manage(profile, data, nullptr);
  EXPECT_THROW(plain.Manage(profile, data, nullptr), velkcore::Exception);
  SetColorManagementCallback({});
  EXPECT_EQ(1, calls);
}

std::vector<unsigned char> PngHeader(std::uint8_t width, std::uint8_t height) {
  std::vector<unsigned char> bytes = {0x89, 'P', 'N', 'G',   '\r', '\n', 0x1A, '\n',
                                      0,    0,   0,   13,    'I',  'H',  'D',  'R',
                                      0,    0,   0,   width, 0,    0,    0,    height};
  return bytes;
}

TEST(PictelImageResourceCache, DecodesOnceAndKeepsSupplierKindsApart) {
  using velkui::utility::PictelImageResourceCache;
  boost::intrusive_ptr<RecordingSupplier> recording(new RecordingSupplier());
  PictelImageResourceCache cache;
  const auto small = PngHeader(4, 3);
  const auto large = PngHeader(9, 9);
  int loads = 0;
  const PictelImageResourceCache::ResourceLoader loader = [&](std::string_view name,
                                                              std::string_view type) {
    ++loads;
    EXPECT_EQ("Icon", name);
    EXPECT_EQ("png", type);
    return std::span<const unsigned char>(small);
  };
  const auto first = cache.GetImage(loader, *recording, "Icon", ImageFileType::kPNG);
  const auto again =
      cache.GetImage(large.data(), large.size(), *recording, "Icon", ImageFileType::kPNG);
  EXPECT_EQ(first, again);
  EXPECT_EQ(1, loads);
  EXPECT_EQ(4, first->GetWidth());
  EXPECT_EQ(first, cache.FindImage(*recording, "Icon", ImageFileType::kPNG));

  auto platform = NewOSSupplier();
  EXPECT_EQ(nullptr, cache.FindImage(*platform, "Icon", ImageFileType::kPNG));
  boost::intrusive_ptr<RecordingSupplier> sameKind(new RecordingSupplier());
  EXPECT_EQ(first, cache.FindImage(*sameKind, "Icon", ImageFileType::kPNG));

  cache.CacheImage(*recording, "Icon", ImageFileType::kPNG,
                   recording->NewFileImage(large.data(), large.size(), ImageFileType::kPNG));
  EXPECT_EQ(9, cache.FindImage(*recording, "Icon", ImageFileType::kPNG)->GetWidth());
  EXPECT_TRUE(cache.RemoveCachedImage(*recording, "Icon", ImageFileType::kPNG));
  EXPECT_FALSE(cache.RemoveCachedImage(*recording, "Icon", ImageFileType::kPNG));
  EXPECT_EQ(0u, cache.GetSize());
}

TEST(PictelImageResourceCache, UndecodableBytesAreNotCached) {
  velkui::utility::PictelImageResourceCache cache;
  auto platform = NewOSSupplier();
  const unsigned char junk[] = "not an image";
  EXPECT_THROW(cache.GetImage(junk, sizeof junk, *platform, "Junk", ImageFileType::kPNG),
               velkcore::Exception);
  EXPECT_EQ(0u, cache.GetSize());
}

}  // namespace
