#pragma once
// What a window system does with a message nobody handled, written once over
// the native layer so that every port behaves alike: closing destroys the
// window, activation gives the activated window the keyboard focus, the
// cursor and mouse-activation questions go to the parent before the default
// answer, an unhandled paint validates, Alt+F4 and the system commands
// minimise, maximise, restore and close.
#include <cstdint>

#include "ui/OS_NativeLayer.h"

namespace norvik::ui {

// The hit-test code of a client area, low word of kOSMsgSetCursor's second parameter.
constexpr unsigned kOSHitClient = 1;

std::intptr_t DefaultWindowProcedureOver(OS_NativeLayer& inLayer, OS_WindowHandle inWindow, unsigned inMessage,
                                         std::uintptr_t inWParam, std::intptr_t inLParam);

// The top-level window that holds inWindow (itself when it has no parent).
OS_WindowHandle TopLevelWindowOf(const OS_NativeLayer& inLayer, OS_WindowHandle inWindow);

}  // namespace norvik::ui
