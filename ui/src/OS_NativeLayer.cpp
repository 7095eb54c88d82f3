#include "ui/OS_NativeLayer.h"

namespace norvik::ui {
namespace {
OS_NativeLayer* gNativeLayer = nullptr;
}

OS_NativeLayer* GetNativeLayer() { return gNativeLayer; }
void SetNativeLayer(OS_NativeLayer* inLayer) { gNativeLayer = inLayer; }

}  // namespace norvik::ui
