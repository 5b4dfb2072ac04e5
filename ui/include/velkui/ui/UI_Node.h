#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/SharedFunctions.h>
#include <velkcore/Strings.h>
#include <velkui/pictel/PictelTypes.h>
#include <velkui/ui/LayoutBridgeTypes.h>
#include <velkui/ui/NodeTypes.h>
#include <velkui/ui/UI_NodeBase.h>
#include <velkui/ui/UI_NodeTimerData.h>

namespace velkui::ui {

using NodeP = boost::intrusive_ptr<UI_Node>;

// The abstract node: a reference-counted object in one tree that owns its
// children, draws itself through a Pictel and answers the event hooks the node
// manager calls. Its virtual operations are listed in a fixed order that hosts
// and subclasses rely on; do not reorder them.
class UI_Node : public UI_NodeBase {
 public:
  using CustomDrawFunction = std::function<bool(const UI_Node*, pictel::Pictel*)>;
  using CustomMouseEventFunction = std::function<bool(UI_Node*, const MouseEvent&, bool& handled)>;
  using CustomKeyboardEventFunction =
      std::function<bool(UI_Node*, const KeyboardEvent&, bool& handled)>;
  using FocusChangedFunction = std::function<void(UI_Node*)>;
  using TimerNotifyFunction = std::function<bool(std::int32_t id)>;
  using ClientOSEventFunc = void (*)(OS_Event*);
  using OSControlClipRects = std::vector<std::pair<const UI_Node*, velkcore::RectT<float>>>;

  // Clears the node from every role the node manager keeps, then removes the children.
  ~UI_Node() override;

