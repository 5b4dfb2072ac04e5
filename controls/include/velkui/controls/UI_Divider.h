#pragma once

#include <velkui/controls/UI_ControlView.h>

namespace velkui::controls {

// A separator line across its longer side.
class UI_Divider : public UI_ControlView {
 public:
  UI_Divider();
  ~UI_Divider() override;

  void UI_Draw(pictel::Pictel* context) const override;
  velkcore::PointT<float> UI_GetRecommendedSize(pictel::Pictel* context) override;
  bool IsVertical() const;
};

}  // namespace velkui::controls
