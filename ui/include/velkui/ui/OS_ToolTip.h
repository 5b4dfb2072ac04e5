#pragma once

#include <cstdint>

#include <velkui/ui/OS_PopupWindow.h>
#include <velkui/ui/UI_ToolTip.h>

namespace velkui::ui {

// The library-drawn tooltip: a pop-up window with a rounded bubble in the
// theme's tooltip colours (130 background, 131 text, 132 outline) and the
// theme's first font. A width of 0 makes one line per line of text, wrapped
// at 400 pixels at most; a positive width wraps the text at that width. The
// bubble sits below the pointer (the tracking offset) or at the location, and
// stays on the pointer's monitor.
class OS_ToolTip : public UI_ToolTip {
 public:
  OS_ToolTip(velkcore::UTF16String text, UI_Node* owner, std::int32_t width);
  ~OS_ToolTip() override;

  void UpdateTooltipText() override;
  void SetLocation(const velkcore::PointT<float>& location) override;
  void SetTrackingOffset(const velkcore::PointT<std::int32_t>& offset) override;
  void Show() override;
  void Hide() override;

  // The pop-up (null until first shown).
  OS_PopupWindow* GetWindow() const { return window_.get(); }

 private:
  // The bubble's size for the current text.
  velkcore::PointT<std::int32_t> MeasureBubble() const;
  void Place();

  OS_PopupWindowP window_;
};

}  // namespace velkui::ui
