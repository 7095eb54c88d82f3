// Property lists as XML documents: the exact text written, reading it back,
// points and rectangles, files, and the refusal of bad documents.
#include <gtest/gtest.h>

#include <cmath>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <limits>
#include <string>

#include "tarsel/PropListUtils.h"
#include "tarsel/ThrowError.h"

using tarsel::config::Exception;
using tarsel::proplist::PropList;
using tarsel::proplist::PropListP;
namespace utils = tarsel::proplist::utils;

namespace {

std::string Str(const UTF8String& s) { return std::string(s.data(), s.size()); }

PropList Read(const std::string& xml) {
  PropList list;
  utils::ReadPropList(xml, list);
  return list;
}

// The key path of the error that reading raises, or "" when it reads.
std::string ReadError(const std::string& xml, std::string* outMessage = nullptr) {
  try {
    Read(xml);
  } catch (const Exception& e) {
    if (outMessage) *outMessage = e.what();
    return e.GetKeyPath();
  }
  return "";
}

std::string Doc(const std::string& listBody) {
  return "<?xml version='1.0'?>\r\n<prop.map version='4'>\r\n<prop.list>\r\n" + listBody + "</prop.list>\r\n</prop.map>\r\n";
}

}  // namespace

TEST(PropListXmlTests, WritesTheDocumentTextExactly) {
  PropList list;
  list.SetValue("name", u"H\u00e9llo & <x>");
  list.SetValue("count", std::uint32_t{2});
  list.SetValue("Zed", true);
  list.SetValue("f", 300.0f);
  list.NewSubList("sub")->SetValue("neg", std::int32_t{-3});
  list.SetValue("items", std::vector<UTF16String>{u"a", u"b"});
  list.SetValue("off", false);

  const std::string expected =
      "<?xml version='1.0'?>\r\n"
      "<prop.map version='4'>\r\n"
      "  <prop.list>\r\n"
      "    <prop.pair>\r\n"
      "      <key>Zed</key>\r\n"
      "      <true/>\r\n"
      "    </prop.pair>\r\n"
      "    <prop.pair>\r\n"
      "      <key>count</key>\r\n"
      "      <int type='unsigned' size='32'>2</int>\r\n"
      "    </prop.pair>\r\n"
      "    <prop.pair>\r\n"
      "      <key>f</key>\r\n"
      "      <float>300</float>\r\n"
      "    </prop.pair>\r\n"
      "    <prop.pair>\r\n"
      "      <key>items</key>\r\n"
      "      <array>\r\n"
      "        <array.type><ustring/></array.type>\r\n"
      "        <ustring>a</ustring>\r\n"
      "        <ustring>b</ustring>\r\n"
      "      </array>\r\n"
      "    </prop.pair>\r\n"
      "    <prop.pair>\r\n"
      "      <key>name</key>\r\n"
      "      <ustring>H\xC3\xA9llo &amp; &lt;x&gt;</ustring>\r\n"
      "    </prop.pair>\r\n"
      "    <prop.pair>\r\n"
      "      <key>off</key>\r\n"
      "      <false/>\r\n"
      "    </prop.pair>\r\n"
      "    <prop.pair>\r\n"
      "      <key>sub</key>\r\n"
      "      <prop.list>\r\n"
      "        <prop.pair>\r\n"
      "          <key>neg</key>\r\n"
      "          <int type='signed' size='32'>-3</int>\r\n"
      "        </prop.pair>\r\n"
      "      </prop.list>\r\n"
      "    </prop.pair>\r\n"
      "  </prop.list>\r\n"
      "</prop.map>\r\n";
  EXPECT_EQ(expected, Str(utils::WritePropList(list)));
}

TEST(PropListXmlTests, FloatsArePrintedWithSixDigitsAndThreeDigitExponents) {
  EXPECT_EQ("300", utils::FormatFloat(300.0f));
  EXPECT_EQ("-1.07374e+008", utils::FormatFloat(-107374182.4f));
  EXPECT_EQ("0.333333", utils::FormatFloat(1.0f / 3.0f));
  EXPECT_EQ("1.5e-007", utils::FormatFloat(1.5e-7f));
  EXPECT_EQ("3.40282e+038", utils::FormatFloat(std::numeric_limits<float>::max()));
  EXPECT_EQ("0", utils::FormatFloat(0.0f));
  EXPECT_EQ("-inf", utils::FormatFloat(-std::numeric_limits<float>::infinity()));
}

