#include "ui/InputPlatform.h"

namespace norvik::ui {
namespace {

class QuietInputPlatform : public InputPlatformInterface {
 public:
  ModifierKeys GetRecentEventModKeys() const override { return {}; }
  ModifierKeys GetCurrentModKeys() const override { return {}; }
  bool RemovePendingMessage(OS_WindowHandle, unsigned) override { return false; }
};

InputPlatformInterface* sInstalledPlatform = nullptr;

}  // namespace

InputPlatformInterface& GetInputPlatform() {
  static QuietInputPlatform sQuiet;
  return sInstalledPlatform ? *sInstalledPlatform : sQuiet;
}

void SetInputPlatform(InputPlatformInterface* inPlatform) { sInstalledPlatform = inPlatform; }

}  // namespace norvik::ui

namespace norvik::utility {

ui::ModifierKeys GetRecentEventModKeys() { return ui::GetInputPlatform().GetRecentEventModKeys(); }
ui::ModifierKeys GetCurrentModKeys() { return ui::GetInputPlatform().GetCurrentModKeys(); }

}  // namespace norvik::utility
