#include "Growth.h"

#include <algorithm>
#include <cmath>

namespace nidus {

double exponentOf(const std::vector<ValueAtSize>& values) {
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

int powerNextTo(double exponent) { return std::max(0, static_cast<int>(std::lround(exponent))); }

std::string textOfPower(int power) {
  if (power == 0) return "O(1)";
  return power == 1 ? "O(N)" : "O(N^" + std::to_string(power) + ")";
}

}  // namespace nidus
