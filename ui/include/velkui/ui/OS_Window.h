#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/SharedFunctions.h>
#include <velkui/pictel/PictelTypes.h>
#include <velkui/ui/ClickCounter.h>
#include <velkui/ui/KeyboardEvent.h>
#include <velkui/ui/OS_Event.h>
#include <velkui/ui/PlatformTypes.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_Node.h>
#include <velkui/ui/UI_Window.h>

namespace velkui::ui {

class Platform;
class UI_NodeTimerManager;

// A node that owns a platform window. As the root of a tree it is a
// top-level window: its local coordinates are its client area, and its
// self-to-parent matrix puts the client origin on the screen. As a child node
// (OS_ViewContainer, SubWindow) it is embedded: its frame lies in its parent
// node's coordinates and its platform window follows that frame inside the
// hosting window.
//
// It turns the platform's messages into calls on the node manager (mouse and
// keyboard translation, painting, timers, activation and focus), and the
// tree's requests (invalidate, capture, focus, show, move) into platform calls.
class OS_Window : public UI_Node, public UI_Window {
 public:
  // Answers true to keep the window open when the user asks to close it.
  using CloseFunction = std::function<bool(OS_Window& window)>;

  // No platform window yet: UI_CreateWindow or UI_AttachWindow makes one.
  OS_Window();
  // Creates the platform window at once.
  OS_Window(const velkcore::UTF16String& title, const velkcore::RectT<std::int32_t>& frame,
            std::uint32_t style = kStyleOverlappedWindow, std::uint32_t exStyle = 0,
            PlatformWindow parent = kNoPlatformWindow);
  // Destroys the platform window (after DetachPlatformWindowPreDelete).
  ~OS_Window() override;

  // ---- UI_Window ----
  PlatformWindow GetPlatformWindow(bool create) override;
  PlatformMenu GetPlatformMenu() const override;
  void UI_SetTitle(const velkcore::UTF16String& title) override;
  bool UI_IsMinimized() const override;
  void UI_Minimize(bool minimize) override;
  bool UI_DuringClose() const override;
  void UI_PostClose() override;
  velkcore::RectT<std::int32_t> UI_GetGlobalStructureRect() const override;
  void UI_SetGlobalStructureRect(const velkcore::RectT<std::int32_t>& frame) override;
  void UI_Move(const velkcore::PointT<std::int32_t>& topLeft) override;
  void UI_Activate() override;

  // ---- UI_Node ----
  velkcore::ScaleMatrixT<float> UI_GetSelfToParentMatrix() const override;
  velkcore::RectT<std::int32_t> UI_GetLocalRect(bool inParent) const override;
  velkcore::RectT<float> UI_GetLocalRectF(bool inParent) const override;
  // The client area: in screen coordinates for a top-level window, in the
  // parent node's coordinates for an embedded one.
  void UI_SetLocalRect(const velkcore::RectT<std::int32_t>& rect) override;
  void UI_SetLocalRectF(const velkcore::RectT<float>& rect) override;
  void UI_Show(bool show) override;
  bool UI_IsShown() const override;
  bool UI_AreAllParentsVisible() const override;
  void UI_Invalidate(const velkcore::RectT<std::int32_t>* localOrNull,
                     InvalidateFlags flags) override;
  void UI_UpdateNow(UpdateFlags flags) override;
  void UI_SetOpacity(float opacity) override;
  void UI_SetParent(UI_Container* parent) override;
  bool UI_SupportsPictel() const override;
  const pictel::SupplierInterface* UI_GetDrawSupplier() const override;
  void UI_SetCapture() override;
  void UI_ReleaseCapture() override;
  bool UI_ReceivesEventsFromOS() const override;
  void UI_DisabledStateChanged() override;
  void UI_NodeChanged(NodeChange change) override;
  void UI_HandleOSEvent(OS_Event* event) override;
  bool UI_DispatchEvent(OS_Event* event) override;
  void UI_FocusChanged() override;
  void UI_SetKeyboardFocusWithOS() override;
  UI_NodeTimerManager* UI_GetTimerManager(bool create) override;
  const UI_NodeTimerManager* UI_GetTimerManager(bool create) const override;
  void ChildAdded(UI_Node* node) override;
  void ChildRemoved(UI_Node* node) override;

  // ---- Appended virtual operations, in slot order ----
  // Adopts an existing platform window as this node's (after UI_AttachWindow's checks).
  virtual void UI_AttachOSWindow(PlatformWindow window);
  virtual void UI_SetTransparentColorKey(const pictel::ColorRGBA& key);
  virtual void UI_SetOpacityAndTransparentColorKey(float opacity, const pictel::ColorRGBA& key);
  // Creates the platform window (the input-contract violation when there is one
  // already). `parent` is the parent of a child window, else its owner.
  virtual void UI_CreateWindow(const velkcore::UTF16String& title, PlatformWindow parent,
                               const velkcore::RectT<std::int32_t>& frame, std::uint32_t style,
                               std::uint32_t extendedStyle);
  // Adopts `window`, which must exist and belong to no other OS_Window.
  virtual void UI_AttachWindow(PlatformWindow window);
  // Makes an embedded window's platform window follow the tree: its parent
  // is the hosting window's, its place the node's frame, shown when the node is.
  virtual void UI_SynchronizeParent();
  // Paints the pending area; false when nothing was painted (no drawing
  // support, an empty client area, nothing pending).
  virtual bool UI_Paint(OS_Event* event) const;
  virtual bool UI_DispatchMouseEventFromOS(OS_Event* event);
  virtual bool UI_DispatchKeyboardEventFromOS(OS_Event* event);

