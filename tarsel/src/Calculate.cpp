// The arithmetic of number fields: a recursive-descent evaluator over
//   expression := term (('+' | '-') term)*
//   term       := signed (('*' | '/') signed)*
//   signed     := ('+' | '-') signed | power
//   power      := primary ('^' signed)?
//   primary    := number | '(' expression ')'
// Every recursion counts towards one depth limit, so that a hostile text of
// thousands of parentheses or signs raises an error instead of exhausting the
// stack.
#include <cmath>
#include <string>

#include "tarsel/Locale.h"
#include "tarsel/StringUtils.h"
#include "tarsel/ThrowError.h"
#include "tarsel/src/NumberText.h"

namespace tarsel::utility {
namespace {

bool IsDigit(char16_t inChar) { return inChar >= u'0' && inChar <= u'9'; }

bool IsUnitChar(char16_t inChar) {
  if ((inChar >= u'a' && inChar <= u'z') || (inChar >= u'A' && inChar <= u'Z')) return true;
  if (inChar == u'%' || inChar == u'\u00B0' || inChar == u'"' || inChar == u'\'' || inChar == u'\u00B5') return true;
  return inChar >= 0x80 && LowerCase(inChar) != UpperCase(inChar);
}

class Evaluator {
 public:
  Evaluator(std::u16string_view inText, bool inIgnoreUnits) : mText(inText), mIgnoreUnits(inIgnoreUnits) {}

  double Run() {
    SkipFiller();
    if (Peek() == u'=') Advance();
    SkipFiller();
    if (AtEnd()) return std::nan("");
    double value = Expression();
    if (Peek() == u'=') Advance();
    SkipFiller();
    if (!AtEnd()) SyntaxError();
    return value;
  }

 private:
  double Expression() {
    double value = Term();
    for (;;) {
      char16_t op = Peek();
      if (op != u'+' && op != u'-' && op != u'\u2212') return value;
      Advance();
      double rhs = Term();
      value = Checked(op == u'+' ? value + rhs : value - rhs);
    }
  }

  double Term() {
    double value = Signed();
    for (;;) {
      char16_t op = Peek();
      if (op != u'*' && op != u'/' && op != u'\u00D7' && op != u'\u00F7') return value;
      Advance();
      double rhs = Signed();
      if (op == u'*' || op == u'\u00D7') {
        value = Checked(value * rhs);
      } else {
        if (rhs == 0) DivisionByZero();
        value = Checked(value / rhs);
      }
    }
  }

  double Signed() {
    char16_t op = Peek();
    if (op != u'+' && op != u'-' && op != u'\u2212') return Power();
    Advance();
    DepthGuard guard(*this);
    double value = Signed();
    return op == u'+' ? value : -value;
  }

  double Power() {
    double base = Primary();
    if (Peek() != u'^') return base;
    Advance();
    DepthGuard guard(*this);
    double exponent = Signed();
    if (base == 0 && exponent < 0) DivisionByZero();
    double value = std::pow(base, exponent);
    if (std::isnan(value)) {
      config::ThrowError(config::ErrorLevel::kError,
                         "$$$/tarsel/utility/Error/CalculateUndefined=The expression has no real value.",
                         config::kErrorGroupContract, config::kErrorCodeConversion);
    }
    return Checked(value);
  }

  double Primary() {
    if (Peek() == u'(') {
      Advance();
      DepthGuard guard(*this);
      double value = Expression();
      if (Peek() != u')') SyntaxError();
      Advance();
      return value;
    }
    return Number();
  }

  double Number() {
    std::size_t start = mPos;
    std::string plain;
    std::size_t digits = 0;
    for (; mPos < mText.size(); ++mPos) {
      char16_t c = mText[mPos];
      if (IsDigit(c)) {
        plain.push_back(static_cast<char>(c));
        ++digits;
      } else if (c == u',' && digits > 0 && mPos + 1 < mText.size() && IsDigit(mText[mPos + 1])) {
        continue;  // a grouping mark
      } else {
        break;
      }
    }
    if (mPos < mText.size() && mText[mPos] == u'.') {
      plain.push_back('.');
      for (++mPos; mPos < mText.size() && IsDigit(mText[mPos]); ++mPos, ++digits) {
        plain.push_back(static_cast<char>(mText[mPos]));
      }
    }
    if (digits == 0) {
      mPos = start;
      SyntaxError();
    }
    ReadExponent(plain);
    double value = detail::ReadCheckedNumber(plain, mText.substr(start, mPos - start));
    SkipFiller();
    return value;
  }

