#include "GalleryWindow.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <memory>
#include <utility>

#include <velkcore/Strings.h>
#include <velkui/controls/UI_Checkbox.h>
#include <velkui/controls/UI_Divider.h>
#include <velkui/controls/UI_StaticText.h>
#include <velkui/controls/UI_TextButton.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PathShapes.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/DefaultKeyframeTheme.h>
#include <velkui/ui/KeyboardEvent.h>
#include <velkui/ui/KeyframeThemeEditor.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/OS_MessagePump.h>
#include <velkui/ui/OS_Window.h>
#include <velkui/ui/Platform.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_Container.h>
#include <velkui/ui/UI_SubView.h>

#include "ControlsGallery.h"
#include "DialogGallery.h"
#include "GalleryNodes.h"

namespace gallery {

namespace {

namespace controls = velkui::controls;
namespace pictel = velkui::pictel;
namespace ui = velkui::ui;
using velkcore::MakeIntrusive;
using velkcore::PointT;
using velkcore::RectT;

constexpr float kTabHeight = 36;
constexpr float kMaxTabWidth = 160;
constexpr float kPageMargin = 24;
constexpr float kCardGap = 24;
constexpr float kCardPadding = 18;
// The pictures are rendered on this colour; the page area matches it.
constexpr pictel::ColorRGBA kPageColor{0.86f, 0.87f, 0.89f, 1};
constexpr pictel::ColorRGBA kBarColor{0.16f, 0.18f, 0.21f, 1};

// Wrapped text that starts at the top of its box.
boost::intrusive_ptr<controls::UI_StaticText> Paragraph(const std::u16string& text) {
  auto paragraph = MakeIntrusive<controls::UI_StaticText>(text, true);
  paragraph->SetAlignment(controls::kControlAlignLeft, controls::kControlAlignTop);
  return paragraph;
}

boost::intrusive_ptr<controls::UI_StaticText> Heading(const std::u16string& text) {
  auto heading = MakeIntrusive<controls::UI_StaticText>(text);
  heading->SetFontSize(15);
  heading->SetFontStyleName(u"Bold");
  return heading;
}

// A rounded card in the theme's window colours, like the showcase panel.
class Card : public ui::UI_SubView {
 public:
  void UI_Draw(pictel::Pictel* context) const override {
    const ui::Theme& theme = ui::Theme::Get();
    const RectT<float> r = UI_GetLocalRectF(false);
    pictel::PathP path(*context->GetSupplier());
    velkui::utils::FormRoundedRect(path, {r.left + 0.5f, r.top + 0.5f, r.width - 1, r.height - 1},
                                   8);
    const pictel::BrushP fill(*context->GetSupplier(), theme.GetColor(4));
    context->GetSurface()->FillPath(*fill, *path, pictel::FillType::kWinding);
    const pictel::PenP pen(*context->GetSupplier(), theme.GetColor(3), 1);
    context->GetSurface()->StrokePath(*pen, *path);
    UI_SubView::UI_Draw(context);
  }
};

// A page's area below the tabs, in the pictures' colour.
class PageArea : public ui::UI_SubView {
 public:
  void UI_Draw(pictel::Pictel* context) const override {
    context->GetSurface()->PaintRect(kPageColor, UI_GetLocalRectF(false));
    UI_SubView::UI_Draw(context);
  }
};

// `image` centred in `area`: at full size when it fits, else scaled down to fit.
void DrawFitted(pictel::Pictel& context, const pictel::ImageInterface& image,
                const RectT<float>& area) {
  const auto width = static_cast<float>(image.GetWidth());
  const auto height = static_cast<float>(image.GetHeight());
  const float scale = std::min({1.0f, area.width / width, area.height / height});
  if (scale <= 0) return;
  const float w = std::round(width * scale);
  const float h = std::round(height * scale);
  context.GetSurface()->DrawImage(*context.GetSupplier(), image,
                                  {std::round(area.left + (area.width - w) / 2),
                                   std::round(area.top + (area.height - h) / 2), w, h},
                                  nullptr, 1.0f);
}

class PicturePage : public PageArea {
 public:
  explicit PicturePage(boost::intrusive_ptr<pictel::ImageInterface> image)
      : image_(std::move(image)) {}
  void UI_Draw(pictel::Pictel* context) const override {
    PageArea::UI_Draw(context);
    const RectT<float> r = UI_GetLocalRectF(false);
    DrawFitted(*context, *image_,
               {kPageMargin / 2, kPageMargin / 2, r.width - kPageMargin, r.height - kPageMargin});
  }

