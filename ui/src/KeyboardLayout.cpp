#include "ui/KeyboardLayout.h"

#include <cstring>

namespace norvik::ui {
namespace {

const KeyboardLayoutInterface* sInstalledLayout = nullptr;

// Punctuation keys of the US layout: platform key, unshifted and shifted character.
struct PunctuationKey {
  short key;
  char plain;
  char shifted;
};
constexpr PunctuationKey kPunctuationKeys[] = {
    {186, ';', ':'}, {187, '=', '+'}, {188, ',', '<'}, {189, '-', '_'}, {190, '.', '>'}, {191, '/', '?'},
    {192, '`', '~'}, {219, '[', '{'}, {220, '\\', '|'}, {221, ']', '}'}, {222, '\'', '"'},
};

// Shifted digits of the US layout, indexed by the digit key's character.
constexpr char kShiftedDigits[] = ")!@#$%^&*(";

// Keys that type the same character with and without the numeric keypad.
struct KeypadKey {
  short key;
  char character;
};
constexpr KeypadKey kKeypadOperators[] = {{106, '*'}, {107, '+'}, {109, '-'}, {110, '.'}, {111, '/'}};

}  // namespace

unsigned USKeyboardLayout::GetCodePage(unsigned) const { return kCodePageWesternEuropean; }

unsigned short USKeyboardLayout::KeyToCharacter(unsigned, short inKey) const {
  if (inKey == 8 || inKey == 9 || inKey == 13 || inKey == 27 || inKey == 32) return static_cast<unsigned short>(inKey);
  if (inKey >= '0' && inKey <= '9') return static_cast<unsigned short>(inKey);
  if (inKey >= 'A' && inKey <= 'Z') return static_cast<unsigned short>(inKey);
  if (inKey >= 96 && inKey <= 105) return static_cast<unsigned short>('0' + (inKey - 96));
  for (const KeypadKey& k : kKeypadOperators) {
    if (k.key == inKey) return static_cast<unsigned short>(k.character);
  }
  for (const PunctuationKey& k : kPunctuationKeys) {
    if (k.key == inKey) return static_cast<unsigned short>(k.plain);
  }
  return 0;
}

short USKeyboardLayout::CharacterToKey(unsigned, unsigned short inCharacter) const {
  if (inCharacter == 8 || inCharacter == 9 || inCharacter == 13 || inCharacter == 27 || inCharacter == ' ')
    return static_cast<short>(inCharacter);
  if (inCharacter >= '0' && inCharacter <= '9') return static_cast<short>(inCharacter);
  if (inCharacter >= 'A' && inCharacter <= 'Z') return static_cast<short>(inCharacter);
  if (inCharacter >= 'a' && inCharacter <= 'z') return static_cast<short>(inCharacter - 'a' + 'A');
  if (inCharacter == 0 || inCharacter > 127) return 0;
  if (const char* p = std::strchr(kShiftedDigits, static_cast<char>(inCharacter))) {
    return static_cast<short>('0' + (p - kShiftedDigits));
  }
  for (const PunctuationKey& k : kPunctuationKeys) {
    if (k.plain == static_cast<char>(inCharacter) || k.shifted == static_cast<char>(inCharacter)) return k.key;
  }
  return 0;
}

const KeyboardLayoutInterface& GetKeyboardLayout() {
  static const USKeyboardLayout sUSLayout;
  return sInstalledLayout ? *sInstalledLayout : sUSLayout;
}

void SetKeyboardLayout(const KeyboardLayoutInterface* inLayout) { sInstalledLayout = inLayout; }

}  // namespace norvik::ui
