#include <velkui/ui/OS_MessagePump.h>

#include <velkui/ui/OS_Window.h>
#include <velkui/ui/Platform.h>

#include "NodeHold.h"

namespace velkui::ui {

PumpResult OS_PumpEvent(bool wait) {
  Platform& platform = GetPlatform();
  if (platform.IsQuitting()) return PumpResult::kQuit;
  OS_Event event;
  if (!platform.GetNextEvent(event, wait)) return PumpResult::kIdle;
  if (event.GetMsg() == kMsgQuit) {
    platform.SetQuitting(static_cast<std::int32_t>(event.GetWParam()));
    return PumpResult::kQuit;
  }
  platform.TranslateEvent(event);
  OS_DispatchEvent(event);
  return PumpResult::kDispatched;
}

bool OS_DispatchPendingEvents() {
  for (;;) {
    switch (OS_PumpEvent(false)) {
      case PumpResult::kDispatched:
        break;
      case PumpResult::kIdle:
        return true;
      case PumpResult::kQuit:
        return false;
    }
  }
}

PumpResult OS_RunMessageLoop(const std::function<bool()>& done) {
  for (;;) {
    if (done && done()) return PumpResult::kDispatched;
    const PumpResult result = OS_PumpEvent(true);
    if (result != PumpResult::kDispatched) return result;
  }
}

void OS_DispatchEvent(OS_Event& event) {
  if (OS_Window* window = OS_Window::UI_GetWindow(event.GetWindow())) {
    const NodeP keep = detail::Hold(window);
    window->UI_DispatchEvent(&event);
    return;
  }
  if (event.GetMsg() == kMsgPaint) {
    // Nobody paints this window: validate it, or the paint would come back forever.
    Platform& platform = GetPlatform();
    if (const std::optional<PaintTarget> target = platform.BeginPaint(event.GetWindow())) {
      platform.EndPaint(event.GetWindow(), *target);
    }
  }
}

void OS_PostQuit(std::int32_t exitCode) {
  GetPlatform().PostQuit(exitCode);
}

}  // namespace velkui::ui
