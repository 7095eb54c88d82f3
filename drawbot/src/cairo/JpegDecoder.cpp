#include "drawbot/src/cairo/JpegDecoder.h"

#include <csetjmp>
#include <cstdint>
#include <cstdio>

#include <jpeglib.h>

namespace norvik::drawbot {

namespace {

// 8192 x 8192: far above any picture of the toolkit, far below what would
// exhaust memory.
constexpr std::uint64_t kMaxPixels = std::uint64_t(1) << 26;

// The library reports a fatal error by calling error_exit, which must not
// return; control goes back to the decoder through the jump buffer, since an
// exception may not cross the library's C frames.
struct ErrorManager {
  jpeg_error_mgr base;
  std::jmp_buf jump;
};

[[noreturn]] void ExitOnError(j_common_ptr inInfo) {
  std::longjmp(reinterpret_cast<ErrorManager*>(inInfo->err)->jump, 1);
}

// Warnings (a truncated file, a bad marker the library recovers from) are not
// worth a message on the console.
void IgnoreMessage(j_common_ptr) {}

// The state that must survive a jump back lives outside the frame of setjmp.
struct Decoding {
  jpeg_decompress_struct info{};
  ErrorManager errors{};
  cairo_surface_t* surface = nullptr;

  ~Decoding() {
    jpeg_destroy_decompress(&info);
    if (surface) cairo_surface_destroy(surface);
  }
};

// Reads the scanlines into the surface; false on a fatal library error.
bool Run(Decoding& ioState, unsigned char const* inData, std::size_t inSize) {
  jpeg_decompress_struct& info = ioState.info;
  info.err = jpeg_std_error(&ioState.errors.base);
  ioState.errors.base.error_exit = &ExitOnError;
  ioState.errors.base.output_message = &IgnoreMessage;
  if (setjmp(ioState.errors.jump)) return false;
  jpeg_create_decompress(&info);
  jpeg_mem_src(&info, inData, static_cast<unsigned long>(inSize));
  if (jpeg_read_header(&info, TRUE) != JPEG_HEADER_OK) return false;
  // The header's size is checked before the library allocates for it: a few
  // bytes may claim an image of gigabytes.
  if (info.image_width == 0 || info.image_height == 0 || info.image_width > 32767 || info.image_height > 32767 ||
      std::uint64_t(info.image_width) * info.image_height > kMaxPixels)
    return false;
  // Grey, RGB and YCbCr all come out as RGB; CMYK files are refused here.
  info.out_color_space = JCS_RGB;
  jpeg_start_decompress(&info);
  if (info.output_components != 3 || info.output_width == 0 || info.output_height == 0 ||
      info.output_width > 32767 || info.output_height > 32767)
    return false;
  ioState.surface = cairo_image_surface_create(CAIRO_FORMAT_RGB24, static_cast<int>(info.output_width),
                                               static_cast<int>(info.output_height));
  if (cairo_surface_status(ioState.surface) != CAIRO_STATUS_SUCCESS) return false;
  cairo_surface_flush(ioState.surface);
  unsigned char* pixels = cairo_image_surface_get_data(ioState.surface);
  const int stride = cairo_image_surface_get_stride(ioState.surface);
  unsigned char* row = static_cast<unsigned char*>(
      (*info.mem->alloc_small)(reinterpret_cast<j_common_ptr>(&info), JPOOL_IMAGE, info.output_width * 3));
  while (info.output_scanline < info.output_height) {
    const unsigned y = info.output_scanline;
    JSAMPROW rows[1] = {row};
    if (jpeg_read_scanlines(&info, rows, 1) != 1) return false;
    auto* out = reinterpret_cast<std::uint32_t*>(pixels + static_cast<std::ptrdiff_t>(y) * stride);
    for (unsigned x = 0; x < info.output_width; ++x)
      out[x] = 0xFF000000u | (std::uint32_t(row[3 * x]) << 16) | (std::uint32_t(row[3 * x + 1]) << 8) |
               std::uint32_t(row[3 * x + 2]);
  }
  jpeg_finish_decompress(&info);
  cairo_surface_mark_dirty(ioState.surface);
  return true;
}

}  // namespace

cairo_surface_t* DecodeJpeg(unsigned char const* inData, std::size_t inSize) {
  if (!inData || inSize == 0) return nullptr;
  Decoding state;
  if (!Run(state, inData, inSize)) return nullptr;
  cairo_surface_t* result = state.surface;
  state.surface = nullptr;
  return result;
}

}  // namespace norvik::drawbot
