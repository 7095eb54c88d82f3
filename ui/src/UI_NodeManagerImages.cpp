// The node manager's image lookup: the one process-wide cache of decoded
// resource images, fed by the manager's resource reader.
#include "tarsel/Contract.h"
#include "ui/UI_NodeManager.h"

namespace norvik::ui {

const drawbot::ImageInterface* UI_NodeManager::GetImage(const drawbot::SupplierInterface* inSupplier,
                                                        const UTF8String& inName,
                                                        drawbot::ImageFileType inFileType) const {
  NRK_CONTRACT(mImageCache != nullptr);
  // The cache keeps the image alive, so a bare pointer is safe to hand out.
  return mImageCache->GetImage(&GetResourceManager(), inSupplier, inName, inFileType).get();
}

}  // namespace norvik::ui
