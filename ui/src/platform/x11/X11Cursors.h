#pragma once

#include "X11Headers.h"

#include <map>

#include <velkui/ui/PlatformTypes.h>

namespace velkui::ui::x11 {

// The pointer shapes, created on first use and freed with the connection.
class X11Cursors {
 public:
  explicit X11Cursors(Display* display) : display_(display) {}
  ~X11Cursors();
  X11Cursors(const X11Cursors&) = delete;
  X11Cursors& operator=(const X11Cursors&) = delete;

  Cursor Get(CursorShape shape);

 private:
  Cursor CreateHidden() const;

  Display* display_;
  std::map<CursorShape, Cursor> cursors_;
};

}  // namespace velkui::ui::x11
