// Paths on the image back end: figures, arcs, fill rules and clipping by a path.
#include <gtest/gtest.h>

#include "drawbot/DrawbotWrappers.h"
#include "support/drawbot/PixelCompare.h"
#include "tarsel/ThrowError.h"

namespace norvik::drawbot {
namespace {

using tarsel::geom::PointT;
using tarsel::geom::RectT;
using testing::PixelCanvas;
using testing::RowCoverage;

const ColorRGBA kBlack(0, 0, 0, 1);

void Square(PathP& ioPath, long inLeft, long inTop, long inSize) {
  ioPath->MoveTo(PointT<long>(inLeft, inTop));
  ioPath->LineTo(PointT<long>(inLeft + inSize, inTop));
  ioPath->LineTo(PointT<long>(inLeft + inSize, inTop + inSize));
  ioPath->LineTo(PointT<long>(inLeft, inTop + inSize));
  ioPath->LineTo(PointT<long>(inLeft, inTop));
}

TEST(Paths, StartingANewFigureClosesOneThatReturnedToItsStart) {
  PixelCanvas open(40, 40), closed(40, 40);
  PenP pen(open.GetSupplier(), kBlack, 4);
  PathP a(open.GetSupplier()), b(open.GetSupplier());
  Square(a, 10, 10, 20);
  Square(b, 10, 10, 20);
  b->MoveTo(PointT<long>(35, 35));
  open.GetSurface()->StrokePath(*pen, *a);
  closed.GetSurface()->StrokePath(*pen, *b);
  // Flat caps leave the outer corner at the start empty; a closed figure joins it.
  EXPECT_EQ(open.Snapshot().Alpha(8, 8), 0);
  EXPECT_EQ(closed.Snapshot().Alpha(8, 8), 255);
  EXPECT_EQ(closed.Snapshot().Alpha(31, 31), 255);  // the other corners are joined in both
  EXPECT_EQ(open.Snapshot().Alpha(31, 31), 255);
}

TEST(Paths, AnArcWithRadiusZeroIsALineToItsCentre) {
  PixelCanvas canvas(20, 5);
  PathP path(canvas.GetSupplier());
  path->MoveTo(PointT<float>(2, 2));
  path->AddArc(PointT<float>(12, 2), 0, 0, 90);
  PenP pen(canvas.GetSupplier(), kBlack, 2);
  canvas.GetSurface()->StrokePath(*pen, *path);
  auto row = RowCoverage(canvas.Snapshot(), 2);
  EXPECT_EQ(row, "..##########........");
}

TEST(Paths, AnArcIsJoinedToTheCurrentPointByALine) {
  PixelCanvas canvas(40, 40);
  canvas.GetSurface()->SetAntiAliasPolicy(kAntiAlias);
  PathP path(canvas.GetSupplier());
  path->MoveTo(PointT<float>(2, 20));
  path->AddArc(PointT<float>(25, 20), 10, 180, 180);  // from the left point, clockwise over the top
  PenP pen(canvas.GetSupplier(), kBlack, 2);
  canvas.GetSurface()->StrokePath(*pen, *path);
  auto shot = canvas.Snapshot();
  EXPECT_GT(shot.Alpha(8, 20), 100);   // the joining line
  EXPECT_GT(shot.Alpha(25, 10), 100);  // the top of the arc
  EXPECT_EQ(shot.Alpha(25, 30), 0);    // nothing under the centre
}

TEST(Paths, EvenOddLeavesTheInnerSquareEmptyAndWindingFillsIt) {
  PixelCanvas evenOdd(30, 30), winding(30, 30);
  PathP path(evenOdd.GetSupplier());
  Square(path, 2, 2, 26);
  path->ClosePath();
  Square(path, 10, 10, 10);
  path->ClosePath();
  BrushP brush(evenOdd.GetSupplier(), kBlack);
  evenOdd.GetSurface()->FillPath(*brush, *path, kFillAlternate);
  winding.GetSurface()->FillPath(*brush, *path, kFillWinding);
  EXPECT_EQ(evenOdd.Snapshot().Alpha(15, 15), 0);
  EXPECT_EQ(evenOdd.Snapshot().Alpha(5, 15), 255);
  EXPECT_EQ(winding.Snapshot().Alpha(15, 15), 255);
}

TEST(Paths, ClippingToAPathLimitsLaterDrawing) {
  PixelCanvas canvas(12, 3);
  PathP clip(canvas.GetSupplier());
  clip->AddRect(RectT<long>(2, 0, 3, 3));
  clip->AddRect(RectT<long>(8, 0, 2, 3));
  canvas.GetSurface()->PushStateStack();
  canvas.GetSurface()->Clip(*clip, kFillWinding);
  canvas.GetSurface()->PaintRect(kBlack, RectT<float>(0, 0, 12, 3));
  canvas.GetSurface()->PopStateStack();
  EXPECT_EQ(RowCoverage(canvas.Snapshot(), 1), "..###...##..");
}

TEST(Paths, ASingularTransformIsRefused) {
  SurfaceP surface(NewOSSupplier(), 10, 10);
  EXPECT_THROW(surface->Transform(tarsel::geom::MatrixT<float>::Scale(0, 1)), tarsel::config::Exception);
  tarsel::geom::MatrixT<float> m;
  surface->GetTransform(&m);
  EXPECT_TRUE(m.IsIdentity());
}

TEST(Paths, AReferenceToNothingRaisesTheReferenceError) {
  try {
    SurfaceP(NewOSSupplier()->NewReferenceSurface(nullptr, false, nullptr));
    FAIL();
  } catch (tarsel::config::Exception const& e) {
    EXPECT_STREQ(e.what(), "Unable to create drawing reference.");
  }
}

}  // namespace
}  // namespace norvik::drawbot
