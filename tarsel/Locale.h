#pragma once
// The locale of the user's texts: the marks of numbers and the order of
// strings. Locale::Default() is the one every string and number helper uses;
// it starts as the process environment's numeric locale (LC_ALL, LC_NUMERIC,
// LANG) and can be replaced, for instance by a test or a host with its own
// preferences.
#include <string>
#include <string_view>

#include "tarsel/UTFString.h"

namespace tarsel {

class Locale {
 public:
  // "C": '.' as decimal mark, ',' as grouping mark.
  Locale();
  Locale(std::string inName, char16_t inDecimalMark, char16_t inGroupingMark);

  // The locale of the process environment, read without changing the C
  // library's global locale. Marks the environment does not give fall back to
  // '.' and ','.
  static Locale FromEnvironment();

  static const Locale& Default();
  static void SetDefault(const Locale& inLocale);

  const std::string& GetName() const { return mName; }
  char16_t GetDecimalMark() const { return mDecimalMark; }
  char16_t GetGroupingMark() const { return mGroupingMark; }

  // Collation: case-folded texts compare code unit by code unit; texts that
  // fold alike are ordered by their code units, so the order is total and
  // "apple" sorts before "Banana" and "Apple" before "apple". Answers <0, 0, >0.
  int Compare(std::u16string_view inA, std::u16string_view inB) const;
  bool Less(std::u16string_view inA, std::u16string_view inB) const { return Compare(inA, inB) < 0; }

 private:
  std::string mName;
  char16_t mDecimalMark;
  char16_t mGroupingMark;
};

// Replaces Locale::Default() for the life of the object, restoring the
// previous one afterwards.
class ScSetDefaultLocale {
 public:
  explicit ScSetDefaultLocale(const Locale& inLocale) : mPrevious(Locale::Default()) { Locale::SetDefault(inLocale); }
  ~ScSetDefaultLocale() { Locale::SetDefault(mPrevious); }
  ScSetDefaultLocale(const ScSetDefaultLocale&) = delete;
  ScSetDefaultLocale& operator=(const ScSetDefaultLocale&) = delete;

 private:
  Locale mPrevious;
};

}  // namespace tarsel
