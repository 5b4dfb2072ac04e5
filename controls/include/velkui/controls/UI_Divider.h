#pragma once

#include <optional>

#include <velkui/arrange/ISeparator.h>
#include <velkui/controls/UI_ControlView.h>

namespace velkui::controls {

// A separator line along its longer side, unless an arrangement placed it in a
// gap: then it runs across the gap whatever its shape.
class UI_Divider : public UI_ControlView, public arrange::ISeparator {
 public:
  UI_Divider();
  ~UI_Divider() override;

  void UI_Draw(pictel::Pictel* context) const override;
  velkcore::PointT<float> UI_GetRecommendedSize(pictel::Pictel* context) override;
  bool IsVertical() const;

  // The frame arrives in the coordinates of the view that holds the divider.
  void SetSeparatorFrame(bool acrossColumn, const arrange::RectF& frame) override;

 private:
  std::optional<bool> vertical_;  // set by an arrangement
};

}  // namespace velkui::controls
