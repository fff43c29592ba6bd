#include "Growth.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <vector>

namespace nidus {
namespace {

using testing::DoubleNear;
using testing::ElementsAre;
using testing::Optional;

/// The values of `curve` in homes of 1,000 to 100,000 services.
std::vector<ValueAtSize> valuesOf(const std::function<double(double size)>& curve) {
  std::vector<ValueAtSize> values;
  for (const double size : {1'000.0, 10'000.0, 100'000.0}) values.push_back({size, curve(size)});
  return values;
}

TEST(GrowthTest, ExponentIsThatOfPower) {
  for (const double exponent : {-0.5, 0.0, 1.0, 1.5, 2.0, 3.0}) {
    SCOPED_TRACE(exponent);
    const auto power = [exponent](double size) { return 7 * std::pow(size, exponent); };
    EXPECT_THAT(exponentOf(valuesOf(power)), Optional(DoubleNear(exponent, 1e-9)));
  }
}

TEST(GrowthTest, LogarithmAddsLittle) {
  const auto curve = [](double size) { return size * std::log(size); };
  EXPECT_THAT(exponentOf(valuesOf(curve)), Optional(DoubleNear(1.11, 0.005)));
}

TEST(GrowthTest, EachSizeCountsAlike) {
  const std::vector<ValueAtSize> values = {{100, 10}, {1'000, 10}, {10'000, 1'000}};
  EXPECT_THAT(exponentOf(values), Optional(DoubleNear(1, 1e-9)));
}

TEST(GrowthTest, QuadraticShareShowsOnceItWeighs) {
  const auto curve = [](double size) { return 5'000 * size + size * size; };
  const auto exponent = exponentOf(valuesOf(curve));
  ASSERT_TRUE(exponent);
  EXPECT_EQ(powerNextTo(*exponent), 2);
}

TEST(GrowthTest, GreatestThreeSizesTell) {
  const std::vector<ValueAtSize> values = {
      {10, 50}, {100, 50}, {1'000, 50}, {10'000, 500}, {100'000, 5'000}};
  EXPECT_THAT(exponentOf(values), Optional(DoubleNear(1, 1e-9)));
}

TEST(GrowthTest, TooFewSizesTellNothing) {
  EXPECT_FALSE(exponentOf({}));
  EXPECT_FALSE(exponentOf(std::vector<ValueAtSize>{{1'000, 1}, {10'000, 10}}));
}

TEST(GrowthTest, SmallHomesTellNothing) {
  EXPECT_FALSE(exponentOf(std::vector<ValueAtSize>{{10, 1}, {100, 10}, {1'000, 100}}));
}

TEST(GrowthTest, RepeatedSizeTellsNothing) {
  EXPECT_FALSE(exponentOf(std::vector<ValueAtSize>{{1'000, 1}, {10'000, 9}, {10'000, 10}}));
}

TEST(GrowthTest, ValueBelowZeroTellsNothing) {
  for (const double noise : {0.0, -1.0}) {
    EXPECT_FALSE(exponentOf(std::vector<ValueAtSize>{{100, noise}, {1'000, 9}, {10'000, 90}}));
  }
}

TEST(GrowthTest, WholePowerNextToExponent) {
  const std::vector<int> powers = {powerNextTo(-0.7), powerNextTo(0.49), powerNextTo(0.5),
                                   powerNextTo(1.49), powerNextTo(1.5)};
  EXPECT_THAT(powers, ElementsAre(0, 0, 1, 1, 2));
}

TEST(GrowthTest, PowersAreWrittenShort) {
  EXPECT_EQ(textOfPower(0), "O(1)");
  EXPECT_EQ(textOfPower(1), "O(N)");
  EXPECT_EQ(textOfPower(3), "O(N^3)");
}

}  // namespace
}  // namespace nidus
