#include "LayoutPanel.h"

#include <array>

#include <velkcore/RefCountedObject.h>
#include <velkui/pictel/PathInterface.h>
#include <velkui/pictel/PathShapes.h>
#include <velkui/pictel/PenInterface.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/Theme.h>

namespace gallery {

namespace {

using velkcore::RectT;
using PointF = velkcore::PointT<float>;
using velkui::arrange::GroupArrangementType;
using velkui::pictel::ColorRGBA;

constexpr ColorRGBA kBackground{0.93f, 0.94f, 0.96f, 1};
constexpr ColorRGBA kGroupFill{1, 1, 1, 1};
constexpr ColorRGBA kGroupFrame{0.78f, 0.81f, 0.86f, 1};
struct CardFace {
  const char16_t* title;
  const char16_t* reading;
  ColorRGBA color;
};
constexpr std::array<CardFace, 3> kCards{{
    {u"Input", u"\u221212.0 dB", {0.16f, 0.45f, 0.86f, 1}},
    {u"Tempo", u"120 BPM", {0.20f, 0.62f, 0.47f, 1}},
    {u"Output", u"\u22120.3 dB", {0.90f, 0.55f, 0.18f, 1}},
}};
constexpr std::array<ColorRGBA, 5> kToolColors{{
    {0.33f, 0.38f, 0.47f, 1},
    {0.55f, 0.36f, 0.72f, 1},
    {0.80f, 0.30f, 0.36f, 1},
    {0.25f, 0.58f, 0.70f, 1},
    {0.62f, 0.64f, 0.28f, 1},
}};
constexpr ColorRGBA kWhite{1, 1, 1, 1};

ColorRGBA Darker(const ColorRGBA& color) {
  return {color.red * 0.75f, color.green * 0.75f, color.blue * 0.75f, color.alpha};
}

void Outline(velkui::pictel::Pictel* context, const RectT<float>& r, const ColorRGBA& color) {
  const auto pen = context->GetSupplier()->NewPen(color, 1);
  const auto path = context->GetSupplier()->NewPath();
  path->AddRect(RectT<float>{r.left + 0.5f, r.top + 0.5f, r.width - 1, r.height - 1});
  context->GetSurface()->StrokePath(*pen, *path);
}

void Fill(velkui::pictel::Pictel* context, const velkui::pictel::PathP& path,
          const ColorRGBA& color) {
  context->GetSurface()->FillPath(*velkui::pictel::BrushP(*context->GetSupplier(), color), *path,
                                  velkui::pictel::FillType::kWinding);
}

void Label(velkui::pictel::Pictel* context, const char16_t* text, float x, float baseline,
           float size, bool bold) {
  const velkui::pictel::FontP font(*context->GetSupplier(), velkui::ui::Theme::Get().GetFontName(0),
                                   bold ? u"Bold" : u"", size);
  context->GetSurface()->DrawString(*velkui::pictel::BrushP(*context->GetSupplier(), kWhite), *font,
                                    text, {x, baseline}, velkui::pictel::TextAlignment::kStart,
                                    velkui::pictel::TextTruncation::kEndEllipsis, 200);
}

// A fixed-size block of the panel.
class Tile : public velkui::ui::UI_SubView {
 public:
  Tile(float width, float height) {
    UI_SetLocalRectF({0, 0, width, height});
    UI_Show(true);
  }
};

// A card: a coloured block with a title band and a reading.
class Card : public Tile {
 public:
  explicit Card(const CardFace& face) : Tile(150, 64), face_(face) {}

  void UI_Draw(velkui::pictel::Pictel* context) const override {
    const RectT<float> r = UI_GetLocalRectF(false);
    auto& surface = *context->GetSurface();
    surface.PaintRect(face_.color, r);
    surface.PaintRect(Darker(face_.color), {r.left, r.top, r.width, 20});
    Label(context, face_.title, 8, 14, 11, true);
    Label(context, face_.reading, 8, 50, 18, true);
    Tile::UI_Draw(context);
  }

 private:
  CardFace face_;
};

enum class Glyph { kPlay, kStop, kRecord, kLoop, kAdd };

// A tool: a coloured button face with a white glyph.
class Tool : public Tile {
 public:
  Tool(Glyph glyph, const ColorRGBA& color) : Tile(40, 32), glyph_(glyph), color_(color) {}

  void UI_Draw(velkui::pictel::Pictel* context) const override {
    const RectT<float> r = UI_GetLocalRectF(false);
    auto& surface = *context->GetSurface();
    surface.PaintRect(color_, r);
    surface.PaintRect(Darker(color_), {r.left, r.top + r.height - 3, r.width, 3});
    DrawGlyph(context, {r.left + r.width / 2, r.top + (r.height - 3) / 2});
    Tile::UI_Draw(context);
  }

 private:
  void DrawGlyph(velkui::pictel::Pictel* context, PointF c) const {
    const auto* supplier = context->GetSupplier();
    velkui::pictel::PathP path(*supplier);
    switch (glyph_) {
      case Glyph::kPlay:
        path->MoveTo(PointF{c.x - 4, c.y - 6});
        path->LineTo(PointF{c.x + 6, c.y});
        path->LineTo(PointF{c.x - 4, c.y + 6});
        path->Close();
        break;
      case Glyph::kStop:
        path->AddRect(RectT<float>{c.x - 5, c.y - 5, 10, 10});
        break;
      case Glyph::kRecord:
        velkui::GetEllipsePath(supplier, {c.x - 6, c.y - 6, 12, 12}, &path);
        break;
      case Glyph::kLoop: {
        const auto pen = supplier->NewPen(kWhite, 2);
        velkui::pictel::PathP ring;
        velkui::GetRoundedRectPath(supplier, {c.x - 7, c.y - 4, 14, 9}, 4, &ring);
        context->GetSurface()->StrokePath(*pen, *ring);
        path->MoveTo(PointF{c.x + 1, c.y - 8});
        path->LineTo(PointF{c.x + 5, c.y - 4});
        path->LineTo(PointF{c.x + 1, c.y});
        path->Close();
        break;
      }
      case Glyph::kAdd:
        path->AddRect(RectT<float>{c.x - 6, c.y - 1, 12, 2});
        path->AddRect(RectT<float>{c.x - 1, c.y - 6, 2, 12});
        break;
    }
    Fill(context, path, kWhite);
  }

  Glyph glyph_;
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
  for (const CardFace& card : kCards) cards_->ChildPushBack(velkcore::MakeIntrusive<Card>(card));
  tools_ = MakeGroup(GroupArrangementType::HorizontalWrapping, 6, 8);
  constexpr std::array<Glyph, 5> kGlyphs{Glyph::kPlay, Glyph::kStop, Glyph::kRecord, Glyph::kLoop,
                                         Glyph::kAdd};
  for (std::size_t i = 0; i < 10; ++i) {
    tools_->ChildPushBack(velkcore::MakeIntrusive<Tool>(kGlyphs[i % kGlyphs.size()],
                                                        kToolColors[i % kToolColors.size()]));
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
