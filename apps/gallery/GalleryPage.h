#pragma once
// The gallery's page: the root node of the window's contents. A header with
// the title and the brightness switch, a row that picks the page on show,
// then that page: the basics (one panel per section) or the buttons. The
// page owns its look: switching between dark and light sets the theme's
// brightness, tells the theme's clients, and repaints.
#include "GalleryOptions.h"
#include "GalleryViews.h"
#include "ui/KeyframeThemeEditor.h"

namespace norvik::gallery {

class BasicsView;
class ButtonsView;
class LayoutPageView;
class PageSelector;

class GalleryPage : public ui::UI_SubView {
 public:
  // The page paints with inTheme, which the caller has made the default theme.
  GalleryPage(ui::KeyframeThemeEditorP inTheme, bool inLight);

  void SetLight(bool inLight);
  bool IsLight() const { return mLight; }

  // Shows inPage and hides the other, as a choice in the selector row does.
  void ShowPage(GalleryPageID inPage);
  GalleryPageID GetShownPage() const { return mShown; }

  BrightnessSwitch* GetBrightnessSwitch() const { return mSwitch.get(); }
  PageSelector* GetPageSelector() const;
  ButtonsView* GetButtonsPage() const;
  LayoutPageView* GetLayoutPage() const;
  // A section of the basics page.
  SectionView* GetSection(const char* inID);
  // The tiles of the focus section, in tab order.
  std::vector<ui::UI_Node*> GetFocusTiles() const;

  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  // As the root of a window's contents, the page is visible when shown.
  bool UI_AreAllParentsVisible() const override;
  void UI_SizeChanged(const RectF& inLocalRect) override;

  static constexpr float kHeaderHeight = 48;
  static constexpr float kSelectorHeight = 30;
  static constexpr float kMargin = 14;
  // The smallest size the sections still fit in.
  static constexpr long kMinWidth = 860;
  static constexpr long kMinHeight = 600;

 private:
  void Arrange();
  ui::KeyframeThemeEditorP mTheme;
  bool mLight;
  boost::intrusive_ptr<HeaderView> mHeader;
  boost::intrusive_ptr<BrightnessSwitch> mSwitch;
  ui::UI_NodeP mSelector;
  ui::UI_NodeP mBasics;
  ui::UI_NodeP mButtons;
  ui::UI_NodeP mLayout;
  ui::UI_NodeP mNumbers;
  GalleryPageID mShown = GalleryPageID::kBasics;
};

using GalleryPageP = boost::intrusive_ptr<GalleryPage>;

}  // namespace norvik::gallery