  // ---- Virtual operations, in slot order ----
  /* 1 */ virtual bool UI_IsSubView() const;
  /* 2 */ virtual velkcore::ScaleMatrixT<float> UI_GetSelfToParentMatrix() const = 0;
  // `local` is in the node's own coordinates. Only points inside the node's own
  // rectangle are asked about: an override may narrow the hit area, not widen it.
  /* 3 */ virtual bool UI_HitTest(const velkcore::PointT<float>& local) const;
  /* 4 */ virtual velkcore::RectT<std::int32_t> UI_GetLocalRect(bool inParent) const = 0;
  /* 5 */ virtual velkcore::RectT<float> UI_GetLocalRectF(bool inParent) const = 0;
  /* 6 */ virtual void UI_SetLocalRect(const velkcore::RectT<std::int32_t>& rect) = 0;
  /* 7 */ virtual void UI_SetLocalRectF(const velkcore::RectT<float>& rect) = 0;
  /* 8 */ virtual void UI_Show(bool show) = 0;
  /* 9 */ virtual bool UI_IsShown() const = 0;
  /* 10 */ virtual bool UI_AreAllParentsVisible() const;
  /* 11 */ virtual void UI_Invalidate(const velkcore::RectT<std::int32_t>* localOrNull,
                                      InvalidateFlags flags);
  /* 12 */ virtual void UI_UpdateNow(UpdateFlags flags) = 0;
  /* 13 */ virtual void UI_SetOpacity(float opacity) = 0;
  /* 14 */ virtual void UI_SetParent(UI_Container* parent);
  /* 15 */ virtual bool UI_SupportsPictel() const;
  /* 16 */ virtual void UI_Draw(pictel::Pictel* context) const;
  /* 17 */ virtual bool UI_UsePictelCache(pictel::Pictel* context) const;
  /* 18 */ virtual void UI_GetDrawSegments(
      std::vector<velkcore::RectT<std::int32_t>>& segments) const;
  /* 19 */ virtual const pictel::SupplierInterface* UI_GetDrawSupplier() const;
  /* 20 */ virtual bool UI_DoPreMouseEvent(UI_Node* target, const MouseEvent& event);
  /* 21 */ virtual bool UI_DoMouseEvent(UI_Node* target, const MouseEvent& event);
  /* 22 */ virtual bool UI_DoMouseActivate();
  /* 23 */ virtual bool UI_DoCursor(UI_Node* target, const velkcore::PointT<float>& point,
                                    ModifierKeys modifiers);
  /* 24 */ virtual bool UI_InvalidateOnMouseOverChange(bool isLeaf) const;
  /* 25 */ virtual bool UI_IsMouseOver(bool leafOnly) const;
  /* 26 */ virtual bool UI_DoPreKeyboardEvent(UI_Node* target, const KeyboardEvent& event);
  /* 27 */ virtual bool UI_DoKeyboardEvent(UI_Node* target, const KeyboardEvent& event);
  /* 28 */ virtual bool UI_InvalidateOnKeyboardFocusChange(bool isLeaf) const;
  /* 29 */ virtual bool UI_WantsKeyboardFocus() const;
  /* 30 */ virtual bool UI_GainKeyboardFocus();
  /* 31 */ virtual void UI_PrepareForKeyboardFocusFromAdvance(UI_Node* previous);
  /* 32 */ virtual bool UI_GainKeyboardFocusFromAdvance();
  /* 33 */ virtual void UI_LoseKeyboardFocus();
  /* 34 */ virtual void UI_UpdateKeyboardFocusStateDueToLoss();
  /* 35 */ virtual bool UI_HasKeyboardFocus(bool leafOnly) const;
  /* 36 */ virtual bool UI_DoTimerNotify(std::int32_t id);
  /* 37 */ virtual void UI_SetCapture() = 0;
  /* 38 */ virtual void UI_ReleaseCapture() = 0;
  /* 39 */ virtual bool UI_ReceivesEventsFromOS() const = 0;
  /* 40 */ virtual velkcore::UTF16String UI_GetToolTip();
  /* 41 */ virtual std::int32_t UI_GetToolTipWidth() const;
  /* 42 */ virtual void UI_SetToolTip(const velkcore::UTF16String& text, std::int32_t width);
  /* 43 */ virtual velkcore::PointT<float> UI_GetRecommendedSize(pictel::Pictel* context);
  /* 44 */ virtual bool UI_WantsDragDropEvents() const;
  /* 45 */ virtual bool UI_HandleDragEnter(const velkcore::PointT<float>& point,
                                           datatransfer::OS_ReceiveData& data,
                                           std::int32_t& effect);
  /* 46 */ virtual bool UI_HandleDragOver(const velkcore::PointT<float>& point,
                                          datatransfer::OS_ReceiveData& data, std::int32_t& effect);
  /* 47 */ virtual void UI_HandleDragLeave();
  /* 48 */ virtual bool UI_HandleDrop(const velkcore::PointT<float>& point,
                                      datatransfer::OS_ReceiveData& data, std::int32_t& effect);
  /* 49 */ virtual void measure(orvant::extents_t& extents);
  /* 50 */ virtual void measure_vertical(orvant::extents_t& extents,
                                         const orvant::place_data_t& placement);
  /* 51 */ virtual void place(const orvant::place_data_t& placement);
  /* 52 */ virtual const orvant::place_data_t& get_placement() const;
  /* 53 */ virtual void UI_ActivationChanged(WindowActivation activation);
  /* 54 */ virtual void UI_SizeChanged(const velkcore::RectT<float>& newLocalRect);
  /* 55 */ virtual void UI_DisabledStateChanged();
  /* 56 */ virtual void UI_NodeChanged(NodeChange change);
  /* 57 */ virtual void UI_HandleOSEvent(OS_Event* event) = 0;
  /* 58 */ virtual bool UI_DispatchCursor(const velkcore::PointT<float>& point,
                                          ModifierKeys modifiers, bool skipOSChildren);
  /* 59 */ virtual bool UI_DispatchEvent(OS_Event* event) = 0;
  /* 60 */ virtual bool UI_DispatchKeyboardCharEventToParent();
  // Rectangles in this node's coordinates of the shown descendants that own platform controls.
  /* 61 */ virtual void UI_GetOSControlClipRects(OSControlClipRects* rects) const;
  /* 62 */ virtual void UI_MouseOverChanged();
  /* 63 */ virtual void UI_FocusChanged();
  /* 64 */ virtual void UI_SetKeyboardFocusWithOS() = 0;
  /* 65 */ virtual void UI_ClearKeyboardFocusWithOS();
  /* 66 */ virtual bool UI_IsPictelCacheValid(const pictel::SurfaceInterface& surface) const;
  /* 67 */ virtual UI_Node* UI_GetMouseProxy(MouseEvent* event);
  /* 68 */ virtual UI_NodeTimerManager* UI_GetTimerManager(bool create);
  /* 69 */ virtual const UI_NodeTimerManager* UI_GetTimerManager(bool create) const;
  /* 70 */ virtual bool UI_DisplaysToolTipForChild(const UI_Node* child) const;

