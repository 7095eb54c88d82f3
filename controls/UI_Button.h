#pragma once
// UI_Button is the one press gesture of the toolkit: the press capture with
// rollover tracking and repeat, keyboard activation, drag-and-drop onto a
// button, tool tips that change with the modifier keys, and the two-tier
// bevel that every chromed control paints. Derived buttons add a face (what
// stands on the bevel) and a value rule.
#include <utility>
#include <vector>

#include <boost/function.hpp>
#include <boost/shared_ptr.hpp>

#include "controls/DrawParameters.h"
#include "controls/UI_ColorChangeSupport.h"
#include "controls/UI_InteractiveControlView.h"
#include "tarsel/PointT.h"

namespace norvik::controls {

class UI_Button;

// What a drag over a button carries, for its drag support function.
struct DropSupportData {
  tarsel::geom::PointT<float> point;
  datatransfer::OS_ReceiveData* data = nullptr;
  unsigned long* effect = nullptr;
};

class UI_Button : public UI_InteractiveControlView, public UI_ColorChangeSupport {
 public:
  enum ButtonValue : std::int32_t { kButtonOff = 0, kButtonOn = 1 };
  enum DropAction { kDropEnter = 0, kDropOver = 1, kDropLeave = 2, kDropDrop = 3 };
  enum DisplayMode : std::int32_t { kDisplayByState = 0, kDisplayAlways = 1, kDisplayNever = 2 };
  using DragSupportFunction = boost::function<bool(DropAction, UI_Button&, DropSupportData*)>;
  using DragSupportFunctionP = boost::shared_ptr<DragSupportFunction>;

  UI_Button();
  ~UI_Button() override;

  static float GetDefaultButtonRepeatDelay() { return 0.25f; }
  static float GetDefaultButtonRepeatInterval() { return 0.05f; }
  static float GetDefaultCornerRadius() { return 0; }

  // ---- virtual operations added here ----
  virtual void PerformAction(bool inDown, ModKeys inModKeys, bool inSendInteractive);
  virtual void SetWantsDragDropEvents(bool inWants) { mWantsDragDropEvents = inWants; }
  virtual void SetDragSupportFxn(const DragSupportFunctionP& inFunction) { mDragSupport = inFunction; }
  virtual bool HandleControlActivateViaKeyboard(const ui::KeyboardEvent& inEvent);
  virtual void SendButtonChangedMessage(ModKeys inModKeys);
  virtual void ModKeyChanged(ModKeys inModKeys);

  // ---- overrides of the node ----
  bool UI_DoMouseEvent(ui::UI_Node* inTarget, const ui::MouseEvent& inEvent) override;
  bool UI_InvalidateOnMouseOverChange(bool) const override { return true; }
  bool UI_DoKeyboardEvent(ui::UI_Node* inTarget, const ui::KeyboardEvent& inEvent) override;
  bool UI_GainKeyboardFocus(ui::FocusChangeReason inReason) override;
  void UI_LoseKeyboardFocus() override;
  bool UI_WantsDragDropEvents() const override;
  bool UI_HandleDragEnter(const PointF& inPoint, datatransfer::OS_ReceiveData* inData,
                          unsigned long& outEffect) override;
  bool UI_HandleDragOver(const PointF& inPoint, datatransfer::OS_ReceiveData* inData,
                         unsigned long& outEffect) override;
  void UI_HandleDragLeave(datatransfer::OS_ReceiveData* inData) override;
  bool UI_HandleDrop(const PointF& inPoint, datatransfer::OS_ReceiveData* inData, unsigned long& outEffect) override;
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;

  // ---- value and behaviour ----
  ButtonValue GetValue() const { return mValue; }
  void SetValue(ButtonValue inValue);
  void SetSpringLoaded(bool inSpring);
  bool IsSpringLoaded() const { return mSpringLoaded; }
  void SetNotificationOnMouseDown(bool inOn) { mNotificationOnMouseDown = inOn; }
  void SetNotificationOnMouseUp(bool inOn) { mNotificationOnMouseUp = inOn; }
  void SetChangeFocusOnClick(bool inChange) { mChangeFocusOnClick = inChange; }
  bool IsButtonCaptured() const;
  bool IsKeyDownPending() const { return mKeyDownPending; }

