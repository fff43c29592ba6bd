#include "PlatformModel/System/NDValue.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace nidus {
namespace {

constexpr std::int64_t kGreatest = std::numeric_limits<std::int64_t>::max();
constexpr std::int64_t kLeast = std::numeric_limits<std::int64_t>::min();
constexpr float kInfinity = std::numeric_limits<float>::infinity();
constexpr float kNotANumber = std::numeric_limits<float>::quiet_NaN();

struct Reading {
  const char* label;
  NDValueRef value;
  bool asBool;
  std::int64_t asInteger;
  float asFloat;
};

std::vector<Reading> readings() {
  return {
      {"false", NDValue::boolean(false), false, 0, 0.0F},
      {"true", NDValue::boolean(true), true, 1, 1.0F},
      {"zero", NDValue::integer(0), false, 0, 0.0F},
      {"integer", NDValue::integer(-40), true, -40, -40.0F},
      {"greatest integer", NDValue::integer(kGreatest), true, kGreatest, 9223372036854775808.0F},
      {"least integer", NDValue::integer(kLeast), true, kLeast, -9223372036854775808.0F},
      {"integer between floats", NDValue::integer(16777217), true, 16777217, 16777216.0F},
      {"zero float", NDValue::floating(0.0F), false, 0, 0.0F},
      {"negative zero", NDValue::floating(-0.0F), false, 0, 0.0F},
      {"small float", NDValue::floating(0.25F), true, 0, 0.25F},
      {"cut down", NDValue::floating(2.9F), true, 2, 2.9F},
      {"cut up", NDValue::floating(-2.9F), true, -2, -2.9F},
      {"above integers", NDValue::floating(1e30F), true, kGreatest, 1e30F},
      {"first above integers", NDValue::floating(0x1p63F), true, kGreatest, 0x1p63F},
      {"least integer as float", NDValue::floating(-0x1p63F), true, kLeast, -0x1p63F},
      {"below integers", NDValue::floating(-kInfinity), true, kLeast, -kInfinity},
      {"text", NDValue::text("5"), false, 0, 0.0F},
      {"empty text", NDValue::text(""), false, 0, 0.0F},
  };
}

TEST(NDValueTest, ReadsEachKindAsEachNumber) {
  for (const Reading& reading : readings()) {
    SCOPED_TRACE(reading.label);
    EXPECT_EQ(reading.value->boolValue(), reading.asBool);
    EXPECT_EQ(reading.value->integerValue(), reading.asInteger);
    EXPECT_EQ(reading.value->floatValue(), reading.asFloat);
  }
}

TEST(NDValueTest, NotANumberIsTrueAndZero) {
  const NDValueRef value = NDValue::floating(kNotANumber);
  EXPECT_TRUE(value->boolValue());
  EXPECT_EQ(value->integerValue(), 0);
  EXPECT_TRUE(std::isnan(value->floatValue()));
}

TEST(NDValueTest, OnlyTextHasStringValue) {
  EXPECT_EQ(NDValue::text("HEAT")->stringValue(), "HEAT");
  EXPECT_FALSE(NDValue::integer(5)->stringValue());
  EXPECT_FALSE(NDValue::floating(5)->stringValue());
  EXPECT_FALSE(NDValue::boolean(true)->stringValue());
}

TEST(NDValueTest, StringValueSharesTheCharacters) {
  const NDString text = "HEAT";
  EXPECT_EQ(NDValue::text(text)->stringValue().view().data(), text.view().data());
}

TEST(NDValueTest, KnowsItsKind) {
  EXPECT_TRUE(NDValue::boolean(true)->isBoolean());
  EXPECT_FALSE(NDValue::boolean(true)->isInteger());
  EXPECT_TRUE(NDValue::integer(1)->isInteger());
  EXPECT_TRUE(NDValue::floating(1)->isFloating());
  EXPECT_TRUE(NDValue::floating(1)->isNumber());
  EXPECT_TRUE(NDValue::text("1")->isText());
  EXPECT_FALSE(NDValue::text("1")->isNumber());
}

TEST(NDValueTest, FactoriesGiveNewObjects) {
  EXPECT_NE(NDValue::integer(5), NDValue::integer(5));
  EXPECT_NE(NDValue::boolean(true), NDValue::boolean(true));
}

struct Comparison {
  const char* label;
  NDValueRef a;
  NDValueRef b;
  std::partial_ordering order;
};

std::vector<Comparison> comparisons() {
  using Order = std::partial_ordering;
  return {
      {"integers", NDValue::integer(1), NDValue::integer(2), Order::less},
      {"booleans", NDValue::boolean(false), NDValue::boolean(true), Order::less},
      {"true is 1", NDValue::boolean(true), NDValue::integer(1), Order::equivalent},
      {"true is 1.0", NDValue::boolean(true), NDValue::floating(1), Order::equivalent},
      {"floats", NDValue::floating(1.5F), NDValue::floating(1.25F), Order::greater},
      {"fraction above", NDValue::integer(2), NDValue::floating(2.5F), Order::less},
      {"fraction below zero", NDValue::integer(-2), NDValue::floating(-2.5F), Order::greater},
      {"fraction around zero", NDValue::integer(0), NDValue::floating(-0.5F), Order::greater},
      {"zeros", NDValue::floating(-0.0F), NDValue::integer(0), Order::equivalent},
      {"beyond float", NDValue::integer(16777217), NDValue::floating(16777216), Order::greater},
      {"greatest", NDValue::integer(kGreatest), NDValue::floating(0x1p63F), Order::less},
      {"least", NDValue::integer(kLeast), NDValue::floating(-0x1p63F), Order::equivalent},
      {"infinity", NDValue::integer(kGreatest), NDValue::floating(kInfinity), Order::less},
      {"below all", NDValue::integer(kLeast), NDValue::floating(-kInfinity), Order::greater},
      {"not a number", NDValue::integer(0), NDValue::floating(kNotANumber), Order::unordered},
      {"both not", NDValue::floating(kNotANumber), NDValue::floating(kNotANumber),
       Order::unordered},
      {"text", NDValue::integer(5), NDValue::text("5"), Order::unordered},
      {"texts", NDValue::text("a"), NDValue::text("b"), Order::unordered},
  };
}

TEST(NDValueTest, ComparesNumbersExactlyBothWays) {
  for (const Comparison& comparison : comparisons()) {
    SCOPED_TRACE(comparison.label);
    EXPECT_EQ(comparison.a->compare(comparison.b), comparison.order);
    const auto turned = comparison.b->compare(comparison.a);
    EXPECT_EQ(std::is_lt(turned), std::is_gt(comparison.order));
    EXPECT_EQ(std::is_gt(turned), std::is_lt(comparison.order));
    EXPECT_EQ(std::is_eq(turned), std::is_eq(comparison.order));
  }
}

TEST(NDValueTest, NullIsNeitherBelowNorAbove) {
  EXPECT_EQ(NDValue::integer(0)->compare(nullptr), std::partial_ordering::unordered);
  EXPECT_EQ(NDValue::text("")->compare(nullptr), std::partial_ordering::unordered);
}

TEST(NDValueTest, EqualityIsByNumberOrText) {
  EXPECT_TRUE(NDValue::boolean(true)->isEqual(*NDValue::floating(1)));
  EXPECT_TRUE(NDValue::text("a")->isEqual(*NDValue::text("a")));
  EXPECT_FALSE(NDValue::text("a")->isEqual(*NDValue::text("A")));
  EXPECT_FALSE(NDValue::text("0")->isEqual(*NDValue::integer(0)));
  EXPECT_FALSE(NDValue::integer(0)->isEqual(*NDValue::text("0")));
  EXPECT_FALSE(NDValue::floating(kNotANumber)->isEqual(*NDValue::floating(kNotANumber)));
}

TEST(NDValueTest, DescribesItselfAsText) {
  const std::vector<std::pair<NDValueRef, std::string>> cases = {
      {nullptr, "(null)"},
      {NDValue::boolean(false), "0"},
      {NDValue::boolean(true), "1"},
      {NDValue::integer(kLeast), "-9223372036854775808"},
      {NDValue::floating(72), "72"},
      {NDValue::floating(72.5F), "72.5"},
      {NDValue::floating(22.222221F), "22.222221"},
      {NDValue::floating(1e30F), "1e+30"},
      {NDValue::text("HEAT"), "HEAT"},
      {NDValue::text(""), ""},
  };
  for (const auto& [value, text] : cases) EXPECT_EQ(description(value), text);
}

}  // namespace
}  // namespace nidus
