#pragma once
// Pixel tests: a canvas that draws through the image back end into memory
// that the test can read, and a comparison with stored reference PNGs under
// tests/data/ that writes the actual image and a difference image to the test
// output folder when they differ.
#include <cstdint>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "drawbot/DrawbotWrappers.h"

namespace norvik::drawbot::testing {

// Premultiplied pixels, 0xAARRGGBB, row after row.
struct PixelImage {
  int width = 0;
  int height = 0;
  std::vector<std::uint32_t> pixels;

  std::uint32_t At(int x, int y) const { return pixels[static_cast<size_t>(y * width + x)]; }
  std::uint8_t Alpha(int x, int y) const { return static_cast<std::uint8_t>(At(x, y) >> 24); }
};

// A surface of the platform supplier over pixels that the test owns.
class PixelCanvas {
 public:
  PixelCanvas(int inWidth, int inHeight);
  SupplierInterface const* GetSupplier() const { return mSupplier; }
  SurfaceInterface* GetSurface() const { return mSurface.Get(); }
  PixelImage Snapshot() const;
  // Fills every pixel with one opaque colour (0xRRGGBB).
  void Clear(std::uint32_t inRGB);

 private:
  int mWidth, mHeight;
  std::vector<std::uint32_t> mPixels;
  SupplierInterface const* mSupplier;
  SurfaceP mSurface;
};

// The columns of row y whose alpha is above 0, as a string of '#' and '.'.
std::string RowCoverage(PixelImage const& inImage, int inY);
std::string ColumnCoverage(PixelImage const& inImage, int inX);

bool LoadPNG(std::string const& inPath, PixelImage* outImage);
bool SavePNG(PixelImage const& inImage, std::string const& inPath);

// Compares with NORVIK_TEST_DATA_DIR/<inName>.png, allowing each channel to
// differ by inTolerance. With NORVIK_UPDATE_REFERENCES=1 in the environment a
// missing reference is written instead (and the check fails, so that it is
// looked at before it is committed).
::testing::AssertionResult MatchesReference(PixelImage const& inActual, std::string const& inName,
                                            int inTolerance = 2);

// Compares two images of one size, allowing each channel to differ by
// inTolerance. On a difference writes <inName>-actual.png, -expected.png and
// -diff.png (differing pixels in red) to the test output folder.
::testing::AssertionResult MatchesImage(PixelImage const& inActual, PixelImage const& inExpected,
                                        std::string const& inName, int inTolerance = 2);

}  // namespace norvik::drawbot::testing
