// UI_Node: coordinate mapping, invalidation and the node's own draw cache.
#include <cmath>

#include "drawbot/CacheInterface.h"
#include "tarsel/MatrixT.h"
#include "tarsel/ThrowError.h"
#include "ui/UI_Node.h"
#include "ui/UI_NodeManager.h"
#include "ui/src/PlainViewGeometry.h"

namespace norvik::ui {

namespace {

using Matrix = UI_Node::Matrix;

// The inverse, raising the toolkit's error for a view scaled to nothing.
Matrix Inverted(const Matrix& inMatrix) {
  tarsel::geom::MatrixT<float> m(inMatrix);
  m.Invert(true);
  return Matrix(m.a, m.d, m.tx, m.ty);
}

UI_Node::RectF TransformRect(const Matrix& inMatrix, const UI_Node::RectF& inRect) {
  return inMatrix.Transform(inRect);
}

UI_Node::RectL RoundRect(const UI_Node::RectF& inRect) {
  long l = UI_Node::UI_RoundToLong(inRect.left), t = UI_Node::UI_RoundToLong(inRect.top);
  long r = UI_Node::UI_RoundToLong(inRect.Right()), b = UI_Node::UI_RoundToLong(inRect.Bottom());
  return UI_Node::RectL(l, t, r - l, b - t);
}

}  // namespace

long UI_Node::UI_RoundToLong(float inValue) { return static_cast<long>(std::floor(inValue + 0.5f)); }

UI_Node::RectL UI_Node::UI_EnclosingRect(const RectF& inRect) {
  long l = static_cast<long>(std::floor(inRect.left)), t = static_cast<long>(std::floor(inRect.top));
  long r = static_cast<long>(std::ceil(inRect.Right())), b = static_cast<long>(std::ceil(inRect.Bottom()));
  return RectL(l, t, r - l, b - t);
}

UI_Node::Matrix UI_Node::UI_GetSelfToSpecificParentMatrix(const UI_Node* inNode, const UI_Node* inStop) {
  float sx = 1, sy = 1, tx = 0, ty = 0;
  const UI_Node* node = inNode;
  while (node && node != inStop) {
    // Views that are only moved, read from their fields: an add a level, in a
    // loop without calls, so that the result stays in registers. The exits
    // are branches, so the next level's address waits on one load only.
    while (plainview::KeepsViewMatrix(*node) && plainview::ViewIsOnlyMoved(*node)) {
      const UI_Container* up = node->UI_GetParentContainer();
      if (!up || !up->GetAsANode()) break;  // the top of the chain takes the general step
      const UI_Node* parent = static_cast<const UI_Node*>(up);
      if (plainview::ScrollingParent(parent)) break;
      const RectF& rect = plainview::Fields::Rect(static_cast<const UI_SubView&>(*node));
      tx += rect.left;
      ty += rect.top;
      node = parent;
      if (node == inStop) return Matrix(sx, sy, tx, ty);
    }
    const UI_Node* parent = node->UI_GetParentNode();
    const Matrix step = plainview::KeepsViewMatrix(*node)
                            ? plainview::ViewStep(*node, plainview::ScrollingParent(parent))
                            : node->UI_GetSelfToParentMatrix();
    if (step.IsTranslationOnly()) {
      tx += step.tx;
      ty += step.ty;
    } else {
      const Matrix composed = step.Concat(Matrix(sx, sy, tx, ty));
      sx = composed.sx;
      sy = composed.sy;
      tx = composed.tx;
      ty = composed.ty;
    }
    node = parent;
  }
  if (node) return Matrix(sx, sy, tx, ty);
  if (inStop) {
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                               "$$$/norvik/ui/Error/ParentNotFound=Parent not found.");
  }
  return Matrix(sx, sy, tx, ty);
}

UI_Node::Matrix UI_Node::UI_GetSelfToRootMatrix(const UI_Node* inNode) {
  return UI_GetSelfToSpecificParentMatrix(inNode, nullptr);
}

