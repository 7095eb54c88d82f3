// The Layout page, rendered headless at two widths in both looks: the
// message box's content stands where its layout puts it and draws its text
// and buttons, and every cell of the grid view gets its border.
#include <algorithm>
#include <filesystem>
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
      system.WriteWindowPNG(window->GetHandle(),
                            (dir / ("layout-" + std::to_string(std::get<1>(GetParam())) +
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
};

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
