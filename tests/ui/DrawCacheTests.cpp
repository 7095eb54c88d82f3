// Per-node draw caches during the traversal: when they are built, reused,
// rebuilt and dropped.
#include <boost/make_shared.hpp>
#include <gtest/gtest.h>

#include "support/ui/DrawTestNodes.h"
#include "support/ui/NodeTestSupport.h"
#include "ui/Theme.h"

namespace norvik::ui::test {
namespace {

using Strings = std::vector<std::string>;
using drawbot::ColorRGBA;
using RectF = tarsel::geom::RectT<float>;

class CachingSupplier : public drawbot::testing::RecordingSupplier {
 public:
  bool PrefersToCacheAggressively() const override { return true; }
};

class DrawCache : public ManagerTest {
 protected:
  void SetUp() override {
    theme.reset(new Theme(379, 3));
    Theme::Initialize(theme);
    root = AddPaintingView("root", 0, 0, 100, 100, 2, &log, nullptr);
    panel = AddPaintingView("panel", 10, 10, 60, 60, 3, &log, root.get());
    leaf = AddPaintingView("leaf", 5, 5, 20, 20, 4, &log, panel.get());
  }
  void TearDown() override { Theme::Terminate(); }
  void Paint() { root->UI_DispatchDrawFromRoot(nullptr, &target.drawbot, false); }

