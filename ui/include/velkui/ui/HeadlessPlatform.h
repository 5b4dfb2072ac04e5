#pragma once

#include <cstdint>
#include <filesystem>
#include <memory>
#include <optional>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include <velkui/pictel/ImageInterface.h>
#include <velkui/ui/Platform.h>

namespace velkui::ui {

// The deterministic backend: windows are records in memory painted into
// Cairo image surfaces, time is a virtual clock that only the caller moves,
// input comes from a queue that the caller fills with native-level events
// (pointer moves, button presses, key presses) which then take the same road
// as real input, monitors, key state and double-click metrics are settable,
// and the clipboard lives in the process. GetNextEvent never blocks: a modal
// loop ends when the queue is empty.
//
// Decoration: a window with a caption has a 24-pixel title bar and a 1-pixel
// border (4 pixels with a sizing frame); other windows have none.
class HeadlessPlatform : public Platform {
 public:
  // One monitor of 1440 × 900 at (0, 0) with a 40-pixel panel at the bottom;
  // double clicks within 500 ms and 4 × 4 pixels; the pointer at (0, 0); the clock at 0.
  HeadlessPlatform();
  ~HeadlessPlatform() override;

  // The installed platform as the headless backend (the invalid-type-conversion
  // error when another backend is installed).
  static HeadlessPlatform& Get();

  // ---- Clock ----
  // Moves the clock only; due timers tick when messages are next taken.
  void AdvanceTime(double seconds);
  // Runs the application for `seconds` of virtual time: the clock moves from
  // one due timer to the next and every message is dispatched on the way.
  void RunFor(double seconds);
  // Dispatches every waiting message (and due timer, and paint) at the
  // current time. Answers false when a quit request was taken. The platform
  // must be the installed one. A queue that never runs dry (a handler that
  // keeps posting, a node that invalidates itself while it paints) raises an
  // error after the message limit (100000 by default) instead of hanging.
  bool ProcessEvents();
  void SetMessageLimit(std::int64_t limit);

  // ---- Native-level input ----
  void MovePointer(const velkcore::PointT<std::int32_t>& screenPoint);
  // `button`: 1 left, 2 middle, 4 right.
  void PressButton(std::int32_t button);
  void ReleaseButton(std::int32_t button);
  // Press and release.
  void Click(std::int32_t button = 1);
  void TurnWheel(std::int32_t delta, bool horizontal = false);
  // A key by virtual key. vk::kLeftShift..vk::kRightAlt press one side of a
  // modifier; the generic kShift, kControl, kAlt press the left one unless
  // `extended` (the right Control and Alt keys are extended keys). Pressing a
  // key that is down already repeats it.
  void PressKey(std::int16_t virtualKey, bool extended = false);
  void ReleaseKey(std::int16_t virtualKey, bool extended = false);
  // Press and release.
  void TypeKey(std::int16_t virtualKey, bool extended = false);
  // The state of a key as the next message will see it (lock keys: toggled).
  void SetKeyState(std::int16_t virtualKey, KeyState state);
  void SetDoubleClickTime(std::uint32_t milliseconds);
  void SetDoubleClickSize(std::int32_t width, std::int32_t height);

  // ---- Window manager ----
  // The user drags the frame: the client area takes the new size and the
  // window gets kMsgSize (and kMsgMove when its origin moved).
  void UserSetClientRect(PlatformWindow window, const velkcore::RectT<std::int32_t>& screenRect);
  // The user clicks the close box.
  void UserClose(PlatformWindow window);
  // The user switches to another application.
  void DeactivateApplication();
  // Replaces the monitors and tells every top-level window (kMsgDisplayChange).
  void SetMonitors(std::vector<MonitorDescription> monitors);

  // ---- Inspection ----
  // Top-level windows from bottom to top; each followed by its children.
  std::vector<PlatformWindow> GetWindows() const;
  std::uint32_t GetWindowStyle(PlatformWindow window) const;
  std::uint32_t GetWindowExStyle(PlatformWindow window) const;
  float GetWindowOpacity(PlatformWindow window) const;
  // The pending paint area's bounds (client pixels), empty when none.
  velkcore::RectT<std::int32_t> GetPendingPaintBounds(PlatformWindow window) const;
  // How many times the window was painted.
  std::int32_t GetPaintCount(PlatformWindow window) const;
  // A copy of the window's client pixels (platform-supplier image).
  boost::intrusive_ptr<pictel::ImageInterface> GetWindowImage(PlatformWindow window) const;
  // The screen as the user would see it: the desktop of every monitor with
  // the shown windows composited in their stacking order, decoration included.
  boost::intrusive_ptr<pictel::ImageInterface> RenderScreen() const;
  // Timers of a window that are running, and the time of their next tick.
  std::vector<std::pair<std::uint32_t, double>> GetTimers(PlatformWindow window) const;
  // Messages waiting in the queue.
  std::size_t GetQueueLength() const;

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
