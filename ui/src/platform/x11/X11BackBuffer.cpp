#include "X11BackBuffer.h"

#include <X11/Xutil.h>
#include <X11/extensions/shape.h>
#include <cairo-xlib.h>
#include "X11Headers.h"

#include <algorithm>
#include <cmath>
#include <new>

namespace velkui::ui::x11 {

namespace {

// Whether 32-bit ARGB in the host's byte order is how the server stores
// pixels of this visual.
bool IsNativeFormat(Display* display, Visual* visual, int depth) {
  if (visual->c_class != TrueColor || (depth != 24 && depth != 32) ||
      visual->red_mask != 0xFF0000u || visual->green_mask != 0xFF00u ||
      visual->blue_mask != 0xFFu) {
    return false;
  }
  const std::uint32_t probe = 1;
  const bool hostLittleEndian = *reinterpret_cast<const unsigned char*>(&probe) == 1;
  if ((ImageByteOrder(display) == LSBFirst) != hostLittleEndian) return false;
  int count = 0;
  XPixmapFormatValues* formats = XListPixmapFormats(display, &count);
  bool bits32 = false;
  for (int i = 0; i < count; ++i) {
    if (formats[i].depth == depth) bits32 = formats[i].bits_per_pixel == 32;
  }
  if (formats != nullptr) XFree(formats);
  return bits32;
}

std::uint8_t ToByte(float value) {
  return static_cast<std::uint8_t>(std::lround(std::clamp(value, 0.0f, 1.0f) * 255.0f));
}

}  // namespace

X11BackBuffer::X11BackBuffer(Display* display, Window window, Visual* visual, int depth,
                             std::int32_t width, std::int32_t height)
    : display_(display), window_(window), width_(std::max(width, 1)), height_(std::max(height, 1)) {
  target_ = cairo_xlib_surface_create(display_, window_, visual, width_, height_);
  if (cairo_surface_status(target_) != CAIRO_STATUS_SUCCESS) {
    cairo_surface_destroy(target_);
    throw std::bad_alloc();
  }
  direct_ = IsNativeFormat(display_, visual, depth);
  depth_ = depth;
  if (direct_) gc_ = XCreateGC(display_, window_, 0, nullptr);
}

X11BackBuffer::~X11BackBuffer() {
  if (gc_ != nullptr) XFreeGC(display_, gc_);
  if (image_ != nullptr) cairo_surface_destroy(image_);
  cairo_surface_destroy(target_);
}

void X11BackBuffer::Resize(std::int32_t width, std::int32_t height) {
  width = std::max(width, 1);
  height = std::max(height, 1);
  if (width == width_ && height == height_) return;
  width_ = width;
  height_ = height;
  cairo_xlib_surface_set_size(target_, width_, height_);
  complete_ = false;
}

cairo_surface_t* X11BackBuffer::Image() {
  if (image_ != nullptr && cairo_image_surface_get_width(image_) == width_ &&
      cairo_image_surface_get_height(image_) == height_) {
    return image_;
  }
  cairo_surface_t* image = cairo_image_surface_create(CAIRO_FORMAT_ARGB32, width_, height_);
  if (cairo_surface_status(image) != CAIRO_STATUS_SUCCESS) {
    cairo_surface_destroy(image);
    throw std::bad_alloc();
  }
  if (image_ != nullptr) {
    // What was painted stays until the repaint of the new size arrives.
    cairo_t* cr = cairo_create(image);
    cairo_set_source_surface(cr, image_, 0, 0);
    cairo_set_operator(cr, CAIRO_OPERATOR_SOURCE);
    cairo_paint(cr);
    cairo_destroy(cr);
    cairo_surface_destroy(image_);
  }
  image_ = image;
  return image_;
}

void X11BackBuffer::Present(const std::vector<velkcore::RectT<std::int32_t>>& rects) {
  if (image_ == nullptr || rects.empty()) return;
  cairo_surface_flush(image_);
  const velkcore::RectT<std::int32_t> bounds{0, 0, cairo_image_surface_get_width(image_),
                                             cairo_image_surface_get_height(image_)};
  if (direct_) {
    XImage image{};
    image.width = bounds.width;
    image.height = bounds.height;
    image.format = ZPixmap;
    image.data = reinterpret_cast<char*>(cairo_image_surface_get_data(image_));
    image.byte_order = ImageByteOrder(display_);
    image.bitmap_unit = 32;
    image.bitmap_bit_order = BitmapBitOrder(display_);
    image.bitmap_pad = 32;
    image.depth = depth_;
    image.bytes_per_line = cairo_image_surface_get_stride(image_);
    image.bits_per_pixel = 32;
    image.red_mask = 0xFF0000u;
    image.green_mask = 0xFF00u;
    image.blue_mask = 0xFFu;
    if (XInitImage(&image) == 0) return;
    for (const velkcore::RectT<std::int32_t>& rect : rects) {
      const velkcore::RectT<std::int32_t> r = velkcore::Intersection(rect, bounds);
      if (r.IsEmpty()) continue;
      XPutImage(display_, window_, gc_, &image, r.left, r.top, r.left, r.top,
                static_cast<unsigned>(r.width), static_cast<unsigned>(r.height));
    }
    return;
  }
  cairo_t* cr = cairo_create(target_);
  cairo_set_operator(cr, CAIRO_OPERATOR_SOURCE);
  cairo_set_source_surface(cr, image_, 0, 0);
  for (const velkcore::RectT<std::int32_t>& r : rects) {
    cairo_rectangle(cr, r.left, r.top, r.width, r.height);
  }
  cairo_fill(cr);
  cairo_destroy(cr);
  cairo_surface_flush(target_);
}

void X11BackBuffer::ApplyShape(const std::optional<pictel::ColorRGBA>& colorKey, bool alphaShape) {
  if (image_ == nullptr) return;
  cairo_surface_flush(image_);
  const unsigned char* data = cairo_image_surface_get_data(image_);
  const int stride = cairo_image_surface_get_stride(image_);
  const int width = cairo_image_surface_get_width(image_);
  const int height = cairo_image_surface_get_height(image_);
  std::uint32_t keyPixel = 0;
  if (colorKey) {
    keyPixel = 0xFF000000u | (std::uint32_t{ToByte(colorKey->red)} << 16) |
               (std::uint32_t{ToByte(colorKey->green)} << 8) | ToByte(colorKey->blue);
  }
  const auto kept = [&](std::uint32_t pixel) {
    if (colorKey && pixel == keyPixel) return false;
    return !alphaShape || (pixel >> 24) >= 128;
  };
  std::vector<XRectangle> runs;
  bool everyPixelKept = true;
  for (int y = 0; y < height; ++y) {
    const auto* row =
        reinterpret_cast<const std::uint32_t*>(data + static_cast<std::ptrdiff_t>(y) * stride);
    int x = 0;
    while (x < width) {
      while (x < width && !kept(row[x])) {
        everyPixelKept = false;
        ++x;
      }
      const int start = x;
      while (x < width && kept(row[x])) ++x;
      if (x > start) {
        runs.push_back({static_cast<short>(start), static_cast<short>(y),
                        static_cast<unsigned short>(x - start), 1});
      }
    }
  }
  if (everyPixelKept) {
    if (shaped_) XShapeCombineMask(display_, window_, ShapeBounding, 0, 0, None, ShapeSet);
    shaped_ = false;
    return;
  }
  XShapeCombineRectangles(display_, window_, ShapeBounding, 0, 0, runs.data(),
                          static_cast<int>(runs.size()), ShapeSet, YXBanded);
  shaped_ = true;
}

}  // namespace velkui::ui::x11
