#include "controls/UI_ButtonBar.h"

#include <algorithm>
#include <cmath>
#include <string>

#include "controls/UI_PictureButton.h"
#include "controls/UI_TextButton.h"
#include "ui/KeyboardEvent.h"

namespace norvik::controls {

namespace {
// An image segment is as wide as a small tool button, and no segment is
// narrower (a label that cannot be measured still gets a target to click).
// The height follows the text segments so that mixed rows line up.
constexpr float kImageSegmentWidth = 28;
}  // namespace

UI_ButtonBar::UI_ButtonBar() {
  UI_SetNodeID("UI_ButtonBar");
  SetWantsKeyboardFocus(true);
}

UI_ButtonBar::~UI_ButtonBar() = default;

// ---- buttons ----

int UI_ButtonBar::AddTextButton(const UTF16String& inText, double inValue, const UTF16String& inToolTip) {
  return AddButton(UI_ButtonP(new UI_TextButton(inText)), inValue, inToolTip);
}

int UI_ButtonBar::AddImageButton(const UTF8String& inImageBaseName, double inValue, const UTF16String& inToolTip) {
  boost::intrusive_ptr<UI_PictureButton> button(new UI_PictureButton);
  button->SetImageBaseName(inImageBaseName);
  return AddButton(button, inValue, inToolTip);
}

int UI_ButtonBar::AddButton(const UI_ButtonP& inButton, double inValue, const UTF16String& inToolTip) {
  const int index = static_cast<int>(mButtons.size());
  inButton->UI_SetNodeID(UI_GetNodeID() + "_TextButton_" + std::to_string(index).c_str());
  inButton->SetSpringLoaded(false);
  inButton->SetValue(UI_Button::kButtonOff);
  if (!inToolTip.empty()) inButton->UI_SetToolTip(inToolTip, 400);
  // The button is this bar's child, so the listener never outlives the bar.
  inButton->NotifyWhenChanged(ui::MakeNotification<void(UI_ControlChangedMessage*)>(
      [this](UI_ControlChangedMessage* inMessage) { SelectionChanged(inMessage); }));
  inButton->UI_Show(true);
  mButtons.push_back(Entry{inButton.get(), inValue});
  ChildPushBack(inButton);
  LayoutButtons();
  return index;
}

// The vector holds plain pointers; a removed child must leave it at once.
void UI_ButtonBar::ChildRemoved(ui::UI_Node* inChild) {
  const int index = IndexOf(inChild);
  if (index >= 0) {
    mButtons.erase(mButtons.begin() + index);
    if (mSelected == index)
      mSelected = -1;
    else if (mSelected > index)
      --mSelected;
  }
  UI_InteractiveControlView::ChildRemoved(inChild);
}

UI_Button* UI_ButtonBar::GetButton(int inIndex) const {
  if (inIndex < 0 || static_cast<std::size_t>(inIndex) >= mButtons.size()) return nullptr;
  return mButtons[static_cast<std::size_t>(inIndex)].button;
}

double UI_ButtonBar::GetButtonValue(int inIndex) const {
  return GetButton(inIndex) ? mButtons[static_cast<std::size_t>(inIndex)].value : 0.0;
}

int UI_ButtonBar::IndexOf(const ui::UI_Node* inNode) const {
  for (std::size_t i = 0; i < mButtons.size(); ++i)
    if (mButtons[i].button == inNode) return static_cast<int>(i);
  return -1;
}

void UI_ButtonBar::UI_SetButtonEnabled(int inIndex, bool inEnabled) {
  UI_Button* button = GetButton(inIndex);
  if (!button || button->IsEnabled() == inEnabled) return;
  button->SetEnabled(inEnabled);
  UI_Invalidate(nullptr, 0);
}

// ---- value ----

void UI_ButtonBar::SetValue(double inValue) {
  ui::UI_NodeProtector protector(this);
  const bool changed = IsValueUnknown() || mValue != inValue;
  mValue = inValue;
  SetValueKnown();
  mSelected = -1;
  for (std::size_t i = 0; i < mButtons.size(); ++i) {
    const bool match = mSelected < 0 && mButtons[i].value == inValue;
    if (match) mSelected = static_cast<int>(i);
    mButtons[i].button->SetValue(match ? UI_Button::kButtonOn : UI_Button::kButtonOff);
  }
  if (changed) UI_Invalidate(nullptr, 0);
}

void UI_ButtonBar::SetValueUnknown() {
  if (IsValueUnknown()) return;
  ui::UI_NodeProtector protector(this);
  mSelected = -1;
  for (const Entry& entry : mButtons) entry.button->SetValue(UI_Button::kButtonOff);
  UI_InteractiveControlView::SetValueUnknown();
}

// A click on the selected button would toggle it off; it stays on and nobody
// hears of it. Any other button becomes the selection, and the bar's
// listeners hear one change only when the bar's number moves (or was unknown).
void UI_ButtonBar::SelectionChanged(UI_ControlChangedMessage* inMessage) {
  const int index = IndexOf(inMessage->GetControl());
  if (index < 0) return;
  ui::UI_NodeProtector protector(this);
  const UI_ButtonP button(mButtons[static_cast<std::size_t>(index)].button);
  if (index == mSelected) {
    button->SetValue(UI_Button::kButtonOn);
    return;
  }
  if (UI_Button* old = GetButton(mSelected)) old->SetValue(UI_Button::kButtonOff);
  mSelected = index;
  const double value = mButtons[static_cast<std::size_t>(index)].value;
  if (value == mValue && IsValueKnown()) return;
  mValue = value;
  SetValueKnown();
  button->SetValue(UI_Button::kButtonOn);
  ForwardControlMessageFromChild(inMessage);
  UI_Invalidate(nullptr, 0);
}

// ---- keyboard ----

int UI_ButtonBar::NeighbourOfSelection(int inStep) const {
  const int count = static_cast<int>(mButtons.size());
  const int from = mSelected >= 0 ? mSelected : (inStep > 0 ? -1 : count);
  for (int i = from + inStep; i >= 0 && i < count; i += inStep) {
    const UI_Button* button = mButtons[static_cast<std::size_t>(i)].button;
    if (button->UI_IsEnabled() && button->UI_AreAllParentsVisible()) return i;
  }
  return -1;
}

bool UI_ButtonBar::UI_DoKeyboardEvent(ui::UI_Node* inTarget, const ui::KeyboardEvent& inEvent) {
  const unsigned short code = inEvent.GetCode().GetControlCode();
  const bool previous = code == ui::kControlCodeLeft || code == ui::kControlCodeUp;
  const bool next = code == ui::kControlCodeRight || code == ui::kControlCodeDown;
  ModKeys keys = inEvent.GetModKey();
  keys.Clear(ui::kModKeyCapsLock);
  if (!(previous || next) || !inEvent.IsActionKeyDown() || keys != ModKeys() || UI_IsDisabled() ||
      (inTarget != this && IndexOf(inTarget) < 0))
    return UI_InteractiveControlView::UI_DoKeyboardEvent(inTarget, inEvent);
  ui::UI_NodeProtector protector(this);
  // The press goes through the button, so the selection rule and the
  // listeners see exactly what a click would have done. At either end of the
  // row the key is still taken, so it does not move focus elsewhere.
  if (UI_Button* button = GetButton(NeighbourOfSelection(previous ? -1 : 1)))
    button->PerformAction(true, inEvent.GetModKey(), false);
  return true;
}

// ---- layout ----

ui::UI_Node::PointF UI_ButtonBar::SegmentSize() const {
  PointF size(kImageSegmentWidth, UI_TextButton::RecommendedSize(0, DefaultTextSize()).y);
  for (const Entry& entry : mButtons) {
    const bool isImage = dynamic_cast<const UI_PictureButton*>(entry.button) != nullptr;
    const PointF wanted = isImage ? PointF(kImageSegmentWidth, 0) : entry.button->UI_GetRecommendedSize();
    size.x = std::max(size.x, wanted.x);
    size.y = std::max(size.y, wanted.y);
  }
  return size;
}

float UI_ButtonBar::GetButtonbarWidth() const { return SegmentSize().x * static_cast<float>(mButtons.size()); }

float UI_ButtonBar::GetButtonbarHeight() const { return mButtons.empty() ? 0 : SegmentSize().y; }

ui::UI_Node::PointF UI_ButtonBar::UI_GetRecommendedSize() const {
  return PointF(GetButtonbarWidth(), GetButtonbarHeight());
}

std::vector<ui::UI_Node::RectF> UI_ButtonBar::LayoutRow(std::size_t inCount, const PointF& inSegmentSize) {
  std::vector<RectF> rects;
  rects.reserve(inCount);
  for (std::size_t i = 0; i < inCount; ++i)
    rects.emplace_back(inSegmentSize.x * static_cast<float>(i), 0, inSegmentSize.x, inSegmentSize.y);
  return rects;
}

// The segments keep their common width while the bar is wide enough; a
// narrower bar shares its width out among them in whole pixels, so the row
// never runs past the bar and the frame ends exactly at the last button.
ui::UI_Node::PointF UI_ButtonBar::FittedSegmentSize() const {
  PointF size = SegmentSize();
  const float width = UI_GetLocalRectF(false).width;
  const float count = static_cast<float>(mButtons.size());
  if (count > 0 && width > 0 && size.x * count > width) size.x = std::floor(width / count);
  return size;
}

void UI_ButtonBar::UI_SizeChanged(const RectF& inLocalRect) {
  LayoutButtons();
  UI_InteractiveControlView::UI_SizeChanged(inLocalRect);
}

void UI_ButtonBar::LayoutButtons() {
  ui::UI_NodeProtector protector(this);
  const std::vector<RectF> rects = LayoutRow(mButtons.size(), FittedSegmentSize());
  const std::vector<Entry> buttons(mButtons);
  for (std::size_t i = 0; i < buttons.size(); ++i) buttons[i].button->UI_SetLocalRectF(rects[i]);
  UI_Invalidate(nullptr, 0);
}

// ---- drawing ----

void UI_ButtonBar::DrawFrame(const DrawButtonParameters& inParams, drawbot::Drawbot& inDrawbot) {
  DrawButtonParameters frame(inParams);
  frame.SetDrawContainer(true);
  frame.SetDrawOutline(true);
  frame.SetDrawButtonFace(nullptr);
  UI_Button::Draw(frame, inDrawbot);
}

void UI_ButtonBar::UI_Draw(drawbot::Drawbot* inDrawbot) {
  if (!inDrawbot) return;
  if (!mButtons.empty()) DrawBarFrame(*inDrawbot);
  // The buttons paint themselves over the frame.
  UI_InteractiveControlView::UI_Draw(inDrawbot);
}

void UI_ButtonBar::DrawBarFrame(drawbot::Drawbot& inDrawbot) const {
  DrawButtonParameters params(this);
  // The bar is not repainted as the cursor crosses it, so its frame never
  // shows the rollover look; the buttons light up on their own.
  DrawParameters::StateFlags state = params.GetControlState();
  state.Clear(kStateRollover);
  params.SetControlState(state);
  // The frame spans the row as laid out, so no part of it shows beside the
  // last button.
  const RectF last = mButtons.back().button->UI_GetLocalRectF(true);
  params.SetRectF(RectF(0, 0, last.left + last.width, std::min(last.height, UI_GetLocalRectF(false).height)));
  DrawFrame(params, inDrawbot);
}

}  // namespace norvik::controls
