#include "Growth.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <utility>

namespace nidus {
namespace {

constexpr std::size_t kSizesThatTell = 3;
constexpr double kGreatHome = 10'000;

bool riseAboveZero(std::span<const ValueAtSize> values) {
  double lastSize = 0;
  return std::all_of(values.begin(), values.end(), [&lastSize](const ValueAtSize& each) {
    return each.size > std::exchange(lastSize, each.size) && each.value > 0;
  });
}

double slopeOf(std::span<const ValueAtSize> values) {
  double middle = 0;
  for (const auto& each : values) {
    middle += std::log(each.size) / static_cast<double>(values.size());
  }
  double products = 0;
  double squares = 0;
  for (const auto& [size, value] : values) {
    const double distance = std::log(size) - middle;
    products += distance * std::log(value);
    squares += distance * distance;
  }
  return products / squares;
}

}  // namespace

std::optional<double> exponentOf(std::span<const ValueAtSize> values) {
  if (values.size() < kSizesThatTell || values.back().size < kGreatHome) return std::nullopt;
  const auto greatest = values.last(kSizesThatTell);
  if (!riseAboveZero(greatest)) return std::nullopt;
  return slopeOf(greatest);
}

int powerNextTo(double exponent) { return std::max(0, static_cast<int>(std::lround(exponent))); }

std::string textOfPower(int power) {
  if (power == 0) return "O(1)";
  return power == 1 ? "O(N)" : "O(N^" + std::to_string(power) + ")";
}

}  // namespace nidus
