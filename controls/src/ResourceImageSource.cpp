#include "controls/ResourceImageSource.h"

#include "ui/DrawbotImageResourceCache.h"
#include "ui/UI_NodeManager.h"

namespace norvik::controls {

void ResourceImageSource::SetResourceManagerImageCache(ui::ResourceManager* inResources,
                                                       ui::DrawbotImageResourceCache* inCache) {
  mResources = inResources;
  mCache = inCache;
}

void ResourceImageSource::BindResourceManager(ui::ResourceManager* inResources) { mResources = inResources; }

const drawbot::ImageInterface* ResourceImageSource::LoadImage(const UTF8String& inName,
                                                              const drawbot::SupplierInterface* inSupplier) const {
  if (inName.empty() || !inSupplier) return nullptr;
  const ui::UI_NodeManager* manager = ui::UI_NodeManager::GetConst();
  ui::DrawbotImageResourceCache* cache = mCache ? mCache : manager ? manager->GetDrawbotImageResourceCache() : nullptr;
  const ui::ResourceManager* resources = mResources ? mResources : manager ? &manager->GetResourceManager() : nullptr;
  if (!cache) return nullptr;
  return cache->GetImage(resources, inSupplier, inName, drawbot::kImageFileTypePNG).get();
}

}  // namespace norvik::controls
