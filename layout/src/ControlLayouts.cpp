#include <velkui/layout/ControlLayouts.h>

#include <velkcore/Error.h>
#include <velkui/controls/UI_Checkbox.h>
#include <velkui/controls/UI_RadioButton.h>
#include <velkui/controls/UI_StaticText.h>
#include <velkui/controls/UI_TextButton.h>

namespace velkui::layout {

namespace {

PointF Padded(const PointF& recommended, float widthPadding) {
  return {recommended.x + widthPadding, recommended.y};
}

}  // namespace

UI_TextLayout::UI_TextLayout(const boost::intrusive_ptr<controls::UI_StaticText>& text,
                             const PointF& size, const pictel::SupplierInterface* supplier)
    : UI_NodeLayout(text, size) {
  if (text->IsMultiLine() && size.x > 0) {
    RectF frame = text->UI_GetLocalRectF(true);
    frame.width = size.x;
    text->UI_SetLocalRectF(frame);
  }
  GrowInitialSizeToFit(Padded(MeasureRecommendedSize(*text, supplier), kWidthPadding));
}

controls::UI_StaticText& UI_TextLayout::GetText() const {
  return *velkcore::CheckedCast<controls::UI_StaticText>(GetNode().get());
}

UI_TextButtonLayout::UI_TextButtonLayout(
    const boost::intrusive_ptr<controls::UI_TextButton>& button, const PointF& size,
    const pictel::SupplierInterface* supplier)
    : UI_NodeLayout(button, size) {
  GrowInitialSizeToFit(Padded(MeasureRecommendedSize(*button, supplier), kWidthPadding));
}

controls::UI_TextButton& UI_TextButtonLayout::GetButton() const {
  return *velkcore::CheckedCast<controls::UI_TextButton>(GetNode().get());
}

UI_CheckboxLayout::UI_CheckboxLayout(const boost::intrusive_ptr<controls::UI_Checkbox>& checkbox,
                                     const PointF& size, const pictel::SupplierInterface* supplier)
    : UI_NodeLayout(checkbox, size) {
  GrowInitialSizeToFit(Padded(MeasureRecommendedSize(*checkbox, supplier), kWidthPadding));
}

controls::UI_Checkbox& UI_CheckboxLayout::GetCheckbox() const {
  return *velkcore::CheckedCast<controls::UI_Checkbox>(GetNode().get());
}

UI_RadioButtonLayout::UI_RadioButtonLayout(
    const boost::intrusive_ptr<controls::UI_RadioButton>& radio, const PointF& size,
    const pictel::SupplierInterface* supplier)
    : UI_NodeLayout(radio, size) {
  GrowInitialSizeToFit(Padded(MeasureRecommendedSize(*radio, supplier), kWidthPadding));
}

controls::UI_RadioButton& UI_RadioButtonLayout::GetRadioButton() const {
  return *velkcore::CheckedCast<controls::UI_RadioButton>(GetNode().get());
}

}  // namespace velkui::layout
