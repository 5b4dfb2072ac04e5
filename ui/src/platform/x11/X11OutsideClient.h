#pragma once

#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include <velkcore/Geometry.h>
#include <velkui/ui/PlatformTypes.h>

namespace velkui::ui {

class X11Platform;

// A second client of the X server the backend talks to, for tests and tools.
// It reads what a window manager reads of the backend's windows, and sends
// synthetic input (XTest) as another process would: that input reaches the
// backend through the server, and wakes a loop that waits in poll().
//
// Create it on the thread that runs the platform; afterwards it may be used
// from one other thread (it shares nothing with the backend's connection).
// This header has no X11 types.
class X11OutsideClient {
 public:
  // What a window manager learns of a top-level window from its properties.
  struct WindowHints {
    // WM_TRANSIENT_FOR; kNoPlatformWindow when not set.
    PlatformWindow transientFor = kNoPlatformWindow;
    // Atom names of _NET_WM_WINDOW_TYPE and _NET_WM_STATE, in order.
    std::vector<std::string> types;
    std::vector<std::string> states;
    // Atom names of WM_PROTOCOLS.
    std::vector<std::string> protocols;
    // WM_HINTS: whether the window takes the keyboard focus, and its group.
    bool acceptsFocus = false;
    PlatformWindow group = kNoPlatformWindow;
    // WM_CLIENT_LEADER; kNoPlatformWindow when not set.
    PlatformWindow clientLeader = kNoPlatformWindow;
    // _MOTIF_WM_HINTS: the close function offered (the close box).
    bool closable = false;
  };

  // Connects to the display of `platform` (the "backend unavailable" error
  // when that fails). The lock state of Num Lock is taken from it now.
  explicit X11OutsideClient(const X11Platform& platform);
  ~X11OutsideClient();
  X11OutsideClient(const X11OutsideClient&) = delete;
  X11OutsideClient& operator=(const X11OutsideClient&) = delete;

  WindowHints ReadHints(PlatformWindow window) const;
  // Removes a property of a window, as a window manager does with
  // _NET_WM_STATE when a window is withdrawn.
  void DeleteProperty(PlatformWindow window, std::string_view name);
  // Gives the server's keyboard focus to a window, as a window manager does
  // when the user clicks it.
  void FocusWindow(PlatformWindow window);

  // Plays the desktop's settings manager: owns _XSETTINGS_S<screen> with a
  // window of its own whose _XSETTINGS_SETTINGS property holds `property` (the
  // bytes as a manager writes them), announced to the root the first time.
  // Called again, it replaces the property, as a manager does on a change.
  void PublishSettings(std::span<const std::uint8_t> property);
  // Ends the manager: its window goes, and the selection with it.
  void WithdrawSettings();

  // Replaces the resources a display hands to the connections opened after
  // this (RESOURCE_MANAGER on the root, in Xrm's text form); empty text removes them.
  void SetResources(std::string_view text);

  // Synthetic input, each sent and handled by the server before it returns.
  // The same arguments and errors as X11Platform's.
  void InjectPointerMove(const velkcore::PointT<std::int32_t>& screenPoint);
  void InjectButton(std::int32_t button, bool down);
  void InjectKey(std::int16_t virtualKey, bool extended, bool down);

 private:
  struct Impl;
  std::unique_ptr<Impl> impl_;
};

}  // namespace velkui::ui
