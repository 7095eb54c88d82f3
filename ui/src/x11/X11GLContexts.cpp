#include "ui/src/x11/X11GLContexts.h"

#include <GL/gl.h>
#include <GL/glx.h>

#include <algorithm>
#include <map>
#include <set>
#include <string>
#include <utility>
#include <vector>

namespace norvik::ui::x11 {
namespace {

// X errors on the GL connection (a surface whose parent went away, a
// refused format) are counted, not fatal; errors of other displays go to
// whoever handled them before.
std::set<Display*> gTrappedDisplays;
XErrorHandler gPreviousHandler = nullptr;
int gErrorCount = 0;

int TrapError(Display* inDisplay, XErrorEvent* inError) {
  if (gTrappedDisplays.count(inDisplay)) {
    ++gErrorCount;
    return 0;
  }
  return gPreviousHandler ? gPreviousHandler(inDisplay, inError) : 0;
}

// The GL connection of each display name, opened once and kept for the life
// of the process: a GL driver is loaded per connection, and drivers do not
// all release what they made when they are unloaded again.
Display* SharedDisplay(const std::string& inName) {
  static std::map<std::string, Display*> sDisplays;
  auto found = sDisplays.find(inName);
  if (found != sDisplays.end()) return found->second;
  Display* display = XOpenDisplay(inName.empty() ? nullptr : inName.c_str());
  if (display) sDisplays[inName] = display;
  return display;
}

Display* AsDisplay(void* inDisplay) { return static_cast<Display*>(inDisplay); }
GLXFBConfig AsConfig(void* inConfig) { return static_cast<GLXFBConfig>(inConfig); }
GLXContext AsContext(OS_GLContextHandle inContext) { return reinterpret_cast<GLXContext>(inContext); }

std::vector<int> ConfigAttributes(const OS_GLPixelFormat& inFormat) {
  const int channel = std::max(1, inFormat.colorBits / 3);
  return {GLX_X_RENDERABLE, True,
          GLX_DRAWABLE_TYPE, GLX_WINDOW_BIT,
          GLX_RENDER_TYPE, GLX_RGBA_BIT,
          GLX_X_VISUAL_TYPE, GLX_TRUE_COLOR,
          GLX_RED_SIZE, channel,
          GLX_GREEN_SIZE, channel,
          GLX_BLUE_SIZE, channel,
          GLX_DEPTH_SIZE, std::max(0, inFormat.depthBits),
          GLX_DOUBLEBUFFER, inFormat.doubleBuffered ? True : False,
          None};
}

}  // namespace

X11GLContexts::X11GLContexts(std::string inDisplayName) : mDisplayName(std::move(inDisplayName)) {}

X11GLContexts::~X11GLContexts() {
  Display* display = AsDisplay(mDisplay);
  if (!display) return;
  if (glXGetCurrentDisplay() == display) glXMakeCurrent(display, None, nullptr);
  for (auto& [context, config] : mContexts) glXDestroyContext(display, AsContext(context));
  for (auto& [surface, info] : mSurfaces) {
    XDestroyWindow(display, static_cast<Window>(surface));
    XFreeColormap(display, info.colormap);
  }
  // The connection stays open for the next layer on this display.
  XSync(display, False);
}

bool X11GLContexts::IsAvailable() {
  if (mTried) return mAvailable;
  mTried = true;
  Display* display = SharedDisplay(mDisplayName);
  if (!display) return false;
  int errorBase = 0, eventBase = 0, major = 0, minor = 0;
  if (!glXQueryExtension(display, &errorBase, &eventBase) || !glXQueryVersion(display, &major, &minor) ||
      major < 1 || (major == 1 && minor < 3))
    return false;
  mDisplay = display;
  if (gTrappedDisplays.empty()) gPreviousHandler = XSetErrorHandler(&TrapError);
  gTrappedDisplays.insert(display);
  mAvailable = true;
  return true;
}

void* X11GLContexts::ChooseConfig(std::uint32_t inParent, const OS_GLPixelFormat& inFormat) {
  Display* display = AsDisplay(mDisplay);
  XWindowAttributes parent;
  if (!XGetWindowAttributes(display, inParent, &parent)) return nullptr;
  const std::vector<int> attributes = ConfigAttributes(inFormat);
  int count = 0;
  GLXFBConfig* configs = glXChooseFBConfig(display, XScreenNumberOfScreen(parent.screen), attributes.data(), &count);
  if (!configs) return nullptr;
  // The best match of the parent's depth, so that the window reads back like
  // its parent; else the best of all.
  GLXFBConfig chosen = count > 0 ? configs[0] : nullptr;
  for (int i = 0; i < count; ++i) {
    XVisualInfo* visual = glXGetVisualFromFBConfig(display, configs[i]);
    const bool sameDepth = visual && visual->depth == parent.depth;
    if (visual) XFree(visual);
    if (sameDepth) {
      chosen = configs[i];
      break;
    }
  }
  XFree(configs);
  return chosen;
}

OS_GLSurfaceHandle X11GLContexts::CreateSurface(std::uint32_t inParent, int inWidth, int inHeight,
                                                const OS_GLPixelFormat& inFormat) {
  if (!IsAvailable() || inParent == 0) return 0;
  Display* display = AsDisplay(mDisplay);
  const int errorsBefore = gErrorCount;
  void* config = ChooseConfig(inParent, inFormat);
  XVisualInfo* visual = config ? glXGetVisualFromFBConfig(display, AsConfig(config)) : nullptr;
  if (!visual) return 0;
  Surface surface;
  surface.parent = inParent;
  surface.config = config;
  surface.width = std::max(1, inWidth);
  surface.height = std::max(1, inHeight);
  surface.doubleBuffered = inFormat.doubleBuffered;
  surface.colormap = XCreateColormap(display, inParent, visual->visual, AllocNone);
  XSetWindowAttributes attributes{};
  attributes.colormap = surface.colormap;
  attributes.border_pixel = 0;
  attributes.background_pixmap = None;  // GL paints every pixel; no flash of a background
  const Window window = XCreateWindow(display, inParent, 0, 0, static_cast<unsigned>(surface.width),
                                      static_cast<unsigned>(surface.height), 0, visual->depth, InputOutput,
                                      visual->visual, CWColormap | CWBorderPixel | CWBackPixmap, &attributes);
  XFree(visual);
  XMapWindow(display, window);
  // The layer's own connection names this window next: it must exist on the
  // server first.
  XSync(display, False);
  if (gErrorCount != errorsBefore) {
    XDestroyWindow(display, window);
    XFreeColormap(display, surface.colormap);
    XSync(display, False);
    return 0;
  }
  mSurfaces[window] = surface;
  return window;
}

void X11GLContexts::ReleaseIfCurrent(OS_GLSurfaceHandle inSurface, OS_GLContextHandle inContext) {
  Display* display = AsDisplay(mDisplay);
  if (glXGetCurrentDisplay() != display) return;
  if ((inSurface && glXGetCurrentDrawable() == inSurface) ||
      (inContext && glXGetCurrentContext() == AsContext(inContext)))
    glXMakeCurrent(display, None, nullptr);
}

void X11GLContexts::DestroySurface(OS_GLSurfaceHandle inSurface) {
  auto found = mSurfaces.find(inSurface);
  if (found == mSurfaces.end()) return;
  Display* display = AsDisplay(mDisplay);
  ReleaseIfCurrent(inSurface, 0);
  XDestroyWindow(display, static_cast<Window>(inSurface));
  XFreeColormap(display, found->second.colormap);
  XFlush(display);
  mSurfaces.erase(found);
}

std::uint32_t X11GLContexts::ParentOf(std::uint32_t inSurface) const {
  auto found = mSurfaces.find(inSurface);
  return found == mSurfaces.end() ? 0 : found->second.parent;
}

void X11GLContexts::FitSurface(OS_GLSurfaceHandle inSurface, int inWidth, int inHeight) {
  auto found = mSurfaces.find(inSurface);
  if (found == mSurfaces.end()) return;
  Surface& surface = found->second;
  const int width = std::max(1, inWidth);
  const int height = std::max(1, inHeight);
  if (surface.width == width && surface.height == height) return;
  surface.width = width;
  surface.height = height;
  XResizeWindow(AsDisplay(mDisplay), static_cast<Window>(inSurface), static_cast<unsigned>(width),
                static_cast<unsigned>(height));
}

OS_GLContextHandle X11GLContexts::CreateContext(OS_GLSurfaceHandle inSurface) {
  auto found = mSurfaces.find(inSurface);
  if (found == mSurfaces.end()) return 0;
  GLXContext context =
      glXCreateNewContext(AsDisplay(mDisplay), AsConfig(found->second.config), GLX_RGBA_TYPE, nullptr, True);
  if (!context) return 0;
  const auto handle = reinterpret_cast<OS_GLContextHandle>(context);
  mContexts[handle] = found->second.config;
  return handle;
}

void X11GLContexts::DestroyContext(OS_GLContextHandle inContext) {
  auto found = mContexts.find(inContext);
  if (found == mContexts.end()) return;
  ReleaseIfCurrent(0, inContext);
  glXDestroyContext(AsDisplay(mDisplay), AsContext(inContext));
  mContexts.erase(found);
}

OS_GLCurrent X11GLContexts::Current() const {
  OS_GLCurrent current;
  current.context = reinterpret_cast<OS_GLContextHandle>(glXGetCurrentContext());
  if (current.context) {
    current.connection = glXGetCurrentDisplay();
    current.surface = glXGetCurrentDrawable();
  }
  return current;
}

bool X11GLContexts::MakeCurrent(const OS_GLCurrent& inCurrent) {
  if (inCurrent.context == 0) {
    if (inCurrent.surface != 0) return false;
    if (Display* current = glXGetCurrentDisplay()) glXMakeCurrent(current, None, nullptr);
    return true;
  }
  if (mContexts.count(inCurrent.context)) {
    // One of ours: only on one of our surfaces.
    if (!mSurfaces.count(inCurrent.surface)) return false;
    return glXMakeCurrent(AsDisplay(mDisplay), static_cast<GLXDrawable>(inCurrent.surface),
                          AsContext(inCurrent.context)) == True;
  }
  // Someone else's pair, as GetCurrent answered it: put back on its display.
  if (!inCurrent.connection) return false;
  return glXMakeCurrent(static_cast<Display*>(inCurrent.connection), static_cast<GLXDrawable>(inCurrent.surface),
                        AsContext(inCurrent.context)) == True;
}

void X11GLContexts::Clear(float inRed, float inGreen, float inBlue, float inAlpha) {
  if (!glXGetCurrentContext()) return;
  glClearColor(inRed, inGreen, inBlue, inAlpha);
  glClearDepth(1.0);
  glClear(GL_COLOR_BUFFER_BIT | GL_DEPTH_BUFFER_BIT);
}

bool X11GLContexts::Swap(OS_GLSurfaceHandle inSurface) {
  auto found = mSurfaces.find(inSurface);
  if (found == mSurfaces.end()) return false;
  Display* display = AsDisplay(mDisplay);
  if (found->second.doubleBuffered)
    glXSwapBuffers(display, static_cast<GLXDrawable>(inSurface));
  else if (glXGetCurrentDrawable() == inSurface)
    glFlush();
  XFlush(display);
  return true;
}

}  // namespace norvik::ui::x11
