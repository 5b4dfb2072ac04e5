#pragma once

namespace velkui::utility {

// Starts the platform drawing library for as long as it lives (font
// configuration and text layout). Instances may nest; the host keeps one alive
// for as long as it draws. A failed start raises error 20; platform surfaces
// made while none is alive raise error 21.
class StartupShutdownGdiPlus {
 public:
  StartupShutdownGdiPlus();
  ~StartupShutdownGdiPlus();
  StartupShutdownGdiPlus(const StartupShutdownGdiPlus&) = delete;
  StartupShutdownGdiPlus& operator=(const StartupShutdownGdiPlus&) = delete;

  static bool IsStarted();
};

}  // namespace velkui::utility
