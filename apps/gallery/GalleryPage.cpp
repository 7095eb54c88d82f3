#include "GalleryPage.h"

#include "ControlsView.h"

#include <algorithm>
#include <cmath>

namespace norvik::gallery {

namespace {

const char* const kSectionIDs[] = {"section-colours", "section-drawing", "section-tree", "section-focus",
                                   "section-controls"};

}  // namespace

GalleryPage::GalleryPage(ui::KeyframeThemeEditorP inTheme, bool inLight) : mTheme(std::move(inTheme)), mLight(inLight) {
  UI_SetNodeID("gallery-page");
  mTheme->SetBrightness(mLight ? 1.0f : 0.0f);
  mTheme->NotifyThemeChanged();

  mHeader.reset(new HeaderView());
  AddGalleryChild(this, mHeader);
  mSwitch.reset(new BrightnessSwitch());
  mSwitch->SetLight(mLight);
  mSwitch->SetChangeFunction([this](bool inLight) { SetLight(inLight); });
  AddGalleryChild(this, mSwitch);

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

void GalleryPage::SetLight(bool inLight) {
  mLight = inLight;
  mSwitch->SetLight(inLight);
  mTheme->SetBrightness(inLight ? 1.0f : 0.0f);
  mTheme->NotifyThemeChanged();
  UI_Invalidate(nullptr, 0);
}

SectionView* GalleryPage::GetSection(const char* inID) {
  for (auto& s : mSections)
    if (s->UI_GetNodeID() == inID) return s.get();
  return nullptr;
}

std::vector<ui::UI_Node*> GalleryPage::GetFocusTiles() const {
  std::vector<ui::UI_Node*> tiles;
  for (auto it = mFocusDemo->ChildBegin(); it != mFocusDemo->ChildEnd(); ++it) tiles.push_back(it->get());
  return tiles;
}

bool GalleryPage::UI_AreAllParentsVisible() const {
  return UI_GetParentNode() ? UI_SubView::UI_AreAllParentsVisible() : UI_IsShown();
}

void GalleryPage::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  Arrange();
}

void GalleryPage::Arrange() {
  const RectF r = UI_GetLocalRectF(false);
  mHeader->UI_SetLocalRectF(RectF(0, 0, r.width, kHeaderHeight));
  mSwitch->UI_SetLocalRectF(RectF(std::max(0.0f, r.width - kMargin - 140), (kHeaderHeight - 28) / 2, 140, 28));
  const float gap = 12;
  const float top = kHeaderHeight + kMargin;
  const float w = std::floor(std::max(0.0f, (r.width - 2 * kMargin - gap) / 2));
  const float avail = std::max(0.0f, r.height - top - kMargin - gap);
  // The top row is as tall as the colours and drawing need; the bottom row
  // takes the rest. On the right of it, focus above controls.
  const float topH = std::floor(std::min(220.0f, avail / 2));
  const float bottomH = std::floor(avail - topH);
  const float focusH = std::floor(std::min(124.0f, std::max(0.0f, (bottomH - gap) / 2)));
  const float left = kMargin, right = kMargin + w + gap, bottom = top + topH + gap;
  const RectF frames[] = {RectF(left, top, w, topH), RectF(right, top, w, topH), RectF(left, bottom, w, bottomH),
                          RectF(right, bottom, w, focusH),
                          RectF(right, bottom + focusH + gap, w, std::max(0.0f, bottomH - focusH - gap))};
  for (std::size_t i = 0; i < mSections.size(); ++i) {
    mSections[i]->UI_SetLocalRectF(frames[i]);
    mContents[i]->UI_SetLocalRectF(mSections[i]->ContentRect());
  }
}

void GalleryPage::UI_Draw(drawbot::Drawbot* inDrawbot) {
  // The page covers its window: every pixel gets the page's background.
  const GalleryColors c = CurrentColors();
  FillRect(inDrawbot, UI_GetLocalRectF(false), c.background);
  UI_SubView::UI_Draw(inDrawbot);
}

}  // namespace norvik::gallery
