#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string_view>
#include <vector>

#include <velkcore/Geometry.h>
#include <velkcore/Strings.h>
#include <velkui/ui/OS_MessagePump.h>
#include <velkui/ui/OS_Window.h>
#include <velkui/ui/UI_SubView.h>

namespace velkui::ui {

class SetModalWindow;

// What a dialog window looks like and where it starts.
struct DialogParams {
  velkcore::UTF16String title;
  // The content (client area) size.
  velkcore::PointT<std::int32_t> size{400, 300};
  // The frame's top-left corner on the screen, unless the dialog is centred.
  velkcore::PointT<std::int32_t> position{100, 100};
  bool center = true;
  // The window the dialog belongs to: the platform keeps the dialog above it,
  // and a modal run blocks it (and the library's other windows). Null: the
  // desktop, and a modal run blocks nothing.
  OS_Window* parent = nullptr;
  // A frameless pop-up instead of a captioned modal frame.
  bool popup = false;
  // A modal frame with a sizing border.
  bool resizable = false;
  // Window styles in the desktop numbering (PlatformTypes.h); none: the
  // styles of the frame kind (OS_Dialog's constants).
  std::optional<std::uint32_t> style;
  std::optional<std::uint32_t> extendedStyle;
};

// A top-level window that can run modally: RunModal shows it, blocks the
// windows it must block and dispatches messages until the dialog closes (or
// the application quits), then restores what it changed.
//
// Its only child is the content container, which always fills the client
// area; put the dialog's nodes into it. Return and Escape that no node
// handles, and the close box, reach OnReturnKey, OnEscapeKey and
// OnCloseButton. PostClose ends a modal run (or hides a modeless dialog).
//
// The modal loop is the platform's message pump: on the x11 backend it waits
// for input; on the headless backend, which never waits, a run also ends when
// nothing is left to dispatch (so that tests never hang) and the dialog is
// then not closing. A run that the quit request ends leaves the quit in force
// (Platform::IsQuitting), so the loops around it end too.
class OS_Dialog : public OS_Window {
 public:
  static constexpr std::string_view kShowCloseBoxSetting =
      "velkui.ui.windows.ShowCloseBoxOnModalDialogs";
  // Pop-up with sibling clipping; control parent.
  static constexpr std::uint32_t kPopupStyle = kStylePopup | kStyleClipSiblings;
  static constexpr std::uint32_t kPopupExStyle = kExStyleControlParent;
  // Pop-up, clipping, caption and modal frame; the close box (system menu)
  // follows kShowCloseBoxSetting, the sizing frame `resizable`.
  static constexpr std::uint32_t kModalFrameStyle =
      kStylePopup | kStyleClipSiblings | kStyleClipChildren | kStyleCaption | kStyleModalFrame;
  static constexpr std::uint32_t kModalFrameExStyle =
      kExStyleControlParent | kExStyleWindowEdge | kExStyleModalFrame;

  // Creates the (hidden) platform window, sizes its client area to
  // params.size, centres it when asked, then adds `content` (a plain
  // sub-view when null) as the content container. A negative size is an
  // input-contract violation.
  explicit OS_Dialog(const DialogParams& params, SubViewP content = nullptr);
  // A dialog destroyed during a modal run ends the run first.
  ~OS_Dialog() override;

  // ---- Node operations ----
  // Return and keypad Enter (not repeated) go to OnReturnKey, Escape to OnEscapeKey.
  bool UI_DoKeyboardEvent(UI_Node* target, const KeyboardEvent& event) override;
  // The close box: the close-request functions may keep the dialog open,
  // otherwise OnCloseButton decides.
  void UI_HandleOSEvent(OS_Event* event) override;
  // The content container follows the client area.
  void UI_SizeChanged(const velkcore::RectT<float>& newLocalRect) override;
  // Showing a closed dialog that is not running modally opens it again.
  void UI_Show(bool show) override;

