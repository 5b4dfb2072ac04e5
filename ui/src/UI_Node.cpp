#include <velkui/ui/UI_Node.h>

#include <stdexcept>

#include <velkcore/Error.h>
#include <velkui/pictel/CacheInterface.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SupplierInterface.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_NodeManager.h>
#include <velkui/ui/UI_SubView.h>

#include "NodeGeometry.h"
#include "NodeHold.h"

namespace velkui::ui {

using velkcore::PointT;
using velkcore::RectT;
using velkcore::ScaleMatrixT;

namespace {

constexpr std::string_view kParentNotFoundKey =
    "$$$/velkui/ui/Error/ParentNotFound=Parent not found.";
constexpr std::int32_t kParentNotFoundNumber = 7;

std::vector<NodeP> SnapshotChildren(const UI_Container& container) {
  return {container.ChildBegin(), container.ChildEnd()};
}

}  // namespace

UI_Node::UI_Node() : UI_NodeBase(this) {
  UI_InvalidatePictelCache(false);
}

UI_Node::~UI_Node() {
  dying_ = true;
  UI_RemoveAllTimers();
  if (UI_NodeManager* manager = UI_NodeManager::Get(false)) manager->NodeDestroyed(*this);
  DeleteChildren();
}

// ---- Virtual operations ----

bool UI_Node::UI_IsSubView() const {
  return false;
}

bool UI_Node::UI_HitTest(const PointT<float>& local) const {
  return UI_GetLocalRectF(false).Contains(local);
}

bool UI_Node::UI_AreAllParentsVisible() const {
  if (!UI_IsShown()) return false;
  const UI_Node* parent = UI_GetParentNode();
  return parent != nullptr && parent->UI_AreAllParentsVisible();
}

void UI_Node::UI_Invalidate(const RectT<std::int32_t>*, InvalidateFlags flags) {
  if (!flags.IsSet(kInvalidateKeepOwnCache)) UI_InvalidatePictelCache(false);
}

void UI_Node::UI_SetParent(UI_Container* parent) {
  parent_ = parent;
  const UI_Node* parentNode = UI_GetParentNode();
  UI_DispatchParentDisabledChange(this, parentNode != nullptr && parentNode->UI_IsDisabled());
}

bool UI_Node::UI_SupportsPictel() const {
  return false;
}

void UI_Node::UI_Draw(pictel::Pictel* context) const {
  DrawChildren(context);
}

bool UI_Node::UI_UsePictelCache(pictel::Pictel* context) const {
  switch (drawCachePolicy_) {
    case DrawCachePolicy::kNever:
      return false;
    case DrawCachePolicy::kAlways:
      return true;
    case DrawCachePolicy::kSurfaceDecides:
      break;
  }
  if (context == nullptr || context->GetSurface() == nullptr) return false;
  const pictel::SupplierInterface* supplier = context->GetSurface()->GetSupplier();
  return supplier != nullptr && supplier->PrefersToCacheAggressively();
}

void UI_Node::UI_GetDrawSegments(std::vector<RectT<std::int32_t>>&) const {}

const pictel::SupplierInterface* UI_Node::UI_GetDrawSupplier() const {
  const UI_Node* parent = UI_GetParentNode();
  return parent != nullptr ? parent->UI_GetDrawSupplier() : nullptr;
}

bool UI_Node::UI_DoPreMouseEvent(UI_Node*, const MouseEvent&) {
  return false;
}

bool UI_Node::UI_DoMouseEvent(UI_Node*, const MouseEvent&) {
  return false;
}

bool UI_Node::UI_DoMouseActivate() {
  return false;
}

bool UI_Node::UI_DoCursor(UI_Node*, const PointT<float>&, ModifierKeys) {
  return false;
}

bool UI_Node::UI_InvalidateOnMouseOverChange(bool) const {
  return false;
}

bool UI_Node::UI_IsMouseOver(bool leafOnly) const {
  if (!stateFlags_.IsSet(kStateMouseOver)) return false;
  if (!leafOnly) return true;
  const UI_NodeManager* manager = UI_NodeManager::GetConst(false);
  return manager != nullptr && manager->GetMouseOverLeafNode() == this;
}

bool UI_Node::UI_DoPreKeyboardEvent(UI_Node*, const KeyboardEvent&) {
  return false;
}

bool UI_Node::UI_DoKeyboardEvent(UI_Node*, const KeyboardEvent&) {
  return false;
}

bool UI_Node::UI_InvalidateOnKeyboardFocusChange(bool) const {
  return false;
}

bool UI_Node::UI_WantsKeyboardFocus() const {
  return false;
}

bool UI_Node::UI_GainKeyboardFocus() {
  return UI_GainKeyboardFocus(this);
}

void UI_Node::UI_PrepareForKeyboardFocusFromAdvance(UI_Node*) {}

bool UI_Node::UI_GainKeyboardFocusFromAdvance() {
  // Asking a node that does not want focus would hand the request to its parent.
  return UI_WantsKeyboardFocus() && UI_GainKeyboardFocus();
}

void UI_Node::UI_LoseKeyboardFocus() {
  UI_LoseKeyboardFocus(this);
}

void UI_Node::UI_UpdateKeyboardFocusStateDueToLoss() {
  if (UI_NodeManager* manager = UI_NodeManager::Get(false)) {
    manager->UpdateKeyboardFocusStateDueToLoss(*this);
  }
}

bool UI_Node::UI_HasKeyboardFocus(bool leafOnly) const {
  if (focusState_ == 0) return false;
  if (!leafOnly) return true;
  const UI_NodeManager* manager = UI_NodeManager::GetConst(false);
  return manager != nullptr && manager->GetKeyboardFocusLeafNode() == this;
}

bool UI_Node::UI_DoTimerNotify(std::int32_t id) {
  return timerNotify_ != nullptr && timerNotify_->CallUntilTrue(id);
}

velkcore::UTF16String UI_Node::UI_GetToolTip() {
  return toolTip_;
}

std::int32_t UI_Node::UI_GetToolTipWidth() const {
  return toolTipWidth_;
}

void UI_Node::UI_SetToolTip(const velkcore::UTF16String& text, std::int32_t width) {
  if (text == toolTip_) return;
  toolTip_ = text;
  toolTipWidth_ = width;
  if (UI_NodeManager* manager = UI_NodeManager::Get(false)) manager->ToolTipChanged(*this);
}

PointT<float> UI_Node::UI_GetRecommendedSize(pictel::Pictel*) {
  return {0.0f, 0.0f};
}

bool UI_Node::UI_WantsDragDropEvents() const {
  return false;
}

bool UI_Node::UI_HandleDragEnter(const PointT<float>&, datatransfer::OS_ReceiveData&,
                                 std::int32_t&) {
  return false;
}

bool UI_Node::UI_HandleDragOver(const PointT<float>&, datatransfer::OS_ReceiveData&,
                                std::int32_t&) {
  return false;
}

void UI_Node::UI_HandleDragLeave() {}

bool UI_Node::UI_HandleDrop(const PointT<float>&, datatransfer::OS_ReceiveData&, std::int32_t&) {
  return false;
}

void UI_Node::measure(orvant::extents_t&) {
  throw std::logic_error("You must override UI_Node::measure");
}

void UI_Node::measure_vertical(orvant::extents_t&, const orvant::place_data_t&) {
  throw std::logic_error("You must override UI_Node::measure_vertical");
}

void UI_Node::place(const orvant::place_data_t& placement) {
  placement_ = placement;
  placed_ = true;
  const orvant::place_slice_t& h = placement.horizontal_m;
  const orvant::place_slice_t& v = placement.vertical_m;
  UI_SetLocalRectF({static_cast<float>(h.position_m - h.outset_leading_m),
                    static_cast<float>(v.position_m - v.outset_leading_m),
                    static_cast<float>(h.length_m + h.outset_leading_m + h.outset_trailing_m),
                    static_cast<float>(v.length_m + v.outset_leading_m + v.outset_trailing_m)});
}

const orvant::place_data_t& UI_Node::get_placement() const {
  if (placed_) return placement_;
  const RectT<std::int32_t> frame = detail::RoundOut(UI_GetLocalRectF(true));
  framePlacement_ = {};
  framePlacement_.horizontal_m.position_m = frame.left;
  framePlacement_.horizontal_m.length_m = frame.width;
  framePlacement_.vertical_m.position_m = frame.top;
  framePlacement_.vertical_m.length_m = frame.height;
  return framePlacement_;
}

void UI_Node::UI_ActivationChanged(WindowActivation activation) {
  for (const NodeP& child : SnapshotChildren(*this)) child->UI_ActivationChanged(activation);
}

void UI_Node::UI_SizeChanged(const RectT<float>&) {}

void UI_Node::UI_DisabledStateChanged() {}

void UI_Node::UI_NodeChanged(NodeChange) {}

bool UI_Node::UI_DispatchCursor(const PointT<float>& point, ModifierKeys modifiers,
                                bool skipOSChildren) {
  UI_NodeManager* manager = UI_NodeManager::Get(false);
  return manager != nullptr && manager->DispatchCursor(*this, point, modifiers, skipOSChildren);
}

bool UI_Node::UI_DispatchKeyboardCharEventToParent() {
  return false;
}

void UI_Node::UI_GetOSControlClipRects(OSControlClipRects* rects) const {
  velkcore::RequireInput(rects != nullptr);
  CollectOSControlClipRects(ScaleMatrixT<float>{}, rects);
}

void UI_Node::CollectOSControlClipRects(const ScaleMatrixT<float>& toTop,
                                        OSControlClipRects* rects) const {
  for (const NodeP& child : SnapshotChildren(*this)) {
    if (!child->UI_IsShown()) continue;
    const ScaleMatrixT<float> childToTop = detail::Concat(toTop, child->UI_GetSelfToParentMatrix());
    if (child->UI_ReceivesEventsFromOS()) {
      rects->emplace_back(child.get(),
                          detail::TransformRect(childToTop, child->UI_GetLocalRectF(false)));
    } else {
      child->CollectOSControlClipRects(childToTop, rects);
    }
  }
}

void UI_Node::UI_MouseOverChanged() {}

void UI_Node::UI_FocusChanged() {}

void UI_Node::UI_ClearKeyboardFocusWithOS() {}

bool UI_Node::UI_IsPictelCacheValid(const pictel::SurfaceInterface& surface) const {
  if (!cache_) return false;
  if (GetThemeChangeCount() != cacheThemeChangeCount_) return false;
  return cache_->IsValid(surface, UI_GetLocalRectF(false));
}

UI_Node* UI_Node::UI_GetMouseProxy(MouseEvent*) {
  return this;
}

UI_NodeTimerManager* UI_Node::UI_GetTimerManager(bool create) {
  UI_Node* parent = UI_GetParentNode();
  return parent != nullptr ? parent->UI_GetTimerManager(create) : nullptr;
}

const UI_NodeTimerManager* UI_Node::UI_GetTimerManager(bool create) const {
  const UI_Node* parent = UI_GetParentNode();
  return parent != nullptr ? parent->UI_GetTimerManager(create) : nullptr;
}

bool UI_Node::UI_DisplaysToolTipForChild(const UI_Node*) const {
  return false;
}

// ---- Child list hooks ----

void UI_Node::ChildAdded(UI_Node*) {
  UI_Invalidate(nullptr, InvalidateFlags{});
}

void UI_Node::ChildRemoved(UI_Node*) {
  UI_Invalidate(nullptr, InvalidateFlags{});
}

void UI_Node::ChildOrderChanged() {
  UI_Invalidate(nullptr, InvalidateFlags{});
}

// ---- Tree ----

UI_Node* UI_Node::UI_GetParentNode() const {
  return parent_ != nullptr ? parent_->GetAsANode() : nullptr;
}

UI_Node* UI_Node::UI_GetRootNode() {
  UI_Node* node = this;
  while (UI_Node* parent = node->UI_GetParentNode()) node = parent;
  return node;
}

const UI_Node* UI_Node::UI_GetRootNode() const {
  return const_cast<UI_Node*>(this)->UI_GetRootNode();
}

UI_Container* UI_Node::UI_GetRootContainer() {
  UI_Container* container = this;
  for (;;) {
    UI_Node* node = container->GetAsANode();
    if (node == nullptr || node->parent_ == nullptr) return container;
    container = node->parent_;
  }
}

std::vector<UI_Node*> UI_Node::UI_GetNodeParents() const {
  std::vector<UI_Node*> parents;
  for (UI_Node* parent = UI_GetParentNode(); parent != nullptr;
       parent = parent->UI_GetParentNode()) {
    parents.push_back(parent);
  }
  return parents;
}

bool UI_Node::UI_IsChildOf(const UI_Node* ancestor) const {
  if (ancestor == nullptr) return false;
  for (const UI_Node* parent = UI_GetParentNode(); parent != nullptr;
       parent = parent->UI_GetParentNode()) {
    if (parent == ancestor) return true;
  }
  return false;
}

UI_Node* UI_Node::UI_GetParentEventRecipientNode() const {
  for (UI_Node* parent = UI_GetParentNode(); parent != nullptr;
       parent = parent->UI_GetParentNode()) {
    if (parent->UI_ReceivesEventsFromOS()) return parent;
  }
  return nullptr;
}

UI_Container::const_iterator UI_Node::UI_ChildFindFromID(const std::string& id) const {
  for (auto it = ChildBegin(); it != ChildEnd(); ++it) {
    if ((*it)->nodeID_ == id) return it;
  }
  return ChildEnd();
}

UI_Node* UI_Node::UI_ChildGetFromID(const std::string& id) const {
  const auto found = UI_ChildFindFromID(id);
  return found != ChildEnd() ? found->get() : nullptr;
}

// ---- State ----

void UI_Node::UI_GeometryChanged() const {
  if (parent_ == nullptr) return;
  parent_->InvalidateChildBox(index_);
  parent_->ChildGeometryChanged(*this);
}

void UI_Node::UI_SetDisabled(bool disabled) {
  if (stateFlags_.IsSet(kStateSelfDisabled) == disabled) return;
  stateFlags_.Set(kStateSelfDisabled, disabled);
  UI_DisabledStateChanged();
  for (const NodeP& child : SnapshotChildren(*this)) {
    // Read per child: a handler may have changed this node's state meanwhile.
    UI_DispatchParentDisabledChange(child.get(), UI_IsDisabled());
  }
}

void UI_Node::UI_DispatchParentDisabledChange(UI_Node* child, bool parentDisabled) {
  velkcore::RequireInput(child != nullptr);
  if (child->stateFlags_.IsSet(kStateParentDisabled) == parentDisabled) return;
  const NodeP keep = detail::Hold(child);
  child->stateFlags_.Set(kStateParentDisabled, parentDisabled);
  child->UI_DisabledStateChanged();
  if (child->stateFlags_.IsSet(kStateSelfDisabled)) return;
  for (const NodeP& grandChild : SnapshotChildren(*child)) {
    UI_DispatchParentDisabledChange(grandChild.get(), child->UI_IsDisabled());
  }
}

void UI_Node::UI_InstallTimerNotifyFunction(const std::shared_ptr<TimerNotifyFunction>& f) {
  if (!timerNotify_)
    timerNotify_ = std::make_unique<velkcore::SharedFunctions<bool(std::int32_t)>>();
  timerNotify_->Add(f);
}

void UI_Node::UI_RemoveTimerNotifyFunction(const std::shared_ptr<TimerNotifyFunction>& f) {
  if (timerNotify_) timerNotify_->Remove(f);
}

void UI_Node::UI_DispatchNodeChange(NodeChange change) {
  const NodeP keep = detail::Hold(this);
  UI_NodeChanged(change);
  for (const NodeP& child : SnapshotChildren(*this)) child->UI_DispatchNodeChange(change);
}

// ---- Custom functions ----

bool UI_Node::CallCustomMouseFunction(const MouseEvent& event, bool* result) {
  if (!customMouse_) return false;
  // A copy: the function may replace itself.
  const std::shared_ptr<CustomMouseEventFunction> f = customMouse_;
  bool handled = false;
  const bool answer = (*f)(this, event, handled);
  if (!handled) return false;
  *result = answer;
  return true;
}

bool UI_Node::CallCustomKeyboardFunction(const KeyboardEvent& event, bool* result) {
  if (!customKeyboard_) return false;
  const std::shared_ptr<CustomKeyboardEventFunction> f = customKeyboard_;
  bool handled = false;
  const bool answer = (*f)(this, event, handled);
  if (!handled) return false;
  *result = answer;
  return true;
}

void UI_Node::NotifyFocusChanged() {
  UI_FocusChanged();
  if (focusChanged_) {
    const std::shared_ptr<FocusChangedFunction> f = focusChanged_;
    (*f)(this);
  }
}

// ---- Draw cache ----

void UI_Node::UI_InvalidatePictelCache(bool keepOwn) {
  const UI_NodeManager* manager = UI_NodeManager::GetConst(false);
  UI_Node* node = this;
  if (keepOwn) {
    // The node keeps its pixels, so it records nothing: a later invalidation
    // in this generation must still be able to drop them.
    node = UI_GetParentNode();
  }
  while (node != nullptr) {
    if (manager != nullptr) {
      const std::uint64_t seed = manager->GetPictelCacheSeed();
      if (node->cacheSeed_ == seed) return;
      node->cacheSeed_ = seed;
    }
    node->cache_.reset();
    node = node->UI_GetParentNode();
  }
}

// ---- Coordinates ----

ScaleMatrixT<float> UI_Node::UI_GetSelfToSpecificParentMatrix(const UI_Node* ancestor) const {
  ScaleMatrixT<float> result;
  const UI_Node* node = this;
  while (node != ancestor) {
    const UI_Node* parent = node->UI_GetParentNode();
    if (parent == nullptr) {
      if (ancestor == nullptr) break;
      velkcore::ThrowError(velkcore::ErrorLevel::kError, kParentNotFoundKey,
                           velkcore::kCategoryUserInterface, kParentNotFoundNumber);
    }
    result = detail::Concat(node->UI_GetSelfToParentMatrix(), result);
    node = parent;
  }
  return result;
}

ScaleMatrixT<float> UI_Node::UI_GetSelfToRootMatrix() const {
  return UI_GetSelfToSpecificParentMatrix(nullptr);
}

namespace {

// The inverse of a node-to-root matrix; raises the core's singular-matrix error.
ScaleMatrixT<float> Inverse(const ScaleMatrixT<float>& m) {
  if (m.sx == 0.0f || m.sy == 0.0f) velkcore::ThrowSingularMatrix();
  return {-m.tx / m.sx, -m.ty / m.sy, 1.0f / m.sx, 1.0f / m.sy};
}

}  // namespace

PointT<float> UI_Node::UI_LocalToGlobalF(const PointT<float>& p) const {
  return UI_GetSelfToRootMatrix().Transform(p);
}

PointT<float> UI_Node::UI_GlobalToLocalF(const PointT<float>& p) const {
  return Inverse(UI_GetSelfToRootMatrix()).Transform(p);
}

RectT<float> UI_Node::UI_LocalToGlobalF(const RectT<float>& r) const {
  return detail::TransformRect(UI_GetSelfToRootMatrix(), r);
}

RectT<float> UI_Node::UI_GlobalToLocalF(const RectT<float>& r) const {
  return detail::TransformRect(Inverse(UI_GetSelfToRootMatrix()), r);
}

PointT<std::int32_t> UI_Node::UI_LocalToGlobal(const PointT<std::int32_t>& p) const {
  return detail::RoundPoint(
      UI_LocalToGlobalF(PointT<float>{static_cast<float>(p.x), static_cast<float>(p.y)}));
}

PointT<std::int32_t> UI_Node::UI_GlobalToLocal(const PointT<std::int32_t>& p) const {
  return detail::RoundPoint(
      UI_GlobalToLocalF(PointT<float>{static_cast<float>(p.x), static_cast<float>(p.y)}));
}

RectT<std::int32_t> UI_Node::UI_LocalToGlobal(const RectT<std::int32_t>& r) const {
  return detail::RoundOut(UI_LocalToGlobalF(detail::ToFloat(r)));
}

RectT<std::int32_t> UI_Node::UI_GlobalToLocal(const RectT<std::int32_t>& r) const {
  return detail::RoundOut(UI_GlobalToLocalF(detail::ToFloat(r)));
}

}  // namespace velkui::ui
