#pragma once
// The side block of a node: what few nodes use, kept out of the node itself
// so that a bare node stays small. Created by UI_Node::UI_GetExtras on the
// first write; a node without one reads as having none of these set.
#include <list>
#include <vector>

#include "ui/UI_Node.h"

namespace norvik::ui {

struct UI_Node::Extras {
  std::list<long> timerIDs;
  UTF16String toolTip;
  long toolTipWidth = 0;
  std::vector<TimerFunction> timerFunctions;
  std::vector<FocusChangedFunction> focusChangedFunctions;
  std::vector<VoidFunction> sizeChangedFunctions;
  std::vector<VoidFunction> disabledChangedFunctions;
  std::vector<BeforeFocusChangeFunction> beforeFocusChangeFunctions;
  CustomDrawFunction customDraw;
  CustomMouseFunction customMouseEvent;
  CustomMouseFunction customPreMouseEvent;
  CustomKeyboardFunction customKeyboardEvent;
  CustomCursorFunction customDoCursor;
  bool placementValid = false;
  halvorn::place_data_t placement;
};

}  // namespace norvik::ui
