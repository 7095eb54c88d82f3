#pragma once
// Why keyboard focus moves. The numbers are stored and compared by callers,
// so they are fixed.

namespace norvik::ui {

enum FocusChangeReason {
  kFocusChangeAdvance = 0,   // Tab; the only reason that asks UI_WantsKeyboardFocusFromAdvance
  kFocusChangeMnemonic = 1,  // a control's mnemonic was pressed
  kFocusChangeMouse = 2,     // a click on a control
  kFocusChangeRestore = 3,   // window activation, modal pop, application return
  kFocusChangeHandOver = 4,  // handed to a parent or replacement node
  kFocusChangeLoss = 5       // lost to nothing
};

}  // namespace norvik::ui
