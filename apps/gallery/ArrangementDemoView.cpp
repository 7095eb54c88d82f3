#include "ArrangementDemoView.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "GalleryViews.h"
#include "controls/ControlMessages.h"
#include "controls/UI_TextButton.h"

namespace norvik::gallery {

namespace {

constexpr float kRadioPitch = 22;

const char* const kTypeKeys[] = {
    "$$$/norvik/gallery/Arrange/Row=Row",
    "$$$/norvik/gallery/Arrange/Column=Column",
    "$$$/norvik/gallery/Arrange/Flipping=Row or column",
    "$$$/norvik/gallery/Arrange/HorizontalWrapping=Lines across",
    "$$$/norvik/gallery/Arrange/VerticalWrapping=Lines down",
    "$$$/norvik/gallery/Arrange/AutoLayout=Automatic",
};

// Six commands and six options of an editor's timeline.
const char* const kButtonKeys[] = {
    "$$$/norvik/gallery/Arrange/Cut=Cut",         "$$$/norvik/gallery/Arrange/Copy=Copy",
    "$$$/norvik/gallery/Arrange/Paste=Paste",     "$$$/norvik/gallery/Arrange/Trim=Trim edit",
    "$$$/norvik/gallery/Arrange/Ripple=Ripple delete", "$$$/norvik/gallery/Arrange/Render=Render preview",
};
const char* const kCheckboxKeys[] = {
    "$$$/norvik/gallery/Arrange/Snap=Snap",           "$$$/norvik/gallery/Arrange/Loop=Loop playback",
    "$$$/norvik/gallery/Arrange/Scrub=Audio scrubbing", "$$$/norvik/gallery/Arrange/Waveforms=Show waveforms",
    "$$$/norvik/gallery/Arrange/SyncLock=Sync lock",  "$$$/norvik/gallery/Arrange/Linked=Linked selection",
};

template <class Control>
void OnChange(Control& inControl, std::function<void()> inF) {
  inControl.NotifyWhenChanged(ui::MakeNotification<void(controls::UI_ControlChangedMessage*)>(
      [inF](controls::UI_ControlChangedMessage*) { inF(); }));
}

}  // namespace

ArrangementDemoView::ArrangementDemoView() {
  UI_SetNodeID("arrangement-demo");
  MakeSwitches();
  MakeItems();
  // No protector here: a strong reference taken during construction would
  // free the view when it ends.
  ApplySwitchesToArrangement();
}

void ArrangementDemoView::MakeSwitches() {
  mSwitches.reset(new layout::UI_LayoutView());
  mSwitches->UI_SetNodeID("arrangement-switches");
  AddGalleryChild(this, mSwitches);
  mTypeGroup.reset(new controls::UI_RadioGroup());
  mTypeGroup->UI_SetNodeID("arrangement-type");
  for (const char* key : kTypeKeys) {
    ui::UI_NodeP radio(new controls::UI_RadioButton(Text(key)));
    static_cast<controls::UI_ControlView*>(radio.get())->SetWantsKeyboardFocus(true);
    AddGalleryChild(mTypeGroup.get(), radio);
  }
  mTypeGroup->SetIndex(kFirstType);
  AddGalleryChild(mSwitches.get(), mTypeGroup);
  // The layout view keeps the gap that it finds above each switch: the boxes
  // start without a height, each that gap below the one before.
  float top = 6 * kRadioPitch;
  auto makeSwitch = [this, &top](const char* inKey, const char* inID, float inGapAbove) {
    boost::intrusive_ptr<controls::UI_Checkbox> box(new controls::UI_Checkbox(Text(inKey)));
    box->UI_SetNodeID(inID);
    box->SetWantsKeyboardFocus(true);
    top += inGapAbove;
    box->UI_SetLocalRectF(RectF(0, top, 0, 0));
    AddGalleryChild(mSwitches.get(), box);
    OnChange(*box, [this] { ApplySwitches(); });
    return box;
  };
  mSeparators = makeSwitch("$$$/norvik/gallery/Arrange/Separators=Separators", "arrangement-separators", 10);
  mCentreHorizontally =
      makeSwitch("$$$/norvik/gallery/Arrange/CentreH=Centre across", "arrangement-centre-h", 4);
  mCentreVertically = makeSwitch("$$$/norvik/gallery/Arrange/CentreV=Centre down", "arrangement-centre-v", 4);
  // The dividers between the items show from the start.
  mSeparators->SetChecked(true);
  OnChange(*mTypeGroup, [this] { ApplySwitches(); });
}

void ArrangementDemoView::MakeItems() {
  mArrangement.reset(new ui::UI_ArrangementView(kFirstType));
  mArrangement->UI_SetNodeID("arrangement-view");
  // A batch of children costs one placement, made when arrangement comes on.
  mArrangement->EnableArrangement(false);
  mArrangement->SetHorizontalSpacing(8);
  mArrangement->SetVerticalSpacing(8);
  for (auto setMargin : {&ui::UI_ArrangementView::SetLeftMargin, &ui::UI_ArrangementView::SetRightMargin,
                         &ui::UI_ArrangementView::SetTopMargin, &ui::UI_ArrangementView::SetBottomMargin})
    (mArrangement.get()->*setMargin)(6);
  for (int i = 0; i < 6; ++i) {
    ui::UI_NodeP button(new controls::UI_TextButton(Text(kButtonKeys[i])));
    ui::UI_NodeP box(new controls::UI_Checkbox(Text(kCheckboxKeys[i])));
    for (const ui::UI_NodeP& item : {button, box}) {
      static_cast<controls::UI_ControlView*>(item.get())->SetWantsKeyboardFocus(true);
      mItems.push_back(item);
      AddGalleryChild(mArrangement.get(), item);
    }
  }
  AddGalleryChild(this, mArrangement);
  mArrangement->EnableArrangement(true);
}

void ArrangementDemoView::ApplySwitches() {
  ui::UI_NodeP protector(this);
  ApplySwitchesToArrangement();
  Arrange();
  // A new kind may need another height.
  if (mHeightMayChange) mHeightMayChange();
}

void ArrangementDemoView::ApplySwitchesToArrangement() {
  mArrangement->EnableArrangement(false);
  const int index = mTypeGroup->GetIndex();
  if (index >= 0) mArrangement->SetArrangementType(static_cast<arrange::GroupArrangementType>(index));
  mArrangement->EnableSeparators(mSeparators->IsChecked());
  mArrangement->SetHorizontalAlignment(mCentreHorizontally->IsChecked() ? arrange::kAlignHorizontalCenter
                                                                       : arrange::kAlignLeft);
  mArrangement->SetVerticalAlignment(mCentreVertically->IsChecked() ? arrange::kAlignVerticalCenter
                                                                   : arrange::kAlignTop);
  mArrangement->EnableArrangement(true);
}

PointF ArrangementDemoView::SwitchesSize() {
  float y = 0, width = 0;
  for (auto it = mTypeGroup->ChildBegin(); it != mTypeGroup->ChildEnd(); ++it) {
    const PointF size = (*it)->UI_GetRecommendedSize();
    (*it)->UI_SetLocalRectF(RectF(0, y, std::ceil(size.x), std::ceil(size.y)));
    width = std::max(width, std::ceil(size.x));
    y += kRadioPitch;
  }
  mTypeGroup->UI_SetLocalRectF(RectF(0, 0, width, y));
  mSwitches->AutoLayout(nullptr);
  return mSwitches->UI_GetRecommendedSize();
}

float ArrangementDemoView::NeededHeight(float inWidth) {
  float fitting = std::numeric_limits<float>::infinity(), narrowest = fitting, narrowestHeight = 0;
  for (const arrange::impl::ArrangementPtr& candidate : mArrangement->Arrangeable().Arrangements()) {
    candidate->Prepare();
    if (candidate->MinWidth() <= inWidth) fitting = std::min(fitting, candidate->MinHeight());
    if (candidate->MinWidth() < narrowest) {
      narrowest = candidate->MinWidth();
      narrowestHeight = candidate->MinHeight();
    }
  }
  return std::ceil(std::isfinite(fitting) ? fitting : narrowestHeight);
}

float ArrangementDemoView::GetHeightForWidth(float inWidth) {
  const PointF switches = SwitchesSize();
  return std::max(switches.y, NeededHeight(std::max(1.0f, inWidth - switches.x - kGap)));
}

void ArrangementDemoView::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  Arrange();
}

void ArrangementDemoView::Arrange() {
  const RectF r = UI_GetLocalRectF(false);
  const PointF switches = SwitchesSize();
  mSwitches->UI_SetLocalRectF(RectF(0, 0, switches.x, switches.y));
  const float left = switches.x + kGap;
  const float width = std::max(1.0f, r.width - left);
  mArrangement->UI_SetLocalRectF(RectF(left, 0, width, NeededHeight(width)));
}

}  // namespace norvik::gallery
