#include "support/controls/ControlTestSupport.h"

#include "ui/KeyboardEvent.h"
#include "ui/UI_NodeTimerManager.h"

namespace norvik::controls::test {

namespace {
const char* ChangeName(UI_InteractiveControlChangedMessage::ChangeMessage inChange) {
  switch (inChange) {
    case UI_InteractiveControlChangedMessage::kBegin: return "begin";
    case UI_InteractiveControlChangedMessage::kContinue: return "continue";
    case UI_InteractiveControlChangedMessage::kFinish: return "finish";
    case UI_InteractiveControlChangedMessage::kCancel: return "cancel";
  }
  return "?";
}
}  // namespace

void MessageLog::Listen(UI_InteractiveControlView& inControl) {
  inControl.NotifyWhenChangedInteractively(ui::MakeNotification<void(UI_InteractiveControlChangedMessage*)>(
      [this](UI_InteractiveControlChangedMessage* inMessage) {
        entries.push_back(ChangeName(inMessage->GetChangeMessage()));
      }));
  ListenChanged(inControl);
}

void MessageLog::ListenChanged(UI_ControlView& inControl) {
  inControl.NotifyWhenChanged(
      ui::MakeNotification<void(UI_ControlChangedMessage*)>([this](UI_ControlChangedMessage* inMessage) {
        entries.push_back("changed");
        if (auto* button = dynamic_cast<UI_ButtonChangedMessage*>(inMessage))
          changedKeys.push_back(button->GetModKeys());
      }));
}

ControlTest::ControlTest() : root(new ui::test::TestWindowNode) {
  system.Install();
  root->UI_SetNodeID("root");
  root->UI_SetLocalRectF(RectF(0, 0, 200, 200));
  root->UI_Show(true);
}

ControlTest::~ControlTest() {
  manager.EndInputCapture(true);
  system.Uninstall();
}

bool ControlTest::Mouse(ui::MouseEvent::Action inAction, const PointF& inPoint, ModKeys inMods) {
  // As a native window does, every move first updates the mouse-over state.
  if (inAction == ui::MouseEvent::kActionMove)
    root->UI_UpdateMouseOverState(ui::test::MouseAt(ui::MouseEvent::kActionMouseOver, inPoint, 0, 0, inMods));
  return root->UI_DispatchMouseEvent(ui::test::MouseAt(inAction, inPoint, ui::MouseEvent::kButtonLeft, 1, inMods),
                                     true);
}

bool ControlTest::KeyDown(ui::UI_Node* inNode, short inOSCode, unsigned short inChar, ModKeys inMods) {
  return ui::UI_Node::UI_DispatchKeyboardEvent(inNode, ui::test::KeyDownEvent(inOSCode, inChar, inMods));
}

bool ControlTest::KeyUp(ui::UI_Node* inNode, short inOSCode, unsigned short inChar, ModKeys inMods) {
  return ui::UI_Node::UI_DispatchKeyboardEvent(inNode, ui::test::KeyUpEvent(inOSCode, inChar, inMods));
}

void ControlTest::AdvanceAndFireTimers(ui::UI_Node* inNode, unsigned inMilliseconds) {
  system.AdvanceClock(inMilliseconds);
  const std::list<long> keys(inNode->UI_GetTimerIDs());
  for (long key : keys) root->UI_DispatchPossibleTimer(key);
}

}  // namespace norvik::controls::test
