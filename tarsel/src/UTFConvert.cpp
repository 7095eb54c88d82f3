// UTF-8 <-> UTF-16 conversion through the C library's iconv. A thread keeps its
// own conversion descriptors, since iconv descriptors carry state.
#include <iconv.h>

#include <cerrno>
#include <cstring>

#include "tarsel/UTFString.h"

namespace tarsel::utility {
namespace {

class IconvHandle {
 public:
  IconvHandle(const char* inTo, const char* inFrom) : mCd(iconv_open(inTo, inFrom)) {}
  ~IconvHandle() {
    if (mCd != reinterpret_cast<iconv_t>(-1)) iconv_close(mCd);
  }
  IconvHandle(const IconvHandle&) = delete;
  IconvHandle& operator=(const IconvHandle&) = delete;
  iconv_t Get() const { return mCd; }

 private:
  iconv_t mCd;
};

// Converts inBytes with inCd into outBytes. On an invalid or incomplete input
// sequence, appends inReplacement and skips inSkip bytes of input.
template <typename Out>
void Run(iconv_t inCd, const char* inBytes, std::size_t inLength, Out& outText, std::size_t inUnit,
         const char* inReplacement, std::size_t inReplacementSize, std::size_t inSkip) {
  iconv(inCd, nullptr, nullptr, nullptr, nullptr);
  char* in = const_cast<char*>(inBytes);
  std::size_t inLeft = inLength;
  char buffer[1024];
  while (inLeft > 0) {
    char* out = buffer;
    std::size_t outLeft = sizeof(buffer);
    std::size_t r = iconv(inCd, &in, &inLeft, &out, &outLeft);
    std::size_t produced = sizeof(buffer) - outLeft;
    outText.append(reinterpret_cast<const typename Out::value_type*>(buffer), produced / inUnit);
    if (r == static_cast<std::size_t>(-1)) {
      if (errno == E2BIG) continue;
      // EILSEQ or EINVAL: replace and move on.
      outText.append(reinterpret_cast<const typename Out::value_type*>(inReplacement),
                     inReplacementSize / inUnit);
      std::size_t skip = inSkip < inLeft ? inSkip : inLeft;
      in += skip;
      inLeft -= skip;
      iconv(inCd, nullptr, nullptr, nullptr, nullptr);
    }
  }
}

}  // namespace

UTF16String UTF8to16(std::string_view inText) {
  thread_local IconvHandle cd("UTF-16LE", "UTF-8");
  UTF16String result;
  result.reserve(inText.size());
  const char16_t replacement = 0xFFFD;
  Run(cd.Get(), inText.data(), inText.size(), result, 2, reinterpret_cast<const char*>(&replacement), 2, 1);
  return result;
}

UTF8String UTF16to8(std::u16string_view inText) {
  thread_local IconvHandle cd("UTF-8", "UTF-16LE");
  UTF8String result;
  result.reserve(inText.size());
  const char replacement[] = "\xEF\xBF\xBD";
  Run(cd.Get(), reinterpret_cast<const char*>(inText.data()), inText.size() * 2, result, 1, replacement, 3, 2);
  return result;
}

UTF16String AsciiToUTF16(std::string_view inText) {
  UTF16String result;
  result.reserve(inText.size());
  for (char c : inText) result.push_back(static_cast<unsigned char>(c) < 0x80 ? char16_t(c) : char16_t(0xFFFD));
  return result;
}

}  // namespace tarsel::utility
