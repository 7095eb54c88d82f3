// OS_Window: the node side of a native window. Construction, the window
// procedure and its tie from handle to node, the statics that find windows,
// and the tree operations that become native calls.
#include "ui/OS_Window.h"

#include <cmath>

#include "tarsel/ErrorManager.h"
#include "ui/UI_Container.h"
#include "ui/UI_NodeManager.h"
#include "ui/UI_SubView.h"

namespace norvik::ui {

const char* const OS_Window::kWindowProperty = "norvik::ui::OS_Window::property";

const UTF16String& OS_Window::GetWindowClassName() {
  static const UTF16String name(u"TolliverLord - Window Class");
  return name;
}

// ---- OS_NodeTimerData ----

OS_NodeTimerData::OS_NodeTimerData(OS_Window* inWindow, UI_Node* inNode, long inTimerID, float inSeconds)
    : UI_NodeTimerData(inNode, inTimerID, inSeconds), mWindow(inWindow ? inWindow->GetHandle() : 0) {
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer || mWindow == 0) return;
  const unsigned long ms = GetMilliseconds();
  // A native timer of 0 ms would spin the loop; one millisecond is the floor.
  layer->SetTimer(mWindow, static_cast<std::uintptr_t>(UI_NodeTimerManager::KeyOf(this)),
                  static_cast<unsigned>(ms == 0 ? 1 : ms));
}

OS_NodeTimerData::~OS_NodeTimerData() {
  OS_NativeLayer* layer = GetNativeLayer();
  if (layer && mWindow != 0 && layer->IsWindow(mWindow))
    layer->KillTimer(mWindow, static_cast<std::uintptr_t>(UI_NodeTimerManager::KeyOf(this)));
}

// ---- UI_Window ----

bool UI_Window::OwnedByModalWindow() const {
  UI_NodeManager* manager = UI_NodeManager::Get();
  UI_Node* modal = manager ? manager->GetModalWindow() : nullptr;
  const UI_Window* modalWindow = dynamic_cast<const UI_Window*>(modal);
  if (!modalWindow) return false;
  for (const UI_Window* w = this; w; w = w->GetOwner())
    if (w == modalWindow) return true;
  return false;
}

// ---- construction ----

OS_Window::OS_Window()
    : mTimerManager(this, [this](UI_Node* inNode, long inID, float inSeconds) {
        return UI_NodeTimerDataP(new OS_NodeTimerData(this, inNode, inID, inSeconds));
      }) {
  UI_SetNodeID("OS_Window");
}

namespace {
void ForgetTree(UI_NodeManager& ioManager, UI_Node& inNode) {
  ioManager.ForgetNode(&inNode);
  for (auto it = inNode.ChildBegin(); it != inNode.ChildEnd(); ++it) ForgetTree(ioManager, **it);
}
}  // namespace

OS_Window::~OS_Window() {
  // Tearing the tree down calls out (focus hand-over, native destroy
  // messages) and callees take strong references; with the count at 0 their
  // release would delete this window a second time. The count is never
  // dropped again: the memory goes with this destructor.
  if (GetRefCount() == 0) AddRef();
  UI_RemoveAllTimers();
  // A window going away takes every cached pointer into its tree with it:
  // removing the children must not hand focus or hover to this dying node,
  // and a node of the tree that outlives it must not stay a filter.
  if (UI_NodeManager* manager = UI_NodeManager::Get()) ForgetTree(*manager, *this);
  DeleteChildren();
  if (mPlatformWindow != 0) {
    const OS_WindowHandle handle = mPlatformWindow;
    mPlatformWindow = 0;
    if (OS_NativeLayer* layer = GetNativeLayer()) {
      layer->RemoveProperty(handle, kWindowProperty);
      layer->DestroyWindow(handle);
    }
  }
}

void OS_Window::UI_Initialize() {
  if (OS_NativeLayer* layer = GetNativeLayer()) layer->SetWindowProcedure(&OS_Window::WindowProcedure);
}

