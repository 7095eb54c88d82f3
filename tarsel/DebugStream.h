#pragma once
// The debug stream: a narrow std::ostream carrying UTF-8 text, writable from
// any thread. Each thread writes into a line buffer of its own, and whole
// lines (or whatever is pending at a flush) are handed on under one lock, so
// lines of different threads never mix. Text goes to the buffer installed
// with SetStreamBuffer (the console installs its own), or to standard error.
//
//   tarsel::utility::streams::Debug() << "frame " << n << std::endl;
//
// UTF16StreamBuffer is the base of buffers that want the text as UTF-16: it
// gathers bytes, and at each line end and each flush hands the complete
// characters gathered so far to its Flush.
#include <mutex>
#include <ostream>
#include <streambuf>
#include <string>

#include "tarsel/UTFString.h"

namespace tarsel::debug {

class UTF16StreamBuffer : public std::streambuf {
 public:
  UTF16StreamBuffer() = default;
  ~UTF16StreamBuffer() override = default;

 protected:
  int_type overflow(int_type inChar) override;
  std::streamsize xsputn(const char* inText, std::streamsize inCount) override;
  int sync() override;

  // Receives the text gathered since the last call, in whole characters; a
  // UTF-8 sequence cut by a flush waits for its remaining bytes. Called
  // outside the buffer's lock, so it may write to this buffer again.
  virtual void Flush(const UTF16String& inText) = 0;

 private:
  // Appends and, when a line ended, takes the text to hand on.
  bool AppendLocked(const char* inText, std::size_t inCount, UTF16String& outReady);
  UTF16String TakeCompleteLocked();

  std::mutex mMutex;
  std::string mPending;
};

}  // namespace tarsel::debug

namespace tarsel::utility {

namespace streams {
// This thread's debug stream. All threads' debug streams share one
// destination.
std::ostream& Debug();
// True when inStream is one of the debug streams.
bool IsDebugStream(const std::ostream& inStream);
}  // namespace streams

// Points a stream at another buffer and answers the buffer it had. For the
// debug stream this sets the shared destination of every thread's debug text
// (null restores standard error); once it returns, no thread is still
// writing into the old destination, which may then be destroyed. A
// destination's own writes to the debug stream, made while it receives text,
// go to standard error rather than back into itself.
std::streambuf* SetStreamBuffer(std::ostream& ioStream, std::streambuf* inBuffer);

}  // namespace tarsel::utility
