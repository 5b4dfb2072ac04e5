#include <velkui/ui/UI_SubWindowView.h>

#include <velkcore/Error.h>
#include <velkui/ui/MouseEvent.h>

#include "NodeGeometry.h"
#include "NodeHold.h"

namespace velkui::ui {

using velkcore::PointT;

// ---- SubWindow ----

SubWindow::SubWindow() {
  UI_SetNodeID("SubWindow");
}

SubWindow::~SubWindow() = default;

UI_Node* SubWindow::GetProxyOrParent() const {
  return proxy_ != nullptr ? proxy_ : UI_GetParentNode();
}

UI_Node* SubWindow::UI_GetMouseProxy(MouseEvent*) {
  UI_Node* target = GetProxyOrParent();
  return target != nullptr ? target : this;
}

PointT<float> SubWindow::ToProxy(const PointT<float>& point) const {
  const UI_Node* proxy = GetProxyOrParent();
  if (proxy == nullptr) return point;
  const PointT<float> global = UI_GetSelfToRootMatrix().Transform(point);
  return detail::InverseTransform(proxy->UI_GetSelfToRootMatrix(), global).value_or(point);
}

bool SubWindow::UI_WantsDragDropEvents() const {
  const UI_Node* proxy = GetProxyOrParent();
  return proxy != nullptr && proxy->UI_WantsDragDropEvents();
}

bool SubWindow::UI_HandleDragEnter(const PointT<float>& point, datatransfer::OS_ReceiveData& data,
                                   std::int32_t& effect) {
  UI_Node* proxy = GetProxyOrParent();
  return proxy != nullptr && proxy->UI_HandleDragEnter(ToProxy(point), data, effect);
}

bool SubWindow::UI_HandleDragOver(const PointT<float>& point, datatransfer::OS_ReceiveData& data,
                                  std::int32_t& effect) {
  UI_Node* proxy = GetProxyOrParent();
  return proxy != nullptr && proxy->UI_HandleDragOver(ToProxy(point), data, effect);
}

void SubWindow::UI_HandleDragLeave() {
  if (UI_Node* proxy = GetProxyOrParent()) proxy->UI_HandleDragLeave();
}

bool SubWindow::UI_HandleDrop(const PointT<float>& point, datatransfer::OS_ReceiveData& data,
                              std::int32_t& effect) {
  UI_Node* proxy = GetProxyOrParent();
  return proxy != nullptr && proxy->UI_HandleDrop(ToProxy(point), data, effect);
}

// ---- UI_SubWindowView ----

UI_SubWindowView::UI_SubWindowView(std::shared_ptr<SubWindowFactory> factory) {
  UI_SetNodeID("UI_SubWindowView");
  subWindow_ = factory && *factory ? (*factory)(this) : velkcore::MakeIntrusive<SubWindow>();
  velkcore::RequireInput(subWindow_ != nullptr);
  subWindow_->UI_Show(true);
  ChildPushBack(subWindow_);
}

UI_SubWindowView::~UI_SubWindowView() {
  if (subWindow_ && subWindow_->GetProxy() == this) subWindow_->SetProxy(nullptr);
}

void UI_SubWindowView::SyncSubWindowBounds() {
  const velkcore::RectT<float> bounds = UI_GetLocalRectF(false);
  subWindow_->UI_SetLocalRectF(bounds);
}

void UI_SubWindowView::CheckRootWindowChanged() {
  const auto* hostWindow = dynamic_cast<const OS_Window*>(UI_GetParentEventRecipientNode());
  const PlatformWindow host = hostWindow != nullptr
                                  ? const_cast<OS_Window*>(hostWindow)->GetPlatformWindow(false)
                                  : kNoPlatformWindow;
  if (host == lastHost_ && subWindow_->GetPlatformWindow(false) != kNoPlatformWindow) return;
  lastHost_ = host;
  subWindow_->UI_SynchronizeParent();
}

void UI_SubWindowView::UI_SetLocalRectF(const velkcore::RectT<float>& rect) {
  const NodeP keep = detail::Hold(this);
  UI_SubView::UI_SetLocalRectF(rect);
  SyncSubWindowBounds();
}

void UI_SubWindowView::UI_Show(bool show) {
  const NodeP keep = detail::Hold(this);
  UI_SubView::UI_Show(show);
  subWindow_->UI_SynchronizeParent();
}

void UI_SubWindowView::UI_NodeChanged(NodeChange change) {
  UI_SubView::UI_NodeChanged(change);
  if (change == NodeChange::kParentChanged || change == NodeChange::kWindowMembershipChanged) {
    CheckRootWindowChanged();
  }
}

}  // namespace velkui::ui
