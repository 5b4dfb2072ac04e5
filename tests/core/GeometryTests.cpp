#include <velkcore/Error.h>
#include <velkcore/Flags.h>
#include <velkcore/Geometry.h>

#include <gtest/gtest.h>

#include "CoreTestSupport.h"

using namespace velkcore;

TEST(Geometry, MatrixInverseUndoesTheMatrix) {
  const MatrixT<double> m{2, 0.5, -1, 3, 10, -4};
  const MatrixT<double> inv = m.Inverted();
  const PointT<double> p{7, -2};
  const PointT<double> back = inv.Transform(m.Transform(p));
  EXPECT_NEAR(back.x, p.x, 1e-12);
  EXPECT_NEAR(back.y, p.y, 1e-12);
  const MatrixT<double> id = m.Concat(inv);
  EXPECT_NEAR(id.a, 1, 1e-12);
  EXPECT_NEAR(id.tx, 0, 1e-12);
}

TEST(Geometry, ConcatAppliesTheRightHandSideFirst) {
  const auto scale = MatrixT<float>::Scale(2, 2);
  const auto move = MatrixT<float>::Translation(10, 0);
  EXPECT_EQ(move.Concat(scale).Transform({1, 1}), (PointT<float>{12, 2}));
  EXPECT_EQ(scale.Concat(move).Transform({1, 1}), (PointT<float>{22, 2}));
}

TEST(Geometry, SingularMatrixRaisesTheGeometryErrorAndStaysUnchanged) {
  MatrixT<float> m{1, 2, 2, 4, 5, 6};
  const MatrixT<float> before = m;
  const auto e = velkcore_test::ErrorOf([&] { m.Invert(); });
  ASSERT_TRUE(e);
  EXPECT_EQ(e->GetCategory(), 107);
  EXPECT_EQ(e->GetNumber(), 0);
  EXPECT_EQ(m, before);
}

TEST(Geometry, RectIntersectionAndUnion) {
  const RectT<float> a{0, 0, 10, 10};
  EXPECT_EQ(Intersection(a, RectT<float>{5, -5, 10, 10}), (RectT<float>{5, 0, 5, 5}));
  EXPECT_TRUE(Intersection(a, RectT<float>{20, 20, 1, 1}).IsEmpty());
  EXPECT_EQ(Union(a, RectT<float>{}), a);
  EXPECT_EQ(Union(a, RectT<float>{-2, 4, 4, 10}), (RectT<float>{-2, 0, 12, 14}));
  EXPECT_TRUE(a.Contains({0, 0}));
  EXPECT_FALSE(a.Contains({10, 5}));
}

TEST(Geometry, ScaleMatrixIdentityAndTransform) {
  ScaleMatrixT<float> m;
  EXPECT_TRUE(m.IsIdentity());
  m = {5, 6, 2, 3};
  EXPECT_EQ(m.Transform({1, 1}), (PointT<float>{7, 9}));
}

TEST(Flags, SetClearAndTest) {
  Flags<unsigned char> f;
  f.Set(0x02 | 0x10);
  EXPECT_TRUE(f.IsSet(0x02));
  EXPECT_TRUE(f.IsSet(0x12));
  EXPECT_FALSE(f.IsSet(0x06));
  EXPECT_TRUE(f.IsAnySet(0x06));
  f.Clear(0x02);
  EXPECT_EQ(f.Get(), 0x10);
  f.Set(0x04, false);
  EXPECT_EQ((f | Flags<unsigned char>(0x01)).Get(), 0x11);
  EXPECT_EQ((~f).Get(), 0xEF);
}
