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

TEST(ReplaceInString, FillsNumberedSlotsInAnyOrder) {
  EXPECT_EQ(ReplaceInString(u"@1 of @0", UTF16String(u"ten"), UTF16String(u"three")), u"three of ten");
  EXPECT_EQ(ReplaceInString(u"@0@0", UTF16String(u"ab")), u"abab");
  EXPECT_EQ(ReplaceInString(u"Frame @0 of @1", 3, 120L), u"Frame 3 of 120");
  EXPECT_EQ(ReplaceInString(u"gain @0 dB", -1.5), u"gain -1.5 dB");
}

TEST(ReplaceInString, MissingValuesLeaveTheirSlotsAsTheyStand) {
  EXPECT_EQ(ReplaceInString(u"@0 and @1 and @9", UTF16String(u"x")), u"x and @1 and @9");
  EXPECT_EQ(ReplaceInString(u"nothing @0"), u"nothing @0");
}

TEST(ReplaceInString, DoubledAtSignIsALiteralAndOtherAtSignsStay) {
  EXPECT_EQ(ReplaceInString(u"mail@@host @@0 is @0", UTF16String(u"set")), u"mail@host @0 is set");
  EXPECT_EQ(ReplaceInString(u"a@b @ end@", UTF16String(u"x")), u"a@b @ end@");
}

TEST(ReplaceInString, ValuesAreNotFilledAgain) {
  EXPECT_EQ(ReplaceInString(u"@0 @1", UTF16String(u"@1"), UTF16String(u"two")), u"@1 two");
}

TEST(ReplaceInString, TenValuesReachTheLastSlot) {
  UTF16String v[10] = {u"a", u"b", u"c", u"d", u"e", u"f", u"g", u"h", u"i", u"j"};
  EXPECT_EQ(ReplaceInString(u"@9@8@0", v[0], v[1], v[2], v[3], v[4], v[5], v[6], v[7], v[8], v[9]), u"jia");
}

TEST(LineEndings, EveryKindOfLineEndBecomesTheRequestedOne) {
  UTF16String text = u"one\r\ntwo\rthree\nfour\n\r";
  ConvertLineEndings(text, u"\r\n");
  EXPECT_EQ(text, u"one\r\ntwo\r\nthree\r\nfour\r\n\r\n");
  ConvertLineEndings(text);
  EXPECT_EQ(text, u"one\ntwo\nthree\nfour\n\n");
  EXPECT_EQ(GetLineEnding(), u"\n");
}

TEST(LineEndings, ConvertingTwiceChangesNothingMore) {
  UTF16String text = u"a\r\n\r\nb\r";
  ConvertLineEndings(text, u"\r\n");
  UTF16String once = text;
  ConvertLineEndings(text, u"\r\n");
  EXPECT_EQ(text, once);
}

TEST(Mnemonics, TheSingleAmpersandMarksTheFollowingCharacter) {
  EXPECT_EQ(LocateSingleAmpersandInString(u"&Open", false), 0);
  EXPECT_EQ(LocateSingleAmpersandInString(u"&Open", true), 0);
  EXPECT_EQ(LocateSingleAmpersandInString(u"Save &As", false), 5);
  EXPECT_EQ(LocateSingleAmpersandInString(u"Save &As", true), 5);
}

TEST(Mnemonics, DoubledAmpersandsAreLiteralsAndShiftTheStrippedIndex) {
  // "Cut && &Paste" strips to "Cut & Paste", with P at index 6.
  EXPECT_EQ(LocateSingleAmpersandInString(u"Cut && &Paste", false), 7);
  EXPECT_EQ(LocateSingleAmpersandInString(u"Cut && &Paste", true), 6);
  EXPECT_EQ(LocateSingleAmpersandInString(u"Rock && Roll", false), -1);
  EXPECT_EQ(LocateSingleAmpersandInString(u"&&&x", true), 1);
}

TEST(Mnemonics, NoMarkedCharacterAnswersMinusOne) {
  EXPECT_EQ(LocateSingleAmpersandInString(u"", false), -1);
  EXPECT_EQ(LocateSingleAmpersandInString(u"Plain", true), -1);
  EXPECT_EQ(LocateSingleAmpersandInString(u"Trailing&", false), -1);
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

TEST(Mnemonics, TheStrippedIndexPointsAtTheMarkedCharacterOfTheStrippedText) {
  for (const char16_t* text : {u"E&xit", u"a && b &c", u"&&x&y&&", u"&Z"}) {
    UTF16String stripped;
    StripDisplayString(text, stripped);
    long original = LocateSingleAmpersandInString(text, false);
    long index = LocateSingleAmpersandInString(text, true);
    ASSERT_GE(index, 0) << "text " << tarsel::utility::ToStdString(UTF16to8(text));
    EXPECT_EQ(stripped[static_cast<std::size_t>(index)], text[original + 1]);
  }
}

TEST(HexText, ValidatesOnlyNonEmptyHexDigits) {
  EXPECT_TRUE(ValidateForHex(u"00ff80"));
  EXPECT_TRUE(ValidateForHex(u"ABCDEF0123456789"));
  EXPECT_FALSE(ValidateForHex(u""));
  EXPECT_FALSE(ValidateForHex(u"12G4"));
  EXPECT_FALSE(ValidateForHex(u"#fff"));
  EXPECT_FALSE(ValidateForHex(u"ff "));
}

TEST(HexText, WritesUpperCaseDigitsWithoutPadding) {
  EXPECT_EQ(NumberToHexString(0), u"0");
  EXPECT_EQ(NumberToHexString(255), u"FF");
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
