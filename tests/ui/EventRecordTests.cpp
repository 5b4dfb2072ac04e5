#include <gtest/gtest.h>

#include <velkui/ui/ClickCounter.h>
#include <velkui/ui/KeyboardEvent.h>
#include <velkui/ui/MouseEvent.h>
#include <velkui/ui/UI_ModKeyNotifier.h>
#include <velkui/ui/UI_NodeManager.h>

#include "NodeTestSupport.h"

namespace velkui::ui::test {
namespace {

TEST(MouseEventTest, PredicatesReadActionButtonAndCount) {
  const MouseEvent secondPress = Mouse(MouseEvent::kButtonDown, 0, 0, MouseEvent::kLeftButton, 2);
  const MouseEvent secondRelease = Mouse(MouseEvent::kButtonUp, 0, 0, MouseEvent::kLeftButton, 2);
  EXPECT_FALSE(secondPress.IsLeftButtonDoubleClick());
  EXPECT_TRUE(secondRelease.IsLeftButtonDoubleClick());
  EXPECT_FALSE(secondRelease.IsRightButtonDoubleClick());
  EXPECT_TRUE(Mouse(MouseEvent::kButtonDown, 0, 0, MouseEvent::kRightButton).IsContextMenuClick());
  EXPECT_TRUE(
      Mouse(MouseEvent::kButtonDown, 0, 0, MouseEvent::kMiddleButton).IsMiddleButtonSingleDown());
  EXPECT_FALSE(secondPress.IsLeftButtonSingleDown());

  // A swapped mouse: the logical button changes, the end of a drag still
  // compares the physical one.
  MouseEvent initial = Mouse(MouseEvent::kButtonDown, 0, 0, MouseEvent::kRightButton);
  initial.SetPhysicalButton(MouseEvent::kLeftButton);
  MouseEvent release = Mouse(MouseEvent::kButtonUp, 0, 0, MouseEvent::kRightButton);
  EXPECT_FALSE(release.IsEndDragEvent(initial));
  release.SetPhysicalButton(MouseEvent::kLeftButton);
  EXPECT_TRUE(release.IsEndDragEvent(initial));
  EXPECT_FALSE(Mouse(MouseEvent::kMove, 0, 0, MouseEvent::kLeftButton).IsEndDragEvent(initial));

  const MouseEvent vertical(MouseEvent::kWheel, 0, 0, {}, {}, nullptr, 1, 1);
  const MouseEvent shifted(MouseEvent::kWheel, 0, 0, {}, kModifierShift, nullptr, 1, 1);
  const MouseEvent horizontal(MouseEvent::kWheel, 0, 0, {}, {}, nullptr, 1, 0);
  EXPECT_FALSE(vertical.IsHorizontalScroll());
  EXPECT_TRUE(shifted.IsHorizontalScroll());
  EXPECT_TRUE(horizontal.IsHorizontalScroll());
}

TEST(MouseEventTest, WheelDeltasBecomeNotches) {
  const std::pair<std::int32_t, std::int32_t> rows[] = {{120, 1},   {60, 1},    {-60, -1}, {240, 2},
                                                        {-359, -2}, {-360, -3}, {0, 0}};
  for (const auto& [delta, notches] : rows) EXPECT_EQ(WheelDeltaToNotches(delta), notches) << delta;
}

// ---- Click counting ----

class ClickCounterTest : public ::testing::Test {
 protected:
  double now = 100.0;
  ClickCounter counter{[this] { return now; }};

