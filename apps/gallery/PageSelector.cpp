#include "PageSelector.h"

#include <algorithm>
#include <cmath>

#include "GalleryViews.h"
#include "controls/UI_ButtonBar.h"
#include "ui/MessageT.h"

namespace norvik::gallery {

namespace {

// The bar's value for each page.
double ValueOf(GalleryPageID inPage) { return static_cast<double>(static_cast<int>(inPage)); }

}  // namespace

PageSelector::PageSelector() {
  UI_SetNodeID("page-selector");
  auto* bar = new controls::UI_ButtonBar();
  mBar.reset(bar);
  bar->UI_SetNodeID("page-bar");
  bar->AddTextButton(Text("$$$/norvik/gallery/Page/Basics=Basics"), ValueOf(GalleryPageID::kBasics));
  bar->AddTextButton(Text("$$$/norvik/gallery/Page/Buttons=Buttons"), ValueOf(GalleryPageID::kButtons));
  bar->AddTextButton(Text("$$$/norvik/gallery/Page/Layout=Layout"), ValueOf(GalleryPageID::kLayout));
  bar->AddTextButton(Text("$$$/norvik/gallery/Page/Numbers=Numbers and units"), ValueOf(GalleryPageID::kNumbers));
  bar->SetValue(ValueOf(GalleryPageID::kBasics));
  AddGalleryChild(this, mBar);
  bar->NotifyWhenChanged(ui::MakeNotification<void(controls::UI_ControlChangedMessage*)>(
      [this](controls::UI_ControlChangedMessage*) { ChoiceMade(); }));
}

controls::UI_ButtonBar* PageSelector::Bar() const { return static_cast<controls::UI_ButtonBar*>(mBar.get()); }

void PageSelector::ChoiceMade() {
  // The change function changes what is on show; keep this row alive until
  // it returns.
  ui::UI_NodeP self(this);
  if (mChange) mChange(GetSelected());
}

void PageSelector::Select(GalleryPageID inPage) { Bar()->SetValue(ValueOf(inPage)); }

GalleryPageID PageSelector::GetSelected() const {
  for (GalleryPageID page : {GalleryPageID::kButtons, GalleryPageID::kLayout, GalleryPageID::kNumbers})
    if (Bar()->GetValue() == ValueOf(page)) return page;
  return GalleryPageID::kBasics;
}

ui::UI_Node* PageSelector::GetChoice(GalleryPageID inPage) const {
  return Bar()->GetButton(static_cast<long>(ValueOf(inPage)));
}

float PageSelector::GetPreferredWidth() const { return Bar()->GetButtonbarWidth(); }

void PageSelector::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  Arrange();
}

void PageSelector::Arrange() {
  const RectF r = UI_GetLocalRectF(false);
  const float h = std::min(r.height, Bar()->GetButtonbarHeight());
  mBar->UI_SetLocalRectF(RectF(0, std::floor((r.height - h) / 2), Bar()->GetButtonbarWidth(), h));
}

}  // namespace norvik::gallery
