// Theme key-frame documents from outside (a host's own theme files): loading
// may refuse a document only with the toolkit's exception, a refused document
// leaves the theme as it was, and an accepted one gives every colour it names
// finite components at any brightness. The first byte picks strict mode.
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string_view>

#include "tarsel/ThrowError.h"
#include "ui/KeyframeThemeEditor.h"

namespace {

void Fail(char const* inWhat) {
  std::fprintf(stderr, "%s\n", inWhat);
  std::abort();
}

bool Finite(norvik::drawbot::ColorRGBA const& inColor) {
  return std::isfinite(inColor.red) && std::isfinite(inColor.green) && std::isfinite(inColor.blue) &&
         std::isfinite(inColor.alpha);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* inData, std::size_t inSize) {
  using namespace norvik::ui;
  if (inSize == 0) return 0;
  const std::string_view text(reinterpret_cast<const char*>(inData) + 1, inSize - 1);
  KeyframeThemeEditorP theme(new KeyframeThemeEditor());
  theme->SetStrictMode((inData[0] & 1) != 0);
  theme->LoadKeyframes(R"(<ThemeColors><KeyFrame name="5" t="0" v="0.5"/><FontSize name="0" scheme="0" size="12"/>
    </ThemeColors>)");
  const KeyframeThemeEditor::ColorTracks colors = theme->GetColorTracks();
  const KeyframeThemeEditor::FontSizeTracks fonts = theme->GetFontSizeTracks();
  try {
    theme->LoadKeyframes(text);
  } catch (const tarsel::config::Exception&) {
    if (theme->GetColorTracks() != colors || theme->GetFontSizeTracks() != fonts)
      Fail("a refused document changed the theme");
    return 0;
  }
  for (float brightness : {0.0f, 0.37f, 1.0f}) {
    theme->SetBrightness(brightness);
    for (const auto& track : theme->GetColorTracks())
      if (!Finite(theme->GetColor(track.first))) Fail("a colour of an accepted document is not finite");
  }
  return 0;
}
