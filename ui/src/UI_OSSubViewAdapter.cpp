#include "ui/UI_OSSubViewAdapter.h"

#include "tarsel/ThrowError.h"

namespace norvik::ui {

namespace {

template <typename T>
T* ChildAs(const UI_Node* inNode) {
  if (!inNode || inNode->ChildSize() == 0) return nullptr;
  UI_Node* child = inNode->ChildGet(0);
  T* typed = dynamic_cast<T*>(child);
  if (child && !typed)
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                               "$$$/tarsel/utility/Error/InvalidTypeConversion=Invalid type conversion.");
  return typed;
}

}  // namespace

UI_OSSubViewAdapter::UI_OSSubViewAdapter() { UI_SetNodeID("UI_OSSubViewAdapter"); }

void UI_OSSubViewAdapter::SetOSView(const OS_WindowP& inControl) {
  UI_NodeProtector protect(this);
  DeleteChildren();
  UI_SubViewP transform(new UI_SubView);
  transform->UI_SetLocalRectF(RectF(0, 0, mRect.width, mRect.height));
  transform->UI_Show(true);
  ChildPushBack(transform);
  OS_ViewContainerP container(new OS_ViewContainer(false));
  transform->ChildPushBack(container);
  if (inControl) container->ChildPushBack(inControl);
  if (inControl) inControl->UI_Show(true);
  SubViewParentChanged();
  SubViewParentTransformChanged();
}

UI_SubView* UI_OSSubViewAdapter::GetTransformContainer() const { return ChildAs<UI_SubView>(this); }

OS_ViewContainer* UI_OSSubViewAdapter::GetOSViewContainer() const {
  return ChildAs<OS_ViewContainer>(GetTransformContainer());
}

OS_Window* UI_OSSubViewAdapter::GetOSView() const { return ChildAs<OS_Window>(GetOSViewContainer()); }

bool UI_OSSubViewAdapter::HasOSChildView() const { return GetOSView() != nullptr; }

bool UI_OSSubViewAdapter::IsOSChildViewValid() const {
  OS_Window* control = GetOSView();
  return control && control->GetHandle() != 0 && GetOSViewContainer()->GetHandle() != 0;
}

void UI_OSSubViewAdapter::UI_NodeChanged(NodeChange inChange) {
  switch (inChange) {
    case kNodeChangeParent:
      SubViewParentChanged();
      SubViewParentTransformChanged();
      break;
    case kNodeChangeGeometry:
    case kNodeChangeVisibility:
    case kNodeChangeWindowMoved:
      SubViewParentTransformChanged();
      break;
  }
}

void UI_OSSubViewAdapter::SubViewParentChanged() {
  if (!IsOSChildViewValid()) return;
  UI_NodeProtector protect(this);
  OS_ViewContainer* container = GetOSViewContainer();
  container->UI_Show(false);
  container->UI_SynchronizeParent();
  SubViewParentVisibilityChanged();
}

void UI_OSSubViewAdapter::SubViewParentVisibilityChanged() {
  if (!IsOSChildViewValid()) return;
  OS_ViewContainer* container = GetOSViewContainer();
  if (UI_IsShown()) {
    for (UI_Node* parent = UI_GetParentNode(); parent; parent = parent->UI_GetParentNode()) {
      if (parent->UI_ReceivesEventsFromOS()) {
        container->UI_Show(true);
        return;
      }
      if (!parent->UI_IsShown()) break;
    }
  }
  // Some view between the control and its window is hidden (or there is no
  // window): the control must not show through.
  container->UI_Show(false);
}

void UI_OSSubViewAdapter::SubViewParentTransformChanged() {
  if (!IsOSChildViewValid()) return;
  UI_NodeProtector protect(this);
  ClipOSControlUsingContainer();
  SubViewParentVisibilityChanged();
}

UI_Node::RectF UI_OSSubViewAdapter::UI_GetGlobalVisibleRect(const UI_Node* inNode) {
  RectF visible = inNode->UI_LocalToGlobalF(inNode->UI_GetLocalRectF(false));
  for (const UI_Node* parent = inNode->UI_GetParentNode(); parent; parent = parent->UI_GetParentNode()) {
    visible = visible.Intersection(parent->UI_LocalToGlobalF(parent->UI_GetLocalRectF(false)));
    if (parent->UI_ReceivesEventsFromOS()) break;
  }
  return visible;
}

void UI_OSSubViewAdapter::ClipOSControlUsingContainer() {
  OS_ViewContainer* container = GetOSViewContainer();
  OS_Window* control = GetOSView();
  UI_Node* window = UI_GetParentEventRecipientNode();
  if (!container || !control || !window) return;
  // The whole adapter and the part of it that shows, on the screen.
  const RectF full = UI_LocalToGlobalF(RectF(0, 0, mRect.width, mRect.height));
  const RectF visible = UI_GetGlobalVisibleRect(this);
  // The container takes the visible part, in its native parent's coordinates.
  const PointF visibleOrigin = window->UI_GlobalToLocalF(visible.Origin());
  container->UI_SetLocalRectF(RectF(visibleOrigin, visible.width, visible.height));
  // The control keeps its place on the screen by moving inside the container.
  const PointF offset = full.Origin() - visible.Origin();
  control->UI_SetLocalRect(UI_EnclosingRect(RectF(offset, full.width, full.height)));
  if (UI_SubView* transform = GetTransformContainer()) {
    const PointF inAdapter = UI_GlobalToLocalF(visible.Origin());
    transform->UI_SetLocalRectF(RectF(inAdapter, std::max(visible.width, 0.0f), std::max(visible.height, 0.0f)));
  }
}

}  // namespace norvik::ui
