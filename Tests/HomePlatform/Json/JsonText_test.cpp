#include "HomePlatform/Json/JsonText.h"

#include <gtest/gtest.h>

#include <bit>
#include <cfloat>
#include <cmath>
#include <limits>
#include <random>
#include <string>

namespace nidus {
namespace {

std::string floatText(float value) {
  std::string text;
  appendJsonFloat(text, value);
  return text;
}

std::string valueText(const NDValueRef& value) {
  std::string text;
  appendJsonValue(text, value);
  return text;
}

TEST(AppendJsonTextTest, EscapesOnlyWhatMustBe) {
  constexpr char kCharacters[] = "\"\\/\b\f\n\r\t\x01\x1f\x7f é𝄞\0z";
  std::string text;
  appendJsonText(text, std::string_view(kCharacters, sizeof kCharacters - 1));
  EXPECT_EQ(text, "\"\\\"\\\\/\\b\\f\\n\\r\\t\\u0001\\u001f\x7f é𝄞\\u0000z\"");
}

TEST(AppendJsonFloatTest, AlwaysHasFractionOrExponent) {
  struct Case {
    float value;
    const char* text;
  };
  const Case cases[] = {
      {72.0F, "72.0"},
      {22.222221F, "22.222221"},
      {0.0F, "0.0"},
      {-0.0F, "-0.0"},
      {0.1F, "0.1"},
      {1e20F, "1e+20"},
      {1e-5F, "1e-05"},
      {16777216.0F, "16777216.0"},
      {FLT_MAX, "3.4028235e+38"},
  };
  for (const auto& [value, text] : cases) EXPECT_EQ(floatText(value), text);
}

TEST(AppendJsonFloatTest, WritesNullForWhatJsonLacks) {
  EXPECT_EQ(floatText(std::numeric_limits<float>::infinity()), "null");
  EXPECT_EQ(floatText(-std::numeric_limits<float>::infinity()), "null");
  EXPECT_EQ(floatText(std::nanf("")), "null");
}

TEST(AppendJsonFloatTest, ReadsBackTheSameBits) {
  std::mt19937 random(7);
  for (int i = 0; i < 20'000; ++i) {
    const auto value = std::bit_cast<float>(static_cast<std::uint32_t>(random()));
    if (!std::isfinite(value)) continue;
    const auto back = std::get<float>(parseJson(floatText(value)).content);
    ASSERT_EQ(std::bit_cast<std::uint32_t>(back), std::bit_cast<std::uint32_t>(value));
  }
}

TEST(AppendJsonValueTest, WritesEachKind) {
  EXPECT_EQ(valueText(nullptr), "null");
  EXPECT_EQ(valueText(NDValue::boolean(true)), "true");
  EXPECT_EQ(valueText(NDValue::boolean(false)), "false");
  EXPECT_EQ(valueText(NDValue::integer(std::numeric_limits<std::int64_t>::min())),
            "-9223372036854775808");
  EXPECT_EQ(valueText(NDValue::floating(45)), "45.0");
  EXPECT_EQ(valueText(NDValue::text("1")), "\"1\"");
}

TEST(AppendJsonTest, WritesDictionariesOnOneLine) {
  NDDictionary inner;
  inner.set("b", NDDictionaryValue(true));
  NDDictionary dictionary;
  dictionary.set("z", NDDictionaryValue(NDDictionaryList{
                          NDDictionaryValue(), NDDictionaryValue(std::int64_t{1}),
                          NDDictionaryValue(2.0F), NDDictionaryValue(NDString("x"))}));
  dictionary.set("a", NDDictionaryValue(inner));
  std::string text;
  appendJson(text, dictionary);
  EXPECT_EQ(text, R"({"z": [null, 1, 2.0, "x"], "a": {"b": true}})");
}

TEST(AppendJsonTest, ReturnsWhatWasParsed) {
  const std::string text = R"({"a": [null, true, -5, 2.5, "é\n"], "b": {}, "c": []})";
  std::string written;
  appendJson(written, parseJson(text));
  EXPECT_EQ(written, text);
}

}  // namespace
}  // namespace nidus
