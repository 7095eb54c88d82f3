#include "controls/UI_Button.h"

#include "controls/ButtonInputCapture.h"
#include "ui/KeyboardEvent.h"
#include "ui/MouseEvent.h"
#include "ui/UI_DialogHost.h"
#include "ui/UI_ModKeyNotifier.h"
#include "ui/UI_NodeManager.h"

namespace norvik::controls {

namespace {
constexpr const char* kLoseFocusOnEscKey = "norvik.controls.UI_Button.LoseFocusOnESC";
}

UI_Button::UI_Button() {
  UI_SetNodeID("UI_Button");
  // Every button starts known and off: the body of SetValue(0).
  SetValue(kButtonOff);
}

UI_Button::~UI_Button() {
  // The notifier keeps its entry; turn it into a no-op so it never reaches a dead button.
  if (mModKeyConnection) *mModKeyConnection = [](ui::ModifierKeys) {};
}

// ---- value ----

void UI_Button::SetValue(ButtonValue inValue) {
  const bool wasUnknown = IsValueUnknown();
  if (wasUnknown) SetValueKnown();
  const bool changed = mValue != inValue;
  mValue = inValue;
  const bool target = inValue == kButtonOn;
  if (wasUnknown || changed) {
    UI_Invalidate(nullptr, 0);
    SetDownState(target);
  } else if (GetDownState() != target) {
    SetDownState(target);
  }
}

void UI_Button::SetSpringLoaded(bool inSpring) {
  if (mSpringLoaded == inSpring) return;
  mSpringLoaded = inSpring;
  UI_Invalidate(nullptr, 0);
}

void UI_Button::PerformAction(bool inDown, ModKeys inModKeys, bool inSendInteractive) {
  if (UI_IsDisabled()) return;
  ui::UI_NodeProtector protector(this);
  SetValueKnown();
  SetDownState(mSpringLoaded ? false : inDown);
  SendButtonChangedMessage(inModKeys);
  if (inSendInteractive) {
    ScBeginAndEndInteractiveChange change(this);
    ContinueInteractiveChange(inModKeys);
    change.Finish();
  }
}

void UI_Button::SendButtonChangedMessage(ModKeys inModKeys) {
  ui::UI_NodeProtector protector(this);
  SetValue(GetDownState() ? kButtonOn : kButtonOff);
  if (GetChangedList().empty()) return;
  UI_ButtonChangedMessage message(this, inModKeys);
  SendControlMessages(GetChangedList(), &message);
}

bool UI_Button::IsButtonCaptured() const {
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst();
  return manager && dynamic_cast<const ButtonInputCapture*>(manager->GetActiveInputCapture(nullptr)) != nullptr;
}

// ---- mouse ----

bool UI_Button::UI_DoMouseEvent(ui::UI_Node*, const ui::MouseEvent& inEvent) {
  if (UI_IsDisabled()) return false;
  ui::UI_NodeProtector protector(this);
  SendHover(inEvent);
  ui::UI_NodeManager* manager = ui::UI_NodeManager::Get();
  if (inEvent.IsAction(ui::MouseEvent::kActionButtonDown) && inEvent.IsButton(ui::MouseEvent::kButtonLeft)) {
    if (mChangeFocusOnClick) UI_GainKeyboardFocus(ui::kFocusChangeMouse);
    if (mSpringLoaded) SetDownState(false);
    if (mNotificationOnMouseDown) {
      const bool toggled = !GetDownState();
      SetDownState(toggled);
      PerformAction(toggled, inEvent.GetModKey(), false);
    } else if (manager) {
      const float interval = InteractiveCallbackSize() > 0 ? GetDefaultButtonRepeatInterval() : 0.0f;
      manager->BeginInputCapture(ui::InputCaptureP(new ButtonInputCapture(this, inEvent, interval)));
    }
    return true;
  }
  if (inEvent.IsAction(ui::MouseEvent::kActionButtonUp) && inEvent.IsButton(ui::MouseEvent::kButtonLeft) &&
      mNotificationOnMouseUp && !(manager && manager->GetActiveInputCapture(nullptr))) {
    PerformAction(false, inEvent.GetModKey(), false);
    return true;
  }
  return false;
}

// ---- keyboard ----

bool UI_Button::UI_DoKeyboardEvent(ui::UI_Node*, const ui::KeyboardEvent& inEvent) {
  if (UI_IsDisabled()) return false;
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst();
  const ui::CustomSettingsManager* settings = manager ? manager->GetCustomSettingsManager() : nullptr;
  const bool loseFocusOnEsc = settings ? settings->GetBool(kLoseFocusOnEscKey, true) : true;
  if (loseFocusOnEsc && inEvent.IsActionKeyDown() &&
      inEvent.CompareShortcut(ui::KeyboardCode::CreateFromControlCode(ui::kControlCodeEscape), ui::kModKeyNone)) {
    UI_LoseKeyboardFocus();
    return false;
  }
  if (ui::UI_NodeManager::CompareControlActivateShortcut(inEvent)) return HandleControlActivateViaKeyboard(inEvent);
  return false;
}

bool UI_Button::HandleControlActivateViaKeyboard(const ui::KeyboardEvent& inEvent) {
  if (inEvent.IsActionKeyDown()) {
    mKeyDownPending = true;
    SetDownState(mSpringLoaded ? true : !GetDownState());
    return true;
  }
  if (!inEvent.IsActionKeyUp()) return false;
  mKeyDownPending = false;
  // A spring-loaded button that is up here lost its press to a focus change.
  if (mSpringLoaded && !GetDownState()) return false;
  ui::UI_NodeProtector protector(this);
  ScBeginAndEndInteractiveChange change(this);
  PerformAction(mSpringLoaded ? true : GetDownState(), inEvent.GetModKey(), false);
  ContinueInteractiveChange(inEvent.GetModKey());
  change.Finish();
  return true;
}

// ---- focus ----

bool UI_Button::UI_GainKeyboardFocus(ui::FocusChangeReason inReason) {
  ui::UI_NodeProtector protector(this);
  if (!mFocusChangedFunction) {
    mFocusChangedFunction = ui::UI_Node::FocusChangedFunction(
        new boost::function<void(ui::UI_Node*, ui::FocusChangeReason)>(
            [this](ui::UI_Node* inNode, ui::FocusChangeReason inWhy) { ButtonFocusChangedHandler(inNode, inWhy); }));
    InstallFocusChangedFunction(mFocusChangedFunction);
  }
  const bool gained = UI_InteractiveControlView::UI_GainKeyboardFocus(inReason);
  if (gained && inReason == ui::kFocusChangeMnemonic) PerformAction(true, mCurrentModKeys, true);
  return gained;
}

void UI_Button::UI_LoseKeyboardFocus() {
  // The installed entry stays in the node's list, so it is emptied rather
  // than removed; a null pointer is skipped there.
  if (mFocusChangedFunction) *mFocusChangedFunction = [](ui::UI_Node*, ui::FocusChangeReason) {};
  mFocusChangedFunction.reset();
  UI_InteractiveControlView::UI_LoseKeyboardFocus();
}

void UI_Button::ButtonFocusChangedHandler(ui::UI_Node*, ui::FocusChangeReason) {
  if (!mKeyDownPending || UI_HasKeyboardFocus(false)) return;
  mKeyDownPending = false;
  SetDownState(mSpringLoaded ? false : !GetDownState());
}

// ---- modifier tool tips ----

void UI_Button::InsertModifiedToolTip(ModKeys inKeys, const UTF16String& inText) {
  if (inKeys == ModKeys() || mModifiedToolTips.empty()) mBaseToolTip = inText;
  mModifierKeyMask |= inKeys;
  mModifiedToolTips.emplace_back(inKeys, inText);
  SetModifierKeyCallbackEnabled(true);
}

void UI_Button::SetModifierKeyCallbackEnabled(bool inEnabled) {
  mModifierKeyCallbackEnabled = inEnabled;
  if (!inEnabled || mModKeyConnection) return;
  mModKeyConnection.reset(new boost::function<void(ui::ModifierKeys)>([this](ui::ModifierKeys inKeys) {
    if (mModifierKeyCallbackEnabled) ModKeyChanged(inKeys);
  }));
  ui::UI_ModKeyNotifier::Get().InstallModKeyChangedFunction(mModKeyConnection);
}

void UI_Button::ModKeyChanged(ModKeys inModKeys) {
  if (inModKeys == mCurrentModKeys) return;
  mCurrentModKeys = inModKeys;
  for (const auto& [keys, text] : mModifiedToolTips) {
    if (keys == (mModifierKeyMask & inModKeys)) {
      UI_SetToolTip(text, 400);
      return;
    }
  }
  UI_SetToolTip(mBaseToolTip, 400);
}

// ---- drag and drop ----

bool UI_Button::UI_WantsDragDropEvents() const { return mWantsDragDropEvents && mDragSupport; }

bool UI_Button::UI_HandleDragEnter(const PointF& inPoint, datatransfer::OS_ReceiveData* inData,
                                   unsigned long& outEffect) {
  DropSupportData data{inPoint, inData, &outEffect};
  if (mDragSupport && (*mDragSupport)(kDropEnter, *this, &data)) {
    SetDownState(true);
    return true;
  }
  const bool accepted = UI_InteractiveControlView::UI_HandleDragEnter(inPoint, inData, outEffect);
  if (accepted) SetDownState(true);
  return accepted;
}

bool UI_Button::UI_HandleDragOver(const PointF& inPoint, datatransfer::OS_ReceiveData* inData,
                                  unsigned long& outEffect) {
  DropSupportData data{inPoint, inData, &outEffect};
  if (mDragSupport && (*mDragSupport)(kDropOver, *this, &data)) return true;
  return UI_InteractiveControlView::UI_HandleDragOver(inPoint, inData, outEffect);
}

void UI_Button::UI_HandleDragLeave(datatransfer::OS_ReceiveData* inData) {
  SetDownState(false);
  DropSupportData data{PointF(), inData, nullptr};
  if (!(mDragSupport && (*mDragSupport)(kDropLeave, *this, &data)))
    UI_InteractiveControlView::UI_HandleDragLeave(inData);
}

bool UI_Button::UI_HandleDrop(const PointF& inPoint, datatransfer::OS_ReceiveData* inData,
                              unsigned long& outEffect) {
  SetDownState(false);
  DropSupportData data{inPoint, inData, &outEffect};
  if (mDragSupport && (*mDragSupport)(kDropDrop, *this, &data)) return true;
  return UI_InteractiveControlView::UI_HandleDrop(inPoint, inData, outEffect);
}

// ---- looks ----

void UI_Button::SetDefaultAppearance(bool inDefault) {
  if (mDefaultAppearance == inDefault) return;
  mDefaultAppearance = inDefault;
  UI_Invalidate(nullptr, 0);
}

void UI_Button::SetCornerRadius(float inRadius) {
  if (mCornerRadius == inRadius) return;
  mCornerRadius = inRadius;
  UI_Invalidate(nullptr, 0);
}

void UI_Button::SetDownOffset(const PointF& inOffset) {
  if (mDownOffset == inOffset) return;
  mDownOffset = inOffset;
  UI_Invalidate(nullptr, 0);
}

void UI_Button::SetContentOffset(const PointF& inOffset) {
  if (mContentOffset == inOffset) return;
  mContentOffset = inOffset;
  UI_Invalidate(nullptr, 0);
}

void UI_Button::SetStrokeSizes(const std::pair<float, float>& inSizes) {
  if (mStrokeSizes == inSizes) return;
  mStrokeSizes = inSizes;
  UI_Invalidate(nullptr, 0);
}

void UI_Button::SetInsetUndrawnSpace(bool inInset) {
  if (mInsetUndrawnSpace == inInset) return;
  mInsetUndrawnSpace = inInset;
  UI_Invalidate(nullptr, 0);
}

void UI_Button::SetDisplayChromelessNormalState(bool inOn) {
  if (mChromelessNormalState == inOn) return;
  mChromelessNormalState = inOn;
  UI_Invalidate(nullptr, 0);
}

void UI_Button::SetDisplay(std::int32_t& ioField, std::int32_t inValue) {
  if (ioField == inValue) return;
  ioField = inValue;
  UI_Invalidate(nullptr, 0);
}

void UI_Button::FillButtonParameters(DrawButtonParameters& ioParams) const {
  ioParams.SetDefaultAppearance(mDefaultAppearance);
  ioParams.SetCornerRadius(mCornerRadius);
  ioParams.SetStrokeSize(mStrokeSizes.first);
  ioParams.SetOffset(mContentOffset);
  ioParams.SetInsetUndrawnSpace(mInsetUndrawnSpace);
  ioParams.SetDrawInnerBevelOutline(mDrawInnerBevelOutline);
  ioParams.SetDrawOuterBevelOutline(mDrawOuterBevelOutline);
  ioParams.SetDrawInnerGradient(mDrawInnerGradient);
  ioParams.SetDrawContainer(!ShouldDisplayContainerNever());
  ioParams.SetDrawOutline(!ShouldDisplayBorderNever());
  if (mChromelessNormalState && !ioParams.GetControlState().TestAny(kStateDown | kStateRollover | kStateFocused)) {
    ioParams.SetDrawContainer(false);
    ioParams.SetDrawOutline(false);
  }
}

void UI_Button::FillDefaultAppearance(DrawButtonParameters& ioParams) const {
  if (UI_HasKeyboardFocus(false) && ui::UI_DialogHost::FindFor(this)) ioParams.SetDefaultAppearance(true);
  if (ioParams.GetDefaultAppearance() && ioParams.GetControlState().Test(kStateFocused))
    ioParams.SetStrokeSize(mStrokeSizes.second);
}

void UI_Button::UI_Draw(drawbot::Drawbot* inDrawbot) {
  DrawButtonParameters params(this);
  FillButtonParameters(params);
  if (GetDownState()) params.SetOffset(params.GetOffset() + mDownOffset);
  Draw(params, *inDrawbot);
  UI_InteractiveControlView::UI_Draw(inDrawbot);
}

}  // namespace norvik::controls
