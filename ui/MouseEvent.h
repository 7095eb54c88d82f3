#pragma once
// One mouse event as the tree sees it. The position is always in the
// coordinates of the node that is looking at the event: the walks copy the
// event for every node and set the position on the copy.
#include "tarsel/PointT.h"
#include "ui/ModifierKeys.h"
#include "ui/OS_Event.h"

namespace norvik::ui {

class MouseEvent {
 public:
  enum Action {
    kActionNone = 0,
    kActionButtonDown = 1,
    kActionButtonUp = 2,
    kActionMove = 3,        // moved, with or without buttons held
    kActionWheel = 4,
    kActionMouseOver = 5,   // mouse-over update; sent to nodes the mouse leaves, not a real motion
  };

  enum Button {
    kButtonNone = 0,
    kButtonLeft = 1,
    kButtonMiddle = 2,
    kButtonRight = 4,
  };

  enum WheelAxis {
    kWheelAxisHorizontal = 0,
    kWheelAxisVertical = 1,
  };

  MouseEvent() = default;
  MouseEvent(Action inAction, int inButton, int inClickCount, const tarsel::geom::PointT<float>& inPosition,
             ModifierKeys inModKeys, const OS_Event& inOSEvent, int inWheelDelta = 0,
             int inWheelAxis = kWheelAxisVertical, float inRotationDegrees = 0.0f,
             float inMagnificationAmount = 0.0f);
  MouseEvent(const MouseEvent&) = default;
  MouseEvent& operator=(const MouseEvent&) = default;
  virtual ~MouseEvent() = default;

  Action GetAction() const { return mAction; }
  bool IsAction(Action inAction) const { return mAction == inAction; }
  // The buttons: the one that changed for down and up, the ones held for
  // moves and mouse-over updates.
  int GetButton() const { return mButton; }
  bool IsButton(int inButton) const { return (mButton & inButton) != 0; }
  // The button as the gesture code sees it; a control may rewrite it to treat
  // one button as another.
  int GetPhysicalButton() const { return mPhysicalButton; }
  void SetPhysicalButton(int inButton) { mPhysicalButton = inButton; }
  int GetClickCount() const { return mClickCount; }
  const tarsel::geom::PointT<float>& GetPosition() const { return mPosition; }
  void SetPosition(const tarsel::geom::PointT<float>& inPosition) { mPosition = inPosition; }
  ModifierKeys GetModKey() const { return mModKeys; }
  const OS_Event& GetOSEvent() const { return mOSEvent; }
  int GetMouseWheelDelta() const { return mWheelDelta; }
  int GetMouseWheelAxis() const { return mWheelAxis; }
  float GetRotationDegrees() const { return mRotationDegrees; }
  float GetMagnificationAmount() const { return mMagnificationAmount; }

  // A press of inButton with a click count of one.
  bool IsButtonSingleDown(int inButton) const;
  // The release that ends a double click: the count is carried on the up event.
  bool IsButtonDoubleClick(int inButton) const;
  bool IsLeftButtonSingleDown() const { return IsButtonSingleDown(kButtonLeft); }
  bool IsMiddleButtonSingleDown() const { return IsButtonSingleDown(kButtonMiddle); }
  bool IsRightButtonSingleDown() const { return IsButtonSingleDown(kButtonRight); }
  bool IsLeftButtonDoubleClick() const { return IsButtonDoubleClick(kButtonLeft); }
  bool IsMiddleButtonDoubleClick() const { return IsButtonDoubleClick(kButtonMiddle); }
  bool IsRightButtonDoubleClick() const { return IsButtonDoubleClick(kButtonRight); }
  bool IsContextMenuClick() const { return IsButtonSingleDown(kButtonRight); }
  // The release of the button that started a gesture.
  bool IsEndDragEvent(const MouseEvent& inInitial) const;
  bool IsHorizontalScroll() const;

 private:
  Action mAction = kActionNone;
  int mButton = kButtonNone;
  int mPhysicalButton = kButtonNone;
  int mClickCount = 0;
  tarsel::geom::PointT<float> mPosition;
  ModifierKeys mModKeys;
  OS_Event mOSEvent;
  int mWheelDelta = 0;
  int mWheelAxis = kWheelAxisVertical;
  float mRotationDegrees = 0.0f;
  float mMagnificationAmount = 0.0f;
};

}  // namespace norvik::ui
