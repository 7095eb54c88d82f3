// The command line: defaults, each option, and the messages for bad input.
#include <gtest/gtest.h>

#include "GalleryOptions.h"

namespace norvik::gallery {
namespace {

struct Parsed {
  bool ok;
  GalleryOptions options;
  std::string error;
};

Parsed Parse(std::vector<std::string> inArgs) {
  Parsed p;
  p.ok = ParseGalleryOptions(inArgs, p.options, p.error);
  return p;
}

TEST(GalleryOptions, NoArgumentsShowAWindowInTheDarkLookAtTheDefaultSize) {
  Parsed p = Parse({});
  ASSERT_TRUE(p.ok);
  EXPECT_TRUE(p.options.screenshot.empty());
  EXPECT_FALSE(p.options.light);
  EXPECT_FALSE(p.options.help);
  EXPECT_EQ(p.options.width, 1120);
  EXPECT_EQ(p.options.height, 720);
}

TEST(GalleryOptions, ScreenshotLookAndSizeAreRead) {
  Parsed p = Parse({"--light", "--screenshot", "/tmp/out.png", "--size", "800x600"});
  ASSERT_TRUE(p.ok) << p.error;
  EXPECT_EQ(p.options.screenshot, "/tmp/out.png");
  EXPECT_TRUE(p.options.light);
  EXPECT_EQ(p.options.width, 800);
  EXPECT_EQ(p.options.height, 600);
}

TEST(GalleryOptions, ExitAfterFirstFrameIsOffUnlessAsked) {
  EXPECT_FALSE(Parse({}).options.exitAfterFirstFrame);
  Parsed p = Parse({"--exit-after-first-frame", "--light"});
  ASSERT_TRUE(p.ok) << p.error;
  EXPECT_TRUE(p.options.exitAfterFirstFrame);
  EXPECT_TRUE(p.options.light);
  EXPECT_FALSE(Parse({"--exit-after-first-frame=1"}).ok) << "the option takes no value";
}

TEST(GalleryOptions, HelpIsRecognisedInItsShortAndLongForms) {
  EXPECT_TRUE(Parse({"--help"}).options.help);
  EXPECT_TRUE(Parse({"-h"}).options.help);
  EXPECT_NE(GalleryUsage().find("--screenshot"), std::string::npos);
}

TEST(GalleryOptions, AnUnknownOptionIsRefusedByName) {
  Parsed p = Parse({"--dark", "--fullscreen"});
  EXPECT_FALSE(p.ok);
  EXPECT_NE(p.error.find("--fullscreen"), std::string::npos) << p.error;
}

TEST(GalleryOptions, AnOptionWithoutItsValueIsRefused) {
  for (const char* option : {"--screenshot", "--size"}) {
    Parsed atEnd = Parse({option});
    EXPECT_FALSE(atEnd.ok) << option;
    EXPECT_NE(atEnd.error.find(option), std::string::npos) << atEnd.error;
    EXPECT_FALSE(Parse({option, "--light"}).ok) << option << " must not take the next option as its value";
  }
}

TEST(GalleryOptions, MalformedOrOutOfRangeSizesAreRefusedWithTheValueInTheMessage) {
  for (const char* size : {"800", "x600", "800x", "800x600x2", "-800x600", "80x60", "800x60", "99999x600", "8e2x600",
                           "800 x600", "0x0", "12345678901234567890x600"}) {
    Parsed p = Parse({"--size", size});
    EXPECT_FALSE(p.ok) << size;
    EXPECT_NE(p.error.find(size), std::string::npos) << p.error;
  }
  EXPECT_TRUE(Parse({"--size", "560x420"}).ok) << "the smallest size is accepted";
  EXPECT_TRUE(Parse({"--size", "1920X1080"}).ok);
}

TEST(GalleryOptions, LightAndDarkTogetherAreRefusedButRepeatingOneIsNot) {
  EXPECT_FALSE(Parse({"--light", "--dark"}).ok);
  EXPECT_FALSE(Parse({"--dark", "--light"}).ok);
  Parsed twice = Parse({"--light", "--light"});
  EXPECT_TRUE(twice.ok);
  EXPECT_TRUE(twice.options.light);
}

}  // namespace
}  // namespace norvik::gallery
