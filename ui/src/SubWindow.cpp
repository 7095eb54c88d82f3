#include "ui/SubWindow.h"

#include "ui/UI_Container.h"

namespace norvik::ui {

// ---- SubWindow ----

SubWindow::SubWindow(UI_SubWindowView* inOwnerView) : mOwnerView(inOwnerView) {
  UI_SetNodeID("SubWindow");
  auto* root = inOwnerView ? dynamic_cast<OS_Window*>(inOwnerView->UI_GetRootNode()) : nullptr;
  if (root && root->GetHandle())
    UI_CreateWindow(u"SubWindow", root->GetHandle(), RectL(100, 100, 100, 100), kOSStyleChild, 0);
}

UI_Node* SubWindow::GetProxyOrParent() const {
  if (!mProxy) return nullptr;
  if (mProxy->UI_GetStateFlags().Test(kStateFirstChanceMouse)) return mProxy->UI_GetParentNode();
  return mProxy;
}

UI_Node::PointF SubWindow::ToProxy(const UI_Node& inProxy, const PointF& inPoint) const {
  return inProxy.UI_GlobalToLocalF(UI_LocalToGlobalF(inPoint));
}

UI_Node* SubWindow::UI_GetMouseProxy(MouseEvent* ioEvent) {
  UI_Node* proxy = GetProxyOrParent();
  if (!proxy) return this;
  if (ioEvent) ioEvent->SetPosition(ToProxy(*proxy, ioEvent->GetPosition()));
  return proxy;
}

bool SubWindow::UI_DoCursor(UI_Node* inTarget, const PointF& inPoint, ModKeys inModKeys) {
  UI_Node* proxy = GetProxyOrParent();
  if (!proxy) return OS_Window::UI_DoCursor(inTarget, inPoint, inModKeys);
  return proxy->UI_DoCursor(proxy, ToProxy(*proxy, inPoint), inModKeys);
}

bool SubWindow::UI_HandleDragEnter(const PointF& inPoint, datatransfer::OS_ReceiveData* inData,
                                   unsigned long& outEffect) {
  UI_Node* proxy = GetProxyOrParent();
  return proxy ? proxy->UI_HandleDragEnter(ToProxy(*proxy, inPoint), inData, outEffect)
               : OS_Window::UI_HandleDragEnter(inPoint, inData, outEffect);
}

bool SubWindow::UI_HandleDragOver(const PointF& inPoint, datatransfer::OS_ReceiveData* inData,
                                  unsigned long& outEffect) {
  UI_Node* proxy = GetProxyOrParent();
  return proxy ? proxy->UI_HandleDragOver(ToProxy(*proxy, inPoint), inData, outEffect)
               : OS_Window::UI_HandleDragOver(inPoint, inData, outEffect);
}

void SubWindow::UI_HandleDragLeave(datatransfer::OS_ReceiveData* inData) {
  if (UI_Node* proxy = GetProxyOrParent()) {
    proxy->UI_HandleDragLeave(inData);
  } else {
    OS_Window::UI_HandleDragLeave(inData);
  }
}

bool SubWindow::UI_HandleDrop(const PointF& inPoint, datatransfer::OS_ReceiveData* inData, unsigned long& outEffect) {
  UI_Node* proxy = GetProxyOrParent();
  return proxy ? proxy->UI_HandleDrop(ToProxy(*proxy, inPoint), inData, outEffect)
               : OS_Window::UI_HandleDrop(inPoint, inData, outEffect);
}

// ---- UI_SubWindowView ----

UI_SubWindowView::UI_SubWindowView(CreateFunction inCreate) : mCreateFunction(std::move(inCreate)) {
  UI_SetNodeID("UI_SubWindowView");
}

UI_SubWindowView::~UI_SubWindowView() {
  if (auto* sub = dynamic_cast<SubWindow*>(mSubWindow.get()); sub && sub->GetProxy() == this) sub->SetProxy(nullptr);
  // A window whose ownership was given away leaves with its node intact.
  if (!mOwnsWindow && mSubWindow && mSubWindow->UI_GetParentContainer() == this) ChildRemove(mSubWindow.get());
}

void UI_SubWindowView::UI_SetParent(UI_Container* inParent) {
  UI_NodeProtector protect(this);
  UI_SubView::UI_SetParent(inParent);
  if (inParent && !mSubWindow) CreateSubWindow();
}

void UI_SubWindowView::CreateSubWindow() {
  OS_WindowP window = mCreateFunction ? mCreateFunction(this) : OS_WindowP(new SubWindow(this));
  if (!window || window->GetHandle() == 0) return;  // not inside a native window yet
  mSubWindow = window;
  if (auto* sub = dynamic_cast<SubWindow*>(window.get())) sub->SetProxy(this);
  ChildPushBack(window);
  SyncSubWindowBounds();
  CheckRootWindowChanged();
}

void UI_SubWindowView::SyncSubWindowBounds() {
  if (!mSubWindow) return;
  auto* window = dynamic_cast<OS_Window*>(UI_GetParentEventRecipientNode());
  if (!window) return;
  const RectL local = UI_EnclosingRect(UI_GetLocalRectF(false));
  const PointF origin = window->UI_GlobalToLocalF(UI_LocalToGlobalF(PointF(local.Origin())));
  mSubWindow->UI_SetLocalRect(RectL(UI_RoundToLong(origin.x), UI_RoundToLong(origin.y), local.width, local.height));
}

void UI_SubWindowView::CheckRootWindowChanged() {
  if (mSubWindow && UI_AreAllParentsVisible()) mSubWindow->UI_Show(true);
}

void UI_SubWindowView::UI_Show(bool inShow) {
  UI_NodeProtector protect(this);
  UI_SubView::UI_Show(inShow);
  CheckRootWindowChanged();
  if (mSubWindow) mSubWindow->UI_Show(inShow && UI_AreAllParentsVisible());
}

void UI_SubWindowView::UI_SizeChanged(const RectF& inLocalRect) {
  UI_SubView::UI_SizeChanged(inLocalRect);
  SyncSubWindowBounds();
}

void UI_SubWindowView::UI_NodeChanged(NodeChange inChange) {
  // Made when the view joins a tree, and again whenever the tree's window
  // may have gained the handle that the first try lacked.
  if ((inChange == kNodeChangeParent || inChange == kNodeChangeWindowMoved) && !mSubWindow && UI_GetParentNode())
    CreateSubWindow();
  SyncSubWindowBounds();
  if (inChange == kNodeChangeVisibility && mSubWindow) {
    UI_NodeProtector protect(this);
    mSubWindow->UI_Show(UI_AreAllParentsVisible());
  }
}

}  // namespace norvik::ui
