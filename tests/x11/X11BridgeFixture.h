#pragma once
// Node trees in real windows: a node manager, the X11 native layer on a
// private Xvfb installed as the toolkit's platform, and a user at the server
// through XTEST. Tests wait for what they expect by pumping the layer's loop
// for a bounded time, never by sleeping a fixed time.
#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <vector>

#include "support/ui/NativeWindowTestSupport.h"
#include "ui/KeyboardEvent.h"
#include "ui/OS_NativeLayer.h"
#include "ui/OS_NodeManager.h"
#include "ui/OS_ViewContainer.h"
#include "ui/UI_SubView.h"
#include "x11/XTestUser.h"

namespace norvik::test {

// A view that takes focus by click and by Tab and keeps every key event it
// sees, leaving them unanswered so that Tab goes on to its window.
class KeyLogView : public ui::UI_SubView {
 public:
  explicit KeyLogView(const char* inName) { UI_SetNodeID(inName); }
  bool UI_WantsKeyboardFocus() const override { return true; }
  bool UI_WantsKeyboardFocusFromAdvance() const override { return true; }
  bool UI_DoKeyboardEvent(ui::UI_Node*, const ui::KeyboardEvent& inEvent) override {
    keys.push_back(inEvent);
    return false;
  }
  // The events of one action, in order.
  std::vector<ui::KeyboardEvent> Actions(ui::KeyboardEvent::Action inAction) const {
    std::vector<ui::KeyboardEvent> result;
    for (const ui::KeyboardEvent& e : keys)
      if (e.GetAction() == inAction) result.push_back(e);
    return result;
  }
  std::vector<ui::KeyboardEvent> keys;
};

using KeyLogViewP = boost::intrusive_ptr<KeyLogView>;

class X11BridgeTest : public ::testing::Test {
 protected:
  void SetUp() override;
  void TearDown() override;

  // A shown top-level container whose client area covers inScreenRect, able
  // to take activation as an application's main window is, and active.
  ui::OS_TopLevelViewContainerP MakeMainWindow(const ui::OS_Rect& inScreenRect);
  // A shown view of the given rectangle appended to inParent.
  template <class T>
  boost::intrusive_ptr<T> Add(ui::UI_Node* inParent, T* inView, float inX, float inY, float inW, float inH) {
    boost::intrusive_ptr<T> view(inView);
    view->UI_SetLocalRectF(ui::UI_Node::RectF(inX, inY, inW, inH));
    view->UI_Show(true);
    inParent->ChildPushBack(view);
    return view;
  }
  ui::test::InputRecorderViewP AddRecorder(ui::UI_Node* inParent, const char* inName, float inX, float inY, float inW,
                                           float inH) {
    return Add(inParent, new ui::test::InputRecorderView(inName), inX, inY, inW, inH);
  }
  // The screen point of a point in a node's own coordinates.
  ui::OS_Point ScreenPoint(const ui::UI_Node* inNode, long inX, long inY) const;

  // Pumps the layer until inCondition holds; false after inMilliseconds.
  bool WaitFor(const std::function<bool()>& inCondition, int inMilliseconds = 3000);
  // Pumps for a while so that whatever is in flight arrives.
  void Settle(int inMilliseconds = 100);
  // The pixel at a point of the screen, read back from the server, as 0xRRGGBB.
  std::uint32_t ScreenPixel(int inX, int inY);

  ui::OS_NodeManager mManager;
  std::unique_ptr<ui::OS_NativeLayer> mLayer;
  std::unique_ptr<XTestUser> mUser;
};

}  // namespace norvik::test
