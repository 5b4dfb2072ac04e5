#pragma once

#include <velkcore/Strings.h>
#include <velkui/controls/ControlAlignment.h>
#include <velkui/controls/UI_ControlView.h>
#include <velkui/controls/UI_Divider.h>
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

}  // namespace velkui::controls
