// Caches: what PushCacheStack makes, when IsValid holds, and where DrawCache
// puts the pixels.
#include <gtest/gtest.h>

#include "drawbot/BitmapCacheInterface.h"
#include "drawbot/DrawbotWrappers.h"
#include "support/drawbot/PixelCompare.h"
#include "support/drawbot/RecordingSupplier.h"

namespace norvik::drawbot {
namespace {

using tarsel::geom::MatrixT;
using tarsel::geom::RectT;
using testing::PixelCanvas;
using testing::RecordingSupplier;
using testing::RowCoverage;

TEST(DrawCache, ACacheStaysValidAfterAWholePixelMoveAndNotAfterAFractionalOne) {
  SurfaceP surface(NewOSSupplier(), 100, 100);
  RectT<float> rect(0, 0, 20, 10);
  surface->PushStateStack();
  surface->Transform(MatrixT<float>::Translation(3, 4));
  auto cache = surface->PushCacheStack(rect);
  ASSERT_TRUE(cache);
  surface->PopCacheStack(cache);
  EXPECT_TRUE(cache->IsValid(*surface, rect));
  surface->PopStateStack();

  surface->PushStateStack();
  surface->Transform(MatrixT<float>::Translation(5, 7));
  EXPECT_TRUE(cache->IsValid(*surface, rect));
  surface->PopStateStack();

  surface->PushStateStack();
  surface->Transform(MatrixT<float>::Translation(5.5f, 7));
  EXPECT_FALSE(cache->IsValid(*surface, rect));
  surface->PopStateStack();
}

TEST(DrawCache, ACacheIsInvalidForAnotherRectanglePolicyScaleOrSupplier) {
  SurfaceP surface(NewOSSupplier(), 100, 100);
  RectT<float> rect(0, 0, 20, 10);
  auto cache = surface->PushCacheStack(rect);
  ASSERT_TRUE(cache);
  EXPECT_FALSE(cache->IsValid(*surface, RectT<float>(0, 0, 20, 11)));
  surface->SetAntiAliasPolicy(kAntiAlias);
  EXPECT_FALSE(cache->IsValid(*surface, rect));
  surface->SetAntiAliasPolicy(kAntiAliasNone);
  surface->SetInterpolationPolicy(kInterpolationLowQuality);
  EXPECT_FALSE(cache->IsValid(*surface, rect));
  surface->SetInterpolationPolicy(kInterpolationNearestNeighbor);
  EXPECT_TRUE(cache->IsValid(*surface, rect));
  surface->PushStateStack();
  surface->Transform(MatrixT<float>::Scale(2, 2));
  EXPECT_FALSE(cache->IsValid(*surface, rect));
  surface->PopStateStack();
  RecordingSupplier recorder;
  SurfaceP other(recorder.NewOffscreenSurface(100, 100, false));
  EXPECT_FALSE(cache->IsValid(*other, rect));
}

TEST(DrawCache, ARectangleWithinOnePixelRowGivesACacheOfHeightOne) {
  SurfaceP surface(NewOSSupplier(), 100, 100);
  auto cache = surface->PushCacheStack(RectT<float>(2.2f, 3.1f, 10, 0.5f));
  ASSERT_TRUE(cache);
  auto const* bitmap = dynamic_cast<BitmapCacheInterface const*>(cache.get());
  ASSERT_NE(bitmap, nullptr);
  EXPECT_EQ(bitmap->GetSurfaceDestRect(), RectT<long>(2, 3, 11, 1));
  EXPECT_EQ(surface->PushCacheStack(RectT<float>(5, 5, 0, 10)), nullptr);
}

TEST(DrawCache, DrawCachePutsThePixelsBackWhereTheyWereAfterAWholePixelScroll) {
  PixelCanvas canvas(20, 6);
  SurfaceInterface* surface = canvas.GetSurface();
  RectT<float> rect(0, 0, 4, 2);
  surface->PushStateStack();
  surface->Transform(MatrixT<float>::Translation(2, 1));
  auto cache = surface->PushCacheStack(rect);
  ASSERT_TRUE(cache);
  cache->GetSurface()->PaintRect(ColorRGBA(0, 0, 0, 1), RectT<float>(1, 0, 2, 2));
  surface->PopCacheStack(cache);
  surface->PopStateStack();

  surface->PushStateStack();
  surface->Transform(MatrixT<float>::Translation(10, 3));
  ASSERT_TRUE(cache->IsValid(*surface, rect));
  surface->DrawCache(*cache);
  surface->PopStateStack();
  auto image = canvas.Snapshot();
  EXPECT_EQ(RowCoverage(image, 2), "....................");
  EXPECT_EQ(RowCoverage(image, 3), "...........##.......");
  EXPECT_EQ(RowCoverage(image, 4), "...........##.......");
  EXPECT_EQ(RowCoverage(image, 5), "....................");
}

TEST(DrawCache, DrawCacheOnTheRecorderLeavesTheStackBalanced) {
  RecordingSupplier supplier;
  auto* surface = static_cast<testing::RecordingSurface*>(supplier.NewOffscreenSurface(100, 100, false));
  SurfaceP holder(surface);
  auto cache = surface->PushCacheStack(RectT<float>(0, 0, 10, 10));
  ASSERT_TRUE(cache);
  size_t depth = surface->GetStateDepth();
  supplier.ClearCalls();
  surface->DrawCache(*cache);
  EXPECT_EQ(surface->GetStateDepth(), depth);
  std::vector<std::string> expected = {"Push", "DrawImage", "Pop"};
  EXPECT_EQ(supplier.GetOps(), expected);
}

}  // namespace
}  // namespace norvik::drawbot
