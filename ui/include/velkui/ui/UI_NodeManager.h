#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string_view>
#include <utility>
#include <vector>

#include <boost/container/small_vector.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/SharedFunctions.h>
#include <velkui/pictel/PictelImageResourceCache.h>
#include <velkui/ui/CustomSettingsManager.h>
#include <velkui/ui/InputCapture.h>
#include <velkui/ui/NodeTypes.h>
#include <velkui/ui/UI_EventRecorder.h>

namespace velkui::ui {

class UI_ToolTipManager;

// The process's one router of input: it owns the cached roles of nodes
// (mouse-over leaf and root, keyboard-focus leaf, previous focus leaf, the
// active input capture), the event filter lists, the stack of modal windows and
// the draw-cache seed. All of it runs on the user-interface thread.
//
// Roles hold nodes by plain pointer; a node clears itself from every role when
// it dies, and leaves the mouse-over, focus and capture roles consistent when it
// is removed from its tree.
//
// The platform layer derives OS_NodeManager from it and overrides the hooks in
// the "Platform and service hooks" section; every hook has a harmless default
// so that trees work without any window (tests, offscreen rendering).
class UI_NodeManager {
 public:
  using ActivationChangedFunction = std::function<void(bool active)>;
  using TextEditFocusChangedFunction = std::function<void(bool hasFocus)>;
  using UserResizeFunction = std::function<void(bool begin, UI_Node* node, bool live)>;

  UI_NodeManager();
  UI_NodeManager(const UI_NodeManager&) = delete;
  UI_NodeManager& operator=(const UI_NodeManager&) = delete;
  // Uninstalls itself when it is the installed manager.
  virtual ~UI_NodeManager();

  // ---- Singleton ----
  // Installs `manager` (not owned; null uninstalls).
  static void Set(UI_NodeManager* manager);
  // The installed manager; with `required`, no manager is an input-contract violation.
  static UI_NodeManager* Get(bool required = true);
  static const UI_NodeManager* GetConst(bool required = true);

  // ---- Roles ----
  UI_Node* GetMouseOverLeafNode() const { return mouseOverLeaf_; }
  UI_Node* GetMouseOverRootNode() const { return mouseOverRoot_; }
  UI_Node* GetKeyboardFocusLeafNode() const { return focusLeaf_; }
  UI_Node* GetPreviousKeyboardFocusNode() const { return previousFocusLeaf_; }
  void ClearPreviousKeyboardFocus() { previousFocusLeaf_ = nullptr; }
  // Substitutes `newNode` (may be null) for `oldNode` in the focus roles: the
  // focus leaf, the previous focus leaf and the saved focus of modal windows.
  // With `updateState` the focus state chains follow (as if `newNode` gained
  // focus); without, only the pointers change.
  void ReplaceWindowFocusNode(UI_Node* oldNode, UI_Node* newNode, bool updateState);
  // The same for every role, the mouse-over leaf and root and the filter lists included.
  void ReplaceInAllCachedNodes(UI_Node* oldNode, UI_Node* newNode, bool updateState);

  // ---- Input capture ----
  // Ends the current capture as cancelled, then installs and begins `capture`.
  void BeginInputCapture(const InputCaptureP& capture);
  // Ends the installed capture, if any.
  void EndInputCapture(bool cancelled);
  InputCapture* GetInputCapture() const { return capture_.get(); }
  // The node of the installed capture unless it has been cancelled.
  UI_Node* GetActiveInputCapture() const;
  bool HasInputCapture() const { return capture_ != nullptr; }

  // ---- Event filters (offered every event first, in the order added) ----
  void AddMouseEventFilterNode(UI_Node* node);
  bool RemoveMouseEventFilterNode(UI_Node* node);
  void AddKeyboardEventFilterNode(UI_Node* node);
  bool RemoveKeyboardEventFilterNode(UI_Node* node);
  const std::vector<UI_Node*>& GetMouseEventFilterNodes() const { return mouseFilters_; }
  const std::vector<UI_Node*>& GetKeyboardEventFilterNodes() const { return keyboardFilters_; }

  // ---- Modal windows ----
  // Nothing when `window` is already on top; else pushes it with the current focus leaf.
  void PushModalWindow(OS_Window* window);
  // Removes `window`'s entry; when it was on top, focus goes back to the node
  // saved with it (or the focus leaf is cleared when none survives).
  void PopModalWindow(OS_Window* window);
  OS_Window* GetModalWindow() const;
  bool HasModalWindow() const { return !modalStack_.empty(); }

  // ---- Guards' state ----
  bool IsGroupingFocusChanges() const { return groupingFocus_ > 0; }
  bool IsSuspendingOSFocusChanges() const { return suspendOSFocus_ > 0; }
  bool IsSuspendingMouseOverUpdates() const { return suspendMouseOver_ > 0; }
  // With a window: whether that window's mouse activation is suspended.
  bool IsSuspendingOSMouseActivates(const OS_Window* window = nullptr) const;
  bool IsUpdatingFocus() const { return updatingFocus_ > 0; }
  bool IsUserResizing() const { return userResizing_ > 0; }

