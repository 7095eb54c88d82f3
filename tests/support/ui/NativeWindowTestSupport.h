#pragma once
// Fixtures for the native window bridge on the headless window system: a
// manager, the system installed over it, top-level containers placed on the
// virtual screen, and a view that keeps a copy of every event it handles.
#include <functional>
#include <vector>

#include <gtest/gtest.h>

#include "ui/HeadlessWindowSystem.h"
#include "ui/KeyboardEvent.h"
#include "ui/MouseEvent.h"
#include "ui/OS_NodeManager.h"
#include "ui/OS_ViewContainer.h"
#include "ui/UI_SubView.h"

namespace norvik::ui::test {

// Keeps every mouse and keyboard event that reaches it, and answers true.
class InputRecorderView : public UI_SubView {
 public:
  explicit InputRecorderView(const char* inName) { UI_SetNodeID(inName); }

  bool UI_DoMouseEvent(UI_Node* inTarget, const MouseEvent& inEvent) override {
    if (inTarget != this) return false;
    mouse.push_back(inEvent);
    if (onMouse) onMouse(inEvent);
    return true;
  }
  bool UI_DoKeyboardEvent(UI_Node*, const KeyboardEvent& inEvent) override {
    keys.push_back(inEvent);
    return true;
  }
  bool UI_WantsKeyboardFocus() const override { return wantsFocus; }
  bool UI_DoTimerNotify(long inTimerID) override {
    timerFirings.push_back(inTimerID);
    return keepTimers;
  }
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;

  // The events of one action, in order.
  std::vector<MouseEvent> Actions(MouseEvent::Action inAction) const {
    std::vector<MouseEvent> result;
    for (const MouseEvent& e : mouse)
      if (e.GetAction() == inAction) result.push_back(e);
    return result;
  }

  std::vector<MouseEvent> mouse;
  std::vector<KeyboardEvent> keys;
  std::vector<long> timerFirings;
  std::function<void(const MouseEvent&)> onMouse;
  bool wantsFocus = false;
  bool keepTimers = true;
  // When set, the view fills itself with this colour.
  bool paints = false;
  float red = 0, green = 0, blue = 0;
};

using InputRecorderViewP = boost::intrusive_ptr<InputRecorderView>;

class NativeWindowTest : public ::testing::Test {
 protected:
  NativeWindowTest();
  ~NativeWindowTest() override;

  // A shown top-level container whose client area covers inScreenRect, made
  // able to take activation as an application's main window is.
  OS_TopLevelViewContainerP MakeTopLevel(const OS_Rect& inScreenRect);
  // A shown view of the given rectangle under inParent.
  InputRecorderViewP AddView(UI_Node* inParent, const char* inName, float inX, float inY, float inW, float inH);

  OS_NodeManager mManager;
  HeadlessWindowSystem mSystem;
  OS_NativeLayer& mLayer;
};

}  // namespace norvik::ui::test
