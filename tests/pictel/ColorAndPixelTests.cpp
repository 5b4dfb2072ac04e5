#include <array>
#include <cstdint>
#include <vector>

#include <gtest/gtest.h>

#include <velkui/pictel/ColorConversion.h>
#include <velkui/pictel/ColorManagement.h>
#include <velkui/pictel/MemBuffer.h>
#include <velkui/pictel/PixelSwizzle.h>

namespace {

using namespace velkui::pictel;
using Bytes = std::vector<std::uint8_t>;

void ExpectColor(const ColorRGBA& expected, const ColorRGBA& actual) {
  EXPECT_NEAR(expected.red, actual.red, 1e-6);
  EXPECT_NEAR(expected.green, actual.green, 1e-6);
  EXPECT_NEAR(expected.blue, actual.blue, 1e-6);
  EXPECT_FLOAT_EQ(expected.alpha, actual.alpha);
}

TEST(HSBtoRGB, PrimaryHuesAndWrapAround) {
  ExpectColor({1, 0, 0, 1}, HSBtoRGB<float>(0, 1, 1, 1));
  ExpectColor(HSBtoRGB<float>(0, 1, 1, 1), HSBtoRGB<float>(360, 1, 1, 1));
  ExpectColor({1, 0, 1, 1}, HSBtoRGB<float>(-60, 1, 1, 1));
  ExpectColor({0, 1, 0, 0.5f}, HSBtoRGB<double>(120, 1, 1, 0.5f));
  ExpectColor({0, 0, 1, 1}, HSBtoRGB<double>(240 + 720, 1, 1, 1));
}

TEST(HSBtoRGB, EverySectorAndGrey) {
  // Half saturation and brightness 0.8 at the middle of each sector.
  const float b = 0.8f;
  const float p = 0.4f;  // (1 - s) b
  const float q = 0.6f;  // (1 - s f) b with f = 0.5
  ExpectColor({b, q, p, 1}, HSBtoRGB<float>(30, 0.5f, b, 1));
  ExpectColor({q, b, p, 1}, HSBtoRGB<float>(90, 0.5f, b, 1));
  ExpectColor({p, b, q, 1}, HSBtoRGB<float>(150, 0.5f, b, 1));
  ExpectColor({p, q, b, 1}, HSBtoRGB<float>(210, 0.5f, b, 1));
  ExpectColor({q, p, b, 1}, HSBtoRGB<float>(270, 0.5f, b, 1));
  ExpectColor({b, p, q, 1}, HSBtoRGB<float>(330, 0.5f, b, 1));
  ExpectColor({0.3f, 0.3f, 0.3f, 1}, HSBtoRGB<double>(123, 0, 0.3, 1));
}

TEST(RGBtoHSB, UndefinedHueFollowsTheFlag) {
  float h = 5, s = 5, b = 5;
  RGBtoHSB<float>({0, 0, 0, 1}, h, s, b, true);
  EXPECT_EQ(-1.0f, h);
  EXPECT_EQ(0.0f, s);
  EXPECT_EQ(0.0f, b);
  RGBtoHSB<float>({0, 0, 0, 1}, h, s, b, false);
  EXPECT_EQ(0.0f, h);
  double dh = 5, ds = 5, db = 5;
  RGBtoHSB<double>({0.5f, 0.5f, 0.5f, 1}, dh, ds, db, true);
  EXPECT_EQ(-1.0, dh);
  EXPECT_EQ(0.0, ds);
  EXPECT_DOUBLE_EQ(0.5, db);
}

TEST(RGBtoHSB, RoundTripsThroughHSBtoRGB) {
  for (double hue = 0; hue < 360; hue += 15) {
    const ColorRGBA color = HSBtoRGB<double>(hue, 0.75, 0.6, 1);
    double h = 0, s = 0, b = 0;
    RGBtoHSB<double>(color, h, s, b, true);
    EXPECT_NEAR(hue, h, 1e-4) << hue;
    EXPECT_NEAR(0.75, s, 1e-6);
    EXPECT_NEAR(0.6, b, 1e-6);
  }
  float h = 0, s = 0, b = 0;
  RGBtoHSB<float>({1, 0, 0.5f, 1}, h, s, b, false);  // red is largest, negative raw hue
  EXPECT_NEAR(330.0f, h, 1e-4);
}

TEST(Swizzle, PremultiplyLeavesOpaquePixelsAndScalesOthers) {
  Bytes pixels = {255, 10, 20, 30, 128, 255, 255, 255, 0, 200, 100, 50};
  inplace_swizzle<PixelLayout::kARGB, PixelLayout::kARGBPremultiplied>(pixels.data(), 3);
  EXPECT_EQ((Bytes{255, 10, 20, 30, 128, 128, 128, 128, 0, 0, 0, 0}), pixels);
}

TEST(Swizzle, UnpremultiplyClampsAndSkipsOpaqueAndTransparent) {
  Bytes pixels = {128, 64, 128, 200, 0, 9, 9, 9, 255, 1, 2, 3, 10, 20, 5, 10};
  inplace_swizzle<PixelLayout::kARGBPremultiplied, PixelLayout::kARGB>(pixels.data(), 4);
  // 200 / (128 / 255) is 398: a colour byte above alpha saturates at 255.
  EXPECT_EQ((Bytes{128, 127, 255, 255, 0, 9, 9, 9, 255, 1, 2, 3, 10, 255, 127, 255}), pixels);
}

TEST(Swizzle, ByteOrderReversalIsItsOwnInverse) {
  const Bytes original = {1, 2, 3, 4, 5, 6, 7, 8};
  Bytes pixels = original;
  inplace_swizzle<PixelLayout::kARGB, PixelLayout::kBGRA>(pixels.data(), 2);
  EXPECT_EQ((Bytes{4, 3, 2, 1, 8, 7, 6, 5}), pixels);
  inplace_swizzle<PixelLayout::kBGRA, PixelLayout::kARGB>(pixels.data(), 2);
  EXPECT_EQ(original, pixels);
}

TEST(MemBuffer, SizeClearAndChannelSwap) {
  MemBuffer buffer(2, 3, 10, PixelLayout::kBGRA);
  EXPECT_EQ(30u, buffer.GetDataSize());
  buffer.Alloc();
  for (std::size_t i = 0; i < buffer.GetDataSize(); ++i) buffer.GetData()[i] = std::uint8_t(i);
  buffer.SwapColorChannels();
  // Seven whole pixels are swapped; the last two bytes are not a pixel and stay.
  EXPECT_EQ(2, buffer.GetData()[0]);
  EXPECT_EQ(0, buffer.GetData()[2]);
  EXPECT_EQ(26, buffer.GetData()[24]);
  EXPECT_EQ(24, buffer.GetData()[26]);
  EXPECT_EQ(28, buffer.GetData()[28]);
  EXPECT_EQ(29, buffer.GetData()[29]);
  buffer.ClearBuffer();
  for (std::size_t i = 0; i < buffer.GetDataSize(); ++i) EXPECT_EQ(0, buffer.GetData()[i]);
}

TEST(ColorDestinationProfile, BytesPerPixel) {
  ColorDestinationProfile profile;
  EXPECT_EQ(4, profile.GetBytesPerPixel());
  profile.SetPixelLayout(PixelLayout::kBGR);
  EXPECT_EQ(3, profile.GetBytesPerPixel());
  profile.SetPixelLayout(PixelLayout::kBGRA);
  profile.SetDepth(4);  // below a byte per channel
  EXPECT_EQ(3, profile.GetBytesPerPixel());
}

}  // namespace
