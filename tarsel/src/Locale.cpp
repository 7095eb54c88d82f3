#include "tarsel/Locale.h"

#include <langinfo.h>
#include <locale.h>

#include "tarsel/StringUtils.h"

namespace tarsel {
namespace {

// The first UTF-16 unit of a C library mark, or inFallback when it is empty.
char16_t MarkFromLangInfo(const char* inMark, char16_t inFallback) {
  if (!inMark || !*inMark) return inFallback;
  UTF16String mark = utility::UTF8to16(inMark);
  return mark.empty() ? inFallback : mark.front();
}

Locale& DefaultStorage() {
  static Locale locale = Locale::FromEnvironment();
  return locale;
}

}  // namespace

Locale::Locale() : mName("C"), mDecimalMark(u'.'), mGroupingMark(u',') {}

Locale::Locale(std::string inName, char16_t inDecimalMark, char16_t inGroupingMark)
    : mName(std::move(inName)), mDecimalMark(inDecimalMark), mGroupingMark(inGroupingMark) {}

Locale Locale::FromEnvironment() {
  locale_t numeric = newlocale(LC_NUMERIC_MASK, "", static_cast<locale_t>(nullptr));
  if (numeric == static_cast<locale_t>(nullptr)) return Locale();
  char16_t decimal = MarkFromLangInfo(nl_langinfo_l(RADIXCHAR, numeric), u'.');
  char16_t grouping = MarkFromLangInfo(nl_langinfo_l(THOUSEP, numeric), decimal == u',' ? u'.' : u',');
  // A locale that groups with its decimal mark could not be read back.
  if (grouping == decimal) grouping = decimal == u',' ? u'.' : u',';
  const char* name = nl_langinfo_l(_NL_LOCALE_NAME(LC_NUMERIC), numeric);
  Locale result(name && *name ? name : "C", decimal, grouping);
  freelocale(numeric);
  return result;
}

const Locale& Locale::Default() { return DefaultStorage(); }

void Locale::SetDefault(const Locale& inLocale) { DefaultStorage() = inLocale; }

int Locale::Compare(std::u16string_view inA, std::u16string_view inB) const {
  const std::size_t common = std::min(inA.size(), inB.size());
  for (std::size_t i = 0; i < common; ++i) {
    char16_t a = utility::FoldCase(inA[i]), b = utility::FoldCase(inB[i]);
    if (a != b) return a < b ? -1 : 1;
  }
  if (inA.size() != inB.size()) return inA.size() < inB.size() ? -1 : 1;
  int raw = inA.compare(inB);
  return raw < 0 ? -1 : (raw > 0 ? 1 : 0);
}

}  // namespace tarsel
