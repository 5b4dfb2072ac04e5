// Mouse moves, invalidation and drawing in trees of about 10 000 nodes.

#include <random>
#include <vector>

#include <benchmark/benchmark.h>

#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PathInterface.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/UI_NodeManager.h>
#include <velkui/ui/UI_SubView.h>

namespace {

using velkcore::PointT;
using velkcore::RectT;
using velkui::ui::MouseEvent;
using velkui::ui::SubViewP;
using velkui::ui::UI_NodeManager;
using velkui::ui::UI_SubView;

constexpr float kSide = 1000.0f;

class InstalledManager {
 public:
  InstalledManager() { UI_NodeManager::Set(&manager_); }
  ~InstalledManager() { UI_NodeManager::Set(nullptr); }
  UI_NodeManager& Get() { return manager_; }

 private:
  UI_NodeManager manager_;
};

// A node that fills its rectangle, as a plain control would.
class FilledView : public UI_SubView {
 public:
  void UI_Draw(velkui::pictel::Pictel* context) const override {
    context->GetSurface()->PaintRect({0.2f, 0.4f, 0.8f, 1.0f}, UI_GetLocalRectF(false));
    UI_SubView::UI_Draw(context);
  }
};

SubViewP MakeNode(const RectT<float>& frame) {
  auto node = velkcore::MakeIntrusive<FilledView>();
  node->UI_SetLocalRectF(frame);
  node->UI_Show(true);
  return node;
}

// Splits `node` into 10 strips, alternating columns and rows per level.
void Split(UI_SubView& node, int levelsLeft, bool columns) {
  if (levelsLeft == 0) return;
  const RectT<float> own = node.UI_GetLocalRectF(false);
  for (int i = 0; i < 10; ++i) {
    const float step = (columns ? own.width : own.height) / 10.0f;
    const RectT<float> frame = columns ? RectT<float>{step * i, 0, step, own.height}
                                       : RectT<float>{0, step * i, own.width, step};
    SubViewP child = MakeNode(frame);
    Split(*child, levelsLeft - 1, !columns);
    node.ChildPushBack(child);
  }
}

// 1 + 10 + 100 + 1000 + 10 000 nodes; the leaves are 10 x 10 cells.
SubViewP BuildBalancedTree() {
  SubViewP root = MakeNode({0, 0, kSide, kSide});
  Split(*root, 4, true);
  return root;
}

// `count` 10 x 10 siblings in rows of 100 (from the top left), under one root.
SubViewP BuildFlatTree(int count) {
  SubViewP root = MakeNode({0, 0, kSide, kSide});
  for (int i = 0; i < count; ++i) {
    root->ChildPushBack(MakeNode(
        {10.0f * static_cast<float>(i % 100), 10.0f * static_cast<float>(i / 100), 10, 10}));
  }
  return root;
}

std::vector<PointT<float>> RandomPoints() {
  std::mt19937 random(42);
  std::uniform_real_distribution<float> coordinate(0.0f, kSide);
  std::vector<PointT<float>> points(4096);
  for (auto& p : points) p = {coordinate(random), coordinate(random)};
  return points;
}

// What a window does for one pointer move: the mouse-over update, then the move itself.
void MoveMouse(UI_SubView& root, const PointT<float>& p) {
  root.UI_UpdateMouseOverState(MouseEvent(MouseEvent::kMouseOverUpdate, 0, 0, p, {}));
  root.UI_DispatchMouseEvent(MouseEvent(MouseEvent::kMove, 0, 0, p, {}), true);
}

void RunMouseMoves(benchmark::State& state, UI_SubView& root) {
  const std::vector<PointT<float>> points = RandomPoints();
  std::size_t i = 0;
  for (auto _ : state) {
    MoveMouse(root, points[i]);
    i = (i + 1) % points.size();
  }
  state.SetItemsProcessed(state.iterations());
}

void BM_MouseMoveBalancedTree(benchmark::State& state) {
  InstalledManager manager;
  SubViewP root = BuildBalancedTree();
  RunMouseMoves(state, *root);
}
BENCHMARK(BM_MouseMoveBalancedTree);

void BM_MouseMoveTenThousandSiblings(benchmark::State& state) {
  InstalledManager manager;
  SubViewP root = BuildFlatTree(10000);
  RunMouseMoves(state, *root);
}
BENCHMARK(BM_MouseMoveTenThousandSiblings);

// A chain of `depth` nested nodes; the deepest is invalidated.
SubViewP BuildChain(int depth, UI_SubView** deepest) {
  SubViewP root = MakeNode({0, 0, kSide, kSide});
  UI_SubView* node = root.get();
  for (int i = 1; i < depth; ++i) {
    SubViewP child = MakeNode({0.5f, 0.5f, 900, 900});
    node->ChildPushBack(child);
    node = child.get();
  }
  *deepest = node;
  return root;
}

// Invalidating the same node again and again between two repaints.
void BM_InvalidateRepeatedly(benchmark::State& state) {
  InstalledManager manager;
  UI_SubView* deepest = nullptr;
  SubViewP root = BuildChain(static_cast<int>(state.range(0)), &deepest);
  deepest->UI_Invalidate(nullptr, {});
  for (auto _ : state) deepest->UI_Invalidate(nullptr, {});
}
BENCHMARK(BM_InvalidateRepeatedly)->Arg(4)->Arg(64)->Arg(1024);

// For comparison: the first invalidation after each repaint climbs the whole chain.
void BM_InvalidateFirstAfterRepaint(benchmark::State& state) {
  InstalledManager manager;
  UI_SubView* deepest = nullptr;
  SubViewP root = BuildChain(static_cast<int>(state.range(0)), &deepest);
  for (auto _ : state) {
    manager.Get().IncrementPictelCacheSeed();
    deepest->UI_Invalidate(nullptr, {});
  }
}
BENCHMARK(BM_InvalidateFirstAfterRepaint)->Arg(4)->Arg(64)->Arg(1024);

// Paints `root` on a 1000 x 1000 surface clipped to the 100 x 100 square at
// (200, 300), where 100 leaves lie.
void RunClippedDraw(benchmark::State& state, UI_SubView& root) {
  const auto supplier = velkui::pictel::NewOSSupplier();
  const auto surface = supplier->NewSurface(static_cast<std::int32_t>(kSide),
                                            static_cast<std::int32_t>(kSide), true);
  const auto clip = supplier->NewPath();
  clip->AddRect(RectT<float>{200, 300, 100, 100});
  surface->Clip(*clip, velkui::pictel::FillType::kWinding);
  velkui::pictel::Pictel context(supplier.get(), surface.get());
  for (auto _ : state) root.UI_DispatchDrawFromRoot({1, 1, 1, 1}, &context, true);
}

// The 100 leaves inside the clip, as siblings at their places.
SubViewP BuildClippedLeaves() {
  SubViewP root = MakeNode({0, 0, kSide, kSide});
  for (int i = 0; i < 100; ++i) {
    root->ChildPushBack(MakeNode({200.0f + 10.0f * static_cast<float>(i % 10),
                                  300.0f + 10.0f * static_cast<float>(i / 10), 10, 10}));
  }
  return root;
}

void BM_DrawBalancedTreeClipped(benchmark::State& state) {
  InstalledManager manager;
  SubViewP root = BuildBalancedTree();
  RunClippedDraw(state, *root);
}
BENCHMARK(BM_DrawBalancedTreeClipped);

void BM_DrawTenThousandSiblingsClipped(benchmark::State& state) {
  InstalledManager manager;
  SubViewP root = BuildFlatTree(10000);
  // Rows of 100 cells: rows 30..39, columns 20..29 fall in the clip.
  RunClippedDraw(state, *root);
}
BENCHMARK(BM_DrawTenThousandSiblingsClipped);

void BM_DrawOnlyTheHundredInsideTheClip(benchmark::State& state) {
  InstalledManager manager;
  SubViewP root = BuildClippedLeaves();
  RunClippedDraw(state, *root);
}
BENCHMARK(BM_DrawOnlyTheHundredInsideTheClip);

}  // namespace