UI_Node::PointF UI_Node::UI_LocalToGlobalF(const PointF& inPoint) const {
  return UI_GetSelfToRootMatrix(this).Transform(inPoint);
}

UI_Node::PointF UI_Node::UI_GlobalToLocalF(const PointF& inPoint) const {
  return Inverted(UI_GetSelfToRootMatrix(this)).Transform(inPoint);
}

UI_Node::RectF UI_Node::UI_LocalToGlobalF(const RectF& inRect) const {
  return TransformRect(UI_GetSelfToRootMatrix(this), inRect);
}

UI_Node::RectF UI_Node::UI_GlobalToLocalF(const RectF& inRect) const {
  return TransformRect(Inverted(UI_GetSelfToRootMatrix(this)), inRect);
}

UI_Node::PointL UI_Node::UI_LocalToGlobal(const PointL& inPoint) const {
  PointF p = UI_LocalToGlobalF(PointF(inPoint));
  return PointL(UI_RoundToLong(p.x), UI_RoundToLong(p.y));
}

UI_Node::PointL UI_Node::UI_GlobalToLocal(const PointL& inPoint) const {
  PointF p = UI_GlobalToLocalF(PointF(inPoint));
  return PointL(UI_RoundToLong(p.x), UI_RoundToLong(p.y));
}

UI_Node::RectL UI_Node::UI_LocalToGlobal(const RectL& inRect) const {
  return RoundRect(UI_LocalToGlobalF(RectF(inRect)));
}

UI_Node::RectL UI_Node::UI_GlobalToLocal(const RectL& inRect) const {
  return RoundRect(UI_GlobalToLocalF(RectF(inRect)));
}

// ---------------------------------------------------------------- invalidation

void UI_Node::UI_Invalidate(const RectL*, unsigned long inFlags) {
  if (!(inFlags & kInvalidateKeepRendering)) UI_InvalidateDrawbotCache(false);
}

void UI_Node::UI_InvalidateDrawbotCache(bool inKeepCache) {
  UI_NodeManager* manager = UI_NodeManager::Get();
  const std::uint64_t seed = manager ? manager->GetDrawbotCacheSeed() : 0;
  if (seed == mDrawbotCacheInvalidatedSeed) return;
  if (!inKeepCache && mDrawbotCache) UI_SetDrawbotCache(nullptr);
  // A parent's cache holds its children's pixels, so it can never be kept.
  if (UI_Node* parent = UI_GetParentNode()) parent->UI_InvalidateDrawbotCache(false);
  mDrawbotCacheInvalidatedSeed = seed;
}

void UI_Node::UI_SetDrawbotCache(const boost::intrusive_ptr<drawbot::CacheInterface>& inCache) {
  mDrawbotCache = inCache;
  const ThemeSupplier& supplier = UI_GetThemeSupplier();
  if (!supplier || supplier->empty()) return;
  mCacheTheme = (*supplier)();
  if (!mCacheTheme) return;
  mCacheThemeChangeCount = mCacheTheme->GetThemeChangeCount();
  // A stored cache re-arms invalidation everywhere. Dropping one does not:
  // invalidation drops caches on its way up, and must not re-arm itself.
  if (!inCache) return;
  if (UI_NodeManager* manager = UI_NodeManager::Get()) manager->IncrementDrawbotCacheSeed();
}

bool UI_Node::UI_IsDrawbotCacheValid(const drawbot::SurfaceInterface& inSurface) const {
  if (!mCacheTheme || !mDrawbotCache) return false;
  ThemeP current = UI_GetCurrentTheme();
  if (current != mCacheTheme || current->GetThemeChangeCount() != mCacheThemeChangeCount) return false;
  return mDrawbotCache->IsValid(inSurface, UI_GetLocalRectF(false));
}

}  // namespace norvik::ui
