#pragma once

// A headless session for the window tests, and a few helpers to place input.

#include <memory>

#include <gtest/gtest.h>

#include <velkui/ui/HeadlessPlatform.h>
#include <velkui/ui/OS_Window.h>
#include <velkui/ui/PlatformSession.h>

#include "NodeTestSupport.h"

namespace velkui::ui::test {

class WindowTest : public ::testing::Test {
 protected:
  PlatformSession session{std::make_unique<HeadlessPlatform>()};
  HeadlessPlatform& headless = HeadlessPlatform::Get();
  std::shared_ptr<EventLog> log = std::make_shared<EventLog>();

  // A shown top-level window whose client area is `client` (screen pixels).
  OS_WindowP MakeWindow(const RectT<std::int32_t>& client,
                        std::uint32_t style = kStylePopup | kStyleClipSiblings,
                        std::uint32_t exStyle = 0) {
    auto window = velkcore::MakeIntrusive<OS_Window>(u"Window", client, style, exStyle);
    window->UI_Show(true);
    headless.ProcessEvents();
    return window;
  }
  LoggingViewP View(UI_Node* parent, const RectT<float>& frame, const std::string& name) {
    return MakeView(parent, frame, name, log);
  }
  static PlatformWindow Handle(OS_Window& window) { return window.GetPlatformWindow(false); }
  // The screen point of a point in `window`'s client area.
  PointT<std::int32_t> Screen(OS_Window& window, std::int32_t x, std::int32_t y) {
    const RectT<std::int32_t> client = headless.GetClientRect(Handle(window));
    return {client.left + x, client.top + y};
  }
  void MoveTo(OS_Window& window, std::int32_t x, std::int32_t y) {
    headless.MovePointer(Screen(window, x, y));
  }
  // Posts a raw message to `window`, time-stamped now.
  void Post(OS_Window& window, std::uint32_t message, std::uint64_t w = 0, std::int64_t l = 0) {
    headless.PostEvent(OS_Event(Handle(window), message, w, l, headless.GetTime()));
  }
  void ClearLog() { log->clear(); }
};

}  // namespace velkui::ui::test

namespace velkui::ui::test {

// A view that keeps a copy of every mouse and keyboard event it is offered.
class RecordingView : public LoggingView {
 public:
  using LoggingView::LoggingView;

  std::vector<MouseEvent> mouse;
  std::vector<KeyboardEvent> keys;

  bool UI_DoMouseEvent(UI_Node* target, const MouseEvent& event) override {
    mouse.push_back(event);
    return LoggingView::UI_DoMouseEvent(target, event);
  }
  bool UI_DoKeyboardEvent(UI_Node* target, const KeyboardEvent& event) override {
    keys.push_back(event);
    return LoggingView::UI_DoKeyboardEvent(target, event);
  }
  // The events of one action only.
  std::vector<MouseEvent> MouseOf(MouseEvent::Action action) const {
    std::vector<MouseEvent> found;
    for (const MouseEvent& e : mouse) {
      if (e.GetAction() == action) found.push_back(e);
    }
    return found;
  }
  std::u16string Typed() const {
    std::u16string text;
    for (const KeyboardEvent& e : keys) {
      if (e.IsActionKeyChar() && e.GetNumCharacters() > 0) text += e.GetCharacter(0);
    }
    return text;
  }
};

using RecordingViewP = boost::intrusive_ptr<RecordingView>;

}  // namespace velkui::ui::test
