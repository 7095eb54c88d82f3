#pragma once
// Making the platform's native layer without naming the platform: the gallery
// and hosts choose between the X11 port and the headless system here.
#include <memory>

#include "ui/OS_NativeLayer.h"

namespace norvik::ui {

// The X11 native layer on inDisplay (null: $DISPLAY); null when no display
// can be opened.
std::unique_ptr<OS_NativeLayer> CreateX11NativeLayer(const char* inDisplay = nullptr);

}  // namespace norvik::ui
