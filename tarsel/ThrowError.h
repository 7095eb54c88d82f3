#pragma once
// The toolkit's exception and ThrowError, which raises it with a localised
// message. The message comes from a key text (see Localizer.h) whose "^0" to
// "^3" slots are filled from the four replacement values.
#include <exception>
#include <string>
#include <string_view>

#include "tarsel/UTFString.h"

namespace tarsel::config {

enum class ErrorLevel { kInformation = 0, kWarning = 1, kError = 2, kFatal = 3 };

// Error groups in use.
constexpr int kErrorGroupResources = 103;  // layout and resource errors
constexpr int kErrorGroupContract = 105;   // contracts (code 25), type conversions (code 21)
constexpr int kErrorCodeContract = 25;
constexpr int kErrorCodeConversion = 21;

// One value for a "^n" slot, kept as text.
class ReplacementValue {
 public:
  ReplacementValue() = default;
  ReplacementValue(const char* inText);  // NOLINT: implicit by design, like a string literal
  ReplacementValue(std::string_view inText);  // NOLINT
  ReplacementValue(const std::string& inText);  // NOLINT
  ReplacementValue(const UTF8String& inText);  // NOLINT
  ReplacementValue(const UTF16String& inText);  // NOLINT
  ReplacementValue(const char16_t* inText);  // NOLINT
  ReplacementValue(long long inValue);  // NOLINT
  ReplacementValue(int inValue) : ReplacementValue(static_cast<long long>(inValue)) {}  // NOLINT
  ReplacementValue(long inValue) : ReplacementValue(static_cast<long long>(inValue)) {}  // NOLINT
  ReplacementValue(unsigned long inValue) : ReplacementValue(static_cast<long long>(inValue)) {}  // NOLINT
  ReplacementValue(unsigned inValue) : ReplacementValue(static_cast<long long>(inValue)) {}  // NOLINT
  ReplacementValue(double inValue);  // NOLINT

  bool IsSet() const { return mSet; }
  const UTF16String& GetText() const { return mText; }

 private:
  UTF16String mText;
  bool mSet = false;
};

class Exception : public std::exception {
 public:
  Exception(ErrorLevel inLevel, std::string inKeyPath, UTF16String inMessage, int inGroup, int inCode);

  const char* what() const noexcept override { return mMessageUTF8.c_str(); }

  ErrorLevel GetLevel() const { return mLevel; }
  // The path of the key text ("norvik/ui/Error/ParentNotFound"), for callers
  // that recognise an error independently of the language.
  const std::string& GetKeyPath() const { return mKeyPath; }
  const UTF16String& GetMessage() const { return mMessage; }
  const std::string& GetMessageUTF8() const { return mMessageUTF8; }
  int GetGroup() const { return mGroup; }
  int GetCode() const { return mCode; }

 private:
  ErrorLevel mLevel;
  std::string mKeyPath;
  UTF16String mMessage;
  std::string mMessageUTF8;
  int mGroup;
  int mCode;
};

// The localised message of a key text with its "^0".."^3" slots filled.
UTF16String FormatErrorMessage(std::string_view inKeyText, const ReplacementValue& in0 = {},
                               const ReplacementValue& in1 = {}, const ReplacementValue& in2 = {},
                               const ReplacementValue& in3 = {});

// Raises Exception. inFlag is kept for callers that pass it; it does not change
// what is raised.
[[noreturn]] void ThrowError(ErrorLevel inLevel, std::string_view inKeyText, int inGroup = 0, int inCode = 0,
                             bool inFlag = false, const ReplacementValue& in0 = {},
                             const ReplacementValue& in1 = {}, const ReplacementValue& in2 = {},
                             const ReplacementValue& in3 = {});

}  // namespace tarsel::config
