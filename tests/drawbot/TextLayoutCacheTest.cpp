// Kept layouts still follow the font, the wrapping width and the text policies.
#include <gtest/gtest.h>
#include "support/drawbot/PixelCompare.h"

namespace norvik::drawbot {
namespace {

using tarsel::geom::PointT;
using tarsel::geom::RectT;
auto const* kText = reinterpret_cast<unsigned short const*>(u"Audio 1 Gain");

TEST(TextLayoutCache, MeasuredWidthsFollowTheFontAndAreTheDrawnWidthsUnderSmoothText) {
  testing::PixelCanvas left(160, 30), right(160, 30);
  FontP small(left.GetSupplier(), u"DejaVu Sans", u"", 12), large(left.GetSupplier(), u"DejaVu Sans", u"", 24);
  BrushP ink(left.GetSupplier(), ColorRGBA(0, 0, 0, 1));
  const float wide = left.GetSurface()->MeasureStringWidth(*large, kText, -1);
  EXPECT_EQ(left.GetSurface()->MeasureStringWidth(*small, kText, -1), small->MeasureStringWidth(kText, -1));
  EXPECT_GT(wide, 1.8f * small->MeasureStringWidth(kText, -1));
  for (auto* canvas : {&left, &right}) {
    canvas->GetSurface()->SetAntiAliasPolicy(kAntiAlias);
    canvas->GetSurface()->SetTextDisplayPolicy(kTextDisplaySmooth);
  }
  const float width = left.GetSurface()->MeasureStringWidth(*small, kText, -1);
  left.GetSurface()->DrawString(*ink, *small, kText, PointT<float>(3, 20), kTextAlignLeft, kTextTruncationNone, 0);
  right.GetSurface()->DrawString(*ink, *small, kText, PointT<float>(3 + width, 20), kTextAlignRight,
                                 kTextTruncationNone, 0);
  EXPECT_EQ(left.Snapshot().pixels, right.Snapshot().pixels);
}

TEST(TextLayoutCache, TheSameTextWrapsAgainAtANewWidth) {
  testing::PixelCanvas wide(200, 60), narrow(200, 60);
  FontP font(wide.GetSupplier(), u"DejaVu Sans", u"", 12);
  BrushP ink(wide.GetSupplier(), ColorRGBA(0, 0, 0, 1));
  wide.GetSurface()->DrawMultiLineString(*ink, *font, kText, RectT<float>(0, 0, 200, 60), kTextAlignLeft);
  narrow.GetSurface()->DrawMultiLineString(*ink, *font, kText, RectT<float>(0, 0, 50, 60), kTextAlignLeft);
  EXPECT_EQ(testing::RowCoverage(wide.Snapshot(), 25), std::string(200, '.'));
  EXPECT_NE(testing::RowCoverage(narrow.Snapshot(), 25), std::string(200, '.'));
}

}  // namespace
}  // namespace norvik::drawbot
