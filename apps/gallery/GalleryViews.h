#pragma once
// The views the gallery's page is made of. Each paints itself from the
// current theme; the interactive ones (hover boxes, focus tiles, the
// brightness switch) take their state from the node tree, not from copies.
#include <functional>
#include <string>
#include <vector>

#include "GalleryStyle.h"
#include "ui/UI_SubView.h"

namespace norvik::gallery {

// Shows inChild and appends it to inParent, numbering it with its place
// among the children (the tab order walks children by that number).
void AddGalleryChild(ui::UI_Node* inParent, const ui::UI_NodeP& inChild);

// A titled panel: a rounded frame with a heading, holding one section.
class SectionView : public ui::UI_SubView {
 public:
  explicit SectionView(std::string inTitleKey);
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  // The part below the heading, local to this view, where content goes.
  RectF ContentRect() const;
  const UTF16String& Title() const { return mTitle; }
  static constexpr float kHeadingHeight = 30;
  static constexpr float kPadding = 12;

 private:
  UTF16String mTitle;
};

// The theme's colours: the gallery's roles, named, then a strip of the
// palette's first entries as the theme answers them now.
class SwatchView : public ui::UI_SubView {
 public:
  SwatchView();
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  static constexpr int kPaletteStrip = 32;
};

// Strokes, fills, curves, a gradient and aligned text through the drawing
// back end.
class DrawingSamplesView : public ui::UI_SubView {
 public:
  DrawingSamplesView();
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
};

// A box of the node tree demo: lights up while the mouse is over it, and
// outlines itself while the mouse is over one of its children.
class HoverBoxView : public ui::UI_SubView {
 public:
  explicit HoverBoxView(std::string inLabelKey, int inDepth);
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  bool UI_InvalidateOnMouseOverChange(bool) const override { return true; }
  int Depth() const { return mDepth; }

 private:
  UTF16String mLabel;
  int mDepth;
};

// Nested boxes, three levels deep, each a node.
class NodeTreeView : public ui::UI_SubView {
 public:
  NodeTreeView();
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  void UI_SizeChanged(const RectF& inLocalRect) override;

 private:
  void Arrange();
  std::vector<ui::UI_NodeP> mOuter;
  std::vector<std::vector<ui::UI_NodeP>> mInner;
};

// A tile that takes keyboard focus from a click or from Tab and draws a
// focus ring while it holds it.
class FocusTileView : public ui::UI_SubView {
 public:
  explicit FocusTileView(std::string inLabelKey);
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  bool UI_WantsKeyboardFocus() const override { return true; }
  bool UI_WantsKeyboardFocusFromAdvance() const override { return true; }
  bool UI_InvalidateOnKeyboardFocusChange(bool) const override { return true; }
  bool UI_InvalidateOnMouseOverChange(bool) const override { return true; }
  bool UI_DoMouseEvent(ui::UI_Node* inTarget, const ui::MouseEvent& inEvent) override;

 private:
  UTF16String mLabel;
};

// A row of focus tiles with a hint; Tab and Shift+Tab walk them.
class FocusDemoView : public ui::UI_SubView {
 public:
  FocusDemoView();
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  void UI_SizeChanged(const RectF& inLocalRect) override;
  static constexpr int kTileCount = 4;

 private:
  void Arrange();
};

// The page's title bar: the program's name and what the page on show holds.
class HeaderView : public ui::UI_SubView {
 public:
  HeaderView();
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  // What the page on show is about, beside the title.
  void SetSubtitle(const UTF16String& inSubtitle);
  const UTF16String& GetSubtitle() const { return mSubtitle; }

 private:
  UTF16String mSubtitle;
};

// A two-state switch between the dark and the light look. A click flips
// it and calls the change function with the new state.
class BrightnessSwitch : public ui::UI_SubView {
 public:
  using ChangeFunction = std::function<void(bool inLight)>;
  BrightnessSwitch();
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  bool UI_DoMouseEvent(ui::UI_Node* inTarget, const ui::MouseEvent& inEvent) override;
  // Space or Return turns it over, as with any toggle that Tab reaches.
  bool UI_DoKeyboardEvent(ui::UI_Node* inTarget, const ui::KeyboardEvent& inEvent) override;
  bool UI_WantsKeyboardFocus() const override { return true; }
  bool UI_WantsKeyboardFocusFromAdvance() const override { return true; }
  bool UI_InvalidateOnKeyboardFocusChange(bool) const override { return true; }
  bool UI_InvalidateOnMouseOverChange(bool) const override { return true; }
  bool IsLight() const { return mLight; }
  // Sets the state without calling the change function.
  void SetLight(bool inLight);
  void SetChangeFunction(ChangeFunction inF) { mChange = std::move(inF); }

 private:
  void Toggle();
  bool mLight = false;
  ChangeFunction mChange;
};

}  // namespace norvik::gallery