  std::int32_t Press(int base = 1, PointT<std::int32_t> at = {10, 10}, std::int32_t button = 1) {
    now += 0.1;
    return counter.Count(base, MouseEvent::kButtonDown, button, at);
  }
  std::int32_t Release(PointT<std::int32_t> at = {10, 10}, std::int32_t button = 1) {
    now += 0.1;
    return counter.Count(1, MouseEvent::kButtonUp, button, at);
  }
  std::int32_t Move(PointT<std::int32_t> at) {
    now += 0.01;
    return counter.Count(0, MouseEvent::kMove, 0, at);
  }
};

TEST_F(ClickCounterTest, ThePlatformsDoubleClickCountsOnUntilTheChainBreaks) {
  EXPECT_EQ(Press(), 1);
  EXPECT_EQ(Release(), 1);
  EXPECT_EQ(Press(2), 2);  // the platform's double-click message
  EXPECT_EQ(Release(), 2);
  EXPECT_EQ(Press(), 3);
  EXPECT_EQ(Move({11, 12}), 3);  // within half the 4 x 4 rectangle
  EXPECT_EQ(Release(), 3);
  EXPECT_EQ(Press(), 4);
  EXPECT_EQ(Release(), 4);
  EXPECT_EQ(Press(), 5);
  EXPECT_EQ(Release(), 5);

  EXPECT_EQ(Move({13, 10}), 0);  // moved away: the chain is broken
  EXPECT_EQ(Press(), 1);
}

TEST_F(ClickCounterTest, TimeAndOtherButtonsBreakTheChain) {
  Press();
  Release();
  Press(2);
  Release();
  now += 0.6;  // longer than the 500 ms double-click time
  EXPECT_EQ(Press(), 1);
  Release();
  Press(2);
  Release();
  EXPECT_EQ(Press(1, {10, 10}, MouseEvent::kRightButton), 1);

  counter.SetDoubleClickTime(50);
  Press();
  Release();
  EXPECT_EQ(Press(2), 2);   // the platform's own decision stands
  EXPECT_EQ(Release(), 1);  // but 100 ms is outside the 50 ms window
}

// ---- Keyboard codes ----

TEST(KeyboardCodeTest, CodesKeepPrintableExtendedAndControlApart) {
  const KeyboardCode a = KeyboardCode::CreateFromKeyboardChar(u'a', true);
  EXPECT_TRUE(a.IsPrintable());
  EXPECT_TRUE(a.IsExtended());
  EXPECT_EQ(a.GetCharacter(), u'a');
  EXPECT_EQ(a.GetValue(), 0x80000061u);
  EXPECT_EQ(a.GetValue(true), 0xC0000061u);
  EXPECT_EQ(KeyboardCode::CreateFromKeyboardChar(0, false).GetValue(), 0xFFFFu);
  const KeyboardCode tab = KeyboardCode::CreateFromControlCode(kKeyTab, false);
  EXPECT_FALSE(tab.IsPrintable());
  EXPECT_EQ(tab.GetControlCode(), kKeyTab);
  EXPECT_LT(tab, a);
  EXPECT_NE(tab, KeyboardCode::CreateFromControlCode(kKeyTab, true));
}

TEST(KeyboardCodeTest, PlatformKeysMapToControlCodes) {
  EXPECT_EQ(KeyboardEvent::GetControlCode(32), kKeySpace);
  EXPECT_EQ(KeyboardEvent::GetControlCode(13), kKeyReturn);
  EXPECT_EQ(KeyboardEvent::GetControlCode(-13), kKeyEnter);
  EXPECT_EQ(KeyboardEvent::GetControlCode(112), kKeyF1);
  EXPECT_EQ(KeyboardEvent::GetControlCode(135), kKeyF24);
  EXPECT_EQ(KeyboardEvent::GetControlCode(-44), kKeyPrintScreen);
  EXPECT_EQ(KeyboardEvent::GetControlCode(44), kKeyNone);
  EXPECT_EQ(KeyboardEvent::GetControlCode(-37), kKeyLeft);
  EXPECT_EQ(KeyboardEvent::GetControlCode(36), kKeyHome);
  EXPECT_EQ(KeyboardEvent::GetControlCode(35), kKeyEnd);
  EXPECT_EQ(KeyboardEvent::GetControlCode(33), kKeyPageUp);
  EXPECT_EQ(KeyboardEvent::GetControlCode(-93), kKeyApplication);
  EXPECT_EQ(KeyboardEvent::GetControlCode(65), kKeyNone);

  EXPECT_EQ(Key(KeyboardEvent::kCharacter, 65, {}, {u'A'}).GetCode(),
            KeyboardCode::CreateFromKeyboardChar(u'A', false));
  EXPECT_EQ(Key(KeyboardEvent::kKeyDown, -46).GetCode(),
            KeyboardCode::CreateFromControlCode(kKeyDelete, true));
}

TEST(KeyboardCodeTest, ShortcutsIgnoreCapsLockOnly) {
  const KeyboardCode s = KeyboardCode::CreateFromKeyboardChar(u's', false);
  const auto event = Key(KeyboardEvent::kKeyDown, 83, kModifierControl | kModifierCapsLock, {u's'});
  EXPECT_TRUE(event.CompareShortcut(s, kModifierControl));
  EXPECT_FALSE(event.CompareShortcut(s, kModifierControl | kModifierShift));
  EXPECT_FALSE(event.CompareShortcut(s, {}));
}

TEST(KeyboardCodeTest, ControlActivationShortcuts) {
  const auto check = [](KeyboardEvent::Action action, std::int16_t vk, ModifierKeys mods,
                        bool repeat = false) {
    return UI_NodeManager::CompareControlActivateShortcut(Key(action, vk, mods, {}, repeat));
  };
  EXPECT_TRUE(check(KeyboardEvent::kKeyDown, 32, {}));
  EXPECT_TRUE(check(KeyboardEvent::kKeyDown, 32, kModifierCapsLock));
  EXPECT_FALSE(check(KeyboardEvent::kKeyDown, 32, {}, true));
  EXPECT_FALSE(check(KeyboardEvent::kKeyDown, 32, kModifierShift));
  EXPECT_TRUE(check(KeyboardEvent::kKeyDown, -13, kModifierControl));
  EXPECT_TRUE(check(KeyboardEvent::kKeyDown, 13, kModifierControl));
  EXPECT_FALSE(check(KeyboardEvent::kKeyDown, 13, {}));
  EXPECT_TRUE(check(KeyboardEvent::kKeyUp, 32, {}));
  EXPECT_FALSE(check(KeyboardEvent::kKeyUp, 32, kModifierAlt));
  EXPECT_TRUE(check(KeyboardEvent::kKeyUp, 13, kModifierAlt | kModifierShift));
  EXPECT_TRUE(check(KeyboardEvent::kKeyUp, -13, {}));
  EXPECT_FALSE(check(KeyboardEvent::kCharacter, 32, {}));
  // Space recognised by key even when the platform sends its character along.
  EXPECT_TRUE(
      UI_NodeManager::CompareControlActivateShortcut(Key(KeyboardEvent::kKeyDown, 32, {}, {u' '})));
}

TEST(ModKeyNotifierTest, OnlyChangesReachTheFunctions) {
  UI_ModKeyNotifier& notifier = UI_ModKeyNotifier::Get();
  notifier.DispatchModKeyEvent({});
  std::vector<int> seen;
  const auto f = std::make_shared<UI_ModKeyNotifier::ModKeyChangedFunction>(
      [&](ModifierKeys keys) { seen.push_back(keys.Get()); });
  notifier.InstallModKeyChangedFunction(f);
  notifier.DispatchModKeyEvent(kModifierShift);
  notifier.DispatchModKeyEvent(kModifierShift);
  notifier.DispatchModKeyEvent({});
  notifier.AppChanged(false, kModifierAlt);
  notifier.AppChanged(true, kModifierAlt);
  EXPECT_EQ(seen, (std::vector<int>{kModifierShift, 0, kModifierAlt}));
  EXPECT_TRUE(notifier.RemoveModKeyChangedFunction(f));
  notifier.DispatchModKeyEvent({});
}

}  // namespace
}  // namespace velkui::ui::test
