#include "drawbot/MemBuffer.h"

#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <new>

namespace norvik::drawbot {

namespace {

// Tries an allocation a few times before giving up. Stands in for the core
// library's retrying allocator until that exists.
void* AllocateWithRetries(size_t inSize, int inAttempts) {
  for (int i = 0; i < inAttempts; ++i) {
    if (void* p = std::malloc(inSize)) return p;
  }
  throw std::bad_alloc();
}

}  // namespace

MemBuffer::MemBuffer(short inWidth, short inHeight, short inChannels)
    : mWidth(inWidth),
      mHeight(inHeight),
      mChannels(inChannels),
      mRowBytes(static_cast<short>((inWidth * inChannels + 15) & ~15)) {
  size_t size = static_cast<size_t>(mRowBytes) * static_cast<size_t>(mHeight > 0 ? mHeight : 0) + 16;
  mBlock = static_cast<unsigned char*>(AllocateWithRetries(size, 3));
  auto address = reinterpret_cast<std::uintptr_t>(mBlock);
  mData = mBlock + ((16 - (address & 15)) & 15);
}

MemBuffer::~MemBuffer() { std::free(mBlock); }

void MemBuffer::ClearBuffer() {
  std::memset(mData, 0, static_cast<size_t>(mRowBytes) * static_cast<size_t>(mHeight > 0 ? mHeight : 0));
}

void MemBuffer::DebugMarkBuffer() {
  for (short y = 0; y < mHeight; ++y) {
    unsigned char* row = mData + static_cast<size_t>(y) * static_cast<size_t>(mRowBytes);
    for (short x = 0; x < mWidth * mChannels; ++x) row[x] = static_cast<unsigned char>(((x / mChannels) ^ y) & 1 ? 0xff : 0x00);
  }
}

void MemBuffer::SwapColorChannels() {
  if (mChannels < 3) return;
  for (short y = 0; y < mHeight; ++y) {
    unsigned char* p = mData + static_cast<size_t>(y) * static_cast<size_t>(mRowBytes);
    for (short x = 0; x < mWidth; ++x, p += mChannels) {
      unsigned char t = p[0];
      p[0] = p[2];
      p[2] = t;
    }
  }
}

}  // namespace norvik::drawbot
