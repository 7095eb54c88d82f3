// OpenGL views against a real X server: GLX through Mesa on Xvfb. A view in a
// real window clears, draws a rectangle, and the server shows it; the
// context is rebuilt when the view moves to another window, and a paint puts
// back whatever context was current before.
#include <cairo.h>
#include <xcb/xcb.h>

#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string>
#include <vector>

#include "support/ui/NativeWindowTestSupport.h"
#include "ui/MouseEvent.h"
#include "ui/OS_NodeManager.h"
#include "ui/OS_OpenGLView.h"
#include "ui/OS_ViewContainer.h"
#include "x11/GLTestDrawing.h"
#include "x11/X11Fixture.h"

namespace norvik::test {
namespace {

using namespace norvik::ui;

constexpr std::uint32_t kOrange = 0xFF8000;
constexpr std::uint32_t kBlue = 0x0000FF;

// Clears (through the view) and fills one rectangle in orange.
class RectangleGLView : public OS_OpenGLView {
 public:
  void DrawOpenGL() override {
    ++draws;
    if (!HasOpenGLContext()) return;
    renderer = CurrentGLRenderer();
    FillGLRectangle(10, 20, 40, 30, static_cast<int>(UI_GetLocalRect().height), 1.0f, 0.5f, 0.0f);
  }
  bool UI_DoMouseEvent(UI_Node*, const MouseEvent& inEvent) override {
    if (inEvent.GetAction() == MouseEvent::kActionButtonDown) presses.push_back(inEvent.GetPosition());
    return true;
  }
  int draws = 0;
  std::string renderer;
  std::vector<tarsel::geom::PointT<float>> presses;
};

using RectangleGLViewP = boost::intrusive_ptr<RectangleGLView>;

bool ServerHasGLX(xcb_connection_t* inConnection) {
  const char name[] = "GLX";
  xcb_query_extension_reply_t* reply = xcb_query_extension_reply(
      inConnection, xcb_query_extension(inConnection, static_cast<uint16_t>(std::strlen(name)), name), nullptr);
  const bool present = reply && reply->present;
  std::free(reply);
  return present;
}

class X11OpenGLView : public X11Fixture {
 protected:
  void SetUp() override {
    X11Fixture::SetUp();
    if (IsSkipped() || HasFatalFailure()) return;
    ASSERT_TRUE(ServerHasGLX(mUser)) << "the X server offers no GLX extension: OpenGL views cannot be tested "
                                        "(Xvfb needs Mesa's GLX, packages libgl1-mesa-dri and libglx-mesa0)";
    InstallNativeLayer(mLayer.get());
  }

  void TearDown() override {
    mWindows.clear();
    InstallNativeLayer(nullptr);
    X11Fixture::TearDown();
  }

  // A shown top-level container with a blue view under the whole of it.
  OS_TopLevelViewContainerP MakeWindow(const OS_Rect& inScreenRect) {
    OS_TopLevelViewContainerP window(new OS_TopLevelViewContainer(false));
    window->UI_SetLocalRect(inScreenRect);
    ui::test::InputRecorderViewP back(new ui::test::InputRecorderView("back"));
    back->UI_SetLocalRectF(UI_Node::RectF(0, 0, static_cast<float>(inScreenRect.width),
                                          static_cast<float>(inScreenRect.height)));
    back->paints = true;
    back->blue = 1.0f;
    back->UI_Show(true);
    window->ChildPushBack(back);
    window->UI_Show(true);
    mWindows.push_back(window);
    return window;
  }

  RectangleGLViewP AddGLView(UI_Node* inParent, const UI_Node::RectL& inRect) {
    RectangleGLViewP view(new RectangleGLView);
    view->UI_SetLocalRect(inRect);
    inParent->ChildPushBack(view);
    view->UI_Show(true);
    return view;
  }

