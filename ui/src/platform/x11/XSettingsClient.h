#pragma once

#include "X11Connection.h"
#include "X11Headers.h"
#include "XSettingsParser.h"

namespace velkui::ui::x11 {

// Follows the XSETTINGS manager of the connection's screen: the owner of
// _XSETTINGS_S<screen>, whose window carries the settings. They are read again
// when the manager changes them, goes away, or a new one announces itself
// (the MANAGER message, which reaches us only if the root reports
// StructureNotify to this client).
class XSettingsClient {
 public:
  explicit XSettingsClient(const X11Connection& connection);

  // Finds the current manager, watches its window and reads its settings.
  void Refresh();
  // Whether `event` is about the manager; the settings are up to date after it.
  bool HandleEvent(const XEvent& event);
  // Empty when there is no manager or its property cannot be decoded.
  const XSettings& Settings() const { return settings_; }

 private:
  void ReadSettings();

  const X11Connection& connection_;
  Atom selection_ = None;
  Atom property_ = None;
  Atom managerMessage_ = None;
  Window owner_ = None;
  XSettings settings_;
};

}  // namespace velkui::ui::x11