  // ---- Child list hooks: each invalidates the whole node ----
  void ChildAdded(UI_Node* node) override;
  void ChildRemoved(UI_Node* node) override;
  void ChildOrderChanged() override;

  // ---- Tree ----
  // The parent when it is a node (a bare container does not count).
  UI_Node* UI_GetParentNode() const;
  UI_Container* UI_GetParentContainer() const { return parent_; }
  // The topmost node above this one (this node when it has no parent node).
  UI_Node* UI_GetRootNode();
  const UI_Node* UI_GetRootNode() const;
  // The outermost container, which may be a bare container.
  UI_Container* UI_GetRootContainer();
  // Ancestors, nearest first.
  std::vector<UI_Node*> UI_GetNodeParents() const;
  // True when `ancestor` is above this node.
  bool UI_IsChildOf(const UI_Node* ancestor) const;
  std::int32_t UI_GetIndex() const { return index_; }
  void UI_SetIndex(std::int32_t index) { index_ = index; }
  // The nearest ancestor that owns a platform window, or null.
  UI_Node* UI_GetParentEventRecipientNode() const;
  // Direct children only; the first exact match in z-order.
  const_iterator UI_ChildFindFromID(const std::string& id) const;
  UI_Node* UI_ChildGetFromID(const std::string& id) const;

  // Tells the parent that this node's place, size or visibility changed: its
  // cached box goes stale and UI_Container::ChildGeometryChanged hears of it. The
  // sub-view setters call it; a class that overrides UI_IsShown,
  // UI_GetSelfToParentMatrix, UI_GetLocalRectF or UI_ReceivesEventsFromOS calls
  // it whenever their answers change. So should a setter of anything else a
  // parent lays the node out from (an arrangement view reads a sub-view's
  // layout binding), for the parent to hear of it at once.
  void UI_GeometryChanged() const;

  // ---- Identity and state ----
  void UI_SetNodeID(std::string id) { nodeID_ = std::move(id); }
  const std::string& UI_GetNodeID() const { return nodeID_; }
  StateFlags UI_GetStateFlags() const { return stateFlags_; }

  void UI_Hide(bool hide) { UI_Show(!hide); }
  bool UI_IsHidden() const { return !UI_IsShown(); }
  void UI_SetDisabled(bool disabled);
  void UI_SetEnabled(bool enabled) { UI_SetDisabled(!enabled); }
  bool UI_IsDisabled() const {
    return stateFlags_.IsAnySet(kStateSelfDisabled | kStateParentDisabled);
  }
  bool UI_IsEnabled() const { return !UI_IsDisabled(); }
  // Sets or clears the parent-disabled bit of `child` and carries a change on
  // into its subtree (up to self-disabled nodes, whose children already see it).
  static void UI_DispatchParentDisabledChange(UI_Node* child, bool parentDisabled);

  // ---- Drawing ----
  void UI_SetClipToSelfEnabled(bool clip) { clipToSelf_ = clip; }
  bool UI_GetClipToSelfEnabled() const { return clipToSelf_; }
  void UI_SetDrawCachePolicy(DrawCachePolicy policy) { drawCachePolicy_ = policy; }
  DrawCachePolicy UI_GetDrawCachePolicy() const { return drawCachePolicy_; }
  // Drops the node's cached drawing (unless keepOwn) and every ancestor's.
  void UI_InvalidatePictelCache(bool keepOwn);
  const pictel::CacheInterface* UI_GetPictelCache() const { return cache_.get(); }

