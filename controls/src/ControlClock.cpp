#include "controls/ControlClock.h"

#include <chrono>

#include "ui/OS_NativeLayer.h"

namespace norvik::controls {

double ControlClockNow() {
  if (const ui::OS_NativeLayer* layer = ui::GetNativeLayer())
    return static_cast<double>(layer->GetTickCount()) / 1000.0;
  using Clock = std::chrono::steady_clock;
  return std::chrono::duration<double>(Clock::now().time_since_epoch()).count();
}

}  // namespace norvik::controls