// ---- the window procedure ----

std::intptr_t OS_Window::WindowProcedure(OS_WindowHandle inWindow, unsigned inMessage, std::uintptr_t inWParam,
                                         std::intptr_t inLParam) {
  std::intptr_t result = 0;
  // No exception crosses into the platform's frames: it is reported here.
  if (!tarsel::config::ErrorManager::Get(true)->GuardedCall(
          [&] { result = InnerWindowProcedure(inWindow, inMessage, inWParam, inLParam); }))
    result = 0;
  return result;
}

std::intptr_t OS_Window::InnerWindowProcedure(OS_WindowHandle inWindow, unsigned inMessage,
                                              std::uintptr_t inWParam, std::intptr_t inLParam) {
  OS_NativeLayer* layer = GetNativeLayer();
  OS_Window* node = nullptr;
  if (inMessage == kOSMsgNCCreate) {
    node = static_cast<OS_Window*>(reinterpret_cast<UI_Node*>(inLParam));
    if (!node) return 0;
    node->UI_AttachOSWindow(inWindow);
  } else {
    node = UI_GetWindow(inWindow);
  }
  if (!node) return layer ? layer->DefaultWindowProcedure(inWindow, inMessage, inWParam, inLParam) : 0;

  UI_NodeProtector protect(node);
  if (inMessage == kOSMsgClose) {
    if (UI_Container* parent = node->UI_GetParentContainer()) {
      if (layer) layer->SetFocus(0);
      if (!parent->ChildRequestRemove(node)) return 0;
    }
  }
  OS_Event event(inWindow, inMessage, inWParam, inLParam, layer ? layer->GetMessageTime() : 0);
  node->UI_HandleOSEvent(&event);
  if (inMessage == kOSMsgDestroy) {
    node->UI_DuringClose();
  } else if (inMessage == kOSMsgNCDestroy) {
    node->UI_DetachOSWindow();
    node->UI_PostClose();
  }
  return event.GetResult();
}

void OS_Window::UI_HandleOSEvent(OS_Event* inEvent) {
  if (UI_DispatchEvent(inEvent)) UI_DefaultHandleOSEvent(inEvent);
}

void OS_Window::UI_DefaultHandleOSEvent(OS_Event* inEvent) {
  if (mClientOSEventFunc) {
    mClientOSEventFunc(inEvent);
    return;
  }
  if (OS_NativeLayer* layer = GetNativeLayer())
    inEvent->SetResult(layer->DefaultWindowProcedure(inEvent->GetHWnd(), inEvent->GetMsg(), inEvent->GetWParam(),
                                                     inEvent->GetLParam()));
}

// ---- attaching ----

namespace {
// A tree built before its window had a handle learns that it now has one:
// native children of views (sub windows) can be made only from then on.
void AnnounceHandle(OS_Window& inWindow) {
  UI_NodeProtector protect(&inWindow);
  const UI_Container::ChildList children(inWindow.ChildBegin(), inWindow.ChildEnd());
  for (const UI_NodeP& child : children) child->UI_DispatchNodeChange(UI_Node::kNodeChangeWindowMoved);
}
}  // namespace

void OS_Window::UI_AttachOSWindow(OS_WindowHandle inHandle) {
  mPlatformWindow = inHandle;
  if (OS_NativeLayer* layer = GetNativeLayer())
    layer->SetProperty(inHandle, kWindowProperty, static_cast<UI_Node*>(this));
}

void OS_Window::UI_DetachOSWindow() {
  if (mPlatformWindow == 0) return;
  if (OS_NativeLayer* layer = GetNativeLayer()) layer->RemoveProperty(mPlatformWindow, kWindowProperty);
  mPlatformWindow = 0;
}

void OS_Window::DetachPlatformWindowPreDelete() { UI_DetachOSWindow(); }

void OS_Window::UI_AttachWindow(OS_WindowHandle inHandle) {
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer || inHandle == 0) return;
  UI_Initialize();
  UI_AttachOSWindow(inHandle);
  layer->SubclassWindow(inHandle);
  AnnounceHandle(*this);
}

