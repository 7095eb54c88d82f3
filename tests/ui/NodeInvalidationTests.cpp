// Invalidation: the climb to the ancestors with rectangles brought into each
// parent's space, and the draw-cache seed that cuts repeated climbs short.
#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "drawbot/CacheInterface.h"
#include "support/drawbot/RecordingSupplier.h"
#include "support/ui/NodeTestSupport.h"

namespace norvik::ui::test {
namespace {

using RectL = tarsel::geom::RectT<long>;
using RectF = tarsel::geom::RectT<float>;

class FakeCache : public drawbot::CacheInterface {
 public:
  drawbot::SurfaceInterface* GetSurface() const override { return nullptr; }
  bool IsValid(const drawbot::SurfaceInterface&, const RectF&) const override { return true; }
};

// A small palette; NotifyThemeChanged moves its change count on.
ThemeP MakeTheme() { return ThemeP(new Theme(4, 1)); }

class Invalidation : public ManagerTest {
 protected:
  void SetUp() override {
    root = MakeView(0, 0, 200, 200, nullptr, "root");
    mid = MakeView(10, 10, 100, 100, root.get(), "mid");
    leaf = MakeView(5, 5, 20, 20, mid.get(), "leaf");
    root->invalidations.clear();
    mid->invalidations.clear();
  }
  RecordingViewP root, mid, leaf;
};

TEST_F(Invalidation, AWholeNodeInvalidationClimbsInEachParentsCoordinates) {
  leaf->UI_Invalidate(nullptr, 0);
  ASSERT_EQ(mid->invalidations.size(), 1u);
  EXPECT_EQ(mid->invalidations[0].rect, RectL(5, 5, 20, 20));
  ASSERT_EQ(root->invalidations.size(), 1u);
  EXPECT_EQ(root->invalidations[0].rect, RectL(15, 15, 20, 20));
}

TEST_F(Invalidation, APartRectangleIsClippedToTheNodeAndScaledOnTheWayUp) {
  mid->UI_SetMatrix(tarsel::geom::ScaleMatrixT<float>(0.5f, 0.5f, 0, 0));
  root->invalidations.clear();
  mid->invalidations.clear();
  RectL part(10, -5, 30, 8);
  leaf->UI_Invalidate(&part, 0);
  ASSERT_EQ(mid->invalidations.size(), 1u);
  EXPECT_EQ(mid->invalidations[0].rect, RectL(15, 5, 10, 3));  // (10,0)-(20,3) moved by (5,5)
  ASSERT_EQ(root->invalidations.size(), 1u);
  // mid maps q to (q + 10) * 0.5: (12.5,7.5)-(17.5,9) encloses to (12,7)-(18,9).
  EXPECT_EQ(root->invalidations[0].rect, RectL(12, 7, 6, 2));
}

TEST_F(Invalidation, ARectangleOutsideTheNodeInvalidatesNothingAbove) {
  RectL outside(50, 50, 10, 10);
  leaf->UI_Invalidate(&outside, 0);
  EXPECT_TRUE(mid->invalidations.empty());
}

TEST_F(Invalidation, AncestorsSeeTheCallersFlagsButTheNodeDropsItsOwnCache) {
  manager.IncrementDrawbotCacheSeed();
  leaf->UI_SetDrawbotCache(new FakeCache);
  leaf->UI_Invalidate(nullptr, UI_Node::kInvalidateKeepRendering);
  ASSERT_EQ(mid->invalidations.size(), 1u);
  EXPECT_EQ(mid->invalidations[0].flags, UI_Node::kInvalidateKeepRendering);
  EXPECT_EQ(leaf->UI_GetDrawbotCache(), nullptr);
}

TEST_F(Invalidation, AHiddenViewDropsItsOwnCacheButInvalidatesNoParent) {
  leaf->UI_Show(false);
  mid->invalidations.clear();
  manager.IncrementDrawbotCacheSeed();
  leaf->UI_SetDrawbotCache(new FakeCache);
  leaf->UI_Invalidate(nullptr, 0);
  EXPECT_TRUE(mid->invalidations.empty());
  EXPECT_EQ(leaf->UI_GetDrawbotCache(), nullptr);
}

TEST_F(Invalidation, ANewSeedMakesTheNextInvalidationDropTheCachesUpToTheRoot) {
  mid->UI_SetDrawbotCache(new FakeCache);
  root->UI_SetDrawbotCache(new FakeCache);
  manager.IncrementDrawbotCacheSeed();
  leaf->UI_InvalidateDrawbotCache(false);
  EXPECT_EQ(mid->UI_GetDrawbotCache(), nullptr);
  EXPECT_EQ(root->UI_GetDrawbotCache(), nullptr);
  EXPECT_EQ(leaf->UI_GetDrawbotCacheInvalidatedSeed(), manager.GetDrawbotCacheSeed());
  EXPECT_EQ(root->UI_GetDrawbotCacheInvalidatedSeed(), manager.GetDrawbotCacheSeed());
}

TEST_F(Invalidation, ASecondInvalidationUnderTheSameSeedIsCutShort) {
  manager.IncrementDrawbotCacheSeed();
  leaf->UI_InvalidateDrawbotCache(false);
  // Without a theme, storing a cache does not move the seed on.
  mid->UI_SetThemeSupplier(boost::make_shared<boost::function<ThemeP()>>([] { return ThemeP(); }));
  mid->UI_SetDrawbotCache(new FakeCache);
  leaf->UI_InvalidateDrawbotCache(false);
  EXPECT_NE(mid->UI_GetDrawbotCache(), nullptr);
}

TEST_F(Invalidation, StoringACacheUnderAThemeReArmsInvalidationEverywhere) {
  ThemeP theme = MakeTheme();
  theme->NotifyThemeChanged();
  mid->UI_SetThemeSupplier(boost::make_shared<boost::function<ThemeP()>>([theme] { return ThemeP(theme); }));
  manager.IncrementDrawbotCacheSeed();
  leaf->UI_InvalidateDrawbotCache(false);
  const auto seed = manager.GetDrawbotCacheSeed();
  mid->UI_SetDrawbotCache(new FakeCache);
  EXPECT_EQ(manager.GetDrawbotCacheSeed(), seed + 1);
  leaf->UI_InvalidateDrawbotCache(false);
  EXPECT_EQ(mid->UI_GetDrawbotCache(), nullptr);
}

TEST_F(Invalidation, ACacheIsValidOnlyUnderTheSameThemeAndChangeCount) {
  ThemeP theme = MakeTheme();
  leaf->UI_SetThemeSupplier(boost::make_shared<boost::function<ThemeP()>>([theme] { return ThemeP(theme); }));
  leaf->UI_SetDrawbotCache(new FakeCache);
  drawbot::testing::RecordingSupplier supplier;
  drawbot::testing::RecordingSurface surface(&supplier, 10, 10);
  EXPECT_TRUE(leaf->UI_IsDrawbotCacheValid(surface));
  theme->NotifyThemeChanged();
  EXPECT_FALSE(leaf->UI_IsDrawbotCacheValid(surface));
}

TEST_F(Invalidation, MovingAChildInvalidatesTheParentAtTheOldAndTheNewPlace) {
  leaf->UI_SetLocalRectF(RectF(50, 60, 20, 20));
  ASSERT_GE(mid->invalidations.size(), 2u);
  EXPECT_EQ(mid->invalidations[0].rect, RectL(5, 5, 20, 20));
  EXPECT_EQ(mid->invalidations[1].rect, RectL(50, 60, 20, 20));
}

}  // namespace
}  // namespace norvik::ui::test
