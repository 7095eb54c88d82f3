// The US keyboard of the headless system: scan codes of the keys and the
// characters that a key down types under Shift, Caps Lock, Num Lock and Ctrl.
// Ctrl with Alt stands for AltGr, which types nothing on this layout.
#include "ui/src/headless/OS_NativeLayer_Headless.h"

namespace norvik::ui::headless {
namespace {

struct ScanEntry {
  int key;
  std::uint8_t scan;
};

// Set-1 scan codes of the keys of a US keyboard, by virtual key.
constexpr ScanEntry kScanCodes[] = {
    {8, 0x0E},   {9, 0x0F},   {13, 0x1C},  {16, 0x2A},  {17, 0x1D},  {18, 0x38},  {19, 0x45},  {20, 0x3A},
    {27, 0x01},  {32, 0x39},  {33, 0x49},  {34, 0x51},  {35, 0x4F},  {36, 0x47},  {37, 0x4B},  {38, 0x48},
    {39, 0x4D},  {40, 0x50},  {44, 0x37},  {45, 0x52},  {46, 0x53},  {48, 0x0B},  {49, 0x02},  {50, 0x03},
    {51, 0x04},  {52, 0x05},  {53, 0x06},  {54, 0x07},  {55, 0x08},  {56, 0x09},  {57, 0x0A},  {65, 0x1E},
    {66, 0x30},  {67, 0x2E},  {68, 0x20},  {69, 0x12},  {70, 0x21},  {71, 0x22},  {72, 0x23},  {73, 0x17},
    {74, 0x24},  {75, 0x25},  {76, 0x26},  {77, 0x32},  {78, 0x31},  {79, 0x18},  {80, 0x19},  {81, 0x10},
    {82, 0x13},  {83, 0x1F},  {84, 0x14},  {85, 0x16},  {86, 0x2F},  {87, 0x11},  {88, 0x2D},  {89, 0x15},
    {90, 0x2C},  {96, 0x52},  {97, 0x4F},  {98, 0x50},  {99, 0x51},  {100, 0x4B}, {101, 0x4C}, {102, 0x4D},
    {103, 0x47}, {104, 0x48}, {105, 0x49}, {106, 0x37}, {107, 0x4E}, {109, 0x4A}, {110, 0x53}, {111, 0x35},
    {112, 0x3B}, {113, 0x3C}, {114, 0x3D}, {115, 0x3E}, {116, 0x3F}, {117, 0x40}, {118, 0x41}, {119, 0x42},
    {120, 0x43}, {121, 0x44}, {122, 0x57}, {123, 0x58}, {144, 0x45}, {145, 0x46}, {160, 0x2A}, {161, 0x36},
    {162, 0x1D}, {163, 0x1D}, {164, 0x38}, {165, 0x38}, {186, 0x27}, {187, 0x0D}, {188, 0x33}, {189, 0x0C},
    {190, 0x34}, {191, 0x35}, {192, 0x29}, {219, 0x1A}, {220, 0x2B}, {221, 0x1B}, {222, 0x28},
};

struct PunctuationEntry {
  int key;
  char16_t plain;
  char16_t shifted;
};

constexpr PunctuationEntry kPunctuation[] = {
    {186, u';', u':'}, {187, u'=', u'+'}, {188, u',', u'<'}, {189, u'-', u'_'}, {190, u'.', u'>'},
    {191, u'/', u'?'}, {192, u'`', u'~'}, {219, u'[', u'{'}, {220, u'\\', u'|'}, {221, u']', u'}'},
    {222, u'\'', u'"'},
};

constexpr char16_t kShiftedDigits[] = u")!@#$%^&*(";

bool Held(const KeyStates& inKeys, int inKey) { return (inKeys[static_cast<std::size_t>(inKey)] & kKeyHeld) != 0; }
bool Toggled(const KeyStates& inKeys, int inKey) {
  return (inKeys[static_cast<std::size_t>(inKey)] & kKeyToggled) != 0;
}

// Ctrl with a key types a control character for letters and a few others.
char16_t ControlCharacterOf(int inVirtualKey, bool inShift) {
  if (inVirtualKey >= 'A' && inVirtualKey <= 'Z') return static_cast<char16_t>(inVirtualKey - 'A' + 1);
  switch (inVirtualKey) {
    case 219: return 27;
    case 220: return 28;
    case 221: return 29;
    case '6': return inShift ? 30 : 0;
    case 189: return inShift ? 31 : 0;
    case 13: return 10;
    case 8: return 127;
    case 32: return 32;
    default: return 0;
  }
}

}  // namespace

std::uint8_t ScanCodeOf(int inVirtualKey) {
  for (const ScanEntry& entry : kScanCodes)
    if (entry.key == inVirtualKey) return entry.scan;
  return 0;
}

bool IsExtendedByDefault(int inVirtualKey) {
  return inVirtualKey == kOSKeyRightControl || inVirtualKey == kOSKeyRightAlt || inVirtualKey == 111;
}

char16_t CharacterOf(int inVirtualKey, const KeyStates& inKeys) {
  const bool shift = Held(inKeys, kOSKeyShift);
  const bool ctrl = Held(inKeys, kOSKeyControl);
  const bool alt = Held(inKeys, kOSKeyAlt);
  if (ctrl && alt) return 0;
  if (ctrl) return ControlCharacterOf(inVirtualKey, shift);
  if (inVirtualKey >= 'A' && inVirtualKey <= 'Z') {
    const bool upper = shift != Toggled(inKeys, kOSKeyCapsLock);
    return static_cast<char16_t>(upper ? inVirtualKey : inVirtualKey - 'A' + 'a');
  }
  if (inVirtualKey >= '0' && inVirtualKey <= '9')
    return shift ? kShiftedDigits[inVirtualKey - '0'] : static_cast<char16_t>(inVirtualKey);
  for (const PunctuationEntry& entry : kPunctuation)
    if (entry.key == inVirtualKey) return shift ? entry.shifted : entry.plain;
  const bool numLock = Toggled(inKeys, kOSKeyNumLock);
  if (inVirtualKey >= 96 && inVirtualKey <= 105) return numLock ? static_cast<char16_t>(u'0' + inVirtualKey - 96) : 0;
  switch (inVirtualKey) {
    case 8: return 8;
    case 9: return 9;
    case 13: return 13;
    case 27: return 27;
    case 32: return u' ';
    case 106: return u'*';
    case 107: return u'+';
    case 109: return u'-';
    case 110: return numLock ? u'.' : 0;
    case 111: return u'/';
    default: return 0;
  }
}

}  // namespace norvik::ui::headless
