// The page in a headless window, driven the way a user would: the two
// looks, the brightness switch, hover over the node tree, focus by click and
// by Tab, resizing, and closing the window.
#include <cstdlib>

#include <gtest/gtest.h>

#include "ControlsView.h"
#include "GalleryPage.h"
#include "controls/UI_Checkbox.h"
#include "controls/UI_RadioButton.h"
#include "controls/UI_RadioGroup.h"
#include "controls/UI_TextButton.h"
#include "GalleryWindow.h"
#include "GalleryWindowFixture.h"
#include "PageSelector.h"
#include "ui/HeadlessWindowSystem.h"
#include "ui/OS_Event.h"
#include "ui/OS_NodeManager.h"
#include "ui/OS_WindowConstants.h"
#include "ui/Theme.h"

namespace norvik::gallery {
namespace {

constexpr int kVirtualKeyTab = 0x09;
constexpr int kVirtualKeyShift = 0x10, kVirtualKeySpace = 0x20;

using testing::Luma;

class GalleryWindowTest : public testing::GalleryWindowFixture {
 protected:
  void Open(bool inLight, long inWidth = 900, long inHeight = 600) {
    GalleryWindowFixture::Open(inLight, inWidth, inHeight);
  }
  // The centre of a node, in screen coordinates.
  ui::OS_Point ScreenCentre(const ui::UI_Node* inNode) {
    const RectF local = inNode->UI_GetLocalRectF(false);
    const ui::UI_Node::RectL onPage =
        InWindow(inNode, ui::UI_Node::RectL(0, 0, static_cast<long>(local.width), static_cast<long>(local.height)));
    return system.GetLayer().ClientToScreen(
        window->GetHandle(), ui::OS_Point(onPage.left + onPage.width / 2, onPage.top + onPage.height / 2));
  }
  void Click(const ui::UI_Node* inNode) {
    system.Click(ScreenCentre(inNode));
    system.Pump();
  }
  ui::OS_Point ClientCentre(const ui::UI_Node* inNode) {
    return system.GetLayer().ScreenToClient(window->GetHandle(), ScreenCentre(inNode));
  }
  ui::UI_Node* TreeBox(const char* inOuterID, int inIndex) {
    ui::UI_Node* tree = page->GetSection("section-tree")->UI_ChildGetFromID("node-tree");
    ui::UI_Node* outer = tree->UI_ChildGetFromID(inOuterID);
    return (outer->ChildBegin() + inIndex)->get();
  }
};

TEST_F(GalleryWindowTest, TheDarkLookPaintsADarkPageWithLightTitleText) {
  Open(false);
  ui::HeadlessPixels px = Pixels();
  ASSERT_EQ(px.width, 900);
  ASSERT_EQ(px.height, 600);
  EXPECT_LT(Luma(px.At(4, 300)), 0x50) << "page background";
  EXPECT_LT(Luma(px.At(4, 10)), 0x50) << "header";
  int brightest = 0;
  for (int x = 40; x < 160; ++x)
    for (int y = 14; y < 34; ++y) brightest = std::max(brightest, Luma(px.At(x, y)));
  EXPECT_GT(brightest, 0xA0) << "the title is drawn in light text";
}

TEST_F(GalleryWindowTest, TheLightLookPaintsALightPageWithDarkTitleText) {
  Open(true);
  ui::HeadlessPixels px = Pixels();
  EXPECT_GT(Luma(px.At(4, 300)), 0xC0);
  int darkest = 255;
  for (int x = 40; x < 160; ++x)
    for (int y = 14; y < 34; ++y) darkest = std::min(darkest, Luma(px.At(x, y)));
  EXPECT_LT(darkest, 0x60);
}

TEST_F(GalleryWindowTest, ClickingTheSwitchTurnsTheWholePageLightAndBackDark) {
  Open(false);
  BrightnessSwitch* toggle = page->GetBrightnessSwitch();
  const int darkLuma = Luma(Pixels().At(4, 300));
  Click(toggle);
  EXPECT_TRUE(toggle->IsLight());
  EXPECT_TRUE(page->IsLight());
  EXPECT_FLOAT_EQ(theme->GetBrightness(), 1.0f);
  const int lightLuma = Luma(Pixels().At(4, 300));
  EXPECT_GT(lightLuma, darkLuma + 100) << "the repaint after the click shows the light look";
  Click(toggle);
  EXPECT_FALSE(page->IsLight());
  EXPECT_EQ(Luma(Pixels().At(4, 300)), darkLuma);
}

TEST_F(GalleryWindowTest, TheBoxUnderTheMouseLightsUpAndGoesBackWhenTheMouseLeaves) {
  Open(false);
  ui::UI_Node* music = TreeBox("mixer", 1);
  const ui::OS_Point at = ClientCentre(music);
  const std::uint32_t before = Pixels().At(at.x, at.y);
  system.MovePointer(ScreenCentre(music));
  system.Pump();
  EXPECT_TRUE(music->UI_IsMouseOver(true));
  EXPECT_TRUE(music->UI_GetParentNode()->UI_IsMouseOver(false)) << "its parent is on the mouse-over chain";
  const std::uint32_t hovered = Pixels().At(at.x, at.y);
  EXPECT_NE(hovered, before);
  // Onto a sibling: the first box goes back, the sibling lights up.
  ui::UI_Node* master = TreeBox("mixer", 2);
  system.MovePointer(ScreenCentre(master));
  ui::HeadlessPixels px = Pixels();
  EXPECT_FALSE(music->UI_IsMouseOver(true));
  EXPECT_EQ(px.At(at.x, at.y), before);
  const ui::OS_Point masterAt = ClientCentre(master);
  EXPECT_EQ(px.At(masterAt.x, masterAt.y), hovered);
  // Out of the window altogether.
  system.MovePointer(ui::OS_Point(5000, 5000));
  system.Pump();
  EXPECT_FALSE(master->UI_IsMouseOver(false));
  EXPECT_EQ(Pixels().At(masterAt.x, masterAt.y), before);
}

TEST_F(GalleryWindowTest, TabWalksTheFocusTilesForwardAndShiftTabWalksBack) {
  Open(false);
  std::vector<ui::UI_Node*> tiles = page->GetFocusTiles();
  ASSERT_EQ(tiles.size(), static_cast<std::size_t>(FocusDemoView::kTileCount));
  // The light-look switch in the header is the first stop, and Space turns it.
  system.TypeKey(kVirtualKeyTab);
  system.Pump();
  EXPECT_TRUE(page->GetBrightnessSwitch()->UI_HasKeyboardFocus(false));
  system.TypeKey(kVirtualKeySpace);
  system.Pump();
  EXPECT_TRUE(page->IsLight());
  system.TypeKey(kVirtualKeyTab);
  system.Pump();
  EXPECT_TRUE(page->GetPageSelector()->UI_HasKeyboardFocus(false));
  system.TypeKey(kVirtualKeyTab);
  system.Pump();
  EXPECT_TRUE(tiles[0]->UI_HasKeyboardFocus(true));
  system.TypeKey(kVirtualKeyTab);
  system.Pump();
  EXPECT_TRUE(tiles[1]->UI_HasKeyboardFocus(true));
  EXPECT_FALSE(tiles[0]->UI_HasKeyboardFocus(true));
  system.PressKey(kVirtualKeyShift);
  system.TypeKey(kVirtualKeyTab);
  system.ReleaseKey(kVirtualKeyShift);
  system.Pump();
  EXPECT_TRUE(tiles[0]->UI_HasKeyboardFocus(true));
}

TEST_F(GalleryWindowTest, ClickingATileFocusesItAndDrawsTheRingAroundIt) {
  Open(false);
  ui::UI_Node* timeline = page->GetFocusTiles()[2];
  const RectF r = timeline->UI_GetLocalRectF(false);
  const ui::UI_Node::RectL onPage = InWindow(timeline, ui::UI_Node::RectL(0, 0, 1, 1));
  // A pixel of the ring: on the tile's left edge, half way down.
  const int ringX = static_cast<int>(onPage.left), ringY = static_cast<int>(onPage.top + r.height / 2);
  const std::uint32_t before = Pixels().At(ringX, ringY);
  Click(timeline);
  EXPECT_TRUE(timeline->UI_HasKeyboardFocus(true));
  const std::uint32_t ring = Pixels().At(ringX, ringY);
  EXPECT_NE(ring, before);
  EXPECT_GT(ring & 0xFF, (ring >> 16) & 0xFF) << "the ring is in the accent blue";
  system.TypeKey(kVirtualKeyTab);
  system.Pump();
  EXPECT_TRUE(page->GetFocusTiles()[3]->UI_HasKeyboardFocus(true)) << "Tab goes on from the clicked tile";
  EXPECT_EQ(Pixels().At(ringX, ringY), before) << "the ring leaves with the focus";
}

TEST_F(GalleryWindowTest, TheControlsTakeClicksThroughTheWindow) {
  Open(false, 1120, 720);  // the program's default size, where every control is in view
  auto* view = static_cast<ControlsView*>(page->GetSection("section-controls")->UI_ChildGetFromID("controls"));
  ASSERT_NE(view, nullptr);
  controls::UI_Checkbox* snap = view->GetSnapCheckbox();
  ASSERT_TRUE(snap->IsChecked());
  Click(snap);
  EXPECT_FALSE(snap->IsChecked());
  system.AdvanceClock(1000);  // past the double-click time, so the next click is a single one
  Click(snap);
  EXPECT_TRUE(snap->IsChecked());
  controls::UI_RadioGroup* group = view->GetTimeDisplayGroup();
  EXPECT_EQ(group->GetIndex(), 0);
  ui::UI_Node* samples = (group->ChildBegin() + 2)->get();
  system.AdvanceClock(1000);
  // On the round button at the left end of the radio.
  const ui::UI_Node::RectL onPage = InWindow(samples, ui::UI_Node::RectL(6, 9, 1, 1));
  system.Click(system.GetLayer().ClientToScreen(window->GetHandle(), ui::OS_Point(onPage.left, onPage.top)));
  system.AdvanceClock(100);
  EXPECT_EQ(group->GetIndex(), 2);
  EXPECT_EQ(group->GetSelectedRadioButton(), samples);
  // A push button reports itself on the status line.
  const UTF16String hint = view->GetStatus();
  system.AdvanceClock(1000);
  Click(view->GetRenderButton());
  EXPECT_NE(view->GetStatus(), hint);
  EXPECT_NE(view->GetStatus().find(u"Render"), UTF16String::npos);
}

TEST_F(GalleryWindowTest, ResizingTheWindowLaysTheSectionsOutInTheNewSize) {
  Open(false, 900, 600);
  system.GetLayer().SetWindowPos(window->GetHandle(), ui::kOSInsertTop, ui::OS_Rect(60, 60, 1300, 900), 0);
  system.Pump();
  EXPECT_EQ(page->UI_GetLocalRectF(false).width, 1300);
  EXPECT_EQ(page->UI_GetLocalRectF(false).height, 900);
  for (const char* id : {"section-colours", "section-drawing", "section-tree", "section-focus", "section-controls"}) {
    SectionView* s = page->GetSection(id);
    ASSERT_NE(s, nullptr) << id;
    const RectF r = s->UI_GetLocalRectF(true);
    EXPECT_GE(r.left, 0) << id;
    EXPECT_LE(r.left + r.width, 1300) << id;
    EXPECT_LE(r.top + r.height, 900) << id;
    EXPECT_GT(r.width, 500) << id << " grows with the window";
  }
  ui::HeadlessPixels px = Pixels();
  EXPECT_EQ(px.width, 1300);
  const SectionView* focus = page->GetSection("section-focus");
  const RectF local = focus->UI_GetLocalRectF(false);
  const ui::UI_Node::RectL onPage =
      InWindow(focus, ui::UI_Node::RectL(0, 0, static_cast<long>(local.width), static_cast<long>(local.height)));
  const RectF fr(static_cast<float>(onPage.left), static_cast<float>(onPage.top), static_cast<float>(onPage.width),
                 static_cast<float>(onPage.height));
  EXPECT_NE(px.At(static_cast<int>(fr.left + fr.width - 3), static_cast<int>(fr.top + fr.height - 3)),
            px.At(static_cast<int>(fr.left + fr.width + 3), static_cast<int>(fr.top + fr.height - 3)))
      << "the panel is painted up to its new right edge";
}

TEST_F(GalleryWindowTest, ClosingTheWindowEndsTheLoopAndTheWindowIsGone) {
  Open(false);
  const ui::OS_WindowHandle handle = window->GetHandle();
  system.GetLayer().PostMessage(handle, ui::kOSMsgClose, 0, 0);
  EXPECT_EQ(window->Run(), 0);
  EXPECT_FALSE(window->IsOpen());
  EXPECT_FALSE(system.GetLayer().IsWindow(handle));
  window.reset();  // destroying the object after the window is gone is harmless
}

TEST_F(GalleryWindowTest, TheWindowIsAnActiveMainWindowWithTheGalleryTitleAndThePageFillsIt) {
  Open(false, 800, 500);
  ui::OS_NativeLayer& layer = system.GetLayer();
  const ui::OS_WindowHandle handle = window->GetHandle();
  EXPECT_EQ(layer.GetWindowText(handle), u"norvik gallery");
  EXPECT_EQ(layer.GetActiveWindow(), handle);
  EXPECT_EQ(layer.GetExStyle(handle) & ui::kOSExStyleNoActivate, 0u) << "a main window takes activation";
  EXPECT_EQ(layer.GetStyle(handle) & ui::kOSStylePopup, 0u);
  EXPECT_EQ(layer.GetClientRect(handle), ui::OS_Rect(0, 0, 800, 500));
  EXPECT_EQ(page->UI_GetParentNode(), window.get());
  EXPECT_EQ(page->UI_GetLocalRectF(true), RectF(0, 0, 800, 500));
}

TEST_F(GalleryWindowTest, AButtonPressedAndReleasedOutsideItDoesNothingWhilePressAndReleaseOnItReports) {
  Open(false, 1120, 720);
  auto* view = static_cast<ControlsView*>(page->GetSection("section-controls")->UI_ChildGetFromID("controls"));
  ASSERT_NE(view, nullptr);
  const UTF16String hint = view->GetStatus();
  // The button holds the mouse from the press: the release far outside the
  // window still reaches it, and it lets go without reporting.
  system.MovePointer(ScreenCentre(view->GetRenderButton()));
  system.PressButton(ui::kHeadlessButtonLeft);
  system.Pump();
  EXPECT_EQ(system.GetLayer().GetCapture(), window->GetHandle()) << "the press captured the mouse";
  system.MovePointer(ui::OS_Point(3000, 3000));
  system.ReleaseButton(ui::kHeadlessButtonLeft);
  system.Pump();
  EXPECT_EQ(view->GetStatus(), hint);
  EXPECT_EQ(system.GetLayer().GetCapture(), 0u) << "the release let the mouse go";
  system.AdvanceClock(1000);
  Click(view->GetRenderButton());
  EXPECT_NE(view->GetStatus(), hint);
}

TEST_F(GalleryWindowTest, TheFirstFrameIsReportedOnceAfterTheShownWindowPaints) {
  theme = ui::MakeDefaultKeyframeTheme();
  ui::Theme::Initialize(theme);
  system.Install();
  page.reset(new GalleryPage(theme, false));
  window.reset(new GalleryWindow(page, 900, 600));
  int frames = 0;
  std::uint32_t pixelThen = 0;
  window->SetFirstFrameFunction([&] {
    ++frames;
    pixelThen = system.ReadWindowPixels(window->GetHandle()).At(4, 300);
  });
  EXPECT_EQ(frames, 0) << "nothing is painted before the loop runs";
  system.Pump();
  EXPECT_EQ(frames, 1);
  EXPECT_LT(Luma(pixelThen), 0x50) << "the page was on the window when the frame was reported";
  EXPECT_NE(pixelThen, 0u);
  page->SetLight(true);
  system.Pump();
  EXPECT_EQ(frames, 1) << "later paints are not first frames";
  EXPECT_GT(Luma(Pixels().At(4, 300)), 0xC0);
}

TEST_F(GalleryWindowTest, EverySectionHasATitleAndContentInsideIt) {
  Open(false);
  for (const char* id : {"section-colours", "section-drawing", "section-tree", "section-focus", "section-controls"}) {
    SectionView* s = page->GetSection(id);
    ASSERT_NE(s, nullptr) << id;
    EXPECT_FALSE(s->Title().empty()) << id;
    ASSERT_EQ(s->ChildSize(), 1u) << id;
    const RectF content = s->ChildBegin()->get()->UI_GetLocalRectF(true);
    const RectF frame = s->UI_GetLocalRectF(false);
    EXPECT_GT(content.height, 40) << id;
    EXPECT_LE(content.top + content.height, frame.height) << id;
  }
  EXPECT_EQ(page->GetSection("no-such-section"), nullptr);
  // Nothing inside a section's content hangs out of it (where it could be
  // seen but not clicked).
  for (const char* id : {"section-focus", "section-controls"}) {
    ui::UI_Node* content = page->GetSection(id)->ChildBegin()->get();
    const RectF bounds = content->UI_GetLocalRectF(false);
    for (auto it = content->ChildBegin(); it != content->ChildEnd(); ++it) {
      const RectF r = (*it)->UI_GetLocalRectF(true);
      EXPECT_LE(r.top + r.height, bounds.height) << id << " child " << (it - content->ChildBegin());
      for (auto inner = (*it)->ChildBegin(); inner != (*it)->ChildEnd(); ++inner) {
        const RectF ir = (*inner)->UI_GetLocalRectF(true);
        EXPECT_LE(r.top + ir.top + ir.height, bounds.height) << id << " grandchild";
      }
    }
  }
}

// Shown nodes under inNode that stick out of their parents: cut off, or out of reach.
std::string Overflowing(ui::UI_Node* inNode) {
  std::string found;
  const RectF in = inNode->UI_GetLocalRectF(false);
  for (auto it = inNode->ChildBegin(); it != inNode->ChildEnd(); ++it) {
    const RectF r = (*it)->UI_GetLocalRectF(true);
    if ((*it)->UI_IsShown() && (r.left < 0 || r.top < 0 || r.Right() > in.width + 0.5f || r.Bottom() > in.height + 0.5f))
      found += " " + std::string((*it)->UI_GetNodeID()) + " in " + std::string(inNode->UI_GetNodeID());
    if ((*it)->UI_IsShown()) found += Overflowing(it->get());
  }
  return found;
}

TEST_F(GalleryWindowTest, AtTheSmallestSizeItAcceptsNoPageHasANodeOutsideItsParent) {
  Open(false, GalleryPage::kMinWidth, GalleryPage::kMinHeight);
  for (GalleryPageID id : {GalleryPageID::kBasics, GalleryPageID::kButtons, GalleryPageID::kLayout, GalleryPageID::kNumbers}) {
    page->ShowPage(id), system.Pump();
    EXPECT_EQ(Overflowing(page.get()), "") << GalleryPageName(id);
  }
}

}  // namespace
}  // namespace norvik::gallery
