#pragma once
// The gallery's command line.
#include <string>
#include <vector>

namespace norvik::gallery {

// The pages of the gallery, and their names on the command line.
enum class GalleryPageID { kBasics, kButtons, kLayout, kNumbers };
const char* GalleryPageName(GalleryPageID inPage);
// False, leaving outPage alone, for a name that is no page.
bool ReadGalleryPageName(const std::string& inName, GalleryPageID& outPage);

struct GalleryOptions {
  std::string screenshot;  // write this PNG and exit; empty: show a window when a display opens
  bool light = false;
  GalleryPageID page = GalleryPageID::kBasics;
  long width = 1120;
  long height = 720;
  bool help = false;
  // Quit once the window's first frame is on the screen, printing how long
  // the program took to get there.
  bool exitAfterFirstFrame = false;
};

// Exit codes of the program.
enum GalleryExitCode { kExitOK = 0, kExitFailure = 1, kExitUsage = 2 };

// Reads the arguments after the program name. On a bad argument, answers
// false with a message naming it in outError.
bool ParseGalleryOptions(const std::vector<std::string>& inArgs, GalleryOptions& outOptions, std::string& outError);

// The text --help prints.
std::string GalleryUsage();

}  // namespace norvik::gallery
