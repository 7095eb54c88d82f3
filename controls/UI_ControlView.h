#pragma once
// UI_ControlView is the base of every control: the known/unknown value state,
// the pressed (down) look, the keyboard focus wish, the mnemonic of its label
// and the lists of listeners told of hovering and of changes.
//
// A control paints from a snapshot of these (GetControlState and the
// DrawParameters family), never from the live node, so that the same drawing
// code can paint a control's look inside a list cell with no control at all.
#include <cstdint>
#include <list>
#include <memory>
#include <vector>

#include <boost/function.hpp>
#include <boost/shared_ptr.hpp>

#include "controls/ControlMessages.h"
#include "tarsel/Flags.h"
#include "tarsel/UTFString.h"
#include "ui/KeyboardCode.h"
#include "ui/UI_NodeManager.h"
#include "ui/UI_SubView.h"

namespace norvik::controls {

// Calls the listeners of a snapshot of inList in order. Entries that are null
// or hold no function are skipped: listeners are never removed one by one,
// so emptying an entry is how a client switches itself off.
template <class List, class Message>
void CallListeners(const List& inList, Message* inMessage) {
  if (inList.empty()) return;
  const std::vector<typename List::value_type> snapshot(inList.begin(), inList.end());
  for (const auto& entry : snapshot)
    if (entry && *entry) (*entry)(inMessage);
}

class UI_ControlView : public ui::UI_SubView {
 public:
  // Bits of GetControlState.
  static constexpr unsigned long kStateDown = 1;
  static constexpr unsigned long kStateRollover = 2;
  static constexpr unsigned long kStateDisabled = 4;
  static constexpr unsigned long kStateFocused = 8;

  using UnknownStateFunction = boost::function<void(UI_ControlView*)>;

  UI_ControlView();
  ~UI_ControlView() override;

  // ---- virtual operations added here ----
  virtual void SetValueUnknown();
  virtual void SetDownState(bool inDown);
  virtual void SetWantsKeyboardFocus(bool inWants);
  virtual void SetSuppressFocusDrawing(bool inSuppress);
  // Whether this control may light up while inCapture runs: only when the
  // capture belongs to it or to one of its children.
  virtual bool DoDrawRollover(const ui::InputCapture& inCapture) const;
  // Copies inInput to outOutput, finds its mnemonic and strips the markers.
  virtual bool UI_ProcessStringAndSetMnemonic(const UTF16String& inInput, UTF16String& outOutput);
  virtual bool UI_CanGainSingleKeyMnemonicFocus() const;
  virtual bool UI_AllowsSingleKeyMnemonic() const { return true; }
  virtual void UI_TurnOnMnemonicDisplay();
  virtual void UI_TurnOffMnemonicDisplay();
  virtual void SetValueKnown();
  virtual void KnownValueStateChanged();
  virtual void SendValueChangedMessage();
  virtual void SendHover(const ui::MouseEvent& inEvent);

  // ---- overrides of the node ----
  bool UI_DoPreKeyboardEvent(ui::UI_Node* inTarget, const ui::KeyboardEvent& inEvent) override;
  bool UI_InvalidateOnKeyboardFocusChange(bool) const override { return true; }
  bool UI_WantsKeyboardFocus() const override;
  bool UI_WantsKeyboardFocusFromAdvance() const override { return UI_WantsKeyboardFocus(); }
  bool UI_GainKeyboardFocus(ui::FocusChangeReason inReason) override;

  // ---- state ----
  StateFlags GetControlState(bool inCheckCapture) const;
  bool IsValueUnknown() const { return mValueUnknown; }
  bool IsValueKnown() const { return !mValueUnknown; }
  bool GetDownState() const { return mDownState; }
  void ToggleDownState() { SetDownState(!mDownState); }
  bool GetWantsKeyboardFocus() const { return mWantsKeyboardFocus; }
  bool GetSuppressFocusDrawing() const { return mSuppressFocusDrawing; }
  bool IsDisabled() const { return UI_IsDisabled(); }
  void SetDisabled(bool inDisabled) { UI_SetDisabled(inDisabled); }
  bool IsEnabled() const { return !IsDisabled(); }
  void SetEnabled(bool inEnabled) { SetDisabled(!inEnabled); }
  static float DefaultTextSize();
  static std::uint64_t DefaultTextSizeId() { return 0; }

  // ---- mnemonics ----
  bool GetDisplayMnemonic() const { return mDisplayMnemonic; }
  ui::KeyboardCode GetMnemonicKey() const { return mMnemonicKey; }
  std::int64_t GetMnemonicLocation() const { return mMnemonicLocation; }
  void SetMnemonicLocation(std::int64_t inLocation) { mMnemonicLocation = inLocation; }

  // ---- listeners ----
  void NotifyWhenChanged(const ControlChangedFunctionP& inFunction) { mChangedList.push_back(inFunction); }
  void NotifyHover(const HoverFunctionP& inFunction) { mHoverList.push_back(inFunction); }
  void NotifyWhenUnknownStateChanged(const UnknownStateFunction& inFunction);
  static void SendControlMessage(const ControlChangedFunctionP& inFunction, UI_ControlChangedMessage* inMessage);
  static void SendControlMessages(const std::list<ControlChangedFunctionP>& inList,
                                  UI_ControlChangedMessage* inMessage);
  // Sends a child's message to this control's listeners as this control's own.
  void ForwardControlMessageFromChild(UI_ControlChangedMessage* inMessage);

 protected:
  void UI_SetMnemonicsShown(bool inShown) override;
  const std::list<ControlChangedFunctionP>& GetChangedList() const { return mChangedList; }

 private:
  boost::shared_ptr<UnknownStateFunction> mUnknownStateFunction;
  std::list<HoverFunctionP> mHoverList;
  std::list<ControlChangedFunctionP> mChangedList;
  std::unique_ptr<ui::UI_NodeManager::AddAndRemoveKeyboardEventFilterNode> mMnemonicFilter;
  bool mValueUnknown = true;
  bool mDownState = false;
  bool mWantsKeyboardFocus = false;
  bool mSuppressFocusDrawing = false;
  bool mDisplayMnemonic = false;
  ui::KeyboardCode mMnemonicKey;
  std::int64_t mMnemonicLocation = -1;
};

using UI_ControlViewP = boost::intrusive_ptr<UI_ControlView>;

}  // namespace norvik::controls
