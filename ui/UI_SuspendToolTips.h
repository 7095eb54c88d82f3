#pragma once
// Keeps tool tips from showing while it lives: on construction it takes down
// the tip on screen, and until the last suspension ends no tip is displayed.
// Gestures hold one from begin to end.
#include <boost/noncopyable.hpp>

namespace norvik::ui {

class UI_ToolTipManager;

class UI_SuspendToolTips : private boost::noncopyable {
 public:
  // inManager may be null when the platform has no tool tips.
  explicit UI_SuspendToolTips(UI_ToolTipManager* inManager);
  ~UI_SuspendToolTips();

  // Whether any suspension is alive.
  static bool IsSuspended() { return sSuspendCount > 0; }

 private:
  static int sSuspendCount;
};

}  // namespace norvik::ui
