#pragma once

#include <utility>
#include <vector>

#include <velkcore/Strings.h>
#include <velkui/controls/ControlAlignment.h>
#include <velkui/controls/UI_Button.h>
#include <velkui/controls/UI_TextControlBase.h>

namespace velkui::controls {

// A push button (or, not spring-loaded, a toggle) with a caption. The caption
// may carry a mnemonic ("&Save"); other captions may be shown while modifier
// keys are held (InsertModifiedName). A label text, when set, is drawn to the
// left of the button's body.
class UI_TextButton : public UI_Button, public UI_TextControlBase {
 public:
  static constexpr float kDefaultCornerRadius = 4.0f;

  UI_TextButton();
  explicit UI_TextButton(const velkcore::UTF16String& text);
  ~UI_TextButton() override;

  void UI_Draw(pictel::Pictel* context) const override;
  velkcore::PointT<float> UI_GetRecommendedSize(pictel::Pictel* context) override;
  bool UI_DoKeyboardEvent(ui::UI_Node* target, const ui::KeyboardEvent& event) override;
  void ModKeyChanged(ui::ModifierKeys modKeys) override;

  // The caption as given, mnemonic markup included.
  const velkcore::UTF16String& GetText() const { return text_; }
  void SetText(const velkcore::UTF16String& text);
  // The caption as shown now (markup stripped, modified name applied).
  const velkcore::UTF16String& GetDisplayText() const;
  // A modified name replaces the caption for the modifier keys held now.
  bool IsModifiedNameShown() const;

  ControlAlignment GetAlignment() const { return alignment_; }
  void SetAlignment(ControlAlignment alignment);
  float GetTextIndent() const { return textIndent_; }
  void SetTextIndent(float indent);

  void InsertModifiedName(ui::ModifierKeys keys, const velkcore::UTF16String& text);
  bool GetDisplayBorderNever() const { return displayBorderNever_; }
  void SetDisplayBorderNever(bool never);
  // Return and keypad Enter (not repeated) press the button too.
  bool GetSupportLegacyWindowsKeyboardActivation() const { return legacyActivation_; }
  void SetSupportLegacyWindowsKeyboardActivation(bool support) { legacyActivation_ = support; }

 protected:
  void TextSettingsChanged() override;

 private:
  class Face;

  velkcore::UTF16String text_;
  velkcore::UTF16String displayText_;
  std::vector<std::pair<ui::ModifierKeys, velkcore::UTF16String>> modifiedNames_;
  ControlAlignment alignment_ = kControlAlignCenter;
  float textIndent_ = 0;
  bool displayBorderNever_ = false;
  bool legacyActivation_ = false;
};

}  // namespace velkui::controls
