#pragma once
// A reference-counted block of raw pixels whose rows start on 16-byte
// boundaries, for code that builds pixels by hand before making an image.
#include "tarsel/RefCountedObject.h"

namespace norvik::drawbot {

class MemBuffer : public tarsel::utility::RefCountedObject {
 public:
  // Allocates rowBytes * height + 16 bytes, retrying a failed allocation.
  MemBuffer(short inWidth, short inHeight, short inChannels);
  ~MemBuffer() override;
  MemBuffer(const MemBuffer&) = delete;
  MemBuffer& operator=(const MemBuffer&) = delete;

  short GetWidth() const { return mWidth; }
  short GetHeight() const { return mHeight; }
  short GetNumChannels() const { return mChannels; }
  // (width * channels + 15) & ~15.
  short GetRowBytes() const { return mRowBytes; }
  // The first row, aligned to 16 bytes.
  unsigned char* GetDataPtr() const { return mData; }

  void ClearBuffer();
  // Fills the buffer with a recognisable pattern, for finding unwritten pixels.
  void DebugMarkBuffer();
  // Swaps the first and third channel of every pixel (RGB to BGR and back).
  void SwapColorChannels();

 private:
  short mWidth;
  short mHeight;
  short mChannels;
  short mRowBytes;
  unsigned char* mBlock = nullptr;
  unsigned char* mData = nullptr;
};

}  // namespace norvik::drawbot
