// The Buttons page in a headless window: every kind of button in every state
// it has, each state visibly unlike the normal one in both looks; the page
// selector switched by clicks; the live buttons reporting on the status line.
#include <filesystem>

#include <gtest/gtest.h>

#include "ButtonsView.h"
#include "GalleryPage.h"
#include "GalleryWindow.h"
#include "GalleryWindowFixture.h"
#include "PageSelector.h"
#include "controls/UI_ButtonBar.h"
#include "controls/UI_Checkbox.h"
#include "controls/UI_RadioGroup.h"
#include "ui/HeadlessWindowSystem.h"
#include "ui/OS_NodeManager.h"
#include "ui/Theme.h"

namespace norvik::gallery {
namespace {

using RectL = ui::UI_Node::RectL;

using testing::Luma;

// How many pixels of inRect differ between two images of one window.
int CountDifferences(const ui::HeadlessPixels& inA, const RectL& inRectA, const ui::HeadlessPixels& inB,
                     const RectL& inRectB) {
  int count = 0;
  for (long y = 0; y < std::min(inRectA.height, inRectB.height); ++y)
    for (long x = 0; x < std::min(inRectA.width, inRectB.width); ++x)
      count += inA.At(static_cast<int>(inRectA.left + x), static_cast<int>(inRectA.top + y)) !=
                       inB.At(static_cast<int>(inRectB.left + x), static_cast<int>(inRectB.top + y))
                   ? 1
                   : 0;
  return count;
}

// The spread of brightness within inRect: 0 for a flat area.
int LumaSpread(const ui::HeadlessPixels& inPixels, const RectL& inRect) {
  int lo = 255, hi = 0;
  for (long y = inRect.top; y < inRect.top + inRect.height; ++y)
    for (long x = inRect.left; x < inRect.left + inRect.width; ++x) {
      const int l = Luma(inPixels.At(static_cast<int>(x), static_cast<int>(y)));
      lo = std::min(lo, l);
      hi = std::max(hi, l);
    }
  return hi - lo;
}


class ButtonsPageTest : public testing::GalleryWindowFixture {
 protected:
  void Open(bool inLight, long inWidth = 1120, long inHeight = 720) {
    GalleryWindowFixture::Open(inLight, inWidth, inHeight);
  }
  void TearDown() override {
    if (HasFailure() && window) {
      const std::filesystem::path dir = std::filesystem::path(NORVIK_TEST_OUTPUT_DIR) / "buttons-page";
      std::filesystem::create_directories(dir);
      const std::string name = ::testing::UnitTest::GetInstance()->current_test_info()->name();
      system.WriteWindowPNG(window->GetHandle(), (dir / (name + ".png")).string());
    }
    GalleryWindowFixture::TearDown();
  }
  RectL OnPage(const ui::UI_Node* inNode, const RectF& inLocal) {
    return InWindow(inNode, RectL(static_cast<long>(inLocal.left), static_cast<long>(inLocal.top),
                                  static_cast<long>(inLocal.width), static_cast<long>(inLocal.height)));
  }
  ButtonGridView* Grid() const { return page->GetButtonsPage()->GetGrid(); }
  // Checks that every kind has a sample in each of its states and nothing
  // else, each inside its own cell (a button bar's row of buttons included);
  // answers the number of samples.
  int ExpectSamplesInsideTheirCells() {
    int samples = 0;
    for (int k = 0; k < kButtonKindCount; ++k) {
      for (int s = 0; s < kShownStateCount; ++s) {
        ui::UI_Node* sample = Grid()->GetSample(KindAt(k), StateAt(s));
        EXPECT_EQ(sample != nullptr, KindShowsState(KindAt(k), StateAt(s))) << "kind " << k << " state " << s;
        if (!sample) continue;
        ++samples;
        const RectL cell = Cell(KindAt(k), StateAt(s));
        RectL frame = OnPage(sample, sample->UI_GetLocalRectF(false));
        if (const auto* bar = dynamic_cast<const controls::UI_ButtonBar*>(sample))
          frame.width = std::max(frame.width, static_cast<long>(bar->GetButtonbarWidth()));
        EXPECT_GT(frame.width, 10) << "kind " << k << " state " << s;
        EXPECT_GE(frame.left, cell.left) << "kind " << k << " state " << s;
        EXPECT_GE(frame.top, cell.top) << "kind " << k << " state " << s;
        EXPECT_LE(frame.left + frame.width, cell.left + cell.width) << "kind " << k << " state " << s;
        EXPECT_LE(frame.top + frame.height, cell.top + cell.height) << "kind " << k << " state " << s;
      }
    }
    return samples;
  }

