#include <gtest/gtest.h>

#include <algorithm>
#include <limits>
#include <mutex>
#include <sstream>
#include <thread>
#include <vector>

#include "tarsel/DebugDatabase.h"
#include "tarsel/DebugStream.h"

using tarsel::debug::UTF16StreamBuffer;
using tarsel::utility::SetStreamBuffer;
using tarsel::utility::streams::Debug;

namespace {

// Keeps each flushed piece of text.
class RecordingBuffer : public UTF16StreamBuffer {
 public:
  std::vector<UTF16String> Pieces() {
    std::lock_guard<std::mutex> lock(mMutex);
    return mPieces;
  }

 protected:
  void Flush(const UTF16String& inText) override {
    std::lock_guard<std::mutex> lock(mMutex);
    mPieces.push_back(inText);
  }

 private:
  std::mutex mMutex;
  std::vector<UTF16String> mPieces;
};

// Installs a buffer as the debug stream's destination for its lifetime.
class ScDebugDestination {
 public:
  explicit ScDebugDestination(std::streambuf* inBuffer) : mPrevious(SetStreamBuffer(Debug(), inBuffer)) {}
  ~ScDebugDestination() { SetStreamBuffer(Debug(), mPrevious); }

 private:
  std::streambuf* mPrevious;
};

}  // namespace

TEST(UTF16StreamBuffer, HandsOnEachLineAndWhateverIsPendingAtAFlush) {
  RecordingBuffer buffer;
  std::ostream out(&buffer);
  out << "frame " << 12 << "\n" << "partial";
  EXPECT_EQ(buffer.Pieces(), (std::vector<UTF16String>{u"frame 12\n"}));
  out << std::flush;
  EXPECT_EQ(buffer.Pieces(), (std::vector<UTF16String>{u"frame 12\n", u"partial"}));
  out << std::flush;  // nothing pending: no empty piece
  EXPECT_EQ(buffer.Pieces().size(), 2u);
}

TEST(UTF16StreamBuffer, ACharacterCutByAFlushWaitsForItsRemainingBytes) {
  RecordingBuffer buffer;
  std::ostream out(&buffer);
  const std::string euro = "\xE2\x82\xAC";  // U+20AC in three bytes
  out << "price " << euro.substr(0, 2) << std::flush;
  out << euro.substr(2) << std::flush;
  EXPECT_EQ(buffer.Pieces(), (std::vector<UTF16String>{u"price ", u"\u20ac"}));
}

TEST(UTF16StreamBuffer, IllFormedBytesBecomeReplacementCharactersNotLostText) {
  RecordingBuffer buffer;
  std::ostream out(&buffer);
  out << "a\xFF" "b" << std::endl;
  ASSERT_EQ(buffer.Pieces().size(), 1u);
  EXPECT_EQ(buffer.Pieces()[0], UTF16String(u"a\ufffdb\n"));
}

TEST(DebugStream, GoesToTheInstalledBufferAndBackToStandardErrorWhenRemoved) {
  RecordingBuffer buffer;
  {
    ScDebugDestination destination(&buffer);
    Debug() << "to the console " << 3.5 << std::endl;
  }
  EXPECT_EQ(buffer.Pieces(), (std::vector<UTF16String>{u"to the console 3.5\n"}));
  ::testing::internal::CaptureStderr();
  Debug() << "to stderr" << std::endl;
  EXPECT_EQ(::testing::internal::GetCapturedStderr(), "to stderr\n");
  EXPECT_EQ(buffer.Pieces().size(), 1u);
}

TEST(DebugStream, SetStreamBufferOnAnOrdinaryStreamSwapsItsBuffer) {
  std::ostringstream original;
  std::stringbuf other;
  std::streambuf* previous = SetStreamBuffer(original, &other);
  original << "redirected";
  EXPECT_EQ(other.str(), "redirected");
  EXPECT_EQ(SetStreamBuffer(original, previous), &other);
  EXPECT_FALSE(tarsel::utility::streams::IsDebugStream(original));
  EXPECT_TRUE(tarsel::utility::streams::IsDebugStream(Debug()));
}

