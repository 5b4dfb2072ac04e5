#pragma once

// A session on the X11 backend (the display comes from run-under-xvfb), views
// that record what reaches them, and a pump that waits for the real server
// with a time limit instead of hanging.

#include <chrono>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include <velkcore/RefCountedObject.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/test/InputRecorder.h>
#include <velkui/test/PixelProbe.h>
#include <velkui/ui/KeyboardEvent.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/OS_MessagePump.h>
#include <velkui/ui/OS_Window.h>
#include <velkui/ui/PlatformSession.h>
#include <velkui/ui/UI_Container.h>
#include <velkui/ui/UI_SubView.h>

#include "X11Platform.h"

namespace velkui::ui::x11test {

using velkcore::PointT;
using velkcore::RectT;
using velkui::test::Pixel;
using velkui::test::PixelProbe;

// A view painted in one colour that keeps every mouse and keyboard event.
class RecordingView : public velkui::test::InputRecorder<UI_SubView> {
 public:
  explicit RecordingView(pictel::ColorRGBA color, std::string name = "view") : color(color) {
    UI_SetNodeID(name);
  }

  pictel::ColorRGBA color;
  bool wantsFocus = false;
  // "down", "up", "keydown", "keyup", "char" in the order they came.
  std::vector<std::string> order;
  std::function<void(const MouseEvent&)> onMouse;
  int draws = 0;

  bool UI_DoMouseEvent(UI_Node* target, const MouseEvent& event) override {
    InputRecorder::UI_DoMouseEvent(target, event);
    if (event.GetAction() == MouseEvent::kButtonDown) order.push_back("down");
    if (event.GetAction() == MouseEvent::kButtonUp) order.push_back("up");
    if (onMouse) onMouse(event);
    return event.GetAction() != MouseEvent::kMove;
  }
  bool UI_DoKeyboardEvent(UI_Node* target, const KeyboardEvent& event) override {
    InputRecorder::UI_DoKeyboardEvent(target, event);
    order.push_back(event.IsActionKeyDown() ? "keydown" : event.IsActionKeyUp() ? "keyup" : "char");
    return true;
  }
  bool UI_WantsKeyboardFocus() const override { return wantsFocus; }
  void UI_Draw(pictel::Pictel* context) const override {
    ++const_cast<RecordingView*>(this)->draws;
    context->GetSurface()->PaintRect(color, UI_GetLocalRectF(false));
    UI_SubView::UI_Draw(context);
  }

  std::vector<std::int16_t> KeyDownCodes() const {
    std::vector<std::int16_t> codes;
    for (const KeyboardEvent& e : keys) {
      if (e.IsActionKeyDown()) codes.push_back(e.GetOSCode());
    }
    return codes;
  }
};
using RecordingViewP = boost::intrusive_ptr<RecordingView>;

inline Pixel PixelOf(const pictel::ColorRGBA& c) {
  const auto byte = [](float v) { return static_cast<std::uint8_t>(v * 255.0f + 0.5f); };
  return {byte(c.red), byte(c.green), byte(c.blue), 255};
}

class X11Test : public ::testing::Test {
 protected:
  PlatformSession session{CreatePlatform("x11")};
  X11Platform& x11 = X11Platform::Get();

  // Dispatches messages until `done` holds or `seconds` pass; answers `done()`.
  bool PumpUntil(const std::function<bool()>& done, double seconds = 5.0) {
    const auto deadline = std::chrono::steady_clock::now() + std::chrono::duration<double>(seconds);
    for (;;) {
      OS_DispatchPendingEvents();
      if (done()) return true;
      const double left =
          std::chrono::duration<double>(deadline - std::chrono::steady_clock::now()).count();
      if (left <= 0) return done();
      x11.WaitForActivity(std::min(left, 0.05));
    }
  }
  // Dispatches everything for a while (for "nothing more happens" checks).
  void PumpFor(double seconds) {
    PumpUntil([] { return false; }, seconds);
  }

  // A shown, active top-level window whose client area is `client`.
  OS_WindowP MakeWindow(const RectT<std::int32_t>& client,
                        std::uint32_t style = kStylePopup | kStyleClipSiblings,
                        std::uint32_t exStyle = 0) {
    auto window = velkcore::MakeIntrusive<OS_Window>(u"Test window", client, style, exStyle);
    window->SetBackgroundColor(pictel::ColorRGBA{1, 1, 1, 1});
    window->UI_Show(true);
    const PlatformWindow handle = Handle(*window);
    EXPECT_TRUE(
        PumpUntil([&] { return x11.GetPaintCount(handle) > 0 && !x11.HasPendingPaint(handle); }));
    return window;
  }
  RecordingViewP AddView(UI_Container& parent, const RectT<float>& frame, pictel::ColorRGBA color,
                         std::string name = "view") {
    auto view = velkcore::MakeIntrusive<RecordingView>(color, std::move(name));
    view->UI_SetLocalRectF(frame);
    view->UI_Show(true);
    parent.ChildPushBack(view);
    return view;
  }
  static PlatformWindow Handle(OS_Window& window) { return window.GetPlatformWindow(false); }
  PointT<std::int32_t> Screen(OS_Window& window, std::int32_t x, std::int32_t y) {
    const RectT<std::int32_t> client = x11.GetClientRect(Handle(window));
    return {client.left + x, client.top + y};
  }
  // The pixel the server shows at a client point of `window`.
  Pixel ShownPixel(OS_Window& window, std::int32_t x, std::int32_t y) {
    return PixelProbe(*x11.CaptureWindowPixels(Handle(window))).At(x, y);
  }
  void Click(OS_Window& window, std::int32_t x, std::int32_t y, std::int32_t button = 1) {
    x11.InjectPointerMove(Screen(window, x, y));
    x11.InjectButton(button, true);
    x11.InjectButton(button, false);
  }
  void TypeKey(std::int16_t key, bool extended = false) {
    x11.InjectKey(key, extended, true);
    x11.InjectKey(key, extended, false);
  }
};

}  // namespace velkui::ui::x11test
