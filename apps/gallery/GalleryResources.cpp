#include "GalleryResources.h"

#include <memory>

#include "drawbot/SupplierInterface.h"
#include "ui/DrawbotImageResourceCache.h"
#include "utility/OS_ResourceManager.h"

namespace norvik::gallery {

void ProvideImageResources(ui::UI_NodeManager& ioManager) {
  if (!ioManager.GetDrawbotImageResourceCache()) {
    ioManager.SetResourceManager(std::make_unique<utility::OS_ResourceManager>());
    ioManager.SetDrawbotImageResourceCache(std::make_unique<ui::DrawbotImageResourceCache>());
  }
  // The platform supplier lives as long as the process: the manager shares
  // it without owning it.
  if (!ioManager.GetOSDrawSupplier())
    ioManager.SetOSDrawSupplier(std::shared_ptr<drawbot::SupplierInterface>(drawbot::NewOSSupplier(), [](auto*) {}));
}

}  // namespace norvik::gallery
