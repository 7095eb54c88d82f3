#pragma once
// Text streams over the toolkit's strings. Numbers are read and written in the
// classic "C" form whatever the process locale, since these streams carry
// data (theme files, console output), not text laid out for a reader; use
// NumberToString for the latter.
//
// The standard library has no numeric facets for char16_t, so the streams run
// on UTF-8 internally and convert at their edges.
#include <istream>
#include <memory>
#include <ostream>
#include <sstream>
#include <streambuf>
#include <string>

#include "tarsel/UTFString.h"

namespace tarsel {

namespace utility {
// Writes a UTF-16 string as UTF-8 into any narrow stream. (In this namespace
// so that argument-dependent lookup finds it through the strings' allocator.)
std::ostream& operator<<(std::ostream& ioStream, const UTF16String& inText);
// Reads one blank-delimited word, as operator>> into std::string does.
std::istream& operator>>(std::istream& ioStream, UTF16String& outText);
}  // namespace utility

// Reads from a UTF-16 string: `iUTF16StringStream in(u"12 3.5 word"); in >> i >> d >> text;`
class iUTF16StringStream : public std::istream {
 public:
  explicit iUTF16StringStream(std::u16string_view inText);
  void str(std::u16string_view inText);

 private:
  std::stringbuf mBuffer;
};

// Collects written text as a UTF16String.
class oUTF16StringStream : public std::ostream {
 public:
  oUTF16StringStream();
  UTF16String str() const;
  void str(std::u16string_view inText);

 private:
  std::stringbuf mBuffer;
};

// Collects written text as a UTF8String.
class oUTF8StringStream : public std::ostream {
 public:
  oUTF8StringStream();
  UTF8String str() const;

 private:
  std::stringbuf mBuffer;
};

// The receiving end of a UTF16OutputStream: gets the text in whole characters
// when the stream's buffer fills up and when the stream is flushed
// (std::endl, std::flush); after the text of an explicit flush comes Flush(),
// the moment for a receiver that batches text to pass it on.
class UTF16StreamSink {
 public:
  virtual ~UTF16StreamSink() = default;
  virtual void Write(std::u16string_view inText) = 0;
  virtual void Flush() {}
};

// A stream for visible text: UTF-16 strings, narrow UTF-8 text and numbers go
// in. It hands its text either, converted to UTF-16, to a sink, or, as UTF-8,
// to a stream buffer of the caller's (as the debug and console streams take).
// A multi-byte character cut by a flush is held back until its remaining bytes
// arrive. Without a sink or buffer, text is dropped.
class UTF16OutputStream : public std::ostream {
 public:
  explicit UTF16OutputStream(UTF16StreamSink* inSink = nullptr);
  // Writes into inBuffer, which the caller keeps alive and owns.
  explicit UTF16OutputStream(std::streambuf* inBuffer);
  ~UTF16OutputStream() override;
  // Sends further text to inSink instead of wherever it went.
  void SetSink(UTF16StreamSink* inSink);
  UTF16StreamSink* GetSink() const;

 private:
  class Buffer;
  std::unique_ptr<Buffer> mBuffer;
};

}  // namespace tarsel
