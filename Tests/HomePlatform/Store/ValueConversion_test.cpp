#include "HomePlatform/Store/ValueConversion.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace nidus {
namespace {

constexpr std::int64_t kLeast = std::numeric_limits<std::int64_t>::min();
constexpr std::int64_t kGreatest = std::numeric_limits<std::int64_t>::max();

constexpr float kGreatestFloat = std::numeric_limits<float>::max();

NDValueRef integer(std::int64_t value) { return NDValue::integer(value); }
NDValueRef floating(float value) { return NDValue::floating(value); }

TEST(ConvertToFormatTest, RoundsToIntegersWithinRange) {
  struct Case {
    const char* format;
    NDValueRef value;
    std::int64_t expected;
  };
  const Case cases[] = {
      {"int", floating(2.5F), 3},
      {"int", floating(-2.5F), -3},
      {"int", floating(2.4999998F), 2},
      {"int", floating(0.49999997F), 0},
      {"int", floating(-0.5F), -1},
      {"int", NDValue::boolean(true), 1},
      {"int", integer(2147483647), 2147483647},
      {"int", integer(-2147483648LL), -2147483648LL},
      {"int", floating(-2147483648.0F), -2147483648LL},
      {"uint8", floating(255.4F), 255},
      {"uint8", floating(-0.4F), 0},
      {"uint16", integer(65535), 65535},
      {"uint32", integer(4294967295LL), 4294967295LL},
      {"uint64", integer(kGreatest), kGreatest},
      {"uint64", floating(9.223371e18F), 9223370937343148032LL},
      {"uint64", NDValue::boolean(false), 0},
  };
  for (const auto& [format, value, expected] : cases) {
    SCOPED_TRACE(format + (" " + value->description()));
    const NDValueRef converted = convertToFormat(value, format);
    ASSERT_TRUE(converted);
    EXPECT_TRUE(converted->isInteger());
    EXPECT_EQ(converted->integerValue(), expected);
  }
}

TEST(ConvertToFormatTest, RefusesWhatDoesNotFit) {
  struct Case {
    const char* format;
    NDValueRef value;
  };
  const Case cases[] = {
      {"int", integer(2147483648LL)},
      {"int", integer(-2147483649LL)},
      {"int", floating(2147483648.0F)},
      {"int", floating(std::nanf(""))},
      {"uint8", integer(256)},
      {"uint8", integer(-1)},
      {"uint8", floating(255.5F)},
      {"uint8", floating(-0.5F)},
      {"uint16", integer(65536)},
      {"uint32", integer(4294967296LL)},
      {"uint32", integer(-1)},
      {"uint64", integer(-1)},
      {"uint64", integer(kLeast)},
      {"uint64", floating(9223372036854775808.0F)},
      {"uint64", floating(std::numeric_limits<float>::infinity())},
      {"uint64", floating(-std::numeric_limits<float>::infinity())},
      {"int", NDValue::text("1")},
      {"bool", NDValue::text("true")},
      {"float", NDValue::text("1.0")},
      {"string", integer(1)},
      {"string", floating(1)},
      {"string", NDValue::boolean(true)},
  };
  for (const auto& [format, value] : cases) {
    SCOPED_TRACE(format + (" " + value->description()));
    EXPECT_FALSE(convertToFormat(value, format));
  }
}

TEST(ConvertToFormatTest, TakesAnyNumberAsBoolean) {
  EXPECT_TRUE(convertToFormat(integer(-7), "bool")->boolValue());
  EXPECT_TRUE(convertToFormat(floating(0.1F), "bool")->boolValue());
  EXPECT_FALSE(convertToFormat(floating(-0.0F), "bool")->boolValue());
  EXPECT_TRUE(convertToFormat(integer(0), "bool")->isBoolean());
}

TEST(ConvertToFormatTest, TakesAnyNumberAsFloat) {
  EXPECT_EQ(convertToFormat(integer(16777217), "float")->floatValue(), 16777216.0F);
  EXPECT_EQ(convertToFormat(NDValue::boolean(true), "float")->floatValue(), 1.0F);
  EXPECT_TRUE(convertToFormat(integer(1), "float")->isFloating());
}

TEST(ConvertToFormatTest, KeepsTheSameObject) {
  struct Case {
    const char* format;
    NDValueRef value;
  };
  const Case cases[] = {
      {"bool", NDValue::boolean(true)}, {"uint8", integer(5)},     {"float", floating(5)},
      {"string", NDValue::text("")},    {"tlv8", integer(kLeast)}, {"", floating(kGreatestFloat)},
      {"Bool", NDValue::text("x")},
  };
  for (const auto& [format, value] : cases) EXPECT_EQ(convertToFormat(value, format), value);
  const NDValueRef value = NDValue::text("as it is");
  EXPECT_EQ(convertToFormat(value, nullptr), value);
}

TEST(ConvertToFormatTest, TakesNoTextBesideUTF8) {
  for (const char* format : {"string", "", "other"}) {
    EXPECT_EQ(convertToFormat(NDValue::text("caf\xE9"), format), nullptr) << format;
    EXPECT_NE(convertToFormat(NDValue::text("caf\xC3\xA9"), format), nullptr) << format;
  }
}

TEST(ConvertToFormatTest, TakesNoInfinityButAsBoolean) {
  constexpr float kInfinity = std::numeric_limits<float>::infinity();
  for (const float number : {kInfinity, -kInfinity, std::nanf("")}) {
    for (const char* format : {"float", "int", "", "tlv8"}) {
      EXPECT_EQ(convertToFormat(floating(number), format), nullptr) << format << ' ' << number;
    }
    EXPECT_TRUE(convertToFormat(floating(number), "bool")->boolValue()) << number;
  }
  EXPECT_NE(convertToFormat(floating(kGreatestFloat), "float"), nullptr);
}

TEST(IsSameValueTest, TellsKindsAndBitsApart) {
  const NDValueRef values[] = {nullptr,        NDValue::boolean(true), integer(1),
                               floating(1.0F), floating(0.0F),         floating(-0.0F),
                               integer(2),     NDValue::text("1"),     NDValue::text("")};
  for (const NDValueRef& a : values) {
    for (const NDValueRef& b : values) EXPECT_EQ(isSameValue(a, b), &a == &b);
  }
  EXPECT_TRUE(isSameValue(NDValue::text("1"), NDValue::text("1")));
  EXPECT_TRUE(isSameValue(floating(std::nanf("")), floating(std::nanf(""))));
}

TEST(ConvertToFormatTest, GivesNullForNull) {
  for (const char* format : {"bool", "int", "float", "string", "other"}) {
    EXPECT_FALSE(convertToFormat(nullptr, format));
  }
  EXPECT_FALSE(convertToFormat(nullptr, nullptr));
}

}  // namespace
}  // namespace nidus
