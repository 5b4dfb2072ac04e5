#include "ControlsGallery.h"

#include <algorithm>
#include <memory>
#include <vector>

#include <velkui/controls/ControlPalettes.h>
#include <velkui/controls/UI_Checkbox.h>
#include <velkui/controls/UI_DisclosureTriangleButton.h>
#include <velkui/controls/UI_OwnerDrawButton.h>
#include <velkui/controls/UI_PictureButton.h>
#include <velkui/controls/UI_PictureTextButton.h>
#include <velkui/controls/UI_RadioGroup.h>
#include <velkui/controls/UI_StaticText.h>
#include <velkui/controls/UI_TextButton.h>
#include <velkui/pictel/PathShapes.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/DefaultKeyframeTheme.h>
#include <velkui/ui/KeyframeThemeEditor.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_NodeManager.h>

namespace gallery {

namespace {

namespace controls = velkui::controls;
namespace ui = velkui::ui;
using velkcore::MakeIntrusive;
using velkcore::PointT;
using velkcore::RectT;

constexpr float kMargin = 18;
constexpr float kLabelWidth = 118;
constexpr float kRowHeight = 46;
constexpr float kGap = 10;

// The panel's background and frame, in theme colours.
class ShowcasePanel : public ui::UI_SubView {
 public:
  void UI_Draw(velkui::pictel::Pictel* context) const override {
    const ui::Theme& theme = ui::Theme::Get();
    const RectT<float> r = UI_GetLocalRectF(false);
    velkui::pictel::PathP path(*context->GetSupplier());
    velkui::utils::FormRoundedRect(path, {r.left + 0.5f, r.top + 0.5f, r.width - 1, r.height - 1},
                                   8);
    const velkui::pictel::BrushP fill(*context->GetSupplier(), theme.GetColor(4));
    context->GetSurface()->FillPath(*fill, *path, velkui::pictel::FillType::kWinding);
    const velkui::pictel::PenP pen(*context->GetSupplier(), theme.GetColor(3), 1);
    context->GetSurface()->StrokePath(*pen, *path);
    UI_SubView::UI_Draw(context);
  }
};

// Places controls in rows: a row label, then the controls left to right.
class RowLayout {
 public:
  RowLayout(ui::UI_SubView& panel, velkui::pictel::Pictel& context, float top)
      : panel_(panel), context_(context), top_(top) {}

  void StartRow(const std::u16string& label) {
    if (started_) top_ += kRowHeight;
    started_ = true;
    left_ = kMargin + kLabelWidth;
    auto text = MakeIntrusive<controls::UI_StaticText>(label);
    text->SetFontSize(11);
    text->SetFontStyleName(u"Bold");
    Place(text, {kMargin, top_, kLabelWidth - 8, kRowHeight});
  }

  // Adds `control` at its recommended size (or `size` when given), centred in the row.
  template <typename Control>
  boost::intrusive_ptr<Control> Add(const boost::intrusive_ptr<Control>& control,
                                    PointT<float> size = {0, 0}) {
    if (size.x <= 0) size = control->UI_GetRecommendedSize(&context_);
    Place(control, {left_, top_ + (kRowHeight - size.y) / 2, size.x, size.y});
    left_ += size.x + kGap;
    return control;
  }
  void Skip(float width) { left_ += width; }
  float Bottom() const { return top_ + kRowHeight; }

 private:
  void Place(const ui::NodeP& node, const RectT<float>& frame) {
    node->UI_SetLocalRectF({std::round(frame.left), std::round(frame.top), std::ceil(frame.width),
                            std::ceil(frame.height)});
    node->UI_Show(true);
    panel_.ChildPushBack(node);
  }

