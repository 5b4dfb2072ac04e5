#pragma once

#include <velkcore/Strings.h>
#include <velkui/controls/ControlAlignment.h>
#include <velkui/controls/UI_ControlView.h>
#include <velkui/controls/UI_TextControlBase.h>

namespace velkui::controls {

// A piece of text that the user reads but does not change: one line
// (truncated as set) or several (wrapped at the width). The text is shown as
// given; ampersands are not mnemonic markup here.
class UI_StaticText : public UI_ControlView, public UI_TextControlBase {
 public:
  UI_StaticText();
  explicit UI_StaticText(const velkcore::UTF16String& text, bool multiLine = false);
  ~UI_StaticText() override;

  void UI_Draw(pictel::Pictel* context) const override;
  // One line: the text's width and line height. Several lines: the current
  // width (or 200 when the text has none) and the wrapped height.
  velkcore::PointT<float> UI_GetRecommendedSize(pictel::Pictel* context) override;

  const velkcore::UTF16String& GetText() const { return text_; }
  void SetText(const velkcore::UTF16String& text);
  bool IsMultiLine() const { return multiLine_; }
  void SetMultiLine(bool multiLine);
  ControlAlignment GetAlignment() const { return alignment_; }
  ControlVerticalAlignment GetVerticalAlignment() const { return verticalAlignment_; }
  void SetAlignment(ControlAlignment alignment,
                    ControlVerticalAlignment vertical = kControlAlignMiddle);

 protected:
  void TextSettingsChanged() override;

 private:
  velkcore::UTF16String text_;
  bool multiLine_ = false;
  ControlAlignment alignment_ = kControlAlignLeft;
  ControlVerticalAlignment verticalAlignment_ = kControlAlignMiddle;
};

// A separator line across its longer side.
class UI_Divider : public UI_ControlView {
 public:
  UI_Divider();
  ~UI_Divider() override;

  void UI_Draw(pictel::Pictel* context) const override;
  velkcore::PointT<float> UI_GetRecommendedSize(pictel::Pictel* context) override;
  bool IsVertical() const;
};

// Keeps the click that closed a popup from opening it again: a popup control
// calls EndPopup when its popup closes and opens it only when DoPopup agrees
// (never set, or more than 0.1 s ago).
class PopupToggler {
 public:
  static constexpr double kReopenDelay = 0.1;

  bool DoPopup() const;
  void EndPopup();

 private:
  double closedAt_ = -1.0;
  bool valid_ = false;
};

}  // namespace velkui::controls
