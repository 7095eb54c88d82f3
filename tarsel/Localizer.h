#pragma once
// Localisation of key texts. A key text is one literal "$$$/path=Default": the
// path names the text, the part after the first '=' is the default. Inside the
// text, "#{endl}" is a line end and "^}" an apostrophe; "@0".."@9" are slots
// for ReplaceInString and "^0".."^3" slots for ThrowError.
//
// Translations are loaded per locale from key=value files in UTF-8 (with or
// without a byte-order mark): one "path=text" per line, the path with or
// without its "$$$/" prefix, blanks around both parts dropped, and '#'
// starting a comment line.
#include <map>
#include <string>
#include <string_view>

#include "tarsel/UTFString.h"

namespace tarsel::config {

class Localizer {
 public:
  // The process's localiser.
  static Localizer& Get();

  // The localised text of a key text: the loaded translation of its path if
  // there is one, else its default; "#{endl}" and "^}" are expanded. A text
  // that is not a key text comes back unchanged.
  UTF16String Localize(std::string_view inKeyText) const;

  // The translation of a path, without expansion; false when there is none.
  bool Lookup(std::string_view inPath, UTF16String& outText) const;

  void SetTranslation(std::string_view inPath, const UTF16String& inText);
  // Reads a key=value file and adds its entries; answers how many it read.
  // Throws the toolkit's exception when the file cannot be read.
  std::size_t LoadTranslationFile(const std::string& inFilePath);
  // Adds the entries of key=value text; answers how many it read.
  std::size_t LoadTranslationText(std::string_view inText);
  void ClearTranslations();

  // Replaces the translations with those of a locale, read from
  // "<inDirectory>/<name>.txt". The name is tried as given ("de_DE.UTF-8"),
  // then without its code set and modifier ("de_DE"), then as the language
  // alone ("de"). On success the locale name becomes inLocaleName and the
  // answer is how many entries were read; when no file is found, the toolkit's
  // exception is raised and the translations stay as they were.
  std::size_t LoadLocale(const std::string& inDirectory, const std::string& inLocaleName);

  void SetLocaleName(const std::string& inName) { mLocaleName = inName; }
  const std::string& GetLocaleName() const { return mLocaleName; }

  // The parts of a key text: "$$$/a/b=Text" has path "a/b" and default "Text".
  static bool IsKeyText(std::string_view inText);
  static std::string_view KeyPath(std::string_view inKeyText);
  static std::string_view DefaultText(std::string_view inKeyText);
  // Expands "#{endl}" to a line feed and "^}" to an apostrophe.
  static UTF16String ExpandEscapes(const UTF16String& inText);

 private:
  std::map<std::string, UTF16String, std::less<>> mTranslations;
  std::string mLocaleName = "en_US";
};

// Shorthand for Localizer::Get().Localize(inKeyText).
UTF16String Localize(std::string_view inKeyText);

}  // namespace tarsel::config
