#pragma once
// Toggle picture buttons whose images come from the toolkit's resources by
// state: the lock (locked while down) and the link of constrained
// proportions (linked while down). Each state's image is decoded for the
// drawing it lands on; a missing one raises the resource error.
#include "controls/UI_PictureButton.h"

namespace norvik::controls {

class UI_LockButton : public UI_PictureButton {
 public:
  UI_LockButton();
  // "RV4_Locked_Sm_N", "..._R" while rolled over, "Unlocked" when up, "_D" for icon type 1.
  static UTF8String ImageName(bool inDown, bool inRollover, int inIconType);
};

class UI_LinkButton : public UI_PictureButton {
 public:
  UI_LinkButton();
  // "RV4_ConstrainedProportions" when down, "RV4_UnconstrainedProportions" when up, "_D" for icon type 1.
  static UTF8String ImageName(bool inDown, int inIconType);
};

}  // namespace norvik::controls
