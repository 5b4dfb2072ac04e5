#pragma once

#include <cstdint>

#include <boost/intrusive_ptr.hpp>

#include <velkcore/Geometry.h>
#include <velkcore/RefCountedObject.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/NodeTypes.h>
#include <velkui/ui/UI_Node.h>

namespace velkui::ui {

// A capture of all input by one node for the length of a gesture (usually a
// drag started by a press). Install it with UI_NodeManager::BeginInputCapture;
// while it is active every mouse and keyboard event goes to it.
class InputCapture : public velkcore::RefCountedObject {
 public:
  InputCapture(UI_Node* node, const MouseEvent& initialEvent);
  ~InputCapture() override;

  // ---- Virtual operations, in slot order ----
  virtual void Begin();
  virtual void End();
  virtual bool DoMouseEvent(const MouseEvent& event);
  virtual bool DoKeyboardEvent(const KeyboardEvent& event);
  virtual bool DoCursor(const velkcore::PointT<float>& point, ModifierKeys modifiers);
  virtual bool DoTimerNotify(std::int32_t id);

  UI_Node* GetNode() const { return node_.get(); }
  const MouseEvent& GetInitialMouseEvent() const { return initialEvent_; }
  const MouseEvent& GetPreviousMouseEvent() const { return previousEvent_; }
  // Only marks the capture cancelled: events flow normally again, but the
  // capture stays installed until someone ends it.
  void Cancel() { cancelled_ = true; }
  bool HasBeenCancelled() const { return cancelled_; }
  bool HasBegun() const { return begun_; }
  bool HasEnded() const { return ended_; }
  bool HasPlatformCapture() const { return platformCapture_; }

 private:
  friend class UI_NodeManager;

  NodeP node_;
  MouseEvent initialEvent_;
  MouseEvent previousEvent_;
  bool cancelled_ = false;
  bool begun_ = false;
  bool ended_ = false;
  bool platformCapture_ = false;
  bool toolTipsSuspended_ = false;
};

using InputCaptureP = boost::intrusive_ptr<InputCapture>;

}  // namespace velkui::ui
