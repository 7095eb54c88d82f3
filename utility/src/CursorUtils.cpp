#include "utility/CursorUtils.h"

#include <algorithm>
#include <climits>
#include <cstdint>
#include <string>
#include <vector>

#include "drawbot/DrawbotWrappers.h"
#include "drawbot/SupplierInterface.h"
#include "drawbot/SurfaceInterface.h"
#include "tarsel/PropList.h"
#include "tarsel/PropListUtils.h"
#include "tarsel/ThrowError.h"
#include "ui/OS_WindowConstants.h"
#include "ui/ResourceManager.h"

namespace norvik::utility {

namespace {

constexpr char kInvalidCursorData[] =
    "$$$/norvik/ui/Error/InvalidCursorDataFile=Not a valid cursor data definition.";
constexpr char kIncompatibleCursorData[] =
    "$$$/norvik/ui/Error/IncompatibleCursorDataFileVersion=Unable to load cursor data file. Incompatible version.";

UTF16String ReplaceID(std::u16string_view inPattern, int inID) {
  UTF16String text(inPattern);
  const UTF16String number = tarsel::utility::AsciiToUTF16(std::to_string(inID));
  const std::size_t at = text.find(u"@0");
  if (at != UTF16String::npos) text.replace(at, 2, number);
  return text;
}

short NarrowToShort(long inValue) {
  return static_cast<short>(std::clamp<long>(inValue, SHRT_MIN, SHRT_MAX));
}

}  // namespace

void GetCursorResourceNames(int inID, UTF16String& outPNGName, UTF16String& outDataName) {
  outPNGName = ReplaceID(u"CursorID-@0", inID);
  outDataName = ReplaceID(u"CursorDataID-@0", inID);
}

void GetNativeCursorResourceNames(int inID, UTF16String& outPNGName, UTF16String& outDataName) {
  outPNGName = ReplaceID(u"NativeCursor-@0", inID);
  outDataName = ReplaceID(u"NativeCursorData-@0", inID);
}

const std::vector<int>& GetNativeCursorNumbers() {
  static const std::vector<int> kNumbers = {
      kCursorTextInsert, kCursorOpenHand, kCursorZoomIn,   kCursorZoomOut,     kCursorClosedHand, kCursorResizeColumns,
      kCursorScrub,      kCursorWheel,    kCursorResizeRows, kCursorHotText,   kCursorColorPicker, kCursorEyedropper,
      kCursorPencil,     kCursorMove,     kCursorTrimStart, kCursorTrimEnd,    kCursorRazor};
  return kNumbers;
}

int GetSystemCursorNumber(int inID) {
  switch (inID) {
    case kCursorArrow:
    case kCursorArrowAlternate:
    case kCursorArrowOther: return ui::kOSCursorArrow;
    case kCursorWait: return ui::kOSCursorWait;
    case kCursorCross: return ui::kOSCursorCross;
    case kCursorNotAllowed: return ui::kOSCursorNo;
    default: return 0;
  }
}

std::pair<short, short> LoadCursorHotSpot(UTF16String const& inDataName, ui::ResourceManager const& inResources) {
  if (!inResources.HasBinary(inDataName, u"xml")) return {0, 0};
  std::vector<char> bytes;
  inResources.GetBinary(inDataName, u"xml", &bytes);
  tarsel::proplist::PropList document;
  tarsel::proplist::utils::ReadPropList(std::string_view(bytes.data(), bytes.size()), document);

  UTF8String version;
  if (!document.GetValue("NRK_CursorData", version))
    tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError, kInvalidCursorData);
  if (version != "1.0") tarsel::config::ThrowError(tarsel::config::ErrorLevel::kError, kIncompatibleCursorData);

  tarsel::geom::PointT<long> hotSpot(0, 0);
  tarsel::proplist::utils::ReadPoint32(document, "kHotSpot", hotSpot);
  return {NarrowToShort(hotSpot.x), NarrowToShort(hotSpot.y)};
}

ui::OS_CursorHandle GetCursorFromImage(boost::intrusive_ptr<drawbot::ImageInterface> inImage, short inHotX,
                                       short inHotY) {
  ui::OS_NativeLayer* layer = ui::GetNativeLayer();
  if (!layer || !inImage) return 0;
  const unsigned long width = inImage->GetWidth();
  const unsigned long height = inImage->GetHeight();
  if (width == 0 || height == 0) return 0;

  // Draw the picture into premultiplied 32-bit pixels, the form native
  // cursors are made from.
  std::vector<std::uint32_t> pixels(width * height, 0u);
  drawbot::SupplierInterface* supplier = drawbot::NewOSSupplier();
  {
    drawbot::SurfaceP surface(supplier->NewBufferSurface(width, height, static_cast<long>(width * 4),
                                                         drawbot::kPixelLayoutBGRAPremul, pixels.data(), nullptr));
    surface->DrawImage(*inImage, tarsel::geom::PointT<float>(0, 0), 1.0f);
    surface->Flush();
  }
  const int hotX = std::clamp<int>(inHotX, 0, static_cast<int>(width) - 1);
  const int hotY = std::clamp<int>(inHotY, 0, static_cast<int>(height) - 1);
  return layer->CreateCursorFromPixels(pixels.data(), static_cast<int>(width), static_cast<int>(height), hotX, hotY);
}

ui::OS_CursorHandle DisplayCursorFromImage(boost::intrusive_ptr<drawbot::ImageInterface> inImage, short inHotX,
                                           short inHotY) {
  const ui::OS_CursorHandle cursor = GetCursorFromImage(std::move(inImage), inHotX, inHotY);
  if (cursor) DisplayCursor(cursor);
  return cursor;
}

void DisplayCursor(ui::OS_CursorHandle inCursor) {
  if (ui::OS_NativeLayer* layer = ui::GetNativeLayer()) layer->SetCursor(inCursor);
}

void DisposeCursor(ui::OS_CursorHandle inCursor) {
  ui::OS_NativeLayer* layer = ui::GetNativeLayer();
  if (layer && inCursor) layer->DestroyCursor(inCursor);
}

}  // namespace norvik::utility
