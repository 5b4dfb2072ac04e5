#include "X11Cursors.h"

#include <X11/cursorfont.h>
#include "X11Headers.h"

namespace velkui::ui::x11 {

namespace {

unsigned FontShapeOf(CursorShape shape) {
  switch (shape) {
    case CursorShape::kIBeam:
      return XC_xterm;
    case CursorShape::kWait:
      return XC_watch;
    case CursorShape::kCrosshair:
      return XC_crosshair;
    case CursorShape::kHand:
      return XC_hand2;
    case CursorShape::kSizeNS:
      return XC_sb_v_double_arrow;
    case CursorShape::kSizeWE:
      return XC_sb_h_double_arrow;
    case CursorShape::kSizeNWSE:
      return XC_bottom_right_corner;
    case CursorShape::kSizeNESW:
      return XC_bottom_left_corner;
    case CursorShape::kSizeAll:
      return XC_fleur;
    case CursorShape::kNo:
      return XC_circle;
    case CursorShape::kArrow:
    case CursorShape::kHidden:
      break;
  }
  return XC_left_ptr;
}

}  // namespace

X11Cursors::~X11Cursors() {
  for (const auto& [shape, cursor] : cursors_) XFreeCursor(display_, cursor);
}

Cursor X11Cursors::Get(CursorShape shape) {
  const auto found = cursors_.find(shape);
  if (found != cursors_.end()) return found->second;
  const Cursor cursor = shape == CursorShape::kHidden
                            ? CreateHidden()
                            : XCreateFontCursor(display_, FontShapeOf(shape));
  cursors_.emplace(shape, cursor);
  return cursor;
}

Cursor X11Cursors::CreateHidden() const {
  // An empty one-pixel bitmap as both the shape and its mask.
  static const char kEmpty[1] = {0};
  const Window root = DefaultRootWindow(display_);
  const Pixmap blank = XCreateBitmapFromData(display_, root, kEmpty, 1, 1);
  XColor black{};
  const Cursor cursor = XCreatePixmapCursor(display_, blank, blank, &black, &black, 0, 0);
  XFreePixmap(display_, blank);
  return cursor;
}

}  // namespace velkui::ui::x11
