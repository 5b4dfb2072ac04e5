#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>

#include <velkcore/Error.h>
#include <velkcore/PropListXML.h>
#include <velkui/ui/HeadlessPlatform.h>
#include <velkui/ui/MonitorInfo.h>
#include <velkui/ui/PlatformSession.h>
#include <velkui/ui/PrefManager.h>

namespace velkui::ui::test {
namespace {

using velkcore::PropList;
using velkcore::RectT;

class PrefTest : public ::testing::Test {
 protected:
  PrefTest() {
    base_ = std::filesystem::temp_directory_path() /
            ("velkui-prefs-" + std::to_string(::testing::UnitTest::GetInstance()->random_seed()) +
             "-" + ::testing::UnitTest::GetInstance()->current_test_info()->name());
    std::filesystem::remove_all(base_);
    std::filesystem::create_directories(base_);
    SetMonitors({{0, 0, 1000, 800}});
  }
  ~PrefTest() override {
    PrefManager::Finalize();
    std::filesystem::remove_all(base_);
  }

  void SetMonitors(const std::vector<RectT<std::int32_t>>& rects) {
    std::vector<MonitorDescription> monitors;
    for (std::size_t i = 0; i < rects.size(); ++i) {
      monitors.push_back({rects[i], rects[i], i + 1, i == 0});
    }
    headless.SetMonitors(monitors);
  }
  PrefManager& Open(bool reset = false) {
    PrefManager::Initialize(velkcore::UTF8to16(base_.string()), reset);
    return *PrefManager::GetPrefManager(true);
  }
  std::filesystem::path File() const { return base_ / "VELKDialogPrefs" / "VELKDialogPrefs.xml"; }
  // Writes a preference file by hand: one dialog entry and the given monitor list.
  void WriteFile(const PropList& monitorInfo, bool withPosition = true) {
    PropList file;
    PropList* dialogs = file.NewSubList("DialogInfo");
    PropList* entry = dialogs->NewSubList("Export");
    entry->Set("DialogID", velkcore::UTF16String(u"Export"));
    if (withPosition) velkcore::WriteRect32(*entry, "Position", {100, 100, 300, 200});
    PropList* other = dialogs->NewSubList("Other");
    velkcore::WriteRect32(*other, "Position", {10, 10, 50, 50});
    file.Set("MonitorInfo", monitorInfo);
    std::filesystem::create_directories(File().parent_path());
    velkcore::SavePropList(file, File());
  }
  static PropList Monitors(const std::vector<RectT<std::int32_t>>& rects) {
    PropList list;
    MonitorInfo(rects).SaveToPropList(list);
    return list;
  }

