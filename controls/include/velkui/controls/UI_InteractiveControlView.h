#pragma once

#include <cstddef>

#include <velkui/controls/UI_ControlView.h>

namespace velkui::controls {

// A control whose value the user changes over time (dragging, scrubbing,
// holding a key): it brackets each such change with begin, continues, and one
// finish or cancel, sent to its interactive listeners.
class UI_InteractiveControlView : public UI_ControlView {
 public:
  UI_InteractiveControlView();
  ~UI_InteractiveControlView() override;

  void NotifyWhenChangedInteractively(const ControlCallbackP& callback);
  // Entries of the interactive list, empty ones included.
  std::size_t InteractiveCallbackSize() const { return interactiveListeners_.Size(); }

  // Replays a child's step as this control's own; after a finish it also sends
  // the value-changed message.
  void ForwardInteractiveControlMessageFromChild(UI_InteractiveControlChangedMessage* message);

  // Begin on construction; Finish sends the finish once; destruction without
  // Finish sends a cancel. A listener that throws during that cancel cannot
  // leave the destructor: the exception is dropped there.
  class ScBeginAndEndInteractiveChange {
   public:
    explicit ScBeginAndEndInteractiveChange(UI_InteractiveControlView& control);
    ~ScBeginAndEndInteractiveChange();
    ScBeginAndEndInteractiveChange(const ScBeginAndEndInteractiveChange&) = delete;
    ScBeginAndEndInteractiveChange& operator=(const ScBeginAndEndInteractiveChange&) = delete;

    void Continue(ui::ModifierKeys modKeys);
    void Finish();
    bool IsFinished() const { return finished_; }

   private:
    boost::intrusive_ptr<UI_ControlView> keep_;
    UI_InteractiveControlView& control_;
    bool finished_ = false;
  };

 protected:
  void BeginInteractiveChange();
  void ContinueInteractiveChange(ui::ModifierKeys modKeys);
  void FinishInteractiveChange();
  void CancelInteractiveChange();
  void FinishedUserChange() { SendValueChangedMessage(); }

 private:
  friend class ButtonInputCapture;
  void SendInteractive(ChangeMessage change, ui::ModifierKeys modKeys);

  ControlListenerList interactiveListeners_;
};

}  // namespace velkui::controls
