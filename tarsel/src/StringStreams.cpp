#include "tarsel/StringStreams.h"

#include <locale>

namespace tarsel {

namespace utility {
std::ostream& operator<<(std::ostream& ioStream, const UTF16String& inText) {
  UTF8String text = UTF16to8(inText);
  return ioStream.write(text.data(), static_cast<std::streamsize>(text.size()));
}

std::istream& operator>>(std::istream& ioStream, UTF16String& outText) {
  std::string word;
  if (ioStream >> word) outText = UTF8to16(word);
  return ioStream;
}
}  // namespace utility

iUTF16StringStream::iUTF16StringStream(std::u16string_view inText) : std::istream(&mBuffer) {
  imbue(std::locale::classic());
  str(inText);
}

void iUTF16StringStream::str(std::u16string_view inText) {
  mBuffer.str(utility::ToStdString(utility::UTF16to8(inText)));
  clear();
}


oUTF16StringStream::oUTF16StringStream() : std::ostream(&mBuffer) { imbue(std::locale::classic()); }

UTF16String oUTF16StringStream::str() const { return utility::UTF8to16(mBuffer.str()); }

void oUTF16StringStream::str(std::u16string_view inText) {
  mBuffer.str(utility::ToStdString(utility::UTF16to8(inText)));
  mBuffer.pubseekoff(0, std::ios_base::end, std::ios_base::out);
}

oUTF8StringStream::oUTF8StringStream() : std::ostream(&mBuffer) { imbue(std::locale::classic()); }

UTF8String oUTF8StringStream::str() const {
  std::string text = mBuffer.str();
  return UTF8String(text.data(), text.size());
}

class UTF16OutputStream::Buffer : public std::streambuf {
 public:
  explicit Buffer(UTF16StreamSink* inSink) : mSink(inSink) { setp(mBytes, mBytes + sizeof(mBytes)); }
  ~Buffer() override { Drain(); }

  UTF16StreamSink* mSink;

 protected:
  int_type overflow(int_type inChar) override {
    Drain();
    if (!traits_type::eq_int_type(inChar, traits_type::eof())) {
      *pptr() = traits_type::to_char_type(inChar);
      pbump(1);
    }
    return traits_type::not_eof(inChar);
  }

  int sync() override {
    Drain();
    if (mSink) mSink->Flush();
    return 0;
  }

 private:
  void Drain() {
    std::size_t size = static_cast<std::size_t>(pptr() - pbase());
    std::size_t complete = CompletePrefix(size);
    if (mSink && complete > 0) mSink->Write(utility::UTF8to16(std::string_view(mBytes, complete)));
    std::size_t rest = size - complete;
    for (std::size_t i = 0; i < rest; ++i) mBytes[i] = mBytes[complete + i];
    setp(mBytes, mBytes + sizeof(mBytes));
    pbump(static_cast<int>(rest));
  }

  // The length of the buffer's prefix that ends on a character boundary: a
  // lead byte whose sequence is not yet complete stays behind.
  std::size_t CompletePrefix(std::size_t inSize) const {
    std::size_t back = 0;
    while (back < 3 && back < inSize) {
      unsigned char c = static_cast<unsigned char>(mBytes[inSize - 1 - back]);
      if ((c & 0xC0) != 0x80) {
        std::size_t need = (c & 0xE0) == 0xC0 ? 2 : (c & 0xF0) == 0xE0 ? 3 : (c & 0xF8) == 0xF0 ? 4 : 1;
        return need > back + 1 ? inSize - 1 - back : inSize;
      }
      ++back;
    }
    return inSize;
  }

  char mBytes[1024];
};

UTF16OutputStream::UTF16OutputStream(UTF16StreamSink* inSink)
    : std::ostream(nullptr), mBuffer(std::make_unique<Buffer>(inSink)) {
  rdbuf(mBuffer.get());
  imbue(std::locale::classic());
}

UTF16OutputStream::UTF16OutputStream(std::streambuf* inBuffer)
    : std::ostream(nullptr), mBuffer(std::make_unique<Buffer>(nullptr)) {
  rdbuf(inBuffer ? inBuffer : mBuffer.get());
  imbue(std::locale::classic());
}

UTF16OutputStream::~UTF16OutputStream() { flush(); }

void UTF16OutputStream::SetSink(UTF16StreamSink* inSink) {
  flush();
  mBuffer->mSink = inSink;
  rdbuf(mBuffer.get());
}

UTF16StreamSink* UTF16OutputStream::GetSink() const { return mBuffer->mSink; }

}  // namespace tarsel
