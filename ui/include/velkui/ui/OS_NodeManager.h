#pragma once

#include <memory>

#include <velkui/ui/UI_NodeManager.h>
#include <velkui/ui/UI_ToolTipManager.h>

namespace velkui::ui {

// The node manager of the platform layer: the pointer, the modifier keys and
// the keyboard queue come from the installed platform, and it owns the
// process's tooltip manager (tips are OS_ToolTip pop-ups timed on the
// platform clock). PlatformSession creates and installs it.
class OS_NodeManager : public UI_NodeManager {
 public:
  OS_NodeManager();
  ~OS_NodeManager() override;

  std::optional<velkcore::PointT<float>> QueryPointerPosition(const UI_Node& root) const override;
  ModifierKeys QueryModifierKeys() const override;
  void RemovePendingKeyboardMessages() override;
  void MouseOverLeafChangedForToolTips(UI_Node* newLeaf) override;
  void DisposeToolTipOwnedBy(UI_Node& node) override;
  void ToolTipChanged(UI_Node& node) override;
  void SuspendToolTips(bool suspend) override;
  UI_ToolTipManager* GetToolTipManager() override;

 private:
  std::unique_ptr<UI_ToolTipManager> toolTips_;
};

}  // namespace velkui::ui
