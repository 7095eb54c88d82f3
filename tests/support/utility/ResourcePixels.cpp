#include "support/utility/ResourcePixels.h"

#include <vector>

#include "drawbot/DrawbotWrappers.h"

namespace norvik::utility::testing {

drawbot::testing::PixelImage DecodedResourcePNG(const ui::ResourceManager& inResources, const tarsel::UTF16String& inName) {
  std::vector<char> bytes;
  inResources.GetBinary(inName, u"png", &bytes);
  const auto size = static_cast<unsigned long>(bytes.size());
  // The platform decoder tells the size; the canvas's own supplier draws it.
  drawbot::FileImageP probe(drawbot::NewOSSupplier(), drawbot::kImageFileTypePNG, bytes.data(), size);
  drawbot::testing::PixelCanvas canvas(static_cast<int>(probe->GetWidth()), static_cast<int>(probe->GetHeight()));
  drawbot::FileImageP image(canvas.GetSupplier(), drawbot::kImageFileTypePNG, bytes.data(), size);
  canvas.GetSurface()->DrawImage(*image, tarsel::geom::PointT<float>(0, 0), 1);
  return canvas.Snapshot();
}

}  // namespace norvik::utility::testing
