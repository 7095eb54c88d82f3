// The clip: IsWithinClipBounds and the bisection of GetMinimumClipBounds.
#include <cairo.h>
#include <gtest/gtest.h>

#include "drawbot/DrawbotWrappers.h"
#include "support/drawbot/RecordingSupplier.h"

namespace norvik::drawbot {
namespace {

using tarsel::geom::MatrixT;
using tarsel::geom::RectT;
using testing::RecordingSupplier;
using testing::RecordingSurface;

TEST(ClipBounds, IsWithinClipBoundsIsTrueOnlyForRectanglesThatTouchTheClip) {
  SurfaceP surface(NewOSSupplier(), 100, 100);
  PathP clip(NewOSSupplier());
  clip->AddRect(RectT<long>(20, 20, 30, 30));
  surface->Clip(*clip, kFillWinding);
  EXPECT_TRUE(surface->IsWithinClipBounds(RectT<long>(0, 0, 21, 21)));
  EXPECT_FALSE(surface->IsWithinClipBounds(RectT<long>(0, 0, 20, 20)));
  EXPECT_FALSE(surface->IsWithinClipBounds(RectT<long>(50, 20, 10, 10)));
  EXPECT_FALSE(surface->IsWithinClipBounds(RectT<long>(25, 25, 0, 10)));
}

TEST(ClipBounds, MinimumClipBoundsShrinksToThePartThatTouchesTheClip) {
  RecordingSupplier supplier;
  boost::intrusive_ptr<RecordingSurface> surface(new RecordingSurface(&supplier, 1000, 1000));
  surface->SetClipRects({RectT<long>(100, 300, 50, 20), RectT<long>(400, 120, 10, 10)});
  RectT<long> found = surface->GetMinimumClipBounds(RectT<long>(0, 0, 1000, 1000));
  EXPECT_EQ(found, RectT<long>::FromEdges(100, 120, 410, 320));
  EXPECT_TRUE(surface->GetMinimumClipBounds(RectT<long>(500, 500, 20, 20)).IsEmpty()) << "outside the clip";
}

TEST(ClipBounds, BisectionProbesLogarithmicallyManyRectangles) {
  RecordingSupplier supplier;
  boost::intrusive_ptr<RecordingSurface> surface(new RecordingSurface(&supplier, 100000, 10));
  surface->SetClipRects({RectT<long>(77777, 0, 3, 10)});
  surface->mClipProbes = 0;
  RectT<long> found = surface->GetMinimumHorizontalClipBounds(RectT<long>(0, 0, 100000, 10));
  EXPECT_EQ(found, RectT<long>(77777, 0, 3, 10));
  EXPECT_LT(surface->mClipProbes, 40);
}

TEST(ClipBounds, APaintRegionIsHonouredExactlyUnlessItsBoundsAreTheWholeTarget) {
  cairo_surface_t* target = cairo_image_surface_create(CAIRO_FORMAT_ARGB32, 200, 200);
  cairo_region_t* region = cairo_region_create();
  cairo_rectangle_int_t a{10, 10, 20, 20}, b{150, 150, 20, 20};
  cairo_region_union_rectangle(region, &a);
  cairo_region_union_rectangle(region, &b);
  {
    OSSurfaceP surface(NewOSSupplier(), target, region);
    // Inside the bounding box of the region, but between its two rectangles.
    EXPECT_FALSE(surface->IsWithinClipBounds(RectT<long>(50, 50, 50, 50)));
    EXPECT_TRUE(surface->IsWithinClipBounds(RectT<long>(25, 25, 10, 10)));
    EXPECT_EQ(surface->GetMinimumClipBounds(RectT<long>(0, 0, 100, 100)), RectT<long>(10, 10, 20, 20));
    std::vector<RectT<long>> rects;
    surface->GetOutputClipRects(&rects);
    ASSERT_EQ(rects.size(), 2u);
    EXPECT_EQ(rects[0], RectT<long>(10, 10, 20, 20));
  }
  // Rectangles whose bounds are the whole target are no restriction at all.
  cairo_rectangle_int_t corner{180, 180, 20, 20}, origin{0, 0, 20, 20};
  cairo_region_t* spanning = cairo_region_create_rectangle(&origin);
  cairo_region_union_rectangle(spanning, &corner);
  {
    OSSurfaceP surface(NewOSSupplier(), target, spanning);
    EXPECT_TRUE(surface->IsWithinClipBounds(RectT<long>(50, 50, 50, 50)));
  }
  cairo_region_destroy(spanning);
  cairo_region_destroy(region);
  cairo_surface_destroy(target);
}

}  // namespace
}  // namespace norvik::drawbot
