#pragma once
// String and number helpers over the toolkit's UTF-16 text.
//
// Case mapping works code unit by code unit over the Basic Multilingual Plane
// (Latin, Greek, Cyrillic and every other script with simple one-to-one case
// pairs); supplementary-plane characters pass through unchanged. Mappings that
// change a string's length (German sharp s to "SS") are not made, so that
// indexes into a text stay valid after its case has been changed.
//
// Numbers have a plain form ("-1234.5": '.' as decimal mark, ',' as grouping
// mark) and a user form with the decimal and grouping marks of
// tarsel::Locale::Default(). InternationalizeNum and DeInternationalizeNum
// move between the two.
#include <string_view>
#include <type_traits>
#include <vector>

#include "tarsel/Flags.h"
#include "tarsel/UTFString.h"

namespace tarsel::utility {

// ---- Case ----------------------------------------------------------------

// In place.
void ToLowerCase(UTF16String& ioText);
void ToUpperCase(UTF16String& ioText);
void ToLowerCase(UTF8String& ioText);
void ToUpperCase(UTF8String& ioText);
// The first letter of each word upper case, the other letters lower case. A
// word is a run of letters, digits and apostrophes.
void ToTitleCase(UTF16String& ioText);

// UTF-8 text is mapped through UTF-16; broken UTF-8 sequences come back as
// U+FFFD.

// Copies.
UTF16String LowerCase(std::u16string_view inText);
char16_t LowerCase(char16_t inChar);
char16_t UpperCase(char16_t inChar);

// The case-folded form for comparisons that ignore case: characters that
// differ only in case (including the Greek final and medial sigma) fold alike.
char16_t FoldCase(char16_t inChar);
UTF16String FoldCase(std::u16string_view inText);

// ---- Replacing -------------------------------------------------------------

// Replaces every occurrence of inFrom, left to right and without rescanning
// replaced text; answers how many were replaced. An empty inFrom replaces
// nothing.
std::size_t ReplaceAllStringInString(UTF16String& ioText, std::u16string_view inFrom, std::u16string_view inTo);
std::size_t ReplaceAllStringInString(UTF8String& ioText, std::string_view inFrom, std::string_view inTo);

// Fills the slots "@0".."@9" of inText with inValues[0..9]. A slot without a
// value stays as it stands, "@@" stands for a single "@" (so "@@0" reads "@0"),
// and an "@" followed by anything else is kept. Values are inserted verbatim:
// slot marks inside a value are not filled again.
UTF16String ReplaceInStringList(std::u16string_view inText, const std::vector<UTF16String>& inValues);

namespace detail {
inline UTF16String SlotValue(const UTF16String& inValue) { return inValue; }
inline UTF16String SlotValue(std::u16string_view inValue) { return UTF16String(inValue.data(), inValue.size()); }
inline UTF16String SlotValue(const char16_t* inValue) { return inValue ? UTF16String(inValue) : UTF16String(); }
UTF16String SlotValue(long long inValue);
UTF16String SlotValue(double inValue);
template <typename T, typename = std::enable_if_t<std::is_integral_v<T>>>
UTF16String SlotValue(T inValue) {
  return SlotValue(static_cast<long long>(inValue));
}
}  // namespace detail

// ReplaceInString(text, value0, value1, ...): values are UTF-16 strings or
// numbers (written as NumberToString writes them).
template <typename... Values>
UTF16String ReplaceInString(std::u16string_view inText, const Values&... inValues) {
  static_assert(sizeof...(Values) <= 10, "ReplaceInString fills the slots @0 to @9");
  return ReplaceInStringList(inText, std::vector<UTF16String>{detail::SlotValue(inValues)...});
}

// ---- Line endings ------------------------------------------------------------

// The platform's line ending: a line feed.
const UTF16String& GetLineEnding();
// Turns every line end of inText (CR LF, a lone CR or a lone LF) into
// inLineEnding.
void ConvertLineEndings(UTF16String& ioText, std::u16string_view inLineEnding);
inline void ConvertLineEndings(UTF16String& ioText) { ConvertLineEndings(ioText, GetLineEnding()); }

// ---- Mnemonics ----------------------------------------------------------------

// Display strings mark their mnemonic with a single '&' in front of the
// character ("&Open"); "&&" is a literal ampersand. A lone '&' at the very end
// marks nothing.
//
// With inStripped false: the index in inText of the first single ampersand.
// With inStripped true: the index of the character it marks in the text as
// StripDisplayString leaves it. -1 when there is no mnemonic.
long LocateSingleAmpersandInString(std::u16string_view inText, bool inStripped);
// Removes every single ampersand and turns "&&" into "&".
void StripDisplayString(UTF16String& ioText);
void StripDisplayString(std::u16string_view inText, UTF16String& outStripped);

// ---- Character classes and hex ------------------------------------------------------

// True when inText is not empty and holds hex digits only (0-9, a-f, A-F).
bool ValidateForHex(std::u16string_view inText);
// True when inText holds at least one decimal digit 0-9.
bool HasNumericChars(std::u16string_view inText);
// Upper-case hex digits without prefix or padding: 255 gives "FF", 0 gives "0".
UTF16String NumberToHexString(unsigned long long inValue);

// ---- Numbers -------------------------------------------------------------------

// Format flags of NumberToString and StringToNumber.
enum NumberFormatFlag : unsigned short {
  kNumberFormatNormal = 0,
  // Plain form: '.' as decimal mark and ',' as grouping mark, whatever the
  // locale says.
  kNumberFormatNoLocalization = 1,
  // Pad to the minimum width with spaces in front of the sign; without this
  // flag the padding is zeros between the sign and the digits.
  kNumberFormatLeadingSpaces = 2,
  // Drop zeros at the end of the fraction, and the decimal mark when no
  // fraction remains.
  kNumberFormatNoTrailingZeros = 4,
  // Group the integer digits by three with the grouping mark.
  kNumberFormatUseSeparator = 8,
  // A '+' in front of numbers that are not negative.
  kNumberFormatAlwaysSign = 16,
  // A space in front of numbers that are not negative, so that a column of
  // numbers lines up with its negative members. kNumberFormatAlwaysSign wins.
  kNumberFormatPadSign = 32,
};

using NumberFormatFlags = Flags<unsigned short>;

// Plain decimal digits with a leading '-' when negative.
UTF16String NumberToString(long inValue);
UTF16String NumberToString(long long inValue);
UTF16String NumberToString(unsigned long long inValue);
inline UTF16String NumberToString(int inValue) { return NumberToString(static_cast<long>(inValue)); }
inline UTF16String NumberToString(unsigned inValue) { return NumberToString(static_cast<unsigned long long>(inValue)); }
inline UTF16String NumberToString(unsigned long inValue) {
  return NumberToString(static_cast<unsigned long long>(inValue));
}
// The shortest plain text that reads back as exactly inValue ("0.1", "1e+300"),
// "NaN" for NaN and U+221E with its sign for infinities.
UTF16String NumberToString(double inValue);

// inValue rounded to inDecimalPlaces (half away from zero, applied to the
// shortest decimal form of the double, so that 1.005 gives "1.01" as a reader
// expects). Negative decimal places round to tens, hundreds... and show no
// fraction. inMinimumWidth is the least number of characters of the result,
// padded as the flags say, up to kNumberMaxMinimumWidth. inMaxFixedLength bounds the fixed-point text: a
// number that would need more characters (1e300 with no decimal places) is
// written in scientific notation instead. Zero after rounding never has a
// minus sign. Infinities are written as U+221E with their sign, NaN as "NaN".
constexpr int kNumberMaxMinimumWidth = 1024;
UTF16String NumberToString(double inValue, int inMinimumWidth, int inDecimalPlaces, NumberFormatFlags inFlags,
                           int inMaxFixedLength);

// Reads a number in user form, or in plain form with kNumberFormatNoLocalization.
// Blanks around the number, a leading '+' or '-' (also U+2212), grouping marks
// in the integer part, and an exponent ("1.5e3") are accepted; U+221E with an
// optional sign reads as infinity, as NumberToString writes it. A text of
// blanks only holds no number and answers NaN. Anything else raises
// tarsel::config::Exception: "NotANumber" for malformed text, "NumberOutOfRange"
// for a number beyond the range of a double. Numbers too small for a double
// read as zero.
double StringToNumber(std::u16string_view inText, NumberFormatFlags inFlags);

// Flags of Calculate.
enum CalculateFlag : unsigned short {
  // As for StringToNumber: the text is in plain form.
  kCalculateNoLocalization = 1,
  // Letters, '%' and the degree sign are skipped, so that text carrying unit
  // names ("12pt", "p6") evaluates to its arithmetic.
  kCalculateIgnoreUnitNames = 2,
};

// Evaluates an arithmetic text: numbers, + - * / ^ (power, right associative
// and binding tighter than a sign, so -2^2 is -4), unary signs and
// parentheses, with blanks anywhere between tokens. A leading and a trailing
// '=' are allowed and ignored, so "=2*3" reads as a calculation. A text of
// blanks only answers NaN. Syntax errors, division by zero, results beyond
// the range of a double, and nesting deeper than kCalculateMaxDepth raise
// tarsel::config::Exception.
double Calculate(std::u16string_view inText, NumberFormatFlags inFlags);
constexpr int kCalculateMaxDepth = 256;

// Plain form to user form: '.' becomes the locale's decimal mark and ',' its
// grouping mark, in one pass.
void InternationalizeNum(UTF16String& ioText);
// User form to plain form, the exact inverse of InternationalizeNum.
void DeInternationalizeNum(UTF16String& ioText);

}  // namespace tarsel::utility
