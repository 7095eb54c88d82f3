#pragma once
// The gallery's Layout page: across the top an arrangement view that reflows
// a dozen controls at each width; below it a message box's content composed
// by the layout builder, and a grid view that stands controls in bordered
// cells, side by side on a wide page and one above the other on a narrow one.
#include "ArrangementDemoView.h"
#include "GalleryViews.h"
#include "MessagePanelView.h"
#include "layout/UI_GridView.h"

namespace norvik::gallery {

class LayoutPageView : public ui::UI_SubView {
 public:
  LayoutPageView();

  ArrangementDemoView* GetArrangementDemo() const { return mDemo.get(); }
  MessagePanelView* GetMessagePanel() const { return mPanel.get(); }
  layout::UI_GridView* GetGridView() const { return mGrid.get(); }

  void UI_SizeChanged(const RectF& inLocalRect) override;

  // Below this width the sections stand one above the other.
  static constexpr float kSideBySideWidth = 700;

 private:
  void Arrange();
  void FillGrid();
  // The height the arrangement's section takes.
  float ArrangeDemo(float inWidth);
  boost::intrusive_ptr<SectionView> mDemoSection, mPanelSection, mGridSection;
  boost::intrusive_ptr<ArrangementDemoView> mDemo;
  boost::intrusive_ptr<MessagePanelView> mPanel;
  layout::UI_GridViewP mGrid;
};

}  // namespace norvik::gallery
