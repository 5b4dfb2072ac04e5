#include <gtest/gtest.h>

#include <velkui/arrange/ArrangementSet.h>

namespace velkui::arrange::impl {
namespace {

// A candidate with given minimum and best sizes that never grows.
class Fixed : public IArrangement {
 public:
  Fixed(float minW, float minH, float bestW = -1, float bestH = -1)
      : minW_(minW),
        minH_(minH),
        bestW_(bestW < 0 ? minW : bestW),
        bestH_(bestH < 0 ? minH : bestH) {}
  float Waste(const PointF& size) override {
    return waste >= 0 ? waste : IArrangement::Waste(size);
  }
  float waste = -1;
  PointF Arrange(const RectF& r) override { return {r.width, r.height}; }
  bool HorizontallyExpandable() const override { return false; }
  bool VerticallyExpandable() const override { return false; }
  float MinWidth() const override { return minW_; }
  float MinHeight() const override { return minH_; }
  float BestWidth() const override { return bestW_; }
  float BestHeight() const override { return bestH_; }
  float ExpandedWidth(float) const override { return minW_; }
  float ExpandedHeight(float) const override { return minH_; }

 private:
  float minW_, minH_, bestW_, bestH_;
};

IArrangementP Make(float w, float h, float bw = -1, float bh = -1) {
  return IArrangementP(new Fixed(w, h, bw, bh));
}

TEST(ArrangementSetTest, KeepsOnlyCandidatesNotCoveredByAnother) {
  ArrangementSet set;
  const IArrangementP wide = Make(100, 10);
  const IArrangementP tall = Make(10, 100);
  set.AddArrangement(wide);
  set.AddArrangement(tall);
  set.AddArrangement(Make(120, 20));  // covered by `wide`: dropped
  set.AddArrangement(nullptr);
  ASSERT_EQ(set.Size(), 2u);
  EXPECT_EQ(set[0], wide);
  EXPECT_EQ(set[1], tall);

  // Covers both: they go and it is the only one left.
  const IArrangementP small = Make(10, 10);
  set.AddArrangement(small);
  ASSERT_EQ(set.Size(), 1u);
  EXPECT_EQ(set[0], small);
}

TEST(ArrangementSetTest, LaterCandidateOfEqualMinimumSizeReplacesTheEarlier) {
  ArrangementSet set;
  const IArrangementP first = Make(50, 50);
  const IArrangementP other = Make(30, 80);
  const IArrangementP second = Make(50, 50);
  set.AddArrangement(first);
  set.AddArrangement(other);
  set.AddArrangement(second);
  ASSERT_EQ(set.Size(), 2u);
  EXPECT_EQ(set[0], other);
  EXPECT_EQ(set[1], second);
  EXPECT_TRUE(set.WouldDrop(60, 50));
  EXPECT_FALSE(set.WouldDrop(50, 50));
  EXPECT_FALSE(set.WouldDrop(40, 60));
}

TEST(ArrangementSetTest, ChoosesFittingCandidateWithLeastWaste) {
  ArrangementSet set;
  EXPECT_EQ(set.ChooseFor({10, 10}), nullptr);
  const IArrangementP wide = Make(90, 10);
  const IArrangementP tall = Make(20, 60);
  const IArrangementP square = Make(40, 40);
  set.AddArrangement(wide);
  set.AddArrangement(tall);
  set.AddArrangement(square);
  // 100x20: only `wide` fits although it is not first among the fitting by area.
  EXPECT_EQ(set.ChooseFor({100, 20}), wide.get());
  // 45x70: `tall` (waste 3150 - 1200) and `square` (3150 - 1600) fit; least waste wins.
  EXPECT_EQ(set.ChooseFor({45, 70}), square.get());
}

TEST(ArrangementSetTest, EqualWasteFallsBackToSmallerMinimumArea) {
  ArrangementSet areas;
  auto* large = new Fixed(35, 25);  // area 875
  auto* small = new Fixed(10, 38);  // area 380
  large->waste = small->waste = 7;
  const IArrangementP largeP(large);
  const IArrangementP smallP(small);
  areas.AddArrangement(largeP);
  areas.AddArrangement(smallP);
  EXPECT_EQ(areas.ChooseFor({40, 40}), small);
}

TEST(ArrangementSetTest, WhenNothingFitsLeastOverflowWins) {
  ArrangementSet set;
  const IArrangementP wide = Make(200, 10);  // overflows 100 wide by 100 x 10
  const IArrangementP tall = Make(10, 200);  // overflows 50 high by 150 x 10
  set.AddArrangement(wide);
  set.AddArrangement(tall);
  EXPECT_EQ(set.ChooseFor({100, 50}), wide.get());
  EXPECT_EQ(set.ChooseFor({5, 150}), tall.get());  // 1500 against 1950
}

TEST(ArrangementSetTest, BestSizeIsMinimumOfCandidateClosestToGoldenRatio) {
  ArrangementSet set;
  EXPECT_EQ(set.BestSize(), (PointF{0, 0}));
  set.AddArrangement(Make(100, 10, 300, 30));  // ratio 10
  set.AddArrangement(Make(40, 30, 160, 100));  // ratio 1.6
  set.AddArrangement(Make(10, 100, 10, 100));  // ratio 0.1
  EXPECT_EQ(set.BestSize(), (PointF{40, 30}));
}

TEST(ArrangementSetTest, ZeroBestHeightCountsAsInfinitelyFar) {
  ArrangementSet set;
  set.AddArrangement(Make(0, 0, 50, 0));
  EXPECT_EQ(set.BestSize(), (PointF{0, 0}));
  ArrangementSet mixed;
  mixed.AddArrangement(Make(5, 0, 50, 0));
  mixed.AddArrangement(Make(0, 5, 1, 100));  // far from golden, but finite
  EXPECT_EQ(mixed.BestSize(), (PointF{0, 5}));
}

}  // namespace
}  // namespace velkui::arrange::impl
