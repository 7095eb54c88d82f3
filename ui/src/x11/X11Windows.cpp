// Windows: creation with their hints, destruction, the per-window state that X
// does not keep, hierarchy and z-order.
#include <algorithm>
#include <cstring>

#include "tarsel/ErrorManager.h"
#include "ui/ApplicationIdentity.h"
#include "ui/OS_DefaultWindowProcedure.h"
#include "ui/src/x11/OS_NativeLayer_X11.h"

namespace norvik::ui::x11 {
namespace {

const char16_t kClassName16[] = u"TolliverLord - Window Class";

constexpr std::uint32_t kEventMask =
    XCB_EVENT_MASK_EXPOSURE | XCB_EVENT_MASK_STRUCTURE_NOTIFY | XCB_EVENT_MASK_KEY_PRESS |
    XCB_EVENT_MASK_KEY_RELEASE | XCB_EVENT_MASK_BUTTON_PRESS | XCB_EVENT_MASK_BUTTON_RELEASE |
    XCB_EVENT_MASK_POINTER_MOTION | XCB_EVENT_MASK_ENTER_WINDOW | XCB_EVENT_MASK_LEAVE_WINDOW |
    XCB_EVENT_MASK_FOCUS_CHANGE | XCB_EVENT_MASK_PROPERTY_CHANGE;

bool IsChildStyle(std::uint32_t inStyle) { return (inStyle & kOSStyleChild) != 0; }

}  // namespace

X11Window* OS_NativeLayer_X11::Find(OS_WindowHandle inWindow) const {
  auto it = mWindows.find(inWindow);
  return it == mWindows.end() ? nullptr : it->second.get();
}

std::vector<OS_WindowHandle>& OS_NativeLayer_X11::SiblingsOf(const X11Window& inWindow) {
  if (inWindow.parent != 0)
    if (X11Window* parent = Find(inWindow.parent)) return parent->children;
  return mStacking;
}

OS_WindowHandle OS_NativeLayer_X11::TopLevelOf(OS_WindowHandle inWindow) const {
  OS_WindowHandle window = inWindow;
  for (const X11Window* w = Find(window); w && w->parent != 0; w = Find(window)) window = w->parent;
  return window;
}

std::intptr_t OS_NativeLayer_X11::CallProcedure(OS_WindowHandle inWindow, unsigned inMessage,
                                                std::uintptr_t inWParam, std::intptr_t inLParam) {
  const X11Window* window = Find(inWindow);
  if (!window) return 0;
  if (window->ours && mProcedure) return mProcedure(inWindow, inMessage, inWParam, inLParam);
  return DefaultWindowProcedure(inWindow, inMessage, inWParam, inLParam);
}

std::intptr_t OS_NativeLayer_X11::DefaultWindowProcedure(OS_WindowHandle inWindow, unsigned inMessage,
                                                         std::uintptr_t inWParam, std::intptr_t inLParam) {
  return DefaultWindowProcedureOver(*this, inWindow, inMessage, inWParam, inLParam);
}

void OS_NativeLayer_X11::SendSize(OS_WindowHandle inWindow) {
  const X11Window* window = Find(inWindow);
  if (!window) return;
  unsigned kind = window->minimized ? kOSSizeMinimized : window->maximized ? kOSSizeMaximized : kOSSizeRestored;
  CallProcedure(inWindow, kOSMsgSize, kind,
                MakePointParam(static_cast<int>(window->rect.width), static_cast<int>(window->rect.height)));
}

OS_WindowHandle OS_NativeLayer_X11::CreateWindow(const OS_WindowCreateParams& inParams) {
  const bool isChild = IsChildStyle(inParams.style) && inParams.parent != 0 && Find(inParams.parent);
  auto window = std::make_unique<X11Window>();
  xcb_window_t id = xcb_generate_id(mConnection);
  window->id = id;
  window->className = kClassName16;
  window->text = inParams.title;
  window->style = inParams.style & ~kOSStyleVisible;
  window->exStyle = inParams.exStyle;
  window->classStyle = inParams.classStyle;
  window->parent = isChild ? inParams.parent : 0;
  window->owner = isChild ? 0 : inParams.parent;
  window->rect = inParams.rect;
  window->normalRect = inParams.rect;
  window->positioned = inParams.rect.left != 0 || inParams.rect.top != 0;
  window->overrideRedirect = !isChild && BypassesWindowManager(inParams.style, inParams.exStyle);

  const std::uint32_t mask = XCB_CW_BACK_PIXMAP | XCB_CW_BIT_GRAVITY | XCB_CW_OVERRIDE_REDIRECT | XCB_CW_EVENT_MASK;
  const std::uint32_t values[] = {XCB_BACK_PIXMAP_NONE, XCB_GRAVITY_NORTH_WEST,
                                  window->overrideRedirect ? 1u : 0u, kEventMask};
  const xcb_window_t xParent = isChild ? static_cast<xcb_window_t>(inParams.parent) : mScreen->root;
  xcb_void_cookie_t cookie = xcb_create_window_checked(
      mConnection, XCB_COPY_FROM_PARENT, id, xParent, static_cast<int16_t>(inParams.rect.left),
      static_cast<int16_t>(inParams.rect.top), static_cast<uint16_t>(std::max<long>(1, inParams.rect.width)),
      static_cast<uint16_t>(std::max<long>(1, inParams.rect.height)), 0, XCB_WINDOW_CLASS_INPUT_OUTPUT,
      mScreen->root_visual, mask, values);
  if (xcb_generic_error_t* error = xcb_request_check(mConnection, cookie)) {
    ReportXError(error, "create window");
    std::free(error);
    return 0;
  }
  const OS_WindowHandle handle = id;
  X11Window& ref = *window;
  mWindows[handle] = std::move(window);
  SiblingsOf(ref).insert(SiblingsOf(ref).begin(), handle);

  // Desktops match the application's windows by instance and class name.
  std::string wmClass = GetApplicationInstanceName();
  wmClass.append(1, '\0').append(GetApplicationClassName()).append(1, '\0');
  xcb_change_property(mConnection, XCB_PROP_MODE_REPLACE, id, XCB_ATOM_WM_CLASS, XCB_ATOM_STRING, 8,
                      static_cast<std::uint32_t>(wmClass.size()), wmClass.data());
  if (!isChild) ApplyTopLevelHints(ref);
  SetWindowText(handle, inParams.title);

  if (CallProcedure(handle, kOSMsgNCCreate, 0, reinterpret_cast<std::intptr_t>(inParams.createParam)) == 0) {
    if (X11Window* refused = Find(handle)) {
      refused->destroying = true;
      CallProcedure(handle, kOSMsgNCDestroy, 0, 0);
      SiblingsOf(*refused).erase(std::remove(SiblingsOf(*refused).begin(), SiblingsOf(*refused).end(), handle),
                                 SiblingsOf(*refused).end());
      mWindows.erase(handle);
      xcb_destroy_window(mConnection, id);
    }
    return 0;
  }
  if (!Find(handle)) return 0;
  SendSize(handle);
  if (!Find(handle)) return 0;
  if ((inParams.style & kOSStyleMaximize) != 0 && !isChild)
    ShowWindow(handle, kOSShowMaximized);
  else if ((inParams.style & kOSStyleVisible) != 0)
    ShowWindow(handle, kOSShowNA);
  return Find(handle) ? handle : 0;
}

void OS_NativeLayer_X11::DestroySubtree(OS_WindowHandle inWindow) {
  X11Window* window = Find(inWindow);
  if (!window) return;
  std::vector<OS_WindowHandle> children = window->children;
  for (OS_WindowHandle child : children) DestroySubtree(child);
  CallProcedure(inWindow, kOSMsgNCDestroy, 0, 0);
  if (X11Window* gone = Find(inWindow)) {
    if (gone->gc) xcb_free_gc(mConnection, gone->gc);
    auto& siblings = SiblingsOf(*gone);
    siblings.erase(std::remove(siblings.begin(), siblings.end(), inWindow), siblings.end());
    mWindows.erase(inWindow);
  }
  mQueue.erase(std::remove_if(mQueue.begin(), mQueue.end(),
                              [&](const X11Message& m) { return m.event.GetHWnd() == inWindow; }),
               mQueue.end());
  for (auto it = mTimers.begin(); it != mTimers.end();) it = it->first.first == inWindow ? mTimers.erase(it) : ++it;
}

void OS_NativeLayer_X11::DestroyWindow(OS_WindowHandle inWindow) {
  X11Window* window = Find(inWindow);
  if (!window || window->destroying) return;
  xcb_destroy_window(mConnection, static_cast<xcb_window_t>(inWindow));
  ForgetDestroyedWindow(inWindow);
  xcb_flush(mConnection);
}

void OS_NativeLayer_X11::ForgetDestroyedWindow(OS_WindowHandle inWindow) {
  X11Window* window = Find(inWindow);
  if (!window || window->destroying) return;
  std::vector<OS_WindowHandle> subtree{inWindow};
  for (std::size_t i = 0; i < subtree.size(); ++i)
    if (X11Window* w = Find(subtree[i])) subtree.insert(subtree.end(), w->children.begin(), w->children.end());
  for (OS_WindowHandle h : subtree) {
    if (X11Window* w = Find(h)) w->destroying = true;
    if (mCapture == h) ReleaseCapture();
    if (mFocus == h) mFocus = 0;
    if (mPointerWindow == h) mPointerWindow = 0;
  }
  if (mSizeMoveWindow == inWindow) {
    mSizeMoveWindow = 0;
    CallProcedure(inWindow, kOSMsgExitSizeMove, 0, 0);
  }
  if (mActive == inWindow) {
    CallProcedure(inWindow, kOSMsgActivate, kOSActivationInactive, 0);
    mActive = 0;
  }
  for (OS_WindowHandle h : subtree) CallProcedure(h, kOSMsgDestroy, 0, 0);
  DestroySubtree(inWindow);
}

bool OS_NativeLayer_X11::IsWindow(OS_WindowHandle inWindow) const { return Find(inWindow) != nullptr; }

bool OS_NativeLayer_X11::SubclassWindow(OS_WindowHandle inWindow) {
  X11Window* window = Find(inWindow);
  if (!window) return false;
  window->ours = true;
  return true;
}

bool OS_NativeLayer_X11::UsesOurProcedure(OS_WindowHandle inWindow) const {
  const X11Window* window = Find(inWindow);
  return window && window->ours;
}

UTF16String OS_NativeLayer_X11::GetClassName(OS_WindowHandle inWindow) const {
  const X11Window* window = Find(inWindow);
  return window ? window->className : UTF16String();
}

void OS_NativeLayer_X11::SetProperty(OS_WindowHandle inWindow, const std::string& inName, void* inValue) {
  X11Window* window = Find(inWindow);
  if (!window) return;
  // Kept here only: a handle to a node means nothing to other clients.
  window->properties[inName] = inValue;
}

void* OS_NativeLayer_X11::GetProperty(OS_WindowHandle inWindow, const std::string& inName) const {
  const X11Window* window = Find(inWindow);
  if (!window) return nullptr;
  auto it = window->properties.find(inName);
  return it == window->properties.end() ? nullptr : it->second;
}

void OS_NativeLayer_X11::RemoveProperty(OS_WindowHandle inWindow, const std::string& inName) {
  X11Window* window = Find(inWindow);
  if (!window) return;
  window->properties.erase(inName);
}

void OS_NativeLayer_X11::SetWindowText(OS_WindowHandle inWindow, const UTF16String& inText) {
  X11Window* window = Find(inWindow);
  if (!window) return;
  window->text = inText;
  UTF8String utf8 = tarsel::utility::UTF16to8(inText);
  xcb_change_property(mConnection, XCB_PROP_MODE_REPLACE, window->id, Atom("_NET_WM_NAME"), Atom("UTF8_STRING"), 8,
                      static_cast<std::uint32_t>(utf8.size()), utf8.data());
  xcb_change_property(mConnection, XCB_PROP_MODE_REPLACE, window->id, XCB_ATOM_WM_NAME, XCB_ATOM_STRING, 8,
                      static_cast<std::uint32_t>(utf8.size()), utf8.data());
  if (window->parent != 0) return;
  // Task bars name an iconified window by its icon name.
  xcb_change_property(mConnection, XCB_PROP_MODE_REPLACE, window->id, Atom("_NET_WM_ICON_NAME"), Atom("UTF8_STRING"),
                      8, static_cast<std::uint32_t>(utf8.size()), utf8.data());
  xcb_change_property(mConnection, XCB_PROP_MODE_REPLACE, window->id, XCB_ATOM_WM_ICON_NAME, XCB_ATOM_STRING, 8,
                      static_cast<std::uint32_t>(utf8.size()), utf8.data());
}

UTF16String OS_NativeLayer_X11::GetWindowText(OS_WindowHandle inWindow) const {
  const X11Window* window = Find(inWindow);
  return window ? window->text : UTF16String();
}

std::uint32_t OS_NativeLayer_X11::GetStyle(OS_WindowHandle inWindow) const {
  const X11Window* window = Find(inWindow);
  return window ? window->style : 0;
}

void OS_NativeLayer_X11::SetStyle(OS_WindowHandle inWindow, std::uint32_t inStyle) {
  X11Window* window = Find(inWindow);
  if (!window) return;
  const std::uint32_t old = window->style;
  window->style = (inStyle & ~kOSStyleVisible) | (old & kOSStyleVisible);
  if ((old ^ inStyle) & kOSStyleVisible) ShowWindow(inWindow, (inStyle & kOSStyleVisible) ? kOSShowNA : kOSShowHide);
  if (X11Window* still = Find(inWindow); still && still->parent == 0) UpdateTopLevelKind(*still);
}

std::uint32_t OS_NativeLayer_X11::GetExStyle(OS_WindowHandle inWindow) const {
  const X11Window* window = Find(inWindow);
  return window ? window->exStyle : 0;
}

void OS_NativeLayer_X11::SetExStyle(OS_WindowHandle inWindow, std::uint32_t inExStyle) {
  X11Window* window = Find(inWindow);
  if (!window) return;
  window->exStyle = inExStyle;
  if (window->parent == 0) UpdateTopLevelKind(*window);
}

std::vector<OS_WindowHandle> OS_NativeLayer_X11::EnumerateWindows() const {
  std::vector<OS_WindowHandle> result;
  result.reserve(mWindows.size());
  for (const auto& [handle, window] : mWindows) result.push_back(handle);
  return result;
}

OS_WindowHandle OS_NativeLayer_X11::GetParent(OS_WindowHandle inWindow) const {
  const X11Window* window = Find(inWindow);
  return window ? window->parent : 0;
}

OS_WindowHandle OS_NativeLayer_X11::GetOwner(OS_WindowHandle inWindow) const {
  const X11Window* window = Find(inWindow);
  return window ? window->owner : 0;
}

bool OS_NativeLayer_X11::IsChild(OS_WindowHandle inParent, OS_WindowHandle inWindow) const {
  for (const X11Window* w = Find(inWindow); w && w->parent != 0; w = Find(w->parent))
    if (w->parent == inParent) return true;
  return false;
}

OS_WindowHandle OS_NativeLayer_X11::GetTopWindow(OS_WindowHandle inParent) const {
  if (inParent == 0) return mStacking.empty() ? 0 : mStacking.front();
  const X11Window* parent = Find(inParent);
  return parent && !parent->children.empty() ? parent->children.front() : 0;
}

OS_WindowHandle OS_NativeLayer_X11::GetNextWindow(OS_WindowHandle inWindow, int inRelation) const {
  const X11Window* window = Find(inWindow);
  if (!window) return 0;
  if (inRelation == kOSWindowOwner) return window->owner;
  if (inRelation == kOSWindowChild) return window->children.empty() ? 0 : window->children.front();
  const X11Window* parent = window->parent ? Find(window->parent) : nullptr;
  const std::vector<OS_WindowHandle>& siblings = parent ? parent->children : mStacking;
  auto it = std::find(siblings.begin(), siblings.end(), inWindow);
  if (it == siblings.end()) return 0;
  switch (inRelation) {
    case kOSWindowFirst: return siblings.front();
    case kOSWindowLast: return siblings.back();
    case kOSWindowNext: return std::next(it) == siblings.end() ? 0 : *std::next(it);
    case kOSWindowPrevious: return it == siblings.begin() ? 0 : *std::prev(it);
    default: return 0;
  }
}

void OS_NativeLayer_X11::SetParent(OS_WindowHandle inWindow, OS_WindowHandle inParent) {
  X11Window* window = Find(inWindow);
  if (!window || inWindow == inParent || (inParent != 0 && !Find(inParent)) || IsChild(inWindow, inParent)) return;
  auto& oldSiblings = SiblingsOf(*window);
  oldSiblings.erase(std::remove(oldSiblings.begin(), oldSiblings.end(), inWindow), oldSiblings.end());
  const OS_Point screen = ClientToScreen(inWindow, OS_Point(0, 0));
  window->parent = inParent;
  if (inParent != 0) window->owner = 0;
  OS_Point origin = inParent ? ScreenToClient(inParent, screen) : screen;
  window->rect.left = origin.x;
  window->rect.top = origin.y;
  SiblingsOf(*window).insert(SiblingsOf(*window).begin(), inWindow);
  xcb_reparent_window(mConnection, window->id, inParent ? static_cast<xcb_window_t>(inParent) : mScreen->root,
                      static_cast<int16_t>(origin.x), static_cast<int16_t>(origin.y));
  if (inParent == 0 && !window->overrideRedirect) ApplyTopLevelHints(*window);
  xcb_flush(mConnection);
}

void OS_NativeLayer_X11::EnableWindow(OS_WindowHandle inWindow, bool inEnable) {
  X11Window* window = Find(inWindow);
  if (!window) return;
  if (inEnable)
    window->style &= ~kOSStyleDisabled;
  else
    window->style |= kOSStyleDisabled;
  if (!inEnable && (mCapture == inWindow || IsChild(inWindow, mCapture))) ReleaseCapture();
}

bool OS_NativeLayer_X11::IsWindowEnabled(OS_WindowHandle inWindow) const {
  const X11Window* window = Find(inWindow);
  return window && (window->style & kOSStyleDisabled) == 0;
}

void OS_NativeLayer_X11::ShowCaret(OS_WindowHandle inWindow, bool inShow) {
  if (X11Window* window = Find(inWindow)) window->caretCount += inShow ? 1 : -1;
}


}  // namespace norvik::ui::x11
