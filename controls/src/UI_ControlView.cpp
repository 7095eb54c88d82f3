#include "controls/UI_ControlView.h"

#include <cctype>

#include "tarsel/StringUtils.h"
#include "ui/InputCapture.h"
#include "ui/KeyboardEvent.h"
#include "ui/Theme.h"

namespace norvik::controls {

UI_ControlView::UI_ControlView() { UI_SetNodeID("UI_ControlView"); }

UI_ControlView::~UI_ControlView() = default;

float UI_ControlView::DefaultTextSize() { return ui::GetFontSize(0); }

// ---- value state ----

void UI_ControlView::SetValueUnknown() {
  if (mValueUnknown) return;
  mValueUnknown = true;
  UI_Invalidate(nullptr, 0);
  KnownValueStateChanged();
}

void UI_ControlView::SetValueKnown() {
  if (!mValueUnknown) return;
  mValueUnknown = false;
  UI_Invalidate(nullptr, 0);
  KnownValueStateChanged();
}

void UI_ControlView::KnownValueStateChanged() {
  if (mUnknownStateFunction && *mUnknownStateFunction) {
    const boost::shared_ptr<UnknownStateFunction> keep(mUnknownStateFunction);
    (*keep)(this);
  }
}

void UI_ControlView::NotifyWhenUnknownStateChanged(const UnknownStateFunction& inFunction) {
  mUnknownStateFunction = boost::shared_ptr<UnknownStateFunction>(new UnknownStateFunction(inFunction));
}

// ---- looks ----

void UI_ControlView::SetDownState(bool inDown) {
  if (mDownState == inDown) return;
  mDownState = inDown;
  UI_Invalidate(nullptr, 0);
}

void UI_ControlView::SetWantsKeyboardFocus(bool inWants) {
  if (mWantsKeyboardFocus == inWants) return;
  mWantsKeyboardFocus = inWants;
  UI_Invalidate(nullptr, 0);
}

void UI_ControlView::SetSuppressFocusDrawing(bool inSuppress) {
  if (mSuppressFocusDrawing == inSuppress) return;
  mSuppressFocusDrawing = inSuppress;
  UI_Invalidate(nullptr, 0);
}

bool UI_ControlView::DoDrawRollover(const ui::InputCapture& inCapture) const {
  const ui::UI_Node* node = inCapture.GetNode();
  return node && (node == this || node->UI_IsChildOf(*this));
}

UI_ControlView::StateFlags UI_ControlView::GetControlState(bool inCheckCapture) const {
  StateFlags state;
  state.Set(kStateDown, mDownState);
  state.Set(kStateRollover, UI_IsMouseOver(false));
  state.Set(kStateDisabled, UI_IsDisabled());
  state.Set(kStateFocused, UI_HasKeyboardFocus(false));
  if (!inCheckCapture) return state;
  if (const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst()) {
    if (const ui::InputCaptureP& capture = manager->GetInputCapture(); capture && state.Test(kStateRollover))
      state.Set(kStateRollover, DoDrawRollover(*capture));
  }
  if (mSuppressFocusDrawing) state.Clear(kStateFocused);
  return state;
}

// ---- focus ----

bool UI_ControlView::UI_WantsKeyboardFocus() const { return mWantsKeyboardFocus && !UI_IsDisabled(); }

bool UI_ControlView::UI_GainKeyboardFocus(ui::FocusChangeReason inReason) {
  if (inReason == ui::kFocusChangeLoss) return false;
  return UI_SubView::UI_GainKeyboardFocus(inReason);
}

// ---- mnemonics ----

bool UI_ControlView::UI_ProcessStringAndSetMnemonic(const UTF16String& inInput, UTF16String& outOutput) {
  outOutput = inInput;
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst();
  if (!manager || !manager->IsMnemonicEnabled()) return false;
  bool found = false;
  if (!outOutput.empty()) {
    const std::u16string_view text(outOutput.data(), outOutput.size());
    const long at = tarsel::utility::LocateSingleAmpersandInString(text, false);
    const char16_t marked = at >= 0 && static_cast<std::size_t>(at + 1) < outOutput.size() ? outOutput[at + 1] : 0;
    const unsigned short upper =
        marked < 128 ? static_cast<unsigned short>(std::toupper(marked)) : static_cast<unsigned short>(marked);
    if (upper != 0) {
      mMnemonicKey = ui::KeyboardCode::CreateFromKeyboardChar(upper, false);
      mMnemonicLocation = tarsel::utility::LocateSingleAmpersandInString(text, true);
      if (!mMnemonicFilter)
        mMnemonicFilter = std::make_unique<ui::UI_NodeManager::AddAndRemoveKeyboardEventFilterNode>(
            ui::UI_NodeManager::Get(), this);
      found = true;
    } else {
      mMnemonicKey = ui::KeyboardCode(ui::KeyboardCode::kNoCode);
    }
  }
  tarsel::utility::StripDisplayString(outOutput);
  return found;
}

bool UI_ControlView::UI_CanGainSingleKeyMnemonicFocus() const {
  const auto* leaf = dynamic_cast<const UI_ControlView*>(ui::UI_Node::UI_GetKeyboardFocusLeafNode());
  return leaf && leaf->UI_AllowsSingleKeyMnemonic();
}

void UI_ControlView::UI_TurnOnMnemonicDisplay() {
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst();
  mDisplayMnemonic = manager && manager->IsMnemonicEnabled();
}

void UI_ControlView::UI_TurnOffMnemonicDisplay() { mDisplayMnemonic = false; }

void UI_ControlView::UI_SetMnemonicsShown(bool inShown) {
  if (inShown)
    UI_TurnOnMnemonicDisplay();
  else
    UI_TurnOffMnemonicDisplay();
  UI_Invalidate(nullptr, 0);
}

bool UI_ControlView::UI_DoPreKeyboardEvent(ui::UI_Node*, const ui::KeyboardEvent& inEvent) {
  if (!inEvent.IsActionKeyDown()) return false;
  const bool matches = inEvent.CompareShortcut(mMnemonicKey, ui::kModKeyAlt) ||
                       (inEvent.CompareShortcut(mMnemonicKey, ui::kModKeyNone) && UI_CanGainSingleKeyMnemonicFocus());
  if (matches && !UI_IsDisabled() && UI_AreAllParentsVisible()) {
    ui::UI_NodeProtector protector(this);
    SetWantsKeyboardFocus(true);
    UI_GainKeyboardFocus(ui::kFocusChangeMnemonic);
    ui::FlushPostActionKeyEvents(inEvent);
    return true;
  }
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst();
  const ModKeys keys = inEvent.GetModKey() & ModKeys(static_cast<unsigned char>(~ui::kModKeyCapsLock));
  if (keys == ModKeys(ui::kModKeyAlt) && manager && manager->IsMnemonicEnabled()) {
    UI_TurnOnMnemonicDisplay();
    UI_Invalidate(nullptr, 0);
  }
  return false;
}

// ---- listeners ----

void UI_ControlView::SendControlMessage(const ControlChangedFunctionP& inFunction,
                                        UI_ControlChangedMessage* inMessage) {
  if (inFunction && *inFunction) (*inFunction)(inMessage);
}

void UI_ControlView::SendControlMessages(const std::list<ControlChangedFunctionP>& inList,
                                         UI_ControlChangedMessage* inMessage) {
  CallListeners(inList, inMessage);
}

void UI_ControlView::SendValueChangedMessage() {
  if (mChangedList.empty()) return;
  ui::UI_NodeProtector protector(this);
  UI_ControlChangedMessage message(this);
  SendControlMessages(mChangedList, &message);
}

void UI_ControlView::ForwardControlMessageFromChild(UI_ControlChangedMessage* inMessage) {
  inMessage->SetControl(this);
  SendControlMessages(mChangedList, inMessage);
}

void UI_ControlView::SendHover(const ui::MouseEvent& inEvent) {
  if (mHoverList.empty()) return;
  if (!inEvent.IsAction(ui::MouseEvent::kActionMouseOver) && !inEvent.IsAction(ui::MouseEvent::kActionMove)) return;
  ui::UI_NodeProtector protector(this);
  UI_HoverMessage message(this, inEvent);
  CallListeners(mHoverList, &message);
}

}  // namespace norvik::controls