 private:
  boost::intrusive_ptr<pictel::ImageInterface> image_;
};

// What a control is called in the message line.
std::u16string Describe(const controls::UI_ControlView& control) {
  std::u16string name;
  if (const auto* button = dynamic_cast<const controls::UI_TextButton*>(&control)) {
    name = button->GetDisplayText();
  } else if (const auto* text = dynamic_cast<const controls::UI_TextControlBase*>(&control)) {
    name = velkcore::StripDisplayString(text->GetLabelText());
  }
  std::u16string described = velkcore::UTF8to16(control.UI_GetNodeID());
  if (!name.empty()) described += u" \u201C" + name + u"\u201D";
  if (const auto* button = dynamic_cast<const controls::UI_Button*>(&control)) {
    described += button->GetValue() == controls::kButtonOn ? u": on" : u": off";
  }
  return described;
}

// The showcase panel with real controls, and a card beside it that switches
// the interface between light and dark and tells the last message sent.
class LiveControlsPage : public PageArea {
 public:
  explicit LiveControlsPage(pictel::Pictel& measure) {
    BuildShowcase(measure);
    side_ = MakeIntrusive<Card>();
    side_->UI_Show(true);
    ChildPushBack(side_);
    const float inner = kSideWidth - 2 * kCardPadding;
    Place(*side_, {kCardPadding, 12, inner, 24}, Heading(u"Try them"));
    Place(*side_, {kCardPadding, 44, inner, 52},
          Paragraph(u"Hover, press and drag off the buttons. Tab moves the keyboard focus, "
                    u"Space presses the focused button and Alt shows the mnemonics."));
    dark_ = Place(*side_, {kCardPadding, 104, inner, 20},
                  MakeIntrusive<controls::UI_Checkbox>(u"&Dark interface"));
    dark_->SetChecked(false);
    Listen(*dark_, [this] { SetDark(dark_->IsChecked()); });
    Place(*side_, {kCardPadding, 138, inner, 2}, MakeIntrusive<controls::UI_Divider>());
    auto caption = Place(*side_, {kCardPadding, 150, inner, 20},
                         MakeIntrusive<controls::UI_StaticText>(u"Last message"));
    caption->SetFontStyleName(u"Bold");
    lastMessage_ = Place(*side_, {kCardPadding, 172, inner, 40}, Paragraph(u"None yet."));
  }
  ~LiveControlsPage() override { SetDark(false); }

  void UI_SizeChanged(const RectT<float>& newLocalRect) override {
    PageArea::UI_SizeChanged(newLocalRect);
    const float total = kControlsShowcaseWidth + kCardGap + kSideWidth;
    const float left = std::round(std::max(kPageMargin, (newLocalRect.width - total) / 2));
    showcase_->UI_SetLocalRectF(
        {left, kPageMargin + 8, kControlsShowcaseWidth, kControlsShowcaseHeight});
    side_->UI_SetLocalRectF(
        {left + kControlsShowcaseWidth + kCardGap, kPageMargin + 8, kSideWidth, kSideHeight});
  }

 private:
  static constexpr float kSideWidth = 300;
  static constexpr float kSideHeight = 226;

  void BuildShowcase(pictel::Pictel& measure) {
    showcase_ = BuildControlsShowcase(
        measure, u"Live controls",
        u"Every button kind of the library, live: each one sends its messages.");
    ChildPushBack(showcase_);
    ListenToAll(*showcase_);
  }
  void ListenToAll(ui::UI_Node& node) {
    auto* container = dynamic_cast<ui::UI_Container*>(&node);
    if (container == nullptr) return;
    for (auto child = container->ChildBegin(); child != container->ChildEnd(); ++child) {
      if (auto* control = dynamic_cast<controls::UI_ControlView*>(child->get())) {
        Listen(*control, [this, control] { lastMessage_->SetText(Describe(*control)); });
      }
      ListenToAll(**child);
    }
  }
  void Listen(controls::UI_ControlView& control, std::function<void()> heard) {
    auto listener = std::make_shared<controls::ControlCallback>(
        [heard = std::move(heard)](ui::MessageT<ui::UI_Node>*) { heard(); });
    control.NotifyWhenChanged(listener);
    listeners_.push_back(std::move(listener));
  }
  void SetDark(bool dark) {
    ui::Theme& theme = ui::Theme::Get();
    if (auto* editor = dynamic_cast<ui::KeyframeThemeEditor*>(&theme)) {
      ui::LoadDefaultKeyframeTheme(*editor);
    }
    theme.SetBrightness(dark ? ui::kDarkInterfaceBrightness : ui::GetDefaultBrightness());
    theme.NotifyThemeChanged();
    if (ui::UI_Node* root = UI_GetRootNode()) root->UI_Invalidate(nullptr, {});
  }

