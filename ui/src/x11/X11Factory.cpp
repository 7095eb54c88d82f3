#include "tarsel/ThrowError.h"
#include "ui/NativeLayerFactory.h"
#include "ui/src/x11/OS_NativeLayer_X11.h"

namespace norvik::ui {

std::unique_ptr<OS_NativeLayer> CreateX11NativeLayer(const char* inDisplay) {
  try {
    return std::make_unique<x11::OS_NativeLayer_X11>(inDisplay);
  } catch (const tarsel::config::Exception&) {
    return nullptr;
  }
}

}  // namespace norvik::ui
