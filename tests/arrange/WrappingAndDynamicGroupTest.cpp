#include <memory>

#include <gtest/gtest.h>

#include "arrange/DynamicGroup.h"
#include "support/arrange/ArrangeTestDoubles.h"

namespace norvik::arrange {
namespace {

using test::LeafSizes;
using test::RecordingLeaf;

LeafSizes Leaf(float inWidth, float inHeight, bool inWide = false, bool inTall = false) {
  LeafSizes sizes;
  sizes.naturalWidth = inWidth;
  sizes.naturalHeight = inHeight;
  sizes.expandsHorizontally = inWide;
  sizes.expandsVertically = inTall;
  return sizes;
}

TEST(Wrapping, ThreeChildrenTakeOneLineWhenWideAndAsManyLinesAsNeededWhenNarrow) {
  struct Case {
    float width, height;
    PointF second, third;
  } cases[] = {
      {100, 10, {10, 0}, {20, 0}},
      {25, 20, {10, 0}, {0, 10}},
      {10, 30, {0, 10}, {0, 20}},
  };
  for (const Case& c : cases) {
    WithChildren<HorizontalWrapping> wrapping;
    RecordingLeaf a, b, d;
    for (RecordingLeaf* leaf : {&a, &b, &d}) wrapping.AddChild(*leaf);
    EXPECT_EQ(wrapping.Arrangements().size(), 4u) << "every cut of three children is distinct";
    wrapping.Arrange(RectF(0, 0, c.width, c.height));
    EXPECT_EQ(PointF(b.placed.back().left, b.placed.back().top), c.second) << c.width;
    EXPECT_EQ(PointF(d.placed.back().left, d.placed.back().top), c.third) << c.width;
  }
}

TEST(Flipping, PicksRowOrColumnByWasteWhenBothFitAndByOverflowWhenNeitherDoes) {
  struct Case {
    const char* name;
    LeafSizes first, second;
    RectF box;
    bool column;
  } cases[] = {
      {"wide box, the row wastes less", Leaf(10, 10, true, true), Leaf(10, 10), {0, 0, 100, 20}, false},
      {"tall box, the column wastes less", Leaf(10, 10, true, true), Leaf(10, 10), {0, 0, 20, 100}, true},
      {"too small, the row overflows less", Leaf(10, 10), Leaf(30, 5), {0, 0, 25, 12}, false},
      {"too small, the column overflows less", Leaf(10, 10), Leaf(30, 5), {0, 0, 12, 25}, true},
  };
  for (const Case& c : cases) {
    WithChildren<Flipping> flipping;
    RecordingLeaf a(c.first), b(c.second);
    flipping.AddChild(a);
    flipping.AddChild(b);
    flipping.Arrange(c.box);
    EXPECT_EQ(b.placed.back().left == 0, c.column) << c.name;
  }
}

class ListedDynamicGroup : public DefaultGroup<DynamicGroup> {
 public:
  using DefaultGroup::DefaultGroup;
  void Add(IArrangeable& inChild) {
    children.push_back(&inChild);
    inChild.SetParent(&Arrangeable());
    Invalidate();
  }
  bool VisitChildren(boost::function<bool(IArrangeable&)> inVisitor) override {
    for (IArrangeable* child : children)
      if (!inVisitor(*child)) return false;
    return true;
  }
  std::vector<IArrangeable*> children;
};

TEST(DynamicGroup, ATypeChangeKeepsChildrenAndMarginsAndPlacesAgain) {
  ListedDynamicGroup group(nullptr, kGroupRow);
  RecordingLeaf a, b;
  group.Add(a);
  group.Add(b);
  group.SetLeftMargin(5);
  group.SetVerticalSpacing(2);
  group.Arrange(RectF(0, 0, 100, 100));
  EXPECT_EQ(b.placed.back(), RectF(15, 0, 10, 10));
  group.SetArrangementType(kGroupColumn);
  EXPECT_EQ(group.ArrangementType(), kGroupColumn);
  EXPECT_EQ(a.Parent(), &group.Arrangeable());
  EXPECT_EQ(a.placed.back(), RectF(5, 0, 10, 10));
  EXPECT_EQ(b.placed.back(), RectF(5, 12, 10, 10));
  const std::size_t placements = b.placed.size();
  group.SetLeftMargin(5);
  EXPECT_EQ(b.placed.size(), placements) << "an unchanged value does not invalidate";
  for (int type = kGroupRow; type <= kGroupAutoLayout; ++type) {
    group.SetArrangementType(static_cast<GroupArrangementType>(type));
    EXPECT_EQ(a.placed.back().left, 5.0f) << type;
    EXPECT_FALSE(group.Arrangeable().Arrangements().empty()) << type;
  }
}

}  // namespace
}  // namespace norvik::arrange
