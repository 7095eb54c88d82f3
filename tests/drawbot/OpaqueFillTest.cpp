// Opaque whole-pixel rectangles written straight into memory match the general fill.
#include <gtest/gtest.h>
#include "support/drawbot/PixelCompare.h"

namespace norvik::drawbot {
namespace {

using tarsel::geom::MatrixT;
using tarsel::geom::RectT;
struct FillCase {
  const char* name;
  ColorRGBA color;
  RectT<float> rect, clip;  // a clip 1 wide is a circle; 0 wide, none
  MatrixT<float> transform;
};
void Draw(testing::PixelCanvas& ioCanvas, const FillCase& inCase, bool inAsPath) {
  SurfaceInterface* surface = ioCanvas.GetSurface();
  surface->PushStateStack();
  surface->Transform(inCase.transform);
  PathP clip(ioCanvas.GetSupplier()), path(ioCanvas.GetSupplier());
  if (inCase.clip.width == 1) clip->AddArc(tarsel::geom::PointT<float>(10, 10), 6, 0, 360);
  if (inCase.clip.width > 1) clip->AddRect(inCase.clip);
  if (inCase.clip.width > 0) surface->Clip(*clip, kFillWinding);
  const RectT<float>& r = inCase.rect;
  path->AddRect(RectT<float>::FromEdges(std::floor(r.left), std::floor(r.top), std::ceil(r.Right()),
                                        std::ceil(r.Bottom())));
  if (inAsPath) surface->FillPath(*BrushP(ioCanvas.GetSupplier(), inCase.color), *path, kFillWinding);
  if (!inAsPath) surface->PaintRect(inCase.color, r);
  surface->PopStateStack();
}

TEST(OpaqueFill, PaintedRectanglesGiveThePixelsOfTheGeneralFillInEveryClipAndTransform) {
  const MatrixT<float> none, moved = MatrixT<float>::Translation(3, 4), half = MatrixT<float>::Translation(0.5f, 0);
  const RectT<float> whole(0, 0, 20, 20);
  const FillCase cases[] = {
      {"odd channels", ColorRGBA(1.0f / 255, 0.4999f, 0.998f, 1), whole, {}, none},
      {"out of range", ColorRGBA(-0.5f, 1.5f, 0.7f, 2), RectT<float>(5, 5, 4, 4), {}, none},
      {"widened fraction", ColorRGBA(0.9f, 0.2f, 0.2f, 1), RectT<float>(2.5f, 1.25f, 4, 1.5f), {}, none},
      {"past the edges", ColorRGBA(0.3f, 0.3f, 0.9f, 1), RectT<float>(-4, 15, 40, 10), {}, none},
      {"moved box clip", ColorRGBA(0.6f, 0.1f, 0.5f, 1), RectT<float>(0, 0, 9, 9), RectT<float>(2, 2, 5, 30), moved},
      {"fractional clip", ColorRGBA(0.6f, 0.6f, 0.1f, 1), whole, RectT<float>(2.5f, 3.5f, 6, 6), none},
      {"circle clip", ColorRGBA(0.4f, 0.7f, 0.9f, 1), whole, RectT<float>(0, 0, 1, 1), none},
      {"half-pixel move", ColorRGBA(0.5f, 0.5f, 0.5f, 1), RectT<float>(2, 2, 6, 6), {}, half},
      {"translucent", ColorRGBA(0.7f, 0.3f, 0.1f, 0.5f), RectT<float>(1, 1, 9, 9), {}, none},
  };
  for (const FillCase& c : cases) {
    testing::PixelCanvas fast(20, 20), general(20, 20);
    for (auto* canvas : {&fast, &general}) canvas->Clear(0x204060);
    Draw(fast, c, false), Draw(general, c, true);
    EXPECT_EQ(fast.Snapshot().pixels, general.Snapshot().pixels) << c.name;
  }
}

}  // namespace
}  // namespace norvik::drawbot
