#pragma once
// Shows a native control inside a view tree. The adapter holds a fixed chain:
// its first child is a transform container (a plain view), whose first child
// is an OS_ViewContainer, whose first child is the control's OS_Window. The
// container is what the platform clips: it shrinks to the part of the adapter
// that the views above it let show, and the control is offset inside it so
// that it stays where it was on the screen. The control is on screen only
// while every view between it and its native window is shown.
#include "ui/OS_ViewContainer.h"
#include "ui/UI_SubView.h"

namespace norvik::ui {

class UI_OSSubViewAdapter : public UI_SubView {
 public:
  UI_OSSubViewAdapter();

  // Builds the chain around inControl (a transform container and a view
  // container are made here). Replaces any earlier chain.
  void SetOSView(const OS_WindowP& inControl);

  // The links of the chain, by position; a link of the wrong class raises
  // the invalid-type-conversion error, a missing one answers null.
  UI_SubView* GetTransformContainer() const;
  OS_ViewContainer* GetOSViewContainer() const;
  OS_Window* GetOSView() const;
  bool HasOSChildView() const;
  // The chain is complete and the control has a native window.
  bool IsOSChildViewValid() const;

  void UI_NodeChanged(NodeChange inChange) override;

  void SubViewParentChanged();
  void SubViewParentVisibilityChanged();
  void SubViewParentTransformChanged();
  void ClipOSControlUsingContainer();
  // The intersection of the global rectangles of inNode and its ancestors.
  static RectF UI_GetGlobalVisibleRect(const UI_Node* inNode);
};

using UI_OSSubViewAdapterP = boost::intrusive_ptr<UI_OSSubViewAdapter>;

}  // namespace norvik::ui
