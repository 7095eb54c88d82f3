// The composite's constraint layout: measuring rows and columns with their
// spacing, placing items by alignment, hidden items, and the adapter registry
// tags that accompany archived nodes.
#include <gtest/gtest.h>

#include "support/ui/NodeTestSupport.h"
#include "tarsel/ThrowError.h"
#include "ui/UI_Composite.h"
#include "ui/UI_NodeAdapterBase.h"
#include "ui/UI_NodeTag.h"

namespace norvik::ui::test {
namespace {

using RectF = tarsel::geom::RectT<float>;
using halvorn::layout_attributes_placement_t;

// A view with a fixed natural size.
class SizedView : public UI_SubView {
 public:
  SizedView(float inWidth, float inHeight) : mWidth(inWidth), mHeight(inHeight) {}
  void measure(halvorn::extents_t& outExtents) override {
    outExtents.horizontal().length = mWidth;
    outExtents.vertical().length = mHeight;
  }
  void measure_vertical(halvorn::extents_t& ioExtents, const halvorn::place_data_t&) override {
    ioExtents.vertical().length = mHeight;
  }

 private:
  float mWidth, mHeight;
};

UI_NodeP Sized(float inWidth, float inHeight) { return UI_NodeP(new SizedView(inWidth, inHeight)); }

halvorn::place_data_t PlaceAt(float inX, float inY, float inW, float inH) {
  halvorn::place_data_t p;
  p.horizontal().position = inX;
  p.horizontal().length = inW;
  p.vertical().position = inY;
  p.vertical().length = inH;
  return p;
}

using CompositeLayout = ManagerTest;

TEST_F(CompositeLayout, AColumnStacksItsItemsAndHiddenItemsTakeNoRoom) {
  boost::intrusive_ptr<UI_Composite> column(new UI_Composite(layout_attributes_placement_t::placement_column));
  column->AddChildNode(Sized(30, 10));
  auto hidden = column->AddChildNode(Sized(50, 50));
  column->AddChildNode(Sized(20, 15));
  column->set_visible(hidden, false);
  halvorn::extents_t e;
  column->measure(e);
  EXPECT_EQ(e.horizontal().length, 30);
  EXPECT_EQ(e.vertical().length, 10 + 10 + 15);
}

TEST_F(CompositeLayout, ARowMeasuresItsItemsWithTenBetweenAndPlacesThemInsideItsRectangle) {
  boost::intrusive_ptr<UI_Composite> row(new UI_Composite(layout_attributes_placement_t::placement_row));
  auto a = Sized(30, 10);
  auto b = Sized(20, 25);
  row->AddChildNode(a);
  row->AddChildNode(b);
  row->AddChildNode(Sized(5, 5));
  halvorn::extents_t e;
  row->measure(e);
  EXPECT_EQ(e.horizontal().length, 30 + 10 + 20 + 10 + 5);
  EXPECT_EQ(e.vertical().length, 25);
  row->place(PlaceAt(100, 200, 75, 25));
  EXPECT_EQ(row->UI_GetLocalRectF(true), RectF(100, 200, 75, 25));
  EXPECT_EQ(a->UI_GetLocalRectF(true), RectF(0, 0, 30, 10));
  EXPECT_EQ(b->UI_GetLocalRectF(true), RectF(40, 0, 20, 25));
  EXPECT_EQ(row->get_placement().horizontal().position, 100);
}

TEST_F(CompositeLayout, CrossAxisAlignmentPutsItemsAtTheStartCentreEndOrAcross) {
  boost::intrusive_ptr<UI_Composite> row(new UI_Composite(layout_attributes_placement_t::placement_row));
  std::vector<UI_NodeP> items;
  for (halvorn::alignment_t a : {halvorn::align_forward, halvorn::align_center, halvorn::align_reverse,
                                 halvorn::align_fill}) {
    halvorn::layout_attributes_t attrs;
    attrs.alignment[1] = a;
    items.push_back(Sized(10, 10));
    row->AddChildNode(items.back(), attrs);
  }
  row->place(PlaceAt(0, 0, 100, 50));
  EXPECT_EQ(items[0]->UI_GetLocalRectF(true), RectF(0, 0, 10, 10));
  EXPECT_EQ(items[1]->UI_GetLocalRectF(true), RectF(20, 20, 10, 10));
  EXPECT_EQ(items[2]->UI_GetLocalRectF(true), RectF(40, 40, 10, 10));
  EXPECT_EQ(items[3]->UI_GetLocalRectF(true), RectF(60, 0, 10, 50));
}

TEST_F(CompositeLayout, SpareRoomAlongTheRowGoesToTheFillingItems) {
  boost::intrusive_ptr<UI_Composite> row(new UI_Composite(layout_attributes_placement_t::placement_row));
  auto fixed = Sized(20, 10);
  auto grow = Sized(10, 10);
  row->AddChildNode(fixed);
  halvorn::layout_attributes_t fill;
  fill.alignment[0] = halvorn::align_fill;
  row->AddChildNode(grow, fill);
  row->place(PlaceAt(0, 0, 100, 10));
  EXPECT_EQ(grow->UI_GetLocalRectF(true), RectF(30, 0, 70, 10));
}

TEST_F(CompositeLayout, OutsetsWidenThePlacedRectangle) {
  auto v = MakeView(0, 0, 1, 1);
  halvorn::place_data_t p = PlaceAt(10, 20, 30, 40);
  p.horizontal().outset_before = 2;
  p.horizontal().outset_after = 3;
  p.vertical().outset_before = 1;
  v->place(p);
  EXPECT_EQ(v->UI_GetLocalRectF(true), RectF(8, 19, 35, 41));
}

TEST_F(CompositeLayout, PlacementOfAnUnplacedViewComesFromItsRectangle) {
  auto v = MakeView(1.5f, 2.25f, 10, 5.5f);
  const halvorn::place_data_t& p = v->get_placement();
  EXPECT_EQ(p.horizontal().position, 1);
  EXPECT_EQ(p.horizontal().length, 11);  // ceil(11.5) - 1
  EXPECT_EQ(p.vertical().position, 2);
  EXPECT_EQ(p.vertical().length, 6);  // ceil(7.75) - 2
}

TEST_F(CompositeLayout, AViewThatDoesNotMeasureItselfSaysSo) {
  auto v = MakeView(0, 0, 1, 1);
  halvorn::extents_t e;
  try {
    v->measure(e);
    FAIL() << "expected an error";
  } catch (const tarsel::config::Exception& ex) {
    EXPECT_STREQ(ex.what(), "You must override UI_Node::measure");
  }
  try {
    v->measure_vertical(e, halvorn::place_data_t());
    FAIL() << "expected an error";
  } catch (const tarsel::config::Exception& ex) {
    EXPECT_STREQ(ex.what(), "You must override UI_Node::measure_vertical");
  }
}

// ---------------------------------------------------------------------------

TEST(NodeTags, ANodeIsRegisteredForExactlyTheTagsLifetime) {
  UI_NodeAdapterBase adapter(u"TestAdapterForTags", nullptr, true, true);
  EXPECT_EQ(UI_NodeAdapterBase::GetAdapterForName(u"TestAdapterForTags"), &adapter);
  UI_NodeP node(new UI_SubView);
  {
    UI_NodeTagP tag(new UI_NodeTag(node, &adapter, u"MyPanel"));
    EXPECT_EQ(UI_NodeAdapterBase::GetAdapterForNode(node.get()), &adapter);
    EXPECT_EQ(UI_NodeAdapterBase::GetClassNameForNode(node.get()), UTF16String(u"MyPanel"));
    tag->SetClassName(u"Renamed");
    EXPECT_EQ(UI_NodeAdapterBase::GetClassNameForNode(node.get()), UTF16String(u"Renamed"));
  }
  EXPECT_EQ(UI_NodeAdapterBase::GetAdapterForNode(node.get()), nullptr);
  EXPECT_TRUE(UI_NodeAdapterBase::GetClassNameForNode(node.get()).empty());
}

TEST(NodeTags, ALaterAdapterOfTheSameNameReplacesTheEarlierOne) {
  UI_NodeAdapterBase first(u"TestAdapterTwice", nullptr, false, false);
  {
    UI_NodeAdapterBase second(u"TestAdapterTwice", &first, true, false);
    EXPECT_EQ(UI_NodeAdapterBase::GetAdapterForName(u"TestAdapterTwice"), &second);
    EXPECT_EQ(second.GetBaseAdapter(), &first);
  }
  EXPECT_EQ(UI_NodeAdapterBase::GetAdapterForName(u"TestAdapterTwice"), nullptr);
  EXPECT_EQ(UI_NodeAdapterBase::GetAdapterForName(u"NoSuchAdapter"), nullptr);
}

}  // namespace
}  // namespace norvik::ui::test
