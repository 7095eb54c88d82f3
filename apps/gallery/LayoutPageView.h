#pragma once
// The gallery's Layout page: a message box's content composed by the layout
// builder, and a grid view that stands controls in bordered cells. Side by
// side on a wide page, one above the other on a narrow one.
#include "GalleryViews.h"
#include "MessagePanelView.h"
#include "layout/UI_GridView.h"

namespace norvik::gallery {

class LayoutPageView : public ui::UI_SubView {
 public:
  LayoutPageView();

  MessagePanelView* GetMessagePanel() const { return mPanel.get(); }
  layout::UI_GridView* GetGridView() const { return mGrid.get(); }

  void UI_SizeChanged(const RectF& inLocalRect) override;

  // Below this width the sections stand one above the other.
  static constexpr float kSideBySideWidth = 900;

 private:
  void Arrange();
  void FillGrid();
  boost::intrusive_ptr<SectionView> mPanelSection, mGridSection;
  boost::intrusive_ptr<MessagePanelView> mPanel;
  layout::UI_GridViewP mGrid;
};

}  // namespace norvik::gallery