  // Takes the areas of shown embedded platform windows (UI_GetOSControlClipRects)
  // out of `clip` (client pixels), which they paint themselves.
  void UI_ClipOSControls(std::vector<velkcore::RectT<std::int32_t>>& clip) const;

  // ---- The library's windows ----
  // Checks that a platform is installed (there is no window class to register).
  static void UI_Initialize();
  static bool UI_IsOSWindowType(PlatformWindow window);
  // The OS_Window of a platform window, or null.
  static OS_Window* UI_GetWindow(PlatformWindow window);
  // Every window with a platform window, in the order they were made.
  static std::vector<OS_Window*> UI_EnumerateAllWindows();
  // The first window (in that order) whose node ID is `id`, or null.
  static OS_Window* UI_FindWindowFromID(const std::string& id);
  static std::vector<OS_Window*> UI_FindAllWindowsMatchingID(const std::string& id);
  // The library window under the pointer, or null.
  static OS_Window* GetWindowFromMouse();

  // ---- Focus with the platform ----
  // The platform gave the window the keyboard focus: the node that had focus
  // in it before regains it.
  void UI_OSSetFocus();
  // The platform took the focus away to `newFocus` (none: another application).
  void UI_OSKillFocus(PlatformWindow newFocus);

  // ---- Other state ----
  std::uint32_t GetStyle() const { return style_; }
  std::uint32_t GetExStyle() const { return exStyle_; }
  // Whether the window is a child node in another tree.
  bool IsEmbedded() const { return UI_GetParentNode() != nullptr; }
  // The colour painted under the children; by default the theme's window
  // background (colour 4), white without a theme.
  void SetBackgroundColor(const std::optional<pictel::ColorRGBA>& color);
  pictel::ColorRGBA GetBackgroundColor() const;
  ClickCounter& GetClickCounter() { return clickCounter_; }
  // Close-request functions are asked in order; the first that answers true
  // keeps the window open. Without a veto the window hides.
  void InstallCloseFunction(const std::shared_ptr<CloseFunction>& f);
  void RemoveCloseFunction(const std::shared_ptr<CloseFunction>& f);
  // Leaves the platform window alone from now on: timers, capture and the
  // registry entry go (the destructor calls it first).
  void DetachPlatformWindowPreDelete();

 protected:
  // The supplier windows draw with: one shared by all windows, unless a
  // subclass gives the window its own (pop-ups do).
  void SetDrawSupplier(boost::intrusive_ptr<pictel::SupplierInterface> supplier);
  // The platform window of the nearest ancestor window (embedded windows live in it).
  PlatformWindow GetHostPlatformWindow() const;
  // The screen rectangle an embedded window's frame covers now.
  velkcore::RectT<std::int32_t> GetEmbeddedScreenRect() const;
  // Handles a close request (kMsgClose).
  void HandleCloseRequest();
  // Asks the close-request functions; true when one keeps the window open (or
  // a close request is being handled already).
  bool RunCloseFunctions();
  // Paints through an offscreen buffer even when the platform does not ask for one.
  void SetPaintsBuffered(bool buffered) { paintBuffered_ = buffered; }
  bool GetPaintsBuffered() const { return paintBuffered_; }

 private:
  void Register();
  void Unregister();
  void ReadClientRect();
  void ClientAreaChanged(const velkcore::RectT<std::int32_t>& before);
  void SyncEmbeddedGeometry();
  void SyncPlatformVisibility();
  void SynchronizeEmbeddedDescendants(UI_Node& node);
  void StartPlatformTimers();
  void RefreshClickMetrics();
  bool HandleTimerMessage(const OS_Event& event);
  bool DispatchPointerMove(OS_Event* event);
  bool DispatchButton(OS_Event* event);
  bool DispatchWheel(OS_Event* event);
  bool DispatchPointerLeft(OS_Event* event);
  void DispatchCursorAt(const velkcore::PointT<float>& point, ModifierKeys modifiers);
  void ActivateOnClick();
  bool IsNearestWindowOf(const UI_Node* node) const;
  void DisplayChanged();

  PlatformWindow handle_ = kNoPlatformWindow;
  std::uint32_t style_ = 0;
  std::uint32_t exStyle_ = 0;
  bool shown_ = false;
  bool closing_ = false;
  bool paintBuffered_ = false;
  // Top-level: the client area on screen. Embedded: the frame in the parent node.
  velkcore::RectT<std::int32_t> client_;
  velkcore::RectT<float> frame_;
  ClickCounter clickCounter_;
  std::unique_ptr<UI_NodeTimerManager> timers_;
  boost::intrusive_ptr<pictel::SupplierInterface> supplier_;
  std::optional<pictel::ColorRGBA> background_;
  ThemeChangedFunctionPtr themeChanged_;
  velkcore::SharedFunctions<bool(OS_Window&)> closeFunctions_;
  // The node that had focus in this window when it last lost it.
  NodeP focusMemory_;
  velkcore::PointT<float> lastPointer_{};
};

using OS_WindowP = boost::intrusive_ptr<OS_Window>;

// A platform keyboard message as a KeyboardEvent (action, characters, key
// code and modifiers by the keyboard rules of the input translation); none
// for a message that is not a key or character message.
std::optional<KeyboardEvent> UI_GetKeyboardEventFromOSEvent(const OS_Event& event,
                                                            const Platform& platform);

}  // namespace velkui::ui
