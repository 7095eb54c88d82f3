#include "ui/KeyboardEvent.h"

#include <algorithm>
#include <cstdlib>
#include <iterator>

#include "ui/InputPlatform.h"
#include "ui/KeyboardLayout.h"

namespace norvik::ui {
namespace {

struct ControlCodeEntry {
  short osCode;
  unsigned short controlCode;
};

// Keys that exist in both the main block and the extended block appear twice,
// once with each sign. -1 is Clear's extended code and also the default OS
// code of an event that has none, so such an event reads as Clear.
constexpr ControlCodeEntry kControlCodes[] = {
    {32, kControlCodeSpace},       {8, kControlCodeBackspace},    {9, kControlCodeTab},
    {13, kControlCodeReturn},      {-13, kControlCodeEnter},      {27, kControlCodeEscape},
    {-44, kControlCodePrintScreen}, {145, kControlCodeScrollLock}, {19, kControlCodePause},
    {45, kControlCodeInsert},      {-45, kControlCodeInsert},     {46, kControlCodeDelete},
    {-46, kControlCodeDelete},     {36, kControlCodeHome},        {-36, kControlCodeHome},
    {35, kControlCodeEnd},         {-35, kControlCodeEnd},        {33, kControlCodePageUp},
    {-33, kControlCodePageUp},     {34, kControlCodePageDown},    {-34, kControlCodePageDown},
    {47, kControlCodeHelp},        {12, kControlCodeClear},       {-1, kControlCodeClear},
    {37, kControlCodeLeft},        {-37, kControlCodeLeft},       {39, kControlCodeRight},
    {-39, kControlCodeRight},      {38, kControlCodeUp},          {-38, kControlCodeUp},
    {40, kControlCodeDown},        {-40, kControlCodeDown},       {-144, kControlCodeNumLock},
    {17, kControlCodeCtrl},        {18, kControlCodeAlt},         {16, kControlCodeShift},
    {20, kControlCodeCapsLock},    {-93, kControlCodeContextMenu},
};

constexpr short kFirstFunctionKey = 112;  // F1
constexpr short kLastFunctionKey = 135;   // F24

// Characters that are their own shortcut character.
bool IsSelfShortcutCharacter(unsigned short c) {
  switch (c) {
    case 0: case 1: case 4: case 8: case 9: case 11: case 12: case 28: case 29: case 30: case 31: case 127:
      return true;
    default:
      return false;
  }
}

// Keys whose typed character is kept as it is rather than looked up again in
// the layout.
bool KeepsTypedCharacter(short inOSCode) {
  switch (inOSCode) {
    case 65: case 67: case 69: case 75: case 78: case 82: case 83: case 84: case 85: case 86: case 87: case 88:
    case 89: case 91: case 92:
      return true;
    default:
      return false;
  }
}

// Code pages whose layouts give usable shortcut characters; other layouts
// (Cyrillic, Greek, ...) fall back to US English for shortcuts.
bool HasShortcutCodePage(unsigned inCodePage) {
  switch (inCodePage) {
    case 932: case 936: case 950: case 949: case 1254: case 1252: case 1257: case 1250: case 1200:
      return true;
    default:
      return false;
  }
}

// Upper case for the scripts that keyboard layouts type: Latin-1, Latin
// Extended-A, Greek and Cyrillic. Other characters have no case here.
unsigned short ToUpper(unsigned short c) {
  if (c >= 'a' && c <= 'z') return static_cast<unsigned short>(c - 32);
  if (c >= 0xE0 && c <= 0xFE && c != 0xF7) return static_cast<unsigned short>(c - 32);
  if (c == 0xFF) return 0x178;
  if (c >= 0x100 && c <= 0x17F && c != 0x130 && c != 0x131 && c != 0x138 && c != 0x149 &&
      c != 0x17F) {
    // Latin Extended-A pairs upper/lower on even/odd code points, shifted by
    // one between 0x139 and 0x148 and between 0x179 and 0x17E.
    bool oddUpper = (c >= 0x139 && c <= 0x148) || (c >= 0x179 && c <= 0x17E);
    bool isLower = oddUpper ? (c % 2 == 0) : (c % 2 == 1);
    return isLower ? static_cast<unsigned short>(c - 1) : c;
  }
  if (c >= 0x3B1 && c <= 0x3C9 && c != 0x3C2) return static_cast<unsigned short>(c - 32);
  if (c >= 0x430 && c <= 0x44F) return static_cast<unsigned short>(c - 32);
  if (c >= 0x450 && c <= 0x45F) return static_cast<unsigned short>(c - 80);
  return c;
}

}  // namespace

KeyboardEvent::KeyboardEvent(Action inAction, unsigned short inCharacter, short inOSCode, ModifierKeys inModKeys,
                             bool inRepeat, const OS_Event& inOSEvent)
    : mAction(inAction),
      mCharacters(1, inCharacter),
      mOSCode(inOSCode),
      mModKeys(inModKeys),
      mRepeat(inRepeat),
      mOSEvent(inOSEvent) {
  ValidateKeyChars(mCharacters);
}

KeyboardEvent::KeyboardEvent(const std::vector<unsigned short>& inCharacters, ModifierKeys inModKeys, bool inRepeat,
                             const OS_Event& inOSEvent)
    : mAction(kActionKeyChar), mCharacters(inCharacters), mModKeys(inModKeys), mRepeat(inRepeat), mOSEvent(inOSEvent) {
  ValidateKeyChars(mCharacters);
}

KeyboardEvent::KeyboardEvent(const OS_Event& inOSEvent) : mCharacters(1, 0), mOSEvent(inOSEvent) {}

unsigned short KeyboardEvent::GetCharacter(std::size_t inIndex) const {
  return inIndex < mCharacters.size() ? mCharacters[inIndex] : 0;
}

unsigned short KeyboardEvent::GetShortcutCharacter() const {
  if (mShortcutCharacter != 0) return mShortcutCharacter;
  unsigned short c = GetCharacter(0);
  if (IsSelfShortcutCharacter(c) || KeepsTypedCharacter(mOSCode)) return mShortcutCharacter = c;

  const KeyboardLayoutInterface& layout = GetKeyboardLayout();
  unsigned active = layout.GetActiveLayout();
  if (!HasShortcutCodePage(layout.GetCodePage(active))) active = kKeyboardLayoutUSEnglish;

  unsigned short mapped = 0;
  if (mOSCode != 0) {
    mapped = layout.KeyToCharacter(active, static_cast<short>(std::abs(mOSCode)));
  } else if (short key = layout.CharacterToKey(active, c); key != 0) {
    mapped = layout.KeyToCharacter(active, key);
  }
  // A key the layout cannot place keeps the character it typed.
  return mShortcutCharacter = (mapped != 0 ? ToUpper(mapped) : c);
}

KeyboardCode KeyboardEvent::GetCode() const {
  if (mCode.IsValid()) return mCode;
  bool extended = IsExtendedOSCode(mOSCode);
  if (unsigned short control = GetControlCode(mOSCode); control != kControlCodeNone) {
    mCode = KeyboardCode::CreateFromControlCode(control, extended);
  } else if (unsigned short c = GetShortcutCharacter(); c != 0) {
    mCode = KeyboardCode::CreateFromKeyboardChar(c, extended);
  }
  return mCode;
}

bool KeyboardEvent::CompareShortcut(KeyboardCode inCode, ModifierKeys inModKeys) const {
  ModifierKeys mods = mModKeys;
  mods.Clear(kModKeyCapsLock);
  return GetCode() == inCode && mods == inModKeys;
}

unsigned short KeyboardEvent::GetControlCode(short inOSCode) {
  if (inOSCode >= kFirstFunctionKey && inOSCode <= kLastFunctionKey)
    return static_cast<unsigned short>(kControlCodeF1 + (inOSCode - kFirstFunctionKey));
  auto it = std::find_if(std::begin(kControlCodes), std::end(kControlCodes),
                         [inOSCode](const ControlCodeEntry& e) { return e.osCode == inOSCode; });
  return it != std::end(kControlCodes) ? it->controlCode : static_cast<unsigned short>(kControlCodeNone);
}

bool KeyboardEvent::IsExtendedOSCode(short inOSCode) {
  if (inOSCode == -144 || inOSCode == -111) return true;
  if (inOSCode >= 33 && inOSCode <= 40) return true;
  if (inOSCode == 45 || inOSCode == 46) return true;
  if (inOSCode >= 96 && inOSCode <= 107) return true;
  return inOSCode == 109 || inOSCode == 110;
}

void KeyboardEvent::ValidateKeyChars(std::vector<unsigned short>& ioCharacters) {
  if (ioCharacters.empty()) ioCharacters.push_back(0);
  for (unsigned short& c : ioCharacters) {
    if (c < 32) c = 0;
  }
}

void FlushPostActionKeyEvents(const KeyboardEvent& inEvent) {
  const OS_Event& os = inEvent.GetOSEvent();
  if (os.GetMsg() != kOSMsgSysKeyDown && os.GetMsg() != kOSMsgSysKeyUp) return;
  GetInputPlatform().RemovePendingMessage(os.GetHWnd(), kOSMsgSysChar);
}

}  // namespace norvik::ui
