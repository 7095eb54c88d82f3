#pragma once
// The walks that visit many nodes (hit tests over wide containers, coordinate
// mapping up deep chains, the clip rejection of the draw traversal) read a
// view's geometry straight from its fields when its class keeps UI_SubView's
// own matrix, show test, rectangle and hit test. A level that is only moved
// then costs an add, where the general path costs a matrix product and a few
// virtual calls per node.
//
// Whether a class keeps them is read from its virtual table, never assumed: a
// class that overrides any of them takes the general path and is called as
// before. Where the compiler offers no way to read a virtual table entry
// (GCC's bound member function extraction), every node takes the general path.
#include <cstdint>
#include <cstring>

#include "ui/UI_SubView.h"

namespace norvik::ui::plainview {

using Matrix = UI_Node::Matrix;
using PointF = UI_Node::PointF;
using RectF = UI_Node::RectF;

// Reads the protected fields of any UI_SubView through member pointers named
// by this derived class; it is never instantiated.
class Fields : public UI_SubView {
 public:
  static const RectF& Rect(const UI_SubView& inView) { return inView.*(&Fields::mRect); }
  static const Matrix& OwnMatrix(const UI_SubView& inView) { return inView.*(&Fields::mMatrix); }
  static bool MatrixOnlyForChildren(const UI_SubView& inView) { return inView.*(&Fields::mMatrixOnlyForChildren); }
  static std::uint8_t ViewFlags(const UI_SubView& inView) { return inView.*(&Fields::mViewFlags); }
};

#if defined(__GNUC__) && !defined(__clang__)
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wpmf-conversions"
using AnyFunction = void (*)();

// The view's own self-to-parent matrix: the node is a UI_SubView.
inline bool KeepsViewMatrix(const UI_Node& inNode) {
  return reinterpret_cast<AnyFunction>(inNode.*(&UI_Node::UI_GetSelfToParentMatrix)) ==
         reinterpret_cast<AnyFunction>(&UI_SubView::UI_GetSelfToParentMatrix);
}

// The view's own rectangle besides its matrix.
inline bool KeepsViewGeometry(const UI_Node& inNode) {
  return KeepsViewMatrix(inNode) &&
         reinterpret_cast<AnyFunction>(inNode.*(&UI_Node::UI_GetLocalRectF)) ==
             reinterpret_cast<AnyFunction>(&UI_SubView::UI_GetLocalRectF);
}

// Besides those, the view's own show test and the node's own hit test.
inline bool KeepsViewHitTest(const UI_Node& inNode) {
  return KeepsViewGeometry(inNode) &&
         reinterpret_cast<AnyFunction>(inNode.*(&UI_Node::UI_IsShown)) ==
             reinterpret_cast<AnyFunction>(&UI_SubView::UI_IsShown) &&
         reinterpret_cast<AnyFunction>(inNode.*(&UI_Node::UI_HitTest)) ==
             reinterpret_cast<AnyFunction>(&UI_Node::UI_HitTest);
}

// The view's own answer that it is no native window.
inline bool KeepsViewNotNative(const UI_Node& inNode) {
  return reinterpret_cast<AnyFunction>(inNode.*(&UI_Node::UI_ReceivesEventsFromOS)) ==
         reinterpret_cast<AnyFunction>(&UI_SubView::UI_ReceivesEventsFromOS);
}

// The node's own walk of the native-control clip rectangles.
inline bool KeepsNodeClipRects(const UI_Node& inNode) {
  return reinterpret_cast<AnyFunction>(inNode.*(&UI_Node::UI_GetOSControlClipRects)) ==
         reinterpret_cast<AnyFunction>(&UI_Node::UI_GetOSControlClipRects);
}
#pragma GCC diagnostic pop
#else
inline bool KeepsViewMatrix(const UI_Node&) { return false; }
inline bool KeepsViewGeometry(const UI_Node&) { return false; }
inline bool KeepsViewHitTest(const UI_Node&) { return false; }
inline bool KeepsViewNotNative(const UI_Node&) { return false; }
inline bool KeepsNodeClipRects(const UI_Node&) { return false; }
#endif

// UI_Node::UI_GetParentNode for walks up deep chains: a container that is
// part of a node is that node, so the next level is known from one load, and
// the test of the container's node pointer runs beside it.
inline const UI_Node* ParentNodeOf(const UI_Node& inNode) {
  const UI_Container* up = inNode.UI_GetParentContainer();
  return up && up->GetAsANode() ? static_cast<const UI_Node*>(up) : nullptr;
}

// The parent when it composes its matrix into its children's steps (a view
// whose matrix is only for its children), as UI_SubView::UI_GetSelfToParentMatrix
// decides it; null otherwise.
inline const UI_Node* ScrollingParent(const UI_Node* parent) {
  if (!parent) return nullptr;
  // A parent that keeps the view's matrix is a view, and its flag is enough
  // to say no; a set flag, or another class, asks whether it is a view.
  if (KeepsViewMatrix(*parent) && !Fields::MatrixOnlyForChildren(static_cast<const UI_SubView&>(*parent)))
    return nullptr;
  if (!parent->UI_IsSubView() || !Fields::MatrixOnlyForChildren(static_cast<const UI_SubView&>(*parent)))
    return nullptr;
  return parent;
}

inline const UI_Node* ScrollingParentOf(const UI_Node& inNode) { return ScrollingParent(inNode.UI_GetParentNode()); }

// True when the view's own matrix moves nothing of it: it applies to the
// children only, or it is the identity. The test is on the bits, so that it
// costs two integer compares; a negative zero only sends the view down the
// general path.
inline bool ViewIsOnlyMoved(const UI_Node& inNode) {
  static constexpr Matrix kIdentity;
  const auto& view = static_cast<const UI_SubView&>(inNode);
  return Fields::MatrixOnlyForChildren(view) || std::memcmp(&Fields::OwnMatrix(view), &kIdentity, sizeof(Matrix)) == 0;
}

// UI_SubView::UI_GetSelfToParentMatrix, read from the fields of a node that
// keeps the view's matrix; inScrollingParent is ScrollingParentOf(inNode),
// which a walk over one container's children asks once.
inline Matrix ViewStep(const UI_Node& inNode, const UI_Node* inScrollingParent) {
  const auto& view = static_cast<const UI_SubView&>(inNode);
  const RectF& rect = Fields::Rect(view);
  Matrix m = Matrix::Translation(rect.left, rect.top);
  if (!Fields::MatrixOnlyForChildren(view)) {
    const Matrix& own = Fields::OwnMatrix(view);
    if (!own.IsIdentity()) m = own.Concat(m);
  }
  if (inScrollingParent) m = Fields::OwnMatrix(static_cast<const UI_SubView&>(*inScrollingParent)).Concat(m);
  return m;
}

// The node's self-to-parent matrix, through the fields when it can be.
inline Matrix SelfToParent(const UI_Node& inNode) {
  return KeepsViewMatrix(inNode) ? ViewStep(inNode, ScrollingParentOf(inNode)) : inNode.UI_GetSelfToParentMatrix();
}

// UI_SubView::UI_IsShown of a node that keeps the view's show test.
inline bool ViewIsShown(const UI_Node& inNode) {
  const auto& view = static_cast<const UI_SubView&>(inNode);
  const RectF& rect = Fields::Rect(view);
  return (Fields::ViewFlags(view) & UI_SubView::kViewShown) && rect.width > 0 && rect.height > 0;
}

// UI_Node::UI_HitTest of a node that keeps the view's rectangle.
inline bool ViewHitTest(const UI_Node& inNode, const PointF& inPoint) {
  const RectF& rect = Fields::Rect(static_cast<const UI_SubView&>(inNode));
  const RectF local(0, 0, rect.width, rect.height);
  return local.width > 0 && local.height > 0 && local.Contains(inPoint);
}

// How many children ahead a walk over a wide container fetches.
constexpr std::ptrdiff_t kPrefetchAhead = 8;

// Asks the memory for the lines that the tests above read of inNode: its
// virtual table pointer and, if it is a view, the fields that follow the
// node's own (a prefetch of an address past a smaller object is harmless).
inline void Prefetch(const UI_Node& inNode) {
  const auto at = reinterpret_cast<std::uintptr_t>(&inNode);
  __builtin_prefetch(reinterpret_cast<const void*>(at));
  __builtin_prefetch(reinterpret_cast<const void*>(at + sizeof(UI_Node)));
}

// UI_SubView::UI_GetLocalRectF(false) of a node that keeps the view's rectangle.
inline RectF ViewLocalRect(const UI_Node& inNode) {
  const RectF& rect = Fields::Rect(static_cast<const UI_SubView&>(inNode));
  return RectF(0, 0, rect.width, rect.height);
}

}  // namespace norvik::ui::plainview
