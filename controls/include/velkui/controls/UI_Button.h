#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <utility>
#include <vector>

#include <velkcore/Geometry.h>
#include <velkcore/Strings.h>
#include <velkui/controls/ControlState.h>
#include <velkui/controls/DrawButtonFace.h>
#include <velkui/controls/DrawButtonParameters.h>
#include <velkui/controls/UI_ColorChangeSupport.h>
#include <velkui/controls/UI_InteractiveControlView.h>
#include <velkui/pictel/Pictel.h>

namespace velkui::controls {

// The base of every pressable control. A press with the mouse (tracked by a
// ButtonInputCapture) or the keyboard changes the down state, sends a
// UI_ButtonChangedMessage to the changed-listeners and brackets the press as an
// interactive change. Spring-loaded buttons pop back up after each press;
// toggles keep the state the press gave them. Subclasses draw.
class UI_Button : public UI_InteractiveControlView, public UI_ColorChangeSupport {
 public:
  // What a drag over the button is doing.
  enum class DropAction : std::int32_t { kEnter = 0, kOver = 1, kLeave = 2, kDrop = 3 };
  // Answers whether the drag is accepted; sets `effect` to the drop effect.
  // `data` is null for kLeave.
  using DragSupportFunction =
      std::function<bool(UI_Button& button, DropAction action, const velkcore::PointT<float>& point,
                         datatransfer::OS_ReceiveData* data, std::int32_t& effect)>;
  using DragSupportFunctionP = std::shared_ptr<DragSupportFunction>;
  using ModifiedToolTip = std::pair<ui::ModifierKeys, velkcore::UTF16String>;

  static constexpr std::int32_t kToolTipWidth = 400;
  // The auto-repeat interval of a press when the button has interactive listeners.
  static constexpr float kRepeatInterval = 0.05f;

  ~UI_Button() override;

  // ---- Node operations ----
  bool UI_DoMouseEvent(ui::UI_Node* target, const ui::MouseEvent& event) override;
  bool UI_DoKeyboardEvent(ui::UI_Node* target, const ui::KeyboardEvent& event) override;
  bool UI_InvalidateOnMouseOverChange(bool isLeaf) const override;
  bool UI_WantsDragDropEvents() const override;
  bool UI_HandleDragEnter(const velkcore::PointT<float>& point, datatransfer::OS_ReceiveData& data,
                          std::int32_t& effect) override;
  bool UI_HandleDragOver(const velkcore::PointT<float>& point, datatransfer::OS_ReceiveData& data,
                         std::int32_t& effect) override;
  void UI_HandleDragLeave() override;
  bool UI_HandleDrop(const velkcore::PointT<float>& point, datatransfer::OS_ReceiveData& data,
                     std::int32_t& effect) override;
  // Takes the focus and, when that works, presses the button.
  bool UI_GainKeyboardFocusFromMnemonic() override;

  // ---- Virtual operations, in slot order ----
  virtual void SetWantsDragDropEvents(bool wants);
  virtual void SetDragSupportFxn(const DragSupportFunctionP& function);
  virtual bool HandleControlActivateViaKeyboard(const ui::KeyboardEvent& event);
  virtual void SendButtonChangedMessage(ui::ModifierKeys modKeys);
  virtual void ModKeyChanged(ui::ModifierKeys modKeys);

  // ---- Value and behaviour ----
  ButtonValue GetValue() const { return value_; }
  // Makes the value known and the down state follow it; sends nothing.
  void SetValue(ButtonValue value);
  bool IsSpringLoaded() const { return springLoaded_; }
  void SetSpringLoaded(bool springLoaded) { springLoaded_ = springLoaded; }
  bool GetNotificationOnMouseDown() const { return notificationOnMouseDown_; }
  void SetNotificationOnMouseDown(bool on) { notificationOnMouseDown_ = on; }
  bool GetNotificationOnMouseUp() const { return notificationOnMouseUp_; }
  void SetNotificationOnMouseUp(bool on) { notificationOnMouseUp_ = on; }
  bool GetChangeFocusOnClick() const { return changeFocusOnClick_; }
  void SetChangeFocusOnClick(bool change) { changeFocusOnClick_ = change; }
  bool GetWantsDragDropEvents() const { return wantsDragDropEvents_; }

