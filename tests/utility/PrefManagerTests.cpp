// Saved window rectangles: kept in the user's preference file, read back on
// the next run, and never reopened off every monitor.
#include <cstdlib>
#include <filesystem>
#include <fstream>

#include <gtest/gtest.h>

#include "tarsel/FileUtils.h"
#include "ui/HeadlessWindowSystem.h"
#include "utility/PrefManager.h"

namespace norvik::utility {
namespace {

using Rect = PrefManager::Rect;
using Point = PrefManager::Point;

class PrefManagerTest : public ::testing::Test {
 protected:
  PrefManagerTest() {
    mFolder = std::filesystem::temp_directory_path() /
              ("norvik-prefs-" + std::to_string(::testing::UnitTest::GetInstance()->random_seed()) + "-" +
               ::testing::UnitTest::GetInstance()->current_test_info()->name());
    std::filesystem::remove_all(mFolder);
    const char* old = std::getenv("XDG_CONFIG_HOME");
    mHadOld = old != nullptr;
    if (old) mOld = old;
    ::setenv("XDG_CONFIG_HOME", mFolder.c_str(), 1);
    mSystem.Install();
    mSystem.SetMonitors({{Rect(0, 0, 1000, 800), Rect(0, 0, 1000, 800)},
                         {Rect(1000, 0, 1000, 800), Rect(1000, 0, 1000, 800)}});
  }
  ~PrefManagerTest() override {
    PrefManager::Finalize();
    if (mHadOld) ::setenv("XDG_CONFIG_HOME", mOld.c_str(), 1);
    else ::unsetenv("XDG_CONFIG_HOME");
    std::filesystem::remove_all(mFolder);
  }

  std::filesystem::path mFolder;
  std::string mOld;
  bool mHadOld = false;
  ui::HeadlessWindowSystem mSystem;
};

TEST_F(PrefManagerTest, AWindowRectangleSurvivesASaveAndALoadOfTheFileInTheToolkitsFolder) {
  {
    PrefManager prefs;
    prefs.SetWindowPositionAndSize("Export", Rect(1100, 50, 400, 300));
    prefs.SetWindowSize("Levels", Point(200, 100));
    prefs.SaveDialogPrefFile();
  }
  EXPECT_TRUE(std::filesystem::exists(mFolder / "norvik" / "NRKDialogPrefs.xml")) << "under the user's configuration";
  PrefManager next;
  next.LoadDialogPrefFile();
  Rect rect;
  ASSERT_TRUE(next.GetWindowPositionAndSize("Export", rect));
  EXPECT_EQ(rect, Rect(1100, 50, 400, 300));
  Point size;
  ASSERT_TRUE(next.GetWindowSize("Levels", size));
  EXPECT_EQ(size, Point(200, 100));
  EXPECT_FALSE(next.GetWindowPositionAndSize("Levels", rect));  // no position stored
  EXPECT_FALSE(next.GetWindowPosition("Unknown", size));
}

TEST_F(PrefManagerTest, AWindowSavedOnAMonitorThatIsGoneReopensOnThePrimary) {
  {
    PrefManager prefs;
    prefs.SetWindowPositionAndSize("Export", Rect(1500, 100, 400, 300));
    prefs.SaveDialogPrefFile();
  }
  mSystem.SetMonitors({{Rect(0, 0, 1000, 800), Rect(0, 0, 1000, 800)}});
  PrefManager next;
  next.LoadDialogPrefFile();
  Rect rect;
  ASSERT_TRUE(next.GetWindowPositionAndSize("Export", rect));
  EXPECT_TRUE(Rect(0, 0, 1000, 800).Contains(rect));
  EXPECT_EQ(rect.width, 400);
  Point position;
  ASSERT_TRUE(next.GetWindowPosition("Export", position));
  EXPECT_TRUE(Rect(0, 0, 1000, 800).Contains(position));
}

TEST_F(PrefManagerTest, NoSavedRectangleEverReopensOffEveryMonitor) {
  PrefManager prefs;
  const Rect screens[] = {Rect(0, 0, 1000, 800), Rect(1000, 0, 1000, 800)};
  // Rectangles everywhere around and across the two screens.
  for (long x = -3000; x <= 4000; x += 350) {
    for (long y = -2000; y <= 2500; y += 250) {
      for (long w : {50L, 700L, 2500L}) {
        const Rect adjusted = prefs.AdjustForMonitorInfoChange(Rect(x, y, w, 300));
        const bool onScreen = adjusted.Intersects(screens[0]) || adjusted.Intersects(screens[1]);
        const bool topOnScreen = screens[0].Contains(adjusted.Origin()) || screens[1].Contains(adjusted.Origin());
        EXPECT_TRUE(onScreen && topOnScreen) << x << "," << y << " w " << w;
      }
    }
  }
}

TEST_F(PrefManagerTest, ADamagedFileLeavesEmptyPreferences) {
  PrefManager prefs;
  std::filesystem::create_directories(mFolder / "norvik");
  std::ofstream(mFolder / "norvik" / "NRKDialogPrefs.xml") << "<not a property list";
  prefs.SetWindowSize("Before", Point(1, 2));
  prefs.LoadDialogPrefFile();
  Point size;
  EXPECT_FALSE(prefs.GetWindowSize("Before", size));
}

TEST_F(PrefManagerTest, TheSingletonLoadsOnInitializeAndSavesOnFinalize) {
  EXPECT_EQ(PrefManager::GetPrefManager(), nullptr);
  PrefManager::Initialize();
  ASSERT_NE(PrefManager::GetPrefManager(), nullptr);
  PrefManager::GetPrefManager()->SetWindowPosition("Tool", Point(10, 20));
  PrefManager::Finalize();
  EXPECT_EQ(PrefManager::GetPrefManager(), nullptr);
  PrefManager::Initialize();
  Point position;
  ASSERT_TRUE(PrefManager::GetPrefManager()->GetWindowPosition("Tool", position));
  EXPECT_EQ(position, Point(10, 20));
}

}  // namespace
}  // namespace norvik::utility
