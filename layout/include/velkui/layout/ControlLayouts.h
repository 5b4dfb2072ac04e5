#pragma once

#include <boost/intrusive_ptr.hpp>

#include <velkui/layout/UI_NodeLayout.h>

namespace velkui::controls {
class UI_Checkbox;
class UI_RadioButton;
class UI_StaticText;
class UI_TextButton;
}  // namespace velkui::controls

namespace velkui::pictel {
class SupplierInterface;
}

namespace velkui::layout {

// The layouts of the common controls of fixed dialogs. Each is made from its
// control, an initial size and the supplier that will draw the control; the
// control is measured once, with a drawing context over a 1 × 1 offscreen
// surface of that supplier, and the initial size grows (never shrinks) to the
// recommended size plus the layout's padding, rounded up to whole pixels.
// Measure again by making a new layout when the control's text changes.
// A null control or supplier is an input-contract violation; the typed
// getters raise the invalid type conversion once SetNode gave the layout a
// node of another kind.

// A static text. A multi-line text wraps at the given width when it is above
// 0 (the text's width is set to it before measuring), else at its own width.
class UI_TextLayout : public UI_NodeLayout {
 public:
  static constexpr float kWidthPadding = 0.0f;

  UI_TextLayout(const boost::intrusive_ptr<controls::UI_StaticText>& text, const PointF& size,
                const pictel::SupplierInterface* supplier);
  controls::UI_StaticText& GetText() const;
};

// A text button: 5 pixels wider than it recommends.
class UI_TextButtonLayout : public UI_NodeLayout {
 public:
  static constexpr float kWidthPadding = 5.0f;

  UI_TextButtonLayout(const boost::intrusive_ptr<controls::UI_TextButton>& button,
                      const PointF& size, const pictel::SupplierInterface* supplier);
  controls::UI_TextButton& GetButton() const;
};

// A check box with its label. Its label is measured with the drawing context's
// font engine; the padding keeps a label from being truncated where the
// window's text comes out a few pixels wider.
class UI_CheckboxLayout : public UI_NodeLayout {
 public:
  static constexpr float kWidthPadding = 4.0f;

  UI_CheckboxLayout(const boost::intrusive_ptr<controls::UI_Checkbox>& checkbox, const PointF& size,
                    const pictel::SupplierInterface* supplier);
  controls::UI_Checkbox& GetCheckbox() const;
};

// A radio button with its label, padded like the check box.
class UI_RadioButtonLayout : public UI_NodeLayout {
 public:
  static constexpr float kWidthPadding = 4.0f;

  UI_RadioButtonLayout(const boost::intrusive_ptr<controls::UI_RadioButton>& radio,
                       const PointF& size, const pictel::SupplierInterface* supplier);
  controls::UI_RadioButton& GetRadioButton() const;
};

}  // namespace velkui::layout
