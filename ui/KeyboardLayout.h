#pragma once
// The questions that shortcut matching asks of the keyboard layout: which
// layout is active, its code page, which character a key types and which key
// types a character. The platform installs its own answer (the X11 port asks
// xkbcommon); until one is installed, a US English layout answers.
namespace norvik::ui {

// Layout identifiers are language identifiers; code pages are those of the
// layout's legacy text encoding.
constexpr unsigned kKeyboardLayoutUSEnglish = 1033;
constexpr unsigned kCodePageWesternEuropean = 1252;

class KeyboardLayoutInterface {
 public:
  virtual ~KeyboardLayoutInterface() = default;

  virtual unsigned GetActiveLayout() const = 0;
  virtual unsigned GetCodePage(unsigned inLayout) const = 0;
  // The unshifted character that key inKey (a positive platform key code)
  // types in inLayout, or 0 when it types none.
  virtual unsigned short KeyToCharacter(unsigned inLayout, short inKey) const = 0;
  // The key that types inCharacter in inLayout, with or without Shift, or 0
  // when no key does.
  virtual short CharacterToKey(unsigned inLayout, unsigned short inCharacter) const = 0;
};

// The US English layout, whatever layout is asked for.
class USKeyboardLayout : public KeyboardLayoutInterface {
 public:
  unsigned GetActiveLayout() const override { return kKeyboardLayoutUSEnglish; }
  unsigned GetCodePage(unsigned inLayout) const override;
  unsigned short KeyToCharacter(unsigned inLayout, short inKey) const override;
  short CharacterToKey(unsigned inLayout, unsigned short inCharacter) const override;
};

// The installed layout, or the US layout when none is.
const KeyboardLayoutInterface& GetKeyboardLayout();
// Installs the platform's layout; the caller keeps ownership and must
// uninstall it (null) before destroying it.
void SetKeyboardLayout(const KeyboardLayoutInterface* inLayout);

}  // namespace norvik::ui
