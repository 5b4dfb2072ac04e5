// Renders the gallery's pages into PNG files, then shows them in a real
// window when there is a display.
//
//   gallery [output.png]
//
// The drawing showcase goes to output.png (default velkui-gallery.png); every
// other page to output-<page>.png beside it. Prints the files written. With a
// display (DISPLAY set and VELKUI_PLATFORM not "headless") a window then
// shows the pages (see GalleryWindow.h: the controls and the dialog are live
// there); closing the window ends the program.
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
#include <velkui/ui/HeadlessPlatform.h>
#include <velkui/ui/PlatformSession.h>

#include "GalleryPage.h"
#include "GalleryWindow.h"

namespace {

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

}  // namespace

int main(int argc, char** argv) {
  const std::filesystem::path output = argc > 1 ? argv[1] : "velkui-gallery.png";
  try {
    std::vector<gallery::RenderedPage> rendered;
    {
      // The pages draw offscreen whatever the display: always headless.
      velkui::ui::PlatformSession session(std::make_unique<velkui::ui::HeadlessPlatform>());
      for (const gallery::GalleryPage& page : gallery::RegisteredPages()) {
        const auto image = page.render();
        const std::filesystem::path file = PagePath(output, page.name);
        velkui::pictel::WriteImageToPNGFile(*image, file);
        std::cout << std::filesystem::absolute(file).string() << '\n';
        rendered.push_back(
            {page.name, velkcore::UTF8to16(page.name.empty() ? "drawing" : page.name), image});
      }
    }
    std::cout.flush();
    if (HasDisplay() && !rendered.empty()) {
      velkui::ui::PlatformSession session;
      gallery::ShowGalleryWindow(std::move(rendered));
    }
  } catch (const std::exception& e) {
    std::cerr << "gallery: " << e.what() << '\n';
    return EXIT_FAILURE;
  }
  return EXIT_SUCCESS;
}
