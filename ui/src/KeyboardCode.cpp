#include "ui/KeyboardCode.h"

namespace norvik::ui {

KeyboardCode KeyboardCode::CreateFromKeyboardChar(unsigned short inCharacter, bool inExtended) {
  if (inCharacter == 0) return KeyboardCode();
  return KeyboardCode(kPrintableBit | (inExtended ? kExtendedBit : 0u) | inCharacter);
}

KeyboardCode KeyboardCode::CreateFromControlCode(unsigned short inControlCode, bool inExtended) {
  if (inControlCode == 0 || inControlCode == kNoCode) return KeyboardCode();
  return KeyboardCode((inExtended ? kExtendedBit : 0u) | inControlCode);
}

}  // namespace norvik::ui
