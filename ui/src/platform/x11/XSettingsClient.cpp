#include "XSettingsClient.h"

#include <string>

namespace velkui::ui::x11 {

namespace {

// Far more than any desktop publishes (in 32-bit units, as Xlib counts).
constexpr long kMaxPropertyLength = 1L << 18;

}  // namespace

XSettingsClient::XSettingsClient(const X11Connection& connection)
    : connection_(connection),
      selection_(connection.Intern("_XSETTINGS_S" + std::to_string(connection.Screen()))),
      property_(connection.Intern("_XSETTINGS_SETTINGS")),
      managerMessage_(connection.Intern("MANAGER")) {}

void XSettingsClient::Refresh() {
  Display* display = connection_.Get();
  // With the server grabbed, the owner cannot go away before we watch its window.
  XGrabServer(display);
  owner_ = XGetSelectionOwner(display, selection_);
  if (owner_ != None) XSelectInput(display, owner_, StructureNotifyMask | PropertyChangeMask);
  XUngrabServer(display);
  XFlush(display);
  ReadSettings();
}

bool XSettingsClient::HandleEvent(const XEvent& event) {
  switch (event.type) {
    case ClientMessage:
      if (event.xclient.window != connection_.Root() ||
          event.xclient.message_type != managerMessage_ || event.xclient.format != 32 ||
          static_cast<Atom>(event.xclient.data.l[1]) != selection_) {
        return false;
      }
      Refresh();
      return true;
    case PropertyNotify:
      if (owner_ == None || event.xproperty.window != owner_ || event.xproperty.atom != property_) {
        return false;
      }
      ReadSettings();
      return true;
    case DestroyNotify:
      if (owner_ == None || event.xdestroywindow.window != owner_) return false;
      Refresh();
      return true;
    default:
      return false;
  }
}

void XSettingsClient::ReadSettings() {
  settings_ = {};
  if (owner_ == None) return;
  Atom type = None;
  int format = 0;
  unsigned long count = 0;
  unsigned long after = 0;
  unsigned char* data = nullptr;
  // A window destroyed meanwhile fails here (the error is recorded, not
  // fatal); its DestroyNotify follows.
  const int status = XGetWindowProperty(connection_.Get(), owner_, property_, 0, kMaxPropertyLength,
                                        False, property_, &type, &format, &count, &after, &data);
  if (status == Success && data != nullptr && type == property_ && format == 8 && after == 0) {
    if (auto parsed = ParseXSettings({data, count})) settings_ = std::move(*parsed);
  }
  if (data != nullptr) XFree(data);
}

}  // namespace velkui::ui::x11
