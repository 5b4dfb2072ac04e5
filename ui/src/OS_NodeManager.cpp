#include <velkui/ui/OS_NodeManager.h>

#include <velkui/ui/OS_ToolTip.h>
#include <velkui/ui/OS_Window.h>
#include <velkui/ui/Platform.h>

namespace velkui::ui {

OS_NodeManager::OS_NodeManager()
    : toolTips_(std::make_unique<UI_ToolTipManager>(
          [](const velkcore::UTF16String& text, UI_Node* owner, std::int32_t width) {
            return UI_ToolTipP(new OS_ToolTip(text, owner, width));
          },
          [] {
            const Platform* platform = GetPlatformIfAny();
            return platform != nullptr ? platform->GetTime() : 0.0;
          })) {
  toolTips_->RegisterForActivationChanges(*this);
}

OS_NodeManager::~OS_NodeManager() {
  // The tip's window goes while the manager is still whole.
  toolTips_.reset();
}

std::optional<velkcore::PointT<float>> OS_NodeManager::QueryPointerPosition(
    const UI_Node& root) const {
  const auto* window = dynamic_cast<const OS_Window*>(&root);
  const Platform* platform = GetPlatformIfAny();
  if (window == nullptr || platform == nullptr) return UI_NodeManager::QueryPointerPosition(root);
  const PlatformWindow handle = const_cast<OS_Window*>(window)->GetPlatformWindow(false);
  if (handle == kNoPlatformWindow) return UI_NodeManager::QueryPointerPosition(root);
  const velkcore::PointT<std::int32_t> pointer = platform->GetPointerPosition();
  const velkcore::RectT<std::int32_t> client = platform->GetClientRect(handle);
  return velkcore::PointT<float>{static_cast<float>(pointer.x - client.left),
                                 static_cast<float>(pointer.y - client.top)};
}

ModifierKeys OS_NodeManager::QueryModifierKeys() const {
  const Platform* platform = GetPlatformIfAny();
  return platform != nullptr ? platform->GetModifierKeys() : UI_NodeManager::QueryModifierKeys();
}

void OS_NodeManager::RemovePendingKeyboardMessages() {
  // Focus moved on a Tab press: its own character must not reach the new
  // focus, but keys typed ahead must.
  if (Platform* platform = GetPlatformIfAny()) platform->RemovePendingCharacter(u'\t');
}

void OS_NodeManager::MouseOverLeafChangedForToolTips(UI_Node* newLeaf) {
  if (toolTips_) toolTips_->MouseOverLeafChanged(newLeaf);
}

void OS_NodeManager::DisposeToolTipOwnedBy(UI_Node& node) {
  if (toolTips_) toolTips_->NodeDestroyed(node);
}

void OS_NodeManager::ToolTipChanged(UI_Node& node) {
  if (toolTips_) toolTips_->ToolTipChanged(node);
}

void OS_NodeManager::SuspendToolTips(bool suspend) {
  if (!toolTips_) return;
  if (suspend) {
    toolTips_->Suspend();
  } else {
    toolTips_->Resume();
  }
}

UI_ToolTipManager* OS_NodeManager::GetToolTipManager() {
  return toolTips_.get();
}

}  // namespace velkui::ui
