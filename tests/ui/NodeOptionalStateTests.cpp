// The optional state of a node (tool tip, custom functions, callback lists,
// timer keys, placement): a node that never set any reads as empty, and each
// piece set later is kept apart from the others and survives the rest being
// cleared.
#include <gtest/gtest.h>

#include <boost/make_shared.hpp>

#include "support/ui/NodeTestSupport.h"

namespace norvik::ui::test {
namespace {

using RectF = tarsel::geom::RectT<float>;

using NodeOptionalState = ManagerTest;

TEST_F(NodeOptionalState, ABareNodeReadsEverythingAsUnset) {
  auto v = MakeView(0, 0, 10, 10);
  const UI_Node& node = *v;
  EXPECT_TRUE(node.UI_GetToolTip().empty());
  EXPECT_EQ(node.UI_GetToolTipWidth(), 0);
  EXPECT_FALSE(node.UI_GetCustomDrawFunction());
  EXPECT_FALSE(node.UI_GetCustomMouseEventFunction());
  EXPECT_FALSE(node.UI_GetCustomPreMouseEventFunction());
  EXPECT_FALSE(node.UI_GetCustomKeyboardEventFunction());
  EXPECT_FALSE(node.UI_GetCustomDoCursorFunction());
  EXPECT_TRUE(node.UI_GetTimerIDs().empty());
  // Nothing to call: the notifications are no-ops and no timer is answered.
  v->UI_SizeChanged(RectF(0, 0, 10, 10));
  v->UI_DisabledStateChanged();
  EXPECT_FALSE(v->UI_DoTimerNotify(1));
  // Clearing what was never set keeps it unset.
  v->UI_SetCustomMouseEventFunction(nullptr);
  EXPECT_FALSE(node.UI_GetCustomMouseEventFunction());
}

TEST_F(NodeOptionalState, AStoredPlacementIsAnsweredUntilTheNextPlace) {
  auto v = MakeView(0, 0, 10, 10);
  halvorn::place_data_t p;
  p.horizontal().position = 5;
  p.horizontal().length = 30;
  p.horizontal().outset_before = 2;
  p.vertical().position = 7;
  p.vertical().length = 40;
  v->place(p);
  // The view's rectangle includes the outsets; the placement keeps what was given.
  v->UI_SetLocalRectF(RectF(100, 100, 1, 1));
  const halvorn::place_data_t& got = v->get_placement();
  EXPECT_EQ(got.horizontal().position, 5);
  EXPECT_EQ(got.horizontal().length, 30);
  EXPECT_EQ(got.horizontal().outset_before, 2);
  EXPECT_EQ(got.vertical().position, 7);
  EXPECT_EQ(got.vertical().length, 40);
}

}  // namespace
}  // namespace norvik::ui::test