  // The window read back from the server, 0xRRGGBB a pixel; written as a
  // PNG under the test output when inSaveAs is given.
  std::vector<std::uint32_t> ReadWindow(OS_WindowHandle inWindow, int inWidth, int inHeight) {
    std::vector<std::uint32_t> pixels;
    xcb_get_image_reply_t* image = xcb_get_image_reply(
        mUser,
        xcb_get_image(mUser, XCB_IMAGE_FORMAT_Z_PIXMAP, static_cast<xcb_drawable_t>(inWindow), 0, 0,
                      static_cast<uint16_t>(inWidth), static_cast<uint16_t>(inHeight), ~0u),
        nullptr);
    if (!image) return pixels;
    const std::uint32_t* data = reinterpret_cast<const std::uint32_t*>(xcb_get_image_data(image));
    pixels.assign(data, data + inWidth * inHeight);
    for (std::uint32_t& p : pixels) p &= 0xFFFFFF;
    std::free(image);
    return pixels;
  }

  void SaveWindow(OS_WindowHandle inWindow, int inWidth, int inHeight, const std::string& inName) {
    std::vector<std::uint32_t> pixels = ReadWindow(inWindow, inWidth, inHeight);
    if (pixels.empty()) return;
    for (std::uint32_t& p : pixels) p |= 0xFF000000u;
    std::filesystem::create_directories(NORVIK_TEST_OUTPUT_DIR);
    cairo_surface_t* surface = cairo_image_surface_create_for_data(
        reinterpret_cast<unsigned char*>(pixels.data()), CAIRO_FORMAT_ARGB32, inWidth, inHeight, inWidth * 4);
    const std::string path = std::string(NORVIK_TEST_OUTPUT_DIR) + "/" + inName + ".actual.png";
    cairo_surface_write_to_png(surface, path.c_str());
    cairo_surface_destroy(surface);
    ADD_FAILURE() << "the window as read back is in " << path;
  }

  // Waits until the pixel reads inExpected; answers what it read last.
  std::uint32_t PixelSoon(OS_WindowHandle inWindow, int inX, int inY, std::uint32_t inExpected) {
    std::uint32_t pixel = 0;
    WaitFor([&] { return (pixel = ReadPixel(inWindow, inX, inY)) == inExpected; }, 2000);
    return pixel;
  }

  // The view at (inLeft, inTop) of its window shows black, with the orange
  // rectangle at (10, 20, 40, 30) of the view; the window around it is blue.
  void ExpectDrawnAt(const OS_TopLevelViewContainerP& inWindow, int inLeft, int inTop, const char* inName) {
    const OS_WindowHandle handle = inWindow->GetHandle();
    const UI_Node::RectL size = inWindow->UI_GetLocalRect();
    const bool ok = PixelSoon(handle, inLeft + 10, inTop + 20, kOrange) == kOrange &&
                    PixelSoon(handle, inLeft + 49, inTop + 49, kOrange) == kOrange &&
                    PixelSoon(handle, inLeft + 9, inTop + 20, 0) == 0 && PixelSoon(handle, inLeft + 50, inTop + 49, 0) == 0 &&
                    PixelSoon(handle, inLeft + 30, inTop + 5, 0) == 0 && PixelSoon(handle, inLeft - 1, inTop, kBlue) == kBlue;
    EXPECT_TRUE(ok) << "orange rectangle at (" << inLeft + 10 << ", " << inTop + 20 << ") on black, in blue";
    if (!ok) SaveWindow(handle, static_cast<int>(size.width), static_cast<int>(size.height), inName);
  }

