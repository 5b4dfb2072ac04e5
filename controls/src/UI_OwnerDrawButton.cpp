#include <velkui/controls/UI_OwnerDrawButton.h>

namespace velkui::controls {

UI_OwnerDrawButton::UI_OwnerDrawButton() {
  UI_SetNodeID("UI_OwnerDrawButton");
}

UI_OwnerDrawButton::~UI_OwnerDrawButton() = default;

void UI_OwnerDrawButton::SetOwnerDrawFunction(const OwnerDrawFunctionP& function) {
  ownerDraw_ = function;
  InvalidateAll();
}

void UI_OwnerDrawButton::UI_Draw(pictel::Pictel* context) const {
  if (ownerDraw_ && *ownerDraw_) {
    const OwnerDrawFunction draw = *ownerDraw_;
    draw(*this, context);
  } else {
    UI_Button::Draw(DrawButtonParameters(this), context);
  }
  UI_Button::UI_Draw(context);
}

}  // namespace velkui::controls
