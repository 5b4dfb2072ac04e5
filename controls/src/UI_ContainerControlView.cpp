#include <velkui/controls/UI_ContainerControlView.h>

#include <velkcore/Error.h>

namespace velkui::controls {

UI_ContainerControlView::UI_ContainerControlView() {
  UI_SetNodeID("UI_ContainerControlView");
  auto container = velkcore::MakeIntrusive<ui::UI_SubView>();
  container->UI_Show(true);
  ChildPushBack(container);
}

UI_ContainerControlView::~UI_ContainerControlView() = default;

ui::UI_SubView* UI_ContainerControlView::GetContainer() {
  velkcore::RequireInput(ChildSize() > 0);
  return velkcore::CheckedCast<ui::UI_SubView>(ChildGet(0).get());
}

const ui::UI_SubView* UI_ContainerControlView::GetContainer() const {
  velkcore::RequireInput(ChildSize() > 0);
  return velkcore::CheckedCast<const ui::UI_SubView>(ChildGet(0).get());
}

void UI_ContainerControlView::UI_SizeChanged(const velkcore::RectT<float>& newLocalRect) {
  if (ChildSize() > 0) {
    GetContainer()->UI_SetLocalRectF({0, 0, newLocalRect.width, newLocalRect.height});
  }
  UI_ControlView::UI_SizeChanged(newLocalRect);
}

}  // namespace velkui::controls
