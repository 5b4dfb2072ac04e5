#include <gtest/gtest.h>

#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PathInterface.h>
#include <velkui/pictel/PenInterface.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/test/GoldenImage.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_SubView.h>

#include "NodeTestSupport.h"

namespace velkui::ui::test {
namespace {

// Default palette indices (window background, panel, control faces, frame,
// focus ring, default-button face).
constexpr ThemeColorIndex kWindow = 4;
constexpr ThemeColorIndex kPanel = 6;
constexpr ThemeColorIndex kFace = 20;
constexpr ThemeColorIndex kFrame = 9;
constexpr ThemeColorIndex kFocusRing = 18;
constexpr ThemeColorIndex kDefaultFace = 32;

// Fills its rectangle with a theme colour and outlines it.
class ThemedView : public UI_SubView {
 public:
  ThemedView(ThemeColorIndex fill, ThemeColorIndex outline) : fill_(fill), outline_(outline) {}

  void UI_Draw(pictel::Pictel* context) const override {
    const RectT<float> r = UI_GetLocalRectF(false);
    pictel::SurfaceInterface& surface = *context->GetSurface();
    surface.PaintRect(Theme::Get().GetColor(fill_), r);
    const auto pen = context->GetSupplier()->NewPen(Theme::Get().GetColor(outline_), 1.0f);
    const auto path = context->GetSupplier()->NewPath();
    path->AddRect(RectT<float>{r.left + 0.5f, r.top + 0.5f, r.width - 1.0f, r.height - 1.0f});
    surface.StrokePath(*pen, *path);
    UI_SubView::UI_Draw(context);
  }

 private:
  ThemeColorIndex fill_;
  ThemeColorIndex outline_;
};

boost::intrusive_ptr<ThemedView> Add(UI_Node* parent, RectT<float> frame, ThemeColorIndex fill,
                                     ThemeColorIndex outline = kFrame) {
  auto view = velkcore::MakeIntrusive<ThemedView>(fill, outline);
  view->UI_SetLocalRectF(frame);
  view->UI_Show(true);
  if (parent != nullptr) parent->ChildPushBack(view);
  return view;
}

// A panel with a row of controls: one scaled, one clipping an overhanging
// child, one cached, and one hidden (absent from the image).
TEST(NodeGoldenTest, ASmallThemedTree) {
  ScopedManager<> manager;
  Theme::Initialize(std::make_unique<Theme>());
  const boost::intrusive_ptr<pictel::SupplierInterface> supplier = pictel::NewOSSupplier();
  const auto surface = supplier->NewSurface(160, 100, false);
  pictel::Pictel context(supplier.get(), surface.get());

  auto root = Add(nullptr, {0, 0, 160, 100}, kWindow);
  auto panel = Add(root.get(), {8, 8, 144, 84}, kPanel);
  Add(panel.get(), {8, 8, 40, 20}, kFace);
  auto scaled = Add(panel.get(), {56, 8, 20, 10}, kDefaultFace, kFocusRing);
  scaled->UI_SetMatrix({-56, -4, 2, 2});  // twice the size, at 56, 12 in the panel
  auto clipping = Add(panel.get(), {8, 40, 40, 30}, kFace);
  clipping->UI_SetClipToSelfEnabled(true);
  Add(clipping.get(), {20, 15, 40, 40}, kDefaultFace, kFocusRing);
  auto cached = Add(panel.get(), {56, 40, 40, 30}, kFace, kFocusRing);
  cached->UI_SetDrawCachePolicy(DrawCachePolicy::kAlways);
  Add(cached.get(), {10, 10, 20, 10}, kDefaultFace);
  Add(panel.get(), {104, 40, 32, 30}, kDefaultFace)->UI_Show(false);

  // Twice: the second paint blits the cache and must look the same.
  root->UI_DispatchDrawFromRoot(Theme::Get().GetColor(kWindow), &context, true);
  root->UI_DispatchDrawFromRoot(Theme::Get().GetColor(kWindow), &context, true);
  ASSERT_NE(cached->UI_GetPictelCache(), nullptr);
  EXPECT_TRUE(velkui::test::MatchesGolden(
      *surface->GetSurfaceImage(), VELKUI_TEST_DATA_DIR "/golden", "node_tree_themed", {2, 0.0}));
  Theme::Terminate();
}

}  // namespace
}  // namespace velkui::ui::test
