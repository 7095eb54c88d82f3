#pragma once
// Fixtures for theme tests: the registry is process-wide, so every test that
// touches it starts and ends with an empty one; and the shared settings file
// is read from a private configuration folder instead of the user's.
#include <cmath>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

#include <gtest/gtest.h>

#include "drawbot/DrawbotTypes.h"
#include "ui/Theme.h"

namespace norvik::ui::test {

class ThemeRegistryTest : public ::testing::Test {
 protected:
  void SetUp() override { Theme::Terminate(); }
  void TearDown() override { Theme::Terminate(); }
};

// Points XDG_CONFIG_HOME at a fresh folder for the life of the object.
class ScPrivateConfigDir {
 public:
  ScPrivateConfigDir() {
    const char* old = std::getenv("XDG_CONFIG_HOME");
    mHadOld = old != nullptr;
    if (old) mOld = old;
    mDir = std::filesystem::temp_directory_path() /
           ("norvik-theme-config-" + std::to_string(reinterpret_cast<std::uintptr_t>(this)));
    std::filesystem::remove_all(mDir);
    std::filesystem::create_directories(mDir);
    setenv("XDG_CONFIG_HOME", mDir.c_str(), 1);
  }
  ~ScPrivateConfigDir() {
    if (mHadOld)
      setenv("XDG_CONFIG_HOME", mOld.c_str(), 1);
    else
      unsetenv("XDG_CONFIG_HOME");
    std::error_code ec;
    std::filesystem::remove_all(mDir, ec);
  }
  void WriteCommonSettings(const std::string& inText) const {
    std::filesystem::create_directories(mDir / "Halvorn" / "Common");
    std::ofstream(mDir / "Halvorn" / "Common" / "Settings.conf") << inText;
  }

 private:
  std::filesystem::path mDir;
  std::string mOld;
  bool mHadOld = false;
};

inline ::testing::AssertionResult ColorNear(const drawbot::ColorRGBA& inActual, const drawbot::ColorRGBA& inExpected,
                                            float inTolerance = 1e-4f) {
  if (std::fabs(inActual.red - inExpected.red) <= inTolerance &&
      std::fabs(inActual.green - inExpected.green) <= inTolerance &&
      std::fabs(inActual.blue - inExpected.blue) <= inTolerance &&
      std::fabs(inActual.alpha - inExpected.alpha) <= inTolerance)
    return ::testing::AssertionSuccess();
  return ::testing::AssertionFailure() << "colour (" << inActual.red << ", " << inActual.green << ", "
                                       << inActual.blue << ", " << inActual.alpha << ") is not ("
                                       << inExpected.red << ", " << inExpected.green << ", " << inExpected.blue
                                       << ", " << inExpected.alpha << ")";
}

inline drawbot::ColorRGBA Grey(float inValue, float inAlpha = 1) {
  return drawbot::ColorRGBA(inValue, inValue, inValue, inAlpha);
}

}  // namespace norvik::ui::test
