#pragma once
// GLX for the X11 layer. GLX speaks through an Xlib display while the layer
// speaks xcb, so GL has a connection of its own to the same server, opened
// on first use and shared by every layer on that display. A surface is a child window of the view's window, with the
// visual of the chosen GLX frame-buffer configuration; it asks for no input,
// so pointer and key events go on to the view's window beneath it.
//
// Handles are checked against what this object made: an unknown surface or
// context is refused, never handed to GLX. X errors on this connection are
// counted, never fatal.
#include <cstdint>
#include <map>
#include <string>

#include "ui/OS_NativeLayer.h"

namespace norvik::ui::x11 {

class X11GLContexts {
 public:
  explicit X11GLContexts(std::string inDisplayName);
  ~X11GLContexts();
  X11GLContexts(const X11GLContexts&) = delete;
  X11GLContexts& operator=(const X11GLContexts&) = delete;

  // Opens the connection on first use; false when the server lacks GLX 1.3.
  bool IsAvailable();

  // A mapped child window of inParent at its origin, inWidth by inHeight.
  OS_GLSurfaceHandle CreateSurface(std::uint32_t inParent, int inWidth, int inHeight,
                                   const OS_GLPixelFormat& inFormat);
  void DestroySurface(OS_GLSurfaceHandle inSurface);
  // The window a surface lies in, 0 for a surface not made here.
  std::uint32_t ParentOf(std::uint32_t inSurface) const;
  // Resizes the surface when the size changed.
  void FitSurface(OS_GLSurfaceHandle inSurface, int inWidth, int inHeight);

  OS_GLContextHandle CreateContext(OS_GLSurfaceHandle inSurface);
  void DestroyContext(OS_GLContextHandle inContext);
  OS_GLCurrent Current() const;
  bool MakeCurrent(const OS_GLCurrent& inCurrent);
  void Clear(float inRed, float inGreen, float inBlue, float inAlpha);
  bool Swap(OS_GLSurfaceHandle inSurface);

 private:
  struct Surface {
    std::uint32_t parent = 0;
    void* config = nullptr;      // GLXFBConfig
    unsigned long colormap = 0;  // Colormap
    int width = 0;
    int height = 0;
    bool doubleBuffered = true;
  };

  void* ChooseConfig(std::uint32_t inParent, const OS_GLPixelFormat& inFormat);
  void ReleaseIfCurrent(OS_GLSurfaceHandle inSurface, OS_GLContextHandle inContext);

  std::string mDisplayName;
  void* mDisplay = nullptr;  // Display*
  bool mTried = false;
  bool mAvailable = false;
  std::map<OS_GLSurfaceHandle, Surface> mSurfaces;
  std::map<OS_GLContextHandle, void*> mContexts;  // context -> its GLXFBConfig
};

}  // namespace norvik::ui::x11