  // ---- looks ----
  void SetDefaultAppearance(bool inDefault);
  bool GetDefaultAppearance() const { return mDefaultAppearance; }
  void SetCornerRadius(float inRadius);
  void SetDownOffset(const PointF& inOffset);
  const PointF& GetDownOffset() const { return mDownOffset; }
  void SetContentOffset(const PointF& inOffset);
  const PointF& GetContentOffset() const { return mContentOffset; }
  void SetStrokeSizes(const std::pair<float, float>& inSizes);
  std::pair<float, float> GetStrokeSizes() const { return mStrokeSizes; }
  void SetDisplayBorderAlways(bool inOn) { SetDisplay(mBorderDisplay, inOn ? kDisplayAlways : kDisplayByState); }
  void SetDisplayBorderNever(bool inOn) { SetDisplay(mBorderDisplay, inOn ? kDisplayNever : kDisplayByState); }
  bool ShouldDisplayBorderAlways() const { return mBorderDisplay == kDisplayAlways; }
  bool ShouldDisplayBorderNever() const { return mBorderDisplay == kDisplayNever; }
  void SetDisplayContainerAlways(bool inOn) { SetDisplay(mContainerDisplay, inOn ? kDisplayAlways : kDisplayByState); }
  void SetDisplayContainerNever(bool inOn) { SetDisplay(mContainerDisplay, inOn ? kDisplayNever : kDisplayByState); }
  bool ShouldDisplayContainerAlways() const { return mContainerDisplay == kDisplayAlways; }
  bool ShouldDisplayContainerNever() const { return mContainerDisplay == kDisplayNever; }
  void SetInsetUndrawnSpace(bool inInset);
  // With this on, a button at rest (not down, lit or focused) paints no
  // chrome at all, only its face: a tool-bar look.
  void SetDisplayChromelessNormalState(bool inOn);
  bool GetDisplayChromelessNormalState() const { return mChromelessNormalState; }

  // ---- modifier tool tips ----
  void InsertModifiedToolTip(ModKeys inKeys, const UTF16String& inText);
  void SetModifierKeyCallbackEnabled(bool inEnabled);

  // Paints the bevel (and the face the parameters point at) with no control.
  static void Draw(const DrawButtonParameters& inParams, drawbot::Drawbot& inDrawbot);

 protected:
  // Fills the button part of a record from this button's settings.
  void FillButtonParameters(DrawButtonParameters& ioParams) const;
  // Inside a dialog, the button that holds focus draws as the dialog's
  // default button; a default button with focus takes the second stroke size.
  void FillDefaultAppearance(DrawButtonParameters& ioParams) const;
  ModKeys GetCurrentModKeys() const { return mCurrentModKeys; }
  const std::vector<std::pair<ModKeys, UTF16String>>& GetModifiedToolTips() const { return mModifiedToolTips; }
  ModKeys GetModifierKeyMask() const { return mModifierKeyMask; }

 private:
  void SetDisplay(std::int32_t& ioField, std::int32_t inValue);
  void ButtonFocusChangedHandler(ui::UI_Node* inNode, ui::FocusChangeReason inReason);

  ModKeys mCurrentModKeys;
  std::vector<std::pair<ModKeys, UTF16String>> mModifiedToolTips;
  bool mWantsDragDropEvents = false;
  DragSupportFunctionP mDragSupport;
  ModKeys mModifierKeyMask;
  UTF16String mBaseToolTip;
  boost::shared_ptr<boost::function<void(ui::ModifierKeys)>> mModKeyConnection;
  bool mModifierKeyCallbackEnabled = false;
  ButtonValue mValue = kButtonOff;
  bool mSpringLoaded = true;
  bool mNotificationOnMouseDown = false;
  bool mNotificationOnMouseUp = false;
  bool mDefaultAppearance = false;
  bool mChangeFocusOnClick = true;
  float mCornerRadius = 0;
  std::pair<float, float> mStrokeSizes{1.0f, 2.0f};
  PointF mDownOffset;
  PointF mContentOffset;
  bool mKeyDownPending = false;
  std::int32_t mBorderDisplay = kDisplayByState;
  std::int32_t mContainerDisplay = kDisplayByState;
  bool mChromelessNormalState = false;
  bool mDrawInnerBevelOutline = true;
  bool mDrawOuterBevelOutline = true;
  bool mDrawInnerGradient = true;
  bool mInsetUndrawnSpace = true;
  ui::UI_Node::FocusChangedFunction mFocusChangedFunction;
};

using UI_ButtonP = boost::intrusive_ptr<UI_Button>;

}  // namespace norvik::controls
