#include "ui/UI_Composite.h"

namespace norvik::ui {

namespace {

halvorn::layout_attributes_t RootAttributes(halvorn::layout_attributes_placement_t::placement_t inPlacement) {
  halvorn::layout_attributes_t a;
  a.placement = inPlacement;
  a.alignment[0] = a.alignment[1] = halvorn::align_fill;
  a.spacing[1] = 10;
  return a;
}

}  // namespace

// Lets a child node take part in the layout through its own measure and place.
// It holds the node, so an item never outlives the node it places, even after
// the node was removed from the composite by other code.
class UI_Composite::NodePlaceable : public halvorn::poly_placeable_interface {
 public:
  explicit NodePlaceable(const UI_NodeP& inNode) : mNode(inNode) {}
  void measure(halvorn::extents_t& outExtents) override { mNode->measure(outExtents); }
  void measure_vertical(halvorn::extents_t& ioExtents, const halvorn::place_data_t& inPlace) override {
    mNode->measure_vertical(ioExtents, inPlace);
  }
  void place(const halvorn::place_data_t& inPlace) override { mNode->place(inPlace); }

 private:
  UI_NodeP mNode;
};

UI_Composite::UI_Composite(halvorn::layout_attributes_placement_t::placement_t inPlacement)
    : mLayout(RootAttributes(inPlacement)) {}

UI_Composite::~UI_Composite() = default;

void UI_Composite::measure(halvorn::extents_t& outExtents) {
  const halvorn::extents_t& root = mLayout.measure();
  for (int s = 0; s < 2; ++s) {
    outExtents.slice[s].length = root.slice[s].length;
    outExtents.slice[s].frame = root.slice[s].frame;
    outExtents.slice[s].guides = root.slice[s].guides;
  }
}

void UI_Composite::measure_vertical(halvorn::extents_t& ioExtents, const halvorn::place_data_t&) {
  const halvorn::extents_t& root = mLayout.measure();
  ioExtents.vertical().length = root.vertical().length;
  ioExtents.vertical().frame = root.vertical().frame;
  ioExtents.vertical().guides = root.vertical().guides;
}

void UI_Composite::place(const halvorn::place_data_t& inPlace) {
  UI_NodeProtector protect(this);
  UI_Node::place(inPlace);
  const RectF local = UI_GetLocalRectF(false);
  halvorn::place_data_t inside;
  inside.horizontal().length = local.width;
  inside.vertical().length = local.height;
  mLayout.place(inside);
}

UI_Composite::iterator UI_Composite::AddItem(halvorn::poly_placeable_interface* inPlaceable, iterator inParent,
                                             const halvorn::layout_attributes_t& inAttributes) {
  return mLayout.add_placeable(inParent, inPlaceable, inAttributes);
}

UI_Composite::iterator UI_Composite::AddChildNode(const UI_NodeP& inNode,
                                                  const halvorn::layout_attributes_t& inAttributes) {
  ChildPushBack(inNode);
  mNodeItems.push_back(std::make_unique<NodePlaceable>(inNode));
  return mLayout.add_placeable(mLayout.root(), mNodeItems.back().get(), inAttributes);
}

UI_Composite::iterator UI_Composite::AddContainer(iterator inParent,
                                                  const halvorn::layout_attributes_t& inAttributes) {
  return mLayout.add_container(inParent, inAttributes);
}

void UI_Composite::set_visible(iterator inItem, bool inVisible) { mLayout.set_visible(inItem, inVisible); }

}  // namespace norvik::ui