OS_WindowHandle OS_Window::UI_CreateWindow(const UTF16String& inTitle, OS_WindowHandle inParent, const RectL& inRect,
                                           std::uint32_t inStyle, std::uint32_t inExStyle,
                                           std::uint32_t inClassStyle) {
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer) return 0;
  UI_Initialize();
  OS_WindowCreateParams params;
  params.title = inTitle;
  params.parent = inParent;
  params.rect = inRect;
  params.style = inStyle;
  params.exStyle = inExStyle;
  params.classStyle = inClassStyle;
  params.createParam = static_cast<UI_Node*>(this);
  const OS_WindowHandle handle = layer->CreateWindow(params);
  if (handle == 0) mPlatformWindow = 0;
  if (handle != 0) AnnounceHandle(*this);
  return handle;
}

// ---- finding windows ----

OS_Window* OS_Window::UI_GetWindow(OS_WindowHandle inHandle) {
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer || inHandle == 0 || !layer->IsWindowOfThisThread(inHandle)) return nullptr;
  return dynamic_cast<OS_Window*>(static_cast<UI_Node*>(layer->GetProperty(inHandle, kWindowProperty)));
}

OS_Window* OS_Window::GetWindowFromMouse(const PointL& inGlobalPoint) {
  OS_NativeLayer* layer = GetNativeLayer();
  return layer ? UI_GetWindow(layer->WindowFromPoint(inGlobalPoint)) : nullptr;
}

bool OS_Window::UI_IsOSWindowType(OS_WindowHandle inHandle) {
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer || !layer->IsWindow(inHandle)) return false;
  return layer->UsesOurProcedure(inHandle) || layer->GetClassName(inHandle) == GetWindowClassName();
}

void OS_Window::UI_EnumerateAllWindows(const std::function<void(OS_Window*)>& inFunction) {
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer) return;
  // Each handle is looked up again when its turn comes: the function may
  // destroy windows further down the list.
  for (OS_WindowHandle handle : layer->EnumerateWindows())
    if (OS_Window* window = UI_GetWindow(handle)) inFunction(window);
}

void OS_Window::UI_FindAllWindowsMatchingID(const UTF8String& inID, std::vector<OS_Window*>& outResult) {
  UI_EnumerateAllWindows([&](OS_Window* inWindow) {
    if (inWindow->UI_GetNodeID() == inID) outResult.push_back(inWindow);
  });
}

OS_Window* OS_Window::UI_FindWindowFromID(const UTF8String& inID) {
  std::vector<OS_Window*> found;
  UI_FindAllWindowsMatchingID(inID, found);
  return found.empty() ? nullptr : found.front();
}

UI_Node::PointL OS_Window::GetGlobalMousePosition() {
  OS_NativeLayer* layer = GetNativeLayer();
  return layer ? layer->GetCursorPos() : PointL();
}

// ---- UI_Window ----

std::uintptr_t OS_Window::GetPlatformWindow(bool) const { return mPlatformWindow; }

void OS_Window::UI_SetTitle(const UTF16String& inTitle) {
  if (OS_NativeLayer* layer = GetNativeLayer(); layer && mPlatformWindow) layer->SetWindowText(mPlatformWindow, inTitle);
}

bool OS_Window::UI_IsMinimized() const {
  OS_NativeLayer* layer = GetNativeLayer();
  return layer && mPlatformWindow && layer->IsMinimized(mPlatformWindow);
}

void OS_Window::UI_Minimize() {
  if (OS_NativeLayer* layer = GetNativeLayer(); layer && mPlatformWindow)
    layer->ShowWindow(mPlatformWindow, kOSShowMinimize);
}

UI_Node::RectL OS_Window::UI_GetGlobalStructureRect() const {
  OS_NativeLayer* layer = GetNativeLayer();
  return layer && mPlatformWindow ? layer->GetWindowRect(mPlatformWindow) : RectL();
}

