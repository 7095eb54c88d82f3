#include "controls/ControlMessages.h"

#include "controls/UI_ControlView.h"

namespace norvik::controls {

UI_ControlMessage::UI_ControlMessage(ui::UI_Node* inNode)
    : ui::MessageT<ui::UI_Node>(inNode), mControl(dynamic_cast<UI_ControlView*>(inNode)) {}

void UI_ControlMessage::SetControl(UI_ControlView* inControl) {
  mControl = inControl;
  SetSubject(inControl);
}

UI_ConstControlMessage::UI_ConstControlMessage(const ui::UI_Node* inNode)
    : ui::MessageT<const ui::UI_Node>(inNode), mControl(dynamic_cast<const UI_ControlView*>(inNode)) {}

}  // namespace norvik::controls
