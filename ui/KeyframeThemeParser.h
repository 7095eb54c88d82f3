#pragma once
// Reads a theme key-frame document into a KeyframeThemeEditor:
//
//   <ThemeColors>
//     <Theme t="0.5"> <KeyFrame name="12" v="0.2" h="210" s="0.1" a="1"/> </Theme>
//     <KeyFrame name="12" t="1" v="0.9" hold="true"/>
//     <FontSize name="0" scheme="2" size="13"/>
//   </ThemeColors>
//
// The first key frame of a colour in a document clears that colour's track,
// so a document replaces whole tracks rather than merging into them. At the
// end of the document the brightness and scheme are set again so that the new
// tracks take effect. Key frames and font sizes that lack a required attribute,
// or whose numbers do not read, are skipped (raised in strict mode);
// identifiers beyond the theme's palette are kept as tracks.
#include <set>

#include "tarsel/XmlParser.h"
#include "ui/KeyframeThemeEditor.h"

namespace norvik::ui {

class KeyframeThemeParser : public tarsel::xml::AbstractParseHandler {
 public:
  explicit KeyframeThemeParser(KeyframeThemeEditor* inEditor);

  void StartDocument() override;
  void EndDocument() override;
  void StartElement(std::string_view inName, const tarsel::xml::Attributes& inAttributes) override;
  void EndElement(std::string_view inName) override;
  void Characters(std::string_view) override {}

 private:
  void ReadKeyFrame(const tarsel::xml::Attributes& inAttributes);
  void ReadFontSize(const tarsel::xml::Attributes& inAttributes);

  KeyframeThemeEditor* mEditor;
  std::set<std::uint64_t> mSeenColors;
  bool mInThemeGroup = false;
  float mGroupT = 0;
};

}  // namespace norvik::ui
