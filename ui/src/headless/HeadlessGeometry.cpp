// Geometry of the headless system: showing and hiding, position and size,
// minimise and maximise, z-order with the topmost band, and hit testing.
#include <algorithm>

#include "ui/src/headless/OS_NativeLayer_Headless.h"

namespace norvik::ui::headless {
namespace {

// Where a minimised top level goes: off every monitor, with no client area.
const OS_Rect kMinimizedRect(-32000, -32000, 0, 0);

bool IsTopmost(const HeadlessWindow& inWindow) { return (inWindow.exStyle & kOSExStyleTopmost) != 0; }

}  // namespace

// ---- showing and hiding ----

void OS_NativeLayer_Headless::ShowWindow(OS_WindowHandle inWindow, int inShowCommand) {
  HeadlessWindow* window = Find(inWindow);
  if (!window) return;
  const bool topLevel = window->parent == 0;
  switch (inShowCommand) {
    case kOSShowHide:
      SetVisible(inWindow, false, false);
      return;
    case kOSShowNormal:
    case kOSShowRestore:
      if (topLevel && window->show != ShowState::kNormal) RestoreWindow(inWindow, false);
      SetVisible(inWindow, true, topLevel);
      return;
    case kOSShowNoActivate:
      if (topLevel && window->show == ShowState::kMinimized) RestoreWindow(inWindow, false);
      SetVisible(inWindow, true, false);
      return;
    case kOSShowMaximized:
      if (topLevel) MaximizeWindow(inWindow, false);
      SetVisible(inWindow, true, topLevel);
      return;
    case kOSShowMinimized:
    case kOSShowMinimize:
    case kOSShowMinNoActive:
      if (topLevel) MinimizeWindow(inWindow, false);
      SetVisible(inWindow, true, false);
      return;
    case kOSShow:
      SetVisible(inWindow, true, topLevel && window->show != ShowState::kMinimized);
      return;
    case kOSShowNA:
    default:
      SetVisible(inWindow, true, false);
      return;
  }
}

void OS_NativeLayer_Headless::SetVisible(OS_WindowHandle inWindow, bool inVisible, bool inActivate) {
  HeadlessWindow* window = Find(inWindow);
  if (!window) return;
  const bool wasVisible = (window->style & kOSStyleVisible) != 0;
  if (inVisible) {
    if (!wasVisible) {
      window->style |= kOSStyleVisible;
      // Whatever was drawn while hidden may be stale: the window and its
      // visible children repaint.
      std::vector<OS_WindowHandle> subtree;
      CollectSubtree(inWindow, subtree);
      for (OS_WindowHandle handle : subtree)
        if (IsWindowVisible(handle)) InvalidateRect(handle, nullptr);
    }
    if (inActivate && window->parent == 0 && CanActivate(inWindow)) Activate(inWindow, kOSActivationActive);
  } else if (wasVisible) {
    window->style &= ~static_cast<std::uint32_t>(kOSStyleVisible);
    if (window->parent == 0 && mActive == inWindow) ActivateNextAfterLoss(inWindow);
  }
  if (inVisible != wasVisible) CheckMouseLeave();
}

bool OS_NativeLayer_Headless::IsWindowVisible(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  if (!window) return false;
  for (; window; window = window->parent ? Find(window->parent) : nullptr)
    if ((window->style & kOSStyleVisible) == 0) return false;
  return true;
}

bool OS_NativeLayer_Headless::IsMinimized(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window && window->show == ShowState::kMinimized;
}

bool OS_NativeLayer_Headless::IsMaximized(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window && window->show == ShowState::kMaximized;
}

// ---- position and size ----

void OS_NativeLayer_Headless::MoveAndSize(OS_WindowHandle inWindow, const OS_Rect& inRect, int inSizeKind,
                                          bool inRedraw) {
  HeadlessWindow* window = Find(inWindow);
  if (!window) return;
  const OS_Rect newRect(inRect.left, inRect.top, std::max(0L, inRect.width), std::max(0L, inRect.height));
  const bool resized = newRect.width != window->rect.width || newRect.height != window->rect.height;
  const bool moved = newRect.left != window->rect.left || newRect.top != window->rect.top;
  window->rect = newRect;
  if (resized) {
    EnsureSurface(*window);
    cairo_rectangle_int_t client = {0, 0, static_cast<int>(newRect.width), static_cast<int>(newRect.height)};
    cairo_region_intersect_rectangle(window->damage, &client);
    if (inRedraw) InvalidateRect(inWindow, nullptr);
    CallProcedure(inWindow, kOSMsgSize, static_cast<std::uintptr_t>(inSizeKind),
                  MakePointParam(static_cast<int>(newRect.width), static_cast<int>(newRect.height)));
  }
  if (resized || moved) CheckMouseLeave();
}

void OS_NativeLayer_Headless::SetWindowPos(OS_WindowHandle inWindow, OS_WindowHandle inInsertAfter,
                                           const OS_Rect& inRect, std::uint32_t inFlags) {
  HeadlessWindow* window = Find(inWindow);
  if (!window) return;
  OS_Rect target = window->rect;
  if ((inFlags & kOSPosNoMove) == 0) {
    target.left = inRect.left;
    target.top = inRect.top;
  }
  if ((inFlags & kOSPosNoSize) == 0) {
    target.width = inRect.width;
    target.height = inRect.height;
  }
  if (target != window->rect) {
    const int kind = window->show == ShowState::kMaximized ? kOSSizeMaximized : kOSSizeRestored;
    if (window->parent == 0 && window->show == ShowState::kNormal) window->normalRect = target;
    MoveAndSize(inWindow, target, kind, (inFlags & kOSPosNoRedraw) == 0);
    if (!Find(inWindow)) return;
  }
  if ((inFlags & kOSPosNoZOrder) == 0) PlaceInZOrder(inWindow, inInsertAfter);
  if ((inFlags & kOSPosHideWindow) != 0) SetVisible(inWindow, false, false);
  if ((inFlags & kOSPosShowWindow) != 0) SetVisible(inWindow, true, false);
  window = Find(inWindow);
  if (window && (inFlags & kOSPosNoActivate) == 0 && window->parent == 0 && IsWindowVisible(inWindow) &&
      CanActivate(inWindow))
    Activate(inWindow, kOSActivationActive);
}

OS_Rect OS_NativeLayer_Headless::ScreenRectOf(const HeadlessWindow& inWindow) const {
  OS_Rect rect = inWindow.rect;
  for (const HeadlessWindow* parent = Find(inWindow.parent); parent; parent = Find(parent->parent))
    rect.Offset(parent->rect.left, parent->rect.top);
  return rect;
}

OS_Rect OS_NativeLayer_Headless::GetWindowRect(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window ? ScreenRectOf(*window) : OS_Rect();
}

OS_Rect OS_NativeLayer_Headless::GetClientRect(OS_WindowHandle inWindow) const {
  const HeadlessWindow* window = Find(inWindow);
  return window ? OS_Rect(0, 0, window->rect.width, window->rect.height) : OS_Rect();
}

OS_Point OS_NativeLayer_Headless::ClientToScreen(OS_WindowHandle inWindow, OS_Point inPoint) const {
  const OS_Rect rect = GetWindowRect(inWindow);
  return OS_Point(inPoint.x + rect.left, inPoint.y + rect.top);
}

OS_Point OS_NativeLayer_Headless::ScreenToClient(OS_WindowHandle inWindow, OS_Point inPoint) const {
  const OS_Rect rect = GetWindowRect(inWindow);
  return OS_Point(inPoint.x - rect.left, inPoint.y - rect.top);
}

// ---- minimise, maximise, placement ----

OS_Rect OS_NativeLayer_Headless::WorkAreaFor(const OS_Rect& inScreenRect) const {
  if (mMonitors.empty()) return inScreenRect;
  const OS_Monitor* best = &mMonitors.front();
  long bestArea = 0;
  for (const OS_Monitor& monitor : mMonitors) {
    const OS_Rect common = monitor.bounds.Intersection(inScreenRect);
    const long area = common.width * common.height;
    if (area > bestArea) {
      bestArea = area;
      best = &monitor;
    }
  }
  return best->workArea;
}

void OS_NativeLayer_Headless::MinimizeWindow(OS_WindowHandle inWindow, bool inActivate) {
  HeadlessWindow* window = Find(inWindow);
  if (!window || window->show == ShowState::kMinimized) return;
  if (window->show == ShowState::kNormal) window->normalRect = window->rect;
  window->placementFlags = window->show == ShowState::kMaximized
                               ? window->placementFlags | kOSPlacementRestoreToMaximized
                               : window->placementFlags & ~kOSPlacementRestoreToMaximized;
  window->show = ShowState::kMinimized;
  window->style = (window->style | kOSStyleMinimize) & ~static_cast<std::uint32_t>(kOSStyleMaximize);
  MoveAndSize(inWindow, kMinimizedRect, kOSSizeMinimized, false);
  if (mActive == inWindow) ActivateNextAfterLoss(inWindow);
  (void)inActivate;
}

void OS_NativeLayer_Headless::MaximizeWindow(OS_WindowHandle inWindow, bool inActivate) {
  HeadlessWindow* window = Find(inWindow);
  if (!window || window->show == ShowState::kMaximized) return;
  if (window->show == ShowState::kNormal) window->normalRect = window->rect;
  window->show = ShowState::kMaximized;
  window->style = (window->style | kOSStyleMaximize) & ~static_cast<std::uint32_t>(kOSStyleMinimize);
  MoveAndSize(inWindow, WorkAreaFor(window->normalRect), kOSSizeMaximized, true);
  if (inActivate && CanActivate(inWindow)) Activate(inWindow, kOSActivationActive);
}

void OS_NativeLayer_Headless::RestoreWindow(OS_WindowHandle inWindow, bool inActivate) {
  HeadlessWindow* window = Find(inWindow);
  if (!window || window->show == ShowState::kNormal) return;
  if (window->show == ShowState::kMinimized && (window->placementFlags & kOSPlacementRestoreToMaximized) != 0) {
    window->show = ShowState::kNormal;
    MaximizeWindow(inWindow, inActivate);
    return;
  }
  window->show = ShowState::kNormal;
  window->style &= ~static_cast<std::uint32_t>(kOSStyleMaximize | kOSStyleMinimize);
  MoveAndSize(inWindow, window->normalRect, kOSSizeRestored, true);
  if (inActivate && CanActivate(inWindow)) Activate(inWindow, kOSActivationActive);
}

bool OS_NativeLayer_Headless::GetWindowPlacement(OS_WindowHandle inWindow, OS_WindowPlacement& outPlacement) const {
  const HeadlessWindow* window = Find(inWindow);
  if (!window) return false;
  outPlacement.flags = window->placementFlags;
  outPlacement.showCommand = window->show == ShowState::kMinimized   ? kOSShowMinimized
                             : window->show == ShowState::kMaximized ? kOSShowMaximized
                                                                     : kOSShowNormal;
  outPlacement.normalRect =
      window->parent != 0 || window->show == ShowState::kNormal ? window->rect : window->normalRect;
  return true;
}

void OS_NativeLayer_Headless::SetWindowPlacement(OS_WindowHandle inWindow, const OS_WindowPlacement& inPlacement) {
  HeadlessWindow* window = Find(inWindow);
  if (!window) return;
  window->placementFlags = inPlacement.flags;
  if (window->parent != 0) {
    SetWindowPos(inWindow, 0, inPlacement.normalRect, kOSPosNoZOrder | kOSPosNoActivate);
    return;
  }
  window->normalRect = inPlacement.normalRect;
  switch (inPlacement.showCommand) {
    case kOSShowMinimized:
    case kOSShowMinimize:
    case kOSShowMinNoActive:
      MinimizeWindow(inWindow, false);
      break;
    case kOSShowMaximized:
      MaximizeWindow(inWindow, false);
      break;
    case kOSShowHide:
      SetVisible(inWindow, false, false);
      break;
    default:
      if (window->show == ShowState::kNormal)
        MoveAndSize(inWindow, inPlacement.normalRect, kOSSizeRestored, true);
      else
        RestoreWindow(inWindow, false);
      break;
  }
}

// ---- z-order ----

void OS_NativeLayer_Headless::PlaceInZOrder(OS_WindowHandle inWindow, OS_WindowHandle inInsertAfter) {
  HeadlessWindow* window = Find(inWindow);
  if (!window) return;
  auto& siblings = SiblingList(*window);
  siblings.erase(std::remove(siblings.begin(), siblings.end(), inWindow), siblings.end());
  const bool topLevel = window->parent == 0;
  if (topLevel && inInsertAfter == kOSInsertTopmost) window->exStyle |= kOSExStyleTopmost;
  if (topLevel && (inInsertAfter == kOSInsertNoTopmost || inInsertAfter == kOSInsertBottom))
    window->exStyle &= ~static_cast<std::uint32_t>(kOSExStyleTopmost);

  // The topmost band sits above everything else among top levels.
  auto bandStart = siblings.begin();
  auto bandEnd = siblings.end();
  if (topLevel) {
    auto firstOrdinary = std::find_if(siblings.begin(), siblings.end(), [this](OS_WindowHandle inHandle) {
      const HeadlessWindow* other = Find(inHandle);
      return other && !IsTopmost(*other);
    });
    if (IsTopmost(*window))
      bandEnd = firstOrdinary;
    else
      bandStart = firstOrdinary;
  }
  auto position = bandStart;
  if (inInsertAfter == kOSInsertBottom) {
    position = bandEnd;
  } else if (inInsertAfter != kOSInsertTop && inInsertAfter != kOSInsertTopmost &&
             inInsertAfter != kOSInsertNoTopmost) {
    auto after = std::find(siblings.begin(), siblings.end(), inInsertAfter);
    if (after != siblings.end()) position = std::clamp(after + 1, bandStart, bandEnd);
  }
  siblings.insert(position, inWindow);
  if (topLevel) RaiseOwnedAbove(inWindow);
}

void OS_NativeLayer_Headless::RaiseOwnedAbove(OS_WindowHandle inOwner) {
  const HeadlessWindow* owner = Find(inOwner);
  if (!owner) return;
  // Owned windows stay above their owner; among themselves they keep their order.
  std::vector<OS_WindowHandle> below;
  auto ownerPos = std::find(mTopLevels.begin(), mTopLevels.end(), inOwner);
  for (auto it = ownerPos; it != mTopLevels.end(); ++it) {
    const HeadlessWindow* other = Find(*it);
    if (other && other->owner == inOwner && (IsTopmost(*other) || !IsTopmost(*owner))) below.push_back(*it);
  }
  for (OS_WindowHandle handle : below) {
    mTopLevels.erase(std::remove(mTopLevels.begin(), mTopLevels.end(), handle), mTopLevels.end());
    mTopLevels.insert(std::find(mTopLevels.begin(), mTopLevels.end(), inOwner), handle);
  }
  for (OS_WindowHandle handle : below) RaiseOwnedAbove(handle);
}

// ---- hit testing ----

OS_WindowHandle OS_NativeLayer_Headless::ChildFromPoint(OS_WindowHandle inWindow, OS_Point inScreenPoint) const {
  const HeadlessWindow* window = Find(inWindow);
  if (!window) return 0;
  // Walks down the children under the point, carrying the screen origin of
  // the current window rather than recomputing it at every level.
  OS_Point origin = ScreenRectOf(*window).Origin();
  for (;;) {
    const HeadlessWindow* hit = nullptr;
    for (OS_WindowHandle handle : window->children) {
      const HeadlessWindow* child = Find(handle);
      if (!child || (child->style & kOSStyleVisible) == 0 || (child->exStyle & kOSExStyleTransparent) != 0) continue;
      if (!child->rect.Offsetted(origin.x, origin.y).Contains(inScreenPoint)) continue;
      hit = child;
      break;
    }
    // A disabled child lets the point fall to its parent.
    if (!hit || (hit->style & kOSStyleDisabled) != 0) return window->handle;
    origin = OS_Point(origin.x + hit->rect.left, origin.y + hit->rect.top);
    window = hit;
  }
}

OS_WindowHandle OS_NativeLayer_Headless::WindowFromPoint(OS_Point inScreenPoint) const {
  for (OS_WindowHandle handle : mTopLevels) {
    const HeadlessWindow* window = Find(handle);
    if (!window || (window->style & kOSStyleVisible) == 0 || window->show == ShowState::kMinimized) continue;
    if ((window->exStyle & kOSExStyleTransparent) != 0 && (window->exStyle & kOSExStyleLayered) != 0) continue;
    if (!window->rect.Contains(inScreenPoint)) continue;
    // A disabled top level takes the point without accepting it.
    if ((window->style & kOSStyleDisabled) != 0) return 0;
    return ChildFromPoint(handle, inScreenPoint);
  }
  return 0;
}

}  // namespace norvik::ui::headless
