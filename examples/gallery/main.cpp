// Renders the gallery's pages into PNG files, then shows them in a real
// window when there is a display.
//
//   gallery [output.png]
//
// The drawing showcase goes to output.png (default velkui-gallery.png); every
// other page to output-<page>.png beside it. Prints the files written. With a
// display (DISPLAY set and VELKUI_PLATFORM not "headless") a window then
// shows the pages: the tabs or the Left and Right keys switch between them;
// closing the window ends the program.
#include <algorithm>
#include <cstdlib>
#include <exception>
#include <filesystem>
#include <iostream>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include <velkcore/Strings.h>
#include <velkui/pictel/ImageIO.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/PictelHandles.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/HeadlessPlatform.h>
#include <velkui/ui/KeyboardEvent.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/OS_MessagePump.h>
#include <velkui/ui/OS_Window.h>
#include <velkui/ui/PlatformSession.h>
#include <velkui/ui/UI_SubView.h>

#include "GalleryPage.h"

namespace {

namespace ui = velkui::ui;
namespace pictel = velkui::pictel;
using velkcore::RectT;

struct RenderedPage {
  std::u16string title;
  boost::intrusive_ptr<pictel::ImageInterface> image;
};

std::filesystem::path PagePath(const std::filesystem::path& output, const std::string& page) {
  if (page.empty()) return output;
  std::filesystem::path path = output;
  path.replace_filename(output.stem().string() + "-" + page + output.extension().string());
  return path;
}

bool HasDisplay() {
  const char* platform = std::getenv("VELKUI_PLATFORM");
  if (platform != nullptr && *platform != '\0') return std::string(platform) != "headless";
  const char* display = std::getenv("DISPLAY");
  return display != nullptr && *display != '\0';
}

// The pages and which one shows: tabs along the top, the page below.
class PageBrowser : public ui::UI_SubView {
 public:
  static constexpr float kTabHeight = 34;

  explicit PageBrowser(std::vector<RenderedPage> pages) : pages_(std::move(pages)) {}

  bool UI_WantsKeyboardFocus() const override { return true; }
  bool UI_DoMouseEvent(ui::UI_Node*, const ui::MouseEvent& event) override {
    if (event.GetAction() != ui::MouseEvent::kButtonDown || event.GetPosition().y >= kTabHeight) {
      return false;
    }
    const float tabWidth = TabWidth();
    Select(static_cast<std::size_t>(std::max(0.0f, event.GetPosition().x) / tabWidth));
    return true;
  }
  bool UI_DoKeyboardEvent(ui::UI_Node*, const ui::KeyboardEvent& event) override {
    if (!event.IsActionKeyDown()) return false;
    if (event.GetOSCode() == -ui::vk::kRight) Select(current_ + 1);
    if (event.GetOSCode() == -ui::vk::kLeft && current_ > 0) Select(current_ - 1);
    return true;
  }
  void UI_Draw(pictel::Pictel* context) const override {
    const pictel::SupplierInterface& supplier = *context->GetSupplier();
    pictel::SurfaceInterface& surface = *context->GetSurface();
    const RectT<float> r = UI_GetLocalRectF(false);
    surface.PaintRect({0.16f, 0.18f, 0.21f, 1}, r);
    const pictel::FontP font(supplier, pictel::GetPlatformUIFontFamily(), u"", 13);
    const float tabWidth = TabWidth();
    for (std::size_t i = 0; i < pages_.size(); ++i) {
      const RectT<float> tab{static_cast<float>(i) * tabWidth, 0, tabWidth, kTabHeight};
      const bool selected = i == current_;
      if (selected) surface.PaintRect({0.27f, 0.31f, 0.37f, 1}, tab);
      const pictel::BrushP ink(supplier, selected ? pictel::ColorRGBA{1, 1, 1, 1}
                                                  : pictel::ColorRGBA{0.7f, 0.73f, 0.78f, 1});
      surface.DrawString(
          *ink, *font, pages_[i].title.c_str(), {tab.left + tab.width / 2, kTabHeight / 2 + 5},
          pictel::TextAlignment::kCenter, pictel::TextTruncation::kEndEllipsis, tab.width - 12);
    }
    const pictel::ImageInterface& image = *pages_[current_].image;
    // The page scaled to fit below the tabs, keeping its proportions.
    const float areaWidth = r.width - 16;
    const float areaHeight = r.height - kTabHeight - 16;
    const float scale = std::min({1.0f, areaWidth / static_cast<float>(image.GetWidth()),
                                  areaHeight / static_cast<float>(image.GetHeight())});
    const float width = static_cast<float>(image.GetWidth()) * scale;
    const float height = static_cast<float>(image.GetHeight()) * scale;
    surface.DrawImage(
        supplier, image,
        {(r.width - width) / 2, kTabHeight + 8 + (areaHeight - height) / 2, width, height}, nullptr,
        1.0f);
  }

 private:
  float TabWidth() const {
    return std::min(180.0f, UI_GetLocalRectF(false).width / static_cast<float>(pages_.size()));
  }
  void Select(std::size_t page) {
    if (page >= pages_.size() || page == current_) return;
    current_ = page;
    UI_Invalidate(nullptr, {});
  }

  std::vector<RenderedPage> pages_;
  std::size_t current_ = 0;
};

void ShowInWindow(std::vector<RenderedPage> pages) {
  ui::PlatformSession session;
  auto window = velkcore::MakeIntrusive<ui::OS_Window>(
      u"velkui gallery", RectT<std::int32_t>{60, 40, 1120, 720}, ui::kStyleOverlappedWindow);
  auto browser = velkcore::MakeIntrusive<PageBrowser>(std::move(pages));
  browser->UI_SetLocalRectF({0, 0, 1120, 720});
  browser->UI_SetLayoutBinding(ui::LayoutBinding(ui::kBindRightToRight | ui::kBindBottomToBottom));
  browser->UI_Show(true);
  window->ChildPushBack(browser);
  window->UI_Show(true);
  browser->UI_GainKeyboardFocus();
  ui::OS_RunMessageLoop([&window] { return !window->UI_IsShown(); });
}

}  // namespace

int main(int argc, char** argv) {
  const std::filesystem::path output = argc > 1 ? argv[1] : "velkui-gallery.png";
  try {
    std::vector<RenderedPage> rendered;
    {
      // The pages draw offscreen whatever the display: always headless.
      velkui::ui::PlatformSession session(std::make_unique<velkui::ui::HeadlessPlatform>());
      for (const gallery::GalleryPage& page : gallery::RegisteredPages()) {
        const auto image = page.render();
        const std::filesystem::path file = PagePath(output, page.name);
        velkui::pictel::WriteImageToPNGFile(*image, file);
        std::cout << std::filesystem::absolute(file).string() << '\n';
        rendered.push_back({velkcore::UTF8to16(page.name.empty() ? "drawing" : page.name), image});
      }
    }
    std::cout.flush();
    if (HasDisplay() && !rendered.empty()) ShowInWindow(std::move(rendered));
  } catch (const std::exception& e) {
    std::cerr << "gallery: " << e.what() << '\n';
    return EXIT_FAILURE;
  }
  return EXIT_SUCCESS;
}