  ThemeP theme;
  Strings log;
  RecordingTarget target;
  PaintingViewP root, panel, leaf;
};

TEST_F(DrawCache, ByDefaultTheSuppliersPreferenceDecides) {
  RecordingTarget plain;
  CachingSupplier caching;
  boost::intrusive_ptr<drawbot::SurfaceInterface> surface(caching.NewOffscreenSurface(10, 10, false));
  drawbot::Drawbot cachingBot(&caching, surface.get());
  EXPECT_FALSE(leaf->UI_UseDrawbotCache(&plain.drawbot));
  EXPECT_TRUE(leaf->UI_UseDrawbotCache(&cachingBot));
  leaf->UI_SetDrawCachePolicy(UI_Node::kDrawCacheNever);
  EXPECT_FALSE(leaf->UI_UseDrawbotCache(&cachingBot));
  leaf->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  EXPECT_TRUE(leaf->UI_UseDrawbotCache(&plain.drawbot));
}

TEST_F(DrawCache, TheFirstPaintFillsTheCacheAndShowsItAndLaterPaintsShowOnlyTheCache) {
  panel->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  Paint();
  EXPECT_EQ(log, (Strings{"panel", "leaf"}));
  ASSERT_TRUE(panel->UI_GetDrawbotCache());
  auto calls = target.Take();
  ASSERT_EQ(RecordingTarget::Count(calls, "PaintRect"), 2);
  ASSERT_EQ(RecordingTarget::Count(calls, "DrawImage"), 1);
  const auto last = [&](const char* inOp) {
    size_t at = 0;
    for (size_t i = 0; i < calls.size(); ++i) at = calls[i].op == inOp ? i : at;
    return at;
  };
  EXPECT_GT(last("DrawImage"), last("PaintRect")) << "shown after it is filled";
  Paint();
  EXPECT_EQ(log, (Strings{"panel", "leaf"}));
  calls = target.Take();
  EXPECT_EQ(RecordingTarget::Count(calls, "DrawImage"), 1);
  EXPECT_EQ(RecordingTarget::Count(calls, "PaintRect"), 0);
}

TEST_F(DrawCache, AWholePixelScrollKeepsTheCacheAndAFractionalScrollRebuildsIt) {
  leaf->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  panel->UI_SetMatrixOnlyForChildren(true);
  Paint();
  panel->UI_SetMatrix(UI_Node::Matrix::Translation(3, -2));
  Paint();
  EXPECT_EQ(leaf->draws, 1);
  panel->UI_SetMatrix(UI_Node::Matrix::Translation(3.5f, -2));
  Paint();
  EXPECT_EQ(leaf->draws, 2);
  panel->UI_SetMatrix(UI_Node::Matrix::Translation(-1.5f, 4));
  Paint();
  EXPECT_EQ(leaf->draws, 2);
}

TEST_F(DrawCache, AThemeChangeMakesEveryCacheStale) {
  panel->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  leaf->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  Paint();
  EXPECT_TRUE(leaf->UI_IsDrawbotCacheValid(*target.surface));
  theme->NotifyThemeChanged();
  EXPECT_FALSE(leaf->UI_IsDrawbotCacheValid(*target.surface));
  Paint();
  EXPECT_EQ(panel->draws, 2);
  EXPECT_EQ(leaf->draws, 2);
}

TEST_F(DrawCache, SwitchingToAnotherThemeMakesTheCacheStale) {
  panel->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  Paint();
  ThemeP other(new Theme(379, 3));
  Theme::RegisterTheme(u"Other", other);
  root->SetThemeName(u"Other", true);
  panel->UI_ResetThemeSupplier();
  ASSERT_EQ(panel->UI_GetCurrentTheme(), other);
  Paint();
  EXPECT_EQ(panel->draws, 2);
}

TEST_F(DrawCache, InvalidatingALeafDropsTheCachesAboveItAndTheNextPaintRebuildsThem) {
  panel->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  root->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  Paint();
  leaf->UI_Invalidate(nullptr, 0);
  EXPECT_FALSE(panel->UI_GetDrawbotCache());
  EXPECT_FALSE(root->UI_GetDrawbotCache());
  Paint();
  EXPECT_EQ(leaf->draws, 2);
  EXPECT_TRUE(panel->UI_GetDrawbotCache());
}

TEST_F(DrawCache, RepeatedInvalidationBetweenTwoStoredCachesClimbsOnlyOnce) {
  Paint();
  leaf->UI_InvalidateDrawbotCache(false);
  // A cache stored without a theme does not re-arm invalidation, so the
  // second invalidation of the leaf stops at once and leaves it in place.
  panel->UI_SetThemeSupplier(boost::make_shared<boost::function<ThemeP()>>([] { return ThemeP(); }));
  boost::intrusive_ptr<drawbot::CacheInterface> handMade(target.surface->PushCacheStack(RectF(0, 0, 10, 10)));
  panel->UI_SetDrawbotCache(handMade);
  leaf->UI_InvalidateDrawbotCache(false);
  EXPECT_EQ(panel->UI_GetDrawbotCache(), handMade);
  // A cache stored under a theme re-arms it: now the climb happens again.
  leaf->UI_SetDrawbotCache(handMade);
  leaf->UI_InvalidateDrawbotCache(false);
  EXPECT_FALSE(panel->UI_GetDrawbotCache());
  EXPECT_FALSE(leaf->UI_GetDrawbotCache());
}

TEST_F(DrawCache, ANodeDropsItsCacheWhenItStopsCachingOrIsHidden) {
  panel->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  leaf->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  Paint();
  ASSERT_TRUE(panel->UI_GetDrawbotCache());
  leaf->UI_Show(false);
  leaf->UI_Show(true);
  panel->UI_SetDrawCachePolicy(UI_Node::kDrawCacheNever);
  Paint();
  EXPECT_FALSE(panel->UI_GetDrawbotCache());
  EXPECT_EQ(panel->draws, 2);
  EXPECT_EQ(leaf->draws, 2);
}

TEST_F(DrawCache, AThemeChangeWhileTheTreeIsDrawnNeverLeavesAStaleCache) {
  panel->UI_SetDrawCachePolicy(UI_Node::kDrawCacheAlways);
  leaf->colorID = 19;
  bool changed = false;
  leaf->onDraw = [&](drawbot::Drawbot*) {
    if (changed) return;
    changed = true;
    theme->SetColor(19, ColorRGBA(1, 0, 1, 1));
    theme->NotifyThemeChanged();
  };
  Paint();
  // The panel's pixels mixed two themes: they were not kept, and the panel
  // was drawn once more, directly, in the new colours.
  EXPECT_FALSE(panel->UI_GetDrawbotCache());
  EXPECT_EQ(panel->draws, 2);
  target.Take();
  Paint();
  bool sawNewColour = false;
  for (const auto& c : target.Take()) sawNewColour |= c.op == "PaintRect" && c.color == ColorRGBA(1, 0, 1, 1);
  EXPECT_TRUE(sawNewColour);
  EXPECT_TRUE(panel->UI_IsDrawbotCacheValid(*target.surface));
}

}  // namespace
}  // namespace norvik::ui::test
