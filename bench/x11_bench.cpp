// The X11 backend on a real server (run it under Xvfb, or any display):
//
//   tests/x11/run-under-xvfb is for the tests; for this program:
//   xvfb-run -a -s "-screen 0 1280x800x24" build/bench/x11_bench
//
// ClickToRepaintedPixels: an XTest click on a node that changes its colour
// when pressed, until the server shows the new colour (read back with
// XGetImage); 100 clicks, with the median and the 90th percentile.
// IdleWindowCpu: the CPU time the process spends in its message loop over
// 5 seconds with a window open and nothing happening.
#include <benchmark/benchmark.h>

#include <time.h>

#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <functional>
#include <memory>
#include <vector>

#include <velkui/pictel/ImageIO.h>
#include <velkui/pictel/MemBuffer.h>
#include <velkui/pictel/Pictel.h>
#include <velkui/pictel/SurfaceInterface.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/OS_MessagePump.h>
#include <velkui/ui/OS_Window.h>
#include <velkui/ui/PlatformSession.h>
#include <velkui/ui/UI_SubView.h>

#include "X11Platform.h"

namespace {

namespace ui = velkui::ui;
namespace pictel = velkui::pictel;
using velkcore::PointT;
using velkcore::RectT;

// A node that flips between two colours on every press.
class FlipView : public ui::UI_SubView {
 public:
  bool dark = false;
  bool UI_DoMouseEvent(ui::UI_Node*, const ui::MouseEvent& event) override {
    if (event.GetAction() == ui::MouseEvent::kButtonDown) {
      dark = !dark;
      UI_Invalidate(nullptr, {});
    }
    return true;
  }
  void UI_Draw(pictel::Pictel* context) const override {
    const float level = dark ? 0.2f : 0.8f;
    context->GetSurface()->PaintRect({level, level, level, 1}, UI_GetLocalRectF(false));
  }
};

bool HasDisplay(benchmark::State& state) {
  if (std::getenv("DISPLAY") != nullptr) return true;
  state.SkipWithError("no DISPLAY: run under Xvfb");
  return false;
}

double ProcessCpuSeconds() {
  timespec now{};
  clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &now);
  return static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) / 1e9;
}

// The red byte of the pixel the server shows at (x, y) of the window.
int ShownLevel(ui::X11Platform& x11, ui::PlatformWindow window, int x, int y) {
  const auto pixels =
      pictel::CopyImagePixels(*x11.CaptureWindowPixels(window), pictel::PixelLayout::kBGRA);
  const std::uint8_t* row =
      pixels->GetData() + static_cast<std::ptrdiff_t>(y) * pixels->GetRowBytes();
  return row[x * 4 + 2];
}

void PumpUntil(ui::X11Platform& x11, const std::function<bool()>& done) {
  const auto deadline = std::chrono::steady_clock::now() + std::chrono::seconds(5);
  while (!done() && std::chrono::steady_clock::now() < deadline) {
    ui::OS_DispatchPendingEvents();
    if (done()) return;
    x11.WaitForActivity(0.005);
  }
}

void ClickToRepaintedPixels(benchmark::State& state) {
  if (!HasDisplay(state)) return;
  ui::PlatformSession session(ui::CreatePlatform("x11"));
  ui::X11Platform& x11 = ui::X11Platform::Get();
  auto window = velkcore::MakeIntrusive<ui::OS_Window>(
      u"Latency", RectT<std::int32_t>{100, 100, 160, 100}, ui::kStylePopup);
  auto view = velkcore::MakeIntrusive<FlipView>();
  view->UI_SetLocalRectF({0, 0, 160, 100});
  view->UI_Show(true);
  window->ChildPushBack(view);
  window->UI_Show(true);
  const ui::PlatformWindow handle = window->GetPlatformWindow(false);
  PumpUntil(x11, [&] { return ShownLevel(x11, handle, 80, 50) == 204; });
  x11.InjectPointerMove({180, 150});
  std::vector<double> latencies;
  for (auto _ : state) {
    const int expected = view->dark ? 204 : 51;
    const auto start = std::chrono::steady_clock::now();
    x11.InjectButton(1, true);
    x11.InjectButton(1, false);
    PumpUntil(x11, [&] { return ShownLevel(x11, handle, 80, 50) == expected; });
    const double seconds =
        std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
    state.SetIterationTime(seconds);
    latencies.push_back(seconds);
  }
  std::sort(latencies.begin(), latencies.end());
  if (!latencies.empty()) {
    state.counters["median_ms"] = latencies[latencies.size() / 2] * 1000.0;
    state.counters["p90_ms"] = latencies[latencies.size() * 9 / 10] * 1000.0;
  }
}
BENCHMARK(ClickToRepaintedPixels)->Iterations(100)->UseManualTime()->Unit(benchmark::kMillisecond);

void IdleWindowCpu(benchmark::State& state) {
  if (!HasDisplay(state)) return;
  ui::PlatformSession session(ui::CreatePlatform("x11"));
  ui::X11Platform& x11 = ui::X11Platform::Get();
  auto window =
      velkcore::MakeIntrusive<ui::OS_Window>(u"Idle", RectT<std::int32_t>{100, 100, 400, 300});
  auto view = velkcore::MakeIntrusive<FlipView>();
  view->UI_SetLocalRectF({0, 0, 400, 300});
  view->UI_Show(true);
  window->ChildPushBack(view);
  window->UI_Show(true);
  const ui::PlatformWindow handle = window->GetPlatformWindow(false);
  PumpUntil(x11, [&] { return x11.GetPaintCount(handle) > 0 && !x11.HasPendingPaint(handle); });
  constexpr std::uint32_t kAlarm = 0x7E57;
  for (auto _ : state) {
    // The loop blocks as an application's would; one timer ends the 5 seconds.
    x11.SetTimer(handle, kAlarm, 5000);
    const double cpuBefore = ProcessCpuSeconds();
    int wakeups = 0;
    for (;;) {
      ui::OS_Event event;
      if (!x11.GetNextEvent(event, true)) continue;
      ++wakeups;
      if (event.GetMsg() == ui::kMsgTimer && event.GetWParam() == kAlarm) break;
      x11.TranslateEvent(event);
      ui::OS_DispatchEvent(event);
    }
    x11.KillTimer(handle, kAlarm);
    state.counters["cpu_ms_per_5s"] = (ProcessCpuSeconds() - cpuBefore) * 1000.0;
    state.counters["messages"] = wakeups;
  }
}
BENCHMARK(IdleWindowCpu)->Iterations(1)->Unit(benchmark::kSecond);

}  // namespace