TEST(PropListXmlTests, EveryLineOfADocumentEndsInCarriageReturnLineFeed) {
  PropList list;
  list.SetValue("multi", u"line one\nline two\r\nthree");
  list.SetValue("key\nwith break", "x");
  const std::string text = Str(utils::WritePropList(list));
  for (std::size_t i = 0; i < text.size(); ++i) {
    if (text[i] == '\n') {
      ASSERT_GT(i, 0u);
      EXPECT_EQ('\r', text[i - 1]) << "bare line feed at offset " << i;
    }
    if (text[i] == '\r') {
      EXPECT_EQ('\n', text[i + 1]) << "bare carriage return at offset " << i;
    }
  }
  UTF16String multi;
  ASSERT_TRUE(Read(text).GetValue("multi", multi));
  EXPECT_EQ(u"line one\nline two\r\nthree", multi) << "line ends inside texts survive the round trip";
}

TEST(PropListXmlTests, WrittenDocumentsReadBackToTheSameList) {
  PropList list;
  list.SetValue("b", true);
  list.SetValue("i", std::numeric_limits<std::int32_t>::min());
  list.SetValue("u", std::numeric_limits<std::uint32_t>::max());
  list.SetValue("f", 0.1f);
  list.SetValue("d", 0.1);
  list.SetValue("dbig", 1.0e300);
  list.SetValue("s", "8-bit & <text>");
  list.SetValue("w", u"tab\there, line\r\nend, \u00e9\U0001F600 and 'quotes' \"too\"");
  list.SetValue("empty", u"");
  list.SetValue("ints", std::vector<std::int32_t>{-1, 0, 1});
  list.SetValue("uints", std::vector<std::uint32_t>{4000000000u});
  list.SetValue("floats", std::vector<float>{1.5f, -2.0f});
  list.SetValue("doubles", std::vector<double>{1.0 / 3.0});
  list.SetValue("strings", std::vector<UTF8String>{"x", ""});
  list.SetValue("none", std::vector<UTF16String>{});
  PropListP sub = list.NewSubList("sub");
  sub->NewSubList("deeper")->SetValue("k", std::int32_t{7});
  sub->NewSubList("empty");

  EXPECT_EQ(list, Read(Str(utils::WritePropList(list))));
}

TEST(PropListXmlTests, ReadingAcceptsOtherWhitespaceAndPlainLineFeeds) {
  const std::string xml =
      "<?xml version='1.0'?>\n<prop.map version='4'><prop.list>\n\t<prop.pair><key>a</key>"
      "<int type='signed' size='32'> 12\n</int></prop.pair>\n"
      "  <prop.pair>\n  <key>b</key>\n  <float>-1.07374e+008</float>\n  </prop.pair>"
      "<!-- comments are ignored -->"
      "<prop.pair><key>c</key><ustring><![CDATA[<raw>]]></ustring></prop.pair>"
      "</prop.list></prop.map>";
  PropList list = Read(xml);
  std::int32_t a = 0;
  float b = 0;
  UTF16String c;
  ASSERT_TRUE(list.GetValue("a", a));
  ASSERT_TRUE(list.GetValue("b", b));
  ASSERT_TRUE(list.GetValue("c", c));
  EXPECT_EQ(12, a);
  EXPECT_FLOAT_EQ(-1.07374e+8f, b);
  EXPECT_EQ(u"<raw>", c);
}

TEST(PropListXmlTests, StringsKeepTheirSurroundingSpaces) {
  PropList list = Read(Doc("<prop.pair><key> k </key><string>  two  </string></prop.pair>"));
  UTF8String v;
  ASSERT_TRUE(list.GetValue(" k ", v));
  EXPECT_EQ("  two  ", v);
}

TEST(PropListXmlTests, OlderMapVersionsAreReadButOthersAreRefused) {
  const std::string body = "<prop.list><prop.pair><key>NRK_CursorData</key><string>1.0</string></prop.pair></prop.list>";
  EXPECT_EQ("", ReadError("<?xml version='1.0'?><prop.map version='1'>" + body + "</prop.map>"));
  EXPECT_EQ("tarsel/proplist/Error/BadVersion",
            ReadError("<?xml version='1.0'?><prop.map version='5'>" + body + "</prop.map>"));
  EXPECT_EQ("tarsel/proplist/Error/BadVersion", ReadError("<prop.map version='44'>" + body + "</prop.map>"));
  EXPECT_EQ("tarsel/proplist/Error/BadVersion", ReadError("<prop.map>" + body + "</prop.map>"));
}

TEST(PropListXmlTests, ErrorsNameTheLineOfTheFault) {
  std::string message;
  const std::string xml = Doc("<prop.pair>\r\n<key>n</key>\r\n<int type='signed' size='32'>12x</int>\r\n</prop.pair>\r\n");
  EXPECT_EQ("tarsel/proplist/Error/BadNumber", ReadError(xml, &message));
  EXPECT_NE(std::string::npos, message.find("line 6")) << message;
  EXPECT_NE(std::string::npos, message.find("12x")) << message;
}

