#include "Growth.h"

#include <algorithm>
#include <cmath>

namespace nidus {

double exponentOf(const std::vector<ValueAtSize>& values) {
  double sizes = 0;
  double logarithms = 0;
  for (const auto& [size, value] : values) {
    sizes += std::log(size);
    logarithms += std::log(value);
  }
  const auto count = static_cast<double>(values.size());
  double products = 0;
  double squares = 0;
  for (const auto& [size, value] : values) {
    const double distance = std::log(size) - sizes / count;
    products += distance * (std::log(value) - logarithms / count);
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
