#pragma once
// The handle that every UI_Draw receives: the supplier that makes drawing
// resources and the surface that draws, both owned elsewhere. A Drawbot lives
// on the stack for one paint or measurement and keeps no state of its own.
//
// Also here: text truncation, HSB conversion, pixel swizzles, the redraw flash
// delay and the split of a rectangle by monitor.
#include <algorithm>
#include <cmath>
#include <utility>
#include <vector>

#include "drawbot/DrawbotTypes.h"
#include "drawbot/SupplierInterface.h"
#include "drawbot/SurfaceInterface.h"
#include "tarsel/UTFString.h"

namespace norvik::drawbot {

class Drawbot {
 public:
  Drawbot(SupplierInterface const* inSupplier, SurfaceInterface* inSurface)
      : mSupplier(inSupplier), mSurface(inSurface) {}
  virtual ~Drawbot() = default;

  SupplierInterface const* GetSupplier() const { return mSupplier; }
  SurfaceInterface* GetSurface() const { return mSurface; }

 private:
  SupplierInterface const* mSupplier;
  SurfaceInterface* mSurface;
};

// The ellipsis that truncation appends: three full stops.
UTF16String const& GetEllipsisString();

// Fits inText into inMaxWidth by the given mode; mode 0 returns it untouched.
UTF16String TruncateString(FontInterface const& inFont, unsigned short const* inText, TextTruncation inMode,
                           float inMaxWidth);

// A shortened path of inLength characters: the first seven characters (when
// inLength is at least 8), the ellipsis, then the end of the source.
void GeneratePathEllipsisString(UTF16String const& inSource, unsigned long inLength, UTF16String& outResult);

// Hue in degrees [0, 360), saturation and brightness 0 to 1.
template <typename T>
void RGBtoHSB(ColorRGBA const& inColor, T& outHue, T& outSaturation, T& outBrightness) {
  T r = inColor.red, g = inColor.green, b = inColor.blue;
  T maxV = std::max(r, std::max(g, b));
  T minV = std::min(r, std::min(g, b));
  T delta = maxV - minV;
  outBrightness = maxV;
  outSaturation = maxV > 0 ? delta / maxV : T(0);
  if (delta <= 0) {
    outHue = 0;
    return;
  }
  T h;
  if (r == maxV)
    h = (g - b) / delta;
  else if (g == maxV)
    h = 2 + (b - r) / delta;
  else
    h = 4 + (r - g) / delta;
  h *= 60;
  if (h < 0) h += 360;
  outHue = h;
}

template <typename T>
ColorRGBA HSBtoRGB(T inHue, T inSaturation, T inBrightness, float inAlpha) {
  ColorRGBA out(0, 0, 0, inAlpha);
  T s = inSaturation, b = inBrightness;
  if (s == 0) {
    out.red = out.green = out.blue = static_cast<float>(b);
    return out;
  }
  T h = std::fmod(inHue, T(360));
  if (h < 0) h += 360;
  h /= 60;
  T fl = std::floor(h);
  int i = static_cast<int>(fl);
  T f = h - fl;
  if (i >= 6) {
    i = 0;
    f = 0;
  }
  T t = (1 - (1 - f) * s) * b, q = (1 - f * s) * b, p = (1 - s) * b;
  T rgb[6][3] = {{b, t, p}, {q, b, p}, {p, b, t}, {p, q, b}, {t, p, b}, {b, p, q}};
  out.red = static_cast<float>(rgb[i][0]);
  out.green = static_cast<float>(rgb[i][1]);
  out.blue = static_cast<float>(rgb[i][2]);
  return out;
}

// Converts inCount pixels in place between layouts: <4, 5> premultiplies,
// <5, 4> divides the alpha out again, <4, 6> and <6, 4> reverse each pixel's bytes.
template <int From, int To>
void inplace_swizzle(void* ioPixels, long inCount);
template <>
void inplace_swizzle<4, 5>(void* ioPixels, long inCount);
template <>
void inplace_swizzle<5, 4>(void* ioPixels, long inCount);
template <>
void inplace_swizzle<4, 6>(void* ioPixels, long inCount);
template <>
void inplace_swizzle<6, 4>(void* ioPixels, long inCount);

// Milliseconds for which a flushed surface flashes its changed rectangles; 0 is off.
void SetRedrawDebugFlashDelay(unsigned long inMilliseconds);
unsigned long GetRedrawDebugFlashDelay();

// Where monitor geometry comes from. The native-window layer installs its own;
// until then one monitor covers the whole coordinate space.
class MonitorSource {
 public:
  virtual ~MonitorSource() = default;
  virtual long GetMonitorCount() const = 0;
  // False when the monitor cannot be queried.
  virtual bool GetMonitorRect(long inIndex, tarsel::geom::RectT<long>* outRect) const = 0;
  virtual void const* GetMonitorIDFromRect(tarsel::geom::RectT<long> const& inRect) const = 0;
};
// Installs inSource (not owned); null goes back to the single monitor.
void SetMonitorSource(MonitorSource const* inSource);

// Splits a global rectangle at monitor borders, in monitor order, each piece
// with the monitor's identity. Raises "Bug in MonitorInfo" when a query fails.
std::vector<std::pair<tarsel::geom::RectT<long>, void const*>> SubdivideByMonitor(
    tarsel::geom::RectT<long> const& inRect);

}  // namespace norvik::drawbot