  PlatformSession session{std::make_unique<HeadlessPlatform>()};
  HeadlessPlatform& headless = HeadlessPlatform::Get();
  std::filesystem::path base_;
};

TEST_F(PrefTest, PlacementsSurviveARestartWithTheSameMonitors) {
  PrefManager& prefs = Open(true);
  EXPECT_EQ(prefs.GetFilePath(), File());
  prefs.SetWindowPositionAndSize(u"Find \u2013 Replace", {100, 120, 300, 200});
  prefs.SetWindowPositionAndSize(u"Export", {-50, 10, 640, 480});
  PrefManager::Finalize();
  EXPECT_EQ(PrefManager::GetPrefManager(), nullptr);
  ASSERT_TRUE(std::filesystem::exists(File()));
  // Nothing but the file itself is left behind in the directory.
  EXPECT_EQ(std::distance(std::filesystem::directory_iterator(File().parent_path()),
                          std::filesystem::directory_iterator()),
            1);
  const PropList stored = velkcore::LoadPropList(File());
  ASSERT_NE(stored.GetSubList("DialogInfo"), nullptr);
  ASSERT_NE(stored.GetSubList("DialogInfo")->GetSubList("Export"), nullptr);
  EXPECT_TRUE(MonitorInfo({{0, 0, 1000, 800}}).Equals(*stored.GetSubList("MonitorInfo")));

  PrefManager& again = Open();
  RectT<std::int32_t> rect;
  ASSERT_TRUE(again.GetWindowPositionAndSize(u"Find \u2013 Replace", rect));
  EXPECT_EQ(rect, (RectT<std::int32_t>{100, 120, 300, 200}));
  ASSERT_TRUE(again.GetWindowPositionAndSize(u"Export", rect));
  EXPECT_EQ(rect, (RectT<std::int32_t>{-50, 10, 640, 480}));
  // Resetting forgets everything.
  PrefManager& fresh = Open(true);
  EXPECT_FALSE(fresh.GetWindowPositionAndSize(u"Export", rect));
}

TEST_F(PrefTest, PositionAndSizeAreReadAndWrittenByHalves) {
  PrefManager& prefs = Open(true);
  RectT<std::int32_t> rect{1, 2, 3, 4};
  EXPECT_FALSE(prefs.GetWindowPosition(u"Missing", rect));
  EXPECT_FALSE(prefs.GetWindowSize(u"Missing", rect));
  EXPECT_EQ(rect, (RectT<std::int32_t>{1, 2, 3, 4}));

  prefs.SetWindowPositionAndSize(u"D", {100, 100, 300, 200});
  rect = {0, 0, 50, 60};
  ASSERT_TRUE(prefs.GetWindowPosition(u"D", rect));
  EXPECT_EQ(rect, (RectT<std::int32_t>{100, 100, 50, 60}));
  // The size reaches the stored right and bottom edges from the caller's corner.
  rect = {150, 120, 0, 0};
  ASSERT_TRUE(prefs.GetWindowSize(u"D", rect));
  EXPECT_EQ(rect, (RectT<std::int32_t>{150, 120, 250, 180}));

  // Each half keeps the other.
  prefs.SetWindowPosition(u"D", {40, 50, 0, 0});
  ASSERT_TRUE(prefs.GetWindowPositionAndSize(u"D", rect));
  EXPECT_EQ(rect, (RectT<std::int32_t>{40, 50, 300, 200}));
  prefs.SetWindowSize(u"D", {0, 0, 80, 90});
  ASSERT_TRUE(prefs.GetWindowPositionAndSize(u"D", rect));
  EXPECT_EQ(rect, (RectT<std::int32_t>{40, 50, 80, 90}));
  prefs.SetWindowPosition(u"New", {7, 8, 99, 99});
  ASSERT_TRUE(prefs.GetWindowPositionAndSize(u"New", rect));
  EXPECT_EQ(rect, (RectT<std::int32_t>{7, 8, 0, 0}));
}

TEST_F(PrefTest, FramesFollowAMonitorThatChangedSize) {
  // The first monitor doubled: (100, 100) comes back at (200, 200).
  WriteFile(Monitors({{0, 0, 1000, 800}}));
  SetMonitors({{0, 0, 2000, 1600}});
  RectT<std::int32_t> rect;
  ASSERT_TRUE(Open().GetWindowPositionAndSize(u"Export", rect));
  EXPECT_EQ(rect, (RectT<std::int32_t>{200, 200, 600, 400}));

  // A monitor away from the origin scales around its own corner.
  PrefManager::Finalize();
  SetMonitors({{0, 0, 1000, 800}, {1000, 0, 1000, 800}});
  Open(true).SetWindowPositionAndSize(u"Right", {1100, 100, 200, 100});
  PrefManager::Finalize();
  SetMonitors({{0, 0, 1000, 800}, {1000, 0, 2000, 1600}});
  ASSERT_TRUE(Open().GetWindowPositionAndSize(u"Right", rect));
  EXPECT_EQ(rect, (RectT<std::int32_t>{1200, 200, 400, 200}));

  // With another number of monitors nothing is scaled.
  PrefManager::Finalize();
  SetMonitors({{0, 0, 3000, 2000}});
  ASSERT_TRUE(Open().GetWindowPositionAndSize(u"Right", rect));
  EXPECT_EQ(rect, (RectT<std::int32_t>{1200, 200, 400, 200}));
}

TEST_F(PrefTest, DamagedMonitorInformationCountsAsMissing) {
  const auto loads = [&](const PropList& monitors) {
    PrefManager::Finalize();
    WriteFile(monitors);
    RectT<std::int32_t> rect;
    return Open().GetWindowPositionAndSize(u"Export", rect);
  };
  ASSERT_TRUE(loads(Monitors({{0, 0, 1000, 800}})));
  EXPECT_FALSE(loads(Monitors({{0, 0, 0, 800}})));
  EXPECT_FALSE(loads(Monitors({{0, 0, 1000, -1}})));
  PropList count = Monitors({{0, 0, 1000, 800}});
  count.Set("NumMonitors", -1);
  EXPECT_FALSE(loads(count));
  count.Set("NumMonitors", 100000);
  EXPECT_FALSE(loads(count));
  count.Set("NumMonitors", std::string("one"));
  EXPECT_FALSE(loads(count));
  count.Set("NumMonitors", 2);
  EXPECT_FALSE(loads(count));
  PropList shortList = Monitors({{0, 0, 1000, 800}});
  shortList.GetSubList("Monitor-0")->Remove("3");
  EXPECT_FALSE(loads(shortList));
  PropList wrongType = Monitors({{0, 0, 1000, 800}});
  wrongType.Set("Monitor-0", std::string("0 0 1000 800"));
  EXPECT_FALSE(loads(wrongType));
  EXPECT_FALSE(loads(PropList()));
}

TEST_F(PrefTest, EntriesWithoutAPositionAndDamagedFilesAreSkipped) {
  WriteFile(Monitors({{0, 0, 1000, 800}}), false);
  RectT<std::int32_t> rect;
  PrefManager& prefs = Open();
  EXPECT_FALSE(prefs.GetWindowPositionAndSize(u"Export", rect));
  // The identifier comes from the key when the entry has none.
  ASSERT_TRUE(prefs.GetWindowPositionAndSize(u"Other", rect));
  EXPECT_EQ(rect, (RectT<std::int32_t>{10, 10, 50, 50}));
  PrefManager::Finalize();

  {
    std::ofstream damaged(File(), std::ios::trunc);
    damaged << "<?xml version=\"1.0\"?><prop.map version=\"4\"><prop.list>";
  }
  EXPECT_NO_THROW(Open());
  EXPECT_FALSE(PrefManager::GetPrefManager()->GetWindowPositionAndSize(u"Other", rect));
  PrefManager::GetPrefManager()->SetWindowPositionAndSize(u"Kept", {1, 2, 3, 4});
  PrefManager::Finalize();
  // The damaged file was replaced by a good one.
  ASSERT_TRUE(Open().GetWindowPositionAndSize(u"Kept", rect));
}

TEST_F(PrefTest, AFailedSaveDoesNotStopFinalize) {
  Open(true).SetWindowPositionAndSize(u"D", {1, 2, 3, 4});
  std::filesystem::remove_all(File().parent_path());
  // The directory is now a file: the save cannot succeed.
  std::ofstream(File().parent_path()) << "in the way";
  EXPECT_NO_THROW(PrefManager::Finalize());
  EXPECT_EQ(PrefManager::GetPrefManager(), nullptr);
  EXPECT_THROW(PrefManager::GetPrefManager(true), velkcore::Exception);
  std::filesystem::remove(File().parent_path());
}

// ---- Monitor information ----

TEST(MonitorInfoTest, RectanglesAreKeptOnTheMonitors) {
  const MonitorInfo monitors({{0, 0, 1000, 800}, {1000, 0, 800, 600}},
                             {{0, 0, 1000, 760}, {1000, 0, 800, 600}});
  EXPECT_EQ(monitors.GetMonitorCount(), 2);
  EXPECT_TRUE(monitors.IsRectVisible({900, 100, 200, 100}));
  // Only the bottom shows: the title bar cannot be reached.
  EXPECT_FALSE(monitors.IsRectVisible({100, -90, 200, 100}));
  EXPECT_FALSE(monitors.IsRectVisible({1790, 100, 200, 100}));

  RectT<std::int32_t> lost{2500, 700, 300, 200};
  monitors.EnsureRectIsVisible(&lost, false);
  EXPECT_EQ(lost, (RectT<std::int32_t>{1500, 400, 300, 200}));
  RectT<std::int32_t> visible{950, 700, 100, 100};
  monitors.EnsureRectIsVisible(&visible, false);
  EXPECT_EQ(visible, (RectT<std::int32_t>{950, 700, 100, 100}));
  monitors.EnsureRectIsVisible(&visible, true);
  EXPECT_EQ(visible, (RectT<std::int32_t>{900, 660, 100, 100}));
  RectT<std::int32_t> huge{-10, -10, 3000, 3000};
  monitors.EnsureRectIsVisible(&huge, true);
  EXPECT_EQ(huge, (RectT<std::int32_t>{0, 0, 1000, 760}));

  EXPECT_EQ(monitors.GetMonitorRectFromPoint({1200, 100}, false),
            (RectT<std::int32_t>{1000, 0, 800, 600}));
  EXPECT_EQ(monitors.GetMonitorRectFromPoint({1200, 700}, false), (RectT<std::int32_t>{}));
  EXPECT_EQ(monitors.GetMonitorRectFromPoint({1200, 700}, true),
            (RectT<std::int32_t>{1000, 0, 800, 600}));
  EXPECT_EQ(monitors.GetMonitorRectFromRect({950, 0, 200, 10}),
            (RectT<std::int32_t>{1000, 0, 800, 600}));
  velkcore::PointT<std::int32_t> corner;
  monitors.GetMaxBottomRight(corner);
  EXPECT_EQ(corner, (velkcore::PointT<std::int32_t>{1800, 800}));
  RectT<std::int32_t> rect{5, 5, 5, 5};
  EXPECT_FALSE(monitors.GetMonitorRect(2, rect));
  EXPECT_EQ(rect, (RectT<std::int32_t>{5, 5, 5, 5}));

  PropList saved;
  monitors.SaveToPropList(saved);
  EXPECT_TRUE(monitors.Equals(saved));
  EXPECT_FALSE(MonitorInfo({{0, 0, 1000, 800}}).Equals(saved));
  saved.GetSubList("Monitor-1")->Set("2", 801);
  EXPECT_FALSE(monitors.Equals(saved));
}

TEST(MonitorInfoTest, ThePlatformFormReadsTheInstalledPlatform) {
  EXPECT_EQ(OS_MonitorInfo().GetMonitorCount(), 0);
  PlatformSession session(std::make_unique<HeadlessPlatform>());
  HeadlessPlatform::Get().SetMonitors({{{0, 0, 800, 600}, {0, 0, 800, 560}, 1, true},
                                       {{-1024, 0, 1024, 768}, {-1024, 0, 1024, 768}, 2, false}});
  const OS_MonitorInfo monitors;
  ASSERT_EQ(monitors.GetMonitorCount(), 2);
  RectT<std::int32_t> area;
  ASSERT_TRUE(monitors.GetWorkArea(0, area));
  EXPECT_EQ(area, (RectT<std::int32_t>{0, 0, 800, 560}));
  EXPECT_EQ(monitors.GetMonitorIDFromRect({-100, 10, 50, 50}), 1);
  EXPECT_EQ(monitors.GetMonitorIDFromRect({5000, 10, 50, 50}), -1);
}

}  // namespace
}  // namespace velkui::ui::test
