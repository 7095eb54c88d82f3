#include "GalleryPage.h"

#include "BasicsView.h"
#include "ButtonsView.h"
#include "LayoutPageView.h"
#include "NumbersView.h"
#include "PageSelector.h"

#include <algorithm>
#include <cmath>

namespace norvik::gallery {

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

  auto* selector = new PageSelector();
  mSelector.reset(selector);
  selector->SetChangeFunction([this](GalleryPageID inPage) { ShowPage(inPage); });
  AddGalleryChild(this, mSelector);
  mBasics.reset(new BasicsView());
  AddGalleryChild(this, mBasics);
  mButtons.reset(new ButtonsView());
  AddGalleryChild(this, mButtons);
  mLayout.reset(new LayoutPageView());
  AddGalleryChild(this, mLayout);
  mNumbers.reset(new NumbersView());
  AddGalleryChild(this, mNumbers);
  ShowPage(GalleryPageID::kBasics);
}

void GalleryPage::ShowPage(GalleryPageID inPage) {
  mShown = inPage;
  GetPageSelector()->Select(inPage);
  mBasics->UI_Show(inPage == GalleryPageID::kBasics);
  mButtons->UI_Show(inPage == GalleryPageID::kButtons);
  mLayout->UI_Show(inPage == GalleryPageID::kLayout);
  mNumbers->UI_Show(inPage == GalleryPageID::kNumbers);
  mHeader->SetSubtitle(
      inPage == GalleryPageID::kButtons
          ? Text("$$$/norvik/gallery/Subtitle/Buttons=Every kind of button in every state, and working ones to try")
      : inPage == GalleryPageID::kLayout
          ? Text("$$$/norvik/gallery/Subtitle/Layout=Arrangements that reflow, dialogs composed by the layout builder, grid views")
      : inPage == GalleryPageID::kNumbers
          ? Text("$$$/norvik/gallery/Subtitle/Numbers=Typed expressions evaluated per field unit, number formats and "
                 "steps")
          : Text("$$$/norvik/gallery/Subtitle=Nodes, drawing, theme colours, hover and keyboard focus"));
  UI_Invalidate(nullptr, 0);
}

PageSelector* GalleryPage::GetPageSelector() const { return static_cast<PageSelector*>(mSelector.get()); }

ButtonsView* GalleryPage::GetButtonsPage() const { return static_cast<ButtonsView*>(mButtons.get()); }

LayoutPageView* GalleryPage::GetLayoutPage() const { return static_cast<LayoutPageView*>(mLayout.get()); }

void GalleryPage::SetLight(bool inLight) {
  mLight = inLight;
  mSwitch->SetLight(inLight);
  mTheme->SetBrightness(inLight ? 1.0f : 0.0f);
  mTheme->NotifyThemeChanged();
  UI_Invalidate(nullptr, 0);
}

SectionView* GalleryPage::GetSection(const char* inID) { return static_cast<BasicsView*>(mBasics.get())->GetSection(inID); }

std::vector<ui::UI_Node*> GalleryPage::GetFocusTiles() const {
  return static_cast<BasicsView*>(mBasics.get())->GetFocusTiles();
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
  mSelector->UI_SetLocalRectF(RectF(kMargin, kHeaderHeight + 4, GetPageSelector()->GetPreferredWidth(), kSelectorHeight - 4));
  const float top = kHeaderHeight + kSelectorHeight + 4;
  const RectF body(kMargin, top, std::max(0.0f, r.width - 2 * kMargin), std::max(0.0f, r.height - top - kMargin));
  mBasics->UI_SetLocalRectF(body);
  mButtons->UI_SetLocalRectF(body);
  mLayout->UI_SetLocalRectF(body);
  mNumbers->UI_SetLocalRectF(body);
}

void GalleryPage::UI_Draw(drawbot::Drawbot* inDrawbot) {
  // The page covers its window: every pixel gets the page's background.
  const GalleryColors c = CurrentColors();
  FillRect(inDrawbot, UI_GetLocalRectF(false), c.background);
  UI_SubView::UI_Draw(inDrawbot);
}

}  // namespace norvik::gallery
