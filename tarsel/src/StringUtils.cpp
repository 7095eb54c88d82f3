#include "tarsel/StringUtils.h"

namespace tarsel::utility {
namespace {

template <typename String, typename View>
std::size_t ReplaceAll(String& ioText, View inFrom, View inTo) {
  if (inFrom.empty()) return 0;
  std::size_t count = 0;
  String result;
  std::size_t start = 0;
  for (std::size_t pos = ioText.find(inFrom.data(), 0, inFrom.size()); pos != String::npos;
       pos = ioText.find(inFrom.data(), start, inFrom.size())) {
    result.append(ioText, start, pos - start);
    result.append(inTo.data(), inTo.size());
    start = pos + inFrom.size();
    ++count;
  }
  if (count == 0) return 0;
  result.append(ioText, start, String::npos);
  ioText.swap(result);
  return count;
}

bool IsDigit(char16_t inChar) { return inChar >= u'0' && inChar <= u'9'; }

// One walk over a display string that both strips it and finds its mnemonic.
struct MnemonicScan {
  UTF16String stripped;
  long ampersandIndex = -1;  // in the original text
  long markedIndex = -1;     // in the stripped text
};

MnemonicScan ScanDisplayString(std::u16string_view inText) {
  MnemonicScan scan;
  scan.stripped.reserve(inText.size());
  for (std::size_t i = 0; i < inText.size(); ++i) {
    if (inText[i] != u'&') {
      scan.stripped.push_back(inText[i]);
      continue;
    }
    if (i + 1 < inText.size() && inText[i + 1] == u'&') {
      scan.stripped.push_back(u'&');
      ++i;
      continue;
    }
    if (scan.ampersandIndex < 0 && i + 1 < inText.size()) {
      scan.ampersandIndex = static_cast<long>(i);
      scan.markedIndex = static_cast<long>(scan.stripped.size());
    }
  }
  return scan;
}

}  // namespace

std::size_t ReplaceAllStringInString(UTF16String& ioText, std::u16string_view inFrom, std::u16string_view inTo) {
  return ReplaceAll(ioText, inFrom, inTo);
}

std::size_t ReplaceAllStringInString(UTF8String& ioText, std::string_view inFrom, std::string_view inTo) {
  return ReplaceAll(ioText, inFrom, inTo);
}

UTF16String ReplaceInStringList(std::u16string_view inText, const std::vector<UTF16String>& inValues) {
  UTF16String result;
  result.reserve(inText.size());
  for (std::size_t i = 0; i < inText.size(); ++i) {
    char16_t next = i + 1 < inText.size() ? inText[i + 1] : u'\0';
    if (inText[i] != u'@' || (next != u'@' && !IsDigit(next))) {
      result.push_back(inText[i]);
      continue;
    }
    ++i;
    if (next == u'@') {
      result.push_back(u'@');
    } else if (static_cast<std::size_t>(next - u'0') < inValues.size()) {
      result += inValues[next - u'0'];
    } else {
      result.push_back(u'@');
      result.push_back(next);
    }
  }
  return result;
}

namespace detail {
UTF16String SlotValue(long long inValue) { return NumberToString(inValue); }
UTF16String SlotValue(double inValue) { return NumberToString(inValue); }
}  // namespace detail

const UTF16String& GetLineEnding() {
  static const UTF16String ending(u"\n");
  return ending;
}

void ConvertLineEndings(UTF16String& ioText, std::u16string_view inLineEnding) {
  UTF16String result;
  result.reserve(ioText.size());
  for (std::size_t i = 0; i < ioText.size(); ++i) {
    char16_t c = ioText[i];
    if (c == u'\r' || c == u'\n') {
      if (c == u'\r' && i + 1 < ioText.size() && ioText[i + 1] == u'\n') ++i;
      result.append(inLineEnding.data(), inLineEnding.size());
    } else {
      result.push_back(c);
    }
  }
  ioText.swap(result);
}

long LocateSingleAmpersandInString(std::u16string_view inText, bool inStripped) {
  MnemonicScan scan = ScanDisplayString(inText);
  return inStripped ? scan.markedIndex : scan.ampersandIndex;
}

void StripDisplayString(UTF16String& ioText) { ioText = ScanDisplayString(ioText).stripped; }

void StripDisplayString(std::u16string_view inText, UTF16String& outStripped) {
  outStripped = ScanDisplayString(inText).stripped;
}

bool ValidateForHex(std::u16string_view inText) {
  if (inText.empty()) return false;
  for (char16_t c : inText) {
    if (!IsDigit(c) && !(c >= u'a' && c <= u'f') && !(c >= u'A' && c <= u'F')) return false;
  }
  return true;
}

bool HasNumericChars(std::u16string_view inText) {
  for (char16_t c : inText) {
    if (IsDigit(c)) return true;
  }
  return false;
}

UTF16String NumberToHexString(unsigned long long inValue) {
  static constexpr char16_t kDigits[] = u"0123456789ABCDEF";
  char16_t buffer[16];
  std::size_t n = 0;
  do {
    buffer[n++] = kDigits[inValue & 0xF];
    inValue >>= 4;
  } while (inValue != 0);
  UTF16String text;
  while (n > 0) text.push_back(buffer[--n]);
  return text;
}

}  // namespace tarsel::utility
