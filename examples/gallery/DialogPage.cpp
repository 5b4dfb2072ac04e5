// The dialog page: a modal dialog with Export (OK) and Cancel over the window
// it belongs to, once in the light interface and once in the dark one (the
// library's key-frame theme at brightness 0). Each side is the headless screen
// while the dialog runs modally: the window behind is blocked (its controls
// draw disabled), the pointer rests on Export; then the click on Export ends
// the run.
#include <cmath>
#include <string>
#include <vector>

#include <velkui/controls/UI_Checkbox.h>
#include <velkui/controls/UI_Divider.h>
#include <velkui/controls/UI_StaticText.h>
#include <velkui/controls/UI_TextButton.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/DefaultKeyframeTheme.h>
#include <velkui/ui/HeadlessPlatform.h>
#include <velkui/ui/KeyframeThemeEditor.h>
#include <velkui/ui/OS_Window.h>

#include "DialogGallery.h"
#include "GalleryNodes.h"
#include "GalleryPage.h"

namespace gallery {
namespace {

namespace controls = velkui::controls;
namespace pictel = velkui::pictel;
namespace ui = velkui::ui;
using velkcore::MakeIntrusive;
using velkcore::PointT;
using velkcore::RectT;

constexpr std::int32_t kScreenWidth = 720;
constexpr std::int32_t kScreenHeight = 470;
constexpr float kMargin = 24;
constexpr float kCaptionHeight = 34;

// The window the dialog belongs to: a session with a transport row and its tracks.
ui::OS_WindowP MakeSessionWindow() {
  auto window = MakeIntrusive<ui::OS_Window>(u"Session \u2014 Night Drive",
                                             RectT<std::int32_t>{20, 20, 640, 400},
                                             ui::kStyleCaption | ui::kStyleSystemMenu);
  float x = 16;
  for (const char16_t* label : {u"Play", u"Stop", u"Record", u"Export\u2026"}) {
    Place(*window, {x, 14, 84, 24}, MakeIntrusive<controls::UI_TextButton>(label));
    x += 92;
  }
  Place(*window, {16, 50, 608, 2}, MakeIntrusive<controls::UI_Divider>());
  struct Track {
    const char16_t* name;
    const char16_t* detail;
    bool on;
  };
  const Track tracks[] = {{u"Drums", u"Stereo \u00B7 -6.0 dB \u00B7 3 regions", true},
                          {u"Bass", u"Mono \u00B7 -3.5 dB \u00B7 5 regions", true},
                          {u"Keys", u"Stereo \u00B7 -9.0 dB \u00B7 2 regions", false},
                          {u"Vocals", u"Mono \u00B7 -1.5 dB \u00B7 8 regions", true},
                          {u"Room", u"Stereo \u00B7 -14 dB \u00B7 1 region", false}};
  float y = 66;
  for (const Track& track : tracks) {
    auto check = Place(*window, {16, y, 150, 22}, MakeIntrusive<controls::UI_Checkbox>(track.name));
    check->SetChecked(track.on);
    Place(*window, {180, y + 1, 440, 20}, MakeIntrusive<controls::UI_StaticText>(track.detail));
    y += 32;
  }
  Place(*window, {16, y + 6, 608, 20},
        MakeIntrusive<controls::UI_StaticText>(
            u"Checked tracks go into the mixdown. Export\u2026 opens the dialog."));
  return window;
}

// The export dialog, photographed while it runs: once it is up, the pointer
// comes to rest on Export, the screen is taken, and the click follows.
class PhotographedExportDialog : public ExportDialog {
 public:
  using ExportDialog::ExportDialog;
  boost::intrusive_ptr<pictel::ImageInterface> screen;