  // "e" or "E", an optional sign and digits; an "e" not followed so is not an
  // exponent (it may start a unit name).
  void ReadExponent(std::string& ioPlain) {
    if (mPos >= mText.size() || (mText[mPos] != u'e' && mText[mPos] != u'E')) return;
    std::size_t i = mPos + 1;
    if (i < mText.size() && (mText[i] == u'+' || mText[i] == u'-')) ++i;
    if (i >= mText.size() || !IsDigit(mText[i])) return;
    ioPlain.push_back('e');
    if (mText[mPos + 1] == u'-') ioPlain.push_back('-');
    for (mPos = i; mPos < mText.size() && IsDigit(mText[mPos]); ++mPos) ioPlain.push_back(static_cast<char>(mText[mPos]));
  }

  char16_t Peek() const { return AtEnd() ? u'\0' : mText[mPos]; }
  bool AtEnd() const { return mPos >= mText.size(); }
  void Advance() {
    ++mPos;
    SkipFiller();
  }

  void SkipFiller() {
    while (mPos < mText.size()) {
      char16_t c = mText[mPos];
      bool blank = c == u' ' || c == u'\t' || c == u'\u00A0';
      if (!blank && !(mIgnoreUnits && IsUnitChar(c))) return;
      ++mPos;
    }
  }

  double Checked(double inValue) const {
    if (!std::isfinite(inValue)) {
      config::ThrowError(config::ErrorLevel::kError,
                         "$$$/tarsel/utility/Error/CalculateOverflow=The result of the expression is too large.",
                         config::kErrorGroupContract, config::kErrorCodeConversion);
    }
    return inValue;
  }

  [[noreturn]] void SyntaxError() const {
    config::ThrowError(config::ErrorLevel::kError,
                       "$$$/tarsel/utility/Error/CalculateSyntax=The expression \"^0\" cannot be read at position ^1.",
                       config::kErrorGroupContract, config::kErrorCodeConversion, false,
                       detail::ExcerptForMessage(mText), static_cast<long long>(mPos + 1));
  }

  [[noreturn]] static void DivisionByZero() {
    config::ThrowError(config::ErrorLevel::kError, "$$$/tarsel/utility/Error/DivisionByZero=Division by zero.",
                       config::kErrorGroupContract, config::kErrorCodeConversion);
  }

  class DepthGuard {
   public:
    explicit DepthGuard(Evaluator& inOwner) : mOwner(inOwner) {
      if (++mOwner.mDepth > kCalculateMaxDepth) {
        config::ThrowError(config::ErrorLevel::kError,
                           "$$$/tarsel/utility/Error/CalculateTooDeep=The expression is nested too deeply.",
                           config::kErrorGroupContract, config::kErrorCodeConversion);
      }
    }
    ~DepthGuard() { --mOwner.mDepth; }
    DepthGuard(const DepthGuard&) = delete;
    DepthGuard& operator=(const DepthGuard&) = delete;

   private:
    Evaluator& mOwner;
  };

  std::u16string_view mText;
  bool mIgnoreUnits;
  std::size_t mPos = 0;
  int mDepth = 0;
};

// The user's marks to plain ones. A grouping mark counts only between two
// digits: where it is a blank, the blanks around operators must stay blanks.
UTF16String ToPlainMarks(std::u16string_view inText) {
  const Locale& locale = Locale::Default();
  UTF16String text(inText.data(), inText.size());
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] == locale.GetDecimalMark()) {
      text[i] = u'.';
    } else if (text[i] == locale.GetGroupingMark() && i > 0 && i + 1 < text.size() && IsDigit(text[i - 1]) &&
               IsDigit(inText[i + 1])) {
      text[i] = u',';
    }
  }
  return text;
}

}  // namespace

double Calculate(std::u16string_view inText, NumberFormatFlags inFlags) {
  UTF16String text = inFlags.Test(kCalculateNoLocalization) ? UTF16String(inText.data(), inText.size())
                                                             : ToPlainMarks(inText);
  return Evaluator(text, inFlags.Test(kCalculateIgnoreUnitNames)).Run();
}

}  // namespace tarsel::utility
