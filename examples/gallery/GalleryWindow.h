#pragma once

#include <string>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include <velkui/pictel/ImageInterface.h>

namespace gallery {

// A page as it was rendered offscreen.
struct RenderedPage {
  std::string name;
  std::u16string title;
  boost::intrusive_ptr<velkui::pictel::ImageInterface> image;
};

// Shows the pages in a real window on the installed platform until the user
// closes it: tabs along the top (or the Left and Right keys) switch pages. The
// controls page and the dialog page are live there: real controls in the
// light or the dark interface, and a button that runs the export dialog
// modally over the gallery window. The other pages show their pictures, at
// full size when they fit. The window fills most of the primary monitor's
// work area. Needs a platform session with a display.
void ShowGalleryWindow(std::vector<RenderedPage> pages);

}  // namespace gallery
