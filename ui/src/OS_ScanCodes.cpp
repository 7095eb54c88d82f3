// The scan-code question of the native layer, answered for a US keyboard:
// character messages carry only the scan code of the key that typed them,
// and the bridge needs the key back (Ctrl+C reports C, not the control code).
#include "ui/OS_NativeLayer.h"

namespace norvik::ui {
namespace {

struct ScanKey {
  unsigned scan;
  int key;
};

// Set-1 make codes; where the keypad shares a code with a navigation key, the
// keypad digit is what a character message came from.
constexpr ScanKey kScanKeys[] = {
    {0x01, 27},  {0x02, '1'}, {0x03, '2'}, {0x04, '3'}, {0x05, '4'}, {0x06, '5'}, {0x07, '6'}, {0x08, '7'},
    {0x09, '8'}, {0x0A, '9'}, {0x0B, '0'}, {0x0C, 189}, {0x0D, 187}, {0x0E, 8},   {0x0F, 9},   {0x10, 'Q'},
    {0x11, 'W'}, {0x12, 'E'}, {0x13, 'R'}, {0x14, 'T'}, {0x15, 'Y'}, {0x16, 'U'}, {0x17, 'I'}, {0x18, 'O'},
    {0x19, 'P'}, {0x1A, 219}, {0x1B, 221}, {0x1C, 13},  {0x1D, 17},  {0x1E, 'A'}, {0x1F, 'S'}, {0x20, 'D'},
    {0x21, 'F'}, {0x22, 'G'}, {0x23, 'H'}, {0x24, 'J'}, {0x25, 'K'}, {0x26, 'L'}, {0x27, 186}, {0x28, 222},
    {0x29, 192}, {0x2A, 16},  {0x2B, 220}, {0x2C, 'Z'}, {0x2D, 'X'}, {0x2E, 'C'}, {0x2F, 'V'}, {0x30, 'B'},
    {0x31, 'N'}, {0x32, 'M'}, {0x33, 188}, {0x34, 190}, {0x35, 191}, {0x36, 16},  {0x37, 106}, {0x38, 18},
    {0x39, 32},  {0x3A, 20},  {0x3B, 112}, {0x3C, 113}, {0x3D, 114}, {0x3E, 115}, {0x3F, 116}, {0x40, 117},
    {0x41, 118}, {0x42, 119}, {0x43, 120}, {0x44, 121}, {0x45, 144}, {0x46, 145}, {0x47, 36},  {0x48, 38},
    {0x49, 33},  {0x4A, 109}, {0x4B, 37},  {0x4C, 12},  {0x4D, 39},  {0x4E, 107}, {0x4F, 35},  {0x50, 40},
    {0x51, 34},  {0x52, 45},  {0x53, 46},  {0x57, 122}, {0x58, 123},
};

}  // namespace

int OS_NativeLayer::ScanCodeToVirtualKey(unsigned inScanCode) const {
  for (const ScanKey& entry : kScanKeys)
    if (entry.scan == inScanCode) return entry.key;
  return 0;
}

}  // namespace norvik::ui
