#include "X11OutsideClient.h"

#include <X11/Xatom.h>
#include <X11/extensions/XTest.h>
#include <X11/keysym.h>
#include "X11Headers.h"

#include <velkcore/Error.h>

#include "X11PlatformImpl.h"

namespace velkui::ui {

namespace {

constexpr long kMotifFunctionsFlag = 1L << 0;
constexpr long kMotifFunctionClose = 1L << 5;

// A 32-bit property of `window` as longs (Xlib's format-32 representation).
std::vector<long> ReadLongs(Display* display, Window window, Atom property, Atom type) {
  Atom actualType = None;
  int format = 0;
  unsigned long count = 0;
  unsigned long after = 0;
  unsigned char* data = nullptr;
  std::vector<long> values;
  if (XGetWindowProperty(display, window, property, 0, 64, False, type, &actualType, &format,
                         &count, &after, &data) == Success &&
      data != nullptr && format == 32) {
    const auto* longs = reinterpret_cast<const long*>(data);
    values.assign(longs, longs + count);
  }
  if (data != nullptr) XFree(data);
  return values;
}

}  // namespace

struct X11OutsideClient::Impl {
  explicit Impl(const std::string& displayName) : connection(displayName.c_str()) {
    int eventBase = 0;
    int errorBase = 0;
    int major = 0;
    int minor = 0;
    xtestAvailable =
        XTestQueryExtension(connection.Get(), &eventBase, &errorBase, &major, &minor) != 0;
    // Xlib loads a connection's keyboard map on first use: here, on the
    // creating thread, rather than on the thread that sends keys.
    XKeysymToKeycode(connection.Get(), XK_space);
  }

  std::vector<std::string> AtomNames(const std::vector<long>& atoms) const {
    std::vector<std::string> names;
    for (const long atom : atoms) names.push_back(connection.AtomName(static_cast<Atom>(atom)));
    return names;
  }

  ~Impl() {
    if (settingsWindow != None) XDestroyWindow(connection.Get(), settingsWindow);
  }

