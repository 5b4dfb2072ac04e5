// The arrangement engine on large and deep trees. bench/yoga/yoga_bench.mjs lays out the same
// trees with yoga-layout for comparison (scripts/bench-setup installs it).
#include <benchmark/benchmark.h>

#include <memory>
#include <vector>

#include <velkui/arrange/Groups.h>
#include <velkui/arrange/Single.h>

namespace {

using namespace velkui::arrange;

constexpr float kWidth = 4000;
constexpr float kHeight = 3000;

class Leaf : public Single {
 public:
  Leaf(float width, float height) : width_(width), height_(height) {}
  float NaturalWidth() const override { return width_; }
  float NaturalHeight() const override { return height_; }
  void Place(const RectF& rect) override { placed_ = rect; }
  void SetWidth(float width) { width_ = width; }
  const RectF& Placed() const { return placed_; }

 private:
  float width_;
  float height_;
  RectF placed_{};
};

float LeafWidth(std::size_t i) {
  return 20.0f + static_cast<float>(i % 7);
}
float LeafHeight(std::size_t i) {
  return 10.0f + static_cast<float>(i % 5);
}

// Groups of ten children, rows and columns alternating by level, built bottom-up.
struct Tree {
  std::vector<std::unique_ptr<Leaf>> leaves;
  std::vector<std::unique_ptr<impl::AbstractArrangeableGroup>> groups;
  IArrangeable* root = nullptr;

