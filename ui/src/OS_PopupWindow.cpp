#include <velkui/ui/OS_PopupWindow.h>

#include <velkui/pictel/OSSupplier.h>

#include "NodeGeometry.h"

namespace velkui::ui {

OS_PopupWindow::OS_PopupWindow() {
  UI_SetNodeID("OS_PopupWindow");
  SetDrawSupplier(pictel::NewOSSupplier());
}

OS_PopupWindow::~OS_PopupWindow() = default;

void OS_PopupWindow::UI_CreatePopupWindow(const velkcore::RectT<float>& screenRect) {
  UI_CreateWindow({}, kNoPlatformWindow, detail::RoundOut(screenRect),
                  kStylePopup | kStyleClipSiblings,
                  kExStyleToolWindow | kExStyleTopmost | kExStyleNoActivate);
}

}  // namespace velkui::ui
