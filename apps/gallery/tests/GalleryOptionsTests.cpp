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
  EXPECT_EQ(p.options.page, GalleryPageID::kBasics);
}

TEST(GalleryOptions, ScreenshotLookAndSizeAreRead) {
  Parsed p = Parse({"--light", "--screenshot", "/tmp/out.png", "--size", "900x640"});
  ASSERT_TRUE(p.ok) << p.error;
  EXPECT_EQ(p.options.screenshot, "/tmp/out.png");
  EXPECT_TRUE(p.options.light);
  EXPECT_EQ(p.options.width, 900);
  EXPECT_EQ(p.options.height, 640);
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
                           "800 x600", "859x600", "860x599", "0x0", "12345678901234567890x600"}) {
    Parsed p = Parse({"--size", size});
    EXPECT_FALSE(p.ok) << size;
    EXPECT_NE(p.error.find(size), std::string::npos) << p.error;
  }
  EXPECT_TRUE(Parse({"--size", "860x600"}).ok) << "the smallest size is accepted";
  EXPECT_TRUE(Parse({"--size", "1920X1080"}).ok);
}

TEST(GalleryOptions, LightAndDarkTogetherAreRefusedButRepeatingOneIsNot) {
  EXPECT_FALSE(Parse({"--light", "--dark"}).ok);
  EXPECT_FALSE(Parse({"--dark", "--light"}).ok);
  Parsed twice = Parse({"--light", "--light"});
  EXPECT_TRUE(twice.ok);
  EXPECT_TRUE(twice.options.light);
}

TEST(GalleryOptions, PageNamesEitherPageAndTheLastOneCounts) {
  Parsed buttons = Parse({"--screenshot", "/tmp/b.png", "--page", "buttons", "--light"});
  ASSERT_TRUE(buttons.ok) << buttons.error;
  EXPECT_EQ(buttons.options.page, GalleryPageID::kButtons);
  EXPECT_TRUE(buttons.options.light);
  EXPECT_EQ(buttons.options.screenshot, "/tmp/b.png");
  EXPECT_EQ(Parse({"--page", "numbers"}).options.page, GalleryPageID::kNumbers);
  Parsed back = Parse({"--page", "buttons", "--page", "basics"});
  ASSERT_TRUE(back.ok);
  EXPECT_EQ(back.options.page, GalleryPageID::kBasics);
  EXPECT_NE(GalleryUsage().find("--page"), std::string::npos);
}

TEST(GalleryOptions, AnUnknownPageIsRefusedWithItsNameAndThePagesThereAre) {
  for (const char* name : {"Buttons", "button", "sliders", " buttons", "buttons2"}) {
    Parsed p = Parse({"--page", name});
    EXPECT_FALSE(p.ok) << name;
    EXPECT_NE(p.error.find(std::string("page ") + name + ":"), std::string::npos) << p.error;
    EXPECT_NE(p.error.find("basics, buttons, layout and numbers"), std::string::npos) << p.error;
  }
  Parsed missing = Parse({"--page"});
  EXPECT_FALSE(missing.ok);
  EXPECT_NE(missing.error.find("--page"), std::string::npos) << missing.error;
  EXPECT_FALSE(Parse({"--page", "--light"}).ok) << "the next option is no page name";
}

TEST(GalleryOptions, PageNamesReadBackAsThemselves) {
  for (GalleryPageID page : {GalleryPageID::kBasics, GalleryPageID::kButtons}) {
    GalleryPageID read = page == GalleryPageID::kBasics ? GalleryPageID::kButtons : GalleryPageID::kBasics;
    ASSERT_TRUE(ReadGalleryPageName(GalleryPageName(page), read));
    EXPECT_EQ(read, page);
  }
  GalleryPageID untouched = GalleryPageID::kButtons;
  EXPECT_FALSE(ReadGalleryPageName("", untouched));
  EXPECT_EQ(untouched, GalleryPageID::kButtons);
}

}  // namespace
}  // namespace norvik::gallery
