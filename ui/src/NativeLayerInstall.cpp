// Installing a native layer, and the focus questions answered through it.
// Written once against OS_NativeLayer, so every port shares it.
#include "ui/InputPlatform.h"
#include "ui/KeyboardLayout.h"
#include "ui/OS_FocusPlatform.h"
#include "ui/OS_NativeLayer.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {
namespace {

// The window property through which a native handle names its window node.
// The value stored under it is the node as a UI_Node*.
const char kWindowNodeProperty[] = "norvik::ui::OS_Window::property";
// Key messages run from key down (256) to the last of the keyboard block (265).
constexpr unsigned kLastKeyMessage = 265;

class NativeFocusPlatform : public OS_FocusPlatform {
 public:
  UI_Node* GetOurWindowNode(OS_WindowHandle inHandle) const override {
    const OS_NativeLayer* layer = GetNativeLayer();
    if (!layer || inHandle == 0 || !layer->IsWindow(inHandle) || !layer->IsWindowOfThisThread(inHandle))
      return nullptr;
    return static_cast<UI_Node*>(layer->GetProperty(inHandle, kWindowNodeProperty));
  }

  bool IsChildWindow(OS_WindowHandle inHandle) const override {
    const OS_NativeLayer* layer = GetNativeLayer();
    return layer && inHandle != 0 && (layer->GetStyle(inHandle) & kOSStyleChild) != 0;
  }

  OS_WindowHandle GetParentWindow(OS_WindowHandle inHandle) const override {
    const OS_NativeLayer* layer = GetNativeLayer();
    return layer && inHandle != 0 ? layer->GetParent(inHandle) : 0;
  }

  void RemovePendingKeyMessages() override {
    OS_NativeLayer* layer = GetNativeLayer();
    if (!layer) return;
    OS_Event removed;
    while (layer->PeekMessage(removed, 0, kOSMsgKeyDown, kLastKeyMessage, true)) {
    }
  }
};

}  // namespace

OS_FocusPlatform& GetNativeFocusPlatform() {
  static NativeFocusPlatform sPlatform;
  return sPlatform;
}

void InstallNativeLayer(OS_NativeLayer* inLayer) {
  SetNativeLayer(inLayer);
  // With no installed answers, the input questions go to the native layer.
  SetInputPlatform(nullptr);
  SetKeyboardLayout(inLayer ? inLayer->GetKeyboardLayout() : nullptr);
  if (UI_NodeManager* manager = UI_NodeManager::Get(true))
    manager->SetFocusPlatform(inLayer ? &GetNativeFocusPlatform() : nullptr);
}

}  // namespace norvik::ui
