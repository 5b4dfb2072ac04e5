#pragma once

#include "X11Headers.h"

#include <string>
#include <string_view>

namespace velkui::ui::x11 {

// The atoms the backend uses, interned in one round trip.
struct X11Atoms {
  Atom wmProtocols = None;
  Atom wmDeleteWindow = None;
  Atom wmState = None;
  Atom wmChangeState = None;
  Atom wmClientLeader = None;
  Atom netWmPing = None;
  Atom netWmName = None;
  Atom netWmPid = None;
  Atom netWmUserTime = None;
  Atom utf8String = None;
  Atom netWmState = None;
  Atom netWmStateModal = None;
  Atom netWmStateAbove = None;
  Atom netWmStateSkipTaskbar = None;
  Atom netWmStateHidden = None;
  Atom netWmWindowType = None;
  Atom netWmWindowTypeNormal = None;
  Atom netWmWindowTypeDialog = None;
  Atom netWmWindowTypeUtility = None;
  Atom netWmWindowTypePopupMenu = None;
  Atom motifWmHints = None;
  Atom netWmWindowOpacity = None;
  Atom netActiveWindow = None;
  Atom netFrameExtents = None;
  Atom netRequestFrameExtents = None;
  Atom netWorkarea = None;
  Atom netCurrentDesktop = None;
  Atom netSupportingWmCheck = None;
  Atom clipboard = None;
  Atom targets = None;
  Atom timestamp = None;
  Atom incr = None;
  Atom text = None;
  Atom textPlainUtf8 = None;
  Atom textPlain = None;
  Atom selectionProperty = None;
  Atom timestampProperty = None;
};

// The connection to the X server: opened from DISPLAY (or the name given), with
// an error handler that records protocol errors instead of ending the process
// (requests on windows the server already destroyed are expected now and then).
class X11Connection {
 public:
  // Raises the "backend unavailable" error (naming the display) when the
  // server cannot be reached.
  explicit X11Connection(const char* displayName = nullptr);
  ~X11Connection();
  X11Connection(const X11Connection&) = delete;
  X11Connection& operator=(const X11Connection&) = delete;

  Display* Get() const { return display_; }
  int Screen() const { return screen_; }
  Window Root() const { return root_; }
  const X11Atoms& Atoms() const { return atoms_; }
  int FileDescriptor() const { return ConnectionNumber(display_); }

  // Whether an EWMH window manager runs (asked again after RefreshWindowManager).
  bool HasWindowManager() const { return hasWindowManager_; }
  void RefreshWindowManager();

  // Protocol errors seen since the last call (and clears the count).
  int TakeErrorCount();

  Atom Intern(std::string_view name) const;
  std::string AtomName(Atom atom) const;

 private:
  Display* display_ = nullptr;
  int screen_ = 0;
  Window root_ = None;
  X11Atoms atoms_;
  bool hasWindowManager_ = false;
};

}  // namespace velkui::ui::x11
