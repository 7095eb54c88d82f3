// Windows of the headless system: creation and destruction, properties,
// styles, text, and the parent, owner and sibling links.
#include <algorithm>

#include "ui/src/headless/OS_NativeLayer_Headless.h"

namespace norvik::ui::headless {

const char16_t kToolkitWindowClass[] = u"TolliverLord - Window Class";
const char16_t kForeignWindowClass[] = u"norvik headless foreign window";

HeadlessWindow::~HeadlessWindow() {
  if (damage) cairo_region_destroy(damage);
  if (surface) cairo_surface_destroy(surface);
}

OS_NativeLayer_Headless::OS_NativeLayer_Headless() {
  OS_Monitor primary;
  primary.bounds = OS_Rect(0, 0, 1920, 1080);
  primary.workArea = OS_Rect(0, 0, 1920, 1040);
  mMonitors.push_back(primary);
  mPointer = OS_Point(-1, -1);
  mCursor = LoadSystemCursor(kOSCursorArrow);
}

OS_NativeLayer_Headless::~OS_NativeLayer_Headless() {
  if (mExecutor) mExecutor->SetWakeUpFunction(nullptr);
}

HeadlessWindow* OS_NativeLayer_Headless::Find(OS_WindowHandle inWindow) const {
  auto it = mWindows.find(inWindow);
  return it == mWindows.end() ? nullptr : it->second.get();
}

OS_WindowHandle OS_NativeLayer_Headless::CreateWindow(const OS_WindowCreateParams& inParams) {
  return MakeWindow(inParams, true, false);
}

OS_WindowHandle OS_NativeLayer_Headless::CreateForeignWindow(const OS_WindowCreateParams& inParams,
                                                             bool inOtherThread) {
  return MakeWindow(inParams, false, inOtherThread);
}

OS_WindowHandle OS_NativeLayer_Headless::MakeWindow(const OS_WindowCreateParams& inParams, bool inOurs,
                                                    bool inOtherThread) {
  if (inParams.parent != 0 && !Find(inParams.parent)) return 0;
  const bool isChild = (inParams.style & kOSStyleChild) != 0;
  if (isChild && inParams.parent == 0) return 0;

  auto window = std::make_unique<HeadlessWindow>();
  const OS_WindowHandle handle = mNextHandle;
  mNextHandle += 4;
  window->handle = handle;
  window->className = inOurs ? kToolkitWindowClass : kForeignWindowClass;
  window->text = inParams.title;
  window->rect = OS_Rect(inParams.rect.left, inParams.rect.top, std::max(0L, inParams.rect.width),
                         std::max(0L, inParams.rect.height));
  // Visibility is applied after creation, so that showing does its work.
  window->style = inParams.style & ~static_cast<std::uint32_t>(kOSStyleVisible | kOSStyleMinimize | kOSStyleMaximize);
  window->exStyle = inParams.exStyle;
  window->classStyle = inParams.classStyle;
  window->ours = inOurs;
  window->thread = inOtherThread ? std::thread::id() : std::this_thread::get_id();
  window->damage = cairo_region_create();
  if (isChild) {
    window->parent = inParams.parent;
  } else {
    window->owner = inParams.parent ? TopLevelOf(inParams.parent) : 0;
    window->normalRect = window->rect;
  }
  mWindows[handle] = std::move(window);
  PlaceInZOrder(handle, kOSInsertTop);

  if (CallProcedure(handle, kOSMsgNCCreate, 0, reinterpret_cast<std::intptr_t>(inParams.createParam)) == 0) {
    // Refused: the window goes away without ever having been shown.
    if (HeadlessWindow* refused = Find(handle)) {
      refused->destroying = true;
      CallProcedure(handle, kOSMsgNCDestroy, 0, 0);
      ForgetWindow(handle);
    }
    return 0;
  }
  HeadlessWindow* created = Find(handle);
  if (!created) return 0;
  EnsureSurface(*created);
  CallProcedure(handle, kOSMsgSize, kOSSizeRestored,
                MakePointParam(static_cast<int>(created->rect.width), static_cast<int>(created->rect.height)));
  if (!Find(handle)) return 0;
  if ((inParams.style & kOSStyleMaximize) != 0 && !isChild)
    MaximizeWindow(handle, false);
  else if ((inParams.style & kOSStyleMinimize) != 0 && !isChild)
    MinimizeWindow(handle, false);
  if ((inParams.style & kOSStyleVisible) != 0) SetVisible(handle, true, !isChild);
  return Find(handle) ? handle : 0;
}

void OS_NativeLayer_Headless::CollectSubtree(OS_WindowHandle inWindow,
                                             std::vector<OS_WindowHandle>& outWindows) const {
  const HeadlessWindow* window = Find(inWindow);
  if (!window) return;
  outWindows.push_back(inWindow);
  for (OS_WindowHandle child : window->children) CollectSubtree(child, outWindows);
}

void OS_NativeLayer_Headless::DestroyWindow(OS_WindowHandle inWindow) {
  HeadlessWindow* window = Find(inWindow);
  if (!window || window->destroying) return;

  // Owned windows go first, as they cannot outlive their owner.
  std::vector<OS_WindowHandle> owned;
  for (const auto& entry : mWindows)
    if (entry.second->owner == inWindow) owned.push_back(entry.first);
  for (OS_WindowHandle handle : owned) DestroyWindow(handle);

  std::vector<OS_WindowHandle> subtree;
  CollectSubtree(inWindow, subtree);
  if (subtree.empty()) return;
  for (OS_WindowHandle handle : subtree) Find(handle)->destroying = true;

  auto inSubtree = [&subtree](OS_WindowHandle inHandle) {
    return inHandle != 0 && std::find(subtree.begin(), subtree.end(), inHandle) != subtree.end();
  };
  SetVisible(inWindow, false, false);
  if (inSubtree(mFocus)) SetFocus(0);
  if (inSubtree(mCapture)) ReleaseCapture();
  if (inSubtree(mMouseLeaveWindow)) mMouseLeaveWindow = 0;

  for (OS_WindowHandle handle : subtree)
    if (Find(handle)) CallProcedure(handle, kOSMsgDestroy, 0, 0);
  for (auto it = subtree.rbegin(); it != subtree.rend(); ++it)
    if (Find(*it)) CallProcedure(*it, kOSMsgNCDestroy, 0, 0);
  for (auto it = subtree.rbegin(); it != subtree.rend(); ++it) ForgetWindow(*it);
}

void OS_NativeLayer_Headless::ForgetWindow(OS_WindowHandle inWindow) {
  HeadlessWindow* window = Find(inWindow);
  if (!window) return;
  auto& siblings = SiblingList(*window);
  siblings.erase(std::remove(siblings.begin(), siblings.end(), inWindow), siblings.end());
  mTimers.erase(std::remove_if(mTimers.begin(), mTimers.end(),
                               [inWindow](const HeadlessTimer& inTimer) { return inTimer.window == inWindow; }),
                mTimers.end());
  mQueue.erase(std::remove_if(mQueue.begin(), mQueue.end(),
                              [inWindow](const QueuedMessage& inMessage) {
                                return inMessage.event.GetHWnd() == inWindow;
                              }),
               mQueue.end());
  for (auto& entry : mWindows)
    if (entry.second->owner == inWindow) entry.second->owner = 0;
  if (mActive == inWindow) mActive = 0;
  if (mFocus == inWindow) mFocus = 0;
  if (mCapture == inWindow) mCapture = 0;
  if (mMouseLeaveWindow == inWindow) mMouseLeaveWindow = 0;
  if (mLastClickWindow == inWindow) mLastClickWindow = 0;
  mWindows.erase(inWindow);
}

bool OS_NativeLayer_Headless::IsWindow(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window && !window->destroying;
}

bool OS_NativeLayer_Headless::SubclassWindow(OS_WindowHandle inWindow) {
  HeadlessWindow* window = Find(inWindow);
  if (!window || window->thread != std::this_thread::get_id()) return false;
  window->ours = true;
  return true;
}

bool OS_NativeLayer_Headless::UsesOurProcedure(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window && window->ours;
}

UTF16String OS_NativeLayer_Headless::GetClassName(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window ? window->className : UTF16String();
}

bool OS_NativeLayer_Headless::IsWindowOfThisThread(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window && window->thread == std::this_thread::get_id();
}

void OS_NativeLayer_Headless::SetProperty(OS_WindowHandle inWindow, const std::string& inName, void* inValue) {
  if (HeadlessWindow* window = Find(inWindow)) window->properties[inName] = inValue;
}

void* OS_NativeLayer_Headless::GetProperty(OS_WindowHandle inWindow, const std::string& inName) const {
  const HeadlessWindow* window = Find(inWindow);
  if (!window) return nullptr;
  auto it = window->properties.find(inName);
  return it == window->properties.end() ? nullptr : it->second;
}

void OS_NativeLayer_Headless::RemoveProperty(OS_WindowHandle inWindow, const std::string& inName) {
  if (HeadlessWindow* window = Find(inWindow)) window->properties.erase(inName);
}

void OS_NativeLayer_Headless::SetWindowText(OS_WindowHandle inWindow, const UTF16String& inText) {
  if (HeadlessWindow* window = Find(inWindow)) window->text = inText;
}

UTF16String OS_NativeLayer_Headless::GetWindowText(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window ? window->text : UTF16String();
}

std::uint32_t OS_NativeLayer_Headless::GetStyle(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window ? window->style : 0;
}

void OS_NativeLayer_Headless::SetStyle(OS_WindowHandle inWindow, std::uint32_t inStyle) {
  if (HeadlessWindow* window = Find(inWindow)) window->style = inStyle;
}

std::uint32_t OS_NativeLayer_Headless::GetExStyle(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window ? window->exStyle : 0;
}

void OS_NativeLayer_Headless::SetExStyle(OS_WindowHandle inWindow, std::uint32_t inExStyle) {
  if (HeadlessWindow* window = Find(inWindow)) window->exStyle = inExStyle;
}

std::vector<OS_WindowHandle>& OS_NativeLayer_Headless::SiblingList(const HeadlessWindow& inWindow) {
  if (inWindow.parent != 0)
    if (HeadlessWindow* parent = Find(inWindow.parent)) return parent->children;
  return mTopLevels;
}

const std::vector<OS_WindowHandle>& OS_NativeLayer_Headless::SiblingList(const HeadlessWindow& inWindow) const {
  if (inWindow.parent != 0)
    if (const HeadlessWindow* parent = Find(inWindow.parent)) return parent->children;
  return mTopLevels;
}

OS_WindowHandle OS_NativeLayer_Headless::TopLevelOf(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  while (window && window->parent != 0) {
    inWindow = window->parent;
    window = Find(inWindow);
  }
  return window ? inWindow : 0;
}

void OS_NativeLayer_Headless::SetParent(OS_WindowHandle inWindow, OS_WindowHandle inParent) {
  HeadlessWindow* window = Find(inWindow);
  if (!window || window->parent == inParent) return;
  if (inParent != 0 && (inParent == inWindow || IsChild(inWindow, inParent) || !Find(inParent))) return;
  auto& oldSiblings = SiblingList(*window);
  oldSiblings.erase(std::remove(oldSiblings.begin(), oldSiblings.end(), inWindow), oldSiblings.end());
  window->parent = inParent;
  if (inParent != 0) window->owner = 0;
  PlaceInZOrder(inWindow, kOSInsertTop);
  if (IsWindowVisible(inWindow)) InvalidateRect(inWindow, nullptr);
}

OS_WindowHandle OS_NativeLayer_Headless::GetParent(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window ? window->parent : 0;
}

OS_WindowHandle OS_NativeLayer_Headless::GetOwner(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window ? window->owner : 0;
}

bool OS_NativeLayer_Headless::IsChild(OS_WindowHandle inParent, OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  while (window && window->parent != 0) {
    if (window->parent == inParent) return true;
    window = Find(window->parent);
  }
  return false;
}

OS_WindowHandle OS_NativeLayer_Headless::GetTopWindow(OS_WindowHandle inParent) const {
  if (inParent == 0) return mTopLevels.empty() ? 0 : mTopLevels.front();
  const HeadlessWindow* parent = Find(inParent);
  return parent && !parent->children.empty() ? parent->children.front() : 0;
}

OS_WindowHandle OS_NativeLayer_Headless::GetNextWindow(OS_WindowHandle inWindow, int inRelation) const {
  const HeadlessWindow* window = Find(inWindow);
  if (!window) return 0;
  if (inRelation == kOSWindowOwner) return window->owner;
  if (inRelation == kOSWindowChild) return window->children.empty() ? 0 : window->children.front();
  const auto& siblings = SiblingList(*window);
  auto it = std::find(siblings.begin(), siblings.end(), inWindow);
  if (it == siblings.end()) return 0;
  switch (inRelation) {
    case kOSWindowFirst: return siblings.front();
    case kOSWindowLast: return siblings.back();
    case kOSWindowNext: return it + 1 == siblings.end() ? 0 : *(it + 1);
    case kOSWindowPrevious: return it == siblings.begin() ? 0 : *(it - 1);
    default: return 0;
  }
}

std::vector<OS_WindowHandle> OS_NativeLayer_Headless::EnumerateWindows() const {
  std::vector<OS_WindowHandle> result;
  for (const auto& entry : mWindows)
    if (!entry.second->destroying && entry.second->thread == std::this_thread::get_id())
      result.push_back(entry.first);
  return result;
}

void OS_NativeLayer_Headless::EnableWindow(OS_WindowHandle inWindow, bool inEnable) {
  HeadlessWindow* window = Find(inWindow);
  if (!window) return;
  if (inEnable) {
    window->style &= ~static_cast<std::uint32_t>(kOSStyleDisabled);
    return;
  }
  window->style |= kOSStyleDisabled;
  // A disabled window keeps neither the keyboard nor the pointer.
  if (mFocus != 0 && (mFocus == inWindow || IsChild(inWindow, mFocus))) SetFocus(0);
  if (mCapture != 0 && (mCapture == inWindow || IsChild(inWindow, mCapture))) ReleaseCapture();
}

bool OS_NativeLayer_Headless::IsWindowEnabled(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window && (window->style & kOSStyleDisabled) == 0;
}

void OS_NativeLayer_Headless::SetApplication(OS_WindowHandle inWindow, int inApplication) {
  if (HeadlessWindow* window = Find(inWindow)) window->application = inApplication;
}

}  // namespace norvik::ui::headless
