#include "ButtonsView.h"

#include <algorithm>
#include <cmath>

namespace norvik::gallery {

ButtonsView::ButtonsView() {
  UI_SetNodeID("page-buttons");
  mGridSection.reset(new SectionView("$$$/norvik/gallery/Section/ButtonStates=Every kind of button in every state"));
  mGridSection->UI_SetNodeID("section-button-states");
  mLiveSection.reset(new SectionView("$$$/norvik/gallery/Section/LiveButtons=Try them"));
  mLiveSection->UI_SetNodeID("section-live-buttons");
  mGrid.reset(new ButtonGridView());
  mLive.reset(new LiveButtonsView());
  AddGalleryChild(this, mGridSection);
  AddGalleryChild(mGridSection.get(), mGrid);
  AddGalleryChild(this, mLiveSection);
  AddGalleryChild(mLiveSection.get(), mLive);
}

void ButtonsView::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  Arrange();
}

void ButtonsView::Arrange() {
  const RectF r = UI_GetLocalRectF(false);
  const float gap = 12;
  const float chrome = SectionView::kHeadingHeight + SectionView::kPadding;
  const float liveH =
      std::min(std::ceil(mLive->GetHeightForWidth(std::max(0.0f, r.width - 2 * SectionView::kPadding)) + chrome),
               std::max(0.0f, r.height / 2));
  // The grid takes what it can use; below the live buttons the page's
  // background shows.
  const float gridH = std::min(std::max(0.0f, r.height - liveH - gap), ButtonGridView::GetPreferredHeight() + chrome);
  mGridSection->UI_SetLocalRectF(RectF(0, 0, r.width, gridH));
  mGrid->UI_SetLocalRectF(mGridSection->ContentRect());
  mLiveSection->UI_SetLocalRectF(RectF(0, gridH + gap, r.width, liveH));
  mLive->UI_SetLocalRectF(mLiveSection->ContentRect());
}

}  // namespace norvik::gallery
