// The supplier of the image back end: surfaces, shaders and images.
#include <algorithm>
#include <cstring>
#include <fstream>
#include <iterator>

#include "drawbot/src/cairo/CairoObjects.h"
#include "drawbot/src/cairo/JpegDecoder.h"
#include "tarsel/ThrowError.h"

namespace norvik::drawbot {

SupplierInterface* NewOSSupplier() {
  static boost::intrusive_ptr<SupplierInterface> sSupplier(new cairo::OSSupplier());
  return sSupplier.get();
}

}  // namespace norvik::drawbot

namespace norvik::drawbot::cairo {

namespace {

constexpr char kUnableToCreateSurface[] =
    "$$$/norvik/drawbot/Error/OSSupplier/UnableToCreateSurface=Unable to create drawing surface.";
constexpr char kUnableToCreateImageBuffer[] =
    "$$$/norvik/drawbot/Error/OSSupplier/UnableToCreateImageBuffer=Unable to create image buffer.";
constexpr char kUnableToReadImageFile[] =
    "$$$/norvik/drawbot/Error/OSSupplier/UnableToReadImageFile=Unable to read image file.";

struct ByteReader {
  unsigned char const* data;
  size_t size;
  size_t offset;
};

cairo_status_t ReadBytes(void* inClosure, unsigned char* outData, unsigned int inLength) {
  auto* reader = static_cast<ByteReader*>(inClosure);
  if (reader->size - reader->offset < inLength) return CAIRO_STATUS_READ_ERROR;
  std::memcpy(outData, reader->data + reader->offset, inLength);
  reader->offset += inLength;
  return CAIRO_STATUS_SUCCESS;
}

void AddStops(cairo_pattern_t* inPattern, ColorRGBA const* inColors, float const* inPositions,
              unsigned long inCount) {
  for (unsigned long i = 0; inColors && inPositions && i < inCount; ++i) {
    ColorRGBA const& c = inColors[i];
    cairo_pattern_add_color_stop_rgba(inPattern, inPositions[i], c.red, c.green, c.blue, c.alpha);
  }
  cairo_pattern_set_extend(inPattern, CAIRO_EXTEND_PAD);
}

// Copies caller's pixels into a premultiplied image where Cairo cannot draw
// them in place.
cairo_surface_t* CopyToImage(unsigned long inWidth, unsigned long inHeight, long inRowBytes, PixelLayout inLayout,
                             unsigned char const* inData) {
  const bool opaque = inLayout == kPixelLayoutRGB24 || inLayout == kPixelLayoutRGB32;
  cairo_format_t format = opaque ? CAIRO_FORMAT_RGB24 : CAIRO_FORMAT_ARGB32;
  cairo_surface_t* image = cairo_image_surface_create(format, static_cast<int>(inWidth), static_cast<int>(inHeight));
  if (cairo_surface_status(image) != CAIRO_STATUS_SUCCESS) {
    cairo_surface_destroy(image);
    ThrowDrawingError(kUnableToCreateImageBuffer);
  }
  cairo_surface_flush(image);
  unsigned char* out = cairo_image_surface_get_data(image);
  int stride = cairo_image_surface_get_stride(image);
  for (unsigned long y = 0; y < inHeight; ++y) {
    unsigned char const* src = inData + y * static_cast<unsigned long>(inRowBytes);
    auto* dst = reinterpret_cast<uint32_t*>(out + y * static_cast<unsigned long>(stride));
    for (unsigned long x = 0; x < inWidth; ++x) {
      if (inLayout == kPixelLayoutRGB24) {
        unsigned char const* p = src + x * 3;
        dst[x] = 0xff000000u | (uint32_t(p[2]) << 16) | (uint32_t(p[1]) << 8) | p[0];
      } else if (inLayout == kPixelLayoutRGB32) {
        unsigned char const* p = src + x * 4;  // B, G, R and an unused byte
        dst[x] = 0xff000000u | (uint32_t(p[2]) << 16) | (uint32_t(p[1]) << 8) | p[0];
      } else {
        unsigned char const* p = src + x * 4;  // B, G, R, A with straight alpha
        uint32_t a = p[3];
        auto pm = [a](uint32_t c) { return (c * a + 127) / 255; };
        dst[x] = (a << 24) | (pm(p[2]) << 16) | (pm(p[1]) << 8) | pm(p[0]);
      }
    }
  }
  cairo_surface_mark_dirty(image);
  return image;
}

// The inverse of CopyToImage: premultiplied pixels back into the caller's
// layout (24-bit, 32-bit without alpha, or straight B, G, R, A).
void WriteBack(cairo_surface_t* inImage, PixelLayout inLayout, long inRowBytes, unsigned char* outData) {
  unsigned char const* in = cairo_image_surface_get_data(inImage);
  const int stride = cairo_image_surface_get_stride(inImage);
  const int width = cairo_image_surface_get_width(inImage), height = cairo_image_surface_get_height(inImage);
  for (int y = 0; y < height; ++y) {
    auto const* src = reinterpret_cast<uint32_t const*>(in + static_cast<std::ptrdiff_t>(y) * stride);
    unsigned char* dst = outData + static_cast<std::ptrdiff_t>(y) * inRowBytes;
    for (int x = 0; x < width; ++x) {
      const uint32_t p = src[x];
      uint32_t a = p >> 24, r = (p >> 16) & 0xff, g = (p >> 8) & 0xff, b = p & 0xff;
      if (inLayout == kPixelLayoutRGB24) {
        dst[3 * x] = static_cast<unsigned char>(b);
        dst[3 * x + 1] = static_cast<unsigned char>(g);
        dst[3 * x + 2] = static_cast<unsigned char>(r);
        continue;
      }
      if (inLayout == kPixelLayoutBGRA && a != 0 && a != 255) {
        auto straight = [a](uint32_t c) { return std::min<uint32_t>(255, (c * 255 + a / 2) / a); };
        r = straight(r), g = straight(g), b = straight(b);
      }
      if (inLayout != kPixelLayoutBGRA) a = dst[4 * x + 3];  // the unused byte stays as it was
      dst[4 * x] = static_cast<unsigned char>(b);
      dst[4 * x + 1] = static_cast<unsigned char>(g);
      dst[4 * x + 2] = static_cast<unsigned char>(r);
      dst[4 * x + 3] = static_cast<unsigned char>(a);
    }
  }
}

// Cairo can draw these in place: premultiplied B, G, R, A and 32-bit RGB.
bool CanWrap(PixelLayout inLayout, unsigned long inWidth, long inRowBytes) {
  return (inLayout == kPixelLayoutBGRAPremul || inLayout == kPixelLayoutRGB32) && inRowBytes % 4 == 0 &&
         static_cast<unsigned long>(inRowBytes) >= inWidth * 4;
}

}  // namespace

OSSupplier::OSSupplier() {
  mMeasuringSurface = cairo_image_surface_create(CAIRO_FORMAT_ARGB32, 1, 1);
  mMeasuringContext = cairo_create(mMeasuringSurface);
  if (cairo_status(mMeasuringContext) != CAIRO_STATUS_SUCCESS)
    ThrowDrawingError(
        "$$$/norvik/drawbot/Error/OSSupplier/GDIPlus/Intitialization=Unable to initialize GDI+.");
  mMeasuringLayout = pango_cairo_create_layout(mMeasuringContext);
  ApplyTextPolicies(mMeasuringLayout, kAntiAliasNone, kTextDisplayGridFitted);
}

OSSupplier::~OSSupplier() {
  mLayoutCache.Clear();
  mFontCache.clear();
  g_object_unref(mMeasuringLayout);
  cairo_destroy(mMeasuringContext);
  cairo_surface_destroy(mMeasuringSurface);
}

SurfaceInterface* OSSupplier::NewSurface(NativeDrawTarget inTarget, NativeRegion inRegion, bool inBuffered) const {
  auto* target = static_cast<cairo_surface_t*>(inTarget);
  if (target == nullptr || cairo_surface_status(target) != CAIRO_STATUS_SUCCESS)
    ThrowDrawingError(kUnableToCreateSurface);
  auto* region = static_cast<cairo_region_t*>(inRegion);
  if (inBuffered && cairo_surface_get_type(target) == CAIRO_SURFACE_TYPE_IMAGE) {
    cairo_surface_t* memory = cairo_image_surface_create(CAIRO_FORMAT_ARGB32, cairo_image_surface_get_width(target),
                                                         cairo_image_surface_get_height(target));
    auto* surface = new OSSurfaceInterface(this, memory, false, target, region);
    cairo_surface_destroy(memory);
    return surface;
  }
  return new OSSurfaceInterface(this, target, false, nullptr, region);
}

SurfaceInterface* OSSupplier::NewReferenceSurface(SurfaceInterface* inSurface, bool inFlag,
                                                  RectT<long> const* inRect) const {
  if (inSurface == nullptr || dynamic_cast<OSSurfaceInterface*>(inSurface->GetOutputSurface()) == nullptr)
    ThrowDrawingError(
        "$$$/norvik/drawbot/Error/OSSupplier/UnableToCreateReference=Unable to create drawing reference.");
  return new OSReferenceSurface(this, inSurface, inFlag, OSReferenceSurface::ReferenceRect(inSurface, inRect));
}

SurfaceInterface* OSSupplier::NewOffscreenSurface(unsigned long inWidth, unsigned long inHeight, bool) const {
  cairo_surface_t* image =
      cairo_image_surface_create(CAIRO_FORMAT_ARGB32, static_cast<int>(inWidth), static_cast<int>(inHeight));
  if (inWidth == 0 || inHeight == 0 || inWidth > 32767 || inHeight > 32767 ||
      cairo_surface_status(image) != CAIRO_STATUS_SUCCESS) {
    cairo_surface_destroy(image);
    ThrowDrawingError(kUnableToCreateSurface);
  }
  auto* surface = new OSSurfaceInterface(this, image, true, nullptr, nullptr);
  cairo_surface_destroy(image);
  return surface;
}

SurfaceInterface* OSSupplier::NewBufferSurface(unsigned long inWidth, unsigned long inHeight, long inRowBytes,
                                               PixelLayout inLayout, void* inData,
                                               boost::intrusive_ptr<DataDeleter> inDeleter) const {
  cairo_format_t format = MapPixelLayout(inLayout);
  if (inData == nullptr || inWidth == 0 || inHeight == 0 || inWidth > 32767 || inHeight > 32767)
    ThrowDrawingError(kUnableToCreateSurface);
  if (!CanWrap(inLayout, inWidth, inRowBytes)) {
    // 24-bit and straight-alpha pixels are drawn on a premultiplied copy that
    // goes back into the caller's buffer at each flush and at the end.
    if (inRowBytes < static_cast<long>(inWidth * (inLayout == kPixelLayoutRGB24 ? 3 : 4)))
      ThrowDrawingError("$$$/norvik/drawbot/Error/OSSupplier/UnsupportedPixelFormat=Unsupported Pixel Format.");
    cairo_surface_t* copy =
        CopyToImage(inWidth, inHeight, inRowBytes, inLayout, static_cast<unsigned char const*>(inData));
    auto* surface = new OSSurfaceInterface(this, copy, true, nullptr, nullptr, std::move(inDeleter));
    cairo_surface_destroy(copy);
    surface->SetWriteBack([inLayout, inRowBytes, inData](cairo_surface_t* inDrawn) {
      WriteBack(inDrawn, inLayout, inRowBytes, static_cast<unsigned char*>(inData));
    });
    return surface;
  }
  cairo_surface_t* image = cairo_image_surface_create_for_data(static_cast<unsigned char*>(inData), format,
                                                               static_cast<int>(inWidth),
                                                               static_cast<int>(inHeight), static_cast<int>(inRowBytes));
  if (cairo_surface_status(image) != CAIRO_STATUS_SUCCESS) {
    cairo_surface_destroy(image);
    ThrowDrawingError(kUnableToCreateSurface);
  }
  auto* surface = new OSSurfaceInterface(this, image, true, nullptr, nullptr, std::move(inDeleter));
  cairo_surface_destroy(image);
  return surface;
}

PenInterface* OSSupplier::NewPen(ColorRGBA const& inColor, float inWidth) const {
  return new OSPenInterface(inColor, inWidth);
}

BrushInterface* OSSupplier::NewBrush(ColorRGBA const& inColor) const { return new OSSolidBrushInterface(inColor); }

LinearShaderInterface* OSSupplier::NewLinearShader(PointT<float> const& inStart, PointT<float> const& inEnd,
                                                   ColorRGBA const* inColors, float const* inPositions,
                                                   unsigned long inCount) const {
  cairo_pattern_t* pattern = cairo_pattern_create_linear(inStart.x, inStart.y, inEnd.x, inEnd.y);
  AddStops(pattern, inColors, inPositions, inCount);
  return new OSLinearGradientBrushInterface(pattern);
}

RadialShaderInterface* OSSupplier::NewRadialShader(PointT<float> const& inCentre, float const* inRadii,
                                                   PointT<float> const& inFocus, ColorRGBA const* inColors,
                                                   float const* inPositions, unsigned long inCount) const {
  double rx = inRadii ? inRadii[0] : 0, ry = inRadii ? inRadii[1] : 0;
  if (!(rx > 0) || !(ry > 0)) ThrowUnspecified();
  // The gradient is built on a circle of radius rx and squeezed vertically to ry.
  double squeeze = ry / rx;
  cairo_pattern_t* pattern =
      cairo_pattern_create_radial(inFocus.x, inCentre.y + (inFocus.y - inCentre.y) / squeeze, 0, inCentre.x,
                                  inCentre.y, rx);
  cairo_matrix_t m;
  cairo_matrix_init_translate(&m, 0, inCentre.y);
  cairo_matrix_scale(&m, 1, 1 / squeeze);
  cairo_matrix_translate(&m, 0, -inCentre.y);
  cairo_pattern_set_matrix(pattern, &m);
  AddStops(pattern, inColors, inPositions, inCount);
  return new OSRadialGradientBrushInterface(pattern);
}

ImageInterface* OSSupplier::NewFileImage(ImageFileType inType, void const* inData, unsigned long inSize) const {
  if ((inType != kImageFileTypePNG && inType != kImageFileTypeJPG) || inData == nullptr)
    ThrowDrawingError(kUnableToReadImageFile);
  std::string fileBytes;
  ByteReader reader{static_cast<unsigned char const*>(inData), inSize, 0};
  if (inSize == 0) {
    std::ifstream file(static_cast<char const*>(inData), std::ios::binary);
    if (!file) ThrowDrawingError(kUnableToReadImageFile);
    fileBytes.assign(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
    reader = ByteReader{reinterpret_cast<unsigned char const*>(fileBytes.data()), fileBytes.size(), 0};
  }
  if (inType == kImageFileTypeJPG) {
    cairo_surface_t* image = DecodeJpeg(reader.data, reader.size);
    if (!image) ThrowDrawingError(kUnableToReadImageFile);
    return new OSImageInterface(image);
  }
  cairo_surface_t* image = cairo_image_surface_create_from_png_stream(&ReadBytes, &reader);
  if (cairo_surface_status(image) != CAIRO_STATUS_SUCCESS) {
    cairo_surface_destroy(image);
    ThrowDrawingError(kUnableToReadImageFile);
  }
  return new OSImageInterface(image);
}

ImageInterface* OSSupplier::NewBufferImage(unsigned long inWidth, unsigned long inHeight, long inRowBytes,
                                           PixelLayout inLayout, void* inData,
                                           boost::intrusive_ptr<DataDeleter> inDeleter) const {
  MapPixelLayout(inLayout);
  if (inData == nullptr || inWidth == 0 || inHeight == 0 || inWidth > 32767 || inHeight > 32767 ||
      inRowBytes < static_cast<long>(inWidth * (inLayout == kPixelLayoutRGB24 ? 3 : 4)))
    ThrowDrawingError(kUnableToCreateImageBuffer);
  if (CanWrap(inLayout, inWidth, inRowBytes)) {
    cairo_surface_t* image = cairo_image_surface_create_for_data(
        static_cast<unsigned char*>(inData), MapPixelLayout(inLayout), static_cast<int>(inWidth),
        static_cast<int>(inHeight), static_cast<int>(inRowBytes));
    if (cairo_surface_status(image) != CAIRO_STATUS_SUCCESS) {
      cairo_surface_destroy(image);
      ThrowDrawingError(kUnableToCreateImageBuffer);
    }
    return new OSImageInterface(image, std::move(inDeleter));
  }
  return new OSImageInterface(
      CopyToImage(inWidth, inHeight, inRowBytes, inLayout, static_cast<unsigned char const*>(inData)));
}

}  // namespace norvik::drawbot::cairo
