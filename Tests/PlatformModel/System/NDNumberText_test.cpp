#include "PlatformModel/System/NDNumberText.h"

#include <gtest/gtest.h>

#include <limits>
#include <utility>
#include <vector>

namespace nidus {
namespace {

TEST(NumberTextTest, WritesIntegersInDecimal) {
  EXPECT_EQ(numberText(std::int64_t{0}), "0");
  EXPECT_EQ(numberText(std::int64_t{-12}), "-12");
  EXPECT_EQ(numberText(std::numeric_limits<std::int64_t>::min()), "-9223372036854775808");
}

TEST(NumberTextTest, WritesShortestFloats) {
  const std::vector<std::pair<float, std::string>> cases = {
      {0.0F, "0"},
      {-0.0F, "-0"},
      {72.0F, "72"},
      {72.5F, "72.5"},
      {0.1F, "0.1"},
      {22.222221F, "22.222221"},
      {70.7F, "70.7"},
      {std::numeric_limits<float>::max(), "3.4028235e+38"},
      {std::numeric_limits<float>::lowest(), "-3.4028235e+38"},
      {std::numeric_limits<float>::denorm_min(), "1e-45"},
      {std::numeric_limits<float>::infinity(), "inf"},
  };
  for (const auto& [number, text] : cases) EXPECT_EQ(numberText(number), text);
}

}  // namespace
}  // namespace nidus
