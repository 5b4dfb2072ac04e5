#include "X11Connection.h"

#include <X11/Xatom.h>
#include <X11/Xutil.h>
#include "X11Headers.h"

#include <array>
#include <atomic>
#include <cstdlib>
#include <mutex>

#include <velkcore/Error.h>

namespace velkui::ui::x11 {

namespace {

constexpr std::string_view kDisplayUnavailableKey =
    "$$$/velkui/ui/Error/DisplayUnavailable=The window-system backend \"^0\" cannot open the "
    "display \"^1\" (set VELKUI_PLATFORM=headless to run without a display).";
constexpr std::int32_t kDisplayUnavailableNumber = 20;

// One handler for every connection of the process: Xlib's default one ends it.
std::mutex gErrorMutex;
int gConnections = 0;
std::atomic<int> gErrorCount = 0;
XErrorHandler gPreviousHandler = nullptr;

int RecordError(Display*, XErrorEvent*) {
  ++gErrorCount;
  return 0;
}

void InstallErrorHandler() {
  const std::lock_guard lock(gErrorMutex);
  if (gConnections++ == 0) gPreviousHandler = XSetErrorHandler(RecordError);
}

void RemoveErrorHandler() {
  const std::lock_guard lock(gErrorMutex);
  if (--gConnections == 0) XSetErrorHandler(gPreviousHandler);
}

}  // namespace

X11Connection::X11Connection(const char* displayName) {
  display_ = XOpenDisplay(displayName);
  if (display_ == nullptr) {
    const char* shown = displayName != nullptr ? displayName : std::getenv("DISPLAY");
    velkcore::ThrowError(velkcore::ErrorLevel::kError, kDisplayUnavailableKey,
                         velkcore::kCategoryUserInterface, kDisplayUnavailableNumber, 0,
                         std::string("x11"), std::string(shown != nullptr ? shown : ""));
  }
  InstallErrorHandler();
  screen_ = DefaultScreen(display_);
  root_ = RootWindow(display_, screen_);

  static constexpr std::array kNames = {
      "WM_PROTOCOLS",
      "WM_DELETE_WINDOW",
      "WM_STATE",
      "WM_CHANGE_STATE",
      "WM_CLIENT_LEADER",
      "_NET_WM_PING",
      "_NET_WM_NAME",
      "_NET_WM_PID",
      "_NET_WM_USER_TIME",
      "UTF8_STRING",
      "_NET_WM_STATE",
      "_NET_WM_STATE_MODAL",
      "_NET_WM_STATE_ABOVE",
      "_NET_WM_STATE_SKIP_TASKBAR",
      "_NET_WM_STATE_HIDDEN",
      "_NET_WM_WINDOW_TYPE",
      "_NET_WM_WINDOW_TYPE_NORMAL",
      "_NET_WM_WINDOW_TYPE_DIALOG",
      "_NET_WM_WINDOW_TYPE_UTILITY",
      "_NET_WM_WINDOW_TYPE_POPUP_MENU",
      "_MOTIF_WM_HINTS",
      "_NET_WM_WINDOW_OPACITY",
      "_NET_ACTIVE_WINDOW",
      "_NET_FRAME_EXTENTS",
      "_NET_REQUEST_FRAME_EXTENTS",
      "_NET_WORKAREA",
      "_NET_CURRENT_DESKTOP",
      "_NET_SUPPORTING_WM_CHECK",
      "CLIPBOARD",
      "TARGETS",
      "TIMESTAMP",
      "INCR",
      "TEXT",
      "text/plain;charset=utf-8",
      "text/plain",
      "VELKUI_SELECTION",
      "VELKUI_TIMESTAMP",
  };
  std::array<Atom, kNames.size()> atoms{};
  std::array<char*, kNames.size()> names{};
  for (std::size_t i = 0; i < kNames.size(); ++i) names[i] = const_cast<char*>(kNames[i]);
  XInternAtoms(display_, names.data(), static_cast<int>(names.size()), False, atoms.data());
  Atom* out[] = {&atoms_.wmProtocols,
                 &atoms_.wmDeleteWindow,
                 &atoms_.wmState,
                 &atoms_.wmChangeState,
                 &atoms_.wmClientLeader,
                 &atoms_.netWmPing,
                 &atoms_.netWmName,
                 &atoms_.netWmPid,
                 &atoms_.netWmUserTime,
                 &atoms_.utf8String,
                 &atoms_.netWmState,
                 &atoms_.netWmStateModal,
                 &atoms_.netWmStateAbove,
                 &atoms_.netWmStateSkipTaskbar,
                 &atoms_.netWmStateHidden,
                 &atoms_.netWmWindowType,
                 &atoms_.netWmWindowTypeNormal,
                 &atoms_.netWmWindowTypeDialog,
                 &atoms_.netWmWindowTypeUtility,
                 &atoms_.netWmWindowTypePopupMenu,
                 &atoms_.motifWmHints,
                 &atoms_.netWmWindowOpacity,
                 &atoms_.netActiveWindow,
                 &atoms_.netFrameExtents,
                 &atoms_.netRequestFrameExtents,
                 &atoms_.netWorkarea,
                 &atoms_.netCurrentDesktop,
                 &atoms_.netSupportingWmCheck,
                 &atoms_.clipboard,
                 &atoms_.targets,
                 &atoms_.timestamp,
                 &atoms_.incr,
                 &atoms_.text,
                 &atoms_.textPlainUtf8,
                 &atoms_.textPlain,
                 &atoms_.selectionProperty,
                 &atoms_.timestampProperty};
  static_assert(std::size(out) == kNames.size());
  for (std::size_t i = 0; i < kNames.size(); ++i) *out[i] = atoms[i];
  RefreshWindowManager();
}

X11Connection::~X11Connection() {
  XCloseDisplay(display_);
  RemoveErrorHandler();
}

void X11Connection::RefreshWindowManager() {
  // EWMH: the root names a check window that names itself.
  const auto readWindow = [this](Window window) -> Window {
    Atom type = None;
    int format = 0;
    unsigned long count = 0;
    unsigned long after = 0;
    unsigned char* data = nullptr;
    Window result = None;
    if (XGetWindowProperty(display_, window, atoms_.netSupportingWmCheck, 0, 1, False, XA_WINDOW,
                           &type, &format, &count, &after, &data) == Success &&
        data != nullptr && type == XA_WINDOW && format == 32 && count == 1) {
      result = static_cast<Window>(reinterpret_cast<unsigned long*>(data)[0]);
    }
    if (data != nullptr) XFree(data);
    return result;
  };
  const Window check = readWindow(root_);
  hasWindowManager_ = check != None && readWindow(check) == check;
}

int X11Connection::TakeErrorCount() {
  return gErrorCount.exchange(0);
}

Atom X11Connection::Intern(std::string_view name) const {
  return XInternAtom(display_, std::string(name).c_str(), False);
}

std::string X11Connection::AtomName(Atom atom) const {
  if (atom == None) return {};
  char* name = XGetAtomName(display_, atom);
  if (name == nullptr) return {};
  std::string result(name);
  XFree(name);
  return result;
}

}  // namespace velkui::ui::x11
