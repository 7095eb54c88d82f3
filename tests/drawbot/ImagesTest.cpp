// Images: PNG decoding, caller's pixel buffers, scaling, opacity and surface images.
#include <cstdio>
#include <fstream>
#include <iterator>

#include <cairo.h>
#include <gtest/gtest.h>

#include <filesystem>

#include "drawbot/Drawbot.h"
#include "drawbot/DrawbotWrappers.h"
#include "support/drawbot/PixelCompare.h"
#include "support/drawbot/RecordingSupplier.h"
#include "support/tarsel/ErrorText.h"
#include "tarsel/ThrowError.h"

namespace norvik::drawbot {
namespace {

using tarsel::geom::PointT;
using tarsel::geom::RectT;
using testing::PixelCanvas;
using testing::PixelImage;

using norvik::test::ErrorOf;

// A 4 x 3 picture with opaque, half-transparent and empty pixels.
PixelImage Checker() {
  PixelImage image{4, 3, {}};
  for (int y = 0; y < 3; ++y)
    for (int x = 0; x < 4; ++x)
      image.pixels.push_back((x + y) % 3 == 0 ? 0xffff0000u : (x + y) % 3 == 1 ? 0x80008000u : 0x00000000u);
  return image;
}

std::string TempPath(char const* inName) { return std::string(NORVIK_TEST_OUTPUT_DIR) + "/" + inName; }

TEST(PngRoundTrip, ADecodedFileOrItsBytesInMemoryDrawTheSamePixelsThatWereSaved) {
  std::string path = TempPath("roundtrip.png");
  std::filesystem::create_directories(NORVIK_TEST_OUTPUT_DIR);
  ASSERT_TRUE(testing::SavePNG(Checker(), path));
  PixelCanvas canvas(4, 3);
  FileImageP image(canvas.GetSupplier(), kImageFileTypePNG, path.c_str(), 0);
  ASSERT_FALSE(image.IsNull());
  EXPECT_EQ(image->GetWidth(), 4u);
  EXPECT_EQ(image->GetHeight(), 3u);
  canvas.GetSurface()->DrawImage(*image, PointT<float>(0, 0), 1);
  EXPECT_EQ(canvas.Snapshot().pixels, Checker().pixels);

  std::ifstream file(path, std::ios::binary);
  std::string bytes((std::istreambuf_iterator<char>(file)), std::istreambuf_iterator<char>());
  PixelCanvas memory(4, 3);
  FileImageP fromBytes(memory.GetSupplier(), kImageFileTypePNG, bytes.data(), static_cast<unsigned long>(bytes.size()));
  memory.GetSurface()->DrawImage(*fromBytes, PointT<float>(0, 0), 1);
  EXPECT_EQ(memory.Snapshot().pixels, Checker().pixels);
}

TEST(PngRoundTrip, UnreadableImagesRaiseTheReadError) {
  SupplierInterface const* supplier = NewOSSupplier();
  char const garbage[] = "definitely not a png";
  EXPECT_EQ(ErrorOf([&] { FileImageP(supplier, kImageFileTypePNG, garbage, sizeof garbage); }),
            "Unable to read image file.");
  EXPECT_EQ(ErrorOf([&] { FileImageP(supplier, kImageFileTypePNG, "/nonexistent/picture.png", 0); }),
            "Unable to read image file.");
  EXPECT_EQ(ErrorOf([&] { FileImageP(supplier, static_cast<ImageFileType>(5), garbage, sizeof garbage); }),
            "Unable to read image file.");
}

TEST(BufferImages, TheDeleterKeepsThePixelsAliveAsLongAsTheImage) {
  static int deleted = 0;
  deleted = 0;
  auto* pixels = new unsigned char[16]();
  boost::intrusive_ptr<DataDeleter> deleter(
      new DataDeleter(pixels, [](void* p) { delete[] static_cast<unsigned char*>(p); ++deleted; }));
  {
    BufferImageP image(NewOSSupplier(), 2, 2, 8, kPixelLayoutBGRAPremul, pixels, deleter);
    deleter.reset();
    EXPECT_EQ(deleted, 0);
  }
  EXPECT_EQ(deleted, 1);
}

TEST(BufferImages, MissingPixelsRaiseTheBufferError) {
  EXPECT_EQ(ErrorOf([] { BufferImageP(NewOSSupplier(), 2, 2, 8, kPixelLayoutBGRAPremul, nullptr, nullptr); }),
            "Unable to create image buffer.");
  unsigned char pixels[4] = {};
  EXPECT_EQ(ErrorOf([&] { BufferImageP(NewOSSupplier(), 2, 2, 2, kPixelLayoutBGRAPremul, pixels, nullptr); }),
            "Unable to create image buffer.");
}

TEST(DrawImageScaled, AnImageIsScaledIntoItsDestinationAndClippedToIt) {
  unsigned char pixels[16] = {0, 0, 0, 255, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 255};  // black top-left, bottom-right
  PixelCanvas canvas(10, 10);
  BufferImageP image(canvas.GetSupplier(), 2, 2, 8, kPixelLayoutBGRAPremul, pixels, nullptr);
  canvas.GetSurface()->DrawImage(*canvas.GetSupplier(), *image, RectT<float>(2, 2, 6, 6), nullptr, 1);
  auto shot = canvas.Snapshot();
  EXPECT_EQ(testing::RowCoverage(shot, 2), "..###.....");
  EXPECT_EQ(testing::RowCoverage(shot, 7), ".....###..");
  EXPECT_EQ(testing::RowCoverage(shot, 8), "..........");
  // The natural-size test looks at the horizontal factor alone: a destination
  // as wide as the image draws it unscaled, clipped to the destination.
  PixelCanvas tall(10, 10);
  tall.GetSurface()->DrawImage(*tall.GetSupplier(), *image, RectT<float>(2, 2, 2, 6), nullptr, 1);
  EXPECT_EQ(testing::RowCoverage(tall.Snapshot(), 3), "...#......");
  EXPECT_EQ(testing::RowCoverage(tall.Snapshot(), 5), "..........");
}

TEST(DrawImageScaled, ASourceRectanglePicksPartOfTheImage) {
  unsigned char pixels[16] = {0, 0, 0, 255, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 255};
  PixelCanvas canvas(6, 6);
  BufferImageP image(canvas.GetSupplier(), 2, 2, 8, kPixelLayoutBGRAPremul, pixels, nullptr);
  RectT<float> bottomRight(1, 1, 1, 1);
  canvas.GetSurface()->DrawImage(*canvas.GetSupplier(), *image, RectT<float>(1, 1, 3, 3), &bottomRight, 1);
  auto shot = canvas.Snapshot();
  EXPECT_EQ(testing::RowCoverage(shot, 0), "......");
  EXPECT_EQ(testing::RowCoverage(shot, 2), ".###..");
  EXPECT_EQ(testing::RowCoverage(shot, 4), "......");
}

TEST(DrawImageScaled, OpacityScalesAlphaAndValuesOutsideTheRangeDrawNothing) {
  unsigned char pixels[4] = {0, 0, 0, 255};
  PixelCanvas canvas(3, 1);
  BufferImageP image(canvas.GetSupplier(), 1, 1, 4, kPixelLayoutBGRAPremul, pixels, nullptr);
  canvas.GetSurface()->DrawImage(*image, PointT<float>(0, 0), 0.5f);
  canvas.GetSurface()->DrawImage(*image, PointT<float>(1, 0), 0);
  canvas.GetSurface()->DrawImage(*image, PointT<float>(2, 0), 1.01f);
  auto shot = canvas.Snapshot();
  EXPECT_NEAR(shot.Alpha(0, 0), 128, 1);
  EXPECT_EQ(shot.Alpha(1, 0), 0);
  EXPECT_EQ(shot.Alpha(2, 0), 0);
}

TEST(DrawImageScaled, ANaturalSizeDrawTurnsAntiAliasingOffOnlyInsideItsState) {
  testing::RecordingSupplier supplier;
  SurfaceP surface(supplier.NewOffscreenSurface(50, 50, false));
  ImageP image(supplier.NewBufferImage(8, 8, 32, kPixelLayoutBGRAPremul, nullptr, nullptr));
  surface->SetAntiAliasPolicy(kAntiAlias);
  surface->DrawImage(supplier, *image, RectT<float>(5, 5, 8, 8), nullptr, 1);
  surface->DrawImage(supplier, *image, RectT<float>(5, 5, 16, 8), nullptr, 1);
  std::vector<std::string> expected = {"Push", "Clip", "DrawImage", "Pop", "Push", "Clip", "DrawImage", "Pop"};
  ASSERT_EQ(supplier.GetOps(), expected);
  EXPECT_EQ(supplier.GetCalls()[2].antiAlias, kAntiAliasNone);
  EXPECT_EQ(supplier.GetCalls()[2].transform, tarsel::geom::MatrixT<float>::Translation(5, 5));
  EXPECT_EQ(supplier.GetCalls()[6].antiAlias, kAntiAlias);
  EXPECT_EQ(supplier.GetCalls()[6].transform, tarsel::geom::MatrixT<float>(2, 0, 0, 1, 5, 5));
  EXPECT_EQ(surface->GetAntiAliasPolicy(), kAntiAlias);
  supplier.SetSmoothingNeeded(true);
  surface->DrawImage(supplier, *image, RectT<float>(5, 5, 8, 16), nullptr, 1);
  EXPECT_EQ(supplier.GetCalls()[10].transform, tarsel::geom::MatrixT<float>(1, 0, 0, 2, 5, 5)) << "scaled, smoothed";
}

TEST(SurfaceImages, AnOffscreenSurfaceGivesItsPixelsAsAnImage) {
  SupplierInterface const* supplier = NewOSSupplier();
  SurfaceP surface(supplier, 4, 4);
  surface->PaintRect(ColorRGBA(0, 0, 1, 1), RectT<float>(1, 1, 2, 2));
  ImageP image(surface->GetSurfaceImage());
  PixelCanvas canvas(4, 4);
  canvas.GetSurface()->DrawImage(*image, PointT<float>(0, 0), 1);
  EXPECT_EQ(canvas.Snapshot().At(1, 1), 0xff0000ffu);
  EXPECT_EQ(canvas.Snapshot().At(0, 0), 0u);
}

TEST(SurfaceImages, ABufferSurfaceOverTwentyFourBitOrStraightPixelsWritesTheDrawingBack) {
  unsigned char rgb[8] = {};
  unsigned char bgra[8] = {};
  for (auto [layout, data] : {std::pair{kPixelLayoutRGB24, rgb}, std::pair{kPixelLayoutBGRA, bgra}}) {
    boost::intrusive_ptr<SurfaceInterface> surface(NewOSSupplier()->NewBufferSurface(2, 1, 8, layout, data, nullptr));
    surface->PaintRect(ColorRGBA(1, 0, 0, 1), RectT<float>(0, 0, 1, 1));
    surface->PaintRect(ColorRGBA(0, 0, 1, 0.5f), RectT<float>(1, 0, 1, 1));
    surface->Flush();
  }
  EXPECT_EQ(std::vector<int>(rgb, rgb + 6), (std::vector<int>{0, 0, 255, 128, 0, 0})) << "blended over black";
  EXPECT_EQ(std::vector<int>(bgra, bgra + 8), (std::vector<int>{0, 0, 255, 255, 255, 0, 0, 128}))
      << "alpha kept straight";
}

TEST(SurfaceImages, ABufferedSurfaceReachesItsTargetOnFlush) {
  // The image stands in for a window's target: a buffered surface over it
  // draws into memory and copies out on Flush.
  cairo_surface_t* target = cairo_image_surface_create(CAIRO_FORMAT_ARGB32, 6, 2);
  {
    OSSurfaceP surface(NewOSSupplier(), target, nullptr, true);
    surface->PaintRect(ColorRGBA(0, 0, 0, 1), RectT<float>(0, 0, 3, 2));
    cairo_surface_flush(target);
    EXPECT_EQ(cairo_image_surface_get_data(target)[3], 0) << "drawn before Flush";
    EXPECT_EQ(ErrorOf([&] { surface->GetSurfaceImage(); }), "Invalid surface image.");
    surface->Flush();
    cairo_surface_flush(target);
    EXPECT_EQ(cairo_image_surface_get_data(target)[3], 255);
    EXPECT_EQ(cairo_image_surface_get_data(target)[4 * 4 + 3], 0);
  }
  cairo_surface_destroy(target);
}

TEST(SurfaceImages, WithAFlashDelayTheTargetStillEndsWithTheDrawing) {
  cairo_surface_t* target = cairo_image_surface_create(CAIRO_FORMAT_ARGB32, 4, 1);
  SetRedrawDebugFlashDelay(1);
  {
    OSSurfaceP surface(NewOSSupplier(), target, nullptr, true);
    surface->PaintRect(ColorRGBA(0, 1, 0, 1), RectT<float>(0, 0, 2, 1));
    surface->Flush();
  }
  SetRedrawDebugFlashDelay(0);
  cairo_surface_flush(target);
  auto const* pixels = reinterpret_cast<uint32_t const*>(cairo_image_surface_get_data(target));
  EXPECT_EQ(pixels[0], 0xff00ff00u);
  EXPECT_EQ(pixels[3], 0u);  // the flash does not stay behind
  cairo_surface_destroy(target);
}

TEST(BufferImages, StraightBGRAIsPremultipliedAndPixelsWithoutAlphaAreDrawnOpaque) {
  unsigned char straight[8] = {0, 0, 255, 128, /* */ 255, 0, 0, 255};  // half-transparent red, opaque blue
  PixelCanvas premultiplied(2, 1);
  BufferImageP bgra(premultiplied.GetSupplier(), 2, 1, 8, kPixelLayoutBGRA, straight, nullptr);
  premultiplied.GetSurface()->DrawImage(*bgra, PointT<float>(0, 0), 1);
  EXPECT_EQ(premultiplied.Snapshot().At(0, 0), 0x80800000u);
  EXPECT_EQ(premultiplied.Snapshot().At(1, 0), 0xff0000ffu);
  unsigned char pixels[8] = {10, 20, 30, 40, 50, 60, 0, 0};  // B, G, R per pixel, rows of 8 bytes
  PixelCanvas canvas(2, 1);
  BufferImageP image(canvas.GetSupplier(), 2, 1, 8, kPixelLayoutRGB24, pixels, nullptr);
  canvas.GetSurface()->DrawImage(*image, PointT<float>(0, 0), 1);
  EXPECT_EQ(canvas.Snapshot().At(0, 0), 0xff1e140au);
  EXPECT_EQ(canvas.Snapshot().At(1, 0), 0xff3c3228u);
  // 32-bit pixels without alpha in rows Cairo cannot wrap are copied, still opaque.
  unsigned char padded[10] = {10, 20, 30, 0, 40, 50, 60, 0, 0, 0};
  PixelCanvas fresh(2, 1);
  BufferImageP unwrapped(fresh.GetSupplier(), 2, 1, 10, kPixelLayoutRGB32, padded, nullptr);
  fresh.GetSurface()->DrawImage(*unwrapped, PointT<float>(0, 0), 1);
  EXPECT_EQ(fresh.Snapshot().At(1, 0), 0xff3c3228u);
}

}  // namespace
}  // namespace norvik::drawbot