  ui::SubViewP showcase_;
  ui::SubViewP side_;
  boost::intrusive_ptr<controls::UI_Checkbox> dark_;
  boost::intrusive_ptr<controls::UI_StaticText> lastMessage_;
  std::vector<controls::ControlCallbackP> listeners_;
};

// A card with a button that runs the export dialog modally over the gallery
// window, and what it answered; the photographs of the dialog below.
class LiveDialogPage : public PageArea {
 public:
  explicit LiveDialogPage(boost::intrusive_ptr<pictel::ImageInterface> photo)
      : photo_(std::move(photo)) {
    card_ = MakeIntrusive<Card>();
    card_->UI_Show(true);
    ChildPushBack(card_);
    const float inner = kCardWidth - 2 * kCardPadding;
    Place(*card_, {kCardPadding, 12, inner, 24}, Heading(u"Modal dialogs"));
    Place(*card_, {kCardPadding, 44, inner, 36},
          Paragraph(u"The button opens the export dialog over this window, as a transient, modal "
                    u"window: the gallery is blocked until it closes. Return presses Export, "
                    u"Escape presses Cancel."));
    open_ = Place(*card_, {kCardPadding, 90, 150, 26},
                  MakeIntrusive<controls::UI_TextButton>(u"&Export Mixdown\u2026"));
    auto listener = std::make_shared<controls::ControlCallback>(
        [this](ui::MessageT<ui::UI_Node>*) { RunExportDialog(); });
    open_->NotifyWhenChanged(listener);
    listener_ = listener;
    answer_ = Place(*card_, {kCardPadding + 166, 93, inner - 166, 20},
                    MakeIntrusive<controls::UI_StaticText>(u"Not opened yet."));
  }

  void UI_SizeChanged(const RectT<float>& newLocalRect) override {
    PageArea::UI_SizeChanged(newLocalRect);
    card_->UI_SetLocalRectF(
        {std::round((newLocalRect.width - kCardWidth) / 2), kPageMargin, kCardWidth, kCardHeight});
  }
  void UI_Draw(pictel::Pictel* context) const override {
    PageArea::UI_Draw(context);
    const RectT<float> r = UI_GetLocalRectF(false);
    const float top = kPageMargin + kCardHeight + kCardGap / 2;
    DrawFitted(*context, *photo_,
               {kPageMargin / 2, top, r.width - kPageMargin, r.height - top - kPageMargin / 2});
  }

 private:
  static constexpr float kCardWidth = 560;
  static constexpr float kCardHeight = 134;

  void RunExportDialog() {
    auto* owner = dynamic_cast<ui::OS_Window*>(UI_GetRootNode());
    const auto dialog = MakeIntrusive<ExportDialog>(owner);
    dialog->Position();
    dialog->RunModal();
    const bool exported = dialog->GetResponse() == ui::UI_Dialog::kOk;
    answer_->SetText(exported ? u"RunModal answered OK (Export)." : u"RunModal answered Cancel.");
  }

  boost::intrusive_ptr<pictel::ImageInterface> photo_;
  ui::SubViewP card_;
  boost::intrusive_ptr<controls::UI_TextButton> open_;
  boost::intrusive_ptr<controls::UI_StaticText> answer_;
  controls::ControlCallbackP listener_;
};

// The tabs along the top and the page of the selected one below.
class PageBrowser : public ui::UI_SubView {
 public:
  struct Page {
    std::u16string title;
    ui::SubViewP view;
  };

  explicit PageBrowser(std::vector<Page> pages) : pages_(std::move(pages)) {
    for (std::size_t i = 0; i < pages_.size(); ++i) {
      pages_[i].view->UI_Show(i == current_);
      ChildPushBack(pages_[i].view);
    }
  }

