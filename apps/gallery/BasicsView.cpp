#include "BasicsView.h"

#include <algorithm>
#include <cmath>

#include "ControlsView.h"

namespace norvik::gallery {

namespace {

const char* const kSectionIDs[] = {"section-colours", "section-drawing", "section-tree", "section-focus",
                                   "section-controls"};

}  // namespace

BasicsView::BasicsView() {
  UI_SetNodeID("page-basics");
  const char* const titles[] = {"$$$/norvik/gallery/Section/Colours=Theme colours",
                                "$$$/norvik/gallery/Section/Drawing=Drawing",
                                "$$$/norvik/gallery/Section/Tree=Node tree and hover",
                                "$$$/norvik/gallery/Section/Focus=Keyboard focus",
                                "$$$/norvik/gallery/Section/Controls=Controls"};
  mContents = {ui::UI_NodeP(new SwatchView()), ui::UI_NodeP(new DrawingSamplesView()),
               ui::UI_NodeP(new NodeTreeView()), ui::UI_NodeP(new FocusDemoView()),
               ui::UI_NodeP(new ControlsView())};
  mFocusDemo = mContents[3];
  for (std::size_t i = 0; i < mContents.size(); ++i) {
    boost::intrusive_ptr<SectionView> section(new SectionView(titles[i]));
    section->UI_SetNodeID(kSectionIDs[i]);
    AddGalleryChild(this, section);
    AddGalleryChild(section.get(), mContents[i]);
    mSections.push_back(section);
  }
}

SectionView* BasicsView::GetSection(const char* inID) {
  for (auto& s : mSections)
    if (s->UI_GetNodeID() == inID) return s.get();
  return nullptr;
}

std::vector<ui::UI_Node*> BasicsView::GetFocusTiles() const {
  std::vector<ui::UI_Node*> tiles;
  for (auto it = mFocusDemo->ChildBegin(); it != mFocusDemo->ChildEnd(); ++it) tiles.push_back(it->get());
  return tiles;
}

void BasicsView::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  Arrange();
}

void BasicsView::Arrange() {
  const RectF r = UI_GetLocalRectF(false);
  const float gap = 12;
  const float w = std::floor(std::max(0.0f, (r.width - gap) / 2));
  const float avail = std::max(0.0f, r.height - gap);
  // The top row is as tall as the colours and drawing need, short of what
  // the focus tiles and the controls need below it; the bottom row takes the
  // rest. On the right of it, focus above controls.
  const float topH = std::floor(std::min(220.0f, std::max(avail * 0.4f, avail - 290)));
  const float bottomH = std::floor(avail - topH);
  const float focusH = std::floor(std::min(124.0f, std::max(0.0f, (bottomH - gap) / 2)));
  const float left = 0, right = w + gap, bottom = topH + gap;
  const RectF frames[] = {RectF(left, 0, w, topH), RectF(right, 0, w, topH), RectF(left, bottom, w, bottomH),
                          RectF(right, bottom, w, focusH),
                          RectF(right, bottom + focusH + gap, w, std::max(0.0f, bottomH - focusH - gap))};
  for (std::size_t i = 0; i < mSections.size(); ++i) {
    mSections[i]->UI_SetLocalRectF(frames[i]);
    mContents[i]->UI_SetLocalRectF(mSections[i]->ContentRect());
  }
}

}  // namespace norvik::gallery
