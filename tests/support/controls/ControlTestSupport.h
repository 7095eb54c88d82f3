#pragma once
// A fixture for control tests: a node manager, the headless window system
// installed for its virtual clock and input answers, and a window-like root
// (200 x 200) whose timers the test fires by hand. Listeners record the
// messages they hear as short texts, in order.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "controls/ControlMessages.h"
#include "controls/UI_InteractiveControlView.h"
#include "support/ui/DispatchTestNodes.h"
#include "support/ui/FocusTestNodes.h"
#include "ui/HeadlessWindowSystem.h"
#include "ui/UI_NodeManager.h"

namespace norvik::controls::test {

using PointF = tarsel::geom::PointT<float>;
using RectF = tarsel::geom::RectT<float>;

// "begin", "continue", "finish", "cancel", "changed", "hover".
class MessageLog {
 public:
  void Listen(UI_InteractiveControlView& inControl);
  void ListenChanged(UI_ControlView& inControl);
  std::vector<std::string> entries;
  std::vector<ModKeys> changedKeys;
};

class ControlTest : public ::testing::Test {
 protected:
  ControlTest();
  ~ControlTest() override;

  template <class T>
  boost::intrusive_ptr<T> Add(T* inControl, const RectF& inRect) {
    boost::intrusive_ptr<T> control(inControl);
    control->UI_SetLocalRectF(inRect);
    control->UI_Show(true);
    root->ChildPushBack(control);
    return control;
  }
  bool Mouse(ui::MouseEvent::Action inAction, const PointF& inPoint, ModKeys inMods = {});
  bool Press(const PointF& inPoint) { return Mouse(ui::MouseEvent::kActionButtonDown, inPoint); }
  bool Drag(const PointF& inPoint) { return Mouse(ui::MouseEvent::kActionMove, inPoint); }
  bool Release(const PointF& inPoint, ModKeys inMods = {}) {
    return Mouse(ui::MouseEvent::kActionButtonUp, inPoint, inMods);
  }
  bool KeyDown(ui::UI_Node* inNode, short inOSCode, unsigned short inChar, ModKeys inMods = {});
  bool KeyUp(ui::UI_Node* inNode, short inOSCode, unsigned short inChar, ModKeys inMods = {});
  // Moves the virtual clock, then fires each timer of inNode once.
  void AdvanceAndFireTimers(ui::UI_Node* inNode, unsigned inMilliseconds);
  std::size_t TimerCount() { return root->Timers().GetTimerCount(); }

  ui::UI_NodeManager manager;
  ui::HeadlessWindowSystem system;
  boost::intrusive_ptr<ui::test::TestWindowNode> root;
  MessageLog log;
};

}  // namespace norvik::controls::test
