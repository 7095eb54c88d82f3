// Truncation modes, path ellipsis, underlined text and the widest line.
#include <gtest/gtest.h>

#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "support/drawbot/RecordingSupplier.h"

namespace norvik::drawbot {
namespace {

using tarsel::geom::PointT;
using testing::RecordingSupplier;

auto const* Chars(UTF16String const& inText) { return reinterpret_cast<unsigned short const*>(inText.c_str()); }

std::string UTF8(UTF16String const& inText) {
  return tarsel::utility::ToStdString(tarsel::utility::UTF16to8(inText));
}

// Recording fonts advance by half their size: a 10 px font is 5 px a character.
class Truncation : public ::testing::Test {
 protected:
  RecordingSupplier supplier;
  FontP font{&supplier, u"DejaVu Sans", u"", 10};
  UTF16String text = u"abcdefghijklmnopqrst";  // 20 characters, 100 px
};

TEST_F(Truncation, EachModeCutsOnlyWhatDoesNotFitAndAnEllipsisCostsOneMoreCharacter) {
  EXPECT_EQ(UTF8(TruncateString(*font, Chars(text), kTextTruncationNone, 12)), "abcdefghijklmnopqrst");
  for (auto mode : {kTextTruncationEnd, kTextTruncationEndWithEllipsis, kTextTruncationPathEllipsis})
    EXPECT_EQ(UTF8(TruncateString(*font, Chars(text), mode, 100)), "abcdefghijklmnopqrst") << mode;
  // 42 px: eight characters (40 px) fit, the ninth would reach 45.
  EXPECT_EQ(UTF8(TruncateString(*font, Chars(text), kTextTruncationEnd, 42)), "abcdefgh");
  EXPECT_EQ(UTF8(TruncateString(*font, Chars(text), kTextTruncationEndWithEllipsis, 42)), "abcdefg...");
  EXPECT_EQ(UTF8(TruncateString(*font, Chars(text), kTextTruncationEnd, 3)), "");
  EXPECT_EQ(UTF8(TruncateString(*font, Chars(text), kTextTruncationEndWithEllipsis, 3)), "");
}

TEST_F(Truncation, PathEllipsisKeepsTheBeginningAndTheEnd) {
  // The longest path form below 62 px is 12 characters (60 px).
  UTF16String fitted = TruncateString(*font, Chars(text), kTextTruncationPathEllipsis, 62);
  EXPECT_EQ(UTF8(fitted), "abcdefg...st");
  EXPECT_LT(font->MeasureStringWidth(Chars(fitted), -1), 62);
}

TEST_F(Truncation, DrawStringDrawsTheTruncatedText) {
  SurfaceP surface(supplier.NewOffscreenSurface(200, 50, false));
  BrushP brush(&supplier, ColorRGBA(1, 0, 0, 1));
  surface->DrawString(*brush, *font, Chars(text), PointT<float>(3, 20), kTextAlignLeft,
                      kTextTruncationEndWithEllipsis, 42);
  ASSERT_EQ(supplier.GetCalls().size(), 1u);
  EXPECT_EQ(supplier.GetCalls()[0].text, "abcdefg...");
  EXPECT_EQ(supplier.GetCalls()[0].point, PointT<float>(3, 20));
}

TEST(PathEllipsis, KeepsTheFirstSevenCharactersFromALengthOfEightAndOnlyTheEndBelow) {
  const struct {
    const char16_t* text;
    long length;
    const char* result;
  } cases[] = {
      {u"/usr/local/share/fonts", 5, "...ts"},
      {u"/usr/local/share/fonts", 14, "/usr/lo...onts"},
      {u"abc", 0, ""},
      {u"abcdefghijk", 11, "abcdefghijk"},
  };
  for (const auto& c : cases) {
    UTF16String out = u"stale";
    GeneratePathEllipsisString(c.text, c.length, out);
    EXPECT_EQ(UTF8(out), c.result) << c.length;
  }
}

class Underline : public ::testing::Test {
 protected:
  void Draw(UTF16String const& inText, TextAlignment inAlign, float inMaxWidth, long inFirst, long inLast,
            TextTruncation inTruncation = kTextTruncationNone) {
    surface->DrawStringWithUnderline(*brush, *font, *pen, Chars(inText), PointT<float>(100, 20.4f), inAlign,
                                     inTruncation, inMaxWidth, inFirst, inLast);
  }
  RecordingSupplier supplier;
  SurfaceP surface{supplier.NewOffscreenSurface(300, 50, false)};
  FontP font{&supplier, u"DejaVu Sans", u"", 10};
  BrushP brush{&supplier, ColorRGBA(0, 0, 0, 1)};
  PenP pen{&supplier, ColorRGBA(0, 0, 1, 1), 1};
};

// The line runs under the underlined characters only (a 10 px recording font
// is 5 px a character), two pixels below the baseline, and centred or right
// aligned text moves the origin left. It is drawn first, without anti-aliasing.
TEST_F(Underline, TheLineRunsUnderTheUnderlinedCharactersFromTheAlignedOrigin) {
  const struct {
    const char16_t* text;
    TextAlignment align;
    long first, last;
    const char* line;
    float textX;
  } cases[] = {
      {u"Open", kTextAlignLeft, 0, 1, "M 100 22 L 110 22 Z", 100},
      {u"Save As", kTextAlignLeft, 5, 5, "M 125 22 L 130 22 Z", 100},
      {u"Open", kTextAlignCenter, 0, 0, "M 90 22 L 95 22 Z", 90},
      {u"Open", kTextAlignRight, 0, 0, "M 80 22 L 85 22 Z", 80},
  };
  for (const auto& c : cases) {
    supplier.ClearCalls();
    Draw(c.text, c.align, 0, c.first, c.last);
    ASSERT_EQ(supplier.GetOps(), (std::vector<std::string>{"Push", "StrokePath", "DrawString", "Pop"})) << c.line;
    EXPECT_EQ(supplier.GetCalls()[1].text, c.line);
    EXPECT_EQ(supplier.GetCalls()[1].antiAlias, kAntiAliasNone) << c.line;
    EXPECT_EQ(supplier.GetCalls()[2].text, UTF8(c.text)) << c.line;
    EXPECT_EQ(supplier.GetCalls()[2].point.x, c.textX) << c.line;
  }
}

TEST_F(Underline, TheAntiAliasPolicyIsPutBackForTheText) {
  surface->SetAntiAliasPolicy(kAntiAlias);
  Draw(u"Open", kTextAlignLeft, 0, 0, 1);
  EXPECT_EQ(supplier.GetCalls()[1].antiAlias, kAntiAliasNone);
  EXPECT_EQ(supplier.GetCalls()[2].antiAlias, kAntiAlias);
  EXPECT_EQ(surface->GetAntiAliasPolicy(), kAntiAlias);
}

TEST_F(Underline, BadRangesAndWidthsDrawNeitherTextNorLine) {
  Draw(u"Open", kTextAlignLeft, 0, 2, 1);
  Draw(u"Open", kTextAlignLeft, 0, -1, 1);
  Draw(u"Open", kTextAlignLeft, 0, 0, -1);
  Draw(u"", kTextAlignLeft, 0, 0, 0);
  Draw(u"Open", kTextAlignLeft, 2, 0, 3);  // a width below the last index
  EXPECT_TRUE(supplier.GetCalls().empty());
}

TEST_F(Underline, AWidthTruncatesTheTextFirst) {
  Draw(u"abcdefghij", kTextAlignLeft, 30, 0, 1, kTextTruncationEndWithEllipsis);
  EXPECT_EQ(supplier.GetCalls()[2].text, "abcd...");  // the sixth character would reach 30
}

TEST(WidestLine, AnEmptyTextIsZeroAndTheLongestLineWins) {
  RecordingSupplier supplier;
  SurfaceP surface(supplier.NewOffscreenSurface(10, 10, false));
  FontP font(&supplier, u"DejaVu Sans", u"", 10);
  EXPECT_EQ(surface->MeasureMaximumMultiLineStringWidth(*font, u""), 0);
  EXPECT_EQ(surface->MeasureMaximumMultiLineStringWidth(*font, u"ab\nabcdef\n\nabc"), 30);
  EXPECT_EQ(surface->MeasureMaximumMultiLineStringWidth(*font, u"abcd"), 20);
}

TEST(TruncationWithRealFonts, TheResultFitsTheWidth) {
  FontP font(NewOSSupplier(), u"DejaVu Sans", u"", 12);
  UTF16String text = u"A rather long clip name for the timeline";
  for (float width : {40.0f, 75.5f, 120.0f}) {
    UTF16String cut = TruncateString(*font, Chars(text), kTextTruncationEnd, width);
    EXPECT_LT(cut.size(), text.size());
    EXPECT_LE(font->MeasureStringWidth(Chars(cut), -1), width);
    UTF16String path = TruncateString(*font, Chars(text), kTextTruncationPathEllipsis, width);
    EXPECT_LT(font->MeasureStringWidth(Chars(path), -1), width);
  }
}

}  // namespace
}  // namespace norvik::drawbot
