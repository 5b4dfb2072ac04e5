#include <velkui/ui/OS_ViewContainer.h>

#include "NodeHold.h"

namespace velkui::ui {

OS_ViewContainer::OS_ViewContainer(bool doubleBuffered) {
  UI_SetNodeID("OS_ViewContainer");
  SetPaintsBuffered(doubleBuffered);
}

OS_ViewContainer::~OS_ViewContainer() = default;

void OS_ViewContainer::UI_SynchronizeParent() {
  if (GetPlatformWindow(false) == kNoPlatformWindow && IsEmbedded()) {
    const PlatformWindow host = GetHostPlatformWindow();
    if (host == kNoPlatformWindow) return;
    const NodeP keep = detail::Hold(this);
    CreatePlatformWindow(host, GetEmbeddedScreenRect());
  }
  OS_Window::UI_SynchronizeParent();
}

void OS_ViewContainer::CreatePlatformWindow(PlatformWindow host,
                                            const velkcore::RectT<std::int32_t>& screenRect) {
  UI_CreateWindow({}, host, screenRect, kStyleChild | kStyleClipSiblings, 0);
}

OS_PopupViewContainer::OS_PopupViewContainer(bool doubleBuffered)
    : OS_ViewContainer(doubleBuffered) {
  UI_SetNodeID("OS_PopupViewContainer");
}

OS_PopupViewContainer::~OS_PopupViewContainer() = default;

void OS_PopupViewContainer::CreatePlatformWindow(PlatformWindow host,
                                                 const velkcore::RectT<std::int32_t>& screenRect) {
  // Owned by the tree's top-level window.
  auto* top = dynamic_cast<OS_Window*>(UI_GetRootNode());
  const PlatformWindow owner = top != nullptr ? top->GetPlatformWindow(false) : host;
  UI_CreateWindow({}, owner, screenRect, kStylePopup | kStyleClipSiblings,
                  kExStyleToolWindow | kExStyleNoActivate);
}

}  // namespace velkui::ui
