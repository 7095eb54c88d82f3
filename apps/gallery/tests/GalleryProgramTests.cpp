// The program as a user runs it: exit codes, messages for bad options, and
// the screenshot it writes without a display.
#include <sys/wait.h>

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

#include <gtest/gtest.h>

namespace {

struct ProgramRun {
  int exitCode = -1;
  std::string output;  // stdout and stderr together
};

ProgramRun RunGallery(const std::string& inArgs) {
  // No display: the program must not depend on one being there.
  const std::string command = "env -u DISPLAY '" + std::string(NORVIK_GALLERY_EXE) + "' " + inArgs + " 2>&1";
  ProgramRun run;
  FILE* pipe = popen(command.c_str(), "r");
  if (!pipe) return run;
  char buffer[512];
  while (std::fgets(buffer, sizeof buffer, pipe)) run.output += buffer;
  const int status = pclose(pipe);
  run.exitCode = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
  return run;
}

// Width and height from a PNG's header chunk; false when the file is no PNG.
bool ReadPNGSize(const std::string& inPath, unsigned& outWidth, unsigned& outHeight) {
  std::ifstream in(inPath, std::ios::binary);
  unsigned char header[24] = {};
  if (!in.read(reinterpret_cast<char*>(header), sizeof header)) return false;
  static const unsigned char kSignature[8] = {0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
  if (!std::equal(kSignature, kSignature + 8, header) || std::string(header + 12, header + 16) != "IHDR") return false;
  auto word = [&](int at) {
    return (unsigned(header[at]) << 24) | (unsigned(header[at + 1]) << 16) | (unsigned(header[at + 2]) << 8) |
           unsigned(header[at + 3]);
  };
  outWidth = word(16);
  outHeight = word(20);
  return true;
}

class GalleryProgram : public ::testing::Test {
 protected:
  void SetUp() override {
    dir = std::filesystem::path(NORVIK_TEST_OUTPUT_DIR) / "program";
    std::filesystem::create_directories(dir);
  }
  std::filesystem::path dir;
};

TEST_F(GalleryProgram, ScreenshotWritesAPNGOfTheRequestedSizeAndExitsZero) {
  const std::string path = (dir / "shot.png").string();
  std::filesystem::remove(path);
  ProgramRun run = RunGallery("--screenshot '" + path + "' --size 900x640 --light");
  EXPECT_EQ(run.exitCode, 0) << run.output;
  unsigned w = 0, h = 0;
  ASSERT_TRUE(ReadPNGSize(path, w, h)) << run.output;
  EXPECT_EQ(w, 900u);
  EXPECT_EQ(h, 640u);
}

TEST_F(GalleryProgram, TheTwoLooksGiveDifferentImages) {
  const std::string dark = (dir / "dark.png").string(), light = (dir / "light.png").string();
  ASSERT_EQ(RunGallery("--dark --screenshot '" + dark + "'").exitCode, 0);
  ASSERT_EQ(RunGallery("--light --screenshot '" + light + "'").exitCode, 0);
  std::ifstream a(dark, std::ios::binary), b(light, std::ios::binary);
  const std::string darkBytes((std::istreambuf_iterator<char>(a)), {}), lightBytes((std::istreambuf_iterator<char>(b)), {});
  EXPECT_FALSE(darkBytes.empty());
  EXPECT_NE(darkBytes, lightBytes);
}

TEST_F(GalleryProgram, ExitAfterFirstFrameTellsTheTimeToTheFirstFrame) {
  const std::string path = (dir / "first.png").string();
  ProgramRun run = RunGallery("--exit-after-first-frame --screenshot '" + path + "'");
  EXPECT_EQ(run.exitCode, 0) << run.output;
  const std::string prefix = "First frame after ";
  const std::size_t at = run.output.find(prefix);
  ASSERT_NE(at, std::string::npos) << run.output;
  const double ms = std::strtod(run.output.c_str() + at + prefix.size(), nullptr);
  EXPECT_GT(ms, 0.0) << run.output;
  EXPECT_NE(run.output.find(" ms.", at), std::string::npos) << run.output;
  unsigned w = 0, h = 0;
  EXPECT_TRUE(ReadPNGSize(path, w, h)) << "the image is still written";
}

TEST_F(GalleryProgram, PageButtonsRendersTheButtonsPageInEitherLook) {
  const std::string basics = (dir / "basics-light.png").string(), buttons = (dir / "buttons-light.png").string(),
                    dark = (dir / "buttons-dark.png").string();
  ASSERT_EQ(RunGallery("--screenshot '" + basics + "' --light").exitCode, 0);
  ProgramRun run = RunGallery("--screenshot '" + buttons + "' --page buttons --light");
  EXPECT_EQ(run.exitCode, 0) << run.output;
  EXPECT_NE(run.output.find(buttons), std::string::npos) << run.output;
  ASSERT_EQ(RunGallery("--page buttons --screenshot '" + dark + "'").exitCode, 0);
  unsigned w = 0, h = 0;
  ASSERT_TRUE(ReadPNGSize(buttons, w, h));
  EXPECT_EQ(w, 1120u);
  EXPECT_EQ(h, 720u);
  auto bytes = [](const std::string& inPath) {
    std::ifstream in(inPath, std::ios::binary);
    return std::string((std::istreambuf_iterator<char>(in)), {});
  };
  EXPECT_NE(bytes(basics), bytes(buttons)) << "another page";
  EXPECT_NE(bytes(buttons), bytes(dark)) << "another look";
}

TEST_F(GalleryProgram, AnUnknownPageExitsTwoNamingItAndWritesNothing) {
  const std::string path = (dir / "no-page.png").string();
  std::filesystem::remove(path);
  ProgramRun run = RunGallery("--screenshot '" + path + "' --page sliders");
  EXPECT_EQ(run.exitCode, 2);
  EXPECT_NE(run.output.find("norvik-gallery: There is no page sliders"), std::string::npos) << run.output;
  EXPECT_FALSE(std::filesystem::exists(path));
}

TEST_F(GalleryProgram, HelpPrintsTheOptionsAndExitsZero) {
  ProgramRun run = RunGallery("--help");
  EXPECT_EQ(run.exitCode, 0);
  for (const char* option :
       {"--screenshot", "--light", "--dark", "--size", "--exit-after-first-frame", "--page", "--help"})
    EXPECT_NE(run.output.find(option), std::string::npos) << option;
}

TEST_F(GalleryProgram, BadOptionsExitTwoWithAMessageAndWriteNothing) {
  const std::string path = (dir / "never.png").string();
  std::filesystem::remove(path);
  for (const std::string& args : {std::string("--bogus"), "--size 10x10 --screenshot '" + path + "'",
                                  std::string("--screenshot"), std::string("--light --dark")}) {
    ProgramRun run = RunGallery(args);
    EXPECT_EQ(run.exitCode, 2) << args;
    EXPECT_NE(run.output.find("norvik-gallery: "), std::string::npos) << run.output;
  }
  EXPECT_FALSE(std::filesystem::exists(path));
}

TEST_F(GalleryProgram, AnUnwritableScreenshotPathExitsOneWithTheReason) {
  const std::string path = (dir / "no-such-folder" / "shot.png").string();
  ProgramRun run = RunGallery("--screenshot '" + path + "'");
  EXPECT_EQ(run.exitCode, 1);
  EXPECT_NE(run.output.find(path), std::string::npos) << run.output;
}

}  // namespace