  bool UI_WantsKeyboardFocus() const override { return true; }
  bool UI_DoMouseEvent(ui::UI_Node*, const ui::MouseEvent& event) override {
    if (event.GetAction() != ui::MouseEvent::kButtonDown || event.GetPosition().y >= kTabHeight) {
      return false;
    }
    const float x = event.GetPosition().x;
    if (x >= 0 && x < TabWidth() * static_cast<float>(pages_.size())) {
      Select(static_cast<std::size_t>(x / TabWidth()));
    }
    return true;
  }
  bool UI_DoKeyboardEvent(ui::UI_Node*, const ui::KeyboardEvent& event) override {
    if (!event.IsActionKeyDown()) return false;
    if (event.GetOSCode() == -ui::vk::kRight) {
      Select(current_ + 1);
      return true;
    }
    if (event.GetOSCode() == -ui::vk::kLeft && current_ > 0) {
      Select(current_ - 1);
      return true;
    }
    return false;
  }
  void UI_SizeChanged(const RectT<float>& newLocalRect) override {
    UI_SubView::UI_SizeChanged(newLocalRect);
    for (const Page& page : pages_) {
      page.view->UI_SetLocalRectF(
          {0, kTabHeight, newLocalRect.width, std::max(0.0f, newLocalRect.height - kTabHeight)});
    }
  }
  void UI_Draw(pictel::Pictel* context) const override {
    const pictel::SupplierInterface& supplier = *context->GetSupplier();
    pictel::SurfaceInterface& surface = *context->GetSurface();
    const RectT<float> r = UI_GetLocalRectF(false);
    surface.PaintRect(kBarColor, {0, 0, r.width, kTabHeight});
    const pictel::FontP font(supplier, pictel::GetPlatformUIFontFamily(), u"", 13);
    const pictel::FontP boldFont(supplier, pictel::GetPlatformUIFontFamily(), u"Bold", 13);
    const float tabWidth = TabWidth();
    for (std::size_t i = 0; i < pages_.size(); ++i) {
      const RectT<float> tab{8 + static_cast<float>(i) * tabWidth, 6, tabWidth, kTabHeight - 6};
      const bool selected = i == current_;
      if (selected) {
        // The selected tab is cut from the page below it.
        pictel::PathP path(supplier);
        velkui::utils::FormRoundedRect(path, {tab.left, tab.top, tab.width, tab.height + 8}, 6);
        const pictel::BrushP fill(supplier, kPageColor);
        surface.FillPath(*fill, *path, pictel::FillType::kWinding);
      }
      const pictel::BrushP ink(supplier, selected ? pictel::ColorRGBA{0.13f, 0.15f, 0.19f, 1}
                                                  : pictel::ColorRGBA{0.72f, 0.75f, 0.8f, 1});
      surface.DrawString(*ink, selected ? *boldFont : *font, pages_[i].title.c_str(),
                         {tab.left + tab.width / 2, tab.top + tab.height / 2 + 5},
                         pictel::TextAlignment::kCenter, pictel::TextTruncation::kEndEllipsis,
                         tab.width - 16);
    }
    UI_SubView::UI_Draw(context);
  }

 private:
  float TabWidth() const {
    const float available = UI_GetLocalRectF(false).width - 16;
    return std::min(kMaxTabWidth, available / static_cast<float>(pages_.size()));
  }
  void Select(std::size_t page) {
    if (page >= pages_.size() || page == current_) return;
    pages_[current_].view->UI_Show(false);
    current_ = page;
    pages_[current_].view->UI_Show(true);
    UI_Invalidate(nullptr, {});
  }

  std::vector<Page> pages_;
  std::size_t current_ = 0;
};

// The window's frame: most of the primary monitor's work area, at most 1360 x 900.
RectT<std::int32_t> WindowFrame() {
  RectT<std::int32_t> area{0, 0, 1280, 800};
  for (const ui::MonitorDescription& monitor : ui::GetPlatform().GetMonitors()) {
    if (monitor.primary) area = monitor.workArea;
  }
  const std::int32_t width = std::min(1360, area.width - 48);
  const std::int32_t height = std::min(900, area.height - 64);
  return {area.left + (area.width - width) / 2, area.top + (area.height - height) / 2, width,
          height};
}

}  // namespace

void ShowGalleryWindow(std::vector<RenderedPage> pages) {
  auto window =
      MakeIntrusive<ui::OS_Window>(u"velkui gallery", WindowFrame(), ui::kStyleOverlappedWindow);
  const auto supplier = pictel::NewOSSupplier();
  const auto surface = supplier->NewSurface(1, 1, false);
  pictel::Pictel measure(supplier.get(), surface.get());
  std::vector<PageBrowser::Page> browserPages;
  for (RenderedPage& page : pages) {
    ui::SubViewP view;
    if (page.name == "controls") {
      view = MakeIntrusive<LiveControlsPage>(measure);
    } else if (page.name == "dialog") {
      view = MakeIntrusive<LiveDialogPage>(page.image);
    } else {
      view = MakeIntrusive<PicturePage>(page.image);
    }
    browserPages.push_back({std::move(page.title), view});
  }
  auto browser = MakeIntrusive<PageBrowser>(std::move(browserPages));
  // The window manager's frame comes out of the area asked for.
  browser->UI_SetLocalRectF(window->UI_GetLocalRectF(false));
  browser->UI_SetLayoutBinding(ui::LayoutBinding(ui::kBindRightToRight | ui::kBindBottomToBottom));
  browser->UI_Show(true);
  window->ChildPushBack(browser);
  window->UI_Show(true);
  browser->UI_GainKeyboardFocus();
  ui::OS_RunMessageLoop([&window] { return !window->UI_IsShown(); });
}

}  // namespace gallery
