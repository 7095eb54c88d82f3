// Replacing, slot filling, line endings, mnemonic ampersands and hex text.
#include <gtest/gtest.h>

#include "tarsel/StringUtils.h"

using namespace tarsel::utility;

TEST(ReplaceAllStringInString, ReplacesEveryOccurrenceWithoutRescanning) {
  UTF16String text = u"+1 and +2";
  EXPECT_EQ(ReplaceAllStringInString(text, u"+", u"plus "), 2u);
  EXPECT_EQ(text, u"plus 1 and plus 2");

  // The replacement contains the pattern: no endless growth.
  UTF16String grow = u"aa";
  EXPECT_EQ(ReplaceAllStringInString(grow, u"a", u"aa"), 2u);
  EXPECT_EQ(grow, u"aaaa");

  // Overlapping candidates are taken left to right.
  UTF16String overlap = u"aaa";
  EXPECT_EQ(ReplaceAllStringInString(overlap, u"aa", u"b"), 1u);
  EXPECT_EQ(overlap, u"ba");
}

TEST(ReplaceAllStringInString, AnEmptyPatternOrNoMatchLeavesTheTextAlone) {
  UTF16String text = u"unchanged";
  EXPECT_EQ(ReplaceAllStringInString(text, u"", u"x"), 0u);
  EXPECT_EQ(ReplaceAllStringInString(text, u"zz", u"x"), 0u);
  EXPECT_EQ(text, u"unchanged");
  UTF8String narrow = "a-b-c";
  EXPECT_EQ(ReplaceAllStringInString(narrow, "-", ""), 2u);
  EXPECT_EQ(narrow, UTF8String("abc"));
}

TEST(ReplaceInString, FillsNumberedSlotsOnceInAnyOrderAndLeavesMissingSlotsAndOtherAtSignsStanding) {
  EXPECT_EQ(ReplaceInString(u"@1 of @0", UTF16String(u"ten"), UTF16String(u"three")), u"three of ten");
  EXPECT_EQ(ReplaceInString(u"@0@0", UTF16String(u"ab")), u"abab");
  EXPECT_EQ(ReplaceInString(u"Frame @0 of @1", 3, 120L), u"Frame 3 of 120");
  EXPECT_EQ(ReplaceInString(u"gain @0 dB", -1.5), u"gain -1.5 dB");
  EXPECT_EQ(ReplaceInString(u"@0 and @1 and @9", UTF16String(u"x")), u"x and @1 and @9");
  EXPECT_EQ(ReplaceInString(u"mail@@host @@0 is @0", UTF16String(u"set")), u"mail@host @0 is set");
  EXPECT_EQ(ReplaceInString(u"a@b @ end@", UTF16String(u"x")), u"a@b @ end@");
  EXPECT_EQ(ReplaceInString(u"@0 @1", UTF16String(u"@1"), UTF16String(u"two")), u"@1 two") << "values are not filled again";
  UTF16String v[10] = {u"a", u"b", u"c", u"d", u"e", u"f", u"g", u"h", u"i", u"j"};
  EXPECT_EQ(ReplaceInString(u"@9@8@0", v[0], v[1], v[2], v[3], v[4], v[5], v[6], v[7], v[8], v[9]), u"jia");
}

TEST(LineEndings, EveryKindOfLineEndBecomesTheRequestedOneAndConvertingTwiceChangesNothingMore) {
  UTF16String text = u"one\r\ntwo\rthree\nfour\n\r";
  ConvertLineEndings(text, u"\r\n");
  EXPECT_EQ(text, u"one\r\ntwo\r\nthree\r\nfour\r\n\r\n");
  ConvertLineEndings(text, u"\r\n");
  EXPECT_EQ(text, u"one\r\ntwo\r\nthree\r\nfour\r\n\r\n");
  ConvertLineEndings(text);
  EXPECT_EQ(text, u"one\ntwo\nthree\nfour\n\n");
  EXPECT_EQ(GetLineEnding(), u"\n");
}

TEST(Mnemonics, TheSingleAmpersandMarksTheFollowingCharacterAndDoubledOnesShiftTheStrippedIndex) {
  const struct {
    const char16_t* text;
    long original, stripped;
  } cases[] = {
      {u"&Open", 0, 0},   {u"Save &As", 5, 5},  {u"Cut && &Paste", 7, 6}, {u"&&&x", 2, 1},
      {u"Rock && Roll", -1, -1}, {u"", -1, -1}, {u"Plain", -1, -1},       {u"Trailing&", -1, -1},
  };
  for (const auto& c : cases) {
    EXPECT_EQ(LocateSingleAmpersandInString(c.text, false), c.original) << ToStdString(UTF16to8(c.text));
    EXPECT_EQ(LocateSingleAmpersandInString(c.text, true), c.stripped) << ToStdString(UTF16to8(c.text));
  }
}

TEST(Mnemonics, StrippingRemovesMarksAndUndoublesAmpersands) {
  UTF16String text = u"Cut && &Paste&";
  StripDisplayString(text);
  EXPECT_EQ(text, u"Cut & Paste");
  UTF16String out;
  StripDisplayString(u"&File", out);
  EXPECT_EQ(out, u"File");
  StripDisplayString(u"&&&&", out);
  EXPECT_EQ(out, u"&&");
}

TEST(HexText, ValidatesOnlyNonEmptyHexDigitsAndWritesUpperCaseDigitsWithoutPadding) {
  EXPECT_TRUE(ValidateForHex(u"ABCDEF0123456789ff"));
  for (const char16_t* bad : {u"", u"12G4", u"#fff", u"ff "}) EXPECT_FALSE(ValidateForHex(bad));
  EXPECT_EQ(NumberToHexString(0), u"0");
  EXPECT_EQ(NumberToHexString(0xFF8000), u"FF8000");
  EXPECT_EQ(NumberToHexString(0xFFFFFFFFFFFFFFFFull), u"FFFFFFFFFFFFFFFF");
}

TEST(NumericChars, AnyDecimalDigitCounts) {
  EXPECT_TRUE(HasNumericChars(u"pt 12"));
  EXPECT_TRUE(HasNumericChars(u"0"));
  EXPECT_FALSE(HasNumericChars(u"picas"));
  EXPECT_FALSE(HasNumericChars(u""));
  EXPECT_FALSE(HasNumericChars(u"٣"));  // only the ASCII digits are numeric text here
}