 protected:
  ui::PumpResult ModalLoop() override {
    ui::HeadlessPlatform& headless = ui::HeadlessPlatform::Get();
    ModalDuring();
    const controls::UI_TextButton& button = *ExportButton();
    const RectT<float> r = button.UI_LocalToGlobalF(button.UI_GetLocalRectF(false));
    const RectT<std::int32_t> client = headless.GetClientRect(GetPlatformWindow(false));
    headless.MovePointer({client.left + static_cast<std::int32_t>(r.left + r.width * 0.6f),
                          client.top + static_cast<std::int32_t>(r.top + r.height * 0.6f)});
    ModalDuring();
    screen = headless.RenderScreen();
    headless.Click();
    return ExportDialog::ModalLoop();
  }
};

struct Shot {
  boost::intrusive_ptr<pictel::ImageInterface> screen;
  ui::UI_Dialog::Response response = ui::UI_Dialog::kCancel;
  bool ownerWasBlocked = false;
};

Shot RunExportDialog() {
  ui::HeadlessPlatform& headless = ui::HeadlessPlatform::Get();
  Shot shot;
  const ui::OS_WindowP session = MakeSessionWindow();
  session->UI_Show(true);
  headless.ProcessEvents();
  {
    const auto dialog = MakeIntrusive<PhotographedExportDialog>(session.get());
    dialog->Position();
    dialog->GetDialogViewContainer().SetPostCloseCallback([&](ui::UI_Dialog::Response) {
      shot.ownerWasBlocked = session->UI_IsDisabled();
      return false;
    });
    dialog->RunModal();
    shot.screen = dialog->screen;
    shot.response = dialog->GetResponse();
  }
  headless.ProcessEvents();
  return shot;
}

// Runs `render` with the interface at `brightness`, through the library's
// key-frame theme when the installed theme can take tracks.
template <typename Render>
auto AtBrightness(float brightness, const Render& render) {
  ui::Theme& theme = ui::Theme::Get();
  auto* editor = dynamic_cast<ui::KeyframeThemeEditor*>(&theme);
  const float before = theme.GetBrightness();
  if (editor != nullptr) ui::LoadDefaultKeyframeTheme(*editor);
  theme.SetBrightness(brightness);
  theme.NotifyThemeChanged();
  auto result = render();
  theme.SetBrightness(before);
  theme.NotifyThemeChanged();
  return result;
}

void Text(pictel::SurfaceInterface& surface, const pictel::SupplierInterface& supplier,
          const std::u16string& text, PointT<float> at, float size, bool bold,
          const pictel::ColorRGBA& color) {
  const pictel::FontP font(supplier, ui::Theme::Get().GetFontName(0), bold ? u"Bold" : u"", size);
  surface.DrawString(*pictel::BrushP(supplier, color), *font, text.c_str(), at,
                     pictel::TextAlignment::kStart, pictel::TextTruncation::kEndEllipsis, 2000);
}

boost::intrusive_ptr<pictel::ImageInterface> RenderDialogPage() {
  ui::HeadlessPlatform& headless = ui::HeadlessPlatform::Get();
  headless.SetMonitors(
      {{{0, 0, kScreenWidth, kScreenHeight}, {0, 0, kScreenWidth, kScreenHeight}, 1, true}});
  const Shot light = AtBrightness(ui::GetDefaultBrightness(), &RunExportDialog);
  const Shot dark = AtBrightness(ui::kDarkInterfaceBrightness, &RunExportDialog);

  const auto supplier = pictel::NewOSSupplier();
  const float width = 2 * kScreenWidth + 3 * kMargin;
  const float height = kScreenHeight + kCaptionHeight + 2 * kMargin + 28;
  const auto surface = supplier->NewSurface(static_cast<std::int32_t>(width),
                                            static_cast<std::int32_t>(height), false);
  surface->PaintRect({0.86f, 0.87f, 0.89f, 1}, {0, 0, width, height});
  const pictel::ColorRGBA ink{0.13f, 0.15f, 0.19f, 1};
  const pictel::ColorRGBA note{0.35f, 0.38f, 0.44f, 1};
  const struct {
    const Shot& shot;
    const char16_t* title;
  } sides[] = {{light, u"Light interface"}, {dark, u"Dark interface (theme brightness 0)"}};
  float left = kMargin;
  for (const auto& side : sides) {
    Text(*surface, *supplier, side.title, {left, kMargin + 18}, 15, true, ink);
    const float top = kMargin + kCaptionHeight;
    surface->PaintRect({0.55f, 0.57f, 0.6f, 1},
                       {left - 1, top - 1, kScreenWidth + 2.0f, kScreenHeight + 2.0f});
    if (side.shot.screen) surface->DrawImage(*side.shot.screen, {left, top}, 1.0f);
    std::u16string outcome = side.shot.response == ui::UI_Dialog::kOk
                                 ? u"RunModal answered OK after the click on Export"
                                 : u"RunModal did not answer OK: something is wrong";
    outcome += side.shot.ownerWasBlocked ? u"; the session window was blocked while it ran."
                                         : u"; the session window was NOT blocked.";
    Text(*surface, *supplier, outcome, {left, top + kScreenHeight + 22}, 12, false, note);
    left += kScreenWidth + kMargin;
  }
  surface->Flush();
  return surface->GetSurfaceImage();
}

const PageRegistration kDialogPage{{"dialog", 35, &RenderDialogPage}};

}  // namespace
}  // namespace gallery
