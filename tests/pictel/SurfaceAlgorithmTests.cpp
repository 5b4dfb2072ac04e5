#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <velkui/pictel/BasicSurfaceReferenceInterface.h>
#include <velkui/pictel/BitmapCacheInterface.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PictelErrors.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/test/RecordingSupplier.h>

#include "PictelTestSupport.h"

namespace {

using namespace velkui::pictel;
using velkcore::MatrixT;
using velkcore::PointT;
using velkcore::RectT;
using velkui::test::RecordingSupplier;
using velkui::test::RecordingSurface;
using Strings = std::vector<std::string>;

// Reads the calls of its own surface alone.
class RecordingTest : public test::RecordingSurfaceTest {
 protected:
  PenP pen{*supplier, {0, 0, 1, 1}, 1.0f};

  int Id() const { return static_cast<RecordingSurface*>(surface.Get())->GetId(); }
  std::size_t Depth() const {
    return static_cast<RecordingSurface*>(surface.Get())->GetStateDepth();
  }
  Strings Calls() const { return supplier->GetLog().Strings(Id()); }
  Strings Drawn() const { return supplier->GetLog().Strings(Id(), true); }
  const velkui::test::RecordedCall& LastCall(const std::string& name) const {
    const auto& calls = supplier->GetLog().GetCalls();
    for (auto it = calls.rbegin(); it != calls.rend(); ++it) {
      if (it->name == name) return *it;
    }
    throw std::runtime_error("no call " + name);
  }

