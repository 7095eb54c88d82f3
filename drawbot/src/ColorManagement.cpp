// Colour-managed painting: the rectangle is split at monitor borders and each
// piece is converted for its own monitor.
#include "drawbot/ColorManagement.h"

#include <climits>
#include <cmath>
#include <cstdlib>
#include <new>
#include <stdexcept>

#include "drawbot/DrawbotWrappers.h"
#include "tarsel/ThrowError.h"

namespace norvik::drawbot {

using tarsel::geom::PointT;
using tarsel::geom::RectT;

namespace {

ColorManagementCallback gCallback = nullptr;

// Without a platform, one monitor covers the whole coordinate space.
class SingleMonitor : public MonitorSource {
 public:
  long GetMonitorCount() const override { return 1; }
  bool GetMonitorRect(long inIndex, RectT<long>* outRect) const override {
    if (inIndex != 0) return false;
    constexpr long kHalf = LONG_MAX / 4;
    *outRect = RectT<long>(-kHalf, -kHalf, 2 * kHalf, 2 * kHalf);
    return true;
  }
  void const* GetMonitorIDFromRect(RectT<long> const&) const override { return this; }
};

SingleMonitor gSingleMonitor;
MonitorSource const* gMonitorSource = &gSingleMonitor;

RectT<long> OuterIntegerRect(RectT<float> const& inRect) {
  long left = static_cast<long>(std::floor(inRect.left));
  long top = static_cast<long>(std::floor(inRect.top));
  long right = static_cast<long>(std::ceil(inRect.left + inRect.width));
  long bottom = static_cast<long>(std::ceil(inRect.top + inRect.height));
  return RectT<long>::FromEdges(left, top, right, bottom);
}

}  // namespace

void SetMonitorSource(MonitorSource const* inSource) { gMonitorSource = inSource ? inSource : &gSingleMonitor; }

std::vector<std::pair<RectT<long>, void const*>> SubdivideByMonitor(RectT<long> const& inRect) {
  long count = gMonitorSource->GetMonitorCount();
  std::vector<RectT<long>> monitors(static_cast<size_t>(std::max(0L, count)));
  for (long i = 0; i < count; ++i)
    if (!gMonitorSource->GetMonitorRect(i, &monitors[static_cast<size_t>(i)]))
      throw std::runtime_error("Bug in MonitorInfo");

  std::vector<std::pair<RectT<long>, void const*>> pieces;
  for (auto const& monitor : monitors) {
    RectT<long> piece = monitor.Intersection(inRect);
    if (piece.width < 1 || piece.height < 1) continue;
    pieces.emplace_back(piece, gMonitorSource->GetMonitorIDFromRect(piece));
  }
  return pieces;
}

void SetColorManagementCallback(ColorManagementCallback inCallback) { gCallback = inCallback; }

void AbstractVisual::Manage(ColorDestinationProfile const& inProfile, OpaqueApplicationData const& inData,
                            void* outDest) const {
  ColorManagementCallback callback = gCallback;
  if (IsManaged() && callback) {
    callback(inProfile, inData, outDest);
    return;
  }
  tarsel::config::ThrowError(
      tarsel::config::ErrorLevel::kError,
      "$$$/norvik/drawbot/Error/ColorManagement/NoColorManagementCallback=Color management callback not registered.");
}

void PaintColorManagedRect(Drawbot& inDrawbot, RectT<float> const& inRect, PointT<long> const& inOrigin,
                           boost::intrusive_ptr<AbstractColor> inColor) {
  if (!inColor || inDrawbot.GetSurface() == nullptr) return;
  RectT<long> global = OuterIntegerRect(inRect).Offsetted(inOrigin.x, inOrigin.y);
  ColorDestinationProfile profile;
  profile.SetPixelLayout(kPixelLayoutARGB);
  profile.SetDepth(8);
  for (auto const& [piece, id] : SubdivideByMonitor(global)) {
    profile.SetDisplayID(id);
    ColorRGBA color = inColor->Convert(profile);
    RectT<long> local = piece.Offsetted(-inOrigin.x, -inOrigin.y);
    inDrawbot.GetSurface()->PaintRect(color, RectT<float>(local));
  }
}

void PaintColorManagedImage(Drawbot& inDrawbot, RectT<float> const& inRect, PointT<long> const& inOrigin,
                            boost::intrusive_ptr<AbstractImage> inImage) {
  if (!inImage || inDrawbot.GetSurface() == nullptr) return;
  RectT<long> bounds = OuterIntegerRect(inRect);
  RectT<long> global = bounds.Offsetted(inOrigin.x, inOrigin.y);
  ImageDestinationProfile profile;
  profile.SetPixelLayout(kPixelLayoutARGB);
  profile.SetDepth(8);
  profile.SetBounds(bounds);
  for (auto const& [piece, id] : SubdivideByMonitor(global)) {
    profile.SetDisplayID(id);
    RectT<long> local = piece.Offsetted(-inOrigin.x, -inOrigin.y);
    profile.SetSubregion(local);
    unsigned long bytesPerPixel = profile.GetBytesPerPixel();
    size_t size = static_cast<size_t>(local.width) * static_cast<size_t>(local.height) * bytesPerPixel;
    void* buffer = std::calloc(size, 1);
    if (buffer == nullptr) throw std::bad_alloc();
    boost::intrusive_ptr<DataDeleter> deleter(new DataDeleter(buffer, &std::free));
    inImage->Convert(profile, buffer);
    // The platform image wants the bytes the other way round. The layout stays
    // at 6 for later pieces, which are reversed all the same.
    inplace_swizzle<4, 6>(buffer, local.width * local.height);
    profile.SetPixelLayout(kPixelLayoutBGRA);
    BufferImageP image(inDrawbot.GetSupplier(), static_cast<unsigned long>(local.width),
                       static_cast<unsigned long>(local.height), static_cast<long>(bytesPerPixel * local.width),
                       kPixelLayoutBGRA, buffer, deleter);
    if (image)
      inDrawbot.GetSurface()->DrawImage(*image, PointT<float>(static_cast<float>(local.left),
                                                              static_cast<float>(local.top)), 1.0f);
  }
}

}  // namespace norvik::drawbot
