#pragma once

// A headless session for the window tests, and a few helpers to place input.

#include <memory>

#include <gtest/gtest.h>

#include <velkui/test/InputRecorder.h>
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

// A logging view that also keeps a copy of every mouse and keyboard event.
using RecordingView = velkui::test::InputRecorder<LoggingView>;
using RecordingViewP = boost::intrusive_ptr<RecordingView>;

}  // namespace velkui::ui::test
