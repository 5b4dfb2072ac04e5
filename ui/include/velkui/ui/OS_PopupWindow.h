#pragma once

#include <velkcore/Geometry.h>
#include <velkui/ui/OS_Window.h>

namespace velkui::ui {

// A window without decoration above the ordinary windows that showing or
// clicking does not activate: tooltips, menus, drop-downs. It draws with its
// own drawing supplier.
class OS_PopupWindow : public OS_Window {
 public:
  OS_PopupWindow();
  ~OS_PopupWindow() override;

  // ---- Appended virtual operations, in slot order ----
  // Creates the platform window over `screenRect` (hidden until UI_Show).
  virtual void UI_CreatePopupWindow(const velkcore::RectT<float>& screenRect);
};

using OS_PopupWindowP = boost::intrusive_ptr<OS_PopupWindow>;

}  // namespace velkui::ui
