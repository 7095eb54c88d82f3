#include "ui/InputPlatform.h"

#include "ui/OS_NativeLayer.h"

namespace norvik::ui {
namespace {

constexpr short kKeyDownBit = static_cast<short>(0x8000);
constexpr short kKeyToggledBit = 1;

// Reads the modifiers from a key-state function of the native layer: Shift,
// Ctrl and Alt held, Caps Lock toggled (always from the message's state).
template <typename KeyState>
ModifierKeys ReadModKeys(const OS_NativeLayer& inLayer, KeyState inKeyState) {
  ModifierKeys keys;
  if ((inKeyState(kOSKeyShift) & kKeyDownBit) != 0) keys.Set(kModKeyShift);
  if ((inKeyState(kOSKeyControl) & kKeyDownBit) != 0) keys.Set(kModKeyCtrl);
  if ((inKeyState(kOSKeyAlt) & kKeyDownBit) != 0) keys.Set(kModKeyAlt);
  if ((inLayer.GetKeyState(kOSKeyCapsLock) & kKeyToggledBit) != 0) keys.Set(kModKeyCapsLock);
  return keys;
}

class NativeInputPlatform : public InputPlatformInterface {
 public:
  ModifierKeys GetRecentEventModKeys() const override {
    const OS_NativeLayer* layer = GetNativeLayer();
    if (!layer) return {};
    return ReadModKeys(*layer, [layer](int inKey) { return layer->GetKeyState(inKey); });
  }
  ModifierKeys GetCurrentModKeys() const override {
    const OS_NativeLayer* layer = GetNativeLayer();
    if (!layer) return {};
    return ReadModKeys(*layer, [layer](int inKey) { return layer->GetAsyncKeyState(inKey); });
  }
  bool RemovePendingMessage(OS_WindowHandle inWindow, unsigned inMessage) override {
    OS_NativeLayer* layer = GetNativeLayer();
    OS_Event removed;
    return layer && layer->PeekMessage(removed, inWindow, inMessage, inMessage, true);
  }
  void SetDefaultCursor() override {
    if (OS_NativeLayer* layer = GetNativeLayer()) layer->SetCursor(layer->LoadSystemCursor(kOSCursorArrow));
  }
};

InputPlatformInterface* sInstalledPlatform = nullptr;

}  // namespace

InputPlatformInterface& GetInputPlatform() {
  static NativeInputPlatform sNative;
  return sInstalledPlatform ? *sInstalledPlatform : sNative;
}

void SetInputPlatform(InputPlatformInterface* inPlatform) { sInstalledPlatform = inPlatform; }

}  // namespace norvik::ui

namespace norvik::utility {

ui::ModifierKeys GetRecentEventModKeys() { return ui::GetInputPlatform().GetRecentEventModKeys(); }
ui::ModifierKeys GetCurrentModKeys() { return ui::GetInputPlatform().GetCurrentModKeys(); }

}  // namespace norvik::utility
