#pragma once
// The gallery's first page: one panel per section (theme colours, drawing,
// the node tree, keyboard focus and a few controls), laid out in two rows
// that share the page's size.
#include <vector>

#include "GalleryViews.h"

namespace norvik::gallery {

class BasicsView : public ui::UI_SubView {
 public:
  BasicsView();

  SectionView* GetSection(const char* inID);
  // The tiles of the focus section, in tab order.
  std::vector<ui::UI_Node*> GetFocusTiles() const;

  void UI_SizeChanged(const RectF& inLocalRect) override;

 private:
  void Arrange();
  std::vector<boost::intrusive_ptr<SectionView>> mSections;
  std::vector<ui::UI_NodeP> mContents;
  ui::UI_NodeP mFocusDemo;
};

}  // namespace norvik::gallery