OS_Window::SetGlobalStructureRect::SetGlobalStructureRect(OS_Window& inWindow, const RectL& inRect)
    : mWindow(inWindow), mOldRect(inWindow.mStructureRect) {
  ++mWindow.mSettingStructureRect;
  mWindow.mStructureRect = inRect;
}

OS_Window::SetGlobalStructureRect::~SetGlobalStructureRect() {
  mWindow.mStructureRect = mOldRect;
  --mWindow.mSettingStructureRect;
}

void OS_Window::UI_SetGlobalStructureRect(const RectL& inRect) {
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer || !mPlatformWindow) return;
  SetGlobalStructureRect scope(*this, inRect);
  // A maximised window keeps its state: the rectangle becomes its restored one.
  const bool toolWindow = (layer->GetExStyle(mPlatformWindow) & kOSExStyleToolWindow) != 0;
  if (!toolWindow && layer->IsMaximized(mPlatformWindow)) {
    OS_WindowPlacement placement;
    if (layer->GetWindowPlacement(mPlatformWindow, placement)) {
      placement.flags = 9;
      placement.normalRect = inRect;
      layer->SetWindowPlacement(mPlatformWindow, placement);
      if (layer->GetWindowRect(mPlatformWindow) == inRect) return;
    }
  }
  layer->SetWindowPos(mPlatformWindow, 0, inRect, kOSPosNoZOrder | kOSPosNoActivate | kOSPosFrameChanged);
}

void OS_Window::UI_Move(const PointL& inPoint) {
  if (OS_NativeLayer* layer = GetNativeLayer(); layer && mPlatformWindow)
    layer->SetWindowPos(mPlatformWindow, 0, RectL(inPoint, 0, 0), kOSPosNoSize | kOSPosNoZOrder | kOSPosNoActivate);
}

void OS_Window::UI_Activate() {
  if (OS_NativeLayer* layer = GetNativeLayer(); layer && mPlatformWindow && UI_IsShown())
    layer->SetActiveWindow(mPlatformWindow);
}

// ---- geometry ----

UI_Node::Matrix OS_Window::UI_GetSelfToParentMatrix() const {
  UI_Node* parent = UI_GetParentNode();
  // Inside a view the window is placed in native coordinates already.
  if (parent && parent->UI_IsSubView()) return Matrix();
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer || !mPlatformWindow) return Matrix();
  PointL origin = layer->ClientToScreen(mPlatformWindow, PointL(0, 0));
  if (parent) {
    if (UI_Node* recipient = parent->UI_ReceivesEventsFromOS() ? parent : parent->UI_GetParentEventRecipientNode()) {
      if (auto* window = dynamic_cast<OS_Window*>(recipient); window && window->GetHandle())
        origin = layer->ScreenToClient(window->GetHandle(), origin);
    }
  }
  return Matrix::Translation(static_cast<float>(origin.x), static_cast<float>(origin.y));
}

UI_Node::RectL OS_Window::UI_GetLocalRect() const {
  OS_NativeLayer* layer = GetNativeLayer();
  return layer && mPlatformWindow ? layer->GetClientRect(mPlatformWindow) : RectL();
}

UI_Node::RectF OS_Window::UI_GetLocalRectF(bool inInParent) const {
  RectL rect = UI_GetLocalRect();
  OS_NativeLayer* layer = GetNativeLayer();
  if (inInParent && layer && mPlatformWindow) {
    PointL origin = layer->ClientToScreen(mPlatformWindow, PointL(0, 0));
    if (const OS_WindowHandle parent = layer->GetParent(mPlatformWindow)) origin = layer->ScreenToClient(parent, origin);
    rect.left += origin.x;
    rect.top += origin.y;
  }
  return RectF(rect);
}

void OS_Window::UI_SetLocalRect(const RectL& inRect) {
  if (OS_NativeLayer* layer = GetNativeLayer(); layer && mPlatformWindow)
    layer->SetWindowPos(mPlatformWindow, 0, inRect, kOSPosNoZOrder | kOSPosNoActivate);
}

