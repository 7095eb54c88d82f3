#include "ui/KeyframeThemeParser.h"

#include <cmath>
#include <type_traits>

#include "tarsel/StringStreams.h"
#include "tarsel/ThrowError.h"

namespace norvik::ui {

namespace {

// Numbers read as the string stream reads them. An attribute that is absent,
// or whose text gives no number, answers false and leaves its element out.
template <typename T>
bool ReadNumber(const tarsel::xml::Attributes& inAttributes, std::string_view inName, T& outValue) {
  const UTF8String* text = inAttributes.Find(inName);
  if (!text) return false;
  tarsel::iUTF16StringStream in(tarsel::utility::UTF8to16(*text));
  T value{};
  in >> value;
  if (in.fail()) return false;
  if constexpr (std::is_floating_point_v<T>) {
    if (!std::isfinite(value)) return false;
  }
  outValue = value;
  return true;
}

bool ReadFloat(const tarsel::xml::Attributes& inAttributes, std::string_view inName, float& outValue) {
  return ReadNumber(inAttributes, inName, outValue);
}

bool ReadIdentifier(const tarsel::xml::Attributes& inAttributes, std::string_view inName, std::uint64_t& outValue) {
  unsigned long long value = 0;
  if (!ReadNumber(inAttributes, inName, value)) return false;
  outValue = value;
  return true;
}

[[noreturn]] void RaiseIncomplete(std::string_view inElement) {
  tarsel::config::ThrowError(
      tarsel::config::ErrorLevel::kError,
      "$$$/norvik/ui/Error/ThemeKeyframeIncomplete=A \"^0\" element lacks a required attribute.", 0, 0, false,
      inElement);
}

}  // namespace

KeyframeThemeParser::KeyframeThemeParser(KeyframeThemeEditor* inEditor) : mEditor(inEditor) {}

void KeyframeThemeParser::StartDocument() {
  mSeenColors.clear();
  mInThemeGroup = false;
  mGroupT = 0;
}

void KeyframeThemeParser::EndDocument() {
  mEditor->SetBrightness(mEditor->GetBrightness());
  mEditor->SetFontSizeScheme(mEditor->GetFontSizeScheme());
}

void KeyframeThemeParser::StartElement(std::string_view inName, const tarsel::xml::Attributes& inAttributes) {
  if (inName == "KeyFrame") {
    ReadKeyFrame(inAttributes);
  } else if (inName == "FontSize") {
    ReadFontSize(inAttributes);
  } else if (inName == "Theme") {
    // "t" is optional: a group without it still groups, at t 0.
    mInThemeGroup = true;
    mGroupT = 0;
    ReadFloat(inAttributes, "t", mGroupT);
  }
  // "ThemeColors" and "ThemeFonts" only frame the content; other elements are ignored.
}

void KeyframeThemeParser::EndElement(std::string_view inName) {
  if (inName == "Theme") {
    mInThemeGroup = false;
    mGroupT = 0;
  }
}

void KeyframeThemeParser::ReadKeyFrame(const tarsel::xml::Attributes& inAttributes) {
  const std::string_view element = "KeyFrame";
  std::uint64_t id = 0;
  float t = mGroupT;
  KeyValue value(0, 0, 0, 1, false);
  bool complete = ReadIdentifier(inAttributes, "name", id);
  if (!mInThemeGroup) complete = ReadFloat(inAttributes, "t", t) && complete;
  complete = ReadFloat(inAttributes, "v", value.mValue) && complete;
  ReadFloat(inAttributes, "h", value.mHue);
  ReadFloat(inAttributes, "s", value.mSaturation);
  ReadFloat(inAttributes, "a", value.mAlpha);
  const UTF8String* hold = inAttributes.Find("hold");
  value.mHold = hold && *hold == "true";
  if (!complete) {
    if (mEditor->GetStrictMode()) RaiseIncomplete(element);
    return;
  }
  if (mSeenColors.insert(id).second) mEditor->ClearColorKeyValue(id);
  mEditor->SetColorKeyValue(id, t, value);
}

void KeyframeThemeParser::ReadFontSize(const tarsel::xml::Attributes& inAttributes) {
  const std::string_view element = "FontSize";
  std::uint64_t id = 0, scheme = 0;
  float size = 0;
  bool complete = ReadIdentifier(inAttributes, "name", id);
  complete = ReadFloat(inAttributes, "size", size) && complete;
  complete = ReadIdentifier(inAttributes, "scheme", scheme) && complete;
  if (!complete) {
    if (mEditor->GetStrictMode()) RaiseIncomplete(element);
    return;
  }
  mEditor->SetFontSizeSchemeValue(id, scheme, size);
}

}  // namespace norvik::ui
