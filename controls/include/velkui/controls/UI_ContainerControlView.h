#pragma once

#include <velkui/controls/UI_ControlView.h>

namespace velkui::controls {

// A control that holds a container of controls as its first child, sized to
// fill it. The container is a plain sub-view until the rearrangeable controls
// container takes its place.
class UI_ContainerControlView : public UI_ControlView {
 public:
  UI_ContainerControlView();
  ~UI_ContainerControlView() override;

  ui::UI_SubView* GetContainer();
  const ui::UI_SubView* GetContainer() const;

  void UI_SizeChanged(const velkcore::RectT<float>& newLocalRect) override;
};

}  // namespace velkui::controls