  x11::X11Connection connection;
  bool xtestAvailable = false;
  bool numLockOn = false;
  Window settingsWindow = None;
};

X11OutsideClient::X11OutsideClient(const X11Platform& platform)
    : impl_(std::make_unique<Impl>(platform.GetDisplayName())) {
  impl_->numLockOn = platform.GetKeyState(vk::kNumLock).toggled;
}

X11OutsideClient::~X11OutsideClient() = default;

X11OutsideClient::WindowHints X11OutsideClient::ReadHints(PlatformWindow window) const {
  Display* display = impl_->connection.Get();
  const x11::X11Atoms& atoms = impl_->connection.Atoms();
  WindowHints hints;
  Window owner = None;
  if (XGetTransientForHint(display, window, &owner) != 0) hints.transientFor = owner;
  hints.types = impl_->AtomNames(ReadLongs(display, window, atoms.netWmWindowType, XA_ATOM));
  hints.states = impl_->AtomNames(ReadLongs(display, window, atoms.netWmState, XA_ATOM));
  Atom* protocols = nullptr;
  int count = 0;
  if (XGetWMProtocols(display, window, &protocols, &count) != 0 && protocols != nullptr) {
    for (int i = 0; i < count; ++i)
      hints.protocols.push_back(impl_->connection.AtomName(protocols[i]));
    XFree(protocols);
  }
  if (XWMHints* wmHints = XGetWMHints(display, window)) {
    hints.acceptsFocus = (wmHints->flags & InputHint) != 0 && wmHints->input != False;
    if ((wmHints->flags & WindowGroupHint) != 0) hints.group = wmHints->window_group;
    XFree(wmHints);
  }
  const std::vector<long> leader =
      ReadLongs(display, window, impl_->connection.Atoms().wmClientLeader, XA_WINDOW);
  if (!leader.empty()) hints.clientLeader = static_cast<PlatformWindow>(leader.front());
  const std::vector<long> motif =
      ReadLongs(display, window, atoms.motifWmHints, atoms.motifWmHints);
  hints.closable = motif.size() >= 2 && (motif[0] & kMotifFunctionsFlag) != 0 &&
                   (motif[1] & kMotifFunctionClose) != 0;
  return hints;
}

void X11OutsideClient::DeleteProperty(PlatformWindow window, std::string_view name) {
  Display* display = impl_->connection.Get();
  XDeleteProperty(display, window, impl_->connection.Intern(name));
  XSync(display, False);
}

void X11OutsideClient::FocusWindow(PlatformWindow window) {
  Display* display = impl_->connection.Get();
  XSetInputFocus(display, window, RevertToParent, CurrentTime);
  XSync(display, False);
}

void X11OutsideClient::PublishSettings(std::span<const std::uint8_t> property) {
  Display* display = impl_->connection.Get();
  const Window root = impl_->connection.Root();
  const Atom settings = impl_->connection.Intern("_XSETTINGS_SETTINGS");
  const bool announce = impl_->settingsWindow == None;
  if (announce) impl_->settingsWindow = XCreateSimpleWindow(display, root, 0, 0, 1, 1, 0, 0, 0);
  XChangeProperty(display, impl_->settingsWindow, settings, settings, 8, PropModeReplace,
                  property.data(), static_cast<int>(property.size()));
  if (announce) {
    const Atom selection =
        impl_->connection.Intern("_XSETTINGS_S" + std::to_string(impl_->connection.Screen()));
    XSetSelectionOwner(display, selection, impl_->settingsWindow, CurrentTime);
    XEvent message{};
    message.xclient.type = ClientMessage;
    message.xclient.window = root;
    message.xclient.message_type = impl_->connection.Intern("MANAGER");
    message.xclient.format = 32;
    message.xclient.data.l[0] = CurrentTime;
    message.xclient.data.l[1] = static_cast<long>(selection);
    message.xclient.data.l[2] = static_cast<long>(impl_->settingsWindow);
    XSendEvent(display, root, False, StructureNotifyMask, &message);
  }
  XSync(display, False);
}

void X11OutsideClient::WithdrawSettings() {
  if (impl_->settingsWindow == None) return;
  Display* display = impl_->connection.Get();
  XDestroyWindow(display, impl_->settingsWindow);
  impl_->settingsWindow = None;
  XSync(display, False);
}

void X11OutsideClient::SetResources(std::string_view text) {
  Display* display = impl_->connection.Get();
  const Window root = impl_->connection.Root();
  if (text.empty()) {
    XDeleteProperty(display, root, XA_RESOURCE_MANAGER);
  } else {
    XChangeProperty(display, root, XA_RESOURCE_MANAGER, XA_STRING, 8, PropModeReplace,
                    reinterpret_cast<const unsigned char*>(text.data()),
                    static_cast<int>(text.size()));
  }
  XSync(display, False);
}

void X11OutsideClient::InjectPointerMove(const velkcore::PointT<std::int32_t>& screenPoint) {
  x11::RequireSyntheticInput(impl_->xtestAvailable);
  Display* display = impl_->connection.Get();
  XTestFakeMotionEvent(display, -1, screenPoint.x, screenPoint.y, CurrentTime);
  XSync(display, False);
}

void X11OutsideClient::InjectButton(std::int32_t button, bool down) {
  velkcore::RequireInput(button == 1 || button == 2 || button == 4);
  x11::RequireSyntheticInput(impl_->xtestAvailable);
  Display* display = impl_->connection.Get();
  const unsigned xButton = button == 1 ? Button1 : button == 2 ? Button2 : Button3;
  XTestFakeButtonEvent(display, xButton, down ? True : False, CurrentTime);
  XSync(display, False);
}

void X11OutsideClient::InjectKey(std::int16_t virtualKey, bool extended, bool down) {
  velkcore::RequireInput(virtualKey > 0 && virtualKey < 256);
  x11::RequireSyntheticInput(impl_->xtestAvailable);
  Display* display = impl_->connection.Get();
  const KeyCode code = x11::RequireKeycode(display, virtualKey, extended, impl_->numLockOn);
  XTestFakeKeyEvent(display, code, down ? True : False, CurrentTime);
  XSync(display, False);
}

}  // namespace velkui::ui