  ui::UI_SubView& panel_;
  velkui::pictel::Pictel& context_;
  float top_;
  float left_ = 0;
  bool started_ = false;
};

boost::intrusive_ptr<controls::UI_TextButton> TextButton(const std::u16string& text) {
  return MakeIntrusive<controls::UI_TextButton>(text);
}

boost::intrusive_ptr<controls::UI_PictureButton> Tool(const std::string& image, bool toggle,
                                                      bool on) {
  auto button = MakeIntrusive<controls::UI_PictureButton>(image);
  button->SetSpringLoaded(!toggle);
  if (on) button->SetValue(controls::kButtonOn);
  return button;
}

// A swatch of colour drawn by the host through the owner-draw callback.
boost::intrusive_ptr<controls::UI_OwnerDrawButton> Swatch() {
  auto button = MakeIntrusive<controls::UI_OwnerDrawButton>();
  button->SetCornerRadius(4);
  button->SetOwnerDrawFunction(std::make_shared<
                               controls::UI_OwnerDrawButton::
                                   OwnerDrawFunction>([](const controls::UI_OwnerDrawButton& b,
                                                         velkui::pictel::Pictel* context) {
    controls::UI_Button::Draw(controls::DrawButtonParameters(&b), context);
    const RectT<float> r = b.UI_GetLocalRectF(false);
    velkui::pictel::PathP path(*context->GetSupplier());
    velkui::utils::FormRoundedRect(path, {r.left + 5, r.top + 5, r.width - 10, r.height - 10}, 2);
    const velkui::pictel::LinearShaderP shader(*context->GetSupplier(), {r.left, 0},
                                               {r.left + r.width, 0},
                                               velkui::pictel::ColorRGBA{0.95f, 0.45f, 0.20f, 1},
                                               velkui::pictel::ColorRGBA{0.85f, 0.15f, 0.45f, 1});
    context->GetSurface()->ShadePath(*shader, *path, velkui::pictel::FillType::kWinding);
  }));
  return button;
}

}  // namespace

velkui::ui::SubViewP BuildControlsShowcase(velkui::pictel::Pictel& context,
                                           const std::u16string& title,
                                           const std::u16string& footer) {
  ui::UI_NodeManager& manager = *ui::UI_NodeManager::Get(true);
  manager.EnableMnemonics();
  auto panel = MakeIntrusive<ShowcasePanel>();
  panel->UI_SetLocalRectF({0, 0, kControlsShowcaseWidth, kControlsShowcaseHeight});
  panel->UI_Show(true);

  auto heading = MakeIntrusive<controls::UI_StaticText>(title);
  heading->SetFontSize(15);
  heading->SetFontStyleName(u"Bold");
  heading->UI_SetLocalRectF({kMargin, 12, kControlsShowcaseWidth - 2 * kMargin, 24});
  heading->UI_Show(true);
  panel->ChildPushBack(heading);

  RowLayout rows(*panel, context, 40);

  rows.StartRow(u"Push buttons");
  auto ok = rows.Add(TextButton(u"OK"), {76, 24});
  ok->SetDefaultAppearance(true);
  auto hovered = rows.Add(TextButton(u"Cancel"), {76, 24});
  auto pressed = rows.Add(TextButton(u"Pressed"), {76, 24});
  pressed->SetDownState(true);
  rows.Add(TextButton(u"Disabled"), {76, 24})->SetDisabled(true);
  auto save = rows.Add(TextButton(u"&Save\u2026"), {76, 24});

  rows.StartRow(u"Toggles");
  auto bold = rows.Add(TextButton(u"Bold"), {58, 24});
  bold->SetSpringLoaded(false);
  bold->SetValue(controls::kButtonOn);
  auto italic = rows.Add(TextButton(u"Italic"), {58, 24});
  italic->SetSpringLoaded(false);
  rows.Skip(8);
  rows.Add(Tool("Play", true, true), {26, 26});
  rows.Add(Tool("Stop", false, false), {26, 26});
  rows.Add(Tool("Record", true, false), {26, 26});
  auto loop = rows.Add(Tool("Loop", true, true), {26, 26});
  loop->SetDisplayBorderAlways(true);
  rows.Add(Tool("Mute", true, false), {26, 26})->SetDisplayBorderAlways(true);
  rows.Add(Tool("Settings", false, false), {26, 26})->SetDisabled(true);

  rows.StartRow(u"Check boxes");
  auto remember = rows.Add(MakeIntrusive<controls::UI_Checkbox>(u"&Remember"));
  remember->SetChecked(true);
  rows.Add(MakeIntrusive<controls::UI_Checkbox>(u"Hidden files"))->SetChecked(false);
  rows.Add(MakeIntrusive<controls::UI_Checkbox>(u"Mixed"));  // value unknown
  auto offCheck = rows.Add(MakeIntrusive<controls::UI_Checkbox>(u"Disabled"));
  offCheck->SetChecked(true);
  offCheck->SetDisabled(true);

  rows.StartRow(u"Radio buttons");
  auto group = MakeIntrusive<controls::UI_RadioGroup>();
  float left = 0;
  for (const char16_t* label : {u"Small", u"Medium", u"Large"}) {
    auto radio = MakeIntrusive<controls::UI_RadioButton>(label);
    const PointT<float> size = radio->UI_GetRecommendedSize(&context);
    radio->UI_SetLocalRectF({left, 0, std::ceil(size.x), std::ceil(size.y)});
    radio->UI_Show(true);
    group->AddRadio(radio);
    left += std::ceil(size.x) + kGap;
  }
  group->SetIndex(1);
  rows.Add(group, {left, 18});
  auto offRadio = rows.Add(MakeIntrusive<controls::UI_RadioButton>(u"Disabled"));
  offRadio->SetDisabled(true);

  rows.StartRow(u"Picture and text");
  rows.Add(MakeIntrusive<controls::UI_PictureTextButton>(u"Play", "Play"), {80, 26});
  auto above =
      rows.Add(MakeIntrusive<controls::UI_PictureTextButton>(u"Settings", "Settings"), {86, 26});
  above->SetRelationship(controls::PictureRelationship::kPictureRight);
  auto imageCheck = rows.Add(MakeIntrusive<controls::UI_ImageCheckbox>(), {26, 26});
  imageCheck->SetChecked(true);
  rows.Add(MakeIntrusive<controls::UI_ImageCheckbox>(), {26, 26});
  auto imageRadio = MakeIntrusive<controls::UI_ImageRadioButton>();
  imageRadio->SetLabelText(u"Image radio");
  imageRadio->SetOn(true);
  rows.Add(imageRadio);

  rows.StartRow(u"Disclosure");
  rows.Add(MakeIntrusive<controls::UI_DisclosureTriangleButton>(u"Details"), {80, 22});
  auto open = rows.Add(MakeIntrusive<controls::UI_DisclosureTriangleButton>(u"Advanced"), {96, 22});
  open->SetValue(controls::kButtonOn);
  rows.Skip(14);
  rows.Add(MakeIntrusive<controls::UI_LockButton>(), {26, 26});
  rows.Add(MakeIntrusive<controls::UI_LockButton>(), {26, 26})->SetValue(controls::kButtonOn);
  rows.Add(MakeIntrusive<controls::UI_LinkButton>(), {26, 26});
  rows.Add(MakeIntrusive<controls::UI_LinkButton>(), {26, 26})->SetValue(controls::kButtonOn);

  rows.StartRow(u"Owner drawn");
  rows.Add(Swatch(), {58, 26});
  auto note = rows.Add(MakeIntrusive<controls::UI_StaticText>(
                           u"Static text beside a host-drawn swatch; a divider below."),
                       {330, 20});
  note->SetTextTruncation(velkui::pictel::TextTruncation::kEndEllipsis);

  auto divider = MakeIntrusive<controls::UI_Divider>();
  divider->UI_SetLocalRectF({kMargin, rows.Bottom() + 4, kControlsShowcaseWidth - 2 * kMargin, 2});
  divider->UI_Show(true);
  panel->ChildPushBack(divider);
  auto footerText = MakeIntrusive<controls::UI_StaticText>(
      !footer.empty() ? footer
                      : u"Hovered: Cancel \u00B7 focused: Save (Alt shows its mnemonic) \u00B7 "
                        u"pressed: Pressed",
      false);
  footerText->UI_SetLocalRectF(
      {kMargin, rows.Bottom() + 10, kControlsShowcaseWidth - 2 * kMargin, 20});
  footerText->UI_Show(true);
  footerText->UI_SetDisabled(true);
  panel->ChildPushBack(footerText);

  // States that the pointer and the keyboard give.
  save->UI_GainKeyboardFocus();
  save->UI_TurnOnMnemonicDisplay();
  const RectT<float> over = hovered->UI_GetLocalRectF(true);
  panel->UI_UpdateMouseOverState(
      velkui::ui::MouseEvent(velkui::ui::MouseEvent::kMouseOverUpdate, 0, 0,
                             {over.left + over.width / 2, over.top + over.height / 2}, {}));
  return panel;
}

void DrawControlsPage(velkui::pictel::Pictel& context, const RectT<float>& area) {
  ui::Theme& theme = ui::Theme::Get();
  // A theme that takes key frames follows the brightness; another gets the dark colours set.
  auto* editor = dynamic_cast<ui::KeyframeThemeEditor*>(&theme);
  if (editor != nullptr) ui::LoadDefaultKeyframeTheme(*editor);
  const float brightness = theme.GetBrightness();
  const float gap = std::max(area.width - 2 * kControlsShowcaseWidth, 0.0f);
  for (const bool dark : {false, true}) {
    if (dark && editor != nullptr) {
      theme.SetBrightness(ui::kDarkInterfaceBrightness);
    } else if (dark) {
      controls::ApplyDarkControlColors(theme);
    }
    theme.NotifyThemeChanged();
    const ui::SubViewP panel =
        BuildControlsShowcase(context, dark ? u"Dark interface" : u"Light interface");
    velkui::pictel::SurfaceInterface& surface = *context.GetSurface();
    surface.PushStateStack();
    const float left = area.left + (dark ? kControlsShowcaseWidth + gap : 0.0f);
    surface.Transform(velkcore::MatrixT<float>{1, 0, 0, 1, left, area.top});
    panel->UI_DispatchDrawFromRoot({0, 0, 0, 0}, &context, false);
    surface.PopStateStack();
  }
  theme.SetBrightness(brightness);
  theme.NotifyThemeChanged();
}

}  // namespace gallery
