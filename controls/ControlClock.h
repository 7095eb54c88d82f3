#pragma once
// The time controls measure gestures with (repeat delays, twirls): the
// installed native layer's tick count, so that a headless run follows its
// virtual clock; without a layer, a monotonic clock.
namespace norvik::controls {

// Seconds since an arbitrary origin.
double ControlClockNow();

}  // namespace norvik::controls
