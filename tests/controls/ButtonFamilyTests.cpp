#include <gtest/gtest.h>

#include <velkcore/Error.h>
#include <velkui/controls/UI_Checkbox.h>
#include <velkui/controls/UI_DisclosureTriangleButton.h>
#include <velkui/controls/UI_PictureButton.h>
#include <velkui/controls/UI_RadioGroup.h>
#include <velkui/controls/UI_TextButton.h>
#include <velkui/pictel/OSSupplier.h>
#include <velkui/ui/UI_ModKeyNotifier.h>

#include "ControlTestSupport.h"

namespace velkui::controls::test {
namespace {

constexpr std::int16_t kVkS = 'S';

class ButtonFamilyTest : public ControlTest {
 protected:
  MessageLog log;
  ~ButtonFamilyTest() override { ui::UI_ModKeyNotifier::Get().DispatchModKeyEvent({}); }
};

// ---- Check boxes and radio buttons ----

TEST_F(ButtonFamilyTest, ACheckBoxFlipsItsCheckOnEveryPress) {
  auto box = Add<UI_Checkbox>({10, 10, 120, 16}, u"Remember");
  log.Watch(*box);
  EXPECT_TRUE(box->IsValueUnknown()) << "a new check box is mixed";
  Click(15, 15);
  EXPECT_TRUE(box->IsChecked()) << "mixed becomes checked";
  EXPECT_TRUE(box->IsValueKnown());
  Click(15, 15);
  EXPECT_FALSE(box->IsChecked());
  EXPECT_FALSE(box->GetDownState()) << "the box itself is spring-loaded";
  EXPECT_EQ(log.Entries(), (Log{"begin", "changed(0)", "continue(0)", "finish", "begin",
                                "changed(0)", "continue(0)", "finish"}));
  log.Clear();
  box->SetChecked(true);
  EXPECT_TRUE(log.Entries().empty()) << "setting the value sends nothing";
  EXPECT_THROW(box->SetCheckValue(2), velkcore::Exception);
}

TEST_F(ButtonFamilyTest, AnImageCheckBoxFlipsLikeACheckBox) {
  auto box = Add<UI_ImageCheckbox>({10, 10, 20, 20});
  Click(15, 15);
  EXPECT_TRUE(box->IsChecked());
  Click(15, 15);
  EXPECT_FALSE(box->IsChecked());
}

class RadioTest : public ButtonFamilyTest {
 protected:
  boost::intrusive_ptr<UI_RadioGroup> group = Add<UI_RadioGroup>({0, 0, 300, 20});
  std::vector<boost::intrusive_ptr<UI_RadioButton>> radios;
  void SetUp() override {
    for (int i = 0; i < 3; ++i) {
      auto radio = velkcore::MakeIntrusive<UI_RadioButton>(u"Choice");
      radio->UI_SetNodeID("radio" + std::to_string(i));
      radio->UI_SetLocalRectF({static_cast<float>(i) * 100, 0, 90, 20});
      radio->UI_Show(true);
      group->AddRadio(radio);
      radios.push_back(radio);
    }
    log.SetPrefixed(true);
    log.Watch(*group);
    log.Watch(*radios[0]);
  }
};

TEST_F(RadioTest, ARadioButtonClickedWhileOnStaysOnAndSendsAgain) {
  Click(5, 5);
  EXPECT_TRUE(radios[0]->IsOn());
  log.Clear();
  Click(5, 5);
  EXPECT_TRUE(radios[0]->IsOn());
  EXPECT_EQ(group->GetIndex(), 0);
  // The group subscribed first, so it hears the change first.
  EXPECT_EQ(log.Entries(), (Log{"radio0:begin", "UI_RadioGroup:changed", "radio0:changed(0)",
                                "radio0:continue(0)", "radio0:finish"}));
}

TEST_F(RadioTest, ClickingAnotherRadioButtonTurnsTheFirstOff) {
  Click(5, 5);
  Click(105, 5);
  EXPECT_FALSE(radios[0]->IsOn());
  EXPECT_TRUE(radios[1]->IsOn());
  EXPECT_EQ(group->GetIndex(), 1);
  group->SetIndex(2);
  EXPECT_EQ(group->GetIndex(), 2);
  EXPECT_FALSE(radios[1]->IsOn());
  group->SetIndex(-1);
  EXPECT_EQ(group->GetIndex(), -1);
  EXPECT_THROW(group->SetIndex(3), velkcore::Exception);
}

TEST_F(RadioTest, TheGroupTakesNoFocusByAdvancingAndOutlivesNoneOfItsRadios) {
  EXPECT_FALSE(group->UI_GainKeyboardFocusFromAdvance());
  // A radio button taken out of a destroyed group no longer reaches it.
  const auto kept = radios[1];
  group->ChildRemove(kept.get());
  root->ChildRemove(group.get());
  group.reset();
  root->ChildPushBack(kept);
  Click(105, 5);
  EXPECT_TRUE(kept->IsOn());
}

// ---- Tooltips and names that follow the modifier keys ----

TEST_F(ButtonFamilyTest, AModifiedToolTipShowsWhileItsKeysAreHeld) {
  auto button = Add<UI_TextButton>({10, 10, 80, 22}, u"Delete");
  button->InsertModifiedToolTip({}, u"Delete the selection");
  button->InsertModifiedToolTip(ui::kModifierAlt, u"Delete without asking");
  EXPECT_EQ(button->UI_GetStoredToolTip(), u"Delete the selection");
  EXPECT_EQ(button->UI_GetToolTipWidth(), UI_Button::kToolTipWidth);
  ui::UI_ModKeyNotifier& keys = ui::UI_ModKeyNotifier::Get();
  keys.DispatchModKeyEvent(ui::kModifierAlt);
  EXPECT_EQ(button->UI_GetStoredToolTip(), u"Delete without asking");
  // Keys without a tooltip of their own are ignored in the match.
  keys.DispatchModKeyEvent(ModifierKeys{ui::kModifierAlt | ui::kModifierCapsLock});
  EXPECT_EQ(button->UI_GetStoredToolTip(), u"Delete without asking");
  keys.DispatchModKeyEvent({});
  EXPECT_EQ(button->UI_GetStoredToolTip(), u"Delete the selection");
  // A destroyed button no longer hears the keys.
  root->ChildRemove(button.get());
  button.reset();
  keys.DispatchModKeyEvent(ui::kModifierAlt);
}

TEST_F(ButtonFamilyTest, AModifiedNameReplacesTheCaptionWhileItsKeysAreHeld) {
  auto button = Add<UI_TextButton>({10, 10, 80, 22}, u"Cancel");
  button->InsertModifiedName(ui::kModifierAlt, u"Reset");
  ui::UI_ModKeyNotifier::Get().DispatchModKeyEvent(ui::kModifierAlt);
  EXPECT_EQ(button->GetDisplayText(), u"Reset");
  ui::UI_ModKeyNotifier::Get().DispatchModKeyEvent({});
  EXPECT_EQ(button->GetDisplayText(), u"Cancel");
}

// ---- Mnemonics ----

class MnemonicTest : public ButtonFamilyTest {
 protected:
  void SetUp() override { manager.EnableMnemonics(); }
};

TEST_F(MnemonicTest, TheMarkupIsStrippedAndTheKeyRemembered) {
  auto button = Add<UI_TextButton>({10, 10, 80, 22});
  velkcore::UTF16String shown;
  EXPECT_TRUE(button->UI_ProcessStringAndSetMnemonic(u"&Save", shown));
  EXPECT_EQ(shown, u"Save");
  EXPECT_EQ(button->GetMnemonicLocation(), 0u);
  EXPECT_EQ(button->GetMnemonicCode(), ui::KeyboardCode::CreateFromKeyboardChar(u'S', false));
  EXPECT_TRUE(button->UI_ProcessStringAndSetMnemonic(u"Fish && &chips", shown));
  EXPECT_EQ(shown, u"Fish & chips");
  EXPECT_EQ(button->GetMnemonicLocation(), 7u);
  EXPECT_EQ(button->GetMnemonicCode(), ui::KeyboardCode::CreateFromKeyboardChar(u'C', false));
  EXPECT_FALSE(button->UI_ProcessStringAndSetMnemonic(u"Trailing&", shown));
  EXPECT_EQ(button->GetMnemonicLocation(), UI_ControlView::kNoMnemonic);
  EXPECT_FALSE(button->UI_ProcessStringAndSetMnemonic(u"", shown));
  EXPECT_EQ(shown, u"");

  manager.DisableMnemonics();
  EXPECT_FALSE(button->UI_ProcessStringAndSetMnemonic(u"&Open", shown));
  EXPECT_EQ(shown, u"Open") << "markup is never shown";
}

TEST_F(MnemonicTest, AltAndTheKeyOrTheKeyAloneWhereTheFocusAllowsItPressTheButton) {
  auto other = Add<UI_TextButton>({200, 10, 80, 22}, u"Other");
  auto button = Add<UI_TextButton>({10, 10, 80, 22}, u"&Save");
  log.Watch(*button);
  EXPECT_FALSE(KeyDown(kVkS, {}, {u's'})) << "no control has the focus";
  EXPECT_TRUE(log.Entries().empty());
  EXPECT_TRUE(KeyDown(kVkS, ui::kModifierAlt));
  EXPECT_TRUE(button->UI_HasKeyboardFocus(true));
  EXPECT_EQ(log.Entries(), (Log{"begin", "changed(0)", "continue(0)", "finish"}));
  other->UI_GainKeyboardFocus();
  EXPECT_TRUE(KeyDown(kVkS, {}, {u's'}));
  EXPECT_EQ(log.Entries().size(), 8u);
}

TEST_F(MnemonicTest, HiddenAndDisabledControlsDoNotAnswer) {
  auto button = Add<UI_TextButton>({10, 10, 80, 22}, u"&Save");
  log.Watch(*button);
  button->UI_Show(false);
  EXPECT_FALSE(KeyDown(kVkS, ui::kModifierAlt));
  button->UI_Show(true);
  button->SetDisabled(true);
  EXPECT_FALSE(KeyDown(kVkS, ui::kModifierAlt));
  EXPECT_TRUE(log.Entries().empty());
  EXPECT_FALSE(button->UI_HasKeyboardFocus(true));
}

TEST_F(MnemonicTest, AltShowsTheUnderlinesUntilItIsReleased) {
  auto button = Add<UI_TextButton>({10, 10, 80, 22}, u"&Save");
  EXPECT_FALSE(button->GetDisplayMnemonic());
  KeyDown(kVkAlt, ui::kModifierAlt);
  EXPECT_TRUE(button->GetDisplayMnemonic());
  KeyUp(kVkAlt, {});
  EXPECT_FALSE(button->GetDisplayMnemonic());
}

TEST_F(MnemonicTest, AMnemonicFlipsAToggle) {
  auto box = Add<UI_Checkbox>({10, 10, 100, 16}, u"&Wrap");
  box->SetChecked(false);
  KeyDown('W', ui::kModifierAlt);
  EXPECT_TRUE(box->IsChecked());
  auto toggle = Add<UI_TextButton>({10, 40, 80, 22}, u"&Bold");
  toggle->SetSpringLoaded(false);
  KeyDown('B', ui::kModifierAlt);
  EXPECT_EQ(toggle->GetValue(), kButtonOn);
  KeyDown('B', ui::kModifierAlt);
  EXPECT_EQ(toggle->GetValue(), kButtonOff);
}

// ---- Picture buttons ----

TEST_F(ButtonFamilyTest, TheImageSupplyFunctionIsAskedWithTheControlState) {
  auto button = Add<UI_PictureButton>({10, 10, 24, 24});
  std::vector<ControlState> asked;
  const auto supplier = pictel::NewOSSupplier();
  const pictel::SurfaceP surface(*supplier, 4, 4);
  pictel::Pictel context(supplier.get(), surface.Get());
  const auto image = surface->GetSurfaceImage();
  button->SetImageSupplyFunction(
      std::make_shared<ConstControlCallback>([&](ui::MessageT<const ui::UI_Node>* m) {
        auto* supply = static_cast<UI_PictureSupplyMessage*>(m);
        asked.push_back(supply->GetStateFlags());
        supply->SetImage(image.get());
      }));
  button->SetDownState(true);
  EXPECT_EQ(button->GetImage(context).Get(), image.get());
  ASSERT_EQ(asked.size(), 1u);
  EXPECT_TRUE(asked[0].IsSet(kControlStateDown));
}

TEST_F(ButtonFamilyTest, TheLibraryArtIsFoundByBaseNameWithTheOnPictureWhileDown) {
  auto lock = Add<UI_LockButton>({10, 10, 24, 24});
  const auto supplier = pictel::NewOSSupplier();
  const pictel::SurfaceP surface(*supplier, 4, 4);
  pictel::Pictel context(supplier.get(), surface.Get());
  const pictel::ImageP open = lock->GetLockImage(context);
  ASSERT_TRUE(open);
  EXPECT_EQ(open->GetWidth(), 16);
  Click(15, 15);
  EXPECT_EQ(lock->GetValue(), kButtonOn) << "the lock is a toggle";
  const pictel::ImageP closed = lock->GetLockImage(context);
  ASSERT_TRUE(closed);
  EXPECT_NE(closed.Get(), open.Get());
  auto missing = Add<UI_PictureButton>({50, 10, 24, 24}, "NoSuchPicture");
  EXPECT_FALSE(missing->GetImage(context));
}

TEST_F(ButtonFamilyTest, ReturnActivatesAPictureButtonUnlessTheSettingIsOff) {
  auto button = Add<UI_PictureButton>({10, 10, 24, 24}, "Play");
  log.Watch(*button);
  button->SetSupportLegacyWindowsKeyboardActivation(true);
  button->SetWantsKeyboardFocus(true);
  button->UI_GainKeyboardFocus();
  KeyDown(kVkReturn);
  KeyUp(kVkReturn);
  EXPECT_EQ(log.Entries().size(), 4u);
  log.Clear();
  KeyDown(kVkReturn, ui::kModifierShift);
  EXPECT_FALSE(button->GetDownState()) << "only without modifiers";
  manager.GetCustomSettingsManager().SetBoolean(
      "velkui.controls.UI_PictureButton.ActivateOnReturnEnter", false);
  KeyDown(kVkReturn);
  KeyUp(kVkReturn);
  EXPECT_TRUE(log.Entries().empty());
}

TEST_F(ButtonFamilyTest, ScalesMustBePositive) {
  auto button = Add<UI_PictureButton>({10, 10, 24, 24}, "Play");
  EXPECT_THROW(button->SetScale({0, 1}), velkcore::Exception);
  EXPECT_THROW(button->SetScale({1, std::numeric_limits<float>::infinity()}), velkcore::Exception);
}

// ---- Disclosure triangle ----

TEST_F(ButtonFamilyTest, TheTriangleTwirlsOverItsDurationOnTheNodeTimer) {
  auto triangle = Add<UI_DisclosureTriangleButton>({10, 10, 100, 20}, u"Details");
  triangle->SetTwirlDuration(0.2f);
  EXPECT_EQ(triangle->GetCurrentAngle(), 0.0f);
  Click(15, 15);
  EXPECT_TRUE(triangle->IsOpen());
  EXPECT_TRUE(triangle->IsTwirling());
  EXPECT_EQ(LiveTimers(*triangle), 1u);
  EXPECT_NEAR(triangle->GetCurrentAngle(), 0.0f, 0.01f);
  Advance(*triangle, 0.1, 0.02);
  EXPECT_NEAR(triangle->GetCurrentAngle(), 45.0f, 1.0f);
  Advance(*triangle, 0.12, 0.02);
  EXPECT_EQ(triangle->GetCurrentAngle(), 90.0f);
  EXPECT_EQ(LiveTimers(*triangle), 0u) << "the timer ends with the twirl";
  Click(15, 15);
  EXPECT_FALSE(triangle->IsOpen());
  EXPECT_NEAR(triangle->GetCurrentAngle(), 90.0f, 0.01f);
  EXPECT_THROW(triangle->SetTwirlDuration(-1), velkcore::Exception);
}

TEST_F(ButtonFamilyTest, ATriangleOutsideAWindowTurnsAtOnce) {
  auto triangle = velkcore::MakeIntrusive<UI_DisclosureTriangleButton>(u"Loose");
  triangle->SetValue(kButtonOn);
  EXPECT_FALSE(triangle->IsTwirling());
  EXPECT_EQ(triangle->GetCurrentAngle(), 90.0f);
}

TEST_F(ButtonFamilyTest, AClickOnAButtonThatWantsNoFocusLeavesTheFocusAlone) {
  auto field = Add<UI_TextButton>({200, 10, 80, 22}, u"Focused");
  auto tool = Add<UI_PictureButton>({10, 10, 24, 24}, "Play");
  field->UI_GainKeyboardFocus();
  Click(15, 15);
  EXPECT_TRUE(field->UI_HasKeyboardFocus(true));
  tool->SetWantsKeyboardFocus(true);
  Click(15, 15);
  EXPECT_TRUE(tool->UI_HasKeyboardFocus(true));
}

}  // namespace
}  // namespace velkui::controls::test
