// UI_Node: the accessors of the side block.
#include "ui/src/UI_NodeExtras.h"

namespace norvik::ui {

UI_Node::Extras& UI_Node::UI_GetExtras() {
  if (!mExtras) mExtras = std::make_unique<Extras>();
  return *mExtras;
}

const UI_Node::Extras& UI_Node::UI_ReadExtras() const {
  static const Extras none;
  return mExtras ? *mExtras : none;
}

const UTF16String& UI_Node::UI_GetToolTip() const { return UI_ReadExtras().toolTip; }
long UI_Node::UI_GetToolTipWidth() const { return UI_ReadExtras().toolTipWidth; }

void UI_Node::UI_SetCustomDrawFunction(const CustomDrawFunction& inF) {
  if (inF || mExtras) UI_GetExtras().customDraw = inF;
}
const UI_Node::CustomDrawFunction& UI_Node::UI_GetCustomDrawFunction() const {
  return UI_ReadExtras().customDraw;
}
void UI_Node::UI_SetCustomMouseEventFunction(const CustomMouseFunction& inF) {
  if (inF || mExtras) UI_GetExtras().customMouseEvent = inF;
}
const UI_Node::CustomMouseFunction& UI_Node::UI_GetCustomMouseEventFunction() const {
  return UI_ReadExtras().customMouseEvent;
}
void UI_Node::UI_SetCustomPreMouseEventFunction(const CustomMouseFunction& inF) {
  if (inF || mExtras) UI_GetExtras().customPreMouseEvent = inF;
}
const UI_Node::CustomMouseFunction& UI_Node::UI_GetCustomPreMouseEventFunction() const {
  return UI_ReadExtras().customPreMouseEvent;
}
void UI_Node::UI_SetCustomKeyboardEventFunction(const CustomKeyboardFunction& inF) {
  if (inF || mExtras) UI_GetExtras().customKeyboardEvent = inF;
}
const UI_Node::CustomKeyboardFunction& UI_Node::UI_GetCustomKeyboardEventFunction() const {
  return UI_ReadExtras().customKeyboardEvent;
}
void UI_Node::UI_SetCustomDoCursorFunction(const CustomCursorFunction& inF) {
  if (inF || mExtras) UI_GetExtras().customDoCursor = inF;
}
const UI_Node::CustomCursorFunction& UI_Node::UI_GetCustomDoCursorFunction() const {
  return UI_ReadExtras().customDoCursor;
}

void UI_Node::InstallTimerFunction(const TimerFunction& inF) { UI_GetExtras().timerFunctions.push_back(inF); }
void UI_Node::InstallFocusChangedFunction(const FocusChangedFunction& inF) {
  UI_GetExtras().focusChangedFunctions.push_back(inF);
}
void UI_Node::InstallSizeChangedFunction(const VoidFunction& inF) {
  UI_GetExtras().sizeChangedFunctions.push_back(inF);
}
void UI_Node::InstallDisabledChangedFunction(const VoidFunction& inF) {
  UI_GetExtras().disabledChangedFunctions.push_back(inF);
}
void UI_Node::InstallBeforeFocusChangeFunction(const BeforeFocusChangeFunction& inF) {
  UI_GetExtras().beforeFocusChangeFunctions.push_back(inF);
}

const std::list<long>& UI_Node::UI_GetTimerIDs() const { return UI_ReadExtras().timerIDs; }
std::list<long>& UI_Node::UI_GetTimerIDs() { return UI_GetExtras().timerIDs; }

}  // namespace norvik::ui
