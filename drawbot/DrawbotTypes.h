#pragma once
// The value types shared by every drawing object: colour, the policy and kind
// enumerations (their numbers are stored in cache records and compared, so they
// are fixed), and the deleter that keeps a caller's pixel buffer alive.
#include <cstdint>

#include "tarsel/RefCountedObject.h"

namespace norvik::drawbot {

// A colour as four floats, nominally 0 to 1, alpha not premultiplied.
struct ColorRGBA {
  float red = 0;
  float green = 0;
  float blue = 0;
  float alpha = 1;

  constexpr ColorRGBA() = default;
  constexpr ColorRGBA(float inRed, float inGreen, float inBlue, float inAlpha = 1)
      : red(inRed), green(inGreen), blue(inBlue), alpha(inAlpha) {}

  // 0xAARRGGBB, each channel times 255 rounded half away from zero and clamped to a byte.
  std::uint32_t ToPacked() const;
  static ColorRGBA FromPacked(std::uint32_t inARGB);

  bool operator==(const ColorRGBA& o) const {
    return red == o.red && green == o.green && blue == o.blue && alpha == o.alpha;
  }
  bool operator!=(const ColorRGBA& o) const { return !(*this == o); }
};

enum AntiAliasPolicy { kAntiAliasNone = 0, kAntiAlias = 1, kAntiAliasHighQuality = 2 };
enum InterpolationPolicy {
  kInterpolationNearestNeighbor = 0,
  kInterpolationLowQuality = 1,
  kInterpolationHighQuality = 2
};
enum TextDisplayPolicy { kTextDisplaySmooth = 0, kTextDisplayGridFitted = 1 };
enum FillType { kFillAlternate = 0, kFillWinding = 1 };
enum TextAlignment { kTextAlignLeft = 0, kTextAlignCenter = 1, kTextAlignRight = 2 };
enum LineCap { kLineCapFlat = 0, kLineCapRound = 1, kLineCapSquare = 2 };
enum LineJoin { kLineJoinMiter = 0, kLineJoinBevel = 1, kLineJoinRound = 2 };
enum TextTruncation {
  kTextTruncationNone = 0,
  kTextTruncationEnd = 1,
  kTextTruncationEndWithEllipsis = 2,
  kTextTruncationPathEllipsis = 3
};
enum PixelLayout {
  kPixelLayoutRGB24 = 1,         // 3 bytes a pixel, no alpha
  kPixelLayoutRGB32 = 3,         // 32 bits, no alpha
  kPixelLayoutARGB = 4,          // bytes A, R, G, B, straight alpha
  kPixelLayoutARGBPremul = 5,    // bytes A, R, G, B, premultiplied
  kPixelLayoutBGRA = 6,          // bytes B, G, R, A, straight alpha
  kPixelLayoutBGRAPremul = 7     // bytes B, G, R, A, premultiplied
};
enum ImageFileType { kImageFileTypeJPG = 0, kImageFileTypePNG = 1 };

// Calls a function on a pointer when its last reference goes: how a pixel
// buffer stays alive for as long as an image or surface made over it.
struct DataDeleter : public tarsel::utility::RefCountedObject {
  using DeleteFunction = void (*)(void*);
  DataDeleter(void* inData, DeleteFunction inFunction) : mData(inData), mFunction(inFunction) {}
  ~DataDeleter() override {
    if (mFunction) mFunction(mData);
  }
  void* GetData() const { return mData; }

 private:
  void* mData;
  DeleteFunction mFunction;
};

}  // namespace norvik::drawbot
