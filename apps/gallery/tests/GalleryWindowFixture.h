#pragma once
// A gallery page in a window of the headless window system, as the program
// shows it, for tests that drive the page the way a user would.
#include <cstdint>

#include <gtest/gtest.h>

#include "GalleryPage.h"
#include "GalleryWindow.h"
#include "ui/HeadlessWindowSystem.h"
#include "ui/OS_NodeManager.h"
#include "ui/Theme.h"

namespace norvik::gallery::testing {

// The brightness of a pixel, 0 to 255, weighted as the eye sees.
inline int Luma(std::uint32_t inPixel) {
  return (static_cast<int>((inPixel >> 16) & 0xFF) * 3 + static_cast<int>((inPixel >> 8) & 0xFF) * 6 +
          static_cast<int>(inPixel & 0xFF)) /
         10;
}

class GalleryWindowFixture : public ::testing::Test {
 protected:
  void Open(bool inLight, long inWidth, long inHeight) {
    theme = ui::MakeDefaultKeyframeTheme();
    ui::Theme::Initialize(theme);
    system.Install();
    page.reset(new GalleryPage(theme, inLight));
    window.reset(new GalleryWindow(page, inWidth, inHeight));
    system.Pump();
  }
  void TearDown() override {
    window.reset();
    page.reset();
    system.Uninstall();
    ui::Theme::Terminate();
  }
  ui::HeadlessPixels Pixels() {
    system.Pump();
    return system.ReadWindowPixels(window->GetHandle());
  }
  // A rectangle of a node in the window's client coordinates: nodes in a
  // window have the screen for their global coordinates.
  ui::UI_Node::RectL InWindow(const ui::UI_Node* inNode, const ui::UI_Node::RectL& inLocal) {
    const ui::UI_Node::RectL onScreen = inNode->UI_LocalToGlobal(inLocal);
    const ui::OS_Point origin = system.GetLayer().ClientToScreen(window->GetHandle(), ui::OS_Point(0, 0));
    return ui::UI_Node::RectL(onScreen.left - origin.x, onScreen.top - origin.y, onScreen.width, onScreen.height);
  }
  void ClickAt(const ui::UI_Node* inNode, long inX, long inY) {
    const ui::UI_Node::RectL onScreen = inNode->UI_LocalToGlobal(ui::UI_Node::RectL(inX, inY, 1, 1));
    system.AdvanceClock(1000);  // past the double-click time: each click is a single one
    system.Click(ui::OS_Point(onScreen.left, onScreen.top));
    system.Pump();
  }
  void Click(const ui::UI_Node* inNode) {
    const ui::UI_Node::RectF r = inNode->UI_GetLocalRectF(false);
    ClickAt(inNode, static_cast<long>(r.width / 2), static_cast<long>(r.height / 2));
  }

  ui::OS_NodeManager manager;
  ui::HeadlessWindowSystem system;
  ui::KeyframeThemeEditorP theme;
  GalleryPageP page;
  GalleryWindowP window;
};

}  // namespace norvik::gallery::testing
