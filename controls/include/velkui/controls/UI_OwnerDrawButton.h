#pragma once

#include <functional>
#include <memory>

#include <velkui/controls/UI_Button.h>

namespace velkui::controls {

// A button whose whole drawing is left to the host.
class UI_OwnerDrawButton : public UI_Button {
 public:
  using OwnerDrawFunction =
      std::function<void(const UI_OwnerDrawButton& button, pictel::Pictel* context)>;
  using OwnerDrawFunctionP = std::shared_ptr<OwnerDrawFunction>;

  UI_OwnerDrawButton();
  ~UI_OwnerDrawButton() override;

  // Without a function (or with an empty one) the plain button body is drawn.
  void SetOwnerDrawFunction(const OwnerDrawFunctionP& function);
  const OwnerDrawFunctionP& GetOwnerDrawFunction() const { return ownerDraw_; }
  void UI_Draw(pictel::Pictel* context) const override;

 private:
  OwnerDrawFunctionP ownerDraw_;
};

}  // namespace velkui::controls
