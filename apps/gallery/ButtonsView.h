#pragma once
// The gallery's Buttons page: every kind of button in every state it has,
// in a table, and below it one working button of each kind.
#include "ButtonGridView.h"
#include "GalleryViews.h"
#include "LiveButtonsView.h"

namespace norvik::gallery {

class ButtonsView : public ui::UI_SubView {
 public:
  ButtonsView();

  ButtonGridView* GetGrid() const { return mGrid.get(); }
  LiveButtonsView* GetLiveButtons() const { return mLive.get(); }

  void UI_SizeChanged(const RectF& inLocalRect) override;

 private:
  void Arrange();
  boost::intrusive_ptr<SectionView> mGridSection, mLiveSection;
  boost::intrusive_ptr<ButtonGridView> mGrid;
  boost::intrusive_ptr<LiveButtonsView> mLive;
};

}  // namespace norvik::gallery
