// Drawing speed on the image back end: many small rectangles, many short
// labels with a cached font, and putting back a cached node.
#include <benchmark/benchmark.h>

#include "drawbot/DrawbotWrappers.h"

namespace {

using norvik::drawbot::BrushP;
using norvik::drawbot::ColorRGBA;
using norvik::drawbot::FontP;
using norvik::drawbot::NewOSSupplier;
using norvik::drawbot::SurfaceP;
using tarsel::geom::MatrixT;
using tarsel::geom::PointT;
using tarsel::geom::RectT;

void FillSmallRectangles(benchmark::State& state) {
  SurfaceP surface(NewOSSupplier(), 1920, 1080);
  for (auto _ : state) {
    for (int i = 0; i < 10000; ++i) {
      float x = static_cast<float>((i * 37) % 1900), y = static_cast<float>((i * 53) % 1060);
      surface->PaintRect(ColorRGBA(0.1f * (i % 10), 0.5f, 0.3f, 1), RectT<float>(x, y, 12, 8));
    }
    surface->Flush();
  }
  state.SetItemsProcessed(state.iterations() * 10000);
}
BENCHMARK(FillSmallRectangles)->Unit(benchmark::kMillisecond);

void DrawShortLabels(benchmark::State& state) {
  SurfaceP surface(NewOSSupplier(), 1920, 1080);
  surface->SetAntiAliasPolicy(norvik::drawbot::kAntiAlias);
  FontP font(NewOSSupplier(), u"DejaVu Sans", u"", 12);
  BrushP brush(NewOSSupplier(), ColorRGBA(0.9f, 0.9f, 0.9f, 1));
  const char16_t* labels[4] = {u"Audio 1 Gain", u"Video Track 2", u"Clip 00:01:02", u"Master Bus A"};
  for (auto _ : state) {
    for (int i = 0; i < 1000; ++i) {
      auto const* text = reinterpret_cast<unsigned short const*>(labels[i % 4]);
      surface->DrawString(*brush, *font, text, PointT<float>(static_cast<float>((i * 97) % 1800), 14.0f + (i % 70) * 15),
                          norvik::drawbot::kTextAlignLeft, norvik::drawbot::kTextTruncationNone, 0);
    }
    surface->Flush();
  }
  state.SetItemsProcessed(state.iterations() * 1000);
}
BENCHMARK(DrawShortLabels)->Unit(benchmark::kMillisecond);

void DrawCachedNode(benchmark::State& state) {
  SurfaceP surface(NewOSSupplier(), 1920, 1080);
  RectT<float> rect(0, 0, 400, 300);
  surface->Transform(MatrixT<float>::Translation(100, 200));
  auto cache = surface->PushCacheStack(rect);
  cache->GetSurface()->PaintRect(ColorRGBA(0.2f, 0.2f, 0.25f, 1), RectT<float>(0, 0, 400, 300));
  surface->PopCacheStack(cache);
  int step = 0;
  for (auto _ : state) {
    // Scrolling by whole pixels keeps the cache valid.
    surface->PushStateStack();
    surface->Transform(MatrixT<float>::Translation(0, static_cast<float>(step++ % 50)));
    if (!cache->IsValid(*surface, rect)) state.SkipWithError("cache went invalid on a whole-pixel scroll");
    surface->DrawCache(*cache);
    surface->PopStateStack();
  }
  surface->Flush();
}
BENCHMARK(DrawCachedNode)->Unit(benchmark::kMicrosecond);

}  // namespace
