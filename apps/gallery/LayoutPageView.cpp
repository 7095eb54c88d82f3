#include "LayoutPageView.h"

#include <algorithm>
#include <cmath>

#include "controls/UI_RadioButton.h"

namespace norvik::gallery {

LayoutPageView::LayoutPageView() {
  UI_SetNodeID("page-layout");
  mDemoSection.reset(new SectionView(
      "$$$/norvik/gallery/Section/Arrangement=An arrangement view: at each size the best-fitting placement wins"));
  mDemoSection->UI_SetNodeID("section-arrangement");
  mDemo.reset(new ArrangementDemoView());
  mDemo->SetHeightMayChangeFunction([this] { Arrange(); });
  AddGalleryChild(this, mDemoSection);
  AddGalleryChild(mDemoSection.get(), mDemo);
  mPanelSection.reset(new SectionView("$$$/norvik/gallery/Section/SmartLayout=A message box composed by the layout builder"));
  mPanelSection->UI_SetNodeID("section-smart-layout");
  mGridSection.reset(new SectionView("$$$/norvik/gallery/Section/GridView=A grid view with cell borders"));
  mGridSection->UI_SetNodeID("section-grid-view");
  mPanel.reset(new MessagePanelView());
  mGrid.reset(new layout::UI_GridView(4, 3));
  mGrid->UI_SetNodeID("grid-view");
  // The gallery shows the cells; an application turns this on while editing.
  layout::UI_GridView::SetDrawCellBordersState(true);
  mGrid->SetMargins({4, 4, 4, 4});
  AddGalleryChild(this, mPanelSection);
  AddGalleryChild(mPanelSection.get(), mPanel);
  AddGalleryChild(this, mGridSection);
  AddGalleryChild(mGridSection.get(), mGrid);
  FillGrid();
}

void LayoutPageView::FillGrid() {
  const char* const labels[] = {"$$$/norvik/gallery/Layout/Track=Track", "$$$/norvik/gallery/Layout/Input=Input",
                                "$$$/norvik/gallery/Layout/Monitor=Monitor",
                                "$$$/norvik/gallery/Layout/Output=Output"};
  const char* const choices[] = {"$$$/norvik/gallery/Layout/Mono=Mono", "$$$/norvik/gallery/Layout/Stereo=Stereo",
                                 "$$$/norvik/gallery/Layout/Auto=Auto", "$$$/norvik/gallery/Layout/Master=Master"};
  const layout::PointF offset(6, 5);
  for (unsigned long row = 0; row < 4; ++row) {
    controls::UI_StaticTextP label(new controls::UI_StaticText(Text(labels[row])));
    mGrid->AddNodeToCell(label, row, 0, offset);
    label->UI_Show(true);
    ui::UI_NodeP control;
    if (row % 2 == 0)
      control.reset(new controls::UI_RadioButton(Text(choices[row])));
    else
      control.reset(new controls::UI_Checkbox(Text(choices[row])));
    mGrid->AddNodeToCell(control, row, 1, offset);
    control->UI_Show(true);
    if (row < 3) {
      ui::UI_NodeP button(new controls::UI_TextButton(Text("$$$/norvik/gallery/Layout/Edit=Edit...")));
      mGrid->AddNodeToCell(button, row, 2, offset);
      button->UI_Show(true);
    }
  }
}

void LayoutPageView::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  Arrange();
}

float LayoutPageView::ArrangeDemo(float inWidth) {
  const float inner = std::max(0.0f, inWidth - 2 * SectionView::kPadding);
  const float height = mDemo->GetHeightForWidth(inner);
  const float sectionHeight = height + SectionView::kHeadingHeight + SectionView::kPadding;
  mDemoSection->UI_SetLocalRectF(RectF(0, 0, inWidth, sectionHeight));
  const RectF content = mDemoSection->ContentRect();
  mDemo->UI_SetLocalRectF(RectF(content.left, content.top, content.width, height));
  return sectionHeight;
}

void LayoutPageView::Arrange() {
  const RectF page = UI_GetLocalRectF(false);
  if (!(page.width > 0)) return;
  const float gap = 12;
  const float chrome = SectionView::kHeadingHeight + SectionView::kPadding;
  const float top = ArrangeDemo(page.width) + gap;
  const RectF r(0, top, page.width, std::max(0.0f, page.height - top));
  const bool sideBySide = r.width >= kSideBySideWidth;
  const float panelSectionWidth = sideBySide ? std::floor((r.width - gap) * 0.55f) : r.width;
  const float inner = std::max(0.0f, panelSectionWidth - 2 * SectionView::kPadding);
  const PointF panelSize = mPanel->GetSizeForWidth(inner);
  const float panelSectionHeight = panelSize.y + chrome + SectionView::kPadding;
  mPanelSection->UI_SetLocalRectF(RectF(0, r.top, panelSectionWidth, panelSectionHeight));
  const RectF content = mPanelSection->ContentRect();
  mPanel->UI_SetLocalRectF(RectF(content.left, content.top, std::min(panelSize.x, content.width), panelSize.y));

  const RectF gridSection = sideBySide ? RectF(panelSectionWidth + gap, r.top, r.width - panelSectionWidth - gap,
                                               panelSectionHeight)
                                       : RectF(0, r.top + panelSectionHeight + gap, r.width,
                                               std::max(0.0f, r.height - panelSectionHeight - gap));
  mGridSection->UI_SetLocalRectF(gridSection);
  const RectF gridContent = mGridSection->ContentRect();
  // The grid view grows to its cells by itself; it starts from the corner.
  mGrid->UI_SetLocalRectF(RectF(gridContent.left, gridContent.top, 1, 1));
}

}  // namespace norvik::gallery
