#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <utility>

#include "ArrangeTestSupport.h"

namespace velkui::arrange::test {
namespace {

using Type = GroupArrangementType;
using Size = std::pair<float, float>;

std::vector<Size> ParetoFront(std::vector<Size> sizes) {
  std::sort(sizes.begin(), sizes.end());
  std::vector<Size> front;
  for (const Size& s : sizes) {
    if (!front.empty() && front.back().second <= s.second) continue;
    if (!front.empty() && front.back().first == s.first) front.pop_back();
    front.push_back(s);
  }
  return front;
}

std::vector<Size> MinSizes(const impl::ArrangementSet& set) {
  std::vector<Size> sizes;
  for (const auto& a : set) sizes.emplace_back(a->MinWidth(), a->MinHeight());
  std::sort(sizes.begin(), sizes.end());
  return sizes;
}

// Ten flipping groups of two leaves inside a flipping group: 2^10 combinations, more than a
// rebuild enumerates, yet the minimum sizes must be exactly those of the full product.
TEST(BoundedEnumerationTest, FlippingOfFlippingsKeepsTheExactMinimumSizes) {
  std::vector<std::unique_ptr<Box>> leaves;
  std::vector<std::unique_ptr<TestGroup>> groups;
  std::vector<IArrangeable*> children;
  std::vector<std::pair<Size, Size>> pairs;  // each child's (row, column) minimum sizes
  for (int i = 0; i < 10; ++i) {
    const float w1 = 3.0f + static_cast<float>((i * 7) % 11);
    const float h1 = 2.0f + static_cast<float>((i * 5) % 13);
    const float w2 = 4.0f + static_cast<float>((i * 3) % 7);
    const float h2 = 6.0f + static_cast<float>((i * 11) % 5);
    leaves.push_back(std::make_unique<Box>(w1, h1));
    leaves.push_back(std::make_unique<Box>(w2, h2));
    groups.push_back(std::make_unique<TestGroup>(Type::Flipping));
    groups.back()->Hold({leaves[leaves.size() - 2].get(), leaves.back().get()});
    children.push_back(groups.back().get());
    pairs.push_back({{w1 + w2, std::max(h1, h2)}, {std::max(w1, w2), h1 + h2}});
  }
  TestGroup root(Type::Flipping);
  root.Hold(children);

  std::vector<Size> all;
  for (unsigned mask = 0; mask < 1024; ++mask) {
    float sumW = 0, maxH = 0, maxW = 0, sumH = 0;
    for (int i = 0; i < 10; ++i) {
      const Size& s = (mask >> i) & 1 ? pairs[i].second : pairs[i].first;
      sumW += s.first;
      sumH += s.second;
      maxW = std::max(maxW, s.first);
      maxH = std::max(maxH, s.second);
    }
    all.emplace_back(sumW, maxH);
    all.emplace_back(maxW, sumH);
  }
  EXPECT_EQ(MinSizes(root.Arrangements()), ParetoFront(all));
}

// A chain of auto-layout groups, each holding two leaves and the next group: the product of
// candidates grows with every level, the rebuild must not, and what it picks must fit.
TEST(BoundedEnumerationTest, DeepAutoLayoutChainStaysBoundedAndFits) {
  constexpr int kDepth = 40;
  std::vector<std::unique_ptr<Box>> leaves;
  std::vector<std::unique_ptr<TestGroup>> groups(kDepth);
  for (int level = kDepth - 1; level >= 0; --level) {
    leaves.push_back(std::make_unique<Box>(5.0f + static_cast<float>(level % 4), 4.0f));
    Box* first = leaves.back().get();
    leaves.push_back(std::make_unique<Box>(3.0f, 6.0f + static_cast<float>(level % 3)));
    Box* second = leaves.back().get();
    groups[level] = std::make_unique<TestGroup>(Type::AutoLayout);
    std::vector<IArrangeable*> children{first, second};
    if (level + 1 < kDepth) children.push_back(groups[level + 1].get());
    groups[level]->Hold(children);
  }
  TestGroup& root = *groups.front();
  const impl::ArrangementSet& set = root.Arrangements();
  ASSERT_FALSE(set.Empty());
  EXPECT_LT(set.Size(), 200u);

  const PointF best = root.BestSize();
  const RectF area{0, 0, best.x, best.y};
  root.Arrange(area);
  for (const auto& leaf : leaves) {
    ASSERT_EQ(leaf->places.size(), 1u);
    const RectF r = leaf->Last();
    EXPECT_FALSE(HasNaN(r));
    EXPECT_GE(r.left, area.left - 0.001f);
    EXPECT_GE(r.top, area.top - 0.001f);
    EXPECT_LE(r.left + r.width, area.width + 0.001f);
    EXPECT_LE(r.top + r.height, area.height + 0.001f);
  }
}

// Small products are enumerated in full, in order: the candidates are those of the full
// child-by-child product (here checked against the brute force as well).
TEST(BoundedEnumerationTest, SmallProductsAreEnumeratedCompletely) {
  Box a(10, 30), b(30, 10), c(20, 20), d(5, 40);
  TestGroup left(Type::Flipping);
  left.Hold({&a, &b});
  TestGroup right(Type::Flipping);
  right.Hold({&c, &d});
  TestGroup root(Type::HorizontalWrapping);
  root.Hold({&left, &right});
  // left: row 40x30, column 30x40; right: row 25x40, column 20x60.
  std::vector<Size> all;
  for (const Size& l : {Size{40, 30}, Size{30, 40}}) {
    for (const Size& r : {Size{25, 40}, Size{20, 60}}) {
      all.emplace_back(l.first + r.first, std::max(l.second, r.second));  // two per line
      all.emplace_back(std::max(l.first, r.first), l.second + r.second);  // one per line
    }
  }
  EXPECT_EQ(MinSizes(root.Arrangements()), ParetoFront(all));
}

// A thousand nested rows and columns, each holding a leaf and the next group: the staircase of
// leaves comes out exactly, without descending the chain once per level.
TEST(DeepTreeTest, ChainOfAThousandNestedGroupsIsArrangedExactly) {
  constexpr int kDepth = 1000;
  std::vector<std::unique_ptr<Box>> leaves(kDepth);
  std::vector<std::unique_ptr<TestGroup>> groups(kDepth);
  for (int level = kDepth - 1; level >= 0; --level) {
    leaves[level] = std::make_unique<Box>(10.0f, 10.0f);
    groups[level] = std::make_unique<TestGroup>(level % 2 == 0 ? Type::Row : Type::Column);
    std::vector<IArrangeable*> children{leaves[level].get()};
    if (level + 1 < kDepth) children.push_back(groups[level + 1].get());
    groups[level]->Hold(children);
  }
  groups.front()->Arrange({0, 0, 6000, 6000});
  for (int level = 0; level < kDepth; level += 111) {
    EXPECT_EQ(leaves[level]->Last(), (RectF{static_cast<float>((level + 1) / 2 * 10),
                                            static_cast<float>(level / 2 * 10), 10, 10}))
        << level;
  }
}

}  // namespace
}  // namespace velkui::arrange::test
