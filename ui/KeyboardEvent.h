#pragma once
// One keyboard event as the tree sees it: a key going down or up, or the
// characters it typed. Shortcut matching works on two values that the event
// computes on first use and keeps: the shortcut character (the key's
// character as the keyboard layout has it, upper-cased) and the KeyboardCode.
#include <vector>

#include "ui/KeyboardCode.h"
#include "ui/ModifierKeys.h"
#include "ui/OS_Event.h"

namespace norvik::ui {

class KeyboardEvent {
 public:
  enum Action {
    kActionNone = 0,
    kActionKeyDown = 1,
    kActionKeyUp = 2,
    kActionKeyChar = 3,
    kActionKeyDeadChar = 4,
  };

  // inOSCode is the platform's key code, negated for keys of the extended block.
  KeyboardEvent(Action inAction, unsigned short inCharacter, short inOSCode, ModifierKeys inModKeys, bool inRepeat,
                const OS_Event& inOSEvent);
  // Typed characters: action kActionKeyChar, no key code.
  KeyboardEvent(const std::vector<unsigned short>& inCharacters, ModifierKeys inModKeys, bool inRepeat,
                const OS_Event& inOSEvent);
  // An event that only carries its native message.
  explicit KeyboardEvent(const OS_Event& inOSEvent);
  KeyboardEvent(const KeyboardEvent&) = default;
  KeyboardEvent& operator=(const KeyboardEvent&) = default;
  virtual ~KeyboardEvent() = default;

  Action GetAction() const { return mAction; }
  bool IsActionKeyDown() const { return mAction == kActionKeyDown; }
  bool IsActionKeyUp() const { return mAction == kActionKeyUp; }
  bool IsActionKeyChar() const { return mAction == kActionKeyChar; }
  bool IsActionKeyDeadChar() const { return mAction == kActionKeyDeadChar; }

  // Character inIndex, or 0 past the end.
  unsigned short GetCharacter(std::size_t inIndex = 0) const;
  std::size_t GetNumCharacters() const { return mCharacters.size(); }
  short GetOSCode() const { return mOSCode; }
  ModifierKeys GetModKey() const { return mModKeys; }
  bool IsRepeat() const { return mRepeat; }
  const OS_Event& GetOSEvent() const { return mOSEvent; }

  // The key's character as shortcuts see it; computed on first use.
  unsigned short GetShortcutCharacter() const;
  // The key's control code or printable character; computed on first use.
  KeyboardCode GetCode() const;

  // The code matches inCode and the modifiers, Caps Lock aside, equal inModKeys.
  bool CompareShortcut(KeyboardCode inCode, ModifierKeys inModKeys) const;
  // The code matches inCode, whatever the modifiers.
  bool CompareCode(KeyboardCode inCode) const { return GetCode() == inCode; }

  // The control code of a platform key code, or kControlCodeNone.
  static unsigned short GetControlCode(short inOSCode);
  // Keys of the numeric keypad (and the navigation keys it doubles as).
  static bool IsExtendedOSCode(short inOSCode);
  // Replaces every value below 32 by 0, and makes sure there is at least one entry.
  static void ValidateKeyChars(std::vector<unsigned short>& ioCharacters);

 private:
  Action mAction = kActionNone;
  std::vector<unsigned short> mCharacters;
  short mOSCode = -1;
  ModifierKeys mModKeys;
  bool mRepeat = false;
  OS_Event mOSEvent;
  mutable unsigned short mShortcutCharacter = 0;
  mutable KeyboardCode mCode;
};

// After a key has triggered an action: a system key (one pressed with Alt)
// leaves a system character message in the native queue, which the platform
// would answer with a beep; this removes one.
void FlushPostActionKeyEvents(const KeyboardEvent& inEvent);

}  // namespace norvik::ui
