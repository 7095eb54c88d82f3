// PNG reading and writing go straight through Cairo here: pixel tests always
// run on the image back end.
#include "support/drawbot/PixelCompare.h"

#include <cairo.h>

#include <cstdlib>
#include <filesystem>

namespace norvik::drawbot::testing {

PixelCanvas::PixelCanvas(int inWidth, int inHeight)
    : mWidth(inWidth),
      mHeight(inHeight),
      mPixels(static_cast<size_t>(inWidth * inHeight), 0),
      mSupplier(NewOSSupplier()),
      mSurface(mSupplier->NewBufferSurface(static_cast<unsigned long>(inWidth), static_cast<unsigned long>(inHeight),
                                           inWidth * 4, kPixelLayoutBGRAPremul, mPixels.data(), nullptr)) {}

PixelImage PixelCanvas::Snapshot() const {
  mSurface->Flush();
  return PixelImage{mWidth, mHeight, mPixels};
}

void PixelCanvas::Clear(std::uint32_t inRGB) {
  mSurface->Flush();
  std::fill(mPixels.begin(), mPixels.end(), 0xff000000u | inRGB);
}

std::string RowCoverage(PixelImage const& inImage, int inY) {
  std::string row;
  for (int x = 0; x < inImage.width; ++x) row += inImage.Alpha(x, inY) ? '#' : '.';
  return row;
}

std::string ColumnCoverage(PixelImage const& inImage, int inX) {
  std::string column;
  for (int y = 0; y < inImage.height; ++y) column += inImage.Alpha(inX, y) ? '#' : '.';
  return column;
}

bool LoadPNG(std::string const& inPath, PixelImage* outImage) {
  cairo_surface_t* png = cairo_image_surface_create_from_png(inPath.c_str());
  if (cairo_surface_status(png) != CAIRO_STATUS_SUCCESS) {
    cairo_surface_destroy(png);
    return false;
  }
  int w = cairo_image_surface_get_width(png), h = cairo_image_surface_get_height(png);
  cairo_surface_t* argb = cairo_image_surface_create(CAIRO_FORMAT_ARGB32, w, h);
  cairo_t* cr = cairo_create(argb);
  cairo_set_source_surface(cr, png, 0, 0);
  cairo_set_operator(cr, CAIRO_OPERATOR_SOURCE);
  cairo_paint(cr);
  cairo_destroy(cr);
  cairo_surface_flush(argb);
  outImage->width = w;
  outImage->height = h;
  outImage->pixels.resize(static_cast<size_t>(w * h));
  unsigned char* data = cairo_image_surface_get_data(argb);
  int stride = cairo_image_surface_get_stride(argb);
  for (int y = 0; y < h; ++y)
    for (int x = 0; x < w; ++x)
      outImage->pixels[static_cast<size_t>(y * w + x)] = reinterpret_cast<std::uint32_t*>(data + y * stride)[x];
  cairo_surface_destroy(argb);
  cairo_surface_destroy(png);
  return true;
}

bool SavePNG(PixelImage const& inImage, std::string const& inPath) {
  cairo_surface_t* s = cairo_image_surface_create(CAIRO_FORMAT_ARGB32, inImage.width, inImage.height);
  cairo_surface_flush(s);
  unsigned char* data = cairo_image_surface_get_data(s);
  int stride = cairo_image_surface_get_stride(s);
  for (int y = 0; y < inImage.height; ++y)
    for (int x = 0; x < inImage.width; ++x) reinterpret_cast<std::uint32_t*>(data + y * stride)[x] = inImage.At(x, y);
  cairo_surface_mark_dirty(s);
  bool ok = cairo_surface_write_to_png(s, inPath.c_str()) == CAIRO_STATUS_SUCCESS;
  cairo_surface_destroy(s);
  return ok;
}

::testing::AssertionResult MatchesReference(PixelImage const& inActual, std::string const& inName,
                                            int inTolerance) {
  std::string referencePath = std::string(NORVIK_TEST_DATA_DIR) + "/" + inName + ".png";
  std::filesystem::path outDir = std::filesystem::path(NORVIK_TEST_OUTPUT_DIR);
  std::filesystem::create_directories((outDir / inName).parent_path());
  std::string actualPath = (outDir / (inName + "-actual.png")).string();

  PixelImage reference;
  if (!LoadPNG(referencePath, &reference)) {
    char const* update = std::getenv("NORVIK_UPDATE_REFERENCES");
    if (update && std::string(update) == "1") {
      std::filesystem::create_directories(std::filesystem::path(referencePath).parent_path());
      SavePNG(inActual, referencePath);
      return ::testing::AssertionFailure() << "wrote missing reference " << referencePath;
    }
    SavePNG(inActual, actualPath);
    return ::testing::AssertionFailure() << "no reference image " << referencePath << "; actual in " << actualPath;
  }
  return MatchesImage(inActual, reference, inName, inTolerance);
}

::testing::AssertionResult MatchesImage(PixelImage const& inActual, PixelImage const& inExpected,
                                        std::string const& inName, int inTolerance) {
  std::filesystem::path outDir = std::filesystem::path(NORVIK_TEST_OUTPUT_DIR);
  std::filesystem::create_directories((outDir / inName).parent_path());
  std::string actualPath = (outDir / (inName + "-actual.png")).string();
  std::string expectedPath = (outDir / (inName + "-expected.png")).string();
  std::string diffPath = (outDir / (inName + "-diff.png")).string();
  if (inExpected.width != inActual.width || inExpected.height != inActual.height) {
    SavePNG(inActual, actualPath);
    return ::testing::AssertionFailure() << "size " << inActual.width << "x" << inActual.height << " differs from "
                                         << inExpected.width << "x" << inExpected.height;
  }
  PixelImage diff{inActual.width, inActual.height, std::vector<std::uint32_t>(inActual.pixels.size(), 0xff000000u)};
  long bad = 0;
  int worst = 0;
  for (size_t i = 0; i < inActual.pixels.size(); ++i) {
    int largest = 0;
    for (int shift = 0; shift < 32; shift += 8) {
      int a = static_cast<int>((inActual.pixels[i] >> shift) & 0xff);
      int b = static_cast<int>((inExpected.pixels[i] >> shift) & 0xff);
      largest = std::max(largest, std::abs(a - b));
    }
    worst = std::max(worst, largest);
    if (largest > inTolerance) {
      ++bad;
      diff.pixels[i] = 0xffff0000u;
    }
  }
  if (bad == 0) return ::testing::AssertionSuccess();
  SavePNG(inActual, actualPath);
  SavePNG(inExpected, expectedPath);
  SavePNG(diff, diffPath);
  return ::testing::AssertionFailure() << bad << " pixels of " << inName << " differ by more than " << inTolerance
                                       << " (worst " << worst << "); see " << actualPath << ", " << expectedPath
                                       << " and " << diffPath;
}

}  // namespace norvik::drawbot::testing
