#pragma once
// What other parts of the toolkit ask of a window without knowing its class:
// its native handle, title, minimised state, closing hooks, its structure
// rectangle (the outer frame on the screen) and activation. OS_Window is the
// one implementation; dialogs and menus speak to windows through this.
#include <cstdint>

#include "tarsel/PointT.h"
#include "tarsel/RectT.h"
#include "tarsel/UTFString.h"

namespace norvik::ui {

class UI_Window {
 public:
  UI_Window() = default;
  virtual ~UI_Window() = default;
  UI_Window(const UI_Window&) = delete;
  UI_Window& operator=(const UI_Window&) = delete;

  // The native handle as a plain number; with inMayBeNull false a window
  // without one is a contract breach of the caller's.
  virtual std::uintptr_t GetPlatformWindow(bool inMayBeNull) const = 0;
  virtual void* GetPlatformMenu() const { return nullptr; }
  virtual void UI_SetTitle(const UTF16String& inTitle) = 0;
  virtual bool UI_IsMinimized() const = 0;
  virtual void UI_Minimize() = 0;
  // The native window is being destroyed; its children still exist.
  virtual void UI_DuringClose() {}
  // The native window is gone; the node lives on without a handle.
  virtual void UI_PostClose() {}
  virtual tarsel::geom::RectT<long> UI_GetGlobalStructureRect() const = 0;
  virtual void UI_SetGlobalStructureRect(const tarsel::geom::RectT<long>& inRect) = 0;
  virtual void UI_Move(const tarsel::geom::PointT<long>& inPoint) = 0;
  virtual void UI_Activate() = 0;

  UI_Window* GetOwner() const { return mOwner; }
  void SetOwner(UI_Window* inOwner) { mOwner = inOwner; }
  // True when the owner chain from this window meets the top modal window.
  bool OwnedByModalWindow() const;

 private:
  UI_Window* mOwner = nullptr;
};

}  // namespace norvik::ui
