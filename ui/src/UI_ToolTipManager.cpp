#include <velkui/ui/UI_ToolTipManager.h>

#include <chrono>
#include <cmath>
#include <utility>

#include <velkcore/Error.h>
#include <velkui/ui/UI_Node.h>
#include <velkui/ui/UI_NodeManager.h>

#include "NodeHold.h"

namespace velkui::ui {

namespace {

constexpr std::string_view kUnknownToolTipErrorKey =
    "$$$/velkui/ui/Error/UnknownToolTipError=Unknown tool tip error.";
constexpr std::int32_t kUnknownToolTipErrorNumber = 6;

double gInitialDisplayDelay = 0.75;
double gReDisplayDelay = 0.375;

double SteadySeconds() {
  using Seconds = std::chrono::duration<double>;
  return std::chrono::duration_cast<Seconds>(std::chrono::steady_clock::now().time_since_epoch())
      .count();
}

// Characters, not UTF-16 units: a surrogate pair counts once.
std::size_t CountCharacters(const velkcore::UTF16String& text) {
  std::size_t count = 0;
  for (const char16_t unit : text) {
    if (unit < 0xDC00 || unit > 0xDFFF) ++count;
  }
  return count;
}

UI_ToolTipManager* InstalledToolTipManager() {
  UI_NodeManager* manager = UI_NodeManager::Get(false);
  return manager != nullptr ? manager->GetToolTipManager() : nullptr;
}

}  // namespace

// ---- UI_ToolTip ----

UI_ToolTip::UI_ToolTip(velkcore::UTF16String text, UI_Node* owner, std::int32_t width)
    : text_(std::move(text)), owner_(owner), width_(width) {}

UI_ToolTip::~UI_ToolTip() = default;

void UI_ToolTip::SetLocation(const velkcore::PointT<float>& location) {
  location_ = location;
}

void UI_ToolTip::SetTrackingOffset(const velkcore::PointT<std::int32_t>& offset) {
  trackingOffset_ = offset;
}

void UI_ToolTip::Show() {
  shown_ = true;
}

void UI_ToolTip::Hide() {
  shown_ = false;
}

void UI_ToolTip::SetText(const velkcore::UTF16String& text) {
  if (text == text_) return;
  text_ = text;
  UpdateTooltipText();
}

void UI_ToolTip::ThrowGenericToolTipError() {
  velkcore::ThrowError(velkcore::ErrorLevel::kError, kUnknownToolTipErrorKey,
                       velkcore::kCategoryUserInterface, kUnknownToolTipErrorNumber);
}

// ---- UI_ToolTipManager ----

UI_ToolTipManager::UI_ToolTipManager(ToolTipFactory factory, Clock clock)
    : factory_(std::move(factory)),
      clock_(clock ? std::move(clock) : Clock(&SteadySeconds)),
      self_(std::make_shared<UI_ToolTipManager*>(this)) {}

UI_ToolTipManager::~UI_ToolTipManager() {
  *self_ = nullptr;
  if (displayed_) {
    const UI_ToolTipP tip = std::move(displayed_);
    tip->Hide();
  }
}

double UI_ToolTipManager::Now() const {
  return clock_();
}

void UI_ToolTipManager::SetTipsEnabled(bool enabled) {
  enabled_ = enabled;
  if (!enabled) DisposeTip();
}

void UI_ToolTipManager::DisplayTip(const velkcore::UTF16String& text, UI_Node* owner,
                                   std::int32_t width) {
  if (displayed_ && displayed_->IsOwner(owner) && displayed_->GetWidth() == width) {
    // The same tip with new text: updated in place, no flicker.
    displayed_->SetText(text);
    return;
  }
  if (!factory_) UI_ToolTip::ThrowGenericToolTipError();
  const UI_ToolTipP tip = factory_(text, owner, width);
  if (!tip) UI_ToolTip::ThrowGenericToolTipError();
  DisplayTip(tip);
}

void UI_ToolTipManager::DisplayTip(const UI_ToolTipP& tip) {
  velkcore::RequireInput(tip != nullptr);
  if (displayed_ == tip) return;
  if (displayed_) {
    const UI_ToolTipP old = std::move(displayed_);
    old->Hide();
  }
  displayed_ = tip;
  tip->UpdateTooltipText();
  tip->Show();
}

void UI_ToolTipManager::DisposeTip() {
  if (!displayed_) return;
  const UI_ToolTipP tip = std::move(displayed_);
  displayed_.reset();
  lastHidden_ = Now();
  tip->Hide();
}

bool UI_ToolTipManager::OwnerOfDisplayedTip(const UI_Node* node) const {
  return displayed_ && displayed_->IsOwner(node);
}

double UI_ToolTipManager::GetDisplayDelay() const {
  if (lastHidden_ && Now() - *lastHidden_ < gReDisplayDelay) return 0.0;
  return gInitialDisplayDelay;
}

double UI_ToolTipManager::GetDisplayTime() {
  return 5.0;
}

double UI_ToolTipManager::GetDisplayTime(const velkcore::UTF16String& text) {
  const std::size_t length = CountCharacters(text);
  if (length <= 50) return 5.0;
  if (length <= 100) return 10.0;
  return 20.0;
}

double UI_ToolTipManager::GetInitialDisplayDelay() {
  return gInitialDisplayDelay;
}

void UI_ToolTipManager::SetInitialDisplayDelay(double seconds) {
  velkcore::RequireInput(std::isfinite(seconds) && seconds >= 0.0);
  gInitialDisplayDelay = seconds;
}

double UI_ToolTipManager::GetReDisplayDelay() {
  return gReDisplayDelay;
}

void UI_ToolTipManager::SetReDisplayDelay(double seconds) {
  velkcore::RequireInput(std::isfinite(seconds) && seconds >= 0.0);
  gReDisplayDelay = seconds;
}

void UI_ToolTipManager::ApplicationActivationChanged(bool active) {
  applicationActive_ = active;
  if (!active) DisposeTip();
}

void UI_ToolTipManager::RegisterForActivationChanges(UI_NodeManager& manager) {
  applicationActive_ = manager.IsApplicationFrontmost();
  manager.InstallApplicationActivationChangedFunction(
      std::make_shared<UI_NodeManager::ActivationChangedFunction>([self = self_](bool active) {
        if (*self != nullptr) (*self)->ApplicationActivationChanged(active);
      }));
}

void UI_ToolTipManager::Suspend() {
  if (suspensions_++ == 0) DisposeTip();
}

void UI_ToolTipManager::Resume() {
  if (suspensions_ > 0) --suspensions_;
}

bool UI_ToolTipManager::CanShowTips() const {
  return enabled_ && suspensions_ == 0 && applicationActive_;
}

void UI_ToolTipManager::MouseOverLeafChanged(UI_Node* leaf) {
  if (leaf != nullptr && enabled_) {
    const NodeP keep = detail::Hold(leaf);
    if (!leaf->UI_DisplayToolTip(false)) DisposeTip();
    return;
  }
  DisposeTip();
}

void UI_ToolTipManager::ToolTipChanged(UI_Node& node) {
  UI_Node* leaf = UI_Node::UI_GetMouseOverLeafNode();
  const NodeP keep = detail::Hold(leaf);
  const bool carries = leaf != nullptr && leaf->UI_GetToolTipForDisplay() == &node;
  if (carries) {
    if (!leaf->UI_DisplayToolTip(false)) DisposeTip();
  } else if (OwnerOfDisplayedTip(&node)) {
    DisposeTip();
  }
}

void UI_ToolTipManager::NodeDestroyed(const UI_Node& node) {
  if (OwnerOfDisplayedTip(&node)) DisposeTip();
}

void UI_ToolTipManager::ToolTipTimerFired(UI_Node& node) {
  UI_Node* leaf = UI_Node::UI_GetMouseOverLeafNode();
  if (leaf == nullptr) return;
  const NodeP keep = detail::Hold(leaf);
  if (leaf->UI_GetToolTipForDisplay() != &node) return;
  if (OwnerOfDisplayedTip(&node)) {
    // Its display time ran out.
    DisposeTip();
    return;
  }
  leaf->UI_DisplayToolTip(true);
}

void UI_ToolTipManager::DismissForInput() {
  DisposeTip();
  if (UI_Node* leaf = UI_Node::UI_GetMouseOverLeafNode()) {
    const NodeP keep = detail::Hold(leaf);
    leaf->UI_GetToolTipForDisplay()->UI_RemoveTimer(kToolTipTimerID);
  }
}

// ---- UI_SuspendToolTips ----

UI_SuspendToolTips::UI_SuspendToolTips() : manager_(InstalledToolTipManager()) {
  if (manager_ != nullptr) manager_->Suspend();
}

UI_SuspendToolTips::~UI_SuspendToolTips() {
  if (manager_ != nullptr && manager_ == InstalledToolTipManager()) manager_->Resume();
}

// ---- UI_Node's tooltip display ----

UI_Node* UI_Node::UI_GetToolTipForDisplay() {
  UI_Node* node = this;
  while (UI_Node* parent = node->UI_GetParentNode()) {
    if (!parent->UI_DisplaysToolTipForChild(node)) break;
    node = parent;
  }
  return node;
}

bool UI_Node::UI_DisplayToolTip(bool now) {
  UI_ToolTipManager* tips = InstalledToolTipManager();
  if (tips == nullptr) return false;
  const NodeP keep = detail::Hold(this);
  UI_Node* const tipNode = UI_GetToolTipForDisplay();
  const NodeP keepTip = detail::Hold(tipNode);
  const velkcore::UTF16String text = tipNode->UI_GetToolTip();
  const std::int32_t width = tipNode->UI_GetToolTipWidth();
  // The tooltip timer needs a window to tick in.
  if (tips->CanShowTips() && !text.empty() && tipNode->UI_GetTimerManager(true) != nullptr) {
    if (!now && !tips->OwnerOfDisplayedTip(tipNode)) {
      tips->DisposeTip();
      tipNode->UI_InstallTimer(static_cast<float>(tips->GetDisplayDelay()), kToolTipTimerID);
    } else {
      tips->DisplayTip(text, tipNode, width);
      tipNode->UI_InstallTimer(static_cast<float>(UI_ToolTipManager::GetDisplayTime(text)),
                               kToolTipTimerID);
    }
    return true;
  }
  tips->DisposeTip();
  return false;
}

}  // namespace velkui::ui
