// Case mapping, folding and collation of UTF-16 text.
#include <gtest/gtest.h>

#include <algorithm>
#include <vector>

#include "tarsel/Locale.h"
#include "tarsel/StringUtils.h"

using namespace tarsel::utility;

namespace {
UTF16String Lower(UTF16String s) {
  ToLowerCase(s);
  return s;
}
UTF16String Upper(UTF16String s) {
  ToUpperCase(s);
  return s;
}
UTF16String Title(UTF16String s) {
  ToTitleCase(s);
  return s;
}
}  // namespace

TEST(StringCase, LowerAndUpperCaseMapLatinGreekAndCyrillicLettersAndKeepTheLength) {
  EXPECT_EQ(Lower(u"ÉCOLE ÀÖØ"), u"école àöø");
  EXPECT_EQ(Upper(u"αβγ δ"), u"ΑΒΓ Δ");
  EXPECT_EQ(Lower(u"ЖУРНАЛ"), u"журнал");
  EXPECT_EQ(Upper(u"mixed 123 Text!"), u"MIXED 123 TEXT!");
  // Sharp s has no one-unit upper case, and a supplementary character is a
  // surrogate pair that must survive untouched.
  EXPECT_EQ(Upper(u"straße 😀 漢字"), u"STRAßE 😀 漢字");
  const UTF16String source = u"Picas";
  EXPECT_EQ(LowerCase(source), u"picas") << "a copy, the source left as it was";
  EXPECT_EQ(source, u"Picas");
  EXPECT_EQ(LowerCase(u'Q'), u'q');
  EXPECT_EQ(UpperCase(u'я'), u'Я');
}

TEST(StringCase, UTF8StringsChangeCaseThroughTheSameTables) {
  UTF8String text = "Ärger über Σ";
  ToLowerCase(text);
  EXPECT_EQ(text, UTF8String("ärger über σ"));
  ToUpperCase(text);
  EXPECT_EQ(text, UTF8String("ÄRGER ÜBER Σ"));
}

TEST(StringCase, TitleCaseCapitalisesTheFirstLetterOfEachWord) {
  EXPECT_EQ(Title(u"hello WORLD"), u"Hello World");
  EXPECT_EQ(Title(u"q"), u"Q");
  EXPECT_EQ(Title(u"  two\tspaced-words"), u"  Two\tSpaced-Words");
  EXPECT_EQ(Title(u"o'clock 'quoted'"), u"O'clock 'Quoted'");
  EXPECT_EQ(Title(u"élan vital"), u"Élan Vital");
  EXPECT_EQ(Title(u"3d view"), u"3d View");
  EXPECT_EQ(Title(u""), u"");
}

TEST(StringCase, FoldingMakesCaseVariantsEqual) {
  EXPECT_EQ(FoldCase(u'A'), FoldCase(u'a'));
  EXPECT_EQ(FoldCase(u'Ω'), FoldCase(u'ω'));
  // Final and medial sigma fold alike.
  EXPECT_EQ(FoldCase(u'ς'), FoldCase(u'σ'));
  EXPECT_EQ(FoldCase(u"ΟΔΟΣ"), FoldCase(u"οδος"));
  EXPECT_NE(FoldCase(u'a'), FoldCase(u'b'));
  EXPECT_EQ(FoldCase(u'7'), u'7');
}

TEST(LocaleCollation, OrdersIgnoringCaseFirstAndThenByCodeUnits) {
  tarsel::Locale locale;
  EXPECT_LT(locale.Compare(u"apple", u"Banana"), 0);
  EXPECT_GT(locale.Compare(u"banana", u"Apple"), 0);
  EXPECT_LT(locale.Compare(u"Apple", u"apple"), 0);
  EXPECT_EQ(locale.Compare(u"same", u"same"), 0);
  EXPECT_LT(locale.Compare(u"abc", u"abcd"), 0);
  EXPECT_LT(locale.Compare(u"", u"a"), 0);
}

TEST(LocaleCollation, SortingWithLessGivesAStableTotalOrder) {
  std::vector<UTF16String> names = {u"delta", u"Alpha", u"charlie", u"alpha", u"Bravo", u"ΑΛΦΑ"};
  tarsel::Locale locale;
  std::sort(names.begin(), names.end(),
            [&](const UTF16String& a, const UTF16String& b) { return locale.Less(a, b); });
  std::vector<UTF16String> expected = {u"Alpha", u"alpha", u"Bravo", u"charlie", u"delta", u"ΑΛΦΑ"};
  EXPECT_EQ(names, expected);
}
