#pragma once
// Toggle picture buttons whose images come from the toolkit's resources by
// state: the lock (locked while down) and the link of constrained
// proportions (linked while down). Where the resources lack the image, a
// simple vector glyph stands in, so the button never paints empty.
#include "controls/UI_PictureButton.h"

namespace norvik::controls {

class UI_LockButton : public UI_PictureButton {
 public:
  UI_LockButton();
  // "RV4_Locked_Sm_N", "..._R" while rolled over, "Unlocked" when up, "_D" for icon type 1.
  static UTF8String ImageName(bool inDown, bool inRollover, int inIconType);
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
};

class UI_LinkButton : public UI_PictureButton {
 public:
  UI_LinkButton();
  // "RV4_ConstrainedProportions" when down, "RV4_UnconstrainedProportions" when up, "_D" for icon type 1.
  static UTF8String ImageName(bool inDown, int inIconType);
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
};

}  // namespace norvik::controls