void OS_Window::UI_SetLocalRectF(const RectF& inRect) {
  const long l = UI_RoundToLong(inRect.left), t = UI_RoundToLong(inRect.top);
  const long r = UI_RoundToLong(inRect.Right()), b = UI_RoundToLong(inRect.Bottom());
  UI_SetLocalRect(RectL(l, t, r - l, b - t));
}

// ---- visibility ----

void OS_Window::UI_Show(bool inShow) {
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer || !mPlatformWindow || UI_IsShown() == inShow) return;
  UI_NodeProtector protect(this);
  layer->ShowWindow(mPlatformWindow, inShow ? kOSShowNA : kOSShowHide);
  UI_InvalidateDrawbotCache(true);
  UI_DispatchNodeChange(kNodeChangeVisibility);
}

bool OS_Window::UI_IsShown() const {
  OS_NativeLayer* layer = GetNativeLayer();
  return layer && mPlatformWindow && (layer->GetStyle(mPlatformWindow) & kOSStyleVisible) != 0;
}

bool OS_Window::UI_AreAllParentsVisible() const {
  if (!UI_IsShown()) return false;
  UI_Node* parent = UI_GetParentNode();
  return parent ? parent->UI_AreAllParentsVisible() : true;
}

void OS_Window::UI_SetParent(UI_Container* inParent) {
  OS_NativeLayer* layer = GetNativeLayer();
  UI_NodeProtector protect(this);
  if (!inParent && mPlatformWindow) {
    mWasShownBeforeDetach = UI_IsShown();
    if (mWasShownBeforeDetach && layer) layer->ShowWindow(mPlatformWindow, kOSShowHide);
  }
  UI_Node::UI_SetParent(inParent);
  if (inParent && mWasShownBeforeDetach && mPlatformWindow && layer) {
    mWasShownBeforeDetach = false;
    layer->ShowWindow(mPlatformWindow, kOSShowNA);
  }
  UI_SynchronizeParent();
}

void OS_Window::UI_SynchronizeParent() {
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer || !mPlatformWindow) return;
  OS_WindowHandle wanted = 0;
  if (auto* window = dynamic_cast<OS_Window*>(UI_GetParentEventRecipientNode())) wanted = window->GetHandle();
  if (layer->GetParent(mPlatformWindow) != wanted) layer->SetParent(mPlatformWindow, wanted);
}

void OS_Window::UI_SynchronizeParentForPopupBornWindow() {
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer || !mPlatformWindow) return;
  auto* window = dynamic_cast<OS_Window*>(UI_GetParentEventRecipientNode());
  if (window && window->GetHandle()) {
    const std::uint32_t style = layer->GetStyle(mPlatformWindow);
    layer->SetStyle(mPlatformWindow, (style & ~std::uint32_t(0xC0C00000)) | kOSStyleChild);
  } else {
    layer->ShowWindow(mPlatformWindow, kOSShowHide);
  }
}

// ---- invalidation, capture, focus ----

void OS_Window::UI_Invalidate(const RectL* inRect, unsigned long inFlags) {
  if (OS_NativeLayer* layer = GetNativeLayer(); layer && mPlatformWindow) layer->InvalidateRect(mPlatformWindow, inRect);
  UI_Node::UI_Invalidate(inRect, inFlags);
}

void OS_Window::UI_UpdateNow(unsigned long inFlags) {
  if (!(inFlags & kUpdateNowImmediate)) return;
  if (OS_NativeLayer* layer = GetNativeLayer(); layer && mPlatformWindow) layer->UpdateWindow(mPlatformWindow);
}

void OS_Window::UI_SetCapture() {
  if (OS_NativeLayer* layer = GetNativeLayer(); layer && mPlatformWindow) layer->SetCapture(mPlatformWindow);
}

