#pragma once
// The recorder of user actions, as event dispatch sees it: the walks hand it
// every mouse and keyboard event together with the node it went to. Until the
// automation layer brings the real recorder, it records nothing.
namespace norvik::ui {
class UI_Node;
class MouseEvent;
class KeyboardEvent;
}  // namespace norvik::ui

namespace norvik::automateui {

class ActionRecorder {
 public:
  static ActionRecorder& GetInstance();

  bool IsRecording() const;
  void RecordMouseEvent(ui::UI_Node* inNode, const ui::MouseEvent& inEvent);
  void RecordKeyboardEvent(ui::UI_Node* inNode, const ui::KeyboardEvent& inEvent);
  // A menu choice that reached a window as a command with this item id.
  void RecordMenuItemEvent(ui::UI_Node* inWindow, unsigned inItemID);

 private:
  ActionRecorder() = default;
};

}  // namespace norvik::automateui
