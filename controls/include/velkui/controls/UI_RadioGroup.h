#pragma once

#include <cstdint>
#include <vector>

#include <velkui/controls/UI_RadioButton.h>

namespace velkui::controls {

// Holds radio buttons and keeps at most one of them on: when one changes,
// every other radio button child that is on is turned off, and the group
// sends its own value-changed message.
class UI_RadioGroup : public UI_ControlView {
 public:
  UI_RadioGroup();
  ~UI_RadioGroup() override;

  // Adds `radio` as the last child (null is an input-contract violation).
  void AddRadio(const boost::intrusive_ptr<UI_RadioButton>& radio);
  // The radio button children, in child order.
  std::vector<UI_RadioButton*> GetRadios() const;
  // The position among the radio buttons of the one that is on; -1 when none is.
  std::int32_t GetIndex() const;
  // Turns the radio button at `index` on and the others off; -1 turns all off.
  // Sends nothing. Other values are an input-contract violation.
  void SetIndex(std::int32_t index);
  void RadioChanged(UI_RadioButton* changed);

  bool UI_GainKeyboardFocusFromAdvance() override;

 private:
  std::vector<ControlCallbackP> subscriptions_;
};

}  // namespace velkui::controls
