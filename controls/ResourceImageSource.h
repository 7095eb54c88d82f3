#pragma once
// Where a control reads its resource images: the node manager's resource
// reader and image cache, unless the control is bound to another pair (an
// application with its own pictures beside the toolkit's).
#include "drawbot/DrawbotTypes.h"
#include "tarsel/UTFString.h"

namespace norvik::drawbot {
class ImageInterface;
class SupplierInterface;
}  // namespace norvik::drawbot

namespace norvik::ui {
class DrawbotImageResourceCache;
class ResourceManager;
}  // namespace norvik::ui

namespace norvik::controls {

class ResourceImageSource {
 public:
  // Reads through inResources into inCache; null for either means the manager's.
  void SetResourceManagerImageCache(ui::ResourceManager* inResources, ui::DrawbotImageResourceCache* inCache);
  // Reads through inResources into the cache already bound, or the manager's.
  void BindResourceManager(ui::ResourceManager* inResources);

  // The image of that name decoded for inSupplier and cached. An empty name
  // gives null; a name the resources lack raises the resource error.
  const drawbot::ImageInterface* LoadImage(const UTF8String& inName,
                                           const drawbot::SupplierInterface* inSupplier) const;

 private:
  ui::ResourceManager* mResources = nullptr;
  ui::DrawbotImageResourceCache* mCache = nullptr;
};

}  // namespace norvik::controls
