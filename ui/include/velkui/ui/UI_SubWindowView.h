#pragma once

#include <functional>
#include <memory>

#include <boost/intrusive_ptr.hpp>

#include <velkui/ui/OS_ViewContainer.h>
#include <velkui/ui/UI_SubView.h>

namespace velkui::ui {

// A platform child window owned by a UI_SubWindowView (video, an OpenGL view,
// a host's own drawing). Mouse input and drag-and-drop over it go to a proxy
// node (by default the view that owns it), so that the tree around it handles
// them as if the child window were not there.
class SubWindow : public OS_ViewContainer {
 public:
  SubWindow();
  ~SubWindow() override;

  // The node that receives this window's mouse and drag-and-drop events; null:
  // the parent node. Held by plain pointer: it must outlive the window or be reset.
  void SetProxy(UI_Node* proxy) { proxy_ = proxy; }
  UI_Node* GetProxy() const { return proxy_; }
  UI_Node* GetProxyOrParent() const;

  UI_Node* UI_GetMouseProxy(MouseEvent* event) override;
  bool UI_WantsDragDropEvents() const override;
  bool UI_HandleDragEnter(const velkcore::PointT<float>& point, datatransfer::OS_ReceiveData& data,
                          std::int32_t& effect) override;
  bool UI_HandleDragOver(const velkcore::PointT<float>& point, datatransfer::OS_ReceiveData& data,
                         std::int32_t& effect) override;
  void UI_HandleDragLeave() override;
  bool UI_HandleDrop(const velkcore::PointT<float>& point, datatransfer::OS_ReceiveData& data,
                     std::int32_t& effect) override;

 private:
  // `point` (this window's coordinates) in the proxy's.
  velkcore::PointT<float> ToProxy(const velkcore::PointT<float>& point) const;

  UI_Node* proxy_ = nullptr;
};

using SubWindowP = boost::intrusive_ptr<SubWindow>;

// A sub-view that owns a SubWindow, made by a factory, as its child: the
// window covers the view, is shown with it and moves into the platform window
// of whatever window the view is put in.
class UI_SubWindowView : public UI_SubView {
 public:
  using SubWindowFactory = std::function<SubWindowP(UI_SubWindowView* view)>;

  // A null factory makes a plain SubWindow. The factory must not answer null.
  explicit UI_SubWindowView(std::shared_ptr<SubWindowFactory> factory = {});
  ~UI_SubWindowView() override;

  SubWindow* GetSubWindow() const { return subWindow_.get(); }

  // The child window covers the view.
  void SyncSubWindowBounds();
  // Follows the view into another window (or out of any).
  void CheckRootWindowChanged();

  void UI_SetLocalRectF(const velkcore::RectT<float>& rect) override;
  void UI_Show(bool show) override;
  void UI_NodeChanged(NodeChange change) override;

 private:
  SubWindowP subWindow_;
  PlatformWindow lastHost_ = kNoPlatformWindow;
};

}  // namespace velkui::ui
