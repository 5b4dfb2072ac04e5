// The double-click time and size follow the desktop's XSETTINGS manager (played
// here by a second connection), under the X resource velkui.multiClickTime.
#include <memory>

#include "X11OutsideClient.h"
#include "X11TestSupport.h"
#include "XSettingsBytes.h"

namespace velkui::ui::x11test {
namespace {

std::vector<std::uint8_t> DoubleClick(std::int32_t time, std::int32_t distance,
                                      bool mostSignificantFirst = false) {
  return XSettingsBytes(mostSignificantFirst)
      .String("Net/ThemeName", "Plain")
      .Integer("Net/DoubleClickTime", time)
      .Integer("Net/DoubleClickDistance", distance)
      .Bytes();
}

using X11SettingsTest = X11Test;

TEST_F(X11SettingsTest, DoubleClickFollowsTheSettingsManager) {
  const auto follows = [&](std::uint32_t time, std::int32_t size) {
    return PumpUntil([&] {
      return x11.GetDoubleClickTime() == time && x11.GetDoubleClickSize() == PointT{size, size};
    });
  };
  EXPECT_TRUE(follows(500, 4)) << "no manager yet";

  X11OutsideClient manager(x11);
  manager.PublishSettings(DoubleClick(320, 6));
  EXPECT_TRUE(follows(320, 12)) << "a manager that starts later";

  manager.PublishSettings(DoubleClick(250, 1, true));
  EXPECT_TRUE(follows(250, 2)) << "a change";

  std::vector<std::uint8_t> truncated = DoubleClick(900, 9);
  truncated.resize(truncated.size() - 2);
  manager.PublishSettings(truncated);
  EXPECT_TRUE(follows(500, 4)) << "a property that cannot be decoded";

  manager.PublishSettings(XSettingsBytes()
                              .Integer("Net/DoubleClickTime", 0)
                              .String("Net/DoubleClickDistance", "8")
                              .Bytes());
  EXPECT_TRUE(follows(500, 4)) << "a zero time and a distance of the wrong type";

  manager.PublishSettings(DoubleClick(320, 0));
  EXPECT_TRUE(follows(320, 0));
  manager.WithdrawSettings();
  EXPECT_TRUE(follows(500, 4)) << "the manager went away";
}

// Sessions of their own: what is there when the backend starts.
TEST(X11SettingsStartTest, ManagerAtStartUpAndTheResourceOverItsTime) {
  std::unique_ptr<X11OutsideClient> manager;
  {
    const PlatformSession session{CreatePlatform("x11")};
    manager = std::make_unique<X11OutsideClient>(X11Platform::Get());
    manager->PublishSettings(DoubleClick(420, 5));
  }
  {
    const PlatformSession session{CreatePlatform("x11")};
    EXPECT_EQ(X11Platform::Get().GetDoubleClickTime(), 420u);
    EXPECT_EQ(X11Platform::Get().GetDoubleClickSize(), (PointT<std::int32_t>{10, 10}));
  }
  manager->SetResources("velkui.multiClickTime: 700\n");
  {
    const PlatformSession session{CreatePlatform("x11")};
    EXPECT_EQ(X11Platform::Get().GetDoubleClickTime(), 700u);
    EXPECT_EQ(X11Platform::Get().GetDoubleClickSize(), (PointT<std::int32_t>{10, 10}));
  }
  manager->SetResources("");
}

}  // namespace
}  // namespace velkui::ui::x11test
