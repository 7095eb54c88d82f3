#include "tarsel/Localizer.h"

#include <fstream>
#include <sstream>
#include <vector>

#include "tarsel/ThrowError.h"

namespace tarsel::config {
namespace {

constexpr std::string_view kKeyPrefix = "$$$/";

std::string_view Trim(std::string_view s) {
  while (!s.empty() && (s.front() == ' ' || s.front() == '\t')) s.remove_prefix(1);
  while (!s.empty() && (s.back() == ' ' || s.back() == '\t' || s.back() == '\r')) s.remove_suffix(1);
  return s;
}

void ReplaceAll(UTF16String& ioText, std::u16string_view inFrom, std::u16string_view inTo) {
  for (std::size_t pos = ioText.find(inFrom.data(), 0, inFrom.size()); pos != UTF16String::npos;
       pos = ioText.find(inFrom.data(), pos + inTo.size(), inFrom.size())) {
    ioText.replace(pos, inFrom.size(), inTo.data(), inTo.size());
  }
}

}  // namespace

Localizer& Localizer::Get() {
  static Localizer instance;
  return instance;
}

bool Localizer::IsKeyText(std::string_view inText) {
  return inText.substr(0, kKeyPrefix.size()) == kKeyPrefix && inText.find('=') != std::string_view::npos;
}

std::string_view Localizer::KeyPath(std::string_view inKeyText) {
  if (!IsKeyText(inKeyText)) return {};
  std::string_view rest = inKeyText.substr(kKeyPrefix.size());
  return rest.substr(0, rest.find('='));
}

std::string_view Localizer::DefaultText(std::string_view inKeyText) {
  if (!IsKeyText(inKeyText)) return inKeyText;
  return inKeyText.substr(inKeyText.find('=') + 1);
}

UTF16String Localizer::ExpandEscapes(const UTF16String& inText) {
  UTF16String text = inText;
  ReplaceAll(text, u"#{endl}", u"\n");
  ReplaceAll(text, u"^}", u"'");
  return text;
}

bool Localizer::Lookup(std::string_view inPath, UTF16String& outText) const {
  auto it = mTranslations.find(inPath);
  if (it == mTranslations.end()) return false;
  outText = it->second;
  return true;
}

UTF16String Localizer::Localize(std::string_view inKeyText) const {
  if (!IsKeyText(inKeyText)) return utility::UTF8to16(inKeyText);
  UTF16String text;
  if (!Lookup(KeyPath(inKeyText), text)) text = utility::UTF8to16(DefaultText(inKeyText));
  return ExpandEscapes(text);
}

void Localizer::SetTranslation(std::string_view inPath, const UTF16String& inText) {
  if (inPath.substr(0, kKeyPrefix.size()) == kKeyPrefix) inPath.remove_prefix(kKeyPrefix.size());
  mTranslations[std::string(inPath)] = inText;
}

std::size_t Localizer::LoadTranslationText(std::string_view inText) {
  std::size_t count = 0;
  if (inText.substr(0, 3) == "\xEF\xBB\xBF") inText.remove_prefix(3);
  while (!inText.empty()) {
    std::size_t end = inText.find('\n');
    std::string_view line = Trim(inText.substr(0, end));
    inText = end == std::string_view::npos ? std::string_view() : inText.substr(end + 1);
    if (line.empty() || line.front() == '#') continue;
    std::size_t eq = line.find('=');
    if (eq == std::string_view::npos || eq == 0) continue;
    SetTranslation(Trim(line.substr(0, eq)), utility::UTF8to16(Trim(line.substr(eq + 1))));
    ++count;
  }
  return count;
}

std::size_t Localizer::LoadTranslationFile(const std::string& inFilePath) {
  std::ifstream in(inFilePath, std::ios::binary);
  if (!in) {
    ThrowError(ErrorLevel::kError, "$$$/tarsel/config/Error/TranslationFile=Cannot read the translation file ^0.",
               kErrorGroupResources, 3, false, ReplacementValue(inFilePath));
  }
  std::ostringstream text;
  text << in.rdbuf();
  return LoadTranslationText(text.str());
}

std::size_t Localizer::LoadLocale(const std::string& inDirectory, const std::string& inLocaleName) {
  std::vector<std::string> candidates{inLocaleName};
  std::string base = inLocaleName.substr(0, inLocaleName.find_first_of(".@"));
  if (base != inLocaleName) candidates.push_back(base);
  std::string language = base.substr(0, base.find('_'));
  if (language != base) candidates.push_back(language);
  for (const std::string& name : candidates) {
    if (name.empty() || name.find('/') != std::string::npos) continue;
    std::ifstream in(inDirectory + "/" + name + ".txt", std::ios::binary);
    if (!in) continue;
    std::ostringstream text;
    text << in.rdbuf();
    ClearTranslations();
    mLocaleName = inLocaleName;
    return LoadTranslationText(text.str());
  }
  ThrowError(ErrorLevel::kError, "$$$/tarsel/config/Error/LocaleNotFound=No translations for the locale ^0 in ^1.",
             kErrorGroupResources, 3, false, ReplacementValue(inLocaleName), ReplacementValue(inDirectory));
}

void Localizer::ClearTranslations() { mTranslations.clear(); }

UTF16String Localize(std::string_view inKeyText) { return Localizer::Get().Localize(inKeyText); }

}  // namespace tarsel::config
