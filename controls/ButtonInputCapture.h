#pragma once
// The press of a button: from the press until the release of the same mouse
// button the look follows the cursor (down inside, as before outside), a
// held button with interactive listeners repeats after a delay, and the
// release inside performs the button while a release outside cancels.
#include "ui/InputCapture.h"

namespace norvik::controls {

class UI_Button;

class ButtonInputCapture : public ui::InputCapture {
 public:
  // inRepeatInterval 0 installs no timer.
  ButtonInputCapture(UI_Button* inButton, const ui::MouseEvent& inEvent, float inRepeatInterval);

  void Begin() override;
  void End() override;
  bool DoMouseEvent(const ui::MouseEvent& inEvent) override;
  bool DoTimerNotify(long inTimerID) override;

  bool HasRepeated() const { return mRepeated; }

 private:
  UI_Button* Button() const;

  bool mSavedDownState = false;
  float mRepeatInterval;
  tarsel::utility::Flags<unsigned char> mModKeys;
  double mStartTime = 0;
  long mTimerID;
  bool mRepeated = false;
};

}  // namespace norvik::controls
