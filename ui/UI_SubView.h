#pragma once
// UI_SubView is the ordinary portable view: a rectangle in its parent's
// coordinates, a scale-and-translate matrix, and view flags. A new view is
// hidden and empty. It lays out its children when its size changes, by each
// child's layout binding, once it has had its first size.
#include <cstdint>

#include "ui/UI_Node.h"

namespace norvik::ui {

class UI_SubView : public UI_Node {
 public:
  // View flags.
  static constexpr std::uint8_t kViewShown = 1;
  static constexpr std::uint8_t kViewLaysOutChildren = 2;
  static constexpr std::uint8_t kViewHasFirstSize = 4;

  // Layout binding bits: how a child follows its parent's resize.
  static constexpr std::uint8_t kBindLeftMoves = 1;      // x follows the right edge; width shrinks
  static constexpr std::uint8_t kBindTopMoves = 2;       // y follows the bottom edge; height shrinks
  static constexpr std::uint8_t kBindWidthGrows = 4;     // width follows the parent's width
  static constexpr std::uint8_t kBindHeightGrows = 8;    // height follows the parent's height
  static constexpr std::uint8_t kBindCenterHorizontally = 16;
  static constexpr std::uint8_t kBindCenterVertically = 32;

  UI_SubView();
  ~UI_SubView() override;

  // ---- overrides of UI_Node ----
  bool UI_IsSubView() const override { return true; }
  Matrix UI_GetSelfToParentMatrix() const override;
  RectL UI_GetLocalRect() const override;
  RectF UI_GetLocalRectF(bool inInParent) const override;
  void UI_SetLocalRect(const RectL& inRect) override;
  void UI_SetLocalRectF(const RectF& inRect) override;
  void UI_Show(bool inShow) override;
  // Needs the shown flag and a width and height above 0.
  bool UI_IsShown() const override;
  void UI_Invalidate(const RectL* inRect, unsigned long inFlags) override;
  void UI_UpdateNow(unsigned long inFlags) override;
  void UI_SetOpacity(float) override {}
  void UI_SetParent(UI_Container* inParent) override;
  bool UI_SupportsDrawbot() const override { return true; }
  void UI_SetCapture() override;
  void UI_ReleaseCapture() override;
  bool UI_ReceivesEventsFromOS() const override { return false; }
  void UI_HandleOSEvent(OS_Event*) override {}
  bool UI_DispatchEvent(OS_Event*) override { return true; }
  void UI_SetKeyboardFocusWithOS() override;

  // ---- virtual operations added here, in slot order ----
  virtual Matrix UI_GetMatrix() const { return mMatrix; }
  virtual void UI_SetLayoutsChildren(bool inLayouts);
  virtual void UI_SetLayoutBinding(std::uint8_t inBinding) { mLayoutBinding = inBinding; }
  virtual void UI_SetSubViewLayoutFlags(std::uint8_t inFlags) { mSubViewLayoutFlags = inFlags; }
  // Moves and resizes the children by their bindings; the first size a view
  // receives moves nothing.
  virtual void UI_LayoutChildren(const RectF& inOldSize, const RectF& inNewSize);

  // ---- plain operations ----
  void UI_SetMatrix(const Matrix& inMatrix);
  // With this set, the matrix moves and scales the children but not the view itself.
  void UI_SetMatrixOnlyForChildren(bool inOnly);
  bool UI_GetMatrixOnlyForChildren() const { return mMatrixOnlyForChildren; }
  std::uint8_t UI_GetViewFlags() const { return mViewFlags; }
  void UI_SetViewFlags(std::uint8_t inFlags) { mViewFlags = inFlags; }
  bool UI_GetLayoutsChildren() const { return (mViewFlags & kViewLaysOutChildren) != 0; }
  std::uint8_t UI_GetLayoutBinding() const { return mLayoutBinding; }
  std::uint8_t UI_GetSubViewLayoutFlags() const { return mSubViewLayoutFlags; }
  // Forgets the timers of this view and of every sub-view below it.
  void UI_RemoveSubViewTimers();
  // Walks the whole subtree breadth first and switches the mnemonics of every
  // control found; views that are not controls are passed through.
  void UI_TurnMnemonicsOnOffForAllChildren(bool inOn);

 protected:
  // Called for every node of the subtree by UI_TurnMnemonicsOnOffForAllChildren;
  // controls override it to show or hide their mnemonic.
  virtual void UI_SetMnemonicsShown(bool) {}

  std::uint8_t mViewFlags = 0;
  std::uint8_t mLayoutBinding = 0;
  std::uint8_t mSubViewLayoutFlags = 0;
  RectF mRect;
  Matrix mMatrix;
  bool mMatrixOnlyForChildren = false;
};

using UI_SubViewP = boost::intrusive_ptr<UI_SubView>;

}  // namespace norvik::ui
