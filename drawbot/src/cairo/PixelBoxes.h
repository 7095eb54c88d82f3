#pragma once
// Opaque fills of whole device pixels written straight into an image
// surface's memory, for the common case of an axis-aligned rectangle on whole
// pixels inside a clip made of a few whole-pixel rectangles. The pixels are
// the ones Cairo's own fill gives; everything else goes through Cairo.
#include <cairo.h>

#include "drawbot/DrawbotTypes.h"

namespace norvik::drawbot::cairo {

// The clip of one surface state as whole device-pixel boxes, when it is known
// to be such (count >= 0); count -1 means any other shape.
struct ClipBoxes {
  static constexpr int kMaxBoxes = 4;
  struct Box {
    int left, top, right, bottom;
  };
  int count = -1;
  Box boxes[kMaxBoxes];

  // The whole of an image surface, or unknown for any other target.
  static ClipBoxes ForTarget(cairo_surface_t* inTarget);
  // Narrows to a region's rectangles (unknown when there are too many).
  void IntersectRegion(const cairo_region_t* inRegion);
  // Narrows to one device box; the box of a clip path that is not one goes unknown.
  void Intersect(const Box& inBox);
};

// The device box of a user-space rectangle when the context's matrix keeps it
// axis-aligned on whole device pixels.
bool DeviceBoxOf(cairo_t* inContext, double inX, double inY, double inW, double inH, ClipBoxes::Box* outBox);

// Fills inBox within the clip with an opaque colour, as an OVER fill through
// Cairo would; false (and nothing written) when the target does not allow it.
bool FillOpaqueBox(cairo_surface_t* inTarget, const ClipBoxes& inClip, const ClipBoxes::Box& inBox,
                   ColorRGBA const& inColor);

}  // namespace norvik::drawbot::cairo