  // ---- Look ----
  bool GetDefaultAppearance() const { return defaultAppearance_; }
  void SetDefaultAppearance(bool isDefault);
  float GetCornerRadius() const { return cornerRadius_; }
  void SetCornerRadius(float radius);
  // Outline widths: normal, and as the default button.
  std::pair<float, float> GetStrokeSizes() const { return strokeSizes_; }
  void SetStrokeSizes(const std::pair<float, float>& sizes);
  const velkcore::PointT<float>& GetDownOffset() const { return downOffset_; }
  void SetDownOffset(const velkcore::PointT<float>& offset);
  const velkcore::PointT<float>& GetContentOffset() const { return contentOffset_; }
  void SetContentOffset(const velkcore::PointT<float>& offset);
  // Where the face content goes now: the content offset, plus the down offset while down.
  velkcore::PointT<float> GetCurrentContentOffset() const;

  // ---- Pressing ----
  // The programmatic press.
  void PerformAction(bool down, ui::ModifierKeys modKeys, bool interactive);
  // The node manager's capture is a button capture.
  static bool IsButtonCaptured();
  // 0.05 s when the button has interactive listeners, else 0 (no auto-repeat).
  float GetRepeatInterval() const;

  // ---- Tooltips that change with the modifier keys ----
  // Keys 0 set the default tooltip; other keys add a tooltip shown while
  // exactly those keys (of all keys that have tooltips) are held.
  void InsertModifiedToolTip(ui::ModifierKeys keys, const velkcore::UTF16String& text);
  const velkcore::UTF16String& GetDefaultToolTip() const { return defaultToolTip_; }
  const std::vector<ModifiedToolTip>& GetModifiedToolTips() const { return modifiedToolTips_; }
  ui::ModifierKeys GetToolTipModKeyMask() const { return toolTipModKeyMask_; }
  void SetModifierKeyCallbackEnabled(bool enabled);
  bool GetModifierKeyCallbackEnabled() const { return modKeyCallback_ != nullptr; }
  ui::ModifierKeys GetCurrentModKeys() const { return currentModKeys_; }

  // ---- Drawing the body ----
  static void Draw(const DrawButtonParameters& parameters, pictel::Pictel* context);
  static void Draw(ControlState controlState, bool drawContainer, bool defaultAppearance,
                   bool rotatedGradient, float strokeSize, float cornerRadius,
                   const velkcore::RectT<float>& rect, const velkcore::PointT<float>& offset,
                   const DrawButtonFace* face, const ColorChangeMap* colorChangeMap,
                   pictel::Pictel* context, bool semiRounded);

 protected:
  UI_Button();

  // An "on" toggle that is not being pressed is drawn with the selected face.
  void ApplyToggleAppearance(DrawButtonParameters& parameters) const;
  // Starts tracking a press of the left button.
  void BeginButtonCapture(const ui::MouseEvent& event);
  // The tooltip for `keys` (the default one when none matches).
  const velkcore::UTF16String& ToolTipForKeys(ui::ModifierKeys keys) const;
  bool CallDragSupport(DropAction action, const velkcore::PointT<float>& point,
                       datatransfer::OS_ReceiveData* data, std::int32_t& effect);

 private:
  bool LosesFocusOnEscape() const;

  ui::ModifierKeys currentModKeys_;
  std::vector<ModifiedToolTip> modifiedToolTips_;
  ui::ModifierKeys toolTipModKeyMask_;
  velkcore::UTF16String defaultToolTip_;
  std::shared_ptr<std::function<void(ui::ModifierKeys)>> modKeyCallback_;
  ButtonValue value_ = kButtonOff;
  bool springLoaded_ = true;
  bool notificationOnMouseDown_ = false;
  bool notificationOnMouseUp_ = false;
  bool defaultAppearance_ = false;
  bool changeFocusOnClick_ = true;
  float cornerRadius_ = 0.0f;
  std::pair<float, float> strokeSizes_{1.0f, 2.0f};
  velkcore::PointT<float> downOffset_{};
  velkcore::PointT<float> contentOffset_{};
  DragSupportFunctionP dragSupport_;
  bool wantsDragDropEvents_ = false;
};

using ButtonP = boost::intrusive_ptr<UI_Button>;

}  // namespace velkui::controls
