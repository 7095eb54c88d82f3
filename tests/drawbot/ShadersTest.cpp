// Linear and radial shaders: the stops that are filled in, and the pixels.
#include <gtest/gtest.h>

#include "drawbot/DrawbotWrappers.h"
#include "support/drawbot/PixelCompare.h"
#include "support/drawbot/RecordingSupplier.h"

namespace norvik::drawbot {
namespace {

using tarsel::geom::PointT;
using tarsel::geom::RectT;
using testing::PixelCanvas;
using testing::RecordingLinearShader;
using testing::RecordingSupplier;

const ColorRGBA kRed(1, 0, 0, 1), kBlue(0, 0, 1, 1), kGreen(0, 1, 0, 1);

RecordingLinearShader const& AsRecorded(LinearShaderP const& inShader) {
  return dynamic_cast<RecordingLinearShader const&>(*inShader);
}

TEST(ShaderStops, InnerStopsGetEndStopsRepeatingTheirNeighboursAndStopsAtTheEndsAreNotDoubled) {
  RecordingSupplier supplier;
  LinearShaderP inner(&supplier, PointT<float>(0, 0), PointT<float>(10, 0),
                      std::vector<std::pair<float, ColorRGBA>>{{0.2f, kRed}, {0.8f, kBlue}});
  EXPECT_EQ(AsRecorded(inner).positions, (std::vector<float>{0, 0.2f, 0.8f, 1}));
  EXPECT_EQ(AsRecorded(inner).colors, (std::vector<ColorRGBA>{kRed, kRed, kBlue, kBlue}));
  LinearShaderP ends(&supplier, PointT<float>(0, 0), PointT<float>(10, 0),
                     std::vector<std::pair<float, ColorRGBA>>{{0, kRed}, {0.5f, kGreen}, {1, kBlue}});
  EXPECT_EQ(AsRecorded(ends).positions, (std::vector<float>{0, 0.5f, 1}));
}

TEST(ShaderPixels, ALinearShaderRunsFromItsStartColourToItsEndColour) {
  PixelCanvas canvas(101, 3);
  LinearShaderP shader(canvas.GetSupplier(), PointT<float>(0, 0), PointT<float>(101, 0),
                       std::vector<std::pair<float, ColorRGBA>>{{0.25f, kRed}, {0.75f, kBlue}});
  PathP path(canvas.GetSupplier());
  path->AddRect(RectT<long>(0, 0, 101, 3));
  canvas.GetSurface()->ShadePath(*shader, *path, kFillAlternate);
  auto shot = canvas.Snapshot();
  EXPECT_EQ(shot.At(5, 1), 0xffff0000u);    // before the first stop: its colour
  EXPECT_EQ(shot.At(95, 1), 0xff0000ffu);   // after the last stop: its colour
  uint32_t middle = shot.At(50, 1);
  EXPECT_NEAR((middle >> 16) & 0xff, 128, 4);
  EXPECT_NEAR(middle & 0xff, 128, 4);
}

TEST(ShaderPixels, ARadialShaderRunsFromTheFocusOutToTheRim) {
  PixelCanvas canvas(41, 41);
  float radii[2] = {20, 20};
  ColorRGBA colors[2] = {kRed, kBlue};
  float positions[2] = {0, 1};
  RadialShaderP shader(canvas.GetSupplier(), PointT<float>(20.5f, 20.5f), radii, PointT<float>(20.5f, 20.5f), colors,
                       positions, 2);
  PathP path(canvas.GetSupplier());
  path->AddRect(RectT<long>(0, 0, 41, 41));
  canvas.GetSurface()->ShadePath(*shader, *path, kFillWinding);
  auto shot = canvas.Snapshot();
  EXPECT_GT((shot.At(20, 20) >> 16) & 0xff, 240u);
  EXPECT_GT(shot.At(20, 0) & 0xff, 240u);
  EXPECT_GT(shot.At(0, 0) & 0xff, 240u);  // beyond the rim the last colour carries on
}

TEST(ShaderPixels, ShadingOrStrokingADegeneratePathRaisesNothing) {
  PixelCanvas canvas(10, 10);
  LinearShaderP shader(canvas.GetSupplier(), PointT<float>(0, 0), PointT<float>(10, 0), kRed, kBlue);
  PathP empty(canvas.GetSupplier());
  PathP point(canvas.GetSupplier());
  point->MoveTo(PointT<float>(3, 3));
  point->LineTo(PointT<float>(3, 3));
  PenP pen(canvas.GetSupplier(), kRed, 1);
  PenP none(canvas.GetSupplier(), kRed, 0);
  EXPECT_NO_THROW(canvas.GetSurface()->ShadePath(*shader, *empty, kFillWinding));
  EXPECT_NO_THROW(canvas.GetSurface()->ShadePath(*shader, *point, kFillWinding));
  EXPECT_NO_THROW(canvas.GetSurface()->StrokePath(*pen, *empty));
  EXPECT_NO_THROW(canvas.GetSurface()->StrokePath(*none, *point));
  auto shot = canvas.Snapshot();
  for (uint32_t p : shot.pixels) ASSERT_EQ(p, 0u);
}

TEST(PenSettings, ADashedLineLeavesGaps) {
  PixelCanvas canvas(20, 3);
  PenP pen(canvas.GetSupplier(), kRed, 1);
  float dashes[2] = {2, 2};
  pen->SetDashArray(dashes, 2);
  PathP path(canvas.GetSupplier());
  path->MoveTo(PointT<long>(0, 1));
  path->LineTo(PointT<long>(16, 1));
  canvas.GetSurface()->StrokePath(*pen, *path);
  EXPECT_EQ(testing::RowCoverage(canvas.Snapshot(), 1).substr(0, 16), "##..##..##..##..");
}

}  // namespace
}  // namespace norvik::drawbot
