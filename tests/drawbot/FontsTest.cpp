// Fonts: the refusal of substitutes, the cache, and where text lands.
#include <gtest/gtest.h>

#include "drawbot/DrawHelpers.h"
#include "drawbot/FontFamilies.h"
#include "support/drawbot/PixelCompare.h"
#include "tarsel/ThrowError.h"

namespace norvik::drawbot {
namespace {

using tarsel::geom::PointT;
using tarsel::geom::RectT;
using testing::PixelCanvas;
using testing::PixelImage;

auto const* Chars(UTF16String const& inText) { return reinterpret_cast<unsigned short const*>(inText.c_str()); }

// Rows that hold any ink, as [first, last].
std::pair<int, int> InkRows(PixelImage const& inImage) {
  int first = -1, last = -1;
  for (int y = 0; y < inImage.height; ++y)
    for (int x = 0; x < inImage.width; ++x)
      if (inImage.Alpha(x, y)) {
        if (first < 0) first = y;
        last = y;
      }
  return {first, last};
}

std::pair<int, int> InkColumns(PixelImage const& inImage) {
  int first = -1, last = -1;
  for (int x = 0; x < inImage.width; ++x)
    for (int y = 0; y < inImage.height; ++y)
      if (inImage.Alpha(x, y)) {
        if (first < 0) first = x;
        last = x;
      }
  return {first, last};
}

TEST(Fonts, AFamilyThatWouldBeSubstitutedIsRefusedAtCreation) {
  try {
    FontP font(NewOSSupplier(), u"Norvik Missing Sans", u"Bold", 12);
    FAIL() << "a substitute font was accepted";
  } catch (tarsel::config::Exception const& e) {
    EXPECT_STREQ(e.what(), "Unable to load font \"Bold\" \"Norvik Missing Sans\"");
    EXPECT_EQ(e.GetKeyPath(), "norvik/drawbot/Error/OSSupplier/UnableToCreateFont");
  }
}

TEST(Fonts, TheCacheHandsOutOneFontPerFamilyStyleAndSizeInPixelsAndMetricsFollowIt) {
  SupplierInterface const* supplier = NewOSSupplier();
  FontP a(supplier, u"DejaVu Sans", u"", 12), b(supplier, u"DejaVu Sans", u"Regular", 12);
  FontP bold(supplier, u"DejaVu Sans", u"Bold", 12), larger(supplier, u"DejaVu Sans", u"", 13);
  EXPECT_EQ(a.Get(), b.Get());  // unknown styles are regular
  EXPECT_NE(a.Get(), bold.Get());
  EXPECT_NE(a.Get(), larger.Get());
  EXPECT_GT(bold->MeasureStringWidth(Chars(u"Timeline"), -1), a->MeasureStringWidth(Chars(u"Timeline"), -1));
  FontP font(supplier, u"DejaVu Sans", u"", 20);
  EXPECT_EQ(font->GetSize(), 20);
  EXPECT_NEAR(font->GetAscent() + font->GetDescent(), 20 * 1.16, 2.0);
  FontP twice(NewOSSupplier(), u"DejaVu Sans", u"", 40);
  float w = font->MeasureStringWidth(Chars(u"Mixer"), -1);
  EXPECT_NEAR(twice->MeasureStringWidth(Chars(u"Mixer"), -1), 2 * w, 2.0);
  EXPECT_LT(font->MeasureStringWidth(Chars(u"Mixer"), 2), w);
  EXPECT_FLOAT_EQ(w, std::round(w)) << "grid-fitted text measures in whole pixels";
}

TEST(Fonts, ChoosingAFamilyFallsBackToThePlatformsOwn) {
  EXPECT_EQ(ChooseFontFamily({u"Norvik Missing Sans", u"DejaVu Sans Mono"}), u"DejaVu Sans Mono");
  EXPECT_EQ(ChooseFontFamily({u"Norvik Missing Sans"}), u"DejaVu Sans");
  EXPECT_FALSE(IsFontFamilyAvailable(u"Norvik Missing Sans"));
}

TEST(TextPlacement, ThePointIsOnTheBaseline) {
  PixelCanvas canvas(60, 40);
  FontP font(canvas.GetSupplier(), u"DejaVu Sans", u"", 16);
  BrushP brush(canvas.GetSupplier(), ColorRGBA(0, 0, 0, 1));
  canvas.GetSurface()->DrawString(*brush, *font, Chars(u"HH"), PointT<float>(5, 25), kTextAlignLeft,
                                  kTextTruncationNone, 0);
  auto [top, bottom] = InkRows(canvas.Snapshot());
  // Capitals sit on the baseline and rise about 0.73 em above it.
  EXPECT_EQ(bottom, 24);
  EXPECT_NEAR(top, 25 - 12, 1);
}

TEST(TextPlacement, AlignmentPutsThePointAtTheMiddleOrTheRightEnd) {
  FontP font(NewOSSupplier(), u"DejaVu Sans", u"", 14);
  float width = font->MeasureStringWidth(Chars(u"IIII"), -1);
  for (auto align : {kTextAlignLeft, kTextAlignCenter, kTextAlignRight}) {
    PixelCanvas canvas(100, 30);
    BrushP brush(canvas.GetSupplier(), ColorRGBA(0, 0, 0, 1));
    canvas.GetSurface()->DrawString(*brush, *font, Chars(u"IIII"), PointT<float>(50, 20), align,
                                    kTextTruncationNone, 0);
    auto [left, right] = InkColumns(canvas.Snapshot());
    float expectedLeft = align == kTextAlignLeft ? 50 : align == kTextAlignCenter ? 50 - width / 2 : 50 - width;
    EXPECT_NEAR(left, expectedLeft, 3) << align;
    EXPECT_NEAR(right, expectedLeft + width, 3) << align;
  }
}

TEST(TextPlacement, TextMatchesItsReferenceImage) {
  PixelCanvas canvas(120, 44);
  canvas.Clear(0xffffff);
  SurfaceInterface* surface = canvas.GetSurface();
  FontP font(canvas.GetSupplier(), u"DejaVu Sans", u"", 12);
  BrushP brush(canvas.GetSupplier(), ColorRGBA(0.1f, 0.1f, 0.1f, 1));
  surface->SetAntiAliasPolicy(kAntiAlias);
  surface->DrawString(*brush, *font, Chars(u"Sequence 01"), PointT<float>(4, 14), kTextAlignLeft,
                      kTextTruncationNone, 0);
  surface->DrawString(*brush, *font, Chars(u"A clip with a long name"), PointT<float>(4, 34), kTextAlignLeft,
                      kTextTruncationEndWithEllipsis, 90);
  // The text tests use a tolerance: font hinting differs slightly between FreeType versions.
  EXPECT_TRUE(testing::MatchesReference(canvas.Snapshot(), "drawbot/text", 24));
}

TEST(Baseline, TheSettingMakesTheBaselineFollowAscentAndDescent) {
  SetBoolSettingReader([](char const* inKey, bool inDefault) {
    return std::string(inKey) == "norvik.utils.FontDependentBaselines" ? true : inDefault;
  });
  FontP font(NewOSSupplier(), u"DejaVu Sans", u"", 12);
  float a = font->GetAscent(), d = font->GetDescent();
  EXPECT_FLOAT_EQ(GetFontBaseline(font, RectT<float>(0, 10, 100, 20)), 10 + ((20 - (a + d)) * 0.5f + a));
  SetBoolSettingReader(nullptr);
  EXPECT_EQ(GetFontBaseline(font, RectT<float>(0, 10, 100, 20)), 25);
}

TEST(MultiLineText, WrappedTextStaysInsideItsRectangle) {
  PixelCanvas canvas(100, 80);
  FontP font(canvas.GetSupplier(), u"DejaVu Sans", u"", 12);
  BrushP brush(canvas.GetSupplier(), ColorRGBA(0, 0, 0, 1));
  canvas.GetSurface()->DrawMultiLineString(*brush, *font, Chars(u"Render the whole timeline again"),
                                           RectT<float>(10, 5, 60, 70), kTextAlignLeft);
  auto image = canvas.Snapshot();
  auto [left, right] = InkColumns(image);
  auto [top, bottom] = InkRows(image);
  EXPECT_GE(left, 10);
  EXPECT_LT(right, 70);
  EXPECT_GE(top, 5);
  EXPECT_GT(bottom - top, 30);  // more than two lines
}

TEST(MultiLineText, AnUnknownTextDisplayPolicyIsRefused) {
  SurfaceP surface(NewOSSupplier(), 10, 10);
  EXPECT_THROW(surface->SetTextDisplayPolicy(static_cast<TextDisplayPolicy>(4)), tarsel::config::Exception);
  surface->SetTextDisplayPolicy(kTextDisplaySmooth);
  EXPECT_EQ(surface->GetTextDisplayPolicy(), kTextDisplaySmooth);
}

int PartialPixels(PixelImage const& inImage, int inTop, int inBottom) {
  int partial = 0;
  for (int y = inTop; y < inBottom; ++y)
    for (int x = 0; x < inImage.width; ++x) partial += inImage.Alpha(x, y) > 0 && inImage.Alpha(x, y) < 255;
  return partial;
}

TEST(TextPlacement, ChangingTheAntiAliasPolicyBetweenStringsChangesHowTheNextOneIsDrawn) {
  PixelCanvas canvas(80, 60);
  SurfaceInterface* surface = canvas.GetSurface();
  FontP font(canvas.GetSupplier(), u"DejaVu Sans", u"", 14);
  BrushP brush(canvas.GetSupplier(), ColorRGBA(0, 0, 0, 1));
  surface->DrawString(*brush, *font, Chars(u"Render"), PointT<float>(2, 18), kTextAlignLeft, kTextTruncationNone, 0);
  surface->PushStateStack();
  surface->SetAntiAliasPolicy(kAntiAlias);
  surface->DrawString(*brush, *font, Chars(u"Render"), PointT<float>(2, 48), kTextAlignLeft, kTextTruncationNone, 0);
  surface->PopStateStack();
  surface->DrawString(*brush, *font, Chars(u"Render"), PointT<float>(40, 18), kTextAlignLeft, kTextTruncationNone,
                      0);
  auto image = canvas.Snapshot();
  EXPECT_EQ(PartialPixels(image, 0, 30), 0) << "without anti-aliasing text has two levels";
  EXPECT_GT(PartialPixels(image, 30, 60), 10);
}

TEST(Fonts, ALengthPastTheEndMeasuresOnlyUpToTheTerminator) {
  FontP font(NewOSSupplier(), u"DejaVu Sans", u"", 12);
  UTF16String text = u"Pan";
  EXPECT_FLOAT_EQ(font->MeasureStringWidth(Chars(text), 50), font->MeasureStringWidth(Chars(text), -1));
  EXPECT_EQ(font->MeasureStringWidth(Chars(text), 0), 0);
  EXPECT_EQ(font->MeasureStringWidth(nullptr, -1), 0);
}

}  // namespace
}  // namespace norvik::drawbot
