#pragma once

#include <velkui/ui/OS_Window.h>

namespace velkui::ui {

// A platform child window inside a node tree: a child node whose frame (in
// its parent node's coordinates) the platform window follows inside the
// hosting window, shown while the node and its ancestors are. The platform
// window is made once the node sits in a window that has one.
class OS_ViewContainer : public OS_Window {
 public:
  explicit OS_ViewContainer(bool doubleBuffered = false);
  ~OS_ViewContainer() override;

  bool UI_GetDoubleBuffered() const { return GetPaintsBuffered(); }
  void UI_SynchronizeParent() override;

 protected:
  // Makes the platform window for the host `host` over `screenRect`.
  virtual void CreatePlatformWindow(PlatformWindow host,
                                    const velkcore::RectT<std::int32_t>& screenRect);
};

// The pop-up form: a platform pop-up (above the other windows, not clipped
// by the host) that follows the node's frame on screen.
class OS_PopupViewContainer : public OS_ViewContainer {
 public:
  explicit OS_PopupViewContainer(bool doubleBuffered = false);
  ~OS_PopupViewContainer() override;

 protected:
  void CreatePlatformWindow(PlatformWindow host,
                            const velkcore::RectT<std::int32_t>& screenRect) override;
};

using OS_ViewContainerP = boost::intrusive_ptr<OS_ViewContainer>;

}  // namespace velkui::ui
