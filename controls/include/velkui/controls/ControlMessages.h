#pragma once

#include <cstdint>

#include <velkui/controls/ControlState.h>
#include <velkui/controls/MessageT.h>
#include <velkui/pictel/ImageInterface.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/NodeTypes.h>

namespace velkui::controls {

class UI_ControlView;

// A message about a control. GetControl raises the invalid-type-conversion
// error when the subject is a node that is not a control.
class UI_ControlMessage : public ui::MessageT<ui::UI_Node> {
 public:
  explicit UI_ControlMessage(UI_ControlView* control);
  UI_ControlView* GetControl() const;
  void SetControl(UI_ControlView* control);
};

class UI_ConstControlMessage : public ui::MessageT<const ui::UI_Node> {
 public:
  explicit UI_ConstControlMessage(const UI_ControlView* control);
  const UI_ControlView* GetControl() const;
  void SetControl(const UI_ControlView* control);
};

// The control's value changed.
class UI_ControlChangedMessage : public UI_ControlMessage {
 public:
  using UI_ControlMessage::UI_ControlMessage;
};

// A button fired; carries the modifier keys held at that moment.
class UI_ButtonChangedMessage : public UI_ControlChangedMessage {
 public:
  UI_ButtonChangedMessage(UI_ControlView* control, ui::ModifierKeys modKeys)
      : UI_ControlChangedMessage(control), modKeys_(modKeys) {}
  ui::ModifierKeys GetModKeys() const { return modKeys_; }

 private:
  ui::ModifierKeys modKeys_;
};

// The steps of an interactive change: begin, any number of continues, then
// exactly one finish or cancel.
enum ChangeMessage : std::int32_t {
  kBeginChange = 0,
  kContinueChange = 1,
  kFinishChange = 2,
  kCancelChange = 3,
};

class UI_InteractiveControlChangedMessage : public UI_ControlMessage {
 public:
  UI_InteractiveControlChangedMessage(UI_ControlView* control, ChangeMessage change,
                                      ui::ModifierKeys modKeys)
      : UI_ControlMessage(control), change_(change), modKeys_(modKeys) {}
  ChangeMessage GetChangeMessage() const { return change_; }
  ui::ModifierKeys GetModKeys() const { return modKeys_; }

 private:
  ChangeMessage change_;
  ui::ModifierKeys modKeys_;
};

// The pointer moved over or left a control; carries a copy of the event.
class UI_HoverMessage : public UI_ControlMessage {
 public:
  UI_HoverMessage(UI_ControlView* control, const ui::MouseEvent& event)
      : UI_ControlMessage(control), event_(event) {}
  const ui::MouseEvent& GetMouseEvent() const { return event_; }
  bool IsAction(ui::MouseEvent::Action action) const { return event_.IsAction(action); }

 private:
  ui::MouseEvent event_;
};

// A picture-showing control asks its host for the image to draw in a state;
// the listener answers with SetImage (the message does not own the image).
class UI_PictureSupplyMessage : public UI_ConstControlMessage {
 public:
  UI_PictureSupplyMessage(const UI_ControlView* control, ControlState stateFlags,
                          ui::ModifierKeys modKeys)
      : UI_ConstControlMessage(control), stateFlags_(stateFlags), modKeys_(modKeys) {}
  ControlState GetStateFlags() const { return stateFlags_; }
  void SetStateFlags(ControlState flags) { stateFlags_ = flags; }
  pictel::ImageInterface* GetImage() const { return image_; }
  void SetImage(pictel::ImageInterface* image) { image_ = image; }
  ui::ModifierKeys GetModKeys() const { return modKeys_; }

 private:
  ControlState stateFlags_;
  pictel::ImageInterface* image_ = nullptr;
  ui::ModifierKeys modKeys_;
};

}  // namespace velkui::controls
