#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>

#include <velkcore/Strings.h>
#include <velkui/ui/NodeTypes.h>
#include <velkui/ui/UI_ToolTip.h>

namespace velkui::ui {

class UI_NodeManager;

// The process's tooltips (one manager, owned by the platform's node manager):
// which tip is displayed, when the last one was hidden, whether tips are
// enabled and whether something (an input capture, an inactive application)
// holds them back. A tip is shown after a delay once the pointer rests on a
// node with tooltip text, and hidden after a display time that grows with the
// length of the text; both run on the node's tooltip timer (kToolTipTimerID).
class UI_ToolTipManager {
 public:
  // Makes the platform form of a tip (a tooltip window).
  using ToolTipFactory = std::function<UI_ToolTipP(const velkcore::UTF16String& text,
                                                   UI_Node* owner, std::int32_t width)>;
  // Seconds on a monotonic clock.
  using Clock = std::function<double()>;

  // Without a factory no tip can be displayed (the generic tooltip error);
  // without a clock the process's steady clock is used.
  explicit UI_ToolTipManager(ToolTipFactory factory = {}, Clock clock = {});
  ~UI_ToolTipManager();
  UI_ToolTipManager(const UI_ToolTipManager&) = delete;
  UI_ToolTipManager& operator=(const UI_ToolTipManager&) = delete;

  void SetTipsEnabled(bool enabled);
  bool GetTipsEnabled() const { return enabled_; }

  // Displays a new tip for `owner` in place of the displayed one. A factory
  // that fails raises the generic tooltip error.
  void DisplayTip(const velkcore::UTF16String& text, UI_Node* owner, std::int32_t width);
  void DisplayTip(const UI_ToolTipP& tip);
  // Hides and forgets the displayed tip (remembering when, for the re-display delay).
  void DisposeTip();
  bool OwnerOfDisplayedTip(const UI_Node* node) const;
  UI_ToolTip* GetDisplayedTip() const { return displayed_.get(); }

  // 0 when the last tip was hidden less than the re-display delay ago, so that
  // moving from one control to the next shows tips at once; else the initial delay.
  double GetDisplayDelay() const;
  // 5 s.
  static double GetDisplayTime();
  // 5 s for up to 50 characters, 10 s up to 100, 20 s beyond.
  static double GetDisplayTime(const velkcore::UTF16String& text);
  static double GetInitialDisplayDelay();
  static void SetInitialDisplayDelay(double seconds);
  static double GetReDisplayDelay();
  static void SetReDisplayDelay(double seconds);

  // An inactive application shows no tips; deactivation hides the displayed one.
  void ApplicationActivationChanged(bool active);
  // Follows `manager`'s application activation from now on.
  void RegisterForActivationChanges(UI_NodeManager& manager);

  // Suspension (input captures hold one): the displayed tip goes and no new
  // tip is shown until every suspension is lifted.
  void Suspend();
  void Resume();
  bool IsSuspended() const { return suspensions_ > 0; }
  // Tips enabled, nothing suspending them, the application active.
  bool CanShowTips() const;

  // ---- Hooks of the node manager ----
  // The mouse-over leaf changed (null: the pointer left every window).
  void MouseOverLeafChanged(UI_Node* leaf);
  // `node`'s tooltip text changed.
  void ToolTipChanged(UI_Node& node);
  // `node` is being destroyed: only its non-virtual parts may be read.
  void NodeDestroyed(const UI_Node& node);
  // `node`'s tooltip timer ticked (it has already been removed).
  void ToolTipTimerFired(UI_Node& node);
  // A click or a key press: the displayed tip goes and the pending one is
  // dropped; the next tip waits until the pointer moves to another node.
  void DismissForInput();

 private:
  double Now() const;

  ToolTipFactory factory_;
  Clock clock_;
  bool enabled_ = true;
  bool applicationActive_ = true;
  std::int32_t suspensions_ = 0;
  UI_ToolTipP displayed_;
  std::optional<double> lastHidden_;
  // Callbacks installed elsewhere reach the manager through this, which the
  // destructor clears.
  std::shared_ptr<UI_ToolTipManager*> self_;
};

// Holds tooltips back for a scope (no effect when there is no tooltip manager).
class UI_SuspendToolTips {
 public:
  UI_SuspendToolTips();
  ~UI_SuspendToolTips();
  UI_SuspendToolTips(const UI_SuspendToolTips&) = delete;
  UI_SuspendToolTips& operator=(const UI_SuspendToolTips&) = delete;

 private:
  UI_ToolTipManager* manager_;
};

}  // namespace velkui::ui