  // ---- Keyboard helpers ----
  static bool CompareControlActivateShortcut(const KeyboardEvent& event);

  // ---- Services ----
  // -2, -3, -4, ...: ids for the library's own timers.
  std::int32_t GetUniqueTimerID() { return nextTimerID_--; }
  std::uint64_t GetPictelCacheSeed() const { return pictelCacheSeed_; }
  void IncrementPictelCacheSeed() { ++pictelCacheSeed_; }
  void EnableMnemonics() { mnemonicsEnabled_ = true; }
  void DisableMnemonics() { mnemonicsEnabled_ = false; }
  bool IsMnemonicEnabled() const { return mnemonicsEnabled_; }
  // Decoded resource images, per supplier type.
  utility::PictelImageResourceCache& GetPictelImageResourceCache() { return imageCache_; }
  CustomSettingsManager& GetCustomSettingsManager() { return customSettings_; }
  const CustomSettingsManager& GetCustomSettingsManager() const { return customSettings_; }
  // The automation recorder's hook; null removes it.
  void SetEventRecorder(std::shared_ptr<UI_EventRecorder> recorder) {
    recorder_ = std::move(recorder);
  }
  const std::shared_ptr<UI_EventRecorder>& GetEventRecorder() const { return recorder_; }

  // ---- Application state and callbacks ----
  void SetApplicationFrontmost(bool frontmost);
  bool IsApplicationFrontmost() const { return frontmost_; }
  void InstallApplicationActivationChangedFunction(
      const std::shared_ptr<ActivationChangedFunction>& f);
  void InstallTextEditFocusChangedFunction(const std::shared_ptr<TextEditFocusChangedFunction>& f);
  void InstallUserResizeFunction(const std::shared_ptr<UserResizeFunction>& f);
  // Removes every installed callback.
  void UnregisterFunctions();
  // Called by native text fields when they gain or lose focus.
  void SetTextEditControlHasFocus(bool hasFocus);
  bool TextEditControlHasFocus() const { return textEditHasFocus_; }
  void BeginUserResizing(UI_Node* node, bool live);
  void EndUserResizing(UI_Node* node, bool live);
  // One resize step of `node` during a user resize.
  void NotifyUserResize(UI_Node* node, bool live);
  // A node the user resized: repainted at once, or, while a user resize is
  // under way, once the last EndUserResizing comes.
  void InvalidateNodeAfterUserResize(UI_Node* node);
  // Repaints the nodes recorded during the user resize and forgets them.
  void InvalidateResizedNodes();

  // ---- Platform and service hooks (OS_NodeManager and later subsystems fill them) ----
  // Where the pointer is now in `root`'s coordinates. The default answers the
  // last position routed through `root`, when it is the mouse-over root.
  virtual std::optional<velkcore::PointT<float>> QueryPointerPosition(const UI_Node& root) const;
  // The modifier keys held now. The default answers the last ones routed.
  virtual ModifierKeys QueryModifierKeys() const;
  // Drops the keyboard messages waiting in the platform queue (a Tab that moved
  // focus must not also arrive as a character). Default: nothing.
  virtual void RemovePendingKeyboardMessages();
  // The mouse-over leaf changed (null: the pointer left): show the leaf's
  // tooltip or dispose of the displayed one. Default: nothing.
  virtual void MouseOverLeafChangedForToolTips(UI_Node* newLeaf);
  // `node` is being destroyed: dispose of the displayed tooltip if it owns it. Default: nothing.
  virtual void DisposeToolTipOwnedBy(UI_Node& node);
  // `node`'s tooltip text changed. Default: nothing.
  virtual void ToolTipChanged(UI_Node& node);
  // An input capture starts or ends: no tooltip while it runs. Default: nothing.
  virtual void SuspendToolTips(bool suspend);
  // Removes the timers of `node` (it moves to another window). Default: all
  // of the node's timers go.
  virtual void RemoveNodeTimers(UI_Node& node);
  // The process's tooltip manager; null by default (no platform, no tooltips).
  virtual UI_ToolTipManager* GetToolTipManager();
  // A decoded image from the library's resources, cached per supplier type.
  utility::PictelImageResourceCache::ImagePtr GetImage(const pictel::SupplierInterface& supplier,
                                                       std::string_view name,
                                                       pictel::ImageFileType type);

 protected:
  // The position last routed through the mouse-over root, in its coordinates.
  const std::optional<velkcore::PointT<float>>& GetLastPointerPosition() const {
    return lastPointer_;
  }

 private:
  friend class UI_Node;
  friend class UI_Container;
  friend class UI_SubView;
  friend class GroupingFocusChanges;
  friend class SuspendOSFocusUpdates;
  friend class SuspendMouseOverUpdates;
  friend class SuspendOSMouseActivates;
  friend class UpdatingFocus;
  friend bool UI_AdvanceFocus(bool forward, int startIndex, UI_Container* parent);

