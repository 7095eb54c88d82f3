#include "ControlsView.h"

#include <algorithm>

#include "GalleryViews.h"
#include "controls/UI_Checkbox.h"
#include "controls/UI_RadioButton.h"
#include "controls/UI_RadioGroup.h"
#include "controls/UI_TextButton.h"
#include "ui/MessageT.h"

namespace norvik::gallery {

ControlsView::ControlsView() {
  UI_SetNodeID("controls");
  mRender.reset(new controls::UI_TextButton(Text("$$$/norvik/gallery/Controls/Render=Render")));
  mExport.reset(new controls::UI_TextButton(Text("$$$/norvik/gallery/Controls/Export=Export...")));
  auto* snap = new controls::UI_Checkbox(Text("$$$/norvik/gallery/Controls/Snap=Snap to edits"));
  snap->SetChecked(true);
  mSnap.reset(snap);
  mWaveforms.reset(new controls::UI_Checkbox(Text("$$$/norvik/gallery/Controls/Waveforms=Show waveforms")));
  auto* group = new controls::UI_RadioGroup();
  mGroup.reset(group);
  for (const char* key : {"$$$/norvik/gallery/Controls/Timecode=Timecode", "$$$/norvik/gallery/Controls/Frames=Frames",
                          "$$$/norvik/gallery/Controls/Samples=Audio samples"}) {
    ui::UI_NodeP radio(new controls::UI_RadioButton(Text(key)));
    AddGalleryChild(group, radio);
    mRadios.push_back(radio);
  }
  for (const ui::UI_NodeP& n : {mRender, mExport, mSnap, mWaveforms, mGroup}) AddGalleryChild(this, n);
  // Every control takes focus from a click and from Tab, like the tiles
  // above them.
  for (const ui::UI_NodeP& n : {mRender, mExport, mSnap, mWaveforms})
    static_cast<controls::UI_ControlView*>(n.get())->SetWantsKeyboardFocus(true);
  for (const ui::UI_NodeP& radio : mRadios) static_cast<controls::UI_ControlView*>(radio.get())->SetWantsKeyboardFocus(true);
  group->SetIndex(0);

  mStatus = Text("$$$/norvik/gallery/Controls/Hint=Press a button: its name shows here.");
  const std::pair<ui::UI_NodeP, const char*> buttons[] = {
      {mRender, "$$$/norvik/gallery/Controls/Rendered=Pressed: Render"},
      {mExport, "$$$/norvik/gallery/Controls/Exported=Pressed: Export..."}};
  for (const auto& [button, key] : buttons) {
    const std::string statusKey(key);
    static_cast<controls::UI_ControlView*>(button.get())
        ->NotifyWhenChanged(ui::MakeNotification<void(controls::UI_ControlChangedMessage*)>(
            [this, statusKey](controls::UI_ControlChangedMessage*) {
              mStatus = Text(statusKey);
              UI_Invalidate(nullptr, 0);
            }));
  }
}

controls::UI_TextButton* ControlsView::GetRenderButton() const {
  return static_cast<controls::UI_TextButton*>(mRender.get());
}

void ControlsView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  const GalleryColors c = CurrentColors();
  const RectF r = UI_GetLocalRectF(false);
  DrawLabel(inDrawbot, mStatus, RectF(0, std::min(r.height - 18, 24.0f + 8 + 3 * 22 + 12), r.width, 18), c.dimText);
  UI_SubView::UI_Draw(inDrawbot);
}

controls::UI_Checkbox* ControlsView::GetSnapCheckbox() const {
  return static_cast<controls::UI_Checkbox*>(mSnap.get());
}

controls::UI_RadioGroup* ControlsView::GetTimeDisplayGroup() const {
  return static_cast<controls::UI_RadioGroup*>(mGroup.get());
}

void ControlsView::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  Arrange();
}

void ControlsView::Arrange() {
  const RectF r = UI_GetLocalRectF(false);
  const float row = 24, gap = 8;
  mRender->UI_SetLocalRectF(RectF(0, 0, 96, row));
  mExport->UI_SetLocalRectF(RectF(96 + gap, 0, 96, row));
  const float half = std::max(0.0f, (r.width - gap) / 2);
  mSnap->UI_SetLocalRectF(RectF(0, row + gap + 4, half, 18));
  mWaveforms->UI_SetLocalRectF(RectF(0, row + gap + 26, half, 18));
  mGroup->UI_SetLocalRectF(RectF(half + gap, row + gap, half, 3 * 22 + 8));
  for (std::size_t i = 0; i < mRadios.size(); ++i)
    mRadios[i]->UI_SetLocalRectF(RectF(6, 4 + 22.0f * static_cast<float>(i), std::max(0.0f, half - 12), 18));
}

}  // namespace norvik::gallery
