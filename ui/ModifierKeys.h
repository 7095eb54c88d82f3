#pragma once
// Modifier keys as mouse and keyboard events carry them.
#include "tarsel/Flags.h"

namespace norvik::ui {

using ModifierKeys = tarsel::utility::Flags<unsigned char>;

enum ModifierKey : unsigned char {
  kModKeyNone = 0,
  kModKeyShift = 2,
  kModKeyCtrl = 4,
  kModKeyCapsLock = 8,  // the toggled state, not the key being held
  kModKeyAlt = 16,
};

}  // namespace norvik::ui
