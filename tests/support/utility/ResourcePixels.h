#pragma once
// The pixels of a picture from a resource manager, decoded and drawn the
// ordinary way, for comparing with what a cursor or a control shows.
#include "support/drawbot/PixelCompare.h"
#include "tarsel/UTFString.h"
#include "ui/ResourceManager.h"

namespace norvik::utility::testing {

// Reads the "png" resource inName and draws it at its own size on a canvas.
drawbot::testing::PixelImage DecodedResourcePNG(const ui::ResourceManager& inResources, const tarsel::UTF16String& inName);

}  // namespace norvik::utility::testing