TEST(DebugStream, LinesFromManyThreadsArriveWholeAndNoneIsLost) {
  RecordingBuffer buffer;
  ScDebugDestination destination(&buffer);
  constexpr int kThreads = 4, kLines = 300;
  std::vector<std::thread> threads;
  for (int t = 0; t < kThreads; ++t)
    threads.emplace_back([t] {
      for (int i = 0; i < kLines; ++i) Debug() << "thread " << t << " says " << i << '\n';
    });
  for (auto& thread : threads) thread.join();
  std::vector<UTF16String> pieces = buffer.Pieces();
  ASSERT_EQ(pieces.size(), static_cast<std::size_t>(kThreads * kLines));
  for (const UTF16String& piece : pieces) {
    ASSERT_EQ(piece.rfind(u"thread ", 0), 0u);
    ASSERT_EQ(std::count(piece.begin(), piece.end(), u'\n'), 1);
  }
}

namespace {
// A destination that writes to the debug stream while it receives text, as a
// careless console might.
class EchoingBuffer : public RecordingBuffer {
 protected:
  void Flush(const UTF16String& inText) override {
    RecordingBuffer::Flush(inText);
    Debug() << "echo" << std::endl;
  }
};
}  // namespace

TEST(DebugStream, ADestinationWritingToTheDebugStreamDoesNotFeedItself) {
  EchoingBuffer buffer;
  ::testing::internal::CaptureStderr();
  {
    ScDebugDestination destination(&buffer);
    Debug() << "once" << std::endl;
  }
  EXPECT_EQ(::testing::internal::GetCapturedStderr(), "echo\n");
  EXPECT_EQ(buffer.Pieces(), (std::vector<UTF16String>{u"once\n"}));
}

TEST(DebugDatabase, EntriesKeepTheirTypeAndReadsOfAnotherTypeOrOfAHugeOrNanDoubleFallBack) {
  auto& db = tarsel::debug::DebugDatabase::Instance();
  db.SetEntry("test.db.flag", true);
  db.SetEntry("test.db.count", 42LL);
  db.SetEntry("test.db.gain", 0.5);
  db.SetEntry("test.db.name", std::string("meters"));
  db.SetEntry("test.db.huge", 1e300);
  db.SetEntry("test.db.nan", std::numeric_limits<double>::quiet_NaN());
  EXPECT_TRUE(std::holds_alternative<bool>(db.GetEntry("test.db.flag")));
  EXPECT_TRUE(std::holds_alternative<std::monostate>(db.GetEntry("test.db.none")));
  EXPECT_TRUE(db.GetBool("test.db.flag", false));
  EXPECT_EQ(db.GetInteger("test.db.gain", -1), 0);
  EXPECT_DOUBLE_EQ(db.GetDouble("test.db.count", 0), 42.0);
  EXPECT_EQ(db.GetString("test.db.name", ""), "meters");
  EXPECT_EQ(db.GetString("test.db.flag", "fallback"), "fallback");
  EXPECT_EQ(db.GetInteger("test.db.name", 7), 7);
  EXPECT_EQ(db.GetInteger("test.db.huge", -3), -3);
  EXPECT_EQ(db.GetInteger("test.db.nan", -4), -4);
}

TEST(DebugDatabase, KeysAreListedSortedAndAnEmptyEntryRemovesAKey) {
  auto& db = tarsel::debug::DebugDatabase::Instance();
  db.SetEntry("test.db2.b", 1LL);
  db.SetEntry("test.db2.a", 2LL);
  std::vector<UTF8String> keys = db.GetDebugKeys();
  EXPECT_TRUE(std::is_sorted(keys.begin(), keys.end()));
  auto a = std::find(keys.begin(), keys.end(), UTF8String("test.db2.a"));
  auto b = std::find(keys.begin(), keys.end(), UTF8String("test.db2.b"));
  ASSERT_NE(a, keys.end());
  EXPECT_EQ(b, a + 1);
  db.SetEntry("test.db2.a", tarsel::debug::DebugEntry());
  EXPECT_FALSE(db.HasEntry("test.db2.a"));
  EXPECT_TRUE(db.HasEntry("test.db2.b"));
}