  // A node with the reference that keeps it alive while handlers run.
  struct ChainLink {
    UI_Node* node;
    NodeP hold;
  };
  // A node and its ancestors, nearest first.
  using NodeChain = boost::container::small_vector<ChainLink, 16>;
  using NodeList = boost::container::small_vector<UI_Node*, 16>;
  static ChainLink MakeLink(UI_Node* node);
  static NodeChain BuildChain(UI_Node* leaf);
  // Drops the ancestors both chains share; tells whether each leaf was among them.
  static void StripCommonAncestors(NodeChain& a, NodeChain& b, bool* aLeafShared,
                                   bool* bLeafShared);

  // Mouse routing.
  bool DispatchMouseEvent(UI_Node& root, const MouseEvent& event, bool skipOSChildren);
  bool DispatchCapturedMouseEvent(UI_Node& target, const MouseEvent& event);
  void DispatchCapturedCursor(InputCapture& capture, const velkcore::PointT<float>& point,
                              ModifierKeys modifiers);
  bool DispatchTowardsLeaf(UI_Node& node, const MouseEvent& event, bool skipOSChildren,
                           ChainLink* leaf);
  bool DeliverMouseEvent(UI_Node& node, UI_Node* leaf, const MouseEvent& event);
  bool RunMouseFilters(UI_Node& leaf, const MouseEvent& event);
  bool DispatchCursor(UI_Node& root, const velkcore::PointT<float>& point, ModifierKeys modifiers,
                      bool skipOSChildren);
  bool DispatchCursorTowardsLeaf(UI_Node& node, const velkcore::PointT<float>& point,
                                 ModifierKeys modifiers, bool skipOSChildren, ChainLink* leaf);

  // Mouse-over state.
  void UpdateMouseOverState(UI_Node& root, const MouseEvent& event);
  // False when a handler changed the mouse-over state meanwhile (its change stands).
  bool SetMouseOverLeafNode(UI_Node* newLeaf, const MouseEvent* event, const UI_Node* eventRoot);
  void DeliverExitNotice(UI_Node& node, const MouseEvent& event, const UI_Node* eventRoot);
  void MouseExited(const MouseEvent* event, UI_Node* root);
  void InvalidateMouseOverNodes();

  // Keyboard routing and focus.
  bool DispatchKeyboardEvent(UI_Node* target, const KeyboardEvent& event);
  bool DispatchCapturedKeyboardEvent(const KeyboardEvent& event);
  bool DispatchPreKeyboardEvent(UI_Node* target, const KeyboardEvent& event);
  bool GainKeyboardFocus(UI_Node& node);
  void UpdateKeyboardFocusStateDueToLoss(UI_Node& node);
  // Moves the focus leaf to `newLeaf` (may be null) and updates both chains.
  void ChangeFocusLeaf(UI_Node* newLeaf, bool notify);
  void ClearFocusQuietly();

  // Lifecycle of nodes.
  void NodeLeavingTree(UI_Node& subtreeRoot);
  void NodeDestroyed(UI_Node& node);

  std::vector<UI_Node*> mouseFilters_;
  std::vector<UI_Node*> keyboardFilters_;
  UI_Node* mouseOverLeaf_ = nullptr;
  UI_Node* mouseOverRoot_ = nullptr;
  UI_Node* focusLeaf_ = nullptr;
  UI_Node* previousFocusLeaf_ = nullptr;
  std::vector<std::pair<OS_Window*, UI_Node*>> modalStack_;
  InputCaptureP capture_;
  std::int32_t updatingFocus_ = 0;
  std::int32_t suspendOSFocus_ = 0;
  std::int32_t suspendMouseOver_ = 0;
  std::int32_t groupingFocus_ = 0;
  std::vector<const OS_Window*> suspendedMouseActivates_;
  bool frontmost_ = true;
  std::int32_t userResizing_ = 0;
  std::vector<NodeP> resizedNodes_;
  utility::PictelImageResourceCache imageCache_;
  CustomSettingsManager customSettings_;
  std::uint64_t pictelCacheSeed_ = 1;
  std::int32_t nextTimerID_ = -2;
  velkcore::SharedFunctions<void(bool)> activationChanged_;
  velkcore::SharedFunctions<void(bool)> textEditFocusChanged_;
  velkcore::SharedFunctions<void(bool, UI_Node*, bool)> userResize_;
  ModifierKeys lastModifiers_;
  bool mnemonicsEnabled_ = false;
  bool textEditHasFocus_ = false;
  std::shared_ptr<UI_EventRecorder> recorder_;
  std::optional<velkcore::PointT<float>> lastPointer_;
  // Bumped by every change of the mouse-over leaf, so that an update that a
  // handler overtook can tell.
  std::uint64_t mouseOverGeneration_ = 0;
};

// Focus advance among the children of `parent`, starting after `startIndex`
// (from the first or the last child when it is -1).
bool UI_AdvanceFocus(bool forward, int startIndex, UI_Container* parent);

}  // namespace velkui::ui
