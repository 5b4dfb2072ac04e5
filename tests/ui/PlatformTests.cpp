#include <gtest/gtest.h>

#include <cstdlib>
#include <functional>
#include <optional>
#include <string>

#include <velkcore/Error.h>
#include <velkui/pictel/ColorManagement.h>
#include <velkui/pictel/StartupShutdownGdiPlus.h>
#include <velkui/ui/HeadlessPlatform.h>
#include <velkui/ui/KeyframeThemeEditor.h>
#include <velkui/ui/PlatformSession.h>
#include <velkui/ui/Theme.h>
#include <velkui/ui/UI_NodeManager.h>

namespace velkui::ui::test {
namespace {

// Sets an environment variable for a scope (unset with nullopt) and puts it back.
class ScopedEnvironment {
 public:
  ScopedEnvironment(const char* name, std::optional<std::string> value) : name_(name) {
    if (const char* old = std::getenv(name)) old_ = old;
    Apply(value);
  }
  ~ScopedEnvironment() { Apply(old_); }

 private:
  void Apply(const std::optional<std::string>& value) {
    if (value) {
      ::setenv(name_, value->c_str(), 1);
    } else {
      ::unsetenv(name_);
    }
  }
  const char* name_;
  std::optional<std::string> old_;
};

std::int32_t ErrorNumberOf(const std::function<void()>& f, std::string* message = nullptr) {
  try {
    f();
  } catch (const velkcore::Exception& e) {
    if (message != nullptr) *message = e.what();
    return e.GetNumber();
  }
  return -1;
}

TEST(PlatformChoiceTest, TheBackendComesFromTheEnvironmentWithoutSilentFallback) {
  {
    const ScopedEnvironment platform("VELKUI_PLATFORM", "headless");
    const ScopedEnvironment display("DISPLAY", ":0");
    EXPECT_EQ(CreatePlatformFromEnvironment()->GetName(), "headless");
  }
  {
    const ScopedEnvironment platform("VELKUI_PLATFORM", std::nullopt);
    const ScopedEnvironment display("DISPLAY", std::nullopt);
    EXPECT_EQ(CreatePlatformFromEnvironment()->GetName(), "headless");
  }
  std::string message;
  {
    // A display without a choice means x11; a display nobody serves is an error, not headless.
    const ScopedEnvironment platform("VELKUI_PLATFORM", std::nullopt);
    const ScopedEnvironment display("DISPLAY", ":4093");
    EXPECT_EQ(ErrorNumberOf([] { CreatePlatformFromEnvironment(); }, &message), 20);
    EXPECT_NE(message.find("\"x11\""), std::string::npos) << message;
    EXPECT_NE(message.find(":4093"), std::string::npos) << message;
    EXPECT_EQ(ErrorNumberOf([] { CreatePlatform("x11"); }), 20);
  }
  EXPECT_EQ(ErrorNumberOf([] { CreatePlatform("wayland"); }, &message), 21);
  EXPECT_NE(message.find("wayland"), std::string::npos);
  EXPECT_EQ(ErrorNumberOf([] { CreatePlatform(""); }), 21);
}

TEST(PlatformSessionTest, StartsAndEndsEverythingAWindowNeeds) {
  ASSERT_EQ(GetPlatformIfAny(), nullptr);
  ASSERT_FALSE(Theme::IsInitialized());
  {
    PlatformSession session(std::make_unique<HeadlessPlatform>());
    EXPECT_EQ(&GetPlatform(), &session.GetPlatform());
    EXPECT_EQ(UI_NodeManager::Get(false), &session.GetNodeManager());
    EXPECT_NE(session.GetNodeManager().GetToolTipManager(), nullptr);
    EXPECT_TRUE(Theme::IsInitialized());
    EXPECT_TRUE(utility::StartupShutdownGdiPlus::IsStarted());
    HeadlessPlatform::Get().SetMonitors({{{0, 0, 100, 100}, {0, 0, 100, 100}, 7, true},
                                         {{100, 0, 100, 100}, {100, 0, 100, 100}, 8, false}});
    const auto pieces = pictel::SubdivideByMonitor({50, 10, 100, 10});
    ASSERT_EQ(pieces.size(), 2u);
    EXPECT_EQ(pieces[1].first, (velkcore::RectT<std::int32_t>{100, 10, 50, 10}));
    EXPECT_EQ(reinterpret_cast<std::uintptr_t>(pieces[1].second), 8u);
    // One session at a time.
    EXPECT_THROW(PlatformSession(std::make_unique<HeadlessPlatform>()), velkcore::Exception);
  }
  EXPECT_EQ(GetPlatformIfAny(), nullptr);
  EXPECT_EQ(UI_NodeManager::Get(false), nullptr);
  EXPECT_FALSE(Theme::IsInitialized());
  EXPECT_FALSE(utility::StartupShutdownGdiPlus::IsStarted());
  EXPECT_EQ(pictel::SubdivideByMonitor({50, 10, 100, 10}).size(), 1u);
}

TEST(PlatformSessionTest, KeepsTheHostsTheme) {
  Theme::Initialize(std::make_unique<KeyframeThemeEditor>());
  Theme* hostTheme = &Theme::Get();
  {
    const ScopedEnvironment platform("VELKUI_PLATFORM", "headless");
    PlatformSession session;
    EXPECT_EQ(session.GetPlatform().GetName(), "headless");
    EXPECT_EQ(&Theme::Get(), hostTheme);
  }
  EXPECT_TRUE(Theme::IsInitialized());
  Theme::Terminate();
}

}  // namespace
}  // namespace velkui::ui::test
