#pragma once

// Xlib for the backend's sources. Xlib defines macros with everyday names; the
// ones that collide with the library's own names are removed here.
#include <X11/Xlib.h>
#include <X11/Xutil.h>

// X.h: the class of XQueryBestSize, clashes with velkui::ui::CursorShape.
#undef CursorShape
