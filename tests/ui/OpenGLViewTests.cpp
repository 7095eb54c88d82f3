// The OpenGL view on a platform without GL (the headless system): no context
// is ever made, the paint still runs its three steps in order, the context's
// life follows the parent, and the view keeps the tree contract of a view
// container: a native child of its parent's window that shows, hides and
// moves with the tree.
#include <stdexcept>
#include <string>
#include <vector>

#include <gmock/gmock.h>

#include "support/ui/NativeWindowTestSupport.h"
#include "ui/OS_OpenGLView.h"

namespace norvik::ui::test {
namespace {

using ::testing::ElementsAre;

// Logs each step and then runs the view's own.
class LoggingGLView : public OS_OpenGLView {
 public:
  void InitOpenGL() override {
    log.push_back("init");
    OS_OpenGLView::InitOpenGL();
  }
  void EndOpenGL() override {
    log.push_back("end");
    OS_OpenGLView::EndOpenGL();
  }
  void PreDrawOpenGL() override {
    log.push_back("pre");
    OS_OpenGLView::PreDrawOpenGL();
  }
  void DrawOpenGL() override {
    log.push_back(HasOpenGLContext() ? "draw with context" : "draw");
    if (failDraw) throw std::runtime_error("the subclass failed");
  }
  void PostDrawOpenGL() override {
    log.push_back("post");
    OS_OpenGLView::PostDrawOpenGL();
  }
  std::vector<std::string> log;
  bool failDraw = false;
};

using LoggingGLViewP = boost::intrusive_ptr<LoggingGLView>;

class OpenGLViewTest : public NativeWindowTest {
 protected:
  LoggingGLViewP MakeView(const UI_Node::RectL& inRect) {
    LoggingGLViewP view(new LoggingGLView);
    view->UI_SetLocalRect(inRect);
    return view;
  }
};

TEST_F(OpenGLViewTest, APaintRunsPreDrawAndPostInOrderWithoutAContext) {
  auto top = MakeTopLevel(OS_Rect(0, 0, 120, 100));
  LoggingGLViewP view = MakeView(UI_Node::RectL(10, 10, 60, 50));
  top->ChildPushBack(view);
  view->UI_Show(true);
  mSystem.Pump();
  view->log.clear();
  view->UI_Invalidate(nullptr, 0);
  mSystem.Pump();
  EXPECT_THAT(view->log, ElementsAre("pre", "draw", "post"));
  const OS_GLCurrent current = mLayer.GetCurrentGLContext();
  EXPECT_EQ(current.context, 0u);
  EXPECT_EQ(current.surface, 0u);
}

TEST_F(OpenGLViewTest, TheContextIsEndedBeforeEachMoveAndMadeAgainOnlyUnderAParent) {
  auto first = MakeTopLevel(OS_Rect(0, 0, 100, 100));
  auto second = MakeTopLevel(OS_Rect(200, 0, 100, 100));
  LoggingGLViewP view = MakeView(UI_Node::RectL(5, 5, 50, 50));
  first->ChildPushBack(view);
  EXPECT_THAT(view->log, ElementsAre("end", "init"));
  view->log.clear();
  first->ChildRemove(view.get());
  EXPECT_THAT(view->log, ElementsAre("end")) << "no parent, no context";
  view->log.clear();
  second->ChildPushBack(view);
  EXPECT_THAT(view->log, ElementsAre("end", "init"));
  EXPECT_FALSE(view->HasOpenGLContext()) << "this platform has no GL";
}

TEST_F(OpenGLViewTest, WithoutGLTheViewStillClipsShowsHidesAndMovesAsANativeChild) {
  auto first = MakeTopLevel(OS_Rect(0, 0, 200, 150));
  auto second = MakeTopLevel(OS_Rect(300, 0, 200, 150));
  LoggingGLViewP view = MakeView(UI_Node::RectL(20, 30, 60, 40));
  first->ChildPushBack(view);
  view->UI_Show(true);
  mSystem.Pump();
  const OS_WindowHandle handle = view->GetHandle();
  EXPECT_EQ(mLayer.GetParent(handle), first->GetHandle());
  EXPECT_NE(mLayer.GetStyle(handle) & kOSStyleChild, 0u) << "a child window, clipped by its parent";
  EXPECT_EQ(mLayer.GetWindowRect(handle), OS_Rect(20, 30, 60, 40));
  EXPECT_TRUE(mLayer.IsWindowVisible(handle));
  view->UI_Show(false);
  EXPECT_FALSE(mLayer.IsWindowVisible(handle));
  view->UI_Show(true);
  EXPECT_TRUE(mLayer.IsWindowVisible(handle));

  first->ChildRemove(view.get());
  second->ChildPushBack(view);
  EXPECT_EQ(view->GetHandle(), handle) << "the same native window, moved";
  EXPECT_EQ(mLayer.GetParent(handle), second->GetHandle());
  EXPECT_EQ(mLayer.GetWindowRect(handle), OS_Rect(320, 30, 60, 40));
}

TEST_F(OpenGLViewTest, AFailingDrawStillRunsPostDrawBeforeTheErrorLeaves) {
  auto top = MakeTopLevel(OS_Rect(0, 0, 100, 100));
  LoggingGLViewP view = MakeView(UI_Node::RectL(0, 0, 50, 50));
  top->ChildPushBack(view);
  view->log.clear();
  view->failDraw = true;
  EXPECT_THROW(view->UI_Draw(nullptr), std::runtime_error);
  EXPECT_THAT(view->log, ElementsAre("pre", "draw", "post"));
}

TEST_F(OpenGLViewTest, ThePlatformWithoutGLRefusesEveryRequestCleanly) {
  auto top = MakeTopLevel(OS_Rect(0, 0, 100, 100));
  EXPECT_EQ(mLayer.CreateGLSurface(top->GetHandle(), OS_OpenGLView::GetPixelFormat()), 0u);
  EXPECT_EQ(mLayer.CreateGLContext(0x1234), 0u);
  EXPECT_FALSE(mLayer.MakeGLContextCurrent(OS_GLCurrent{nullptr, 0x1234, 0x5678}));
  EXPECT_TRUE(mLayer.MakeGLContextCurrent(OS_GLCurrent{})) << "nothing current is a state it can be put in";
  EXPECT_FALSE(mLayer.SwapGLBuffers(0x1234));
  EXPECT_NO_THROW(mLayer.ClearGLContext(0, 0, 0, 0));
  EXPECT_NO_THROW(mLayer.DestroyGLContext(0x5678));
  EXPECT_NO_THROW(mLayer.DestroyGLSurface(0x1234));
}

}  // namespace
}  // namespace norvik::ui::test