TEST(PropListXmlTests, TextThatIsNotWellFormedIsRefusedWithTheLine) {
  std::string message;
  EXPECT_EQ("tarsel/proplist/Error/NotWellFormed",
            ReadError("<?xml version='1.0'?>\n<prop.map version='4'>\n<prop.list>\n</prop.map>", &message));
  EXPECT_NE(std::string::npos, message.find("line 4")) << message;
  EXPECT_EQ("tarsel/proplist/Error/NotWellFormed", ReadError(""));
  std::string withNul = "<prop.map version='4'>";
  withNul.push_back('\0');
  withNul += "<prop.list/></prop.map>";
  EXPECT_EQ("tarsel/proplist/Error/NotWellFormed", ReadError(withNul));
}

TEST(PropListXmlTests, BadNumbersAreRefused) {
  const char* bad[] = {
      "<int type='signed' size='32'>2147483648</int>",    // too big
      "<int type='signed' size='32'></int>",              // empty
      "<int type='unsigned' size='32'>-1</int>",          // negative unsigned
      "<int type='unsigned' size='32'>+1</int>",          // sign not written by anyone
      "<int type='signed' size='32'>0x10</int>",          // hexadecimal
      "<int type='signed' size='64'>1</int>",             // unknown size
      "<int type='long' size='32'>1</int>",               // unknown type
      "<int size='32'>1</int>",                           // no type
      "<float>1e39</float>",                              // beyond float
      "<float>1.0.0</float>",
      "<float size='16'>1</float>",
  };
  for (const char* value : bad) {
    EXPECT_NE("", ReadError(Doc(std::string("<prop.pair><key>k</key>") + value + "</prop.pair>"))) << value;
  }
}

TEST(PropListXmlTests, MalformedStructureIsRefused) {
  const std::pair<const char*, const char*> cases[] = {
      {"<prop.pair><key>k</key></prop.pair>", "MissingValue"},
      {"<prop.pair><true/></prop.pair>", "MissingKey"},
      {"<prop.pair><key>k</key><true/><false/></prop.pair>", "TwoValues"},
      {"<prop.pair><key>k</key><key>j</key><true/></prop.pair>", "MisplacedKey"},
      {"<prop.pair><key>k</key><true/></prop.pair><prop.pair><key>k</key><false/></prop.pair>", "DuplicateKey"},
      {"<prop.pair><key>k</key><double>1</double></prop.pair>", "UnexpectedElement"},
      {"<prop.pair><key>k</key><true>yes</true></prop.pair>", "UnexpectedText"},
      {"stray text", "UnexpectedText"},
      {"<prop.pair><key>k<b/></key><true/></prop.pair>", "UnexpectedElement"},
      {"<prop.pair extra='1'><key>k</key><true/></prop.pair>", "BadAttribute"},
      {"<prop.pair><key>k</key><array><ustring>a</ustring></array></prop.pair>", "UnexpectedElement"},
      {"<prop.pair><key>k</key><array></array></prop.pair>", "NoArrayType"},
      {"<prop.pair><key>k</key><array><array.type></array.type></array></prop.pair>", "NoArrayType"},
      {"<prop.pair><key>k</key><array><array.type><true/></array.type></array></prop.pair>", "BadArrayType"},
      {"<prop.pair><key>k</key><array><array.type><ustring/></array.type><string>a</string></array></prop.pair>",
       "ArrayEntryType"},
      {"<prop.pair><key>k</key><array><array.type><ustring/></array.type><prop.list/></array></prop.pair>",
       "ArrayEntryType"},
  };
  for (const auto& [body, error] : cases) {
    EXPECT_EQ(std::string("tarsel/proplist/Error/") + error, ReadError(Doc(body))) << body;
  }
  EXPECT_EQ("tarsel/proplist/Error/NotAPropList", ReadError("<plist version='4'/>"));
  EXPECT_EQ("tarsel/proplist/Error/NoList", ReadError("<prop.map version='4'></prop.map>"));
  EXPECT_EQ("tarsel/proplist/Error/UnexpectedElement",
            ReadError("<prop.map version='4'><prop.list/><prop.list/></prop.map>"));
}

TEST(PropListXmlTests, AFailedReadLeavesTheTargetListAsItWas) {
  PropList list;
  list.SetValue("keep", true);
  EXPECT_THROW(utils::ReadPropList(Doc("<prop.pair><key>k</key></prop.pair>"), list), Exception);
  EXPECT_TRUE(list.HasKey("keep"));
  utils::ReadPropList(Doc(""), list);
  EXPECT_TRUE(list.IsEmpty()) << "a good read replaces the content";
}

