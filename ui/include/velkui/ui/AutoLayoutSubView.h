#pragma once

#include <cstdint>

#include <velkui/ui/UI_SubView.h>

namespace velkui::ui {

// Sub-view layout flags (UI_SubView::UI_GetSubViewLayoutFlags) read by the auto layout.
inline constexpr std::uint8_t kSubViewAutoLayout = 0x01;
inline constexpr std::uint8_t kSubViewAutoLayoutHorizontal = 0x02;
inline constexpr std::uint8_t kSubViewAutoLayoutMaintainMargins = 0x04;
inline constexpr std::uint8_t kSubViewAutoLayoutScaleChildren = 0x08;

// Lays out the children of `view` one after the other along its axis (horizontal with
// kSubViewAutoLayoutHorizontal, else vertical), when its kSubViewAutoLayout flag is set:
// - the children are taken in order of their left (top) edge;
// - a child with its own auto-layout flag is laid out first and keeps the size that gives;
//   any other child first has the auto-layout views below it laid out, then grows (never
//   shrinks) to its recommended size, each grown dimension rounded up;
// - each child moves along the axis by the growth of the children before it (its origin
//   floored to whole numbers);
// - with kSubViewAutoLayoutScaleChildren every child gets the largest height (horizontal axis)
//   or the largest width (vertical axis);
// - when anything grew, the view is resized: with kSubViewAutoLayoutMaintainMargins by the
//   total growth (along the axis the sum, across it the largest), otherwise to the right-most
//   and bottom-most child edges; both dimensions rounded up.
// The view's layout-children switch is off meanwhile (and each child's while its frame is
// set), so that these resizings do not also apply edge bindings.
//
// A null view or drawing context raises the input-contract violation.
void AutoLayoutSubView(const SubViewP& view, pictel::Pictel* context);
// The same for a view held by reference.
void AutoLayoutSubView(UI_SubView& view, pictel::Pictel* context);

}  // namespace velkui::ui
