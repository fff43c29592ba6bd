#include "PlatformModel/System/NDDictionary.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

TEST(NDDictionaryTest, KeepsOrderOfKeys) {
  NDDictionary dictionary;
  for (const char* key : {"zone", "home", "attic"}) dictionary.set(key, NDDictionaryValue(true));
  std::string keys;
  for (const auto& [key, value] : dictionary) keys += key + ' ';
  EXPECT_EQ(keys, "zone home attic ");
  EXPECT_EQ(dictionary.size(), 3U);
}

TEST(NDDictionaryTest, ReplacedValueKeepsItsPlace) {
  NDDictionary dictionary;
  dictionary.set("a", NDDictionaryValue(true));
  dictionary.set("b", NDDictionaryValue(true));
  dictionary.set("a", NDDictionaryValue(std::int64_t{5}));
  EXPECT_EQ(dictionary.size(), 2U);
  EXPECT_EQ(dictionary.begin()->first, "a");
  EXPECT_EQ(*dictionary.find("a"), NDDictionaryValue(std::int64_t{5}));
}

TEST(NDDictionaryTest, AbsentKeyIsFoundNowhere) {
  NDDictionary dictionary;
  EXPECT_TRUE(dictionary.empty());
  EXPECT_EQ(dictionary.find("a"), nullptr);
  dictionary.set("a", NDDictionaryValue());
  EXPECT_NE(dictionary.find("a"), nullptr);
  EXPECT_FALSE(dictionary.empty());
}

TEST(NDDictionaryTest, SetIfPresentSkipsNull) {
  NDDictionary dictionary;
  dictionary.setIfPresent("none", NDString());
  dictionary.setIfPresent("empty", "");
  EXPECT_EQ(dictionary.size(), 1U);
  EXPECT_EQ(*dictionary.find("empty"), NDDictionaryValue(NDString("")));
}

TEST(NDDictionaryTest, NullTextMakesNullValue) {
  EXPECT_TRUE(std::holds_alternative<std::nullptr_t>(NDDictionaryValue(NDString()).content()));
  EXPECT_EQ(NDDictionaryValue(NDString()), NDDictionaryValue());
  EXPECT_TRUE(std::holds_alternative<NDString>(NDDictionaryValue(NDString("")).content()));
}

TEST(NDDictionaryTest, KindsAreNeverEqual) {
  EXPECT_FALSE(NDDictionaryValue(true) == NDDictionaryValue(std::int64_t{1}));
  EXPECT_FALSE(NDDictionaryValue(1.0F) == NDDictionaryValue(std::int64_t{1}));
  EXPECT_FALSE(NDDictionaryValue() == NDDictionaryValue(false));
  EXPECT_FALSE(NDDictionaryValue(NDDictionaryList()) == NDDictionaryValue(NDDictionary()));
}

TEST(NDDictionaryTest, EqualityLooksInside) {
  const auto make = [](bool inner) {
    NDDictionary leaf;
    leaf.set("x", NDDictionaryValue(inner));
    NDDictionaryList list;
    list.emplace_back(leaf);
    NDDictionary dictionary;
    dictionary.set("list", NDDictionaryValue(list));
    return dictionary;
  };
  EXPECT_EQ(make(true), make(true));
  EXPECT_FALSE(make(true) == make(false));
}

TEST(NDDictionaryTest, EqualityRespectsOrder) {
  NDDictionary a;
  a.set("x", NDDictionaryValue());
  a.set("y", NDDictionaryValue());
  NDDictionary b;
  b.set("y", NDDictionaryValue());
  b.set("x", NDDictionaryValue());
  EXPECT_FALSE(a == b);
}

}  // namespace
}  // namespace nidus
