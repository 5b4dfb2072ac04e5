#pragma once

#include <cstdint>

#include <velkui/ui/AutoLayoutSubView.h>
#include <velkui/ui/UI_SubView.h>

namespace velkui::ui {

// A sub-view that lays its children out automatically (see AutoLayoutSubView); its properties
// are the sub-view layout flags. It draws nothing of its own.
class UI_LayoutView : public UI_SubView {
 public:
  // Horizontal layout mode (GetLayoutMode); any other mode lays out vertically.
  static constexpr std::uint32_t kLayoutHorizontal = 0;
  static constexpr std::uint32_t kLayoutVertical = 1;

  UI_LayoutView();
  ~UI_LayoutView() override;

  // 0 lays the children out horizontally, any other value vertically.
  void SetLayoutMode(std::uint32_t mode);
  std::uint32_t GetLayoutMode() const;
  void SetScaleChildren(bool scale) { SetFlag(kSubViewAutoLayoutScaleChildren, scale); }
  bool GetScaleChildren() const { return HasFlag(kSubViewAutoLayoutScaleChildren); }
  void SetMaintainMargins(bool maintain) { SetFlag(kSubViewAutoLayoutMaintainMargins, maintain); }
  bool GetMaintainMargins() const { return HasFlag(kSubViewAutoLayoutMaintainMargins); }
  void SetLayoutEnabled(bool enabled) { SetFlag(kSubViewAutoLayout, enabled); }
  bool GetLayoutEnabled() const { return HasFlag(kSubViewAutoLayout); }

  // Lays the children out now (nothing while layout is disabled). A null context raises the
  // input-contract violation.
  void AutoLayout(pictel::Pictel* context);

 private:
  void SetFlag(std::uint8_t flag, bool on);
  bool HasFlag(std::uint8_t flag) const { return UI_GetSubViewLayoutFlags().IsSet(flag); }
};

using LayoutViewP = boost::intrusive_ptr<UI_LayoutView>;

}  // namespace velkui::ui
