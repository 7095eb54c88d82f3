#include "ui/KeyframeThemeParser.h"

#include <cmath>

#include "tarsel/StringStreams.h"
#include "tarsel/ThrowError.h"

namespace norvik::ui {

namespace {

[[noreturn]] void RaiseBadNumber(std::string_view inElement, std::string_view inAttribute,
                                 const UTF8String& inText) {
  tarsel::config::ThrowError(
      tarsel::config::ErrorLevel::kError,
      "$$$/norvik/ui/Error/ThemeKeyframeNumber=The attribute \"^0\" of \"^1\" is not a valid number: \"^2\".", 0, 0,
      false, inAttribute, inElement, inText);
}

// Reads the whole text as one number; blanks around it are allowed.
template <typename T>
bool ReadWhole(const UTF8String& inText, T& outValue) {
  tarsel::iUTF16StringStream in(tarsel::utility::UTF8to16(inText));
  in >> outValue;
  if (in.fail()) return false;
  in >> std::ws;
  return in.eof();
}

// An absent attribute answers false; a present one that does not read raises.
bool ReadFloat(const tarsel::xml::Attributes& inAttributes, std::string_view inElement, std::string_view inName,
               float& outValue) {
  const UTF8String* text = inAttributes.Find(inName);
  if (!text) return false;
  if (!ReadWhole(*text, outValue) || !std::isfinite(outValue)) RaiseBadNumber(inElement, inName, *text);
  return true;
}

bool ReadIdentifier(const tarsel::xml::Attributes& inAttributes, std::string_view inElement,
                    std::string_view inName, std::uint64_t& outValue) {
  const UTF8String* text = inAttributes.Find(inName);
  if (!text) return false;
  // The stream would wrap a minus sign into a huge value.
  unsigned long long value = 0;
  if (text->find('-') != UTF8String::npos || !ReadWhole(*text, value)) RaiseBadNumber(inElement, inName, *text);
  outValue = value;
  return true;
}

[[noreturn]] void RaiseUnknown(std::string_view inKeyText, std::uint64_t inID) {
  tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError, inKeyText, 0, 0, false,
                             static_cast<long long>(inID));
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
    // A group without "t" is no group: its key frames carry their own t.
    float t = 0;
    if (ReadFloat(inAttributes, inName, "t", t)) {
      mInThemeGroup = true;
      mGroupT = t;
    }
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
  bool complete = ReadIdentifier(inAttributes, element, "name", id);
  if (!mInThemeGroup) complete = ReadFloat(inAttributes, element, "t", t) && complete;
  complete = ReadFloat(inAttributes, element, "v", value.mValue) && complete;
  ReadFloat(inAttributes, element, "h", value.mHue);
  ReadFloat(inAttributes, element, "s", value.mSaturation);
  ReadFloat(inAttributes, element, "a", value.mAlpha);
  const UTF8String* hold = inAttributes.Find("hold");
  value.mHold = hold && *hold == "true";
  if (!complete) {
    if (mEditor->GetStrictMode()) RaiseIncomplete(element);
    return;
  }
  if (id >= mEditor->GetColorCount()) {
    RaiseUnknown("$$$/norvik/ui/Error/ThemeKeyframeUnknownColor=The key frame names colour ^0, which the theme "
                 "does not have.",
                 id);
  }
  if (mSeenColors.insert(id).second) mEditor->ClearColorKeyValue(id);
  mEditor->SetColorKeyValue(id, t, value);
}

void KeyframeThemeParser::ReadFontSize(const tarsel::xml::Attributes& inAttributes) {
  const std::string_view element = "FontSize";
  std::uint64_t id = 0, scheme = 0;
  float size = 0;
  bool complete = ReadIdentifier(inAttributes, element, "name", id);
  complete = ReadFloat(inAttributes, element, "size", size) && complete;
  complete = ReadIdentifier(inAttributes, element, "scheme", scheme) && complete;
  if (!complete) {
    if (mEditor->GetStrictMode()) RaiseIncomplete(element);
    return;
  }
  if (id >= mEditor->GetFontCount()) {
    RaiseUnknown("$$$/norvik/ui/Error/ThemeKeyframeUnknownFont=The font size names font ^0, which the theme "
                 "does not have.",
                 id);
  }
  mEditor->SetFontSizeSchemeValue(id, scheme, size);
}

}  // namespace norvik::ui
