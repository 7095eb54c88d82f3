// The draw traversal: from a drawing root through the children, each node
// drawn directly or through its cached rendering.
#include <algorithm>
#include <cmath>
#include <optional>
#include <vector>

#include "drawbot/CacheInterface.h"
#include "drawbot/Drawbot.h"
#include "drawbot/SupplierInterface.h"
#include "drawbot/SurfaceInterface.h"
#include "ui/UI_Node.h"
#include "ui/src/PlainViewGeometry.h"

namespace norvik::ui {

namespace {

// Scales at or below this are treated as zero: such a child covers nothing.
constexpr float kMinimumScale = 1e-6f;

// The theme a node's supplier answers and its change count at one moment,
// so that a change in the middle of a drawing can be noticed.
struct ThemeStamp {
  ThemeP theme;
  std::uint64_t count = 0;

  bool operator==(const ThemeStamp& o) const { return theme == o.theme && count == o.count; }
  bool operator!=(const ThemeStamp& o) const { return !(*this == o); }
};

ThemeStamp CurrentThemeStamp(const UI_Node& inNode) {
  ThemeStamp stamp;
  const ThemeSupplier& supplier = inNode.UI_GetThemeSupplier();
  if (supplier && !supplier->empty()) stamp.theme = (*supplier)();
  if (stamp.theme) stamp.count = stamp.theme->GetThemeChangeCount();
  return stamp;
}

// False only when the child cannot pass the clip test of the full dispatch.
// The test is made in the parent's coordinates, on floats, with a margin of
// two child units and a pixel: the full test rounds the child's rectangle and
// the clip in the child's coordinates outwards, each by less than a unit.
// Whether the child is shown or native is left to the full dispatch, which
// asks again anyway: here it would only double the calls for every child.
bool MayTouchClip(const UI_Node& inChild, const UI_Node* inScrollingParent, const UI_Node::RectL& inClip) {
  const bool plain = plainview::KeepsViewGeometry(inChild);
  if (plain && !inScrollingParent && plainview::ViewIsOnlyMoved(inChild)) {
    // The common case, a view only moved: its rectangle in the parent is
    // its own, and the margin is three units.
    const UI_Node::RectF& r = plainview::Fields::Rect(static_cast<const UI_SubView&>(inChild));
    const double x1 = r.left, x2 = static_cast<double>(r.left) + r.width;
    const double y1 = r.top, y2 = static_cast<double>(r.top) + r.height;
    return !(std::min(x1, x2) >= static_cast<double>(inClip.Right()) + 3 ||
             std::max(x1, x2) <= static_cast<double>(inClip.left) - 3 ||
             std::min(y1, y2) >= static_cast<double>(inClip.Bottom()) + 3 ||
             std::max(y1, y2) <= static_cast<double>(inClip.top) - 3);
  }
  const UI_Node::Matrix m =
      plain ? plainview::ViewStep(inChild, inScrollingParent) : inChild.UI_GetSelfToParentMatrix();
  if (!(std::fabs(m.sx) > kMinimumScale) || !(std::fabs(m.sy) > kMinimumScale)) return false;
  const UI_Node::RectF local = plain ? plainview::ViewLocalRect(inChild) : inChild.UI_GetLocalRectF(false);
  const double sx = m.sx, sy = m.sy;
  const double x1 = local.left * sx + m.tx, x2 = local.Right() * sx + m.tx;
  const double y1 = local.top * sy + m.ty, y2 = local.Bottom() * sy + m.ty;
  const double mx = 2 * std::fabs(sx) + 1, my = 2 * std::fabs(sy) + 1;
  // Written so that a NaN anywhere keeps the child for the full test.
  return !(std::min(x1, x2) >= static_cast<double>(inClip.Right()) + mx ||
           std::max(x1, x2) <= static_cast<double>(inClip.left) - mx ||
           std::min(y1, y2) >= static_cast<double>(inClip.Bottom()) + my ||
           std::max(y1, y2) <= static_cast<double>(inClip.top) - my);
}

}  // namespace

void UI_Node::UI_Draw(drawbot::Drawbot* inDrawbot) { UI_DispatchDrawToChildren(inDrawbot); }

bool UI_Node::UI_UseDrawbotCache(drawbot::Drawbot* inDrawbot) const {
  switch (mDrawCachePolicy) {
    case kDrawCacheAlways:
      return true;
    case kDrawCacheNever:
      return false;
    case kDrawCacheDefault:
      break;
  }
  const drawbot::SupplierInterface* supplier = inDrawbot ? inDrawbot->GetSupplier() : nullptr;
  return supplier && supplier->PrefersToCacheAggressively();
}

void UI_Node::UI_DispatchDrawToChildren(drawbot::Drawbot* inDrawbot) {
  UI_NodeProtector protector(this);
  drawbot::SurfaceInterface* surface = inDrawbot ? inDrawbot->GetSurface() : nullptr;
  if (!surface) return;
  // A small repaint of a wide node must not pay a surface save, transform and
  // clip query for every child: children are first rejected against the clip
  // in this node's own integer coordinates, and only the rest are kept, with
  // strong references, since a child's drawing may remove siblings.
  const RectL clip = surface->GetClipBounds();
  if (clip.IsEmpty()) return;
  std::vector<UI_NodeP> drawn;
  const UI_Node* scrolling = plainview::ScrollingParent(this);
  // The size is read again at each step: a child's overriding code may change the list.
  for (std::size_t i = 0; i < mChildren.size(); ++i) {
    // A wide node's children are not in the cache between two paints.
    if (i + plainview::kPrefetchAhead < mChildren.size()) plainview::Prefetch(*mChildren[i + plainview::kPrefetchAhead]);
    UI_Node* child = mChildren[i].get();
    if (MayTouchClip(*child, scrolling, clip)) drawn.emplace_back(child);
  }
  for (const UI_NodeP& child : drawn) {
    if (child->UI_GetParentContainer() != this) continue;
    UI_DispatchDrawToChild(child.get(), inDrawbot);
  }
}

void UI_Node::UI_DispatchDrawToChild(UI_Node* inChild, drawbot::Drawbot* inDrawbot) {
  if (!inChild || !inDrawbot || !inDrawbot->GetSurface()) return;
  if (inChild->UI_ReceivesEventsFromOS()) return;  // a native window paints itself
  if (!inChild->UI_IsShown()) return;
  const Matrix matrix = inChild->UI_GetSelfToParentMatrix();
  if (!(std::fabs(matrix.sx) > kMinimumScale) || !(std::fabs(matrix.sy) > kMinimumScale)) return;

  UI_NodeP protector(inChild);
  drawbot::SurfaceInterfaceP surface(inDrawbot->GetSurface());
  drawbot::ScSurfaceState state(surface.get());
  surface->Transform(tarsel::geom::MatrixT<float>(matrix));
  if (surface->IsWithinClipBounds(UI_EnclosingRect(inChild->UI_GetLocalRectF(false))))
    inChild->UI_DrawAndCache(inDrawbot, false, nullptr);
}

void UI_Node::UI_DrawAndCache(drawbot::Drawbot* inDrawbot, bool inFromRoot,
                              const drawbot::ColorRGBA* inBackground) {
  UI_NodeProtector protector(this);
  drawbot::SurfaceInterface* surface = inDrawbot->GetSurface();
  const RectF rect = UI_GetLocalRectF(false);

  if (UI_UseDrawbotCache(inDrawbot)) {
    if (!mDrawbotCache || !UI_IsDrawbotCacheValid(*surface)) {
      if (mDrawbotCache) UI_InvalidateDrawbotCache(false);
      const ThemeStamp before = CurrentThemeStamp(*this);
      drawbot::CacheInterfaceP cache = surface->PushCacheStack(rect);
      if (cache) {
        drawbot::SurfaceInterface* cacheSurface = cache->GetSurface() ? cache->GetSurface() : surface;
        drawbot::Drawbot cacheDrawbot(inDrawbot->GetSupplier(), cacheSurface);
        UI_DrawSelf(&cacheDrawbot, inFromRoot, inBackground);
        if (cacheSurface != surface) cacheSurface->Flush();
        // Pixels drawn across a theme change mix two themes: they are not kept,
        // and the node is drawn again below in the new colours.
        if (CurrentThemeStamp(*this) == before) UI_SetDrawbotCache(cache);
        surface->PopCacheStack(cache);
      }
    }
  } else {
    // A node that does not cache must still drop what it had.
    UI_InvalidateDrawbotCache(false);
  }

  if (mDrawbotCache)
    surface->DrawCache(*mDrawbotCache);
  else
    UI_DrawSelf(inDrawbot, inFromRoot, inBackground);
}

void UI_Node::UI_DrawSelf(drawbot::Drawbot* inDrawbot, bool inFromRoot, const drawbot::ColorRGBA* inBackground) {
  drawbot::SurfaceInterface* surface = inDrawbot->GetSurface();
  const RectF local = UI_GetLocalRectF(false);
  std::optional<drawbot::ScSurfaceState> clipState;
  if (mClipToSelf) {
    clipState.emplace(surface);
    UI_ClipToRect(local, inDrawbot);
  }
  if (inFromRoot) {
    if (inBackground && inBackground->alpha > 0) {
      surface->SetAntiAliasPolicy(drawbot::kAntiAlias);
      surface->PaintRect(*inBackground, local);
    }
    UI_DispatchDrawToChildren(inDrawbot);
    return;
  }
  UI_DispatchDraw(inDrawbot);
}

void UI_Node::UI_DispatchDraw(drawbot::Drawbot* inDrawbot) {
  UI_NodeProtector protector(this);
  // A copy, so that the function may replace itself while it runs.
  const CustomDrawFunction custom = UI_GetCustomDrawFunction();
  if (custom && !custom->empty() && (*custom)(this, inDrawbot)) return;
  UI_Draw(inDrawbot);
}

void UI_Node::UI_DispatchDrawFromRoot(const drawbot::ColorRGBA* inBackground, drawbot::Drawbot* inDrawbot,
                                      bool inUseBuffer) {
  if (!inDrawbot || !inDrawbot->GetSurface() || !UI_IsShown()) return;
  UI_NodeProtector protector(this);
  UI_ClipOSControls(inDrawbot);
  if (!inDrawbot->GetSurface()->IsWithinClipBounds(UI_EnclosingRect(UI_GetLocalRectF(false)))) return;

  const drawbot::SupplierInterface* supplier = inDrawbot->GetSupplier();
  if (inUseBuffer && supplier) {
    drawbot::SurfaceInterfaceP buffered(supplier->NewReferenceSurface(inDrawbot->GetSurface(), true, nullptr));
    if (buffered) {
      drawbot::Drawbot bufferedDrawbot(supplier, buffered.get());
      UI_DrawAndCache(&bufferedDrawbot, true, inBackground);
      buffered->Flush();
      return;
    }
  }
  UI_DrawAndCache(inDrawbot, true, inBackground);
}

void UI_Node::UI_ClipOSControls(drawbot::Drawbot* inDrawbot) {
  OSControlClipRects rects;
  UI_GetOSControlClipRects(rects);
  if (rects.empty()) return;
  drawbot::SurfaceInterface* output = inDrawbot->GetSurface()->GetOutputSurface();
  const drawbot::SupplierInterface* supplier = inDrawbot->GetSurface()->GetOutputSupplier();
  if (!output || !supplier) return;

  boost::intrusive_ptr<drawbot::PathInterface> path(supplier->NewPath());
  path->AddRect(UI_GetLocalRectF(false));
  for (const auto& entry : rects) {
    const RectF global = entry.first ? entry.first->UI_LocalToGlobalF(entry.second) : entry.second;
    path->AddRect(UI_GlobalToLocalF(global));
  }
  // Even-odd: each control's rectangle inside the node's is a hole.
  output->Clip(*path, drawbot::kFillAlternate);
}

void UI_Node::UI_ClipToRect(const RectF& inRect, drawbot::Drawbot* inDrawbot) {
  drawbot::SurfaceInterface* surface = inDrawbot->GetSurface();
  boost::intrusive_ptr<drawbot::PathInterface> path(inDrawbot->GetSupplier()->NewPath());
  path->AddRect(inRect);
  surface->Clip(*path, drawbot::kFillWinding);
}

}  // namespace norvik::ui
