// Through real windows: a gesture's capture following the pointer outside
// its window until the release, node timers on the real loop, and a popup
// container opening above its owner without taking activation or focus.
#include <xcb/xcb.h>

#include <chrono>
#include <cstdlib>

#include "ui/InputCapture.h"
#include "ui/OS_ViewContainer.h"
#include "ui/UI_NodeManager.h"
#include "x11/X11BridgeFixture.h"

namespace norvik::test {
namespace {

using namespace norvik::ui;

// A gesture that keeps what it receives and lets the release end it.
class LoggingCapture : public InputCapture {
 public:
  LoggingCapture(boost::intrusive_ptr<UI_Node> inNode, const MouseEvent& inEvent) : InputCapture(inNode, inEvent) {}
  bool DoMouseEvent(const MouseEvent& inEvent) override {
    events.push_back(inEvent);
    return inEvent.GetAction() != MouseEvent::kActionButtonUp;
  }
  void End() override { ended = true; }
  std::vector<MouseEvent> events;
  bool ended = false;
};

// A view that begins a gesture when pressed, as a slider's thumb does. The
// view keeps the gesture for the test and the gesture keeps the view, so the
// test lets go of it at the end (ForgetCapture).
class DragView : public UI_SubView {
 public:
  bool UI_DoMouseEvent(UI_Node*, const MouseEvent& inEvent) override {
    if (inEvent.GetAction() != MouseEvent::kActionButtonDown) return false;
    capture.reset(new LoggingCapture(this, inEvent));
    UI_NodeManager::Get()->BeginInputCapture(capture);
    return true;
  }
  boost::intrusive_ptr<LoggingCapture> capture;
};

struct ForgetCapture {
  ~ForgetCapture() { view->capture.reset(); }
  DragView* view;
};

using X11BridgeCapture = X11BridgeTest;

TEST_F(X11BridgeCapture, AGestureFollowsThePointerOutsideItsWindowAndEndsOnRelease) {
  auto window = MakeMainWindow(OS_Rect(100, 100, 300, 200));
  auto thumb = Add(window.get(), new DragView, 50, 40, 40, 40);
  const ForgetCapture forget{thumb.get()};
  auto other = AddRecorder(window.get(), "other", 200, 0, 100, 200);
  mUser->MovePointer(100 + 60, 100 + 50);
  mUser->Button(1, true);
  ASSERT_TRUE(WaitFor([&] { return thumb->capture != nullptr; }));
  EXPECT_EQ(mLayer->GetCapture(), window->GetHandle()) << "the window holds the pointer grab";

  mUser->MovePointer(700, 600);
  ASSERT_TRUE(WaitFor([&] {
    return !thumb->capture->events.empty() && thumb->capture->events.back().GetPosition().x == 700 - 150;
  }));
  const MouseEvent outside = thumb->capture->events.back();
  EXPECT_EQ(outside.GetAction(), MouseEvent::kActionMove);
  EXPECT_FLOAT_EQ(outside.GetPosition().y, 600.0f - 140.0f) << "positions are in the thumb's coordinates";
  EXPECT_TRUE(outside.IsButton(MouseEvent::kButtonLeft)) << "the button is still held";
  // Crossing another node on the way back does not reach it while the gesture runs.
  mUser->MovePointer(100 + 250, 100 + 50);
  ASSERT_TRUE(WaitFor([&] { return thumb->capture->events.back().GetPosition().x == 250 - 50; }));
  EXPECT_TRUE(other->mouse.empty());

  mUser->Button(1, false);
  ASSERT_TRUE(WaitFor([&] { return thumb->capture->ended; }));
  EXPECT_EQ(thumb->capture->events.back().GetAction(), MouseEvent::kActionButtonUp);
  EXPECT_FALSE(thumb->capture->HasBeenCancelled());
  EXPECT_EQ(mManager.GetInputCapture(), nullptr);
  EXPECT_EQ(mLayer->GetCapture(), 0u) << "the grab ends with the gesture";

  // Afterwards the pointer reaches nodes again.
  mUser->Click(100 + 250, 100 + 60);
  ASSERT_TRUE(WaitFor([&] { return !other->Actions(MouseEvent::kActionButtonDown).empty(); }));
}

TEST_F(X11BridgeCapture, ANodeTimerFiresOnTheRealLoopUntilRemoved) {
  auto window = MakeMainWindow(OS_Rect(0, 0, 200, 200));
  auto view = AddRecorder(window.get(), "view", 0, 0, 100, 100);
  const auto start = std::chrono::steady_clock::now();
  view->UI_InstallTimer(0.02f, 9);
  ASSERT_TRUE(WaitFor([&] { return view->timerFirings.size() >= 3; }));
  const auto elapsed = std::chrono::steady_clock::now() - start;
  EXPECT_GE(std::chrono::duration_cast<std::chrono::milliseconds>(elapsed).count(), 55)
      << "three firings of a 20 ms timer take at least 60 ms";
  for (long id : view->timerFirings) EXPECT_EQ(id, 9);

  EXPECT_TRUE(view->UI_RemoveTimer(9, false));
  const std::size_t fired = view->timerFirings.size();
  Settle(80);
  EXPECT_EQ(view->timerFirings.size(), fired);
}

class X11BridgePopup : public X11BridgeTest {
 protected:
  bool IsOverrideRedirect(OS_WindowHandle inWindow) {
    xcb_connection_t* c = mUser->GetConnection();
    xcb_get_window_attributes_reply_t* attributes =
        xcb_get_window_attributes_reply(c, xcb_get_window_attributes(c, static_cast<xcb_window_t>(inWindow)), nullptr);
    const bool result = attributes && attributes->override_redirect;
    std::free(attributes);
    return result;
  }
  // Position of a window among the screen's top levels, bottom first; -1 when absent.
  int StackingIndex(OS_WindowHandle inWindow) {
    xcb_connection_t* c = mUser->GetConnection();
    xcb_query_tree_reply_t* tree = xcb_query_tree_reply(c, xcb_query_tree(c, mUser->GetRoot()), nullptr);
    int index = -1;
    if (!tree) return index;
    const xcb_window_t* children = xcb_query_tree_children(tree);
    for (int i = 0; i < xcb_query_tree_children_length(tree); ++i)
      if (children[i] == inWindow) index = i;
    std::free(tree);
    return index;
  }
};

TEST_F(X11BridgePopup, APopupContainerOpensAboveItsOwnerWithoutTakingActivationOrFocus) {
  // Made before its owner, as a popup that is kept and shown again is.
  boost::intrusive_ptr<OS_PopupViewContainer> popup(new OS_PopupViewContainer(false, true));
  auto owner = MakeMainWindow(OS_Rect(100, 100, 300, 200));
  auto backdrop = AddRecorder(owner.get(), "backdrop", 0, 0, 300, 200);
  backdrop->paints = true;
  backdrop->blue = 1.0f;
  auto field = Add(owner.get(), new KeyLogView("field"), 10, 10, 50, 20);
  ASSERT_TRUE(field->UI_GainKeyboardFocus(kFocusChangeMouse));
  owner->UI_Invalidate(nullptr, 0);
  ASSERT_TRUE(WaitFor([&] { return ScreenPixel(300, 250) == 0x0000FFu; }));

  popup->SetOwner(owner.get());
  popup->UI_SetLocalRect(UI_Node::RectL(150, 150, 100, 60));
  auto item = AddRecorder(popup.get(), "item", 0, 0, 100, 60);
  item->paints = true;
  item->red = 1.0f;
  popup->UI_Show(true);
  ASSERT_TRUE(WaitFor([&] { return ScreenPixel(175, 175) == 0xFF0000u; })) << "the popup shows above its owner";
  EXPECT_EQ(ScreenPixel(300, 250), 0x0000FFu);
  EXPECT_GT(StackingIndex(popup->GetHandle()), StackingIndex(owner->GetHandle()));
  EXPECT_TRUE(IsOverrideRedirect(popup->GetHandle())) << "popups bypass the window manager";
  EXPECT_FALSE(IsOverrideRedirect(owner->GetHandle()));
  EXPECT_EQ(mLayer->GetActiveWindow(), owner->GetHandle());
  EXPECT_EQ(mManager.GetKeyboardFocusLeafNode(), field.get());

  // A click on the popup reaches its node and leaves activation and focus where they were.
  mUser->Click(180, 170);
  ASSERT_TRUE(WaitFor([&] { return !item->Actions(MouseEvent::kActionButtonUp).empty(); }));
  EXPECT_FLOAT_EQ(item->Actions(MouseEvent::kActionButtonDown)[0].GetPosition().x, 30.0f);
  EXPECT_FLOAT_EQ(item->Actions(MouseEvent::kActionButtonDown)[0].GetPosition().y, 20.0f);
  EXPECT_TRUE(backdrop->Actions(MouseEvent::kActionButtonDown).empty());
  EXPECT_EQ(mLayer->GetActiveWindow(), owner->GetHandle());
  EXPECT_EQ(mManager.GetKeyboardFocusLeafNode(), field.get());

  popup->UI_Show(false);
  ASSERT_TRUE(WaitFor([&] { return ScreenPixel(175, 175) == 0x0000FFu; })) << "hiding uncovers the owner";
}

}  // namespace
}  // namespace norvik::test
