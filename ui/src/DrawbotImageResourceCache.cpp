#include "ui/DrawbotImageResourceCache.h"

#include <tuple>
#include <typeinfo>
#include <vector>

#include "drawbot/DrawbotWrappers.h"
#include "drawbot/SupplierInterface.h"
#include "tarsel/ThrowError.h"
#include "ui/ResourceManager.h"

namespace norvik::ui {

bool DrawbotImageResourceCacheKey::operator<(DrawbotImageResourceCacheKey const& inOther) const {
  return std::tie(supplierType, name, fileType) < std::tie(inOther.supplierType, inOther.name, inOther.fileType);
}

DrawbotImageResourceCacheKey DrawbotImageResourceCache::MakeKey(drawbot::SupplierInterface const* inSupplier,
                                                                UTF8String const& inName,
                                                                drawbot::ImageFileType inFileType) {
  // A null supplier gets a key of its own; GetImage refuses to decode for it.
  std::type_index type = inSupplier ? std::type_index(typeid(*inSupplier)) : std::type_index(typeid(void));
  return DrawbotImageResourceCacheKey{type, inName, inFileType};
}

UTF16String DrawbotImageResourceCache::GetResourceTypeName(drawbot::ImageFileType inFileType) {
  switch (inFileType) {
    case drawbot::kImageFileTypeJPG:
      return u"jpg";
    case drawbot::kImageFileTypePNG:
      return u"png";
  }
  return UTF16String();
}

DrawbotImageResourceCache::ImageP DrawbotImageResourceCache::GetImage(ResourceManager const* inResources,
                                                                      drawbot::SupplierInterface const* inSupplier,
                                                                      UTF8String const& inName,
                                                                      drawbot::ImageFileType inFileType) {
  DrawbotImageResourceCacheKey key = MakeKey(inSupplier, inName, inFileType);
  auto found = mImages.find(key);
  if (found != mImages.end()) return found->second;

  if (!inResources || !inSupplier) {
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError,
                               "$$$/norvik/utility/Error/ResourceUtils/UnableToAccessResource="
                               "Unable to access resource.");
  }
  std::vector<char> bytes;
  inResources->GetBinary(tarsel::utility::UTF8to16(inName), GetResourceTypeName(inFileType), &bytes);
  drawbot::FileImageP image(inSupplier, inFileType, bytes.data(), static_cast<unsigned long>(bytes.size()));
  ImageP stored(image.Get());
  mImages.emplace(std::move(key), stored);
  return stored;
}

DrawbotImageResourceCache::ImageP DrawbotImageResourceCache::FindImage(drawbot::SupplierInterface const* inSupplier,
                                                                       UTF8String const& inName,
                                                                       drawbot::ImageFileType inFileType) const {
  auto found = mImages.find(MakeKey(inSupplier, inName, inFileType));
  return found == mImages.end() ? ImageP() : found->second;
}

void DrawbotImageResourceCache::CacheImage(drawbot::SupplierInterface const* inSupplier, UTF8String const& inName,
                                           drawbot::ImageFileType inFileType, ImageP inImage) {
  mImages[MakeKey(inSupplier, inName, inFileType)] = std::move(inImage);
}

bool DrawbotImageResourceCache::RemoveCachedImage(drawbot::SupplierInterface const* inSupplier,
                                                  UTF8String const& inName, drawbot::ImageFileType inFileType) {
  return mImages.erase(MakeKey(inSupplier, inName, inFileType)) > 0;
}

}  // namespace norvik::ui
