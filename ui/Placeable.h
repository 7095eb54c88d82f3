#pragma once
// The placeable contract between a node and a constraint layout. A layout asks
// each item for its extents (measure), decides where it goes, and hands it a
// place_data_t (place). Slice 0 is horizontal, slice 1 vertical.
#include <utility>
#include <vector>

namespace halvorn {

using guide_set_t = std::vector<float>;

struct place_data_t {
  struct slice_t {
    float length = 0;
    float position = 0;
    float outset_before = 0;  // the item may draw this far before its position
    float outset_after = 0;   // and this far after its far edge
    guide_set_t guides;
  };
  slice_t slice[2];

  slice_t& horizontal() { return slice[0]; }
  slice_t& vertical() { return slice[1]; }
  const slice_t& horizontal() const { return slice[0]; }
  const slice_t& vertical() const { return slice[1]; }
};

struct extents_t {
  struct slice_t {
    float length = 0;
    std::pair<float, float> frame{0, 0};  // space taken outside the item, before and after
    std::pair<float, float> inset{0, 0};  // space kept free inside the item, before and after
    guide_set_t guides;
  };
  slice_t slice[2];

  slice_t& horizontal() { return slice[0]; }
  slice_t& vertical() { return slice[1]; }
  const slice_t& horizontal() const { return slice[0]; }
  const slice_t& vertical() const { return slice[1]; }
};

// What a layout needs of an item.
class poly_placeable_interface {
 public:
  virtual ~poly_placeable_interface() = default;
  virtual void measure(extents_t& outExtents) = 0;
  virtual void measure_vertical(extents_t& ioExtents, const place_data_t& inPlace) = 0;
  virtual void place(const place_data_t& inPlace) = 0;
};

struct layout_attributes_placement_t {
  // How a container arranges its items: side by side, one above the other, or
  // all on top of each other.
  enum placement_t { placement_leaf = 0, placement_row = 1, placement_column = 2, placement_overlay = 3 };
};

// Where an item sits in the space its container gives it, per slice.
enum alignment_t {
  align_forward = 1,   // at the start (left or top)
  align_reverse = 2,   // at the end (right or bottom)
  align_center = 3,
  align_fill = 4,      // stretched over the whole space
  align_default = 6    // whatever the container's child alignment says
};

}  // namespace halvorn
