#pragma once

#include <memory>
#include <string>

#include <boost/intrusive_ptr.hpp>

#include <velkui/pictel/ImageInterface.h>
#include <velkui/ui/Platform.h>

namespace velkui::ui {

// The X11 backend: real windows on the X server named by DISPLAY (Xlib),
// painted through a back buffer with cairo-xlib, input translated from X
// events, timers served by the message loop (which sleeps in poll() on the
// connection until the next event or deadline), monitors from XRandR,
// synthetic input through XTest and the CLIPBOARD selection.
//
// Window-manager differences: with an EWMH window manager, activation goes
// through _NET_ACTIVE_WINDOW and the frame comes from _NET_FRAME_EXTENTS;
// without one (a bare Xvfb) the backend sets the input focus itself and
// windows have no frame.
//
// This header has no X11 types, so tests and benchmarks can reach the extras
// below without the window system's headers.
class X11Platform : public Platform {
 public:
  // Connects to DISPLAY; the "backend unavailable" error (103/20) when it cannot.
  X11Platform();
  ~X11Platform() override;

  // The installed platform as the X11 backend (the invalid-type-conversion
  // error when another backend is installed).
  static X11Platform& Get();

  // ---- Extras for tests, benchmarks and tools ----
  // Sleeps until the connection or a timer has something, at most `seconds`;
  // true when something arrived. Never spins.
  bool WaitForActivity(double seconds);
  // Sends what is buffered and waits until the server has handled it, so that
  // the events it caused are waiting.
  void Sync();
  // The pixels the X server shows in the window's client area (XGetImage).
  boost::intrusive_ptr<pictel::ImageInterface> CaptureWindowPixels(PlatformWindow window) const;
  // Moves and resizes a top-level window from a second connection, the way a
  // window manager or the user would: the change comes back as kMsgSize/kMsgMove.
  void ResizeFromOutside(PlatformWindow window, const velkcore::RectT<std::int32_t>& client);
  bool HasWindowManager() const;
  // The display the backend is connected to (":90", say).
  std::string GetDisplayName() const;
  std::int32_t GetPaintCount(PlatformWindow window) const;

  // ---- Platform ----
  std::string_view GetName() const override;
  PlatformWindow CreateWindow(const WindowCreateParams& params) override;
  void DestroyWindow(PlatformWindow window) override;
  bool IsWindow(PlatformWindow window) const override;
  void SetWindowTitle(PlatformWindow window, const velkcore::UTF16String& title) override;
  velkcore::UTF16String GetWindowTitle(PlatformWindow window) const override;
  void ShowWindow(PlatformWindow window, bool show, bool activate) override;
  bool IsWindowVisible(PlatformWindow window) const override;
  void MinimizeWindow(PlatformWindow window, bool minimize) override;
  bool IsWindowMinimized(PlatformWindow window) const override;
  void ActivateWindow(PlatformWindow window, bool byClick) override;
  PlatformWindow GetActiveWindow() const override;
  void EnableWindow(PlatformWindow window, bool enable) override;
  bool IsWindowEnabled(PlatformWindow window) const override;
  void SetWindowOpacity(PlatformWindow window, float opacity) override;
  void SetTransparentColorKey(PlatformWindow window,
                              const std::optional<pictel::ColorRGBA>& key) override;
  void SetWindowParent(PlatformWindow window, PlatformWindow parent) override;
  PlatformWindow GetWindowParent(PlatformWindow window) const override;
  velkcore::RectT<std::int32_t> GetClientRect(PlatformWindow window) const override;
  void SetClientRect(PlatformWindow window, const velkcore::RectT<std::int32_t>& rect) override;
  velkcore::RectT<std::int32_t> GetFrameRect(PlatformWindow window) const override;
  void SetFrameRect(PlatformWindow window, const velkcore::RectT<std::int32_t>& rect) override;
  void InvalidateRect(PlatformWindow window,
                      const velkcore::RectT<std::int32_t>* clientRect) override;
  bool HasPendingPaint(PlatformWindow window) const override;
  std::optional<PaintTarget> BeginPaint(PlatformWindow window) override;
  void EndPaint(PlatformWindow window, const PaintTarget& target) override;
  void SetCapture(PlatformWindow window) override;
  void ReleaseCapture() override;
  PlatformWindow GetCapture() const override;
  void SetFocus(PlatformWindow window) override;
  PlatformWindow GetFocus() const override;
  velkcore::PointT<std::int32_t> GetPointerPosition() const override;
  PlatformWindow GetWindowFromPoint(
      const velkcore::PointT<std::int32_t>& screenPoint) const override;
  void TrackPointerLeave(PlatformWindow window) override;
  bool HasPendingPointerMove(PlatformWindow window) const override;
  bool RemovePendingCharacter(char16_t character) override;
  KeyState GetKeyState(std::int16_t virtualKey) const override;
  std::int16_t MapScanCodeToVirtualKey(std::uint32_t scanCode) const override;
  char16_t GetUnshiftedCharacter(std::int16_t virtualKey) const override;
  std::uint32_t GetDoubleClickTime() const override;
  velkcore::PointT<std::int32_t> GetDoubleClickSize() const override;
  void SetCursor(CursorShape shape) override;
  CursorShape GetCursor() const override;
  double GetTime() const override;
  void SetTimer(PlatformWindow window, std::uint32_t id, std::uint32_t milliseconds) override;
  void KillTimer(PlatformWindow window, std::uint32_t id) override;
  std::vector<MonitorDescription> GetMonitors() const override;
  bool GetNextEvent(OS_Event& event, bool wait) override;
  void TranslateEvent(const OS_Event& event) override;
  void PostEvent(const OS_Event& event) override;
  void PostQuit(std::int32_t exitCode) override;
  void SetClipboard(std::vector<ClipboardItem> items) override;
  std::optional<std::string> GetClipboard(std::string_view type) const override;
  std::vector<std::string> GetClipboardTypes() const override;
  void InjectPointerMove(const velkcore::PointT<std::int32_t>& screenPoint) override;
  void InjectButton(std::int32_t button, bool down) override;
  void InjectWheel(std::int32_t delta, bool horizontal) override;
  void InjectKey(std::int16_t virtualKey, bool extended, bool down) override;

 private:
  struct Impl;
  std::unique_ptr<Impl> impl_;
};

}  // namespace velkui::ui
