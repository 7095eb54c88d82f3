#pragma once
// A small constraint layout: a tree of items, each either a container that
// arranges its visible children in a row, a column or on top of each other,
// or a leaf bound to a placeable. Layout runs in two passes: measure computes
// every item's extents bottom-up; place hands every item its rectangle
// top-down. Both passes are pure functions of the measured sizes, so a
// layout can be checked without a window.
#include <cstddef>
#include <vector>

#include "ui/Placeable.h"

namespace halvorn {

struct layout_attributes_t {
  layout_attributes_placement_t::placement_t placement = layout_attributes_placement_t::placement_leaf;
  // Where this item sits in the space its container gives it, per slice.
  alignment_t alignment[2] = {align_default, align_default};
  // What align_default means for this container's children.
  alignment_t child_alignment[2] = {align_forward, align_forward};
  // [0]: margin between this container's edges and its children;
  // [1]: gap between consecutive children.
  float spacing[2] = {0, 0};
};

class layout_t {
 public:
  using item_id = std::size_t;

  explicit layout_t(const layout_attributes_t& inRoot);

  item_id root() const { return 0; }
  item_id add_container(item_id inParent, const layout_attributes_t& inAttributes);
  item_id add_placeable(item_id inParent, poly_placeable_interface* inPlaceable,
                        const layout_attributes_t& inAttributes = layout_attributes_t());
  void set_visible(item_id inItem, bool inVisible);
  bool is_visible(item_id inItem) const { return items_.at(inItem).visible; }
  layout_attributes_t& attributes(item_id inItem) { return items_.at(inItem).attributes; }

  // The measuring pass; answers the root's extents.
  const extents_t& measure();
  // The placing pass, with the root given inPlace. Measures first if needed.
  void place(const place_data_t& inPlace);
  const place_data_t& placement_of(item_id inItem) const { return items_.at(inItem).placement; }
  const extents_t& extents_of(item_id inItem) const { return items_.at(inItem).extents; }

 private:
  struct item_t {
    item_id parent = 0;
    std::vector<item_id> children;
    layout_attributes_t attributes;
    poly_placeable_interface* placeable = nullptr;
    bool visible = true;
    extents_t extents;
    place_data_t placement;
  };

  void measure_item(item_id inItem);
  void place_item(item_id inItem, const place_data_t& inPlace);
  void place_children_along(const item_t& inItem, int inSlice, std::vector<place_data_t>& ioPlaces) const;
  void place_children_across(const item_t& inItem, int inSlice, std::vector<place_data_t>& ioPlaces) const;
  std::vector<item_id> visible_children(const item_t& inItem) const;
  alignment_t alignment_of(const item_t& inChild, const item_t& inParent, int inSlice) const;

  std::vector<item_t> items_;
  bool measured_ = false;
};

}  // namespace halvorn
