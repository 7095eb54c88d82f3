#include "drawbot/MemBuffer.h"

#include <cstdint>
#include <cstring>

#include "tarsel/ErrorManager.h"

namespace norvik::drawbot {

MemBuffer::MemBuffer(short inWidth, short inHeight, short inChannels)
    : mWidth(inWidth),
      mHeight(inHeight),
      mChannels(inChannels),
      mRowBytes(static_cast<short>((inWidth * inChannels + 15) & ~15)) {
  size_t size = static_cast<size_t>(mRowBytes) * static_cast<size_t>(mHeight > 0 ? mHeight : 0) + 16;
  mBlock = static_cast<unsigned char*>(tarsel::config::ErrorManager::Get(true)->AllocateWithRetries(size, 3));
  auto address = reinterpret_cast<std::uintptr_t>(mBlock);
  mData = mBlock + ((16 - (address & 15)) & 15);
}

MemBuffer::~MemBuffer() { tarsel::config::ErrorManager::Get(true)->Deallocate(mBlock); }

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
