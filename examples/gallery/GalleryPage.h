#pragma once

#include <functional>
#include <string>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include <velkui/pictel/ImageInterface.h>

namespace gallery {

// One page of the gallery. Pages render one after the other inside one
// headless platform session (so a node manager, a theme and the headless
// window system are installed) and each is written to its own PNG: the page
// named "" to the output file, any other to "<output stem>-<name>.png".
//
// A page file registers itself, and the gallery's CMakeLists picks up every
// .cpp file of the folder, so adding a page needs no other change:
//
//   const gallery::PageRegistration kMixerPage{{"mixer", 40, &RenderMixerPage}};
struct GalleryPage {
  std::string name;
  // Pages render in increasing order.
  int order = 0;
  std::function<boost::intrusive_ptr<velkui::pictel::ImageInterface>()> render;
};

class PageRegistration {
 public:
  explicit PageRegistration(GalleryPage page);
};

// The registered pages in render order.
std::vector<GalleryPage> RegisteredPages();

}  // namespace gallery
