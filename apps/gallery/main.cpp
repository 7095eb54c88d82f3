// The gallery: the toolkit's own program, one window whose page shows what
// the toolkit can do. With --screenshot, or where no display opens, it
// renders the page through the headless window system to a PNG and exits.
#include <chrono>
#include <cstdio>
#include <exception>
#include <memory>
#include <string>
#include <vector>

#include "GalleryOptions.h"
#include "GalleryPage.h"
#include "GalleryWindow.h"
#include "tarsel/ThrowError.h"
#include "ui/HeadlessWindowSystem.h"
#include "ui/KeyframeThemeEditor.h"
#include "ui/NativeLayerFactory.h"
#include "ui/OS_NodeManager.h"
#include "ui/Theme.h"

namespace {

using namespace norvik;

std::string Say(std::string_view inKey, const std::string& inValue = std::string()) {
  std::string text = tarsel::utility::ToStdString(tarsel::utility::UTF16to8(gallery::Text(inKey)));
  const std::size_t at = text.find("^0");
  if (at != std::string::npos) text.replace(at, 2, inValue);
  return text;
}

// Taken while the program's static objects are made, before main runs: the
// start from which the time to the first frame is told.
const std::chrono::steady_clock::time_point kProgramStart = std::chrono::steady_clock::now();

void ReportFirstFrame() {
  const double ms = std::chrono::duration<double, std::milli>(std::chrono::steady_clock::now() - kProgramStart).count();
  char value[32];
  std::snprintf(value, sizeof value, "%.1f", ms);
  std::printf("%s\n", Say("$$$/norvik/gallery/FirstFrame=First frame after ^0 ms.", value).c_str());
  std::fflush(stdout);
}

// Renders the page in a headless window and writes the window's pixels.
int RenderToPNG(const gallery::GalleryOptions& inOptions, ui::KeyframeThemeEditorP inTheme, const std::string& inPath) {
  ui::HeadlessWindowSystem system;
  system.Install();
  int result = gallery::kExitOK;
  {
    gallery::GalleryPageP page(new gallery::GalleryPage(inTheme, inOptions.light));
    page->ShowPage(inOptions.page);
    gallery::GalleryWindowP window(new gallery::GalleryWindow(page, inOptions.width, inOptions.height));
    if (inOptions.exitAfterFirstFrame) window->SetFirstFrameFunction(&ReportFirstFrame);
    system.Pump();
    window->UI_UpdateNow(norvik::ui::UI_Node::kUpdateNowImmediate);
    if (!system.WriteWindowPNG(window->GetHandle(), inPath)) {
      std::fprintf(stderr, "%s\n", Say("$$$/norvik/gallery/Error/WritePNG=Could not write the image ^0.", inPath).c_str());
      result = gallery::kExitFailure;
    } else {
      std::printf("%s\n", Say("$$$/norvik/gallery/Wrote=Wrote ^0.", inPath).c_str());
    }
  }
  system.Uninstall();
  return result;
}

// Shows the page in a window on the display until the window is closed, or
// until its first frame is shown when that is all that was asked.
int ShowOnDisplay(ui::OS_NativeLayer& inLayer, const gallery::GalleryOptions& inOptions,
                  ui::KeyframeThemeEditorP inTheme) {
  ui::InstallNativeLayer(&inLayer);
  int result = gallery::kExitOK;
  {
    gallery::GalleryPageP page(new gallery::GalleryPage(inTheme, inOptions.light));
    page->ShowPage(inOptions.page);
    gallery::GalleryWindowP window(new gallery::GalleryWindow(page, inOptions.width, inOptions.height));
    if (inOptions.exitAfterFirstFrame)
      window->SetFirstFrameFunction([&inLayer] {
        ReportFirstFrame();
        inLayer.QuitLoop(gallery::kExitOK);
      });
    result = window->Run();
  }
  ui::InstallNativeLayer(nullptr);
  return result;
}

}  // namespace

int main(int argc, char** argv) {
  gallery::GalleryOptions options;
  std::string error;
  if (!gallery::ParseGalleryOptions(std::vector<std::string>(argv + 1, argv + argc), options, error)) {
    std::fprintf(stderr, "norvik-gallery: %s\n", error.c_str());
    return gallery::kExitUsage;
  }
  if (options.help) {
    std::printf("%s", gallery::GalleryUsage().c_str());
    return gallery::kExitOK;
  }
  try {
    ui::OS_NodeManager manager;
    ui::KeyframeThemeEditorP theme = ui::MakeDefaultKeyframeTheme();
    ui::Theme::Initialize(theme);
    std::string path = options.screenshot;
    if (path.empty()) {
      if (std::unique_ptr<ui::OS_NativeLayer> display = ui::CreateX11NativeLayer()) {
        const int result = ShowOnDisplay(*display, options, theme);
        ui::Theme::Terminate();
        return result;
      }
      path = "norvik-gallery.png";
      std::printf("%s\n", Say("$$$/norvik/gallery/NoDisplay=No display to show a window on: rendering to ^0 instead.",
                              path)
                              .c_str());
    }
    const int result = RenderToPNG(options, theme, path);
    ui::Theme::Terminate();
    return result;
  } catch (const tarsel::config::Exception& e) {
    std::fprintf(stderr, "norvik-gallery: %s\n", e.what());
  } catch (const std::exception& e) {
    std::fprintf(stderr, "norvik-gallery: %s\n", e.what());
  }
  return gallery::kExitFailure;
}
