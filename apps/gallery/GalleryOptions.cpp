#include "GalleryOptions.h"

#include <cerrno>
#include <cstdlib>

#include "GalleryPage.h"
#include "GalleryStyle.h"
#include "tarsel/UTFString.h"

namespace norvik::gallery {

namespace {

std::string Localized(std::string_view inKey, const std::string& inValue = std::string()) {
  std::string text = tarsel::utility::ToStdString(tarsel::utility::UTF16to8(Text(inKey)));
  const std::size_t at = text.find("^0");
  if (at != std::string::npos) text.replace(at, 2, inValue);
  return text;
}

// A whole decimal number within [inMin, inMax], nothing else.
bool ReadDimension(const std::string& inText, long inMin, long inMax, long& outValue) {
  if (inText.empty() || inText.size() > 6) return false;
  for (char ch : inText)
    if (ch < '0' || ch > '9') return false;
  const long value = std::strtol(inText.c_str(), nullptr, 10);
  if (value < inMin || value > inMax) return false;
  outValue = value;
  return true;
}

}  // namespace

const char* GalleryPageName(GalleryPageID inPage) {
  switch (inPage) {
    case GalleryPageID::kButtons:
      return "buttons";
    case GalleryPageID::kLayout:
      return "layout";
    case GalleryPageID::kNumbers:
      return "numbers";
    case GalleryPageID::kBasics:
      break;
  }
  return "basics";
}

bool ReadGalleryPageName(const std::string& inName, GalleryPageID& outPage) {
  for (GalleryPageID page : {GalleryPageID::kBasics, GalleryPageID::kButtons, GalleryPageID::kLayout,
                              GalleryPageID::kNumbers}) {
    if (inName == GalleryPageName(page)) {
      outPage = page;
      return true;
    }
  }
  return false;
}

bool ParseGalleryOptions(const std::vector<std::string>& inArgs, GalleryOptions& outOptions, std::string& outError) {
  bool sawLook = false;
  for (std::size_t i = 0; i < inArgs.size(); ++i) {
    const std::string& arg = inArgs[i];
    if (arg == "--help" || arg == "-h") {
      outOptions.help = true;
    } else if (arg == "--exit-after-first-frame") {
      outOptions.exitAfterFirstFrame = true;
    } else if (arg == "--light" || arg == "--dark") {
      const bool light = arg == "--light";
      if (sawLook && light != outOptions.light) {
        outError = Localized("$$$/norvik/gallery/Error/BothLooks=--light and --dark cannot be given together.");
        return false;
      }
      sawLook = true;
      outOptions.light = light;
    } else if (arg == "--screenshot" || arg == "--size" || arg == "--page") {
      if (i + 1 >= inArgs.size() || inArgs[i + 1].empty() || inArgs[i + 1].rfind("--", 0) == 0) {
        outError = Localized("$$$/norvik/gallery/Error/MissingValue=^0 needs a value.", arg);
        return false;
      }
      const std::string& value = inArgs[++i];
      if (arg == "--screenshot") {
        outOptions.screenshot = value;
      } else if (arg == "--page") {
        if (!ReadGalleryPageName(value, outOptions.page)) {
          outError = Localized("$$$/norvik/gallery/Error/BadPage=There is no page ^0: the pages are basics, buttons, layout and numbers.",
                               value);
          return false;
        }
      } else {
        const std::size_t x = value.find_first_of("xX");
        long w = 0, h = 0;
        if (x == std::string::npos || !ReadDimension(value.substr(0, x), GalleryPage::kMinWidth, 8192, w) ||
            !ReadDimension(value.substr(x + 1), GalleryPage::kMinHeight, 8192, h)) {
          outError = Localized(
              "$$$/norvik/gallery/Error/BadSize=The size ^0 is not WIDTHxHEIGHT with a width from 860 and a height "
              "from 600 up to 8192 pixels.",
              value);
          return false;
        }
        outOptions.width = w;
        outOptions.height = h;
      }
    } else {
      outError = Localized("$$$/norvik/gallery/Error/UnknownOption=Unknown option ^0 (try --help).", arg);
      return false;
    }
  }
  return true;
}

std::string GalleryUsage() {
  return Localized(
      "$$$/norvik/gallery/Usage=Usage: norvik-gallery [options]\n"
      "Shows the toolkit's views in a window; without a display, or with --screenshot, renders them to a PNG "
      "file and exits.\n"
      "  --screenshot FILE  render through the headless window system to FILE (PNG) and exit\n"
      "  --light            start in the light look\n"
      "  --dark             start in the dark look (the default)\n"
      "  --size WxH         client size of the window in pixels (default 1120x720)\n"
      "  --page NAME        start on the page NAME: basics (the default), buttons, layout or numbers\n"
      "  --exit-after-first-frame  exit once the first frame is shown, printing the time it took\n"
      "  --help             show this text\n");
}

}  // namespace norvik::gallery