  OS_NodeManager mManager;
  std::vector<OS_TopLevelViewContainerP> mWindows;
};

TEST_F(X11OpenGLView, AClickOnTheGLSurfaceReachesTheViewAtItsPlace) {
  auto window = MakeWindow(OS_Rect(40, 40, 200, 150));
  RectangleGLViewP view = AddGLView(window.get(), UI_Node::RectL(30, 20, 100, 80));
  ASSERT_TRUE(WaitFor([&] { return view->draws > 0; }));
  const OS_Point inside = mLayer->ClientToScreen(window->GetHandle(), OS_Point(30 + 25, 20 + 35));
  MovePointer(static_cast<int>(inside.x), static_cast<int>(inside.y));
  Settle(50);
  Button(1, true);
  Button(1, false);
  ASSERT_TRUE(WaitFor([&] { return !view->presses.empty(); })) << "the surface kept the click from the view";
  EXPECT_FLOAT_EQ(view->presses.front().x, 25.0f);
  EXPECT_FLOAT_EQ(view->presses.front().y, 35.0f);
}

TEST_F(X11OpenGLView, MovingTheViewToAnotherWindowRebuildsTheContextAndKeepsDrawing) {
  auto first = MakeWindow(OS_Rect(20, 20, 200, 150));
  auto second = MakeWindow(OS_Rect(300, 200, 220, 160));
  RectangleGLViewP view = AddGLView(first.get(), UI_Node::RectL(30, 20, 100, 80));
  ASSERT_TRUE(view->HasOpenGLContext());
  const OS_GLSurfaceHandle firstSurface = view->GetDeviceContext();
  ASSERT_TRUE(WaitFor([&] { return view->draws > 0; }));
  ExpectDrawnAt(first, 30, 20, "gl-view-before-move");

  first->ChildRemove(view.get());
  EXPECT_FALSE(view->HasOpenGLContext()) << "a view without a parent keeps no context";
  view->UI_SetLocalRect(UI_Node::RectL(60, 40, 100, 80));
  second->ChildPushBack(view);
  ASSERT_TRUE(view->HasOpenGLContext());
  EXPECT_NE(view->GetDeviceContext(), firstSurface) << "the surface is made anew in the new window";
  EXPECT_EQ(mLayer->GetParent(view->GetHandle()), second->GetHandle());
  const int drawsBefore = view->draws;
  view->UI_Invalidate(nullptr, 0);
  ASSERT_TRUE(WaitFor([&] { return view->draws > drawsBefore; }));
  ExpectDrawnAt(second, 60, 40, "gl-view-after-move");
}

TEST_F(X11OpenGLView, APaintPutsBackTheContextThatWasCurrentBefore) {
  auto window = MakeWindow(OS_Rect(40, 40, 300, 150));
  RectangleGLViewP painted = AddGLView(window.get(), UI_Node::RectL(10, 10, 100, 80));
  RectangleGLViewP other = AddGLView(window.get(), UI_Node::RectL(150, 10, 100, 80));
  ASSERT_TRUE(painted->HasOpenGLContext() && other->HasOpenGLContext());
  ASSERT_TRUE(WaitFor([&] { return painted->draws > 0 && other->draws > 0; }));

  const OS_GLCurrent hosts{nullptr, other->GetDeviceContext(), other->GetRenderingContext()};
  ASSERT_TRUE(mLayer->MakeGLContextCurrent(hosts));
  painted->UI_Draw(nullptr);
  OS_GLCurrent after = mLayer->GetCurrentGLContext();
  EXPECT_EQ(after.surface, other->GetDeviceContext());
  EXPECT_EQ(after.context, other->GetRenderingContext());

  ASSERT_TRUE(mLayer->MakeGLContextCurrent(OS_GLCurrent{}));
  painted->UI_Draw(nullptr);
  after = mLayer->GetCurrentGLContext();
  EXPECT_EQ(after.context, 0u);
  EXPECT_EQ(after.surface, 0u);
}

TEST_F(X11OpenGLView, UnknownHandlesAreRefusedWithoutHarm) {
  auto window = MakeWindow(OS_Rect(40, 40, 120, 100));
  EXPECT_EQ(mLayer->CreateGLSurface(0x7fffff, OS_GLPixelFormat{}), 0u) << "not a window of ours";
  EXPECT_EQ(mLayer->CreateGLContext(0x7fffff), 0u);
  EXPECT_FALSE(mLayer->MakeGLContextCurrent(OS_GLCurrent{nullptr, 0x7fffff, 0x1234}));
  EXPECT_FALSE(mLayer->SwapGLBuffers(0x7fffff));
  mLayer->DestroyGLContext(0x1234);
  mLayer->DestroyGLSurface(window->GetHandle());  // a window, not a surface: left alone
  EXPECT_TRUE(mLayer->IsWindow(window->GetHandle()));
}

}  // namespace
}  // namespace norvik::test
