// The Layout page, rendered headless at two widths in both looks: the
// arrangement picks other placements at other widths and follows its
// switches, the message box's content stands where its layout puts it and
// draws its text and buttons, and every cell of the grid view gets its border.
#include <algorithm>
#include <filesystem>
#include <set>
#include <tuple>

#include "LayoutPageView.h"
#include "GalleryWindowFixture.h"

namespace norvik::gallery {
namespace {

using RectL = ui::UI_Node::RectL;

class LayoutPageLooks : public testing::GalleryWindowFixture,
                        public ::testing::WithParamInterface<std::tuple<bool, long>> {
 protected:
  void TearDown() override {
    if (HasFailure() && window) {
      const std::filesystem::path dir = std::filesystem::path(NORVIK_TEST_OUTPUT_DIR) / "layout-page";
      std::filesystem::create_directories(dir);
      const std::string name = ::testing::UnitTest::GetInstance()->current_test_info()->name();
      system.WriteWindowPNG(window->GetHandle(),
                            (dir / (name.substr(0, name.find('/')) + "-" + std::to_string(std::get<1>(GetParam())) +
                                    (std::get<0>(GetParam()) ? "-light.png" : "-dark.png")))
                                .string());
    }
    GalleryWindowFixture::TearDown();
  }
  RectL On(const ui::UI_Node* inNode) {
    const ui::UI_Node::RectF r = inNode->UI_GetLocalRectF(false);
    return InWindow(inNode, RectL(0, 0, static_cast<long>(r.width), static_cast<long>(r.height)));
  }
  int Spread(const ui::HeadlessPixels& inPx, const RectL& inRect) {
    int lo = 255, hi = 0;
    for (long y = inRect.top; y < inRect.top + inRect.height; ++y)
      for (long x = inRect.left; x < inRect.left + inRect.width; ++x) {
        const int l = testing::Luma(inPx.At(static_cast<int>(x), static_cast<int>(y)));
        lo = std::min(lo, l);
        hi = std::max(hi, l);
      }
    return hi - lo;
  }
  // The distinct left and top edges of the arrangement's items, checking
  // that each is drawn.
  std::pair<std::set<long>, std::set<long>> ItemEdges(const ArrangementDemoView& inDemo) {
    const ui::HeadlessPixels px = Pixels();
    std::set<long> lefts, tops;
    for (const ui::UI_NodeP& item : inDemo.GetItems()) {
      const RectL r = On(item.get());
      EXPECT_GT(Spread(px, r), 20) << "each item is drawn";
      lefts.insert(r.left);
      tops.insert(r.top);
    }
    return {lefts, tops};
  }
};

TEST_P(LayoutPageLooks, TheArrangementPicksOtherPlacementsAtOtherWidthsAndFollowsItsSwitches) {
  const auto [light, width] = GetParam();
  const bool wide = width >= 1280;
  Open(light, width, 720);
  page->ShowPage(GalleryPageID::kLayout);
  ArrangementDemoView* demo = page->GetLayoutPage()->GetArrangementDemo();
  EXPECT_EQ(ItemEdges(*demo).second.size(), wide ? 1u : 2u) << "lines across: as few lines as the width allows";

  Click(demo->GetTypeGroup()->ChildGet(arrange::kGroupFlipping));
  auto [lefts, tops] = ItemEdges(*demo);
  EXPECT_EQ(tops.size(), wide ? 1u : 12u) << "row or column: a row where it fits, else a column";
  EXPECT_EQ(lefts.size(), wide ? 12u : 1u);

  ui::UI_ArrangementView* view = demo->GetArrangementView();
  ASSERT_EQ(view->SeparatorCount(), 11u) << "dividers show from the start";
  const ui::HeadlessPixels px = Pixels();
  for (std::size_t i = demo->GetItems().size(); i < view->ChildSize(); ++i)
    EXPECT_GT(Spread(px, On(view->ChildGet(i))), 15) << "separator " << i << " draws its line";
  Click(demo->GetSeparatorSwitch());
  EXPECT_EQ(view->ChildSize(), 12u) << "the switch takes the dividers away";

  Click(demo->GetCentreHorizontallySwitch());
  lefts = ItemEdges(*demo).first;
  if (wide)
    EXPECT_GT(*lefts.begin(), On(view).left + 6) << "the row stands in the middle";
  else
    EXPECT_GT(lefts.size(), 1u) << "items of different widths are centred in the column";
}

TEST_P(LayoutPageLooks, TheMessageBoxAndTheGridDrawWhereTheirLayoutsPutThem) {
  const auto [light, width] = GetParam();
  Open(light, width, 720);
  page->ShowPage(GalleryPageID::kLayout);
  const ui::HeadlessPixels px = Pixels();
  LayoutPageView* layoutPage = page->GetLayoutPage();
  MessagePanelView* panel = layoutPage->GetMessagePanel();
  const RectL panelRect = On(panel), message = On(panel->GetMessage());
  EXPECT_GT(Spread(px, message), 60) << "the message's text is drawn";
  EXPECT_GT(message.height, 20) << "the message wraps onto several lines";
  // The last button ends at the panel's right margin, the first starts at its left.
  const ui::UI_Node* save = panel->ChildGet(panel->ChildSize() - 1);
  EXPECT_EQ(On(save).left + On(save).width, panelRect.left + panelRect.width - 16);
  EXPECT_GT(Spread(px, On(save)), 20) << "the button is drawn";

  const layout::UI_GridView* grid = layoutPage->GetGridView();
  const RectL gridRect = On(grid);
  for (unsigned long row = 0; row < 4; ++row)
    for (unsigned long column = 0; column < 3; ++column) {
      const ui::UI_Node::RectF cell = grid->GetGrid()->GetCell(row, column)->GetLocalRectF();
      const int x = static_cast<int>(gridRect.left + cell.left), y = static_cast<int>(gridRect.top + cell.top);
      EXPECT_GT(std::abs(testing::Luma(px.At(x, y + 3)) - testing::Luma(px.At(x + 2, y + 3))), 15)
          << "the left border of cell " << row << "," << column;
    }
  // Wide pages put the grid beside the message box, narrow ones below it.
  EXPECT_EQ(gridRect.top > panelRect.top + panelRect.height, width < LayoutPageView::kSideBySideWidth);
}

INSTANTIATE_TEST_SUITE_P(WidthsAndLooks, LayoutPageLooks,
                         ::testing::Combine(::testing::Bool(), ::testing::Values(800L, 1280L)));

}  // namespace
}  // namespace norvik::gallery
