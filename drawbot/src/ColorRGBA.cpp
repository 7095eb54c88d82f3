// Colour packing, pixel swizzles and the process-wide redraw flash delay.
#include <cmath>
#include <cstdint>
#include <utility>

#include "drawbot/Drawbot.h"

namespace norvik::drawbot {

namespace {

std::uint32_t ToByte(float inChannel) {
  double v = std::round(static_cast<double>(inChannel) * 255.0);  // halves away from zero
  if (!(v > 0)) return 0;
  if (v > 255) return 255;
  return static_cast<std::uint32_t>(v);
}

unsigned long gFlashDelay = 0;

}  // namespace

std::uint32_t ColorRGBA::ToPacked() const {
  return (ToByte(alpha) << 24) | (ToByte(red) << 16) | (ToByte(green) << 8) | ToByte(blue);
}

ColorRGBA ColorRGBA::FromPacked(std::uint32_t inARGB) {
  return ColorRGBA(static_cast<float>((inARGB >> 16) & 0xff) / 255.0f,
                   static_cast<float>((inARGB >> 8) & 0xff) / 255.0f, static_cast<float>(inARGB & 0xff) / 255.0f,
                   static_cast<float>(inARGB >> 24) / 255.0f);
}

template <>
void inplace_swizzle<4, 5>(void* ioPixels, long inCount) {
  auto* p = static_cast<unsigned char*>(ioPixels);
  for (long i = 0; i < inCount; ++i, p += 4) {
    unsigned a = p[0];
    if (a == 255) continue;
    for (int c = 1; c < 4; ++c) p[c] = static_cast<unsigned char>(p[c] * (a / 255.0));
  }
}

template <>
void inplace_swizzle<5, 4>(void* ioPixels, long inCount) {
  auto* p = static_cast<unsigned char*>(ioPixels);
  for (long i = 0; i < inCount; ++i, p += 4) {
    unsigned a = p[0];
    if (a == 255 || a == 0) continue;
    for (int c = 1; c < 4; ++c) {
      double v = p[c] / (a / 255.0);
      p[c] = static_cast<unsigned char>(v > 255 ? 255 : v);
    }
  }
}

template <>
void inplace_swizzle<4, 6>(void* ioPixels, long inCount) {
  auto* p = static_cast<unsigned char*>(ioPixels);
  for (long i = 0; i < inCount; ++i, p += 4) {
    std::swap(p[0], p[3]);
    std::swap(p[1], p[2]);
  }
}

template <>
void inplace_swizzle<6, 4>(void* ioPixels, long inCount) {
  inplace_swizzle<4, 6>(ioPixels, inCount);
}

void SetRedrawDebugFlashDelay(unsigned long inMilliseconds) { gFlashDelay = inMilliseconds; }
unsigned long GetRedrawDebugFlashDelay() { return gFlashDelay; }

}  // namespace norvik::drawbot
