#include "tarsel/DebugStream.h"

#include <cstdio>

namespace tarsel::debug {
namespace {

// Length of the longest prefix of inText that does not end inside a UTF-8
// sequence. Ill-formed bytes count as complete (the conversion replaces them).
std::size_t CompleteUTF8Prefix(const std::string& inText) {
  const std::size_t size = inText.size();
  for (std::size_t back = 1; back <= 3 && back <= size; ++back) {
    const unsigned char byte = static_cast<unsigned char>(inText[size - back]);
    if ((byte & 0xC0) == 0x80) continue;  // continuation byte: look further back
    std::size_t length = (byte & 0xE0) == 0xC0 ? 2 : (byte & 0xF0) == 0xE0 ? 3 : (byte & 0xF8) == 0xF0 ? 4 : 1;
    return length > back ? size - back : size;
  }
  return size;
}

}  // namespace

UTF16StreamBuffer::int_type UTF16StreamBuffer::overflow(int_type inChar) {
  if (traits_type::eq_int_type(inChar, traits_type::eof())) return traits_type::not_eof(inChar);
  const char c = traits_type::to_char_type(inChar);
  xsputn(&c, 1);
  return inChar;
}

std::streamsize UTF16StreamBuffer::xsputn(const char* inText, std::streamsize inCount) {
  if (inCount <= 0) return 0;
  UTF16String ready;
  bool flush;
  {
    std::lock_guard<std::mutex> lock(mMutex);
    flush = AppendLocked(inText, static_cast<std::size_t>(inCount), ready);
  }
  if (flush && !ready.empty()) Flush(ready);
  return inCount;
}

int UTF16StreamBuffer::sync() {
  UTF16String ready;
  {
    std::lock_guard<std::mutex> lock(mMutex);
    ready = TakeCompleteLocked();
  }
  if (!ready.empty()) Flush(ready);
  return 0;
}

bool UTF16StreamBuffer::AppendLocked(const char* inText, std::size_t inCount, UTF16String& outReady) {
  mPending.append(inText, inCount);
  if (std::char_traits<char>::find(inText, inCount, '\n') == nullptr) return false;
  outReady = TakeCompleteLocked();
  return true;
}

UTF16String UTF16StreamBuffer::TakeCompleteLocked() {
  const std::size_t complete = CompleteUTF8Prefix(mPending);
  UTF16String text = utility::UTF8to16(std::string_view(mPending.data(), complete));
  mPending.erase(0, complete);
  return text;
}

}  // namespace tarsel::debug

namespace tarsel::utility {
namespace {

struct DebugDestination {
  std::mutex mMutex;
  std::streambuf* mBuffer = nullptr;
};

DebugDestination& Destination() {
  static DebugDestination* destination = new DebugDestination;  // outlives thread and static exits
  return *destination;
}

// Set while this thread is handing text to the destination.
thread_local bool tForwarding = false;

void Forward(const std::string& inText) {
  if (inText.empty()) return;
  if (!tForwarding) {
    DebugDestination& destination = Destination();
    std::lock_guard<std::mutex> lock(destination.mMutex);
    if (std::streambuf* buffer = destination.mBuffer) {
      tForwarding = true;
      buffer->sputn(inText.data(), static_cast<std::streamsize>(inText.size()));
      buffer->pubsync();
      tForwarding = false;
      return;
    }
  }
  std::fwrite(inText.data(), 1, inText.size(), stderr);
}

// One per thread: gathers a line, then forwards it whole.
class ThreadLineBuffer : public std::streambuf {
 public:
  ~ThreadLineBuffer() override { Forward(mPending); }

 protected:
  int_type overflow(int_type inChar) override {
    if (traits_type::eq_int_type(inChar, traits_type::eof())) return traits_type::not_eof(inChar);
    mPending.push_back(traits_type::to_char_type(inChar));
    if (mPending.back() == '\n') ForwardPending();
    return inChar;
  }
  std::streamsize xsputn(const char* inText, std::streamsize inCount) override {
    if (inCount <= 0) return 0;
    mPending.append(inText, static_cast<std::size_t>(inCount));
    if (std::char_traits<char>::find(inText, static_cast<std::size_t>(inCount), '\n')) ForwardPending();
    return inCount;
  }
  int sync() override {
    ForwardPending();
    return 0;
  }

 private:
  void ForwardPending() {
    std::string text;
    text.swap(mPending);
    Forward(text);
  }
  std::string mPending;
};

class DebugOStream : public std::ostream {
 public:
  DebugOStream() : std::ostream(&mBuffer) {}

 private:
  ThreadLineBuffer mBuffer;
};

}  // namespace

namespace streams {

std::ostream& Debug() {
  thread_local DebugOStream stream;
  return stream;
}

bool IsDebugStream(const std::ostream& inStream) { return dynamic_cast<const DebugOStream*>(&inStream) != nullptr; }

}  // namespace streams

std::streambuf* SetStreamBuffer(std::ostream& ioStream, std::streambuf* inBuffer) {
  if (!streams::IsDebugStream(ioStream)) return ioStream.rdbuf(inBuffer);
  DebugDestination& destination = Destination();
  std::lock_guard<std::mutex> lock(destination.mMutex);
  std::streambuf* previous = destination.mBuffer;
  destination.mBuffer = inBuffer;
  return previous;
}

}  // namespace tarsel::utility
