#pragma once

#include <cstdint>

#include <velkcore/Geometry.h>
#include <velkcore/Strings.h>
#include <velkui/ui/PlatformTypes.h>

namespace velkui::ui {

// What the library asks of any top-level window, whatever node implements it.
class UI_Window {
 public:
  virtual ~UI_Window();

  // ---- Virtual operations, in slot order ----
  // The platform window; with `create`, made now when there is none yet.
  virtual PlatformWindow GetPlatformWindow(bool create) = 0;
  virtual PlatformMenu GetPlatformMenu() const = 0;
  virtual void UI_SetTitle(const velkcore::UTF16String& title) = 0;
  virtual bool UI_IsMinimized() const = 0;
  virtual void UI_Minimize(bool minimize) = 0;
  // Whether the window is handling a close request right now.
  virtual bool UI_DuringClose() const = 0;
  // Asks the window to close once the current message is handled.
  virtual void UI_PostClose() = 0;
  // The outer frame in screen coordinates.
  virtual velkcore::RectT<std::int32_t> UI_GetGlobalStructureRect() const = 0;
  virtual void UI_SetGlobalStructureRect(const velkcore::RectT<std::int32_t>& frame) = 0;
  // Moves the outer frame's top-left corner to `topLeft` (screen).
  virtual void UI_Move(const velkcore::PointT<std::int32_t>& topLeft) = 0;
  virtual void UI_Activate() = 0;

  // The window this one belongs to (dialogs, pop-ups); not owned.
  UI_Window* GetOwner() const { return owner_; }
  void SetOwner(UI_Window* owner);
  // Whether the window or one of its owners is the node manager's modal window.
  bool OwnedByModalWindow() const;

 private:
  UI_Window* owner_ = nullptr;
};

}  // namespace velkui::ui
