#include "Growth.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cmath>
#include <functional>

namespace nidus {
namespace {

using testing::DoubleNear;
using testing::ElementsAre;

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
    EXPECT_THAT(exponentOf(valuesOf(power)), DoubleNear(exponent, 1e-9));
  }
}

TEST(GrowthTest, LogarithmAddsLittle) {
  const auto curve = [](double size) { return size * std::log(size); };
  EXPECT_THAT(exponentOf(valuesOf(curve)), DoubleNear(1.11, 0.005));
}

TEST(GrowthTest, EachSizeCountsAlike) {
  EXPECT_THAT(exponentOf({{10, 10}, {100, 10}, {1'000, 1'000}}), DoubleNear(1, 1e-9));
}

TEST(GrowthTest, QuadraticShareShowsOnceItWeighs) {
  const auto curve = [](double size) { return 5'000 * size + size * size; };
  EXPECT_EQ(powerNextTo(exponentOf(valuesOf(curve))), 2);
}

TEST(GrowthTest, WholePowerNextToExponent) {
  const std::vector<int> powers = {powerNextTo(-0.7), powerNextTo(0.49), powerNextTo(0.5),
                                   powerNextTo(1.49), powerNextTo(1.5)};
  EXPECT_THAT(powers, ElementsAre(0, 0, 1, 1, 2));
}

TEST(GrowthTest, WritesPowers) {
  EXPECT_EQ(textOfPower(0), "O(1)");
  EXPECT_EQ(textOfPower(1), "O(N)");
  EXPECT_EQ(textOfPower(3), "O(N^3)");
}

}  // namespace
}  // namespace nidus
