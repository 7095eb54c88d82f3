#include "support/ui/NativeWindowTestSupport.h"

#include "drawbot/Drawbot.h"
#include "drawbot/SurfaceInterface.h"

namespace norvik::ui::test {

void InputRecorderView::UI_Draw(drawbot::Drawbot* inDrawbot) {
  if (paints && inDrawbot && inDrawbot->GetSurface())
    inDrawbot->GetSurface()->PaintRect(drawbot::ColorRGBA{red, green, blue, 1.0f}, UI_GetLocalRectF(false));
  UI_SubView::UI_Draw(inDrawbot);
}

NativeWindowTest::NativeWindowTest() : mLayer(mSystem.GetLayer()) { mSystem.Install(); }

NativeWindowTest::~NativeWindowTest() = default;

OS_TopLevelViewContainerP NativeWindowTest::MakeTopLevel(const OS_Rect& inScreenRect) {
  OS_TopLevelViewContainerP container(new OS_TopLevelViewContainer(false));
  // An application's main window: it takes activation, unlike a new container.
  mLayer.SetExStyle(container->GetHandle(), mLayer.GetExStyle(container->GetHandle()) & ~kOSExStyleNoActivate);
  container->UI_SetLocalRect(inScreenRect);
  container->UI_Show(true);
  mSystem.Pump();
  return container;
}

InputRecorderViewP NativeWindowTest::AddView(UI_Node* inParent, const char* inName, float inX, float inY, float inW,
                                             float inH) {
  InputRecorderViewP view(new InputRecorderView(inName));
  view->UI_SetLocalRectF(tarsel::geom::RectT<float>(inX, inY, inW, inH));
  view->UI_Show(true);
  if (inParent) inParent->ChildPushBack(view);
  return view;
}

}  // namespace norvik::ui::test
