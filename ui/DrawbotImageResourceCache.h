#pragma once
// Decoded images of the toolkit's resources, one per supplier. An image is
// valid only with surfaces of the supplier that made it, so the key holds the
// supplier's dynamic type beside the name and file type: two suppliers of the
// same kind share an entry, two kinds never do.
//
// Callers keep bare pointers to what GetImage answers; the cache holds the
// images until it is cleared or destroyed (the node manager destroys it in
// TerminateDrawing, before the drawing back end goes away).
#include <map>
#include <typeindex>

#include <boost/intrusive_ptr.hpp>

#include "drawbot/DrawbotTypes.h"
#include "drawbot/ResourceInterfaces.h"
#include "tarsel/UTFString.h"

namespace norvik::drawbot {
class SupplierInterface;
}

namespace norvik::ui {

class ResourceManager;

struct DrawbotImageResourceCacheKey {
  std::type_index supplierType;
  UTF8String name;
  drawbot::ImageFileType fileType;

  bool operator<(DrawbotImageResourceCacheKey const& inOther) const;
};

class DrawbotImageResourceCache {
 public:
  using ImageP = boost::intrusive_ptr<drawbot::ImageInterface>;

  DrawbotImageResourceCache() = default;
  virtual ~DrawbotImageResourceCache() = default;
  DrawbotImageResourceCache(DrawbotImageResourceCache const&) = delete;
  DrawbotImageResourceCache& operator=(DrawbotImageResourceCache const&) = delete;

  // The cached image, else the resource (inName, type of inFileType) read
  // through inResources, decoded by inSupplier and cached. A missing resource
  // raises the resource manager's error; undecodable bytes the supplier's.
  ImageP GetImage(ResourceManager const* inResources, drawbot::SupplierInterface const* inSupplier,
                  UTF8String const& inName, drawbot::ImageFileType inFileType);
  // The cached image or null.
  ImageP FindImage(drawbot::SupplierInterface const* inSupplier, UTF8String const& inName,
                   drawbot::ImageFileType inFileType) const;
  // Stores an image made elsewhere, replacing what the key held.
  void CacheImage(drawbot::SupplierInterface const* inSupplier, UTF8String const& inName,
                  drawbot::ImageFileType inFileType, ImageP inImage);
  bool RemoveCachedImage(drawbot::SupplierInterface const* inSupplier, UTF8String const& inName,
                         drawbot::ImageFileType inFileType);

  std::size_t GetSize() const { return mImages.size(); }
  // Forgets every cached image.
  void Clear() { mImages.clear(); }

  // The resource type name of an image file type: "jpg" for 0, "png" for 1,
  // or empty for a type that has no resources.
  static UTF16String GetResourceTypeName(drawbot::ImageFileType inFileType);

 private:
  static DrawbotImageResourceCacheKey MakeKey(drawbot::SupplierInterface const* inSupplier, UTF8String const& inName,
                                              drawbot::ImageFileType inFileType);

  std::map<DrawbotImageResourceCacheKey, ImageP> mImages;
};

}  // namespace norvik::ui
