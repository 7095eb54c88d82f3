#include "ui/MouseEvent.h"

namespace norvik::ui {

MouseEvent::MouseEvent(Action inAction, int inButton, int inClickCount, const tarsel::geom::PointT<float>& inPosition,
                       ModifierKeys inModKeys, const OS_Event& inOSEvent, int inWheelDelta, int inWheelAxis,
                       float inRotationDegrees, float inMagnificationAmount)
    : mAction(inAction),
      mButton(inButton),
      mPhysicalButton(inButton),
      mClickCount(inClickCount),
      mPosition(inPosition),
      mModKeys(inModKeys),
      mOSEvent(inOSEvent),
      mWheelDelta(inWheelDelta),
      mWheelAxis(inWheelAxis),
      mRotationDegrees(inRotationDegrees),
      mMagnificationAmount(inMagnificationAmount) {}

bool MouseEvent::IsButtonSingleDown(int inButton) const {
  return mAction == kActionButtonDown && IsButton(inButton) && mClickCount == 1;
}

bool MouseEvent::IsButtonDoubleClick(int inButton) const {
  return mAction == kActionButtonUp && IsButton(inButton) && mClickCount == 2;
}

bool MouseEvent::IsEndDragEvent(const MouseEvent& inInitial) const {
  return mAction == kActionButtonUp && mPhysicalButton == inInitial.mPhysicalButton;
}

bool MouseEvent::IsHorizontalScroll() const {
  return mWheelAxis == kWheelAxisHorizontal || mModKeys.Test(kModKeyShift);
}

}  // namespace norvik::ui
