// Renders the gallery's pages into PNG files, without a display.
//
//   gallery [output.png]
//
// The drawing showcase goes to output.png (default velkui-gallery.png); every
// other page to output-<page>.png beside it. Prints the files written.
#include <cstdlib>
#include <exception>
#include <filesystem>
#include <iostream>
#include <memory>
#include <string>

#include <velkui/pictel/ImageIO.h>
#include <velkui/ui/HeadlessPlatform.h>
#include <velkui/ui/PlatformSession.h>

#include "GalleryPage.h"

namespace {

std::filesystem::path PagePath(const std::filesystem::path& output, const std::string& page) {
  if (page.empty()) return output;
  std::filesystem::path path = output;
  path.replace_filename(output.stem().string() + "-" + page + output.extension().string());
  return path;
}

}  // namespace

int main(int argc, char** argv) {
  const std::filesystem::path output = argc > 1 ? argv[1] : "velkui-gallery.png";
  try {
    // The gallery draws offscreen whatever the display: always headless.
    velkui::ui::PlatformSession session(std::make_unique<velkui::ui::HeadlessPlatform>());
    for (const gallery::GalleryPage& page : gallery::RegisteredPages()) {
      const auto image = page.render();
      const std::filesystem::path file = PagePath(output, page.name);
      velkui::pictel::WriteImageToPNGFile(*image, file);
      std::cout << std::filesystem::absolute(file).string() << '\n';
    }
  } catch (const std::exception& e) {
    std::cerr << "gallery: " << e.what() << '\n';
    return EXIT_FAILURE;
  }
  return EXIT_SUCCESS;
}
