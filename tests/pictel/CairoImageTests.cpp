#include <cstdint>
#include <cstring>
#include <vector>

#include <gtest/gtest.h>

#include <velkui/pictel/ImageIO.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PathShapes.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/test/PixelProbe.h>

#include "PictelTestSupport.h"

namespace {

using namespace velkui::pictel;
using velkcore::RectT;
using velkui::test::Pixel;
using velkui::test::PixelProbe;
using Bytes = std::vector<std::uint8_t>;
using test::ErrorNumber;

struct LayoutCase {
  PixelLayout layout;
  int bytesPerPixel;
  int padding;  // extra bytes per row
};

// Each layout with tight rows and with rows that are not a multiple of 4.
const LayoutCase kLayouts[] = {
    {PixelLayout::kBGR, 3, 0},
    {PixelLayout::kBGR, 3, 1},
    {PixelLayout::kBGRX, 4, 0},
    {PixelLayout::kBGRX, 4, 2},
    {PixelLayout::kBGRA, 4, 0},
    {PixelLayout::kBGRA, 4, 3},
    {PixelLayout::kBGRAPremultiplied, 4, 0},
    {PixelLayout::kBGRAPremultiplied, 4, 1},
};

// A caller buffer of 5 × 4 pixels followed by guard bytes that must never change.
class CallerBuffer {
 public:
  explicit CallerBuffer(const LayoutCase& c)
      : rowBytes_(5 * c.bytesPerPixel + c.padding),
        bytesPerPixel_(c.bytesPerPixel),
        bytes_(static_cast<std::size_t>(rowBytes_) * 4 + kGuard, 0x5A) {
    for (int y = 0; y < 4; ++y) {
      for (int x = 0; x < 5; ++x) Set(x, y, {40, 80, 120, 255});
    }
  }
  void* Data() { return bytes_.data(); }
  std::int32_t RowBytes() const { return rowBytes_; }
  // Blue, green, red and (for four-byte layouts) alpha, in memory order.
  void Set(int x, int y, std::array<std::uint8_t, 4> bgra) {
    std::memcpy(&bytes_[Offset(x, y)], bgra.data(), static_cast<std::size_t>(bytesPerPixel_));
  }
  Bytes Get(int x, int y) const {
    return Bytes(bytes_.begin() + Offset(x, y), bytes_.begin() + Offset(x, y) + bytesPerPixel_);
  }
  bool GuardIntact() const {
    return std::all_of(bytes_.end() - kGuard, bytes_.end(),
                       [](std::uint8_t b) { return b == 0x5A; });
  }