  // Draws this node and its subtree on `context` (no background).
  void UI_DispatchDraw(pictel::Pictel* context) const;
  // Paints a whole tree from its root. With `backgroundMode` the root is a
  // plain background: its rectangle is filled with `background` (when its alpha
  // is above 0) and only its children are drawn; otherwise the root draws itself.
  void UI_DispatchDrawFromRoot(const pictel::ColorRGBA& background, pictel::Pictel* context,
                               bool backgroundMode) const;
  // Draws one child: skipped when it owns a platform window, is not shown, has a
  // degenerate scale or lies outside the clip.
  void UI_DispatchDrawToChild(const UI_Node& child, pictel::Pictel* context) const;
  static void UI_DrawAndCache(const UI_Node& node, pictel::Pictel* context, bool backgroundMode,
                              const pictel::ColorRGBA* background);
  static void UI_DrawSelf(const UI_Node& node, pictel::Pictel* context, bool backgroundMode,
                          const pictel::ColorRGBA* background);
  void UI_ClipToSelf(pictel::Pictel* context) const;

  // ---- Custom functions ----
  void UI_SetCustomDrawFunction(std::shared_ptr<CustomDrawFunction> f) {
    customDraw_ = std::move(f);
  }
  void UI_SetCustomMouseEventFunction(std::shared_ptr<CustomMouseEventFunction> f) {
    customMouse_ = std::move(f);
  }
  void UI_SetCustomKeyboardEventFunction(std::shared_ptr<CustomKeyboardEventFunction> f) {
    customKeyboard_ = std::move(f);
  }
  void InstallFocusChangedFunction(std::shared_ptr<FocusChangedFunction> f) {
    focusChanged_ = std::move(f);
  }
  // Timer-notify functions are asked in the order installed (see UI_DoTimerNotify).
  void UI_InstallTimerNotifyFunction(const std::shared_ptr<TimerNotifyFunction>& f);
  void UI_RemoveTimerNotifyFunction(const std::shared_ptr<TimerNotifyFunction>& f);
  void UI_SetClientOSEventFunc(ClientOSEventFunc f) { clientOSEventFunc_ = f; }
  ClientOSEventFunc UI_GetClientOSEventFunc() const { return clientOSEventFunc_; }

  // ---- Node changes ----
  // UI_NodeChanged on this node, then depth first in z-order on every descendant.
  void UI_DispatchNodeChange(NodeChange change);

  // ---- Coordinates ----
  // Composes the self-to-parent matrices from this node up to `ancestor`
  // (excluded); null means up to the topmost node. Raises error 103/7 when the
  // walk leaves the tree without meeting `ancestor`.
  velkcore::ScaleMatrixT<float> UI_GetSelfToSpecificParentMatrix(const UI_Node* ancestor) const;
  velkcore::ScaleMatrixT<float> UI_GetSelfToRootMatrix() const;
  velkcore::PointT<float> UI_LocalToGlobalF(const velkcore::PointT<float>& p) const;
  velkcore::PointT<float> UI_GlobalToLocalF(const velkcore::PointT<float>& p) const;
  velkcore::RectT<float> UI_LocalToGlobalF(const velkcore::RectT<float>& r) const;
  velkcore::RectT<float> UI_GlobalToLocalF(const velkcore::RectT<float>& r) const;
  velkcore::PointT<std::int32_t> UI_LocalToGlobal(const velkcore::PointT<std::int32_t>& p) const;
  velkcore::PointT<std::int32_t> UI_GlobalToLocal(const velkcore::PointT<std::int32_t>& p) const;
  velkcore::RectT<std::int32_t> UI_LocalToGlobal(const velkcore::RectT<std::int32_t>& r) const;
  velkcore::RectT<std::int32_t> UI_GlobalToLocal(const velkcore::RectT<std::int32_t>& r) const;

  // ---- Event routing entry points (called by platform windows) ----
  // On a window's root node; the event position is in this node's coordinates.
  bool UI_DispatchMouseEvent(const MouseEvent& event, bool skipOSChildren);
  void UI_UpdateMouseOverState(const MouseEvent& event);
  // The pointer left `root`'s window: the whole mouse-over chain is left.
  static void UI_MouseExited(const MouseEvent* event, UI_Node* root);
  static bool UI_DispatchKeyboardEvent(UI_Node* target, const KeyboardEvent& event);

