// Monitors: which screen a point or a rectangle belongs to, visibility, and
// the monitors read from the native layer.
#include <gtest/gtest.h>

#include "drawbot/Drawbot.h"
#include "tarsel/PropListUtils.h"
#include "ui/HeadlessWindowSystem.h"
#include "utility/MonitorInfo.h"

namespace norvik::utility {
namespace {

using Rect = MonitorInfo::Rect;
using Point = MonitorInfo::Point;

MonitorInfo TwoSideBySide() { return MonitorInfo({Rect(0, 0, 1000, 800), Rect(1000, 0, 1000, 800)}); }

TEST(MonitorInfoTest, ARectangleOrPointBelongsToTheMonitorHoldingMostOfItOrTheNearest) {
  const MonitorInfo two = TwoSideBySide();
  const Rect left(0, 0, 1000, 800), right(1000, 0, 1000, 800);
  const struct {
    Rect rect;
    Rect monitor;
  } cases[] = {
      {Rect(900, 100, 200, 100), left},  // equally over both: the first
      {Rect(901, 100, 200, 100), right},
      {Rect(2500, 100, 50, 50), right},  // on none: the nearest
      {Rect(-900, 100, 50, 50), left},
  };
  for (const auto& c : cases) EXPECT_EQ(two.GetMonitorRectFromRect(c.rect), c.monitor) << c.rect.left;
  EXPECT_EQ(MonitorInfo({left}).GetMonitorRectFromRect(Rect(50000, -90000, 10, 10)), left);
  EXPECT_EQ(two.GetMonitorRectFromPoint(Point(1000, 10)), right);
  EXPECT_EQ(two.GetMonitorRectFromPoint(Point(999, 10)), left);
  EXPECT_EQ(two.GetMonitorRectFromPoint(Point(500, 5000)), left);
}

TEST(MonitorInfoTest, TheFurthestCornerCoversEveryMonitor) {
  const MonitorInfo monitors({Rect(0, 0, 1000, 800), Rect(-500, 800, 600, 1200)});
  EXPECT_EQ(monitors.GetMaxBottomRight(), Point(1000, 2000));
}

TEST(MonitorInfoTest, ARectangleOffEveryMonitorIsMovedOntoOneAndAVisibleOneStays) {
  const MonitorInfo monitors = TwoSideBySide();
  const Rect visible(100, 100, 300, 200);
  EXPECT_TRUE(monitors.IsRectVisible(visible));
  EXPECT_EQ(monitors.EnsureRectIsVisible(visible), visible);

  const Rect lost(3000, 3000, 300, 200);
  EXPECT_FALSE(monitors.IsRectVisible(lost));
  const Rect placed = monitors.EnsureRectIsVisible(lost);
  EXPECT_TRUE(monitors.IsRectVisible(placed));
  EXPECT_EQ(placed.width, 300);
  EXPECT_EQ(placed.height, 200);

  // A title bar above the top of every screen cannot be taken hold of.
  EXPECT_FALSE(monitors.IsRectVisible(Rect(100, -50, 300, 200)));
  const Rect huge = monitors.EnsureRectIsVisible(Rect(-5000, -5000, 9000, 9000));
  EXPECT_TRUE(monitors.IsRectVisible(huge));
}

TEST(MonitorInfoTest, SavedMonitorsReadBackAndCompare) {
  const MonitorInfo a = TwoSideBySide();
  const MonitorInfo b = TwoSideBySide();
  const MonitorInfo c({Rect(0, 0, 1000, 800)});
  EXPECT_TRUE(a.Equals(b));
  EXPECT_FALSE(a.Equals(c));
  tarsel::proplist::PropList list;
  a.SaveToPropList(list);
  std::int32_t count = 0;
  ASSERT_TRUE(list.GetValue("MonitorCount", count));
  EXPECT_EQ(count, 2);
  Rect second;
  ASSERT_TRUE(tarsel::proplist::utils::ReadRect32(list, "Monitor1", second));
  EXPECT_EQ(second, Rect(1000, 0, 1000, 800));
}

TEST(MonitorInfoTest, TheNativeFormReadsTheWorkAreasOfTheLayerPrimaryFirst) {
  ui::HeadlessWindowSystem system;
  system.Install();
  system.SetMonitors({{Rect(0, 0, 1920, 1080), Rect(0, 0, 1920, 1040)},
                      {Rect(1920, 0, 1280, 1024), Rect(1920, 24, 1280, 1000)}});
  OS_MonitorInfo monitors;
  ASSERT_EQ(monitors.GetMonitorCount(), 2u);
  Rect r;
  ASSERT_TRUE(monitors.GetMonitorRect(0, r));
  EXPECT_EQ(r, Rect(0, 0, 1920, 1040));
  EXPECT_FALSE(monitors.GetMonitorRect(2, r));
  EXPECT_EQ(monitors.GetMonitorIDFromRect(Rect(2000, 100, 100, 100)), 1u);

  // A work-area hint clamped to one screen can leave two with the same work
  // area; their whole screens still tell them apart.
  system.SetMonitors({{Rect(0, 0, 1000, 800), Rect(0, 0, 1000, 800)},
                      {Rect(0, 800, 1000, 800), Rect(0, 0, 1000, 800)}});
  monitors.Update();
  EXPECT_EQ(monitors.GetMonitorIDFromRect(Rect(100, 900, 50, 50)), 1u);
  EXPECT_EQ(monitors.GetMonitorIDFromRect(Rect(100, 100, 50, 50)), 0u);
}

TEST(MonitorInfoTest, ColourManagedDrawingSplitsAtTheNativeLayersMonitors) {
  ui::HeadlessWindowSystem system;
  system.Install();
  system.SetMonitors({{Rect(0, 0, 1000, 800), Rect(0, 0, 1000, 780)},
                      {Rect(1000, 0, 600, 800), Rect(1000, 0, 600, 800)}});
  const auto pieces = drawbot::SubdivideByMonitor(Rect(900, 700, 200, 200));
  ASSERT_EQ(pieces.size(), 2u);
  EXPECT_EQ(pieces[0].first, Rect(900, 700, 100, 80)) << "cut at the first monitor's work area";
  EXPECT_EQ(pieces[1].first, Rect(1000, 700, 100, 100));
  EXPECT_NE(pieces[0].second, pieces[1].second);

  system.SetMonitors({{Rect(0, 0, 1000, 800), Rect(0, 0, 1000, 800)}});
  EXPECT_EQ(drawbot::SubdivideByMonitor(Rect(900, 700, 200, 200)).size(), 1u) << "monitors are read at each split";
}

TEST(MonitorInfoTest, WithoutAPlatformOneMonitorCoversEverything) {
  OS_MonitorInfo monitors;
  ASSERT_EQ(monitors.GetMonitorCount(), 1u);
  EXPECT_TRUE(monitors.IsRectVisible(Rect(123456, -654321, 100, 100)));
}

}  // namespace
}  // namespace norvik::utility