 private:
  static constexpr std::size_t kGuard = 16;
  std::ptrdiff_t Offset(int x, int y) const { return y * rowBytes_ + x * bytesPerPixel_; }
  std::int32_t rowBytes_;
  int bytesPerPixel_;
  Bytes bytes_;
};

class CairoImageTest : public ::testing::Test {
 protected:
  boost::intrusive_ptr<SupplierInterface> supplier = NewOSSupplier();
};

TEST_F(CairoImageTest, BufferSurfacesDrawIntoCallerMemoryInEveryLayout) {
  for (const LayoutCase& c : kLayouts) {
    SCOPED_TRACE(testing::Message()
                 << "layout " << static_cast<int>(c.layout) << " padding " << c.padding);
    CallerBuffer buffer(c);
    int deleted = 0;
    {
      auto surface = supplier->NewBufferSurface(5, 4, buffer.RowBytes(), c.layout, buffer.Data(),
                                                [&deleted](void*) { ++deleted; });
      // The caller's pixels are there to draw over.
      EXPECT_EQ((Pixel{120, 80, 40, 255}), PixelProbe(*surface).At(4, 3));
      surface->PaintRect({0, 0, 1, 1}, {1, 1, 2, 2});
      surface->Flush();
      Bytes blue = {255, 0, 0, 255};
      blue.resize(static_cast<std::size_t>(c.bytesPerPixel));
      EXPECT_EQ(blue, buffer.Get(1, 1));
      EXPECT_EQ(blue, buffer.Get(2, 2));
      Bytes untouched = {40, 80, 120, 255};
      untouched.resize(static_cast<std::size_t>(c.bytesPerPixel));
      EXPECT_EQ(untouched, buffer.Get(3, 2));
      // Drawn after the flush and written back when the surface goes.
      surface->PaintRect({1, 0, 0, 1}, {4, 3, 1, 1});
      EXPECT_EQ(0, deleted);
    }
    EXPECT_EQ(1, deleted);
    EXPECT_EQ(Bytes({0, 0, 255, 255}).at(2), buffer.Get(4, 3).at(2));
    EXPECT_TRUE(buffer.GuardIntact());
  }
}

TEST_F(CairoImageTest, StraightAlphaBuffersArePremultipliedForDrawing) {
  Bytes pixel = {0, 0, 255, 128};  // half-transparent red, straight
  auto image = supplier->NewBufferImage(1, 1, 4, PixelLayout::kBGRA, pixel.data(), {});
  SurfaceP white(*supplier, 1, 1, false);
  white->DrawImage(*image, {0, 0}, 1.0f);
  const Pixel blended = PixelProbe(*white).At(0, 0);
  EXPECT_EQ(255, blended.red);
  EXPECT_NEAR(127, blended.green, 1);
  EXPECT_EQ(255, blended.alpha);
}

TEST_F(CairoImageTest, UnsupportedLayoutsAndBadBuffersAreRefused) {
  Bytes pixels(64);
  const auto surface = [&](std::int32_t width, int layout) {
    return ErrorNumber([&] {
      supplier->NewBufferSurface(width, 2, 8, static_cast<PixelLayout>(layout), pixels.data(), {});
    });
  };
  const auto image = [&](std::int32_t rowBytes, int layout, void* data) {
    return ErrorNumber([&] {
      supplier->NewBufferImage(2, 2, rowBytes, static_cast<PixelLayout>(layout), data, {});
    });
  };
  for (int layout : {4, 5, 0, 2, 8}) {
    EXPECT_EQ(22, surface(2, layout));
    EXPECT_EQ(22, image(8, layout, pixels.data()));
  }
  const int bgra = static_cast<int>(PixelLayout::kBGRA);
  EXPECT_EQ(29, image(7, bgra, pixels.data()));
  EXPECT_EQ(29, image(8, bgra, nullptr));
  EXPECT_EQ(31, surface(0, bgra));
}

TEST_F(CairoImageTest, BufferImageLetsGoOfItsPixelsWhenReleased) {
  Bytes pixels(16, 0xFF);
  int deleted = 0;
  SurfaceP target(*supplier, 4, 4, true);
  {
    auto image = supplier->NewBufferImage(2, 2, 8, PixelLayout::kBGRAPremultiplied, pixels.data(),
                                          [&](void* p) {
                                            EXPECT_EQ(pixels.data(), p);
                                            ++deleted;
                                          });
    target->DrawImage(*image, {1, 1}, 1.0f);
  }
  EXPECT_EQ(1, deleted);
  EXPECT_EQ(4, PixelProbe(*target).CountVisible());
}

TEST_F(CairoImageTest, EncodedImagesDecodeAndGarbageIsError28) {
  SurfaceP source(*supplier, 6, 3, true);
  source->PaintRect({1, 0, 0, 1}, {0, 0, 3, 3});
  source->PaintRect({0, 1, 0, 0.5f}, {3, 0, 3, 3});
  const auto png = EncodeImageAsPNG(*source->GetSurfaceImage());
  auto decoded = supplier->NewFileImage(png.data(), png.size(), ImageFileType::kPNG);
  EXPECT_EQ(6, decoded->GetWidth());
  EXPECT_EQ(3, decoded->GetHeight());
  const PixelProbe probe(*decoded);
  EXPECT_EQ((Pixel{255, 0, 0, 255}), probe.At(1, 1));
  EXPECT_EQ(0, probe.At(4, 1).red);
  EXPECT_NEAR(128, probe.At(4, 1).alpha, 1);

  const char junk[] = "this is not an image at all";
  EXPECT_EQ(28,
            ErrorNumber([&] { supplier->NewFileImage(junk, sizeof junk, ImageFileType::kPNG); }));
  EXPECT_EQ(28, ErrorNumber([&] { supplier->NewFileImage(png.data(), 40, ImageFileType::kPNG); }));
  EXPECT_EQ(28, ErrorNumber([&] { supplier->NewFileImage(nullptr, 0, ImageFileType::kPNG); }));
}

TEST_F(CairoImageTest, OpacityScalesAlpha) {
  SurfaceP red(*supplier, 2, 2, true);
  red->PaintRect({1, 0, 0, 1}, {0, 0, 2, 2});
  SurfaceP target(*supplier, 4, 2, true);
  target->DrawImage(*red->GetSurfaceImage(), {0, 0}, 0.5f);
  target->DrawImage(*red->GetSurfaceImage(), {2, 0}, 0.0f);
  const PixelProbe probe(*target);
  EXPECT_NEAR(128, probe.At(1, 1).alpha, 1);
  EXPECT_EQ(0, probe.At(3, 1).alpha);
}

TEST_F(CairoImageTest, ScaledImageFillsItsDestinationWithNearestNeighbour) {
  Bytes pixels = {0, 0, 255, 255, 255, 0, 0, 255};  // red, blue
  auto image =
      supplier->NewBufferImage(2, 1, 8, PixelLayout::kBGRAPremultiplied, pixels.data(), {});
  SurfaceP target(*supplier, 20, 10, true);
  target->SetInterpolationPolicy(InterpolationPolicy::kNearestNeighbor);
  target->DrawImage(*supplier, *image, {2, 2, 8, 4}, nullptr, 1.0f);
  const PixelProbe probe(*target);
  EXPECT_EQ(16, probe.Count({255, 0, 0, 255}, 2, 2, 4, 4));
  EXPECT_EQ(16, probe.Count({0, 0, 255, 255}, 6, 2, 4, 4));
  EXPECT_EQ(32, probe.CountVisible());
}

TEST_F(CairoImageTest, ImageSurfacesDrawIntoTheirImageWithinBounds) {
  SurfaceP source(*supplier, 8, 8, false);
  const auto png = EncodeImageAsPNG(*source->GetSurfaceImage());
  auto image = supplier->NewFileImage(png.data(), png.size(), ImageFileType::kPNG);
  const RectT<std::int32_t> bounds{2, 2, 4, 4};
  auto drawing = supplier->NewImageSurface(image.get(), true, &bounds);
  drawing->PaintRect({1, 0, 0, 1}, {0, 0, 8, 8});
  const PixelProbe probe(*image);
  EXPECT_EQ(16, probe.Count({255, 0, 0, 255}, 0, 0, 8, 8));
  // Cleared inside the bounds, untouched outside them.
  EXPECT_EQ((Pixel{255, 255, 255, 255}), probe.At(0, 0));
}

TEST_F(CairoImageTest, SurfaceImageSharesThePixels) {
  SurfaceP surface(*supplier, 4, 4, true);
  auto image = surface->GetSurfaceImage();
  surface->PaintRect({0, 1, 0, 1}, {0, 0, 1, 1});
  EXPECT_EQ((Pixel{0, 255, 0, 255}), PixelProbe(*image).At(0, 0));
  const auto copy = CopyImagePixels(*image, PixelLayout::kBGR);
  EXPECT_EQ(12, copy->GetRowBytes());
  EXPECT_EQ(255, copy->GetData()[1]);
}

TEST_F(CairoImageTest, CacheBlitMatchesDirectDrawing) {
  const auto scene = [&](SurfaceInterface& target) {
    PathP path;
    velkui::GetRoundedRectPath(supplier.get(), {2.5f, 3.25f, 20, 12}, 4, &path);
    BrushP brush(*supplier, {0.2f, 0.4f, 0.8f, 0.9f});
    target.FillPath(*brush, *path, FillType::kWinding);
  };
  const velkcore::MatrixT<float> placement{1.5f, 0, 0, 1.5f, 3.25f, 1.5f};
  SurfaceP direct(*supplier, 48, 32, true);
  direct->Transform(placement);
  scene(*direct);

  SurfaceP cached(*supplier, 48, 32, true);
  cached->Transform(placement);
  auto cache = cached->PushCacheStack({0, 0, 28, 18});
  ASSERT_NE(nullptr, cache);
  scene(*cache->GetSurface());
  cached->PopCacheStack(cache.get());
  EXPECT_TRUE(cache->IsValid(*cached, {0, 0, 28, 18}));
  cached->DrawCache(*cache);

  const auto a = CopyImagePixels(*direct->GetSurfaceImage(), PixelLayout::kBGRAPremultiplied);
  const auto b = CopyImagePixels(*cached->GetSurfaceImage(), PixelLayout::kBGRAPremultiplied);
  EXPECT_EQ(0, std::memcmp(a->GetData(), b->GetData(), a->GetDataSize()));
  EXPECT_GT(PixelProbe(*cached).CountVisible(), 300);
}

}  // namespace