  // ---- Keyboard focus ----
  static UI_Node* UI_GetKeyboardFocusLeafNode();
  static UI_Node* UI_GetPreviousKeyboardFocusNode();
  static void UI_ClearPreviousKeyboardFocus();
  static UI_Node* UI_GetMouseOverLeafNode();
  // Recomputes the mouse-over state at the pointer's current position.
  static void UI_InvalidateMouseOverNodes();
  static bool UI_TextEditControlHasFocus();
  // The focus algorithm behind the virtual UI_GainKeyboardFocus of `node`.
  static bool UI_GainKeyboardFocus(UI_Node* node);
  static void UI_LoseKeyboardFocus(UI_Node* node);
  // Handles Tab and Shift+Tab pressed while `node` has focus.
  static bool UI_DoAdvanceKeyboardFocus(UI_Node* node, const KeyboardEvent& event);
  bool UI_HasKeyboardFocusState() const { return focusState_ != 0; }

  // ---- Timers and tooltips ----
  const velkcore::UTF16String& UI_GetStoredToolTip() const { return toolTip_; }
  // Removes this node's timer with `id` (if any), then asks the hosting
  // window's timer manager for a new one ticking every `seconds`. A node in no
  // window (no timer manager) raises the input-contract violation.
  void UI_InstallTimer(float seconds, std::int32_t id);
  // True when a live timer with `id` was removed.
  bool UI_RemoveTimer(std::int32_t id);
  void UI_RemoveAllTimers();
  bool UI_HasTimer(std::int32_t id) const;
  // The node's own timers (the timer managers maintain it).
  UI_NodeTimerList& UI_GetTimerList() { return timers_; }
  // The node that shows the tooltip while this node is the mouse-over leaf:
  // this node, or the topmost ancestor of an unbroken chain of ancestors that
  // each display tooltips for the child below them (UI_DisplaysToolTipForChild).
  UI_Node* UI_GetToolTipForDisplay();
  // Shows (or, with `now` false, schedules) the tooltip for this mouse-over
  // leaf; false when there is none to show, after disposing of the displayed one.
  bool UI_DisplayToolTip(bool now);

 protected:
  UI_Node();

  void UI_SetStateFlags(StateFlags flags) { stateFlags_ = flags; }
  // Whether the node has been placed by the layout bridge.
  bool UI_IsPlaced() const { return placed_; }

 private:
  friend class UI_SubView;
  friend class UI_NodeManager;

  bool CallCustomMouseFunction(const MouseEvent& event, bool* result);
  bool CallCustomKeyboardFunction(const KeyboardEvent& event, bool* result);
  void NotifyFocusChanged();
  void SetMouseOverState(bool over) { stateFlags_.Set(kStateMouseOver, over); }
  void SetKeyboardFocusState(bool focused) { focusState_ = focused ? 1 : 0; }
  void DispatchNodeChangeRecursive(NodeChange change);
  void CollectOSControlClipRects(const velkcore::ScaleMatrixT<float>& toTop,
                                 OSControlClipRects* rects) const;
  void DrawChildren(pictel::Pictel* context) const;
  void DrawChild(const UI_Node& child, pictel::Pictel* context) const;

  UI_Container* parent_ = nullptr;
  std::int32_t index_ = -1;
  StateFlags stateFlags_;
  std::uint8_t focusState_ = 0;
  bool clipToSelf_ = false;
  bool placed_ = false;
  bool dying_ = false;
  DrawCachePolicy drawCachePolicy_ = DrawCachePolicy::kSurfaceDecides;
  std::string nodeID_;
  velkcore::UTF16String toolTip_;
  std::int32_t toolTipWidth_ = 0;
  std::shared_ptr<CustomDrawFunction> customDraw_;
  std::shared_ptr<CustomMouseEventFunction> customMouse_;
  std::shared_ptr<CustomKeyboardEventFunction> customKeyboard_;
  std::shared_ptr<FocusChangedFunction> focusChanged_;
  std::unique_ptr<velkcore::SharedFunctions<bool(std::int32_t)>> timerNotify_;
  UI_NodeTimerList timers_;
  ClientOSEventFunc clientOSEventFunc_ = nullptr;
  mutable boost::intrusive_ptr<pictel::CacheInterface> cache_;
  std::uint64_t cacheSeed_ = 0;
  mutable std::uint64_t cacheThemeChangeCount_ = 0;
  orvant::place_data_t placement_;
  mutable orvant::place_data_t framePlacement_;
  // Set by UI_SubView so that matrix questions about a parent need no cast.
  const UI_SubView* asSubView_ = nullptr;
};

}  // namespace velkui::ui