  LiveButtonsView* Live() const { return page->GetButtonsPage()->GetLiveButtons(); }
  RectL Cell(ButtonKind inKind, ShownState inState) {
    return OnPage(Grid(), Grid()->GetCellRect(inKind, inState));
  }
};

TEST_F(ButtonsPageTest, EveryKindHasASampleInEachOfItsStatesInsideItsOwnCell) {
  Open(false);
  page->ShowPage(GalleryPageID::kButtons);
  const int samples = ExpectSamplesInsideTheirCells();
  EXPECT_EQ(samples, Grid()->GetSampleCount());
  EXPECT_GE(samples, 60);
  // The grid and the live buttons fit the window at the program's size.
  const RectL grid = OnPage(Grid(), Grid()->UI_GetLocalRectF(false));
  const RectL last = Cell(KindAt(kButtonKindCount - 1), StateAt(kShownStateCount - 1));
  EXPECT_LE(last.top + last.height, grid.top + grid.height);
  EXPECT_LE(last.left + last.width, grid.left + grid.width);
  const RectL live = OnPage(Live(), Live()->UI_GetLocalRectF(false));
  EXPECT_LE(live.top + live.height, 720);
  EXPECT_GE(live.top, grid.top + grid.height);
}

TEST_F(ButtonsPageTest, InTheSmallestWindowTheSamplesStillKeepToTheirCells) {
  Open(true, GalleryPage::kMinWidth, GalleryPage::kMinHeight);
  page->ShowPage(GalleryPageID::kButtons);
  EXPECT_EQ(ExpectSamplesInsideTheirCells(), Grid()->GetSampleCount());
}

TEST_F(ButtonsPageTest, TheSelectedStateIsOnlyForButtonsThatKeepAValue) {
  EXPECT_FALSE(KindShowsState(ButtonKind::kText, ShownState::kOn));
  EXPECT_FALSE(KindShowsState(ButtonKind::kPicture, ShownState::kDisabledOn));
  EXPECT_TRUE(KindShowsState(ButtonKind::kLock, ShownState::kOn));
  EXPECT_TRUE(KindShowsState(ButtonKind::kRadio, ShownState::kDisabledOn));
  EXPECT_TRUE(KindShowsState(ButtonKind::kTriStateCheckbox, ShownState::kMixed));
  EXPECT_FALSE(KindShowsState(ButtonKind::kCheckbox, ShownState::kMixed));
}

class ButtonsPageLooks : public ButtonsPageTest, public ::testing::WithParamInterface<bool> {};

TEST_P(ButtonsPageLooks, EveryStateLooksUnlikeTheNormalOneAndTheLabelsStandOut) {
  Open(GetParam());
  page->ShowPage(GalleryPageID::kButtons);
  const ui::HeadlessPixels px = Pixels();
  for (int k = 0; k < kButtonKindCount; ++k) {
    const ButtonKind kind = KindAt(k);
    const RectL normal = Cell(kind, ShownState::kNormal);
    EXPECT_GT(LumaSpread(px, normal), 40) << "kind " << k << ": the normal sample is painted";
    for (int s = 1; s < kShownStateCount; ++s) {
      if (!KindShowsState(kind, StateAt(s))) continue;
      EXPECT_GT(CountDifferences(px, normal, px, Cell(kind, StateAt(s))), 8)
          << "kind " << k << ", state " << s << " looks like the normal state";
    }
    if (KindShowsState(kind, ShownState::kDisabledOn)) {
      EXPECT_GT(CountDifferences(px, Cell(kind, ShownState::kOn), px, Cell(kind, ShownState::kDisabledOn)), 8)
          << "kind " << k << ": disabled and on looks like on";
      EXPECT_GT(CountDifferences(px, Cell(kind, ShownState::kDisabled), px, Cell(kind, ShownState::kDisabledOn)), 8)
          << "kind " << k << ": disabled and on looks like disabled";
    }
    // The kind's name at the left of its row reads against the row.
    const RectF labelRect(6, Grid()->GetCellRect(kind, ShownState::kNormal).top, 100, 14);
    EXPECT_GT(LumaSpread(px, OnPage(Grid(), labelRect)), 90) << "kind " << k << ": its name is legible";
  }
  EXPECT_GT(CountDifferences(px, Cell(ButtonKind::kTriStateCheckbox, ShownState::kOn), px,
                             Cell(ButtonKind::kTriStateCheckbox, ShownState::kMixed)),
            8)
      << "mixed is not on";
  // A disabled button's label is dimmed, not lost: inside the bevel (its
  // edges left out) the label still stands out from the face.
  for (ButtonKind kind : {ButtonKind::kText, ButtonKind::kDefaultText, ButtonKind::kDisclosure}) {
    const ui::UI_Node* disabled = Grid()->GetSample(kind, ShownState::kDisabled);
    const RectF r = disabled->UI_GetLocalRectF(false);
    EXPECT_GT(LumaSpread(px, OnPage(disabled, RectF(20, 5, r.width - 26, r.height - 10))), 40)
        << "kind " << static_cast<int>(kind) << ": the disabled label is legible";
  }
  // The column headings.
  const RectF heading = Grid()->GetCellRect(ButtonKind::kText, ShownState::kPressed);
  EXPECT_GT(LumaSpread(px, OnPage(Grid(), RectF(heading.left, 4, heading.width, 14))), 60);
}

TEST_P(ButtonsPageLooks, APressedTextButtonIsShadedOtherwiseThanItsRollover) {
  // Pressed and rolled over differ only by the down state: the face of the
  // bevel turns, which a single column of the button shows.
  Open(GetParam());
  page->ShowPage(GalleryPageID::kButtons);
  const ui::HeadlessPixels px = Pixels();
  const ui::UI_Node* rollover = Grid()->GetSample(ButtonKind::kText, ShownState::kRollover);
  const ui::UI_Node* pressed = Grid()->GetSample(ButtonKind::kText, ShownState::kPressed);
  const RectL a = OnPage(rollover, RectF(4, 2, 4, 18)), b = OnPage(pressed, RectF(4, 2, 4, 18));
  EXPECT_GT(CountDifferences(px, a, px, b), 20);
}

TEST_P(ButtonsPageLooks, TheButtonBarsFrameEndsWithItsLastButton) {
  Open(GetParam());
  page->ShowPage(GalleryPageID::kButtons);
  const ui::HeadlessPixels px = Pixels();
  for (ShownState state : {ShownState::kNormal, ShownState::kDisabled}) {
    const auto* bar = dynamic_cast<const controls::UI_ButtonBar*>(Grid()->GetSample(ButtonKind::kButtonBar, state));
    ASSERT_NE(bar, nullptr);
    const RectF last = bar->GetButton(static_cast<int>(bar->GetButtonCount()) - 1)->UI_GetLocalRectF(true);
    const RectF local = bar->UI_GetLocalRectF(false);
    EXPECT_LE(last.left + last.width, local.width) << "the buttons keep inside the bar";
    // Right of the last button the cell's own background shows, on every row
    // of the bar: nothing of the frame is left over there.
    const RectL beside = OnPage(bar, RectF(last.left + last.width, 0, 6, local.height));
    const RectL background = OnPage(bar, RectF(last.left + last.width + 8, 0, 1, local.height));
    int framePixels = 0;
    for (long y = 0; y < beside.height; ++y)
      for (long x = 0; x < beside.width; ++x)
        framePixels += px.At(static_cast<int>(beside.left + x), static_cast<int>(beside.top + y)) !=
                               px.At(static_cast<int>(background.left), static_cast<int>(background.top + y))
                           ? 1
                           : 0;
    EXPECT_EQ(framePixels, 0) << "state " << static_cast<int>(state);
  }
}

TEST_P(ButtonsPageLooks, ADisabledRadioButtonKeepsAVisibleRing) {
  Open(GetParam());
  page->ShowPage(GalleryPageID::kButtons);
  const ui::HeadlessPixels px = Pixels();
  const ui::UI_Node* radio = Grid()->GetSample(ButtonKind::kRadio, ShownState::kDisabled);
  const RectF r = radio->UI_GetLocalRectF(false);
  // The ring alone: the box at the left, without the label.
  const RectL ring = OnPage(radio, RectF(0, 0, 14, r.height));
  EXPECT_GT(LumaSpread(px, ring), GetParam() ? 8 : 30);
}

INSTANTIATE_TEST_SUITE_P(BothLooks, ButtonsPageLooks, ::testing::Values(false, true),
                         [](const ::testing::TestParamInfo<bool>& inInfo) {
                           return std::string(inInfo.param ? "Light" : "Dark");
                         });

TEST_F(ButtonsPageTest, TheSelectorSwitchesBetweenThePagesByClicks) {
  Open(false);
  ASSERT_EQ(page->GetShownPage(), GalleryPageID::kBasics);
  EXPECT_FALSE(page->GetButtonsPage()->UI_IsShown());
  const RectL sectionOnPage = OnPage(page->GetSection("section-drawing"), RectF(0, 0, 1, 1));
  const ui::HeadlessPixels basics = Pixels();

  Click(page->GetPageSelector()->GetChoice(GalleryPageID::kButtons));
  EXPECT_EQ(page->GetShownPage(), GalleryPageID::kButtons);
  EXPECT_EQ(page->GetPageSelector()->GetSelected(), GalleryPageID::kButtons);
  EXPECT_TRUE(page->GetButtonsPage()->UI_IsShown());
  EXPECT_FALSE(page->GetSection("section-drawing")->UI_AreAllParentsVisible());
  const ui::HeadlessPixels buttons = Pixels();
  const RectL body(0, sectionOnPage.top, 1120, 720 - sectionOnPage.top);
  EXPECT_GT(CountDifferences(basics, body, buttons, body), 20000) << "the window shows the other page";

  // A click where a basics control was now lands on the Buttons page.
  Click(page->GetPageSelector()->GetChoice(GalleryPageID::kBasics));
  EXPECT_EQ(page->GetShownPage(), GalleryPageID::kBasics);
  EXPECT_FALSE(page->GetButtonsPage()->UI_IsShown());
  EXPECT_EQ(CountDifferences(basics, body, Pixels(), body), 0) << "the basics come back as they were";
}

TEST_F(ButtonsPageTest, TheArrowKeysSwitchPagesOnceTheSelectorHasTheFocus) {
  Open(true);
  constexpr int kVirtualKeyTab = 0x09, kVirtualKeyLeft = 0x25, kVirtualKeyRight = 0x27;
  system.TypeKey(kVirtualKeyTab);  // the light-look switch, then the selector
  system.Pump();
  system.TypeKey(kVirtualKeyTab);
  system.Pump();
  ASSERT_TRUE(page->GetPageSelector()->UI_HasKeyboardFocus(false));
  system.TypeKey(kVirtualKeyRight);
  system.Pump();
  EXPECT_EQ(page->GetShownPage(), GalleryPageID::kButtons);
  system.TypeKey(kVirtualKeyRight);
  system.Pump();
  EXPECT_EQ(page->GetShownPage(), GalleryPageID::kLayout);
  for (int i = 0; i < 2; ++i) {
    system.TypeKey(kVirtualKeyRight);
    system.Pump();
    EXPECT_EQ(page->GetShownPage(), GalleryPageID::kNumbers) << "the row ends without wrapping";
  }
  system.TypeKey(kVirtualKeyLeft);
  system.Pump();
  EXPECT_EQ(page->GetShownPage(), GalleryPageID::kLayout);
}

TEST_F(ButtonsPageTest, HiddenPagesTakeNoClicks) {
  Open(false);
  // The live text button lies under the basics page; while the basics show,
  // a click there does not reach it.
  ui::UI_Node* render = Live()->GetButton(ButtonKind::kText);
  const UTF16String hint = Live()->GetStatus();
  Click(render);
  EXPECT_EQ(Live()->GetStatus(), hint);
  page->ShowPage(GalleryPageID::kButtons);
  system.Pump();
  Click(render);
  EXPECT_EQ(Live()->GetStatus(), u"Text button pressed");
}

TEST_F(ButtonsPageTest, LiveButtonsReportWhatTheyDidOnTheStatusLine) {
  Open(true);
  page->ShowPage(GalleryPageID::kButtons);
  const RectL status = OnPage(Live(), RectF(0, Live()->UI_GetLocalRectF(false).height - 20, 300, 20));
  const ui::HeadlessPixels before = Pixels();

  Click(Live()->GetButton(ButtonKind::kText));
  EXPECT_EQ(Live()->GetStatus(), u"Text button pressed");
  EXPECT_GT(CountDifferences(before, status, Pixels(), status), 20) << "the status line is repainted";

  Click(Live()->GetButton(ButtonKind::kPicture));
  EXPECT_EQ(Live()->GetStatus(), u"Picture button pressed");
  Click(Live()->GetButton(ButtonKind::kOwnerDraw));
  EXPECT_EQ(Live()->GetStatus(), u"Owner-drawn button pressed");

  Click(Live()->GetButton(ButtonKind::kLock));
  EXPECT_EQ(Live()->GetStatus(), u"Lock: locked");
  Click(Live()->GetButton(ButtonKind::kLock));
  EXPECT_EQ(Live()->GetStatus(), u"Lock: unlocked");

  // On the box at the left end of each checkbox.
  ui::UI_Node* box = Live()->GetButton(ButtonKind::kCheckbox);
  ClickAt(box, 6, 9);
  EXPECT_EQ(Live()->GetStatus(), u"Checkbox: on");
  ClickAt(box, 6, 9);
  EXPECT_EQ(Live()->GetStatus(), u"Checkbox: off");
  ui::UI_Node* tri = Live()->GetButton(ButtonKind::kTriStateCheckbox);
  for (const char16_t* expected : {u"Tri-state checkbox: on", u"Tri-state checkbox: mixed", u"Tri-state checkbox: off"}) {
    ClickAt(tri, 6, 9);
    EXPECT_EQ(Live()->GetStatus(), expected);
  }

  auto* bar = static_cast<controls::UI_ButtonBar*>(Live()->GetButton(ButtonKind::kButtonBar));
  Click(bar->GetButton(1));
  EXPECT_EQ(bar->GetValue(), 2);
  EXPECT_EQ(Live()->GetStatus(), u"Button bar: 2×");

  controls::UI_RadioGroup* group = Live()->GetRadioGroup();
  ui::UI_Node* surround = (group->ChildBegin() + 2)->get();
  ClickAt(surround, 6, 9);
  EXPECT_EQ(group->GetIndex(), 2);
  EXPECT_EQ(Live()->GetStatus(), u"Radio: 5.1");

  // The triangle turns open at the click, and tells its listeners once its
  // turn has ended, on a timer of the window.
  controls::UI_ControlView* triangle = Live()->GetButton(ButtonKind::kDisclosure);
  Click(triangle);
  EXPECT_TRUE(triangle->GetDownState());
  EXPECT_EQ(Live()->GetStatus(), u"Radio: 5.1") << "not before the turn has ended";
  system.AdvanceClock(500);
  EXPECT_EQ(Live()->GetStatus(), u"Disclosure triangle: open");
}

TEST_F(ButtonsPageTest, StateSamplesKeepTheirLookUnderTheMouse) {
  Open(false);
  page->ShowPage(GalleryPageID::kButtons);
  const ui::HeadlessPixels before = Pixels();
  const RectL normal = Cell(ButtonKind::kText, ShownState::kNormal);
  const RectL check = Cell(ButtonKind::kCheckbox, ShownState::kNormal);
  system.MovePointer(system.GetLayer().ClientToScreen(
      window->GetHandle(), ui::OS_Point(normal.left + normal.width / 2, normal.top + normal.height / 2)));
  Click(Grid()->GetSample(ButtonKind::kCheckbox, ShownState::kNormal));
  const ui::HeadlessPixels after = Pixels();
  EXPECT_EQ(CountDifferences(before, normal, after, normal), 0);
  EXPECT_EQ(CountDifferences(before, check, after, check), 0);
  EXPECT_FALSE(static_cast<controls::UI_Checkbox*>(Grid()->GetSample(ButtonKind::kCheckbox, ShownState::kNormal))
                   ->IsChecked());
}

}  // namespace
}  // namespace norvik::gallery
