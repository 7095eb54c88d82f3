#include "ui/ConstraintLayout.h"

#include <algorithm>
#include <stdexcept>

namespace halvorn {

namespace {

float outer_length(const extents_t::slice_t& inSlice) {
  return inSlice.length + inSlice.frame.first + inSlice.frame.second;
}

// The slice along which a container lines its children up, or -1 for none.
int main_slice(layout_attributes_placement_t::placement_t inPlacement) {
  switch (inPlacement) {
    case layout_attributes_placement_t::placement_row: return 0;
    case layout_attributes_placement_t::placement_column: return 1;
    default: return -1;
  }
}

}  // namespace

layout_t::layout_t(const layout_attributes_t& inRoot) {
  items_.emplace_back();
  items_.back().attributes = inRoot;
}

layout_t::item_id layout_t::add_container(item_id inParent, const layout_attributes_t& inAttributes) {
  if (inParent >= items_.size()) throw std::out_of_range("layout_t: no such container");
  items_.emplace_back();
  items_.back().parent = inParent;
  items_.back().attributes = inAttributes;
  const item_id id = items_.size() - 1;
  items_[inParent].children.push_back(id);
  measured_ = false;
  return id;
}

layout_t::item_id layout_t::add_placeable(item_id inParent, poly_placeable_interface* inPlaceable,
                                          const layout_attributes_t& inAttributes) {
  const item_id id = add_container(inParent, inAttributes);
  items_[id].attributes.placement = layout_attributes_placement_t::placement_leaf;
  items_[id].placeable = inPlaceable;
  return id;
}

void layout_t::set_visible(item_id inItem, bool inVisible) {
  items_.at(inItem).visible = inVisible;
  measured_ = false;
}

std::vector<layout_t::item_id> layout_t::visible_children(const item_t& inItem) const {
  std::vector<item_id> out;
  for (item_id c : inItem.children) {
    if (items_[c].visible) out.push_back(c);
  }
  return out;
}

alignment_t layout_t::alignment_of(const item_t& inChild, const item_t& inParent, int inSlice) const {
  alignment_t a = inChild.attributes.alignment[inSlice];
  return a == align_default ? inParent.attributes.child_alignment[inSlice] : a;
}

const extents_t& layout_t::measure() {
  measure_item(root());
  measured_ = true;
  return items_[root()].extents;
}

void layout_t::measure_item(item_id inItem) {
  item_t& item = items_[inItem];
  if (item.placeable) {
    item.extents = extents_t();
    item.placeable->measure(item.extents);
    return;
  }
  const std::vector<item_id> children = visible_children(item);
  for (item_id c : children) measure_item(c);
  const int along = main_slice(item.attributes.placement);
  const float margin = item.attributes.spacing[0], gap = item.attributes.spacing[1];
  extents_t extents;
  for (int s = 0; s < 2; ++s) {
    float length = 0;
    for (item_id c : children) {
      const float l = outer_length(items_[c].extents.slice[s]);
      length = s == along ? length + l : std::max(length, l);
    }
    if (s == along && children.size() > 1) length += gap * static_cast<float>(children.size() - 1);
    extents.slice[s].length = length + 2 * margin;
  }
  item.extents = extents;
}

void layout_t::place(const place_data_t& inPlace) {
  if (!measured_) measure();
  place_item(root(), inPlace);
}

void layout_t::place_children_along(const item_t& inItem, int inSlice, std::vector<place_data_t>& ioPlaces) const {
  const std::vector<item_id> children = visible_children(inItem);
  const auto& space = inItem.placement.slice[inSlice];
  const float margin = inItem.attributes.spacing[0], gap = inItem.attributes.spacing[1];
  float used = 0;
  std::size_t fillers = 0;
  for (item_id c : children) {
    used += outer_length(items_[c].extents.slice[inSlice]);
    if (alignment_of(items_[c], inItem, inSlice) == align_fill) ++fillers;
  }
  if (children.size() > 1) used += gap * static_cast<float>(children.size() - 1);
  const float spare = std::max(0.f, space.length - 2 * margin - used);
  // Spare room goes to the filling children; without any, the alignment of
  // the first child moves the whole run.
  const float share = fillers ? spare / static_cast<float>(fillers) : 0;
  float pos = space.position + margin;
  if (!fillers && !children.empty()) {
    alignment_t a = alignment_of(items_[children.front()], inItem, inSlice);
    if (a == align_reverse) pos += spare;
    if (a == align_center) pos += spare / 2;
  }
  for (std::size_t i = 0; i < children.size(); ++i) {
    const auto& e = items_[children[i]].extents.slice[inSlice];
    float length = e.length;
    if (alignment_of(items_[children[i]], inItem, inSlice) == align_fill) length += share;
    auto& slot = ioPlaces[i].slice[inSlice];
    slot.position = pos + e.frame.first;
    slot.length = length;
    slot.guides = e.guides;
    pos += length + e.frame.first + e.frame.second + gap;
  }
}

void layout_t::place_children_across(const item_t& inItem, int inSlice, std::vector<place_data_t>& ioPlaces) const {
  const std::vector<item_id> children = visible_children(inItem);
  const auto& space = inItem.placement.slice[inSlice];
  const float margin = inItem.attributes.spacing[0];
  const float start = space.position + margin;
  const float avail = std::max(0.f, space.length - 2 * margin);
  for (std::size_t i = 0; i < children.size(); ++i) {
    const auto& e = items_[children[i]].extents.slice[inSlice];
    const float inner = std::max(0.f, avail - e.frame.first - e.frame.second);
    auto& slot = ioPlaces[i].slice[inSlice];
    slot.length = e.length;
    slot.guides = e.guides;
    switch (alignment_of(items_[children[i]], inItem, inSlice)) {
      case align_fill: slot.length = inner; slot.position = start + e.frame.first; break;
      case align_reverse: slot.position = start + avail - e.frame.second - e.length; break;
      case align_center: slot.position = start + e.frame.first + (inner - e.length) / 2; break;
      default: slot.position = start + e.frame.first; break;
    }
  }
}

void layout_t::place_item(item_id inItem, const place_data_t& inPlace) {
  item_t& item = items_[inItem];
  item.placement = inPlace;
  if (item.placeable) {
    item.placeable->place(inPlace);
    return;
  }
  const std::vector<item_id> children = visible_children(item);
  std::vector<place_data_t> places(children.size());
  const int along = main_slice(item.attributes.placement);
  for (int s = 0; s < 2; ++s) {
    if (s == along) {
      place_children_along(item, s, places);
    } else {
      place_children_across(item, s, places);
    }
  }
  for (std::size_t i = 0; i < children.size(); ++i) place_item(children[i], places[i]);
}

}  // namespace halvorn
