#include "tarsel/ThrowError.h"

#include <cstdio>

#include "tarsel/Localizer.h"
#include "tarsel/MatrixT.h"

namespace tarsel::config {

ReplacementValue::ReplacementValue(const char* inText)
    : mText(utility::UTF8to16(inText ? inText : "")), mSet(true) {}
ReplacementValue::ReplacementValue(std::string_view inText) : mText(utility::UTF8to16(inText)), mSet(true) {}
ReplacementValue::ReplacementValue(const std::string& inText) : mText(utility::UTF8to16(inText)), mSet(true) {}
ReplacementValue::ReplacementValue(const UTF8String& inText)
    : mText(utility::UTF8to16(std::string_view(inText.data(), inText.size()))), mSet(true) {}
ReplacementValue::ReplacementValue(const UTF16String& inText) : mText(inText), mSet(true) {}
ReplacementValue::ReplacementValue(const char16_t* inText) : mText(inText ? inText : u""), mSet(true) {}
ReplacementValue::ReplacementValue(long long inValue)
    : mText(utility::AsciiToUTF16(std::to_string(inValue))), mSet(true) {}
ReplacementValue::ReplacementValue(double inValue) : mSet(true) {
  char buffer[64];
  std::snprintf(buffer, sizeof(buffer), "%g", inValue);
  mText = utility::AsciiToUTF16(buffer);
}

Exception::Exception(ErrorLevel inLevel, std::string inKeyPath, UTF16String inMessage, int inGroup, int inCode)
    : mLevel(inLevel),
      mKeyPath(std::move(inKeyPath)),
      mMessage(std::move(inMessage)),
      mMessageUTF8(utility::ToStdString(utility::UTF16to8(mMessage))),
      mGroup(inGroup),
      mCode(inCode) {}

UTF16String FormatErrorMessage(std::string_view inKeyText, const ReplacementValue& in0,
                               const ReplacementValue& in1, const ReplacementValue& in2,
                               const ReplacementValue& in3) {
  UTF16String text = Localizer::Get().Localize(inKeyText);
  const ReplacementValue* values[4] = {&in0, &in1, &in2, &in3};
  UTF16String result;
  result.reserve(text.size());
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] == u'^' && i + 1 < text.size() && text[i + 1] >= u'0' && text[i + 1] <= u'3') {
      result += values[text[i + 1] - u'0']->GetText();
      ++i;
    } else {
      result.push_back(text[i]);
    }
  }
  return result;
}

void ThrowError(ErrorLevel inLevel, std::string_view inKeyText, int inGroup, int inCode, bool /*inFlag*/,
                const ReplacementValue& in0, const ReplacementValue& in1, const ReplacementValue& in2,
                const ReplacementValue& in3) {
  throw Exception(inLevel, std::string(Localizer::KeyPath(inKeyText)),
                  FormatErrorMessage(inKeyText, in0, in1, in2, in3), inGroup, inCode);
}

}  // namespace tarsel::config

namespace tarsel::geom {
void ThrowNonInvertableMatrix() {
  config::ThrowError(config::ErrorLevel::kError,
                     "$$$/tarsel/geom/matrix/Error/NonInvertableMatrix=Matrix cannot be inverted.",
                     config::kErrorGroupContract, config::kErrorCodeContract);
}
}  // namespace tarsel::geom
