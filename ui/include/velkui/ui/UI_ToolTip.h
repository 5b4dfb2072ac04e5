#pragma once

#include <cstdint>
#include <optional>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/RefCountedObject.h>
#include <velkcore/Strings.h>
#include <velkui/ui/NodeTypes.h>

namespace velkui::ui {

// One tooltip: its text, the node it belongs to, an optional location (screen
// pixels; without one it appears below the pointer) and a width (0: one line
// as wide as the text; above 0: the text wraps at that width). The owner is
// held by plain pointer: a node that dies disposes of its displayed tip.
// The platform form (OS_ToolTip) shows it in a window.
class UI_ToolTip : public velkcore::RefCountedObject {
 public:
  UI_ToolTip(velkcore::UTF16String text, UI_Node* owner, std::int32_t width);
  ~UI_ToolTip() override;

  // ---- Virtual operations, in slot order ----
  // Shows the current text (after SetText, or when first displayed).
  virtual void UpdateTooltipText() = 0;
  virtual void SetLocation(const velkcore::PointT<float>& location);
  // Where the tip sits relative to the pointer when it has no location.
  virtual void SetTrackingOffset(const velkcore::PointT<std::int32_t>& offset);
  // The tooltip manager shows a tip when it displays it and hides it when it
  // disposes of it.
  virtual void Show();
  virtual void Hide();

  const velkcore::UTF16String& GetText() const { return text_; }
  void SetText(const velkcore::UTF16String& text);
  UI_Node* GetOwner() const { return owner_; }
  bool IsOwner(const UI_Node* node) const { return node != nullptr && node == owner_; }
  std::int32_t GetWidth() const { return width_; }
  const std::optional<velkcore::PointT<float>>& GetLocation() const { return location_; }
  const velkcore::PointT<std::int32_t>& GetTrackingOffset() const { return trackingOffset_; }
  bool IsShown() const { return shown_; }

  // Raises "Unknown tool tip error." (category 103, number 6).
  [[noreturn]] static void ThrowGenericToolTipError();

 private:
  friend class UI_ToolTipManager;

  velkcore::UTF16String text_;
  UI_Node* owner_;
  std::int32_t width_;
  std::optional<velkcore::PointT<float>> location_;
  velkcore::PointT<std::int32_t> trackingOffset_{0, 20};
  bool shown_ = false;
};

using UI_ToolTipP = boost::intrusive_ptr<UI_ToolTip>;

}  // namespace velkui::ui