TEST(PropListXmlTests, EntityDeclarationsAndExternalReferencesAreRefused) {
  EXPECT_NE("", ReadError("<?xml version='1.0'?><!DOCTYPE m [<!ENTITY a 'aaaa'>]>"
                          "<prop.map version='4'><prop.list/></prop.map>"));
  EXPECT_NE("", ReadError("<?xml version='1.0'?><!DOCTYPE m SYSTEM 'file:///etc/passwd'>"
                          "<prop.map version='4'><prop.list><prop.pair><key>&ext;</key><true/></prop.pair>"
                          "</prop.list></prop.map>"));
}

TEST(PropListXmlTests, VeryDeepNestingIsRefusedInsteadOfExhaustingTheStackAndModerateNestingIsRead) {
  std::string body;
  std::string end;
  for (int i = 0; i < 5000; ++i) {
    body += "<prop.pair><key>k</key><prop.list>";
    end = "</prop.list></prop.pair>" + end;
  }
  EXPECT_NE("", ReadError(Doc(body + end)));

  PropList root;
  PropList* cursor = &root;
  PropListP at;
  for (int i = 0; i < 200; ++i) {
    at = cursor->NewSubList("k");
    cursor = at.get();
  }
  cursor->SetValue("leaf", true);
  EXPECT_EQ(root, Read(Str(utils::WritePropList(root))));
}

TEST(PropListXmlTests, PointsAndRectanglesAreArraysOfNumbers) {
  PropList list;
  utils::WritePointF32(list, "LayoutSize", {640.5f, 480.0f});
  utils::WriteRectF32(list, "ControlRect", {1.0f, 2.0f, 30.0f, 40.0f});
  utils::WritePoint32(list, "kHotSpot", {3, -4});
  utils::WriteRect32(list, "r", {-1, -2, 3, 4});
  PropList back = Read(Str(utils::WritePropList(list)));

  tarsel::geom::PointT<float> size;
  tarsel::geom::RectT<float> rect;
  tarsel::geom::PointT<long> hot;
  tarsel::geom::RectT<long> r;
  ASSERT_TRUE(utils::ReadPointF32(back, "LayoutSize", size));
  ASSERT_TRUE(utils::ReadRectF32(back, "ControlRect", rect));
  ASSERT_TRUE(utils::ReadPoint32(back, "kHotSpot", hot));
  ASSERT_TRUE(utils::ReadRect32(back, "r", r));
  EXPECT_EQ(tarsel::geom::PointT<float>(640.5f, 480.0f), size);
  EXPECT_EQ(tarsel::geom::RectT<float>(1.0f, 2.0f, 30.0f, 40.0f), rect);
  EXPECT_EQ(tarsel::geom::PointT<long>(3, -4), hot);
  EXPECT_EQ(tarsel::geom::RectT<long>(-1, -2, 3, 4), r);
}

TEST(PropListXmlTests, PointReadsRefuseTheWrongShapeOrType) {
  PropList list;
  list.SetValue("three", std::vector<std::int32_t>{1, 2, 3});
  list.SetValue("floats", std::vector<float>{1, 2});
  list.SetValue("scalar", std::int32_t{1});
  tarsel::geom::PointT<long> p(9, 9);
  tarsel::geom::RectT<float> r;
  EXPECT_FALSE(utils::ReadPoint32(list, "three", p));
  EXPECT_FALSE(utils::ReadPoint32(list, "floats", p));
  EXPECT_FALSE(utils::ReadPoint32(list, "scalar", p));
  EXPECT_FALSE(utils::ReadPoint32(list, "missing", p));
  EXPECT_FALSE(utils::ReadRectF32(list, "floats", r));
  EXPECT_EQ(tarsel::geom::PointT<long>(9, 9), p);
}

TEST(PropListXmlTests, SavedFilesLoadBackAndMissingFilesRaise) {
  const std::filesystem::path dir = std::filesystem::temp_directory_path() / "norvik_proplist_file_test";
  std::filesystem::remove_all(dir);
  std::filesystem::create_directories(dir);
  const std::string path = (dir / "prefs.xml").string();
  PropList list;
  list.SetValue("x", std::int32_t{5});
  utils::SavePropList(path, list);
  PropList loaded;
  utils::LoadPropList(path, loaded);
  EXPECT_EQ(list, loaded);
  EXPECT_FALSE(std::filesystem::exists(path + ".saving"));

  try {
    utils::LoadPropList((dir / "absent.xml").string(), loaded);
    ADD_FAILURE() << "loading a missing file must raise";
  } catch (const Exception& e) {
    EXPECT_EQ("tarsel/proplist/Error/CannotRead", e.GetKeyPath());
    EXPECT_NE(std::string::npos, std::string(e.what()).find("absent.xml"));
  }
  EXPECT_THROW(utils::SavePropList((dir / "no" / "such" / "dir.xml").string(), list), Exception);
  std::filesystem::remove_all(dir);
}