  std::size_t Nodes() const { return leaves.size() + groups.size(); }
};

std::unique_ptr<Tree> MakeTree(std::size_t leafCount, std::size_t fanout = 10) {
  auto tree = std::make_unique<Tree>();
  std::vector<IArrangeable*> level;
  for (std::size_t i = 0; i < leafCount; ++i) {
    tree->leaves.push_back(std::make_unique<Leaf>(LeafWidth(i), LeafHeight(i)));
    level.push_back(tree->leaves.back().get());
  }
  for (int depth = 0; level.size() > 1; ++depth) {
    std::vector<IArrangeable*> next;
    for (std::size_t i = 0; i < level.size(); i += fanout) {
      std::unique_ptr<impl::AbstractArrangeableGroup> group;
      if (depth % 2 == 0) {
        group = std::make_unique<Row>();
      } else {
        group = std::make_unique<Column>();
      }
      const std::size_t end = std::min(level.size(), i + fanout);
      group->SetChildren({level.begin() + static_cast<std::ptrdiff_t>(i),
                          level.begin() + static_cast<std::ptrdiff_t>(end)});
      next.push_back(group.get());
      tree->groups.push_back(std::move(group));
    }
    level = std::move(next);
  }
  tree->root = level.front();
  return tree;
}

void TreeBuildAndArrange(benchmark::State& state) {
  const auto leafCount = static_cast<std::size_t>(state.range(0));
  std::size_t nodes = 0;
  for (auto _ : state) {
    auto tree = MakeTree(leafCount);
    tree->root->Arrange({0, 0, kWidth, kHeight});
    nodes = tree->Nodes();
    benchmark::DoNotOptimize(tree->leaves.back()->Placed());
  }
  state.SetItemsProcessed(static_cast<std::int64_t>(state.iterations() * nodes));
}
BENCHMARK(TreeBuildAndArrange)->Arg(1000)->Arg(10000)->Arg(100000)->Unit(benchmark::kMicrosecond);

void TreeResize(benchmark::State& state) {
  auto tree = MakeTree(static_cast<std::size_t>(state.range(0)));
  tree->root->Arrange({0, 0, kWidth, kHeight});
  bool flip = false;
  for (auto _ : state) {
    flip = !flip;
    tree->root->Arrange({0, 0, flip ? kWidth + 10 : kWidth, kHeight});
    benchmark::DoNotOptimize(tree->leaves.back()->Placed());
  }
  state.SetItemsProcessed(static_cast<std::int64_t>(state.iterations() * tree->Nodes()));
}
BENCHMARK(TreeResize)->Arg(1000)->Arg(10000)->Arg(100000)->Unit(benchmark::kMicrosecond);

void TreeLeafChanged(benchmark::State& state) {
  const auto leafCount = static_cast<std::size_t>(state.range(0));
  auto tree = MakeTree(leafCount);
  tree->root->Arrange({0, 0, kWidth, kHeight});
  Leaf& changed = *tree->leaves[leafCount / 2];
  int step = 0;
  for (auto _ : state) {
    ++step;
    changed.SetWidth(20.0f + static_cast<float>(step % 2));
    changed.Invalidate();  // re-arranges the root once
    benchmark::DoNotOptimize(tree->leaves.back()->Placed());
  }
  state.SetItemsProcessed(static_cast<std::int64_t>(state.iterations() * tree->Nodes()));
}
BENCHMARK(TreeLeafChanged)->Arg(1000)->Arg(10000)->Arg(100000)->Unit(benchmark::kMicrosecond);

class GrowingLeaf : public Leaf {
 public:
  using Leaf::Leaf;
  bool HorizontallyExpandable() const override { return true; }
};

// A chain of nested groups, each holding one leaf and the next group. With a second argument of
// 1 the next group comes first and only the deepest leaf can grow, which makes every expansion
// query descend to the bottom of the chain.
void DeepChain(benchmark::State& state) {
  const auto depth = static_cast<std::size_t>(state.range(0));
  const bool growingBottom = state.range(1) != 0;
  for (auto _ : state) {
    std::vector<std::unique_ptr<Leaf>> leaves;
    std::vector<std::unique_ptr<impl::AbstractArrangeableGroup>> groups(depth);
    for (std::size_t level = depth; level-- > 0;) {
      if (growingBottom && level + 1 == depth) {
        leaves.push_back(std::make_unique<GrowingLeaf>(LeafWidth(level), LeafHeight(level)));
      } else {
        leaves.push_back(std::make_unique<Leaf>(LeafWidth(level), LeafHeight(level)));
      }
      if (level % 2 == 0) {
        groups[level] = std::make_unique<Row>();
      } else {
        groups[level] = std::make_unique<Column>();
      }
      std::vector<IArrangeable*> children{leaves.back().get()};
      if (level + 1 < depth) {
        children.insert(growingBottom ? children.begin() : children.end(), groups[level + 1].get());
      }
      groups[level]->SetChildren(children);
    }
    groups.front()->Arrange({0, 0, kWidth * 10, kHeight * 10});
    benchmark::DoNotOptimize(leaves.front()->Placed());
  }
  state.SetItemsProcessed(static_cast<std::int64_t>(state.iterations() * depth * 2));
}
BENCHMARK(DeepChain)->ArgsProduct({{250, 500, 1000, 2000}, {0, 1}})->Unit(benchmark::kMicrosecond);

void Wrapping(benchmark::State& state) {
  const auto leafCount = static_cast<std::size_t>(state.range(0));
  for (auto _ : state) {
    std::vector<std::unique_ptr<Leaf>> leaves;
    std::vector<IArrangeable*> children;
    for (std::size_t i = 0; i < leafCount; ++i) {
      leaves.push_back(std::make_unique<Leaf>(LeafWidth(i), LeafHeight(i)));
      children.push_back(leaves.back().get());
    }
    HorizontalWrapping wrapping;
    wrapping.SetChildren(children);
    wrapping.Arrange({0, 0, 800, kHeight * 10});
    benchmark::DoNotOptimize(leaves.back()->Placed());
  }
  state.SetItemsProcessed(static_cast<std::int64_t>(state.iterations() * (leafCount + 1)));
}
BENCHMARK(Wrapping)->Arg(1000)->Unit(benchmark::kMicrosecond);

void WrappingResize(benchmark::State& state) {
  const auto leafCount = static_cast<std::size_t>(state.range(0));
  std::vector<std::unique_ptr<Leaf>> leaves;
  std::vector<IArrangeable*> children;
  for (std::size_t i = 0; i < leafCount; ++i) {
    leaves.push_back(std::make_unique<Leaf>(LeafWidth(i), LeafHeight(i)));
    children.push_back(leaves.back().get());
  }
  HorizontalWrapping wrapping;
  wrapping.SetChildren(children);
  wrapping.Arrange({0, 0, 800, kHeight * 10});
  bool flip = false;
  for (auto _ : state) {
    flip = !flip;
    wrapping.Arrange({0, 0, flip ? 600.0f : 800.0f, kHeight * 10});
    benchmark::DoNotOptimize(leaves.back()->Placed());
  }
  state.SetItemsProcessed(static_cast<std::int64_t>(state.iterations() * (leafCount + 1)));
}
BENCHMARK(WrappingResize)->Arg(1000)->Unit(benchmark::kMicrosecond);

}  // namespace
