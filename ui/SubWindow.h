#pragma once
// A native window floating inside a view: UI_SubWindowView is the view that
// places it, SubWindow the native child window. Mouse, cursor and drop
// events over the native window are handed to the view (its proxy), so the
// native window acts as part of the view tree.
#include <boost/function.hpp>

#include "ui/OS_Window.h"
#include "ui/UI_SubView.h"

namespace norvik::ui {

class UI_SubWindowView;

class SubWindow : public OS_Window {
 public:
  // A native child of the window at the root of inOwnerView's tree; without
  // such a window the sub window has no handle.
  explicit SubWindow(UI_SubWindowView* inOwnerView);

  void SetProxy(UI_SubWindowView* inProxy) { mProxy = inProxy; }
  UI_SubWindowView* GetProxy() const { return mProxy; }
  UI_SubWindowView* GetOwnerView() const { return mOwnerView; }
  // The proxy, or its parent when the proxy passes first-chance mouse on.
  UI_Node* GetProxyOrParent() const;

  UI_Node* UI_GetMouseProxy(MouseEvent* ioEvent) override;
  bool UI_DoCursor(UI_Node* inTarget, const PointF& inPoint, ModKeys inModKeys) override;
  bool UI_WantsDragDropEvents() const override { return true; }
  bool UI_HandleDragEnter(const PointF& inPoint, datatransfer::OS_ReceiveData* inData,
                          unsigned long& outEffect) override;
  bool UI_HandleDragOver(const PointF& inPoint, datatransfer::OS_ReceiveData* inData,
                         unsigned long& outEffect) override;
  void UI_HandleDragLeave(datatransfer::OS_ReceiveData* inData) override;
  bool UI_HandleDrop(const PointF& inPoint, datatransfer::OS_ReceiveData* inData, unsigned long& outEffect) override;

 private:
  PointF ToProxy(const UI_Node& inProxy, const PointF& inPoint) const;

  UI_SubWindowView* mProxy = nullptr;
  UI_SubWindowView* mOwnerView;
};

class UI_SubWindowView : public UI_SubView {
 public:
  using CreateFunction = boost::function<OS_WindowP(UI_SubWindowView*)>;

  explicit UI_SubWindowView(CreateFunction inCreate = CreateFunction());
  ~UI_SubWindowView() override;

  const OS_WindowP& GetSubWindow() const { return mSubWindow; }
  // The view no longer destroys the window's node with itself.
  void ReleaseWindowOwnership() { mOwnsWindow = false; }

  void UI_SetParent(UI_Container* inParent) override;
  void UI_Show(bool inShow) override;
  void UI_SizeChanged(const RectF& inLocalRect) override;
  void UI_NodeChanged(NodeChange inChange) override;

  void CreateSubWindow();
  void SyncSubWindowBounds();
  void CheckRootWindowChanged();

 private:
  OS_WindowP mSubWindow;
  bool mOwnsWindow = true;
  CreateFunction mCreateFunction;
};

using UI_SubWindowViewP = boost::intrusive_ptr<UI_SubWindowView>;

}  // namespace norvik::ui
