#pragma once
// The gallery's page: the root node of the window's contents. A header with
// the title and the brightness switch, then one panel per section. The page
// owns its look: switching between dark and light sets the theme's
// brightness, tells the theme's clients, and repaints.
#include "GalleryViews.h"
#include "ui/KeyframeThemeEditor.h"

namespace norvik::gallery {

class GalleryPage : public ui::UI_SubView {
 public:
  // The page paints with inTheme, which the caller has made the default theme.
  GalleryPage(ui::KeyframeThemeEditorP inTheme, bool inLight);

  void SetLight(bool inLight);
  bool IsLight() const { return mLight; }

  BrightnessSwitch* GetBrightnessSwitch() const { return mSwitch.get(); }
  SectionView* GetSection(const char* inID);
  // The tiles of the focus section, in tab order.
  std::vector<ui::UI_Node*> GetFocusTiles() const;

  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  // As the root of a window's contents, the page is visible when shown.
  bool UI_AreAllParentsVisible() const override;
  void UI_SizeChanged(const RectF& inLocalRect) override;

  static constexpr float kHeaderHeight = 48;
  static constexpr float kMargin = 14;
  // The smallest size the sections still fit in.
  static constexpr long kMinWidth = 560;
  static constexpr long kMinHeight = 420;

 private:
  void Arrange();
  ui::KeyframeThemeEditorP mTheme;
  bool mLight;
  ui::UI_NodeP mHeader;
  boost::intrusive_ptr<BrightnessSwitch> mSwitch;
  std::vector<boost::intrusive_ptr<SectionView>> mSections;
  std::vector<ui::UI_NodeP> mContents;
  ui::UI_NodeP mFocusDemo;
};

using GalleryPageP = boost::intrusive_ptr<GalleryPage>;

}  // namespace norvik::gallery
