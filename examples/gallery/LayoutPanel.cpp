#include "LayoutPanel.h"

#include <array>

#include <velkcore/RefCountedObject.h>
#include <velkui/pictel/PathInterface.h>
#include <velkui/pictel/PenInterface.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>

namespace gallery {

namespace {

using velkcore::RectT;
using velkui::arrange::GroupArrangementType;
using velkui::pictel::ColorRGBA;

constexpr ColorRGBA kBackground{0.93f, 0.94f, 0.96f, 1};
constexpr ColorRGBA kGroupFill{1, 1, 1, 1};
constexpr ColorRGBA kGroupFrame{0.78f, 0.81f, 0.86f, 1};
constexpr std::array<ColorRGBA, 3> kCardColors{{
    {0.16f, 0.45f, 0.86f, 1},
    {0.20f, 0.62f, 0.47f, 1},
    {0.90f, 0.55f, 0.18f, 1},
}};
constexpr std::array<ColorRGBA, 5> kToolColors{{
    {0.33f, 0.38f, 0.47f, 1},
    {0.55f, 0.36f, 0.72f, 1},
    {0.80f, 0.30f, 0.36f, 1},
    {0.25f, 0.58f, 0.70f, 1},
    {0.62f, 0.64f, 0.28f, 1},
}};

void Outline(velkui::pictel::Pictel* context, const RectT<float>& r, const ColorRGBA& color) {
  const auto pen = context->GetSupplier()->NewPen(color, 1);
  const auto path = context->GetSupplier()->NewPath();
  path->AddRect(RectT<float>{r.left + 0.5f, r.top + 0.5f, r.width - 1, r.height - 1});
  context->GetSurface()->StrokePath(*pen, *path);
}

// A coloured block with a darker band along its top, standing for a card or a tool.
class Tile : public velkui::ui::UI_SubView {
 public:
  Tile(float width, float height, const ColorRGBA& color) : color_(color) {
    UI_SetLocalRectF({0, 0, width, height});
    UI_Show(true);
  }

  void UI_Draw(velkui::pictel::Pictel* context) const override {
    const RectT<float> r = UI_GetLocalRectF(false);
    auto& surface = *context->GetSurface();
    surface.PaintRect(color_, r);
    const ColorRGBA band{color_.red * 0.75f, color_.green * 0.75f, color_.blue * 0.75f, 1};
    surface.PaintRect(band, {r.left, r.top, r.width, r.height < 24 ? 4.0f : 12.0f});
    UI_SubView::UI_Draw(context);
  }

 private:
  ColorRGBA color_;
};

// An arrangement view drawn as a white group box, so that its frame shows.
class GroupView : public velkui::ui::UI_ArrangementView {
 public:
  explicit GroupView(GroupArrangementType type) : UI_ArrangementView(type) { UI_Show(true); }

  void UI_Draw(velkui::pictel::Pictel* context) const override {
    const RectT<float> r = UI_GetLocalRectF(false);
    context->GetSurface()->PaintRect(kGroupFill, r);
    Outline(context, r, kGroupFrame);
    UI_ArrangementView::UI_Draw(context);
  }
};

velkui::ui::ArrangementViewP MakeGroup(GroupArrangementType type, float spacing, float margin) {
  auto group = velkcore::MakeIntrusive<GroupView>(type);
  group->SetHorizontalSpacing(spacing);
  group->SetVerticalSpacing(spacing);
  group->SetLeftMargin(margin);
  group->SetRightMargin(margin);
  group->SetTopMargin(margin);
  group->SetBottomMargin(margin);
  return group;
}

constexpr std::uint8_t kFollowParentSize =
    velkui::ui::kBindRightToRight | velkui::ui::kBindBottomToBottom;

}  // namespace

LayoutPanel::LayoutPanel(float width, float height) {
  root_ = velkcore::MakeIntrusive<velkui::ui::UI_SubView>();
  root_->UI_SetNodeID("LayoutPanel");
  root_->UI_SetLocalRectF({0, 0, width, height});
  root_->UI_SetLayoutBinding(kFollowParentSize);
  root_->UI_SetLayoutsChildren(true);
  root_->UI_Show(true);

  // Plain arrangement view: only the nested groups draw.
  content_ = velkcore::MakeIntrusive<velkui::ui::UI_ArrangementView>(GroupArrangementType::Column);
  content_->SetVerticalSpacing(12);
  content_->SetLeftMargin(12);
  content_->SetRightMargin(12);
  content_->SetTopMargin(12);
  content_->SetBottomMargin(12);
  content_->UI_SetLayoutBinding(kFollowParentSize);
  content_->UI_SetLocalRectF({0, 0, width, height});
  content_->UI_Show(true);

  cards_ = MakeGroup(GroupArrangementType::Flipping, 10, 8);
  cards_->EnableSeparators(true);
  for (const ColorRGBA& color : kCardColors) {
    cards_->ChildPushBack(velkcore::MakeIntrusive<Tile>(150.0f, 64.0f, color));
  }
  tools_ = MakeGroup(GroupArrangementType::HorizontalWrapping, 6, 8);
  for (int i = 0; i < 10; ++i) {
    tools_->ChildPushBack(velkcore::MakeIntrusive<Tile>(
        40.0f, 32.0f, kToolColors[static_cast<std::size_t>(i) % kToolColors.size()]));
  }
  content_->ChildPushBack(cards_);
  content_->ChildPushBack(tools_);
  root_->ChildPushBack(content_);
}

void LayoutPanel::Resize(float width, float height) {
  root_->UI_SetLocalRectF({0, 0, width, height});
}

void LayoutPanel::Draw(velkui::pictel::Pictel& context) const {
  root_->UI_DispatchDrawFromRoot(kBackground, &context, true);
}

}  // namespace gallery
