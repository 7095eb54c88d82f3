#pragma once
// The kinds of button the Buttons page shows and the states it shows them
// in. A live button of a kind behaves as in any program; a state sample is
// the same control frozen in one state, so that every state can be seen at
// once: its value, down state and enabled state are set through the
// control's own setters, and rollover and focus, which the node tree gives
// to one node at a time, are answered by the sample itself. A sample takes
// no mouse events and no focus, so nothing a user does changes it.
#include "GalleryStyle.h"
#include "controls/UI_ControlView.h"

namespace norvik::gallery {

enum class ButtonKind {
  kText,
  kDefaultText,
  kPicture,
  kPictureText,
  kLock,
  kLink,
  kOwnerDraw,
  kDisclosure,
  kCheckbox,
  kTriStateCheckbox,
  kRadio,
  kButtonBar,
};
constexpr int kButtonKindCount = 12;

enum class ShownState { kNormal, kRollover, kPressed, kOn, kMixed, kFocused, kDisabled, kDisabledOn };
constexpr int kShownStateCount = 8;

inline ButtonKind KindAt(int inIndex) { return static_cast<ButtonKind>(inIndex); }
inline ShownState StateAt(int inIndex) { return static_cast<ShownState>(inIndex); }

UTF16String ButtonKindName(ButtonKind inKind);
UTF16String ShownStateName(ShownState inState);
// Whether a button of inKind has inState: "on" only for buttons that keep a
// value, "mixed" only for the tri-state checkbox. A button bar always shows
// its selection, and its buttons light up one by one under the mouse: it
// has no rollover, on or mixed state of its own.
bool KindShowsState(ButtonKind inKind, ShownState inState);
// The size a button of inKind takes in the page.
PointF ButtonSize(ButtonKind inKind);

// A working button of inKind, with its label, picture and settings.
controls::UI_ControlViewP MakeLiveButton(ButtonKind inKind);
// A button of inKind frozen in inState.
controls::UI_ControlViewP MakeStateSample(ButtonKind inKind, ShownState inState);

}  // namespace norvik::gallery
