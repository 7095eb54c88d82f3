// Rounding and half-pixel rules of the image back end, read back from pixels.
#include <gtest/gtest.h>

#include "drawbot/DrawHelpers.h"
#include "support/drawbot/PixelCompare.h"

namespace norvik::drawbot {
namespace {

using testing::ColumnCoverage;
using testing::PixelCanvas;
using testing::RowCoverage;
using tarsel::geom::PointT;
using tarsel::geom::RectT;

const ColorRGBA kBlack(0, 0, 0, 1);

// Painted rectangles stay crisp, anti-aliased or not: a fractional one is
// widened outward to whole pixels, and its edges are fully covered.
TEST(HalfPixelRules, APaintedRectangleFillsWholePixelsWithFullCoverage) {
  const struct {
    const char* name;
    RectT<float> rect;
    AntiAliasPolicy policy;
  } cases[] = {
      {"whole", RectT<float>(2, 1, 5, 2), kAntiAliasNone},
      {"fractional", RectT<float>(2.5f, 1.25f, 4.0f, 1.5f), kAntiAliasNone},
      {"whole, anti-aliased", RectT<float>(2, 1, 5, 2), kAntiAlias},
  };
  for (const auto& c : cases) {
    PixelCanvas canvas(12, 4);
    canvas.GetSurface()->SetAntiAliasPolicy(c.policy);
    canvas.GetSurface()->PaintRect(kBlack, c.rect);
    auto image = canvas.Snapshot();
    EXPECT_EQ(RowCoverage(image, 0), "............") << c.name;
    EXPECT_EQ(RowCoverage(image, 1), "..#####.....") << c.name;
    EXPECT_EQ(RowCoverage(image, 2), "..#####.....") << c.name;
    EXPECT_EQ(RowCoverage(image, 3), "............") << c.name;
    EXPECT_EQ(image.At(2, 1), 0xff000000u) << c.name;
    EXPECT_EQ(image.At(6, 2), 0xff000000u) << c.name;
  }
}

// A one-pixel line from (2, 5) to (9, 5): through whole-number points without
// anti-aliasing it lights row 5 alone; anti-aliased it straddles rows 4 and 5
// at half strength; through float points it is no longer pixel aligned and is
// drawn in the shifted frame, half a pixel away, even without anti-aliasing.
TEST(HalfPixelRules, AOnePixelLineLightsTheRowsItsAlignmentAndPolicyGiveIt) {
  const struct {
    const char* name;
    bool floatPoints;
    AntiAliasPolicy policy;
    int alphaRow4, alphaRow5;
  } cases[] = {
      {"aligned", false, kAntiAliasNone, 0, 255},
      {"anti-aliased", false, kAntiAlias, 128, 128},
      {"float points", true, kAntiAliasNone, 255, 0},
  };
  for (const auto& c : cases) {
    PixelCanvas canvas(12, 10);
    canvas.GetSurface()->SetAntiAliasPolicy(c.policy);
    PathP path(canvas.GetSupplier());
    if (c.floatPoints) {
      path->MoveTo(PointT<float>(2, 5));
      path->LineTo(PointT<float>(9, 5));
    } else {
      path->MoveTo(PointT<long>(2, 5));
      path->LineTo(PointT<long>(9, 5));
    }
    canvas.GetSurface()->StrokePath(*PenP(canvas.GetSupplier(), kBlack, 1), *path);
    auto image = canvas.Snapshot();
    EXPECT_NEAR(image.Alpha(5, 4), c.alphaRow4, 2) << c.name;
    EXPECT_NEAR(image.Alpha(5, 5), c.alphaRow5, 2) << c.name;
    EXPECT_EQ(RowCoverage(image, 3), "............") << c.name;
    EXPECT_EQ(RowCoverage(image, 6), "............") << c.name;
  }
}

TEST(HalfPixelRules, StrokeRectOutlinesTheRectangleIncludingItsFarEdge) {
  PixelCanvas canvas(10, 10);
  Drawbot drawbot(canvas.GetSupplier(), canvas.GetSurface());
  canvas.GetSurface()->SetAntiAliasPolicy(kAntiAlias);
  StrokeRect(drawbot, RectT<long>(1, 1, 6, 6), kBlack, 1);
  auto image = canvas.Snapshot();
  EXPECT_EQ(RowCoverage(image, 1), ".#######..");
  EXPECT_EQ(RowCoverage(image, 3), ".#.....#..");
  EXPECT_EQ(RowCoverage(image, 7), ".#######..");
  EXPECT_EQ(image.Alpha(1, 3), 255);
  // StrokeRect turned anti-aliasing off only inside its own state.
  EXPECT_EQ(canvas.GetSurface()->GetAntiAliasPolicy(), kAntiAlias);
}

TEST(HalfPixelRules, ShapesMatchTheirReferenceImage) {
  PixelCanvas canvas(48, 32);
  canvas.Clear(0xffffff);
  SurfaceInterface* surface = canvas.GetSurface();
  SupplierInterface const* supplier = canvas.GetSupplier();
  surface->PaintRect(ColorRGBA(0.2f, 0.4f, 0.8f, 1), RectT<float>(2, 2, 10, 8));
  surface->SetAntiAliasPolicy(kAntiAlias);
  PathP ellipse;
  GetEllipsePath(supplier, RectT<float>(16, 2, 14, 10), &ellipse);
  BrushP red(supplier, ColorRGBA(0.9f, 0.1f, 0.1f, 1));
  surface->FillPath(*red, *ellipse, kFillWinding);
  PathP rounded;
  GetRoundedRectPath(supplier, RectT<float>(4, 14, 26, 14), 5, &rounded);
  PenP green(supplier, ColorRGBA(0.1f, 0.6f, 0.2f, 1), 2);
  surface->StrokePath(*green, *rounded);
  PathP arc(supplier);
  arc->MoveTo(PointT<float>(36, 24));
  arc->AddArc(PointT<float>(40, 16), 6, 180, 270);
  PenP black(supplier, kBlack, 1.5f);
  surface->StrokePath(*black, *arc);
  EXPECT_TRUE(testing::MatchesReference(canvas.Snapshot(), "drawbot/shapes"));
}

}  // namespace
}  // namespace norvik::drawbot
