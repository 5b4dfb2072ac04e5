#include <velkui/controls/UI_RadioGroup.h>

#include <memory>

#include <velkcore/Error.h>

namespace velkui::controls {

UI_RadioGroup::UI_RadioGroup() {
  UI_SetNodeID("UI_RadioGroup");
}

UI_RadioGroup::~UI_RadioGroup() {
  // The radio buttons may outlive the group: their subscriptions end here.
  for (const ControlCallbackP& subscription : subscriptions_) *subscription = nullptr;
}

void UI_RadioGroup::AddRadio(const boost::intrusive_ptr<UI_RadioButton>& radio) {
  velkcore::RequireInput(radio != nullptr);
  UI_RadioButton* const added = radio.get();
  auto subscription = std::make_shared<ControlCallback>(
      [this, added](ui::MessageT<ui::UI_Node>*) { RadioChanged(added); });
  radio->NotifyWhenChanged(subscription);
  subscriptions_.push_back(subscription);
  ChildPushBack(radio);
}

std::vector<UI_RadioButton*> UI_RadioGroup::GetRadios() const {
  std::vector<UI_RadioButton*> radios;
  for (auto child = ChildBegin(); child != ChildEnd(); ++child) {
    if (auto* radio = dynamic_cast<UI_RadioButton*>(child->get())) radios.push_back(radio);
  }
  return radios;
}

std::int32_t UI_RadioGroup::GetIndex() const {
  const std::vector<UI_RadioButton*> radios = GetRadios();
  for (std::size_t i = 0; i < radios.size(); ++i) {
    if (radios[i]->IsOn()) return static_cast<std::int32_t>(i);
  }
  return -1;
}

void UI_RadioGroup::SetIndex(std::int32_t index) {
  const std::vector<UI_RadioButton*> radios = GetRadios();
  velkcore::RequireInput(index >= -1 && index < static_cast<std::int32_t>(radios.size()));
  for (std::size_t i = 0; i < radios.size(); ++i) {
    radios[i]->SetOn(static_cast<std::int32_t>(i) == index);
  }
}

void UI_RadioGroup::RadioChanged(UI_RadioButton* changed) {
  // A radio button that left the group no longer concerns it.
  if (changed == nullptr || changed->UI_GetParentNode() != this) return;
  const auto keep = KeepAlive();
  for (UI_RadioButton* radio : GetRadios()) {
    if (radio != changed && radio->IsOn()) radio->SetOn(false);
  }
  SendValueChangedMessage();
}

bool UI_RadioGroup::UI_GainKeyboardFocusFromAdvance() {
  return false;
}

}  // namespace velkui::controls
