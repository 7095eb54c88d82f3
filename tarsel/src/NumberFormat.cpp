// Numbers to text and back. Formatting works on the shortest decimal digits of
// a double (std::to_chars), so rounding follows the digits a person sees;
// reading checks the form itself and leaves the conversion to std::from_chars.
#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdlib>
#include <locale.h>
#include <string>

#include "tarsel/Locale.h"
#include "tarsel/StringUtils.h"
#include "tarsel/ThrowError.h"
#include "tarsel/src/NumberText.h"

namespace tarsel::utility {
namespace {

constexpr char16_t kInfinity = u'\u221E';
constexpr char16_t kMinusSign = u'\u2212';
constexpr int kMaxDecimalPlaces = 340;  // beyond this a double has only zeros

struct Marks {
  char16_t decimal;
  char16_t grouping;
};

Marks MarksFor(NumberFormatFlags inFlags) {
  if (inFlags.Test(kNumberFormatNoLocalization)) return {u'.', u','};
  const Locale& locale = Locale::Default();
  return {locale.GetDecimalMark(), locale.GetGroupingMark()};
}

// The decimal digits of |inValue| (finite): the value is 0.digits * 10^point.
struct DecimalDigits {
  std::string digits;
  int point = 0;
};

DecimalDigits ShortestDigits(double inValue) {
  char buffer[64];
  auto result = std::to_chars(buffer, buffer + sizeof(buffer), std::fabs(inValue), std::chars_format::scientific);
  std::string_view text(buffer, static_cast<std::size_t>(result.ptr - buffer));
  std::size_t e = text.find('e');
  DecimalDigits d;
  for (char c : text.substr(0, e)) {
    if (c != '.') d.digits.push_back(c);
  }
  d.point = std::atoi(std::string(text.substr(e + 1)).c_str()) + 1;
  return d;
}

// Keeps inDecimalPlaces digits after the point, rounding half away from zero.
void RoundDigits(DecimalDigits& ioDigits, int inDecimalPlaces) {
  const long keep = static_cast<long>(ioDigits.point) + inDecimalPlaces;
  if (keep >= static_cast<long>(ioDigits.digits.size())) return;
  if (keep < 0) {
    ioDigits.digits = "0";
    ioDigits.point = 1;
    return;
  }
  const bool up = ioDigits.digits[static_cast<std::size_t>(keep)] >= '5';
  ioDigits.digits.resize(static_cast<std::size_t>(keep));
  if (!up) {
    if (ioDigits.digits.empty()) {
      ioDigits.digits = "0";
      ioDigits.point = 1;
    }
    return;
  }
  long i = keep - 1;
  for (; i >= 0; --i) {
    char& c = ioDigits.digits[static_cast<std::size_t>(i)];
    if (c != '9') {
      ++c;
      break;
    }
    c = '0';
  }
  if (i < 0) {
    ioDigits.digits.insert(ioDigits.digits.begin(), '1');
    ++ioDigits.point;
  }
}

bool AllZeros(const std::string& inDigits) { return inDigits.find_first_not_of('0') == std::string::npos; }

char DigitAt(const DecimalDigits& inDigits, long inIndex) {
  return inIndex >= 0 && inIndex < static_cast<long>(inDigits.digits.size())
             ? inDigits.digits[static_cast<std::size_t>(inIndex)]
             : '0';
}

void StripTrailingZeros(std::string& ioFraction) {
  while (!ioFraction.empty() && ioFraction.back() == '0') ioFraction.pop_back();
}

UTF16String GroupDigits(const std::string& inInteger, char16_t inMark) {
  UTF16String text;
  for (std::size_t i = 0; i < inInteger.size(); ++i) {
    if (i > 0 && (inInteger.size() - i) % 3 == 0) text.push_back(inMark);
    text.push_back(static_cast<char16_t>(inInteger[i]));
  }
  return text;
}

// |inValue| in scientific notation with inDecimalPlaces digits after the
// point, or with more where rounding would carry the number past the largest
// double ("2e+308" for 1.79e308), since the text must read back.
std::string ScientificText(double inValue, int inDecimalPlaces) {
  char buffer[kMaxDecimalPlaces + 32];
  for (int places = inDecimalPlaces;; ++places) {
    auto result =
        std::to_chars(buffer, buffer + sizeof(buffer), std::fabs(inValue), std::chars_format::scientific, places);
    double back = 0;
    if (std::from_chars(buffer, result.ptr, back).ec != std::errc::result_out_of_range || places >= 17) {
      return std::string(buffer, result.ptr);
    }
  }
}

// The digits of |inValue| in scientific notation, for numbers too long to
// write out: "1.5e+300".
UTF16String ScientificBody(double inValue, int inDecimalPlaces, NumberFormatFlags inFlags, Marks inMarks) {
  std::string text = ScientificText(inValue, inDecimalPlaces);
  std::size_t e = text.find('e');
  std::string mantissa = text.substr(0, e), exponent = text.substr(e);
  std::size_t dot = mantissa.find('.');
  if (dot != std::string::npos && inFlags.Test(kNumberFormatNoTrailingZeros)) {
    StripTrailingZeros(mantissa);
    if (mantissa.back() == '.') mantissa.pop_back();
  }
  UTF16String body = AsciiToUTF16(mantissa + exponent);
  if (dot != std::string::npos && dot < body.size() && body[dot] == u'.') body[dot] = inMarks.decimal;
  return body;
}

struct FormattedBody {
  UTF16String text;
  bool isZero = false;
};

FormattedBody FixedBody(double inValue, int inDecimalPlaces, NumberFormatFlags inFlags, Marks inMarks,
                        int inMaxFixedLength) {
  DecimalDigits d = ShortestDigits(inValue);
  RoundDigits(d, inDecimalPlaces);
  FormattedBody body;
  body.isZero = AllZeros(d.digits);
  const int fractionDigits = std::max(inDecimalPlaces, 0);
  const long integerDigits = std::max(d.point, 1);
  if (inMaxFixedLength > 0 && integerDigits + fractionDigits + 2 > inMaxFixedLength) {
    body.text = ScientificBody(inValue, fractionDigits, inFlags, inMarks);
    return body;
  }
  std::string integer;
  for (long i = 0; i < integerDigits; ++i) integer.push_back(DigitAt(d, i - (integerDigits - d.point)));
  std::string fraction;
  for (long i = 0; i < fractionDigits; ++i) fraction.push_back(DigitAt(d, d.point + i));
  if (inFlags.Test(kNumberFormatNoTrailingZeros)) StripTrailingZeros(fraction);

  body.text = inFlags.Test(kNumberFormatUseSeparator) ? GroupDigits(integer, inMarks.grouping)
                                                      : AsciiToUTF16(integer);
  if (!fraction.empty()) {
    body.text.push_back(inMarks.decimal);
    body.text += AsciiToUTF16(fraction);
  }
  return body;
}

UTF16String SignFor(bool inNegative, NumberFormatFlags inFlags) {
  if (inNegative) return u"-";
  if (inFlags.Test(kNumberFormatAlwaysSign)) return u"+";
  if (inFlags.Test(kNumberFormatPadSign)) return u" ";
  return {};
}

UTF16String Pad(const UTF16String& inSign, const UTF16String& inBody, int inMinimumWidth, NumberFormatFlags inFlags,
                bool inNumeric) {
  const long width = std::min(inMinimumWidth, kNumberMaxMinimumWidth);
  const long missing = width - static_cast<long>(inSign.size() + inBody.size());
  if (missing <= 0) return inSign + inBody;
  UTF16String padding(static_cast<std::size_t>(missing), u' ');
  if (inFlags.Test(kNumberFormatLeadingSpaces) || !inNumeric) return padding + inSign + inBody;
  padding.assign(static_cast<std::size_t>(missing), u'0');
  return inSign + padding + inBody;
}

[[noreturn]] void ThrowNotANumber(std::u16string_view inText) {
  config::ThrowError(config::ErrorLevel::kError, "$$$/tarsel/utility/Error/NotANumber=\"^0\" is not a number.",
                     config::kErrorGroupContract, config::kErrorCodeConversion, false,
                     detail::ExcerptForMessage(inText));
}

bool IsBlank(char16_t inChar) { return inChar == u' ' || inChar == u'\t' || inChar == u'\u00A0'; }
bool IsDigit(char16_t inChar) { return inChar >= u'0' && inChar <= u'9'; }

std::u16string_view TrimBlanks(std::u16string_view inText) {
  while (!inText.empty() && IsBlank(inText.front())) inText.remove_prefix(1);
  while (!inText.empty() && IsBlank(inText.back())) inText.remove_suffix(1);
  return inText;
}

// Checks the form of a number without its sign and writes it in plain ASCII
// into outPlain. False when the form is wrong.
bool ToPlainNumber(std::u16string_view inText, Marks inMarks, std::string& outPlain) {
  std::size_t i = 0, digits = 0;
  for (; i < inText.size(); ++i) {
    char16_t c = inText[i];
    if (IsDigit(c)) {
      outPlain.push_back(static_cast<char>(c));
      ++digits;
    } else if (c == inMarks.grouping && digits > 0 && i + 1 < inText.size() && IsDigit(inText[i + 1])) {
      continue;
    } else {
      break;
    }
  }
  if (i < inText.size() && inText[i] == inMarks.decimal) {
    outPlain.push_back('.');
    for (++i; i < inText.size() && IsDigit(inText[i]); ++i, ++digits) outPlain.push_back(static_cast<char>(inText[i]));
  }
  if (digits == 0) return false;
  if (i < inText.size() && (inText[i] == u'e' || inText[i] == u'E')) {
    outPlain.push_back('e');
    ++i;
    if (i < inText.size() && (inText[i] == u'+' || inText[i] == u'-')) outPlain.push_back(static_cast<char>(inText[i++]));
    std::size_t exponentDigits = 0;
    for (; i < inText.size() && IsDigit(inText[i]); ++i, ++exponentDigits) {
      outPlain.push_back(static_cast<char>(inText[i]));
    }
    if (exponentDigits == 0) return false;
  }
  return i == inText.size();
}

}  // namespace

namespace detail {

UTF16String ExcerptForMessage(std::u16string_view inText) {
  constexpr std::size_t kMaxExcerpt = 40;
  UTF16String excerpt(inText.substr(0, kMaxExcerpt));
  for (char16_t& c : excerpt) {
    if (c < 0x20) c = u'\uFFFD';
  }
  if (inText.size() > kMaxExcerpt) excerpt += u"\u2026";
  return excerpt;
}

double ReadCheckedNumber(std::string_view inPlain, std::u16string_view inOriginal) {
  double value = 0;
  auto result = std::from_chars(inPlain.data(), inPlain.data() + inPlain.size(), value);
  if (result.ec == std::errc() && result.ptr == inPlain.data() + inPlain.size()) return value;
  if (result.ec != std::errc::result_out_of_range) ThrowNotANumber(inOriginal);
  // Out of range either way: strtod tells overflow (infinity) from underflow.
  static const locale_t cLocale = newlocale(LC_NUMERIC_MASK, "C", static_cast<locale_t>(nullptr));
  std::string text(inPlain);
  value = strtod_l(text.c_str(), nullptr, cLocale);
  if (std::isinf(value)) {
    config::ThrowError(config::ErrorLevel::kError,
                       "$$$/tarsel/utility/Error/NumberOutOfRange=The number \"^0\" is too large.",
                       config::kErrorGroupContract, config::kErrorCodeConversion, false, ExcerptForMessage(inOriginal));
  }
  return value;
}

}  // namespace detail

UTF16String NumberToString(long inValue) { return AsciiToUTF16(std::to_string(inValue)); }
UTF16String NumberToString(long long inValue) { return AsciiToUTF16(std::to_string(inValue)); }
UTF16String NumberToString(unsigned long long inValue) { return AsciiToUTF16(std::to_string(inValue)); }

UTF16String NumberToString(double inValue) {
  if (std::isnan(inValue)) return u"NaN";
  if (std::isinf(inValue)) return inValue < 0 ? UTF16String(u"-\u221E") : UTF16String(u"\u221E");
  char buffer[64];
  auto result = std::to_chars(buffer, buffer + sizeof(buffer), inValue);
  return AsciiToUTF16(std::string_view(buffer, static_cast<std::size_t>(result.ptr - buffer)));
}

UTF16String NumberToString(double inValue, int inMinimumWidth, int inDecimalPlaces, NumberFormatFlags inFlags,
                           int inMaxFixedLength) {
  if (std::isnan(inValue)) return Pad({}, u"NaN", inMinimumWidth, inFlags, false);
  const int places = std::clamp(inDecimalPlaces, -kMaxDecimalPlaces, kMaxDecimalPlaces);
  if (std::isinf(inValue)) {
    return Pad(SignFor(inValue < 0, inFlags), UTF16String(1, kInfinity), inMinimumWidth, inFlags, false);
  }
  FormattedBody body = FixedBody(inValue, places, inFlags, MarksFor(inFlags), inMaxFixedLength);
  return Pad(SignFor(std::signbit(inValue) && !body.isZero, inFlags), body.text, inMinimumWidth, inFlags, true);
}

double StringToNumber(std::u16string_view inText, NumberFormatFlags inFlags) {
  std::u16string_view text = TrimBlanks(inText);
  if (text.empty()) return std::nan("");
  bool negative = false;
  if (text.front() == u'+' || text.front() == u'-' || text.front() == kMinusSign) {
    negative = text.front() != u'+';
    text.remove_prefix(1);
  }
  if (text.size() == 1 && text.front() == kInfinity) {
    return negative ? -HUGE_VAL : HUGE_VAL;
  }
  std::string plain = negative ? "-" : "";
  if (!ToPlainNumber(text, MarksFor(inFlags), plain)) ThrowNotANumber(inText);
  return detail::ReadCheckedNumber(plain, inText);
}

void InternationalizeNum(UTF16String& ioText) {
  const Locale& locale = Locale::Default();
  for (char16_t& c : ioText) {
    if (c == u'.') {
      c = locale.GetDecimalMark();
    } else if (c == u',') {
      c = locale.GetGroupingMark();
    }
  }
}

void DeInternationalizeNum(UTF16String& ioText) {
  const Locale& locale = Locale::Default();
  for (char16_t& c : ioText) {
    if (c == locale.GetDecimalMark()) {
      c = u'.';
    } else if (c == locale.GetGroupingMark()) {
      c = u',';
    }
  }
}

}  // namespace tarsel::utility
