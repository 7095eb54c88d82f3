// Colour values, HSB, swizzles, colour management, monitors, shape helpers
// and pixel buffers.
#include <stdexcept>

#include <gtest/gtest.h>

#include "drawbot/ColorManagement.h"
#include "drawbot/DrawHelpers.h"
#include "drawbot/MemBuffer.h"
#include "support/drawbot/RecordingSupplier.h"
#include "tarsel/ErrorManager.h"
#include "tarsel/ThrowError.h"

namespace norvik::drawbot {
namespace {

using tarsel::geom::PointT;
using tarsel::geom::RectT;
using testing::RecordingPath;
using testing::RecordingSupplier;

TEST(ColorPacking, ChannelsRoundHalfAwayFromZeroIntoARGB) {
  EXPECT_EQ(ColorRGBA(1, 0, 0, 1).ToPacked(), 0xffff0000u);
  EXPECT_EQ(ColorRGBA(0, 0.5f, 0, 0.5f).ToPacked(), 0x80008000u);  // 127.5 rounds up
  EXPECT_EQ(ColorRGBA(0.2f, 0.4f, 0.6f, 0).ToPacked(), 0x00336699u);
  EXPECT_EQ(ColorRGBA(2, -1, 0, 1).ToPacked(), 0xffff0000u);
  EXPECT_EQ(ColorRGBA::FromPacked(0x80ff0000u).ToPacked(), 0x80ff0000u);
}

TEST(HSB, PrimaryAndGreyColoursConvertAndEverySectorRoundTrips) {
  EXPECT_EQ(HSBtoRGB<float>(0, 1, 1, 1), ColorRGBA(1, 0, 0, 1));
  EXPECT_EQ(HSBtoRGB<double>(200, 0, 0.5, 0.25f), ColorRGBA(0.5f, 0.5f, 0.5f, 0.25f));
  double h, s, b;
  RGBtoHSB(ColorRGBA(0, 0, 1, 1), h, s, b);
  EXPECT_DOUBLE_EQ(h, 240);
  EXPECT_DOUBLE_EQ(s, 1);
  EXPECT_DOUBLE_EQ(b, 1);
  for (float hue = 5; hue < 360; hue += 37) {
    RGBtoHSB(HSBtoRGB<double>(hue, 0.6, 0.7, 1), h, s, b);
    EXPECT_NEAR(h, hue, 1e-3);
    EXPECT_NEAR(s, 0.6, 1e-5);
    EXPECT_NEAR(b, 0.7, 1e-5);
  }
}

TEST(Swizzle, PremultiplyingAndDividingOutAlphaLeaveOpaqueAndTransparentPixelsAndReversingIsItsOwnInverse) {
  unsigned char straight[8] = {128, 255, 100, 2, /* */ 255, 10, 20, 30};
  inplace_swizzle<4, 5>(straight, 2);
  EXPECT_EQ(std::vector<int>(straight, straight + 8), (std::vector<int>{128, 128, 50, 1, 255, 10, 20, 30}));
  unsigned char premultiplied[12] = {0, 9, 8, 7, /* */ 128, 64, 32, 0, /* */ 255, 1, 2, 3};
  inplace_swizzle<5, 4>(premultiplied, 3);
  EXPECT_EQ(std::vector<int>(premultiplied, premultiplied + 12),
            (std::vector<int>{0, 9, 8, 7, 128, 127, 63, 0, 255, 1, 2, 3}));
  unsigned char px[4] = {1, 2, 3, 4};
  inplace_swizzle<4, 6>(px, 1);
  EXPECT_EQ(std::vector<int>(px, px + 4), (std::vector<int>{4, 3, 2, 1}));
  inplace_swizzle<6, 4>(px, 1);
  EXPECT_EQ(std::vector<int>(px, px + 4), (std::vector<int>{1, 2, 3, 4}));
}

struct AppData : OpaqueApplicationData {};

int gCallbackCalls = 0;
void CountingCallback(ColorDestinationProfile const&, OpaqueApplicationData const&, void*) { ++gCallbackCalls; }

TEST(ColorManagement, AManagedVisualCallsTheCallbackAndWithoutOneOrForAnUnmanagedVisualManageRaises) {
  SetColorManagementCallback(nullptr);
  boost::intrusive_ptr<ManagedImage> managed(new ManagedImage());
  EXPECT_THROW(managed->Manage(ImageDestinationProfile(), AppData(), nullptr), tarsel::config::Exception);
  gCallbackCalls = 0;
  SetColorManagementCallback(&CountingCallback);
  managed->Manage(ImageDestinationProfile(), AppData(), nullptr);
  EXPECT_EQ(gCallbackCalls, 1) << "a managed visual calls the installed callback";
  boost::intrusive_ptr<UnManagedRGBA> plain(new UnManagedRGBA(ColorRGBA(1, 0, 0, 1)));
  try {
    plain->Manage(ColorDestinationProfile(), AppData(), nullptr);
    FAIL() << "managing an unmanaged colour was accepted";
  } catch (tarsel::config::Exception const& e) {
    EXPECT_STREQ(e.what(), "Color management callback not registered.");
  }
  SetColorManagementCallback(nullptr);
}

// Two side-by-side monitors of 100 x 100.
class TwoMonitors : public MonitorSource {
 public:
  long GetMonitorCount() const override { return 2; }
  bool GetMonitorRect(long i, RectT<long>* out) const override {
    if (failing) return false;
    *out = RectT<long>(i * 100, 0, 100, 100);
    return true;
  }
  void const* GetMonitorIDFromRect(RectT<long> const& r) const override { return r.left < 100 ? &a : &b; }
  bool failing = false;
  int a = 0, b = 0;
};

class Monitors : public ::testing::Test {
 protected:
  void SetUp() override { SetMonitorSource(&monitors); }
  void TearDown() override { SetMonitorSource(nullptr); }
  TwoMonitors monitors;
};

TEST_F(Monitors, ARectangleIsSplitAtTheBorderInMonitorOrder) {
  auto pieces = SubdivideByMonitor(RectT<long>(80, 10, 40, 20));
  ASSERT_EQ(pieces.size(), 2u);
  EXPECT_EQ(pieces[0].first, RectT<long>(80, 10, 20, 20));
  EXPECT_EQ(pieces[0].second, &monitors.a);
  EXPECT_EQ(pieces[1].first, RectT<long>(100, 10, 20, 20));
  EXPECT_EQ(pieces[1].second, &monitors.b);
  EXPECT_TRUE(SubdivideByMonitor(RectT<long>(300, 300, 10, 10)).empty());
}

TEST_F(Monitors, AFailedQueryRaisesBugInMonitorInfo) {
  monitors.failing = true;
  try {
    SubdivideByMonitor(RectT<long>(0, 0, 10, 10));
    FAIL();
  } catch (std::runtime_error const& e) {
    EXPECT_STREQ(e.what(), "Bug in MonitorInfo");
  }
}

class CountingColor : public UnManagedColor {
 public:
  ColorRGBA Convert(ColorDestinationProfile const& inProfile) override {
    ids.push_back(inProfile.GetDisplayID());
    return ColorRGBA(0, 1, 0, 1);
  }
  std::vector<void const*> ids;
};

TEST_F(Monitors, AColourManagedRectangleIsConvertedOncePerMonitorAndCoversTheRectangle) {
  RecordingSupplier supplier;
  SurfaceP surface(supplier.NewOffscreenSurface(200, 100, false));
  Drawbot drawbot(&supplier, surface.Get());
  boost::intrusive_ptr<CountingColor> color(new CountingColor());
  // Surface origin at global (50, 0): local 30.5 .. 70.2 is global 80.5 .. 120.2.
  PaintColorManagedRect(drawbot, RectT<float>(30.5f, 5, 39.7f, 10), PointT<long>(50, 0), color);
  EXPECT_EQ(color->ids, (std::vector<void const*>{&monitors.a, &monitors.b}));
  ASSERT_EQ(supplier.GetCalls().size(), 2u);
  EXPECT_EQ(supplier.GetCalls()[0].rect, RectT<float>(30, 5, 20, 10));
  EXPECT_EQ(supplier.GetCalls()[1].rect, RectT<float>(50, 5, 21, 10));
}

class SolidImage : public UnManagedImage {
 public:
  void Convert(ImageDestinationProfile const& inProfile, void* outDest) const override {
    layouts.push_back(inProfile.GetPixelLayout());
    auto* p = static_cast<unsigned char*>(outDest);
    RectT<long> r = inProfile.GetSubregion();
    for (long i = 0; i < r.width * r.height; ++i) {
      p[4 * i] = 255;  // A, R, G, B
      p[4 * i + 1] = 255;
    }
  }
  mutable std::vector<PixelLayout> layouts;
};

TEST_F(Monitors, AColourManagedImageIsConvertedPerMonitorAndDrawnAtEachPiece) {
  RecordingSupplier supplier;
  SurfaceP surface(supplier.NewOffscreenSurface(200, 100, false));
  Drawbot drawbot(&supplier, surface.Get());
  boost::intrusive_ptr<SolidImage> image(new SolidImage());
  PaintColorManagedImage(drawbot, RectT<float>(90, 0, 20, 4), PointT<long>(0, 0), image);
  // The layout is left at 6 after the first piece.
  EXPECT_EQ(image->layouts, (std::vector<PixelLayout>{kPixelLayoutARGB, kPixelLayoutBGRA}));
  ASSERT_EQ(supplier.GetCalls().size(), 2u);
  EXPECT_EQ(supplier.GetCalls()[0].rect, RectT<float>(90, 0, 10, 4));
  EXPECT_EQ(supplier.GetCalls()[1].rect, RectT<float>(100, 0, 10, 4));
}

TEST(ShapeHelpers, ANullSupplierKeepsTheExistingPath) {
  RecordingSupplier supplier;
  PathP path(&supplier);
  PathInterface* before = path.Get();
  GetEllipsePath(nullptr, RectT<float>(0, 0, 20, 10), &path);
  EXPECT_EQ(path.Get(), before);
}

TEST(ShapeHelpers, ARadiusBeyondHalfTheSideMakesTheCornersMeetAndRadiusZeroIsAPlainRectangle) {
  RecordingSupplier supplier;
  PathP path;
  GetRoundedRectPath(&supplier, RectT<float>(0, 0, 40, 10), 8, &path);
  auto const& points = dynamic_cast<RecordingPath const&>(*path).GetPoints();
  // The right side: the top right corner ends where the bottom right one starts.
  EXPECT_EQ(points[4], PointT<float>(40, 5));
  EXPECT_EQ(points[5], PointT<float>(40, 5));
  GetRoundedRectPath(&supplier, RectT<float>(1, 2, 30, 20), 0, &path);
  EXPECT_EQ(dynamic_cast<RecordingPath const&>(*path).GetDescription(), "R 1 2 30 20") << "radius zero: a rectangle";
}

TEST(MemBuffers, RowsAreSixteenByteAlignedAndChannelsSwap) {
  boost::intrusive_ptr<MemBuffer> buffer(new MemBuffer(5, 3, 3));
  EXPECT_EQ(buffer->GetRowBytes(), 16);
  EXPECT_EQ(reinterpret_cast<std::uintptr_t>(buffer->GetDataPtr()) % 16, 0u);
  buffer->ClearBuffer();
  unsigned char* row1 = buffer->GetDataPtr() + buffer->GetRowBytes();
  row1[0] = 1;
  row1[2] = 3;
  buffer->SwapColorChannels();
  EXPECT_EQ(row1[0], 3);
  EXPECT_EQ(row1[2], 1);
  boost::intrusive_ptr<MemBuffer> wide(new MemBuffer(17, 2, 4));
  EXPECT_EQ(wide->GetRowBytes(), 80);
}

TEST(MemBuffers, AllocationGoesThroughTheErrorManagerWithThreeAttemptsAndRaisesOutOfMemory) {
  auto* manager = tarsel::config::ErrorManager::Get(true);
  std::vector<std::size_t> requests;
  manager->SetBlockFunctions([&](std::size_t inSize) -> void* { requests.push_back(inSize); return nullptr; },
                             [](void*) {});
  try {
    MemBuffer failing(5, 3, 3);
    ADD_FAILURE() << "a failed allocation built a buffer";
  } catch (tarsel::config::Exception const& error) {
    EXPECT_EQ(error.GetKeyPath(), "tarsel/config/Error/OutOfMemory");
  }
  manager->SetBlockFunctions({}, {});
  EXPECT_EQ(requests, (std::vector<std::size_t>(3, 16 * 3 + 16)));
}

}  // namespace
}  // namespace norvik::drawbot