void OS_Window::UI_ReleaseCapture() {
  OS_NativeLayer* layer = GetNativeLayer();
  if (layer && mPlatformWindow && layer->GetCapture() == mPlatformWindow) layer->ReleaseCapture();
}

void OS_Window::UI_DisabledStateChanged() {
  if (OS_NativeLayer* layer = GetNativeLayer(); layer && mPlatformWindow)
    layer->EnableWindow(mPlatformWindow, !UI_IsDisabled());
  UI_Node::UI_DisabledStateChanged();
}

void OS_Window::UI_SetKeyboardFocusWithOS() {
  if (OS_NativeLayer* layer = GetNativeLayer(); layer && mPlatformWindow && UI_IsShown())
    layer->SetFocus(mPlatformWindow);
}

UI_NodeTimerManager* OS_Window::UI_GetTimerManager(bool) { return &mTimerManager; }
const UI_NodeTimerManager* OS_Window::UI_GetTimerManager(bool) const { return &mTimerManager; }

void OS_Window::ChildAdded(UI_Node* inChild) {
  UI_Node::ChildAdded(inChild);
  if (inChild) inChild->UI_DispatchNodeChange(kNodeChangeWindowMoved);
}

void OS_Window::ChildRemoved(UI_Node* inChild) {
  UI_Node::ChildRemoved(inChild);
  if (inChild) inChild->UI_DispatchNodeChange(kNodeChangeWindowMoved);
}

drawbot::SupplierInterface* OS_Window::UI_GetDrawSupplier() const {
  if (drawbot::SupplierInterface* fromParent = UI_Node::UI_GetDrawSupplier()) return fromParent;
  if (UI_NodeManager* manager = UI_NodeManager::Get())
    if (drawbot::SupplierInterface* supplier = manager->GetOSDrawSupplier()) return supplier;
  OS_NativeLayer* layer = GetNativeLayer();
  // The layer's supplier is shared and stateless as far as drawing goes.
  return layer ? const_cast<drawbot::SupplierInterface*>(layer->GetDrawSupplier()) : nullptr;
}

// ---- layered attributes ----

void OS_Window::SetExWindowAttributes(float inOpacity, const std::uint32_t* inColorKey) {
  OS_NativeLayer* layer = GetNativeLayer();
  if (!layer || !mPlatformWindow) return;
  constexpr std::uint32_t kLayeredBits = kOSExStyleLayered | kOSExStyleTransparent;
  if (inOpacity >= 0.0f && inOpacity <= 1.0f) {
    const std::uint32_t exStyle = layer->GetExStyle(mPlatformWindow);
    if (inOpacity == 1.0f) {
      layer->SetExStyle(mPlatformWindow, exStyle & ~kLayeredBits);
      return;
    }
    layer->SetExStyle(mPlatformWindow, exStyle | kLayeredBits);
    const auto alpha = static_cast<unsigned char>(std::lround(inOpacity * 255.0f));
    layer->SetLayeredAttributes(mPlatformWindow, inColorKey ? *inColorKey : 0, alpha,
                                inColorKey ? (kOSLayeredAlpha | kOSLayeredColorKey) : kOSLayeredAlpha);
  } else if (inOpacity < 0.0f && inColorKey) {
    layer->SetLayeredAttributes(mPlatformWindow, *inColorKey, 0, kOSLayeredColorKey);
  }
}

void OS_Window::UI_SetOpacity(float inOpacity) { SetExWindowAttributes(inOpacity, nullptr); }

void OS_Window::UI_SetTransparentColorKey(std::uint32_t inColorKey) { SetExWindowAttributes(-1.0f, &inColorKey); }

void OS_Window::UI_SetOpacityAndTransparentColorKey(float inOpacity, std::uint32_t inColorKey) {
  SetExWindowAttributes(inOpacity, &inColorKey);
}

void OS_Window::UI_InstallMouseLeavingMessage() {
  if (OS_NativeLayer* layer = GetNativeLayer(); layer && mPlatformWindow) layer->TrackMouseLeave(mPlatformWindow);
}

}  // namespace norvik::ui
