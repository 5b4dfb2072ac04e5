#pragma once

#include <cairo.h>
#include "X11Headers.h"

#include <cstdint>
#include <optional>
#include <vector>

#include <velkcore/Geometry.h>
#include <velkui/pictel/PictelTypes.h>

namespace velkui::ui::x11 {

// A window's pixels: the library paints into an image of the client area's
// size, and only the painted rectangles go to the window. On the usual 24-bit
// true-colour visuals the image's bytes are already the server's pixel format
// and go with XPutImage; other visuals go through cairo-xlib, which converts.
// (cairo-xlib's shared-memory uploads lose track of a few bytes at the end,
// so the plain path avoids them.) The image also answers exposures without a
// repaint.
class X11BackBuffer {
 public:
  X11BackBuffer(Display* display, Window window, Visual* visual, int depth, std::int32_t width,
                std::int32_t height);
  ~X11BackBuffer();
  X11BackBuffer(const X11BackBuffer&) = delete;
  X11BackBuffer& operator=(const X11BackBuffer&) = delete;

  // The image to paint into, at the window's size (its content is kept where
  // the size did not change).
  cairo_surface_t* Image();
  // The window took a new size (the image follows at the next Image()).
  void Resize(std::int32_t width, std::int32_t height);
  // Whether every pixel of the current size has been painted once.
  bool IsComplete() const { return complete_; }
  void MarkComplete() { complete_ = true; }
  // Copies `rects` (client pixels) of the image to the window.
  void Present(const std::vector<velkcore::RectT<std::int32_t>>& rects);
  // Cuts the window's shape to the pixels that are neither of the colour key
  // nor (with `alphaShape`) mostly transparent. No key and no transparent
  // pixel: the whole rectangle.
  void ApplyShape(const std::optional<pictel::ColorRGBA>& colorKey, bool alphaShape);

 private:
  Display* display_;
  Window window_;
  std::int32_t width_;
  std::int32_t height_;
  cairo_surface_t* image_ = nullptr;
  cairo_surface_t* target_ = nullptr;
  // The XPutImage path: the image's bytes are the server's format.
  bool direct_ = false;
  int depth_ = 24;
  GC gc_ = nullptr;
  bool complete_ = false;
  bool shaped_ = false;
};

}  // namespace velkui::ui::x11
