// Text streams over UTF-16 and UTF-8 strings.
#include <gtest/gtest.h>

#include <vector>

#include "tarsel/StringStreams.h"

using namespace tarsel;

namespace {

class RecordingSink : public UTF16StreamSink {
 public:
  void Write(std::u16string_view inText) override {
    chunks.emplace_back(inText);
    all.append(inText.data(), inText.size());
  }
  void Flush() override { flushedAt.push_back(all.size()); }
  std::vector<UTF16String> chunks;
  UTF16String all;
  std::vector<std::size_t> flushedAt;
};

}  // namespace

TEST(iUTF16StringStream, ReadsNumbersAndWordsInTheClassicFormAndMalformedNumbersFailTheStream) {
  iUTF16StringStream in(u"12 3.5 -7e1 größe");
  int i = 0;
  double d = 0, e = 0;
  UTF16String word;
  in >> i >> d >> e >> word;
  ASSERT_FALSE(in.fail());
  EXPECT_EQ(i, 12);
  EXPECT_DOUBLE_EQ(d, 3.5);
  EXPECT_DOUBLE_EQ(e, -70);
  EXPECT_EQ(word, u"größe");
  in >> i;
  EXPECT_TRUE(in.fail());
  iUTF16StringStream bad(u"abc");
  bad >> d;
  EXPECT_TRUE(bad.fail());
}

TEST(oUTF16StringStream, CollectsMixedTextAndNumbersInUTF16AndUTF8) {
  oUTF16StringStream out;
  out << "gain " << 2.5 << UTF16String(u" dB ∞ ") << 42;
  EXPECT_EQ(out.str(), u"gain 2.5 dB ∞ 42");
  out.str(u"x=");
  out << 1;
  EXPECT_EQ(out.str(), u"x=1");
  oUTF8StringStream narrow;
  narrow << UTF16String(u"Ω") << ' ' << 0.25;
  EXPECT_EQ(narrow.str(), UTF8String("Ω 0.25"));
}

TEST(UTF16OutputStream, HandsTextToItsSinkOnFlush) {
  RecordingSink sink;
  UTF16OutputStream out(&sink);
  out << "line " << 1;
  EXPECT_TRUE(sink.all.empty());
  out << std::endl;
  EXPECT_EQ(sink.all, u"line 1\n");
  out << UTF16String(u"état") << std::flush;
  EXPECT_EQ(sink.all, u"line 1\nétat");
}

TEST(UTF16OutputStream, ACharacterCutByAFlushArrivesWhole) {
  RecordingSink sink;
  UTF16OutputStream out(&sink);
  const char euro[] = "\xE2\x82\xAC";  // U+20AC in three bytes
  out.write(euro, 1);
  out.flush();
  out.write(euro + 1, 2);
  out.flush();
  EXPECT_EQ(sink.all, u"€");
  for (const UTF16String& chunk : sink.chunks) EXPECT_EQ(chunk.find(u'\uFFFD'), UTF16String::npos);
}

TEST(UTF16OutputStream, LongTextOverflowsTheBufferIntoTheSink) {
  RecordingSink sink;
  {
    UTF16OutputStream out(&sink);
    for (int i = 0; i < 1000; ++i) out << "é";
  }  // destruction flushes the rest
  EXPECT_EQ(sink.all, UTF16String(1000, u'é'));
  EXPECT_GT(sink.chunks.size(), 1u);
}

TEST(UTF16OutputStream, WithoutASinkTextIsDroppedAndASinkCanBeSetLater) {
  UTF16OutputStream out;
  out << "lost" << std::flush;
  RecordingSink sink;
  out.SetSink(&sink);
  EXPECT_EQ(out.GetSink(), &sink);
  out << "kept" << std::flush;
  EXPECT_EQ(sink.all, u"kept");
  out.SetSink(nullptr);
}

TEST(UTF16OutputStream, TheSinkHearsOfExplicitFlushesOnlyAfterTheirText) {
  RecordingSink sink;
  UTF16OutputStream out(&sink);
  for (int i = 0; i < 600; ++i) out << "ab";  // fills the buffer: text, no flush
  EXPECT_FALSE(sink.all.empty());
  EXPECT_TRUE(sink.flushedAt.empty());
  out << std::endl;
  ASSERT_EQ(sink.flushedAt.size(), 1u);
  EXPECT_EQ(sink.flushedAt[0], 1201u);
}

TEST(UTF16OutputStream, WritesUTF8IntoACallersStreamBuffer) {
  std::stringbuf buffer;
  {
    UTF16OutputStream out(&buffer);
    out << UTF16String(u"Pegel ") << -6.5 << " dB\u00B1";
  }
  EXPECT_EQ(buffer.str(), "Pegel -6.5 dB\u00B1");

  // Switching to a sink leaves the caller's buffer alone from then on.
  RecordingSink sink;
  UTF16OutputStream out(&buffer);
  out.SetSink(&sink);
  out << "later" << std::flush;
  EXPECT_EQ(sink.all, u"later");
  EXPECT_EQ(buffer.str(), "Pegel -6.5 dB\u00B1");
}
