#include "PageSelector.h"

#include "GalleryViews.h"
#include "controls/UI_RadioGroup.h"
#include "ui/MessageT.h"

namespace norvik::gallery {

namespace {

constexpr float kChoiceWidth = 96;

int IndexOf(GalleryPageID inPage) { return inPage == GalleryPageID::kButtons ? 1 : 0; }

}  // namespace

PageSelector::PageSelector() {
  UI_SetNodeID("page-selector");
  auto* group = new controls::UI_RadioGroup();
  mGroup.reset(group);
  const char* const keys[] = {"$$$/norvik/gallery/Page/Basics=Basics", "$$$/norvik/gallery/Page/Buttons=Buttons"};
  for (int i = 0; i < 2; ++i) {
    mChoices[i].reset(new controls::UI_RadioButton(Text(keys[i])));
    mChoices[i]->UI_SetNodeID(i == 0 ? "page-choice-basics" : "page-choice-buttons");
    AddGalleryChild(group, mChoices[i]);
  }
  AddGalleryChild(this, mGroup);
  group->SetIndex(0);
  group->NotifyWhenChanged(ui::MakeNotification<void(controls::UI_ControlChangedMessage*)>(
      [this](controls::UI_ControlChangedMessage*) { ChoiceMade(); }));
}

void PageSelector::ChoiceMade() {
  // The change function rebuilds what is on show; keep this row alive
  // until it returns.
  ui::UI_NodeP self(this);
  if (mChange) mChange(GetSelected());
}

void PageSelector::Select(GalleryPageID inPage) {
  static_cast<controls::UI_RadioGroup*>(mGroup.get())->SetIndex(IndexOf(inPage));
}

GalleryPageID PageSelector::GetSelected() const {
  return static_cast<controls::UI_RadioGroup*>(mGroup.get())->GetIndex() == 1 ? GalleryPageID::kButtons
                                                                               : GalleryPageID::kBasics;
}

ui::UI_Node* PageSelector::GetChoice(GalleryPageID inPage) const { return mChoices[IndexOf(inPage)].get(); }

float PageSelector::GetPreferredWidth() const { return 2 * kChoiceWidth; }

void PageSelector::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  Arrange();
}

void PageSelector::Arrange() {
  const RectF r = UI_GetLocalRectF(false);
  mGroup->UI_SetLocalRectF(RectF(0, 0, r.width, r.height));
  const float h = 18;
  for (int i = 0; i < 2; ++i)
    mChoices[i]->UI_SetLocalRectF(RectF(kChoiceWidth * static_cast<float>(i), (r.height - h) / 2, kChoiceWidth - 8, h));
}

}  // namespace norvik::gallery
