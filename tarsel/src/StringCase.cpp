// Case mapping through the C library's wide-character functions, under a
// UTF-8 C locale of our own (towlower_l/towupper_l): the global locale is left
// alone, and the tables cover the whole Basic Multilingual Plane, so Latin,
// Greek and Cyrillic letters map as they should. When no UTF-8 locale can be
// made, only ASCII letters change case.
#include <locale.h>
#include <wctype.h>

#include "tarsel/StringUtils.h"

namespace tarsel::utility {
namespace {

locale_t CaseLocale() {
  static const locale_t locale = [] {
    for (const char* name : {"C.UTF-8", "C.utf8", "en_US.UTF-8"}) {
      locale_t l = newlocale(LC_CTYPE_MASK, name, static_cast<locale_t>(nullptr));
      if (l != static_cast<locale_t>(nullptr)) return l;
    }
    return static_cast<locale_t>(nullptr);
  }();
  return locale;
}

bool IsSurrogate(char16_t inChar) { return inChar >= 0xD800 && inChar <= 0xDFFF; }

char16_t MapChar(char16_t inChar, bool inUpper) {
  if (inChar < 0x80) {
    if (inUpper && inChar >= u'a' && inChar <= u'z') return static_cast<char16_t>(inChar - 32);
    if (!inUpper && inChar >= u'A' && inChar <= u'Z') return static_cast<char16_t>(inChar + 32);
    return inChar;
  }
  locale_t locale = CaseLocale();
  if (IsSurrogate(inChar) || locale == static_cast<locale_t>(nullptr)) return inChar;
  wint_t mapped = inUpper ? towupper_l(inChar, locale) : towlower_l(inChar, locale);
  // A mapping out of the plane would need a surrogate pair; keep the length.
  return mapped <= 0xFFFF && !IsSurrogate(static_cast<char16_t>(mapped)) ? static_cast<char16_t>(mapped) : inChar;
}

bool IsWordChar(char16_t inChar) {
  if (inChar < 0x80) {
    return (inChar >= u'a' && inChar <= u'z') || (inChar >= u'A' && inChar <= u'Z') ||
           (inChar >= u'0' && inChar <= u'9');
  }
  locale_t locale = CaseLocale();
  if (IsSurrogate(inChar)) return true;  // letters outside the plane stay inside their word
  return locale != static_cast<locale_t>(nullptr) && iswalnum_l(inChar, locale);
}

template <typename String>
void MapUTF8(String& ioText, bool inUpper) {
  UTF16String wide = UTF8to16(std::string_view(ioText.data(), ioText.size()));
  for (char16_t& c : wide) c = MapChar(c, inUpper);
  UTF8String narrow = UTF16to8(wide);
  ioText.assign(narrow.data(), narrow.size());
}

}  // namespace

char16_t LowerCase(char16_t inChar) { return MapChar(inChar, false); }
char16_t UpperCase(char16_t inChar) { return MapChar(inChar, true); }

void ToLowerCase(UTF16String& ioText) {
  for (char16_t& c : ioText) c = MapChar(c, false);
}

void ToUpperCase(UTF16String& ioText) {
  for (char16_t& c : ioText) c = MapChar(c, true);
}

void ToLowerCase(UTF8String& ioText) { MapUTF8(ioText, false); }
void ToUpperCase(UTF8String& ioText) { MapUTF8(ioText, true); }

void ToTitleCase(UTF16String& ioText) {
  bool inWord = false;
  for (char16_t& c : ioText) {
    // An apostrophe continues a word ("o'clock") but does not start one.
    bool apostrophe = c == u'\'' || c == u'\u2019';
    bool wordChar = apostrophe ? inWord : IsWordChar(c);
    c = MapChar(c, wordChar && !inWord);
    inWord = wordChar;
  }
}

UTF16String LowerCase(std::u16string_view inText) {
  UTF16String text(inText.data(), inText.size());
  ToLowerCase(text);
  return text;
}

// Upper then lower, so that characters with two lower forms (final and medial
// sigma) and title-case digraphs land on one form.
char16_t FoldCase(char16_t inChar) { return MapChar(MapChar(inChar, true), false); }

UTF16String FoldCase(std::u16string_view inText) {
  UTF16String text(inText.data(), inText.size());
  for (char16_t& c : text) c = FoldCase(c);
  return text;
}

}  // namespace tarsel::utility
