#include "GalleryPage.h"

#include <algorithm>
#include <utility>

namespace gallery {

namespace {

std::vector<GalleryPage>& Pages() {
  static std::vector<GalleryPage> pages;
  return pages;
}

}  // namespace

PageRegistration::PageRegistration(GalleryPage page) {
  Pages().push_back(std::move(page));
}

std::vector<GalleryPage> RegisteredPages() {
  std::vector<GalleryPage> pages = Pages();
  std::stable_sort(pages.begin(), pages.end(),
                   [](const GalleryPage& a, const GalleryPage& b) { return a.order < b.order; });
  return pages;
}

}  // namespace gallery
