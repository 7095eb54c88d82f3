#pragma once
// Keys on X11: keysyms mapped onto the toolkit's virtual key numbers, and the
// keyboard-layout answers read from the xkbcommon keymap.
#include <xkbcommon/xkbcommon.h>

#include "ui/KeyboardLayout.h"

namespace norvik::ui::x11 {

class OS_NativeLayer_X11;

struct VirtualKey {
  int code = 0;           // 0: the keysym has no virtual key
  bool extended = false;  // a key of the navigation block or right-hand modifier
};

// The virtual key of a keysym (as the unshifted level of a key gives it).
VirtualKey KeysymToVirtualKey(xkb_keysym_t inKeysym);

class X11KeyboardLayout : public KeyboardLayoutInterface {
 public:
  explicit X11KeyboardLayout(const OS_NativeLayer_X11& inLayer) : mLayer(inLayer) {}
  unsigned GetActiveLayout() const override;
  unsigned GetCodePage(unsigned inLayout) const override;
  unsigned short KeyToCharacter(unsigned inLayout, short inKey) const override;
  short CharacterToKey(unsigned inLayout, unsigned short inCharacter) const override;

 private:
  const OS_NativeLayer_X11& mLayer;
};

}  // namespace norvik::ui::x11
