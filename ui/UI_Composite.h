#pragma once
// UI_Composite is a view that arranges placeable items, usually its child
// nodes, with a constraint layout. Its root container fills the composite in
// both slices and keeps 10 units between consecutive items.
#include <memory>
#include <vector>

#include "ui/ConstraintLayout.h"
#include "ui/UI_SubView.h"

namespace norvik::ui {

class UI_Composite : public UI_SubView {
 public:
  using iterator = halvorn::layout_t::item_id;

  explicit UI_Composite(halvorn::layout_attributes_placement_t::placement_t inPlacement);
  ~UI_Composite() override;

  // Runs the measuring pass and reports the root's extents.
  void measure(halvorn::extents_t& outExtents) override;
  void measure_vertical(halvorn::extents_t& ioExtents, const halvorn::place_data_t& inPlace) override;
  // Takes the placement, then lays the items out inside the new rectangle.
  void place(const halvorn::place_data_t& inPlace) override;

  // An item for any placeable; the composite does not own it.
  iterator AddItem(halvorn::poly_placeable_interface* inPlaceable, iterator inParent,
                   const halvorn::layout_attributes_t& inAttributes = halvorn::layout_attributes_t());
  // Adds inNode as a child and as a layout item that measures and places it.
  iterator AddChildNode(const UI_NodeP& inNode,
                        const halvorn::layout_attributes_t& inAttributes = halvorn::layout_attributes_t());
  iterator AddContainer(iterator inParent, const halvorn::layout_attributes_t& inAttributes);
  iterator Root() const { return mLayout.root(); }
  void set_visible(iterator inItem, bool inVisible);
  halvorn::layout_t& GetLayout() { return mLayout; }

 private:
  class NodePlaceable;

  halvorn::layout_t mLayout;
  std::vector<std::unique_ptr<NodePlaceable>> mNodeItems;
};

}  // namespace norvik::ui
