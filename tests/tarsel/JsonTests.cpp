// JSON text to boost::any values and back, and the object helpers.
#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <string>

#include "tarsel/JSONSerialization.h"
#include "tarsel/ThrowError.h"

using tarsel::config::Exception;
using namespace tarsel::serialization;

namespace {

std::string Str(const UTF8String& s) { return std::string(s.data(), s.size()); }

std::string ParseErrorKey(const std::string& text, std::string* outMessage = nullptr) {
  try {
    JSONParse(text);
  } catch (const Exception& e) {
    if (outMessage) *outMessage = e.what();
    return e.GetKeyPath();
  }
  return "";
}

}  // namespace

TEST(JsonTests, ParsingGivesTheDocumentedTypes) {
  const boost::any v = JSONParse(R"({"b": true, "i": -42, "f": 1.5, "s": "h\u00e9", "n": null, "a": [1, "x"]})");
  const auto* object = boost::any_cast<JSONObject>(&v);
  ASSERT_NE(nullptr, object);
  EXPECT_EQ(true, boost::any_cast<bool>(object->at("b")));
  EXPECT_EQ(-42, boost::any_cast<std::int64_t>(object->at("i")));
  EXPECT_EQ(1.5, boost::any_cast<double>(object->at("f")));
  EXPECT_EQ(u"h\u00e9", boost::any_cast<UTF16String>(object->at("s")));
  EXPECT_TRUE(object->at("n").empty());
  const auto& array = boost::any_cast<const JSONArray&>(object->at("a"));
  ASSERT_EQ(2u, array.size());
  EXPECT_EQ(1, boost::any_cast<std::int64_t>(array[0]));
  EXPECT_EQ(u"x", boost::any_cast<UTF16String>(array[1]));
}

TEST(JsonTests, IntegersBeyondSixtyFourSignedBitsBecomeDoubles) {
  EXPECT_EQ(std::numeric_limits<std::int64_t>::max(),
            boost::any_cast<std::int64_t>(JSONParse("9223372036854775807")));
  EXPECT_EQ(18446744073709551615.0, boost::any_cast<double>(JSONParse("18446744073709551615")));
  EXPECT_EQ(100.0, boost::any_cast<double>(JSONParse("1e2"))) << "an exponent makes a double";
}

TEST(JsonTests, WritingAndParsingAgainKeepsTheValue) {
  boost::any root;
  AddToObject(root, "name", UTF16String(u"Tool \"one\"\n\u2603"));
  AddToObject(root, "count", std::int64_t{3});
  AddToObject(root, "ratio", 0.25);
  AddToObject(root, "on", false);
  AddToObject(root, "nothing", boost::any());
  boost::any list;
  AppendToArray(list, std::int64_t{1});
  AppendToArray(list, UTF16String(u"two"));
  AddToObject(root, "list", list);

  const boost::any back = JSONParse(Str(GetJSONString(root)));
  EXPECT_EQ(Str(GetJSONString(root)), Str(GetJSONString(back)));
  EXPECT_EQ(u"Tool \"one\"\n\u2603", boost::any_cast<UTF16String>(GetVariantInObject(back, "name")));
  EXPECT_EQ(0.25, boost::any_cast<double>(GetVariantInObject(back, "ratio")));
  EXPECT_TRUE(ObjectHasProperty(back, "nothing"));
  EXPECT_TRUE(GetVariantInObject(back, "nothing").empty());
}

TEST(JsonTests, ObjectsAreWrittenWithKeysInByteOrder) {
  boost::any root;
  AddToObject(root, "b", 1);
  AddToObject(root, "B", 2u);
  AddToObject(root, "a", UTF8String("8-bit"));
  EXPECT_EQ(R"({"B":2,"a":"8-bit","b":1})", Str(GetJSONString(root)));
}

TEST(JsonTests, TheLastOfTwoEqualKeysWinsAndMissingPropertiesAndNonObjectsGiveEmptyValues) {
  const boost::any v = JSONParse(R"({"k": 1, "k": 2})");
  EXPECT_EQ(2, boost::any_cast<std::int64_t>(GetVariantInObject(v, "k")));
  EXPECT_FALSE(ObjectHasProperty(v, "other"));
  EXPECT_TRUE(GetVariantInObject(v, "other").empty());
  const boost::any array = JSONParse("[1]");
  EXPECT_FALSE(ObjectHasProperty(array, "k"));
  EXPECT_TRUE(GetVariantInObject(array, "0").empty());
}

TEST(JsonTests, AddingToANonObjectOrAppendingToANonArrayRaises) {
  boost::any number = std::int64_t{1};
  EXPECT_THROW(AddToObject(number, "k", 1), Exception);
  EXPECT_THROW(AppendToArray(number, 1), Exception);
  boost::any object = JSONObject();
  EXPECT_THROW(AppendToArray(object, 1), Exception);
  EXPECT_EQ(1, boost::any_cast<std::int64_t>(number)) << "the value is left as it was";
}

TEST(JsonTests, AnObjectCanBeAddedToItself) {
  boost::any root;
  AddToObject(root, "x", 1);
  AddToObject(root, "self", root);
  EXPECT_EQ(R"({"self":{"x":1},"x":1})", Str(GetJSONString(root)));
}

TEST(JsonTests, MalformedTextRaisesTheToolkitExceptionWithAClearMessage) {
  std::string message;
  EXPECT_EQ("tarsel/serialization/Error/BadJSON", ParseErrorKey("{\"a\": tru}", &message));
  EXPECT_NE(std::string::npos, message.find("cannot be read")) << message;
  EXPECT_NE(std::string::npos, message.find("line 1")) << message;
  EXPECT_EQ(std::string::npos, message.find("json.exception")) << message;
  EXPECT_EQ("tarsel/serialization/Error/BadJSON", ParseErrorKey("[1e999]", &message));
  EXPECT_NE(std::string::npos, message.find("1e999")) << message;
  for (const char* bad : {"", "{", "[1,]", "{\"a\" 1}", "01", "\"\\x\"", "[1] 2", "nul", "\"\xC3\x28\"", "1e999x"}) {
    EXPECT_EQ("tarsel/serialization/Error/BadJSON", ParseErrorKey(bad)) << bad;
  }
}

TEST(JsonTests, DeepNestingIsRefusedBothWays) {
  EXPECT_EQ("tarsel/serialization/Error/TooDeep", ParseErrorKey(std::string(100000, '[')));
  EXPECT_EQ("", ParseErrorKey(std::string(100, '[') + std::string(100, ']')));

  boost::any value;
  for (std::size_t i = 0; i <= kMaxJSONDepth; ++i) {
    JSONArray wrapper;
    wrapper.push_back(value);
    value = wrapper;
  }
  EXPECT_THROW(GetJSONString(value), Exception);
}

TEST(JsonTests, ValuesThatJsonCannotHoldRaise) {
  EXPECT_THROW(GetJSONString(std::numeric_limits<double>::quiet_NaN()), Exception);
  EXPECT_THROW(GetJSONString(std::numeric_limits<float>::infinity()), Exception);
  struct Opaque {};
  EXPECT_THROW(GetJSONString(Opaque()), Exception);
}

TEST(JsonTests, BrokenUtf8InNarrowStringsIsReplacedOnWriting) {
  const UTF8String text = GetJSONString(UTF8String("a\xFF"));
  EXPECT_EQ(u"a\uFFFD", boost::any_cast<UTF16String>(JSONParse(Str(text))));
}
