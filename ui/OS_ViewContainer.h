#pragma once
// View containers put views into native windows. A container is an OS_Window
// that holds UI_SubView children, remembers the rectangle it was asked for as
// floats, and paints its subtree. It starts as a hidden, parentless popup and
// becomes a child window once it has a parent that receives events from the
// platform; its rectangle is applied again then, since the origin changed.
#include "ui/OS_Window.h"

namespace norvik::ui {

class OS_ViewContainer : public OS_Window {
 public:
  explicit OS_ViewContainer(bool inDoubleBuffered = true);
  ~OS_ViewContainer() override;

  bool UI_GetDoubleBuffered() const { return mDoubleBuffered; }

  void UI_SetLocalRect(const RectL& inRect) override;
  // Applies the enclosing integer rectangle, so that no float edge is lost.
  void UI_SetLocalRectF(const RectF& inRect) override;
  void UI_SetParent(UI_Container* inParent) override;
  void UI_SynchronizeParent() override;
  bool UI_SupportsDrawbot() const override { return true; }
  void UI_Draw(drawbot::Drawbot* inDrawbot) override;

 protected:
  bool mDoubleBuffered;
  RectF mRect;
};

// The root of a window's view tree; the application gives it a native parent
// (or shows it as it is, a top-level window of its own).
class OS_TopLevelViewContainer : public OS_ViewContainer {
 public:
  explicit OS_TopLevelViewContainer(bool inDoubleBuffered = true);

  Matrix UI_GetSelfToParentMatrix() const override { return OS_Window::UI_GetSelfToParentMatrix(); }
  bool UI_AreAllParentsVisible() const override;
  bool UI_DoKeyboardEvent(UI_Node* inTarget, const KeyboardEvent& inEvent) override;
};

// A container for popups: paints the panel background (or nothing with
// inNoBackground) and then its tree.
class OS_PopupViewContainer : public OS_ViewContainer {
 public:
  explicit OS_PopupViewContainer(bool inNoBackground = false, bool inDoubleBuffered = true);

  void UI_Draw(drawbot::Drawbot* inDrawbot) override;
  bool GetNoBackground() const { return mNoBackground; }

 protected:
  bool mNoBackground;
};

using OS_ViewContainerP = boost::intrusive_ptr<OS_ViewContainer>;
using OS_TopLevelViewContainerP = boost::intrusive_ptr<OS_TopLevelViewContainer>;

}  // namespace norvik::ui
