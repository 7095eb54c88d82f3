#pragma once
// The toolkit's pictures for the gallery's buttons: the node manager reads
// named images through a resource manager and keeps them in its image cache.
// A manager without a cache gets the resources compiled into the library,
// a cache, and the platform's drawing supplier to decode them with.
#include "ui/UI_NodeManager.h"

namespace norvik::gallery {

void ProvideImageResources(ui::UI_NodeManager& ioManager);

}  // namespace norvik::gallery
