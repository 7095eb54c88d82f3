// The in-memory property list: typed access, sub-lists, order and copying.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tarsel/PropList.h"

using tarsel::proplist::ConstPropListP;
using tarsel::proplist::PropList;
using tarsel::proplist::PropListP;
using tarsel::proplist::ValueType;

TEST(PropListTests, AValueIsFoundOnlyUnderTheTypeItWasStoredWithAndAFailedReadLeavesTheOutputAlone) {
  PropList list;
  list.SetValue("n", std::int32_t{-5});
  list.SetValue("u", std::uint32_t{7});
  list.SetValue("f", 1.5f);
  list.SetValue("d", 2.25);
  list.SetValue("items", std::vector<UTF16String>{u"Left", u"Right"});

  std::int32_t i = 99;
  std::uint32_t u = 99;
  float f = 0;
  double d = 0;
  EXPECT_TRUE(list.GetValue("n", i));
  EXPECT_EQ(-5, i);
  EXPECT_FALSE(list.GetValue("n", u));
  EXPECT_EQ(99u, u);
  EXPECT_FALSE(list.GetValue("u", i));
  EXPECT_TRUE(list.GetValue("u", u));
  EXPECT_FALSE(list.GetValue("f", d));
  EXPECT_TRUE(list.GetValue("f", f));
  EXPECT_FALSE(list.GetValue("d", f));
  EXPECT_TRUE(list.GetValue("d", d));
  EXPECT_EQ(2.25, d);
  std::vector<UTF8String> narrow;
  EXPECT_FALSE(list.GetValue("items", narrow));

  bool b = true;
  UTF16String s = u"kept";
  EXPECT_FALSE(list.GetValue("nothing", b));
  EXPECT_FALSE(list.GetValue("nothing", s));
  EXPECT_EQ(u"kept", s);
  EXPECT_EQ(ValueType::kNone, list.GetValueType("nothing"));
  EXPECT_EQ(nullptr, list.GetSubList("nothing"));
}

TEST(PropListTests, StringLiteralsAreStoredAsTextNotAsBooleans) {
  PropList list;
  list.SetValue("narrow", "1.2");
  list.SetValue("wide", u"Hello");
  EXPECT_EQ(ValueType::kString, list.GetValueType("narrow"));
  EXPECT_EQ(ValueType::kUString, list.GetValueType("wide"));
  UTF8String narrow;
  UTF16String wide;
  ASSERT_TRUE(list.GetValue("narrow", narrow));
  EXPECT_EQ("1.2", narrow);
  EXPECT_FALSE(list.GetValue("narrow", wide)) << "8-bit and UTF-16 strings are different types";

  list.SetValue("std", std::string("from std::string"));
  ASSERT_TRUE(list.GetValue("std", narrow));
  EXPECT_EQ("from std::string", narrow);
}

TEST(PropListTests, SettingAKeyAgainReplacesItsValueAndTypeAndEraseRemovesOnlyThatKey) {
  PropList list;
  list.SetValue("k", true);
  list.SetValue("k", u"now text");
  list.SetValue("other", false);
  EXPECT_EQ(2u, list.Size());
  bool b = false;
  EXPECT_FALSE(list.GetValue("k", b));
  EXPECT_EQ(ValueType::kUString, list.GetValueType("k"));
  EXPECT_TRUE(list.Erase("k"));
  EXPECT_FALSE(list.Erase("k"));
  EXPECT_TRUE(list.HasKey("other"));
  EXPECT_EQ(1u, list.Size());
}

TEST(PropListTests, KeysAreVisitedInByteOrder) {
  PropList list;
  for (const char* key : {"section-0", "count", "sectionName", "Zed", "apple", "\xC3\xA9t\xC3\xA9", "section-10"}) {
    list.SetValue(key, true);
  }
  std::vector<std::string> keys;
  for (const auto& entry : list) keys.emplace_back(entry.first.data(), entry.first.size());
  // Upper case before lower case, and bytes above 0x7F after all ASCII.
  EXPECT_EQ((std::vector<std::string>{"Zed", "apple", "count", "section-0", "section-10", "sectionName",
                                      "\xC3\xA9t\xC3\xA9"}),
            keys);
}

TEST(PropListTests, NewSubListReplacesAnyValueWithAnEmptyListThatOutlivesClearingItsParent) {
  PropList root;
  root.SetValue("plain", 3.0f);
  EXPECT_EQ(nullptr, root.GetSubList("plain"));
  root.NewSubList("s")->SetValue("x", true);
  PropListP sub = root.NewSubList("s");
  EXPECT_TRUE(sub->IsEmpty());
  EXPECT_EQ(sub, root.GetSubList("s"));
  EXPECT_EQ(ValueType::kList, root.GetValueType("s"));
  sub->SetValue("v", std::uint32_t{3});
  root.Clear();
  EXPECT_TRUE(root.IsEmpty());
  EXPECT_EQ(1, sub->GetRefCount());
  EXPECT_TRUE(sub->HasKey("v"));
}

TEST(PropListTests, CopiesAreDeepAndEqualityLooksAtTypesAndNestedContent) {
  PropList original;
  original.NewSubList("s")->SetValue("v", std::int32_t{1});
  PropList copy = original;
  EXPECT_EQ(original, copy);
  copy.GetSubList("s")->SetValue("v", std::int32_t{2});
  std::int32_t v = 0;
  original.GetSubList("s")->GetValue("v", v);
  EXPECT_EQ(1, v) << "changing the copy's sub-list must not reach the original";
  EXPECT_NE(original, copy);

  PropList a, b;
  a.SetValue("n", std::int32_t{1});
  b.SetValue("n", std::uint32_t{1});
  EXPECT_NE(a, b) << "same number, different type";
}

TEST(PropListTests, AListCanBeStoredAsASubListOfItself) {
  PropList list;
  list.SetValue("v", true);
  list.SetSubList("self", list);
  list.SetSubList("self", list);
  ConstPropListP self = list.GetSubList("self");
  ASSERT_NE(nullptr, self);
  ConstPropListP inner = self->GetSubList("self");
  ASSERT_NE(nullptr, inner);
  EXPECT_EQ(nullptr, inner->GetSubList("self")) << "a snapshot is stored, not the live list";
  EXPECT_TRUE(inner->HasKey("v"));
}

TEST(PropListTests, AssigningASubListToItsParentKeepsTheData) {
  PropList root;
  root.NewSubList("child")->SetValue("x", std::int32_t{9});
  root = *root.GetSubList("child");
  std::int32_t x = 0;
  EXPECT_TRUE(root.GetValue("x", x));
  EXPECT_EQ(9, x);
  EXPECT_FALSE(root.HasKey("child"));
}
