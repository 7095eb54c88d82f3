#include "ButtonSamples.h"

#include "controls/UI_ButtonBar.h"
#include "controls/UI_Checkbox.h"
#include "controls/UI_DisclosureTriangleButton.h"
#include "controls/UI_LockButton.h"
#include "controls/UI_PictureButton.h"
#include "controls/UI_PictureTextButton.h"
#include "controls/UI_RadioButton.h"
#include "controls/UI_TextButton.h"
#include "ui/Theme.h"
#include "ui/UI_NodeManager.h"

namespace norvik::gallery {

namespace {

// What a sample answers in place of the node tree.
class SampleLook {
 public:
  void Force(bool inRollover, bool inFocused) {
    mRollover = inRollover;
    mFocused = inFocused;
  }

 protected:
  bool mRollover = false;
  bool mFocused = false;
};

template <class Button>
class StateSample : public Button, public SampleLook {
 public:
  using Button::Button;
  bool UI_IsMouseOver(bool inLeafOnly) const override { return mRollover || Button::UI_IsMouseOver(inLeafOnly); }
  bool UI_HasKeyboardFocus(bool inLeafOnly) const override {
    return mFocused || Button::UI_HasKeyboardFocus(inLeafOnly);
  }
  // A capture running elsewhere (a live button held down) does not put the
  // rollover samples out.
  bool DoDrawRollover(const ui::InputCapture& inCapture) const override {
    return mRollover || Button::DoDrawRollover(inCapture);
  }
  bool UI_HitTest(const PointF&) const override { return false; }
  bool UI_WantsKeyboardFocus() const override { return false; }
};

template <class Button, class... Args>
Button* New(bool inSample, Args&&... inArgs) {
  if (inSample) return new StateSample<Button>(std::forward<Args>(inArgs)...);
  return new Button(std::forward<Args>(inArgs)...);
}

// The owner-drawn button paints a flat tile of its own in the gallery's
// colours, lit by the same states as the toolkit's bevels.
void DrawOwnerTile(controls::UI_OwnerDrawButton& inButton, drawbot::Drawbot& inDrawbot) {
  const GalleryColors c = CurrentColors();
  const auto state = inButton.GetControlState(true);
  const bool disabled = state.Test(controls::UI_ControlView::kStateDisabled);
  const bool down = state.Test(controls::UI_ControlView::kStateDown);
  const bool rollover = state.Test(controls::UI_ControlView::kStateRollover);
  const RectF r = inButton.UI_GetLocalRectF(false);
  ColorRGBA fill = Mix(c.panel, c.text, 0.10f);
  if (rollover) fill = c.hover;
  if (down) fill = Mix(c.panel, c.accent, 0.75f);
  if (disabled) fill = Mix(c.panel, c.text, 0.04f);
  const RectF tile(1, 1, r.width - 2, r.height - 2);
  FillRoundRect(&inDrawbot, tile, tile.height / 2, fill);
  StrokeRoundRect(&inDrawbot, tile, tile.height / 2, disabled ? Mix(c.panel, c.border, 0.5f) : c.border, 1);
  if (state.Test(controls::UI_ControlView::kStateFocused))
    StrokeRoundRect(&inDrawbot, RectF(0, 0, r.width, r.height), r.height / 2, c.accent, 2);
  DrawLabel(&inDrawbot, Text("$$$/norvik/gallery/Buttons/OwnerLabel=Owner"), tile,
            disabled ? c.dimText : (down ? ColorRGBA(1, 1, 1, 1) : c.text), drawbot::kTextAlignCenter);
}

// The plus of the picture button, in the glyph colour that reads on the
// current look's panels.
void SupplyAddImage(controls::UI_PictureSupplyMessage* ioMessage) {
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst();
  if (!manager || !manager->GetDrawbotImageResourceCache() || !manager->GetOSDrawSupplier()) return;
  const UTF8String name = ui::GetIconType() == 1 ? "SP_Add_Sm_N_D" : "SP_Add_Sm_N";
  ioMessage->SetImage(manager->GetImage(manager->GetOSDrawSupplier(), name, drawbot::kImageFileTypePNG));
}

controls::UI_ControlView* NewButton(ButtonKind inKind, bool inSample) {
  using namespace controls;
  switch (inKind) {
    case ButtonKind::kText:
      return New<UI_TextButton>(inSample, Text("$$$/norvik/gallery/Buttons/Render=Render"));
    case ButtonKind::kDefaultText: {
      auto* button = New<UI_TextButton>(inSample, Text("$$$/norvik/gallery/Buttons/OK=OK"));
      button->SetDefaultAppearance(true);
      return button;
    }
    case ButtonKind::kPicture: {
      auto* button = New<UI_PictureButton>(inSample);
      button->SetImageSupplyFunction(&SupplyAddImage);
      return button;
    }
    case ButtonKind::kPictureText: {
      auto* button = New<UI_PictureTextButton>(inSample, Text("$$$/norvik/gallery/Buttons/Info=Details"));
      button->SetImageBaseName("MessageBoxInfoIcon_Sm");
      return button;
    }
    case ButtonKind::kLock: return New<UI_LockButton>(inSample);
    case ButtonKind::kLink: return New<UI_LinkButton>(inSample);
    case ButtonKind::kOwnerDraw: {
      auto* button = New<UI_OwnerDrawButton>(inSample);
      button->SetOwnerDrawFunction(&DrawOwnerTile);
      return button;
    }
    case ButtonKind::kDisclosure:
      return New<UI_DisclosureTriangleButton>(inSample, Text("$$$/norvik/gallery/Buttons/Effects=Effects"));
    case ButtonKind::kCheckbox: return New<UI_Checkbox>(inSample, Text("$$$/norvik/gallery/Buttons/Loop=Loop"));
    case ButtonKind::kTriStateCheckbox: {
      auto* box = New<UI_Checkbox>(inSample, Text("$$$/norvik/gallery/Buttons/Tracks=All tracks"));
      box->SetTriState(true);
      return box;
    }
    case ButtonKind::kRadio: return New<UI_RadioButton>(inSample, Text("$$$/norvik/gallery/Buttons/Stereo=Stereo"));
    case ButtonKind::kButtonBar: {
      auto* bar = New<UI_ButtonBar>(inSample);
      // Zoom factors: short labels, so that the bar fits a cell of the table.
      bar->AddTextButton(Text("$$$/norvik/gallery/Buttons/ZoomOne=1×"), 1);
      bar->AddTextButton(Text("$$$/norvik/gallery/Buttons/ZoomTwo=2×"), 2);
      bar->SetValue(1);
      return bar;
    }
  }
  return nullptr;
}

}  // namespace

UTF16String ButtonKindName(ButtonKind inKind) {
  static const char* const keys[kButtonKindCount] = {
      "$$$/norvik/gallery/Buttons/Kind/Text=Text button",
      "$$$/norvik/gallery/Buttons/Kind/Default=Default button",
      "$$$/norvik/gallery/Buttons/Kind/Picture=Picture button",
      "$$$/norvik/gallery/Buttons/Kind/PictureText=Picture and text",
      "$$$/norvik/gallery/Buttons/Kind/Lock=Lock button",
      "$$$/norvik/gallery/Buttons/Kind/Link=Link button",
      "$$$/norvik/gallery/Buttons/Kind/Owner=Owner-drawn button",
      "$$$/norvik/gallery/Buttons/Kind/Disclosure=Disclosure triangle",
      "$$$/norvik/gallery/Buttons/Kind/Checkbox=Checkbox",
      "$$$/norvik/gallery/Buttons/Kind/TriState=Tri-state checkbox",
      "$$$/norvik/gallery/Buttons/Kind/Radio=Radio buttons",
      "$$$/norvik/gallery/Buttons/Kind/ButtonBar=Button bar",
  };
  return Text(keys[static_cast<int>(inKind)]);
}

UTF16String ShownStateName(ShownState inState) {
  static const char* const keys[kShownStateCount] = {
      "$$$/norvik/gallery/Buttons/State/Normal=Normal",     "$$$/norvik/gallery/Buttons/State/Rollover=Rollover",
      "$$$/norvik/gallery/Buttons/State/Pressed=Pressed",   "$$$/norvik/gallery/Buttons/State/On=On",
      "$$$/norvik/gallery/Buttons/State/Mixed=Mixed",       "$$$/norvik/gallery/Buttons/State/Focused=Focused",
      "$$$/norvik/gallery/Buttons/State/Disabled=Disabled", "$$$/norvik/gallery/Buttons/State/DisabledOn=Disabled, on",
  };
  return Text(keys[static_cast<int>(inState)]);
}

bool KindShowsState(ButtonKind inKind, ShownState inState) {
  const bool keepsValue = inKind == ButtonKind::kLock || inKind == ButtonKind::kLink ||
                          inKind == ButtonKind::kDisclosure || inKind == ButtonKind::kCheckbox ||
                          inKind == ButtonKind::kTriStateCheckbox || inKind == ButtonKind::kRadio;
  if (inKind == ButtonKind::kButtonBar)
    return inState == ShownState::kNormal || inState == ShownState::kPressed || inState == ShownState::kFocused ||
           inState == ShownState::kDisabled;
  switch (inState) {
    case ShownState::kOn:
    case ShownState::kDisabledOn: return keepsValue;
    case ShownState::kMixed: return inKind == ButtonKind::kTriStateCheckbox;
    default: return true;
  }
}

PointF ButtonSize(ButtonKind inKind) {
  switch (inKind) {
    case ButtonKind::kPicture: return PointF(26, 24);
    case ButtonKind::kLock:
    case ButtonKind::kLink: return PointF(24, 22);
    case ButtonKind::kOwnerDraw: return PointF(76, 22);
    case ButtonKind::kCheckbox:
    case ButtonKind::kTriStateCheckbox:
    case ButtonKind::kRadio: return PointF(96, 18);
    case ButtonKind::kDisclosure: return PointF(90, 20);
    case ButtonKind::kButtonBar: return PointF(66, 20);
    default: return PointF(90, 22);
  }
}

controls::UI_ControlViewP MakeLiveButton(ButtonKind inKind) {
  return controls::UI_ControlViewP(NewButton(inKind, false));
}

controls::UI_ControlViewP MakeStateSample(ButtonKind inKind, ShownState inState) {
  controls::UI_ControlViewP control(NewButton(inKind, true));
  const bool on = inState == ShownState::kOn || inState == ShownState::kDisabledOn;
  const bool pressed = inState == ShownState::kPressed;
  if (auto* box = dynamic_cast<controls::UI_Checkbox*>(control.get())) {
    box->SetValue(inState == ShownState::kMixed ? controls::UI_Checkbox::kMixed
                                                : (on ? controls::UI_Checkbox::kOn : controls::UI_Checkbox::kOff));
  } else if (auto* button = dynamic_cast<controls::UI_Button*>(control.get())) {
    button->SetValue(on ? controls::UI_Button::kButtonOn : controls::UI_Button::kButtonOff);
  }
  // Pressed is the look under the mouse while the button is held: down and
  // rolled over. In a bar, the segment that is not selected is the one held.
  if (auto* bar = dynamic_cast<controls::UI_ButtonBar*>(control.get())) {
    if (pressed && bar->GetButton(1)) bar->GetButton(1)->SetDownState(true);
  } else if (pressed) {
    control->SetDownState(true);
  }
  dynamic_cast<SampleLook&>(*control).Force(inState == ShownState::kRollover || pressed,
                                            inState == ShownState::kFocused);
  control->SetEnabled(inState != ShownState::kDisabled && inState != ShownState::kDisabledOn);
  return control;
}

}  // namespace norvik::gallery