  void Underline(const char16_t* text, TextAlignment alignment, std::int32_t start,
                 std::int32_t end, TextTruncation truncation = TextTruncation::kNone,
                 float maxWidth = 0.0f) {
    surface->DrawStringWithUnderline(*brush, *font, *pen, text, {100, 50}, alignment, truncation,
                                     maxWidth, start, end);
  }
};

TEST_F(RecordingTest, UnderlineIsStrokedWithoutAntiAliasingThenTextIsDrawn) {
  Underline(u"Hello", TextAlignment::kStart, 1, 3);
  EXPECT_EQ((Strings{"PushStateStack", "SetAntiAliasPolicy 0",
                     "StrokePath pen(0,0,1,1) w1 W M105,52 L120,52", "SetAntiAliasPolicy 1",
                     "DrawString \"Hello\" at 100,50 align0 solid(0,0,0,1)", "PopStateStack"}),
            Calls());
  EXPECT_EQ(AntiAliasPolicy::kOff, LastCall("StrokePath").antiAlias);
  EXPECT_EQ(AntiAliasPolicy::kOn, LastCall("DrawString").antiAlias);
  EXPECT_EQ(0u, Depth());
}

TEST_F(RecordingTest, UnderlineFollowsTheAlignmentAndRoundsItsEnds) {
  Underline(u"Hello", TextAlignment::kCenter, 1, 3);  // text starts at 87.5
  Underline(u"Hello", TextAlignment::kEnd, 1, 3);     // text starts at 75
  EXPECT_EQ((Strings{"StrokePath pen(0,0,1,1) w1 W M93,52 L108,52",
                     "DrawString \"Hello\" at 100,50 align1 solid(0,0,0,1)",
                     "StrokePath pen(0,0,1,1) w1 W M80,52 L95,52",
                     "DrawString \"Hello\" at 100,50 align2 solid(0,0,0,1)"}),
            Drawn());
}

TEST_F(RecordingTest, UnderlineEndBeyondTheTextIsClippedToIt) {
  Underline(u"Hello", TextAlignment::kStart, 3, 99);
  Underline(u"Hello", TextAlignment::kStart, 7, 9);  // starts after the text: no line
  EXPECT_EQ((Strings{"StrokePath pen(0,0,1,1) w1 W M115,52 L125,52",
                     "DrawString \"Hello\" at 100,50 align0 solid(0,0,0,1)",
                     "DrawString \"Hello\" at 100,50 align0 solid(0,0,0,1)"}),
            Drawn());
}

TEST_F(RecordingTest, InvalidUnderlineRangesDrawNothingAtAll) {
  Underline(u"Hello", TextAlignment::kStart, 3, 2);
  Underline(u"Hello", TextAlignment::kStart, -1, 2);
  Underline(u"", TextAlignment::kStart, 0, 0);
  EXPECT_TRUE(Calls().empty());
}

TEST_F(RecordingTest, UnderlinedTextIsTruncatedOnlyWithAMaximumWidth) {
  Underline(u"Hello", TextAlignment::kStart, 0, 4, TextTruncation::kEnd, 0.0f);
  Underline(u"Hello", TextAlignment::kStart, 0, 4, TextTruncation::kEnd, 20.0f);
  EXPECT_EQ((Strings{"StrokePath pen(0,0,1,1) w1 W M100,52 L125,52",
                     "DrawString \"Hello\" at 100,50 align0 solid(0,0,0,1)",
                     "StrokePath pen(0,0,1,1) w1 W M100,52 L115,52",
                     "DrawString \"Hel\" at 100,50 align0 solid(0,0,0,1)"}),
            Drawn());
}

class ScaledImageTest : public RecordingTest {
 protected:
  boost::intrusive_ptr<ImageInterface> image =
      supplier->NewBufferImage(32, 16, 128, PixelLayout::kBGRAPremultiplied, nullptr, {});
};

TEST_F(ScaledImageTest, EmptyDestinationOrSourceDrawsNothingAndKeepsTheState) {
  surface->DrawImage(*supplier, *image, {10, 10, 0, 20}, nullptr, 1.0f);
  surface->DrawImage(*supplier, *image, {10, 10, 20, -1}, nullptr, 1.0f);
  const RectT<float> emptySource{0, 0, 0, 16};
  surface->DrawImage(*supplier, *image, {10, 10, 20, 20}, &emptySource, 1.0f);
  EXPECT_TRUE(Calls().empty());
  EXPECT_EQ(0u, Depth());
}

TEST_F(ScaledImageTest, UnitScaleDrawsWithoutAntiAliasingInsideTheDestination) {
  surface->DrawImage(*supplier, *image, {10, 20, 32, 16}, nullptr, 0.5f);
  EXPECT_EQ((Strings{"PushStateStack", "Clip R10,20,32,16", "Transform 1,0,0,1,10,20",
                     "SetAntiAliasPolicy 0", "DrawImage buffer 32x16 at 0,0 opacity 0.5",
                     "PopStateStack"}),
            Calls());
  EXPECT_EQ((RectT<std::int32_t>{10, 20, 32, 16}), LastCall("DrawImage").clip);
}

TEST_F(ScaledImageTest, ScaledImageKeepsItsTopLeftOnTheDestinationCorner) {
  const RectT<float> source{5, 5, 16, 16};  // only its size counts
  surface->DrawImage(*supplier, *image, {10, 20, 64, 8}, &source, 1.0f);
  const MatrixT<float>& m = LastCall("DrawImage").transform;
  EXPECT_EQ((PointT<float>{10, 20}), m.Transform({0, 0}));
  EXPECT_EQ((PointT<float>{74, 28}), m.Transform({16, 16}));
  EXPECT_EQ(AntiAliasPolicy::kOn, LastCall("DrawImage").antiAlias);
  EXPECT_EQ(0u, Depth());
}

TEST_F(RecordingTest, ClipNarrowingGivesTheOverlapWithTheClip) {
  EXPECT_EQ((RectT<std::int32_t>{150, 80, 50, 20}),
            surface->GetMinimumClipBounds({150, 80, 100, 50}));
  EXPECT_EQ((RectT<std::int32_t>{150, 80, 50, 50}),
            surface->GetMinimumHorizontalClipBounds({150, 80, 100, 50}));
  EXPECT_EQ((RectT<std::int32_t>{150, 80, 100, 20}),
            surface->GetMinimumVerticalClipBounds({150, 80, 100, 50}));
  PathP clip(*supplier);
  clip->AddRect(RectT<std::int32_t>{10, 10, 50, 50});
  surface->Clip(*clip, FillType::kWinding);
  EXPECT_EQ((RectT<std::int32_t>{10, 10, 50, 50}), surface->GetClipBounds());
  EXPECT_EQ((RectT<std::int32_t>{10, 10, 20, 20}), surface->GetMinimumClipBounds({0, 0, 30, 30}));
}

TEST_F(RecordingTest, ClipNarrowingOfADisjointRectangleIsEmpty) {
  const RectT<std::int32_t> outside{300, 10, 20, 20};
  EXPECT_FALSE(surface->IsWithinClipBounds(outside));
  EXPECT_FALSE(surface->IsWithinClipBounds({200, 0, 10, 10}));  // touches the edge only
  EXPECT_TRUE(surface->IsWithinClipBounds({199, 99, 10, 10}));
  const RectT<std::int32_t> narrowed = surface->GetMinimumClipBounds(outside);
  EXPECT_EQ(0, narrowed.width);
  EXPECT_EQ(0, narrowed.height);
}

TEST_F(RecordingTest, CacheOfAnEmptyAreaIsNull) {
  EXPECT_EQ(nullptr, surface->PushCacheStack({10, 10, 30, 0}));
  EXPECT_EQ(nullptr, surface->PushCacheStack({10, 10, -5, 10}));
  surface->PopCacheStack(nullptr);
}

TEST_F(RecordingTest, CacheCoversTheDevicePixelsOfItsRectangle) {
  surface->Transform(MatrixT<float>::Translation(5, 5));
  const RectT<float> rect{10.5f, 20.25f, 30, 10};
  auto cache = surface->PushCacheStack(rect);
  ASSERT_NE(nullptr, cache);
  const auto& bitmap = dynamic_cast<const BitmapCacheInterface&>(*cache);
  EXPECT_EQ((RectT<std::int32_t>{15, 25, 31, 11}), bitmap.GetPixelBounds());
  MatrixT<float> inCache;
  cache->GetSurface()->GetTransform(&inCache);
  EXPECT_EQ((PointT<float>{0.5f, 0.25f}), inCache.Transform({rect.left, rect.top}));
  EXPECT_EQ(cache->GetSurface()->GetAntiAliasPolicy(), surface->GetAntiAliasPolicy());
}

TEST_F(RecordingTest, CacheIsValidOnlyForTheSameRectangleMatrixAndPolicies) {
  const RectT<float> rect{0, 0, 40, 20};
  auto cache = surface->PushCacheStack(rect);
  ASSERT_NE(nullptr, cache);
  EXPECT_TRUE(cache->IsValid(*surface, rect));
  EXPECT_FALSE(cache->IsValid(*surface, {0, 0, 40, 20.5f}));

  surface->PushStateStack();
  surface->Transform(MatrixT<float>::Translation(1, 0));
  EXPECT_FALSE(cache->IsValid(*surface, rect));
  surface->PopStateStack();
  EXPECT_TRUE(cache->IsValid(*surface, rect));

  surface->SetInterpolationPolicy(InterpolationPolicy::kLowQuality);
  EXPECT_FALSE(cache->IsValid(*surface, rect));
  surface->SetInterpolationPolicy(InterpolationPolicy::kHighQuality);
  surface->SetAntiAliasPolicy(AntiAliasPolicy::kHighQuality);
  EXPECT_FALSE(cache->IsValid(*surface, rect));
  surface->SetAntiAliasPolicy(AntiAliasPolicy::kOn);

  auto platform = NewOSSupplier();
  SurfaceP other(*platform, 200, 100);
  EXPECT_FALSE(cache->IsValid(*other, rect));
}

TEST_F(RecordingTest, CacheIsDrawnInDeviceSpaceAtItsPixelOrigin) {
  surface->Transform(MatrixT<float>{2, 0, 0, 2, 10, 4});
  auto cache = surface->PushCacheStack({3, 1, 10, 5});
  ASSERT_NE(nullptr, cache);
  const int cacheId = static_cast<RecordingSurface*>(cache->GetSurface())->GetId();
  surface->PopCacheStack(cache.get());
  EXPECT_EQ("Flush", supplier->GetLog().Strings(cacheId).back());

  surface->DrawCache(*cache);
  const auto& blit = LastCall("DrawImage");
  EXPECT_EQ("DrawImage surface#" + std::to_string(cacheId) + " 20x10 at 16,6 opacity 1",
            blit.ToString());
  EXPECT_TRUE(blit.transform.IsIdentity());
  EXPECT_EQ(InterpolationPolicy::kNearestNeighbor, blit.interpolation);
  EXPECT_EQ(0u, Depth());
}

TEST_F(RecordingTest, CacheIsNotDrawnUnderASingularMatrixOrWithoutAnImage) {
  auto cache = surface->PushCacheStack({0, 0, 10, 10});
  surface->PushStateStack();
  surface->Transform(MatrixT<float>::Scale(0, 1));
  surface->DrawCache(*cache);
  surface->PopStateStack();
  supplier->SetSurfacesHaveImages(false);
  auto imageless = surface->PushCacheStack({0, 0, 10, 10});
  surface->DrawCache(*imageless);
  EXPECT_TRUE(Drawn().empty());
}

class ForeignCache : public CacheInterface {
 public:
  SurfaceInterface* GetSurface() override { return nullptr; }
  bool IsValid(const SurfaceInterface&, const RectT<float>&) const override { return true; }
};

TEST_F(RecordingTest, DrawingAForeignCacheIsAnError) {
  ForeignCache foreign;
  EXPECT_TRUE(
      test::RaisesDrawingError([&] { surface->DrawCache(foreign); }, 30, kErrorUnspecifiedKey));
}

TEST_F(RecordingTest, LinearShaderStopsAreCompletedToTheEnd) {
  const ColorRGBA red{1, 0, 0, 1};
  const ColorRGBA green{0, 1, 0, 1};
  auto twoColours = supplier->NewLinearShader({0, 0}, {0, 10}, red, green);
  auto stops = supplier->NewLinearShader({0, 0}, {10, 0}, {{0.0f, red}, {0.5f, green}});
  auto path = supplier->NewPath();
  path->AddRect(RectT<float>{0, 0, 10, 10});
  surface->ShadePath(*twoColours, *path, FillType::kWinding);
  surface->ShadePath(*stops, *path, FillType::kEvenOdd);
  EXPECT_EQ((Strings{"ShadePath linear 0,0->0,10 0:(1,0,0,1) 1:(0,1,0,1) R0,0,10,10 rule1",
                     "ShadePath linear 0,0->10,0 0:(1,0,0,1) 0.5:(0,1,0,1) 1:(0,1,0,1) "
                     "R0,0,10,10 rule0"}),
            Drawn());
  EXPECT_THROW(supplier->NewLinearShader({0, 0}, {1, 1}, {}), velkcore::Exception);
}

TEST_F(RecordingTest, ForwardingSurfaceSendsEverythingToItsTarget) {
  boost::intrusive_ptr<RecordingSupplier> ownSupplier(new RecordingSupplier());
  const RectT<std::int32_t> bounds{20, 10, 30, 40};
  {
    boost::intrusive_ptr<BasicSurfaceReferenceInterface> reference(
        new BasicSurfaceReferenceInterface(ownSupplier.get(), surface.Get(), true, &bounds));
    reference->ClipToReferenceSurface(supplier.get());
    EXPECT_EQ(bounds, surface->GetClipBounds());
    reference->Transform(MatrixT<float>::Translation(3, 4));
    reference->DrawString(*brush, *font, u"abc", {1, 2}, TextAlignment::kStart,
                          TextTruncation::kNone, 0);
    reference->PaintRect({1, 1, 1, 1}, {0, 0, 5, 5});
    EXPECT_EQ(1u, Depth());
  }
  // The target's own state is back as it was before the reference existed.
  EXPECT_EQ(0u, Depth());
  MatrixT<float> matrix;
  surface->GetTransform(&matrix);
  EXPECT_TRUE(matrix.IsIdentity());
  EXPECT_EQ((RectT<std::int32_t>{0, 0, 200, 100}), surface->GetClipBounds());
  EXPECT_EQ(
      (Strings{"DrawString \"abc\" at 1,2 align0 solid(0,0,0,1)", "PaintRect (1,1,1,1) [0,0,5,5]"}),
      Drawn());
}

TEST_F(RecordingTest, ForwardingSurfaceNeedsATarget) {
  EXPECT_TRUE(test::RaisesDrawingError(
      [&] { BasicSurfaceReferenceInterface reference(supplier.get(), nullptr, false, nullptr); },
      33, kErrorUnableToCreateReferenceKey));
}

}  // namespace
