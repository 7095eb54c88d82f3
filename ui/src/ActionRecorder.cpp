#include "ui/ActionRecorder.h"

namespace norvik::automateui {

ActionRecorder& ActionRecorder::GetInstance() {
  static ActionRecorder sInstance;
  return sInstance;
}

bool ActionRecorder::IsRecording() const { return false; }

void ActionRecorder::RecordMouseEvent(ui::UI_Node*, const ui::MouseEvent&) {}

void ActionRecorder::RecordKeyboardEvent(ui::UI_Node*, const ui::KeyboardEvent&) {}

void ActionRecorder::RecordMenuItemEvent(ui::UI_Node*, unsigned) {}

}  // namespace norvik::automateui
