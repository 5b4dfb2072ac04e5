#include <velkui/ui/UI_LayoutView.h>

namespace velkui::ui {

UI_LayoutView::UI_LayoutView() = default;
UI_LayoutView::~UI_LayoutView() = default;

void UI_LayoutView::SetLayoutMode(std::uint32_t mode) {
  SetFlag(kSubViewAutoLayoutHorizontal, mode == kLayoutHorizontal);
}

std::uint32_t UI_LayoutView::GetLayoutMode() const {
  return HasFlag(kSubViewAutoLayoutHorizontal) ? kLayoutHorizontal : kLayoutVertical;
}

void UI_LayoutView::AutoLayout(pictel::Pictel* context) {
  AutoLayoutSubView(*this, context);
}

void UI_LayoutView::SetFlag(std::uint8_t flag, bool on) {
  velkcore::Flags<std::uint8_t> flags = UI_GetSubViewLayoutFlags();
  flags.Set(flag, on);
  UI_SetSubViewLayoutFlags(flags);
}

}  // namespace velkui::ui
