#pragma once

namespace velkcore {

// The user-interface thread: registered once by the node manager at start-up.
void RegisterMainThread();
bool IsMainThreadRegistered();
// True on the registered thread (and on every thread before one is registered).
bool IsMainThread();

}  // namespace velkcore
