#include "DialogGallery.h"

#include <cmath>
#include <vector>

#include <velkui/controls/UI_RadioButton.h>
#include <velkui/controls/UI_StaticText.h>
#include <velkui/layout/ControlLayouts.h>
#include <velkui/layout/LayoutJoiner.h>
#include <velkui/layout/Spacers.h>

namespace gallery {

namespace {

namespace controls = velkui::controls;
namespace layout = velkui::layout;
namespace ui = velkui::ui;
using layout::SmartLayoutP;
using velkcore::MakeIntrusive;

constexpr float kMargin = 18;
constexpr float kMessageWidth = 330;

ui::DialogParams ExportParams(ui::OS_Window* owner) {
  ui::DialogParams params;
  params.title = u"Export Mixdown";
  params.parent = owner;
  return params;
}

// `items` from top to bottom, `gap` apart.
SmartLayoutP Column(const std::vector<SmartLayoutP>& items, float gap) {
  SmartLayoutP column = items.back();
  for (auto item = items.rbegin() + 1; item != items.rend(); ++item) {
    column = MakeIntrusive<layout::LayoutJoiner>(
        MakeIntrusive<layout::SpacerOnTheBottom>(*item, gap, false), column,
        layout::LayoutPlacement_AboveDO::GetSharedPtr(), layout::ExtraSpace_Pass::GetSharedPtr());
  }
  return column;
}

// `items` from left to right, `gap` apart, pushed to the right end of their area.
SmartLayoutP RightAlignedRow(const std::vector<SmartLayoutP>& items, float gap) {
  SmartLayoutP row = items.back();
  for (auto item = items.rbegin() + 1; item != items.rend(); ++item) {
    row = MakeIntrusive<layout::LayoutJoiner>(
        MakeIntrusive<layout::SpacerOnTheRight>(*item, gap, false), row,
        layout::LayoutPlacement_LeftOfDO::GetSharedPtr(), layout::ExtraSpace_Pass::GetSharedPtr());
  }
  return MakeIntrusive<layout::SpacerOnTheLeft>(row, 0.0f, true);
}

template <typename Control>
boost::intrusive_ptr<Control> Shown(ui::UI_Node& parent, boost::intrusive_ptr<Control> control) {
  control->UI_Show(true);
  parent.ChildPushBack(control);
  return control;
}

}  // namespace

ExportDialog::ExportDialog(ui::OS_Window* owner) : UI_Dialog(ExportParams(owner)) {
  UI_SetNodeID("GalleryExportDialog");
  BuildContent();
}

void ExportDialog::BuildContent() {
  ui::UI_SubView& content = GetContentContainer();
  const velkui::pictel::SupplierInterface* supplier = UI_GetDrawSupplier();
  using PointF = layout::PointF;

  auto heading = Shown(content, MakeIntrusive<controls::UI_StaticText>(u"Export the mixdown"));
  heading->SetFontSize(14);
  heading->SetFontStyleName(u"Bold");
  auto message = Shown(content, MakeIntrusive<controls::UI_StaticText>(
                                    u"The selected tracks are rendered offline and written to "
                                    u"one file beside the session. Effects and automation are "
                                    u"applied as you hear them.",
                                    true));

  formats_ = Shown(content, MakeIntrusive<controls::UI_RadioGroup>());
  std::vector<SmartLayoutP> radios;
  for (const char16_t* label : {u"WAV, 24-bit", u"AIFF, 24-bit", u"FLAC, lossless"}) {
    auto radio = MakeIntrusive<controls::UI_RadioButton>(label);
    radio->UI_Show(true);
    formats_->AddRadio(radio);
    radios.push_back(MakeIntrusive<layout::UI_RadioButtonLayout>(radio, PointF{0, 20}, supplier));
  }
  formats_->SetIndex(0);
  auto normalize =
      Shown(content, MakeIntrusive<controls::UI_Checkbox>(u"Normalize peaks to \u22121 dB"));
  normalize->SetChecked(true);
  auto markers =
      Shown(content, MakeIntrusive<controls::UI_Checkbox>(u"Include markers and regions"));
  markers->SetChecked(false);
  cancel_ = Shown(content, MakeIntrusive<controls::UI_TextButton>(u"Cancel"));
  export_ = Shown(content, MakeIntrusive<controls::UI_TextButton>(u"Export"));
  SetButtons(export_, cancel_);

  // The radio buttons live in their group's coordinates.
  const SmartLayoutP group = MakeIntrusive<layout::ParentChildLayoutJoiner>(
      MakeIntrusive<layout::UI_NodeLayout>(formats_, PointF{0, 0}), Column(radios, 2));
  const SmartLayoutP column = Column(
      {MakeIntrusive<layout::UI_TextLayout>(heading, PointF{0, 0}, supplier),
       MakeIntrusive<layout::UI_TextLayout>(message, PointF{kMessageWidth, 0}, supplier), group,
       Column({MakeIntrusive<layout::UI_CheckboxLayout>(normalize, PointF{0, 20}, supplier),
               MakeIntrusive<layout::UI_CheckboxLayout>(markers, PointF{0, 20}, supplier)},
              2),
       RightAlignedRow(
           {MakeIntrusive<layout::UI_TextButtonLayout>(cancel_, PointF{84, 0}, supplier),
            MakeIntrusive<layout::UI_TextButtonLayout>(export_, PointF{84, 0}, supplier)},
           10)},
      12);
  const SmartLayoutP whole = MakeIntrusive<layout::SpacerOnAllSides>(column, kMargin);
  const PointF size = whole->GetInitialSize();
  SetContentSize(
      {static_cast<std::int32_t>(std::ceil(size.x)), static_cast<std::int32_t>(std::ceil(size.y))});
  const velkcore::RectT<float> client = content.UI_GetLocalRectF(false);
  whole->SetLocation({0, 0, client.width, client.height});
  Center();
}

}  // namespace gallery