  // ---- Appended virtual operations, in slot order ----
  // BeginModal, ModalLoop, EndModal; EndModal runs even when a handler
  // throws out of the loop. A dialog already running modally is an
  // input-contract violation.
  virtual void RunModal();
  // Starts a modal run without a loop (a host that keeps working and calls
  // ModalDuring now and then, then EndModal): clears the closing flag,
  // remembers the active window, blocks the windows to block (only when the
  // dialog has a parent window: the library's other top-level windows, except
  // the dialog's own and pop-ups that never activate), makes the dialog the
  // node manager's modal window, shows it and, when
  // ActivatesWindowOnBeginModal, activates it.
  virtual void BeginModal();
  // Dispatches the messages waiting now, without waiting for more; answers
  // whether the run goes on (not closing, no quit request).
  virtual bool ModalDuring();
  // Ends the modal run (nothing when none runs): re-enables the windows
  // BeginModal blocked that still exist, reactivates the window that was
  // active before (when ActivatesWindowOnBeginModal), hides the dialog and
  // gives up the modal-window role.
  virtual void EndModal();
  // Return that nobody handled; true when handled. Default: not handled.
  virtual bool OnReturnKey(ModifierKeys modifiers);
  // Escape that nobody handled. Default: PostClose.
  virtual bool OnEscapeKey(ModifierKeys modifiers);
  // The close box. Default: PostClose.
  virtual void OnCloseButton();
  // Sets the closing flag, which ends the modal run; a dialog that runs no
  // modal loop hides at once.
  virtual void PostClose();

  // ---- Placement and size ----
  // Centres the frame on the parent window when it is shown, else on the
  // work area of the primary monitor, and keeps it reachable on the monitors.
  void Center();
  // Sets the client area's size (within the minimum and maximum size),
  // keeping its top-left corner.
  void SetContentSize(const velkcore::PointT<std::int32_t>& size);
  // Limits of the content size. The platform imposes none of its own: they
  // start at 0 × 0 and unlimited. A minimum above the maximum, or a negative
  // size, is an input-contract violation.
  void SetMinimumSize(const velkcore::PointT<std::int32_t>& size);
  void SetMaximumSize(const velkcore::PointT<std::int32_t>& size);
  const velkcore::PointT<std::int32_t>& GetMinimumSize() const { return minimumSize_; }
  const velkcore::PointT<std::int32_t>& GetMaximumSize() const { return maximumSize_; }
  // The parent window given at construction while it lives, else null (the desktop).
  OS_Window* GetDialogParent() const;

  // ---- State ----
  UI_SubView& GetContentContainer() const { return *content_; }
  bool IsModal() const { return modal_; }
  // The closing flag: set by PostClose, cleared when a modal run begins or a
  // closed dialog is shown again.
  bool IsClosing() const { return closing_; }
  // Whether the last modal run ended on the quit request.
  bool WasEndedByQuit() const { return endedByQuit_; }

 protected:
  // The loop of RunModal: dispatches messages until the closing flag is set,
  // the quit request comes, or (headless) nothing is left.
  virtual PumpResult ModalLoop();
  // Whether BeginModal activates the dialog (and EndModal reactivates the
  // window active before). Default: true.
  virtual bool ActivatesWindowOnBeginModal() const;

 private:
  struct BlockedWindow {
    PlatformWindow handle;
    const OS_Window* window;
  };

  static std::uint32_t DefaultStyle(const DialogParams& params);
  void BlockOtherWindows();
  void UnblockWindows();
  void ReactivatePreviousWindow();
  velkcore::PointT<std::int32_t> ClampToLimits(velkcore::PointT<std::int32_t> size) const;

  SubViewP content_;
  bool closing_ = false;
  bool modal_ = false;
  bool endedByQuit_ = false;
  std::vector<BlockedWindow> blocked_;
  PlatformWindow previousActive_ = kNoPlatformWindow;
  std::unique_ptr<SetModalWindow> modalGuard_;
  velkcore::PointT<std::int32_t> minimumSize_{0, 0};
  velkcore::PointT<std::int32_t> maximumSize_;
};

using OS_DialogP = boost::intrusive_ptr<OS_Dialog>;

}  // namespace velkui::ui
