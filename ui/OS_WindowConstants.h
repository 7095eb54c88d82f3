#pragma once
// Numbers of the native window vocabulary: styles, extended styles, show
// commands, position flags, activation codes, system cursors and the like.
// The bridge between native windows and nodes is written against these
// numbers; each platform layer maps them onto its own window system (the
// headless system keeps them as they are).
#include <cstdint>

namespace norvik::ui {

// Window styles.
enum OS_WindowStyle : std::uint32_t {
  kOSStyleOverlapped = 0x00000000,
  kOSStyleMaximizeBox = 0x00010000,
  kOSStyleMinimizeBox = 0x00020000,
  kOSStyleThickFrame = 0x00040000,
  kOSStyleSysMenu = 0x00080000,
  kOSStyleBorder = 0x00800000,
  kOSStyleCaption = 0x00C00000,
  kOSStyleMaximize = 0x01000000,
  kOSStyleClipChildren = 0x02000000,
  kOSStyleClipSiblings = 0x04000000,
  kOSStyleDisabled = 0x08000000,
  kOSStyleVisible = 0x10000000,
  kOSStyleMinimize = 0x20000000,
  kOSStyleChild = 0x40000000,
  kOSStylePopup = 0x80000000,
  kOSStyleOverlappedWindow = 0x00CF0000,
};

// Extended window styles.
enum OS_WindowExStyle : std::uint32_t {
  kOSExStyleDialogModalFrame = 0x00000001,
  kOSExStyleTopmost = 0x00000008,
  kOSExStyleTransparent = 0x00000020,
  kOSExStyleToolWindow = 0x00000080,
  kOSExStyleAppWindow = 0x00040000,
  kOSExStyleLayered = 0x00080000,
  kOSExStyleNoActivate = 0x08000000,
};

// Class styles given when the toolkit registers its window class.
enum OS_ClassStyle : std::uint32_t {
  kOSClassStyleDoubleClicks = 0x0008,
  kOSClassStyleDropShadow = 0x00020000,
};

// Show commands.
enum OS_ShowCommand : int {
  kOSShowHide = 0,
  kOSShowNormal = 1,
  kOSShowMinimized = 2,
  kOSShowMaximized = 3,
  kOSShowNoActivate = 4,
  kOSShow = 5,
  kOSShowMinimize = 6,
  kOSShowMinNoActive = 7,
  kOSShowNA = 8,
  kOSShowRestore = 9,
};

// Flags of a position and size change.
enum OS_PositionFlags : std::uint32_t {
  kOSPosNoSize = 0x0001,
  kOSPosNoMove = 0x0002,
  kOSPosNoZOrder = 0x0004,
  kOSPosNoRedraw = 0x0008,
  kOSPosNoActivate = 0x0010,
  kOSPosFrameChanged = 0x0020,
  kOSPosShowWindow = 0x0040,
  kOSPosHideWindow = 0x0080,
};

// Low word of the first parameter of the activation message.
enum OS_ActivationCode : int {
  kOSActivationInactive = 0,
  kOSActivationActive = 1,
  kOSActivationClickActive = 2,
};

// Answers to the mouse-activation message.
enum OS_MouseActivateResult : int {
  kOSMouseActivate = 1,
  kOSMouseActivateAndEat = 2,
  kOSMouseNoActivate = 3,
  kOSMouseNoActivateAndEat = 4,
};

// First parameter of the size message.
enum OS_SizeKind : int {
  kOSSizeRestored = 0,
  kOSSizeMinimized = 1,
  kOSSizeMaximized = 2,
};

// System commands (first parameter of kOSMsgSysCommand, low four bits clear).
enum OS_SystemCommand : unsigned {
  kOSSysCommandMinimize = 61472,
  kOSSysCommandMaximize = 61488,
  kOSSysCommandClose = 61536,
  kOSSysCommandRestore = 61728,
};

// Notification codes carried in the high word of kOSMsgCommand's first parameter.
enum OS_EditNotification : unsigned {
  kOSEditSetFocus = 256,
  kOSEditKillFocus = 512,
};

// Read-only style bit of a native edit field.
constexpr std::uint32_t kOSEditStyleReadOnly = 0x0800;

// System cursors.
enum OS_SystemCursor : int {
  kOSCursorArrow = 32512,
  kOSCursorIBeam = 32513,
  kOSCursorWait = 32514,
  kOSCursorCross = 32515,
  kOSCursorUpArrow = 32516,
  kOSCursorSizeNWSE = 32642,
  kOSCursorSizeNESW = 32643,
  kOSCursorSizeWE = 32644,
  kOSCursorSizeNS = 32645,
  kOSCursorSizeAll = 32646,
  kOSCursorNo = 32648,
  kOSCursorHand = 32649,
  kOSCursorAppStarting = 32650,
  kOSCursorHelp = 32651,
};

// Flags of layered window attributes.
enum OS_LayeredFlags : unsigned {
  kOSLayeredColorKey = 1,
  kOSLayeredAlpha = 2,
};

// Relations for walking the window list.
enum OS_WindowRelation : int {
  kOSWindowFirst = 0,
  kOSWindowLast = 1,
  kOSWindowNext = 2,
  kOSWindowPrevious = 3,
  kOSWindowOwner = 4,
  kOSWindowChild = 5,
};

// Window placement flag: restore to maximised.
constexpr unsigned kOSPlacementRestoreToMaximized = 0x0002;

// Virtual key codes of the mouse buttons and modifiers, for key state queries.
enum OS_VirtualKey : int {
  kOSKeyLeftButton = 1,
  kOSKeyRightButton = 2,
  kOSKeyMiddleButton = 4,
  kOSKeyShift = 16,
  kOSKeyControl = 17,
  kOSKeyAlt = 18,
  kOSKeyCapsLock = 20,
  kOSKeyNumLock = 144,
  kOSKeyLeftShift = 160,
  kOSKeyRightShift = 161,
  kOSKeyLeftControl = 162,
  kOSKeyRightControl = 163,
  kOSKeyLeftAlt = 164,
  kOSKeyRightAlt = 165,
};

// Packing of coordinates into a message's second parameter: x in the low
// 16 bits, y in the next 16, both signed.
constexpr std::intptr_t MakePointParam(int inX, int inY) {
  return static_cast<std::intptr_t>((static_cast<std::uint32_t>(static_cast<std::uint16_t>(inX))) |
                                    (static_cast<std::uint32_t>(static_cast<std::uint16_t>(inY)) << 16));
}
constexpr int PointParamX(std::intptr_t inParam) { return static_cast<std::int16_t>(inParam & 0xFFFF); }
constexpr int PointParamY(std::intptr_t inParam) { return static_cast<std::int16_t>((inParam >> 16) & 0xFFFF); }
constexpr std::uintptr_t MakeWParam(unsigned inLow, unsigned inHigh) {
  return static_cast<std::uintptr_t>((inLow & 0xFFFF) | ((inHigh & 0xFFFF) << 16));
}
constexpr unsigned LowWord(std::uintptr_t inValue) { return static_cast<unsigned>(inValue & 0xFFFF); }
constexpr unsigned HighWord(std::uintptr_t inValue) { return static_cast<unsigned>((inValue >> 16) & 0xFFFF); }

}  // namespace norvik::ui
