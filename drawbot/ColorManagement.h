#pragma once
// Colour-managed visuals. A managed colour or image is converted separately
// for every monitor it is painted on, either by a subclass or by the one
// process-wide callback that the application installs.
#include <boost/intrusive_ptr.hpp>

#include "drawbot/Drawbot.h"

namespace norvik::drawbot {

struct ColorDestinationProfile {
  virtual ~ColorDestinationProfile() = default;

  void SetDisplayID(void const* inID) { mDisplayID = inID; }
  void const* GetDisplayID() const { return mDisplayID; }
  void SetPixelLayout(PixelLayout inLayout) { mLayout = inLayout; }
  PixelLayout GetPixelLayout() const { return mLayout; }
  // Bits per channel.
  void SetDepth(unsigned long inDepth) { mDepth = inDepth; }
  unsigned long GetDepth() const { return mDepth; }
  unsigned long GetBytesPerPixel() const {
    return ((mDepth / 8) * static_cast<unsigned long>(mLayout) == 0 || mLayout == kPixelLayoutRGB24) ? 3 : 4;
  }

 private:
  void const* mDisplayID = nullptr;
  PixelLayout mLayout = kPixelLayoutARGB;
  unsigned long mDepth = 8;
};

struct ImageDestinationProfile : public ColorDestinationProfile {
  // The whole image area, in global coordinates.
  void SetBounds(tarsel::geom::RectT<long> const& inBounds) { mBounds = inBounds; }
  tarsel::geom::RectT<long> const& GetBounds() const { return mBounds; }
  // The part to convert now, relative to the bounds.
  void SetSubregion(tarsel::geom::RectT<long> const& inRegion) { mSubregion = inRegion; }
  tarsel::geom::RectT<long> const& GetSubregion() const { return mSubregion; }

 private:
  tarsel::geom::RectT<long> mBounds;
  tarsel::geom::RectT<long> mSubregion;
};

// The application's own record, passed through to the callback untouched.
struct OpaqueApplicationData {
  virtual ~OpaqueApplicationData() = default;
};

using ColorManagementCallback = void (*)(ColorDestinationProfile const&, OpaqueApplicationData const&, void*);

// Installs the one callback, replacing any earlier one; null removes it.
void SetColorManagementCallback(ColorManagementCallback inCallback);

class AbstractVisual : public tarsel::utility::RefCountedObject {
 public:
  virtual bool IsManaged() const = 0;
  // Hands the conversion to the callback; raises "Color management callback not
  // registered." when there is none or the visual is not managed.
  void Manage(ColorDestinationProfile const& inProfile, OpaqueApplicationData const& inData, void* outDest) const;
};

class AbstractColor : public AbstractVisual {
 public:
  virtual ColorRGBA Convert(ColorDestinationProfile const& inProfile) = 0;
};

class UnManagedColor : public AbstractColor {
 public:
  bool IsManaged() const override { return false; }
};

class UnManagedRGBA : public UnManagedColor {
 public:
  explicit UnManagedRGBA(ColorRGBA const& inColor) : mColor(inColor) {}
  ColorRGBA Convert(ColorDestinationProfile const&) override { return mColor; }

 private:
  ColorRGBA mColor;
};

class AbstractImage : public AbstractVisual {
 public:
  // Writes the subregion's pixels in the profile's layout into outDest.
  virtual void Convert(ImageDestinationProfile const& inProfile, void* outDest) const = 0;
};

class UnManagedImage : public AbstractImage {
 public:
  bool IsManaged() const override { return false; }
};

class ManagedImage : public AbstractImage {
 public:
  bool IsManaged() const override { return true; }
  void Convert(ImageDestinationProfile const&, void*) const override {}
};

// inOrigin is the surface's global origin; the rectangle is split by monitor
// and each piece filled with the colour converted for that monitor.
void PaintColorManagedRect(Drawbot& inDrawbot, tarsel::geom::RectT<float> const& inRect,
                           tarsel::geom::PointT<long> const& inOrigin, boost::intrusive_ptr<AbstractColor> inColor);
void PaintColorManagedImage(Drawbot& inDrawbot, tarsel::geom::RectT<float> const& inRect,
                            tarsel::geom::PointT<long> const& inOrigin, boost::intrusive_ptr<AbstractImage> inImage);

}  // namespace norvik::drawbot
