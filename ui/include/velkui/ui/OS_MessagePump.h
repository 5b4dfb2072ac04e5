#pragma once

#include <cstdint>
#include <functional>

#include <velkui/ui/OS_Event.h>

namespace velkui::ui {

// The message pump of the installed platform, for the application's main loop
// and for modal loops (a dialog's ModalLoop is OS_RunMessageLoop with "until
// closed"). One turn takes the next message, lets the platform translate it
// (a key press gets its character message) and dispatches it to the OS_Window
// of its platform window.

enum class PumpResult : std::int32_t {
  kDispatched = 0,
  // Nothing to do: without `wait`, or on the headless backend, whose queue ran dry.
  kIdle = 1,
  // The quit request was taken (it stays in force: see Platform::IsQuitting).
  kQuit = 2,
};

// One turn of the loop.
PumpResult OS_PumpEvent(bool wait);
// Dispatches everything that waits, never blocking. False once quitting.
bool OS_DispatchPendingEvents();
// Runs until `done` answers true (asked before every turn), the quit request
// comes, or the platform has nothing and will not wait (headless).
PumpResult OS_RunMessageLoop(const std::function<bool()>& done);
// Hands `event` to the OS_Window of its platform window; a message for no
// library window is dropped (a paint is validated so that it does not return).
void OS_DispatchEvent(OS_Event& event);
// Asks every loop to end (Platform::PostQuit).
void OS_PostQuit(std::int32_t exitCode);

}  // namespace velkui::ui
