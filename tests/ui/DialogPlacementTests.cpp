// Where dialogs open: remembered through the PrefManager under their node ID,
// kept visible on the monitors of today, centred when nothing is remembered.
#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include <velkui/ui/MonitorInfo.h>
#include <velkui/ui/PrefManager.h>

#include "DialogTestSupport.h"

namespace velkui::ui::test {
namespace {

class DialogPlacementTest : public DialogTest {
 protected:
  DialogPlacementTest() {
    base_ = std::filesystem::temp_directory_path() /
            ("velkui-dialog-place-" +
             std::to_string(::testing::UnitTest::GetInstance()->random_seed()) + "-" +
             ::testing::UnitTest::GetInstance()->current_test_info()->name());
    std::filesystem::remove_all(base_);
    std::filesystem::create_directories(base_);
    PrefManager::Initialize(base_.u16string(), true);
  }
  ~DialogPlacementTest() override {
    PrefManager::Finalize();
    std::filesystem::remove_all(base_);
  }

  // Saves the store to its file and reads it back, as the next start would.
  void Restart() {
    PrefManager::Finalize();
    PrefManager::Initialize(base_.u16string(), false);
  }
  ScriptedDialogP Named(const std::string& id) {
    auto dialog = MakeDialog(main.get());
    dialog->UI_SetNodeID(id);
    return dialog;
  }
  void CloseWith(ScriptedDialog& dialog, std::int16_t key) {
    dialog.during = [this, key] { headless.TypeKey(key); };
    dialog.RunModal();
  }

  std::filesystem::path base_;
};

TEST_F(DialogPlacementTest, ThePlaceWhereADialogClosedIsWhereItOpensNextTime) {
  {
    auto dialog = Named("FindDialog");
    EXPECT_TRUE(dialog->RemembersPosition());
    dialog->Position();  // nothing stored yet: centred on its parent
    const RectT<std::int32_t> parent = main->UI_GetGlobalStructureRect();
    const RectT<std::int32_t> centred = dialog->UI_GetGlobalStructureRect();
    EXPECT_EQ(centred.left, parent.left + (parent.width - centred.width) / 2);
    dialog->UI_Move({260, 180});
    CloseWith(*dialog, vk::kEscape);
  }
  Restart();
  auto again = Named("FindDialog");
  again->Position();
  const RectT<std::int32_t> frame = again->UI_GetGlobalStructureRect();
  EXPECT_EQ(frame.left, 260);
  EXPECT_EQ(frame.top, 180);
  EXPECT_EQ(frame.width, 302) << "the size is the dialog's own";

  // Closing with OK saves as well; another dialog keeps its own place.
  again->UI_Move({300, 220});
  CloseWith(*again, vk::kReturn);
  auto other = Named("ReplaceDialog");
  other->Position();
  EXPECT_NE(other->UI_GetGlobalStructureRect().left, 300);
  RectT<std::int32_t> stored;
  ASSERT_TRUE(PrefManager::GetPrefManager()->GetWindowPosition(u"FindDialog", stored));
  EXPECT_EQ(stored.left, 300);
  EXPECT_EQ(stored.top, 220);
}

TEST_F(DialogPlacementTest, ADialogWithTheDefaultIdRemembersNothing) {
  auto dialog = MakeDialog(main.get());
  EXPECT_FALSE(dialog->RemembersPosition());
  dialog->UI_Move({50, 60});
  CloseWith(*dialog, vk::kEscape);
  RectT<std::int32_t> stored;
  EXPECT_FALSE(PrefManager::GetPrefManager()->GetWindowPosition(u"UI_Dialog", stored));

  // Without a PrefManager nothing is remembered either, and Position centres.
  PrefManager::Finalize();
  auto named = Named("FindDialog");
  EXPECT_FALSE(named->RemembersPosition());
  named->UI_Move({0, 0});
  named->Position();
  EXPECT_NE(named->UI_GetGlobalStructureRect().left, 0);
  CloseWith(*named, vk::kEscape);
  PrefManager::Initialize(base_.u16string(), false);
}

TEST_F(DialogPlacementTest, AStoredPlaceOffTheMonitorsIsBroughtBack) {
  PrefManager::GetPrefManager()->SetWindowPosition(u"FindDialog", {5000, 3000, 0, 0});
  auto dialog = Named("FindDialog");
  dialog->Position();
  const RectT<std::int32_t> frame = dialog->UI_GetGlobalStructureRect();
  EXPECT_TRUE(OS_MonitorInfo().IsRectVisible(frame));
  EXPECT_EQ(frame.width, 302);
  EXPECT_EQ(frame.height, 186);
}

}  // namespace
}  // namespace velkui::ui::test
