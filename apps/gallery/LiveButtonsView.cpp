#include "LiveButtonsView.h"

#include <algorithm>

#include "GalleryViews.h"
#include "controls/UI_ButtonBar.h"
#include "controls/UI_Checkbox.h"
#include "controls/UI_DisclosureTriangleButton.h"
#include "controls/UI_RadioGroup.h"
#include "controls/UI_TextButton.h"
#include "ui/MessageT.h"

namespace norvik::gallery {

namespace {

constexpr float kGap = 14;
constexpr float kRadioWidth = 84;

// inKeyText's text with ^0 replaced by inValue.
UTF16String Fill(std::string_view inKeyText, const UTF16String& inValue) {
  UTF16String text = Text(inKeyText);
  const std::size_t at = text.find(u"^0");
  if (at != UTF16String::npos) text.replace(at, 2, inValue);
  return text;
}

UTF16String OnOff(bool inOn) {
  return inOn ? Text("$$$/norvik/gallery/Buttons/Live/On=on") : Text("$$$/norvik/gallery/Buttons/Live/Off=off");
}

}  // namespace

LiveButtonsView::LiveButtonsView() {
  UI_SetNodeID("live-buttons");
  auto* group = new controls::UI_RadioGroup();
  mRadioGroup.reset(group);
  mRadioGroup->UI_SetNodeID("live-radio-group");
  for (const char* key : {"$$$/norvik/gallery/Buttons/Live/Mono=Mono", "$$$/norvik/gallery/Buttons/Live/Stereo=Stereo",
                          "$$$/norvik/gallery/Buttons/Live/Surround=5.1"}) {
    ui::UI_NodeP radio(new controls::UI_RadioButton(Text(key)));
    static_cast<controls::UI_ControlView*>(radio.get())->SetWantsKeyboardFocus(true);
    AddGalleryChild(group, radio);
    mRadios.push_back(radio);
  }
  group->SetIndex(1);
  for (int k = 0; k < kButtonKindCount; ++k) {
    const ButtonKind kind = KindAt(k);
    if (kind == ButtonKind::kRadio) {
      mButtons.emplace_back(static_cast<controls::UI_ControlView*>(mRadios.front().get()));
      mItems.push_back(mRadioGroup);
      Listen(*group, kind);
      continue;
    }
    controls::UI_ControlViewP button = MakeLiveButton(kind);
    button->SetWantsKeyboardFocus(true);
    mButtons.push_back(button);
    mItems.push_back(button);
    Listen(*button, kind);
  }
  for (const ui::UI_NodeP& item : mItems) AddGalleryChild(this, item);
  mStatus = Text("$$$/norvik/gallery/Buttons/Live/Hint=Click a button: what it did shows here.");
}

void LiveButtonsView::Listen(controls::UI_ControlView& inControl, ButtonKind inKind) {
  inControl.NotifyWhenChanged(ui::MakeNotification<void(controls::UI_ControlChangedMessage*)>(
      [this, inKind](controls::UI_ControlChangedMessage*) { SetStatus(Describe(inKind)); }));
}

UTF16String LiveButtonsView::Describe(ButtonKind inKind) const {
  const controls::UI_ControlView& control = *mButtons[static_cast<int>(inKind)];
  const auto* button = dynamic_cast<const controls::UI_Button*>(&control);
  const bool on = button && button->GetValue() == controls::UI_Button::kButtonOn;
  switch (inKind) {
    case ButtonKind::kText: return Text("$$$/norvik/gallery/Buttons/Live/Text=Text button pressed");
    case ButtonKind::kDefaultText: return Text("$$$/norvik/gallery/Buttons/Live/Default=Default button pressed");
    case ButtonKind::kPicture: return Text("$$$/norvik/gallery/Buttons/Live/Picture=Picture button pressed");
    case ButtonKind::kPictureText:
      return Text("$$$/norvik/gallery/Buttons/Live/PictureText=Picture and text button pressed");
    case ButtonKind::kOwnerDraw: return Text("$$$/norvik/gallery/Buttons/Live/Owner=Owner-drawn button pressed");
    case ButtonKind::kLock:
      return on ? Text("$$$/norvik/gallery/Buttons/Live/Locked=Lock: locked")
                : Text("$$$/norvik/gallery/Buttons/Live/Unlocked=Lock: unlocked");
    case ButtonKind::kLink:
      return on ? Text("$$$/norvik/gallery/Buttons/Live/Linked=Link: proportions linked")
                : Text("$$$/norvik/gallery/Buttons/Live/Unlinked=Link: proportions free");
    case ButtonKind::kDisclosure:
      return on ? Text("$$$/norvik/gallery/Buttons/Live/Open=Disclosure triangle: open")
                : Text("$$$/norvik/gallery/Buttons/Live/Closed=Disclosure triangle: closed");
    case ButtonKind::kCheckbox:
      return Fill("$$$/norvik/gallery/Buttons/Live/Checkbox=Checkbox: ^0",
                  OnOff(static_cast<const controls::UI_Checkbox&>(control).IsChecked()));
    case ButtonKind::kTriStateCheckbox: {
      const auto value = static_cast<const controls::UI_Checkbox&>(control).GetValue();
      return Fill("$$$/norvik/gallery/Buttons/Live/TriState=Tri-state checkbox: ^0",
                  value == controls::UI_Checkbox::kMixed ? Text("$$$/norvik/gallery/Buttons/Live/Mixed=mixed")
                                                         : OnOff(value == controls::UI_Checkbox::kOn));
    }
    case ButtonKind::kRadio: {
      const controls::UI_RadioButton* selected = GetRadioGroup()->GetSelectedRadioButton();
      return Fill("$$$/norvik/gallery/Buttons/Live/Radio=Radio: ^0", selected ? selected->GetText() : UTF16String());
    }
    case ButtonKind::kButtonBar: {
      const auto& bar = static_cast<const controls::UI_ButtonBar&>(control);
      const auto* selected = dynamic_cast<const controls::UI_TextButton*>(bar.GetButton(bar.GetSelectedIndex()));
      return Fill("$$$/norvik/gallery/Buttons/Live/ButtonBar=Button bar: ^0",
                  selected ? selected->GetText() : UTF16String());
    }
  }
  return UTF16String();
}

void LiveButtonsView::SetStatus(const UTF16String& inStatus) {
  if (inStatus == mStatus) return;
  mStatus = inStatus;
  UI_Invalidate(nullptr, 0);
}

controls::UI_ControlView* LiveButtonsView::GetButton(ButtonKind inKind) const {
  return mButtons[static_cast<int>(inKind)].get();
}

controls::UI_RadioGroup* LiveButtonsView::GetRadioGroup() const {
  return static_cast<controls::UI_RadioGroup*>(mRadioGroup.get());
}

std::vector<RectF> LiveButtonsView::Flow(float inWidth, float& outBottom) const {
  std::vector<RectF> frames;
  float x = 0, y = 0;
  for (int k = 0; k < kButtonKindCount; ++k) {
    const ButtonKind kind = KindAt(k);
    const PointF size = kind == ButtonKind::kRadio ? PointF(kRadioWidth * mRadios.size(), 18) : ButtonSize(kind);
    if (x > 0 && x + size.x > inWidth) {
      x = 0;
      y += kRowHeight;
    }
    frames.emplace_back(x, y + std::floor((kRowHeight - size.y) / 2), size.x, size.y);
    x += size.x + kGap;
  }
  outBottom = y + kRowHeight;
  return frames;
}

float LiveButtonsView::GetHeightForWidth(float inWidth) const {
  float bottom = 0;
  Flow(inWidth, bottom);
  return bottom + 4 + kStatusHeight;
}

void LiveButtonsView::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  Arrange();
}

void LiveButtonsView::Arrange() {
  float bottom = 0;
  const std::vector<RectF> frames = Flow(UI_GetLocalRectF(false).width, bottom);
  for (std::size_t i = 0; i < frames.size(); ++i) mItems[i]->UI_SetLocalRectF(frames[i]);
  for (std::size_t i = 0; i < mRadios.size(); ++i)
    mRadios[i]->UI_SetLocalRectF(RectF(kRadioWidth * static_cast<float>(i), 0, kRadioWidth - 8, 18));
}

void LiveButtonsView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  float bottom = 0;
  Flow(r.width, bottom);
  DrawLabel(inDrawbot, mStatus, RectF(0, bottom + 4, r.width, kStatusHeight), c.dimText);
  UI_SubView::UI_Draw(inDrawbot);
}

}  // namespace norvik::gallery
