#pragma once

#include <string>
#include <vector>

namespace nidus {

/// What was measured at one size; both are greater than 0.
struct ValueAtSize {
  double size = 0;
  double value = 0;
};

/// The power of the size that the values grow as: the slope of their logarithms over those of the
/// sizes, by least squares, so that each size counts alike. `values` has at least two sizes.
///
/// From 1,000 to 100,000 a logarithm of the size as a further factor adds 0.11. So do caches that
/// end on the way, which is why no form with a logarithm is told apart here.
[[nodiscard]] double exponentOf(const std::vector<ValueAtSize>& values);

/// The whole power next to `exponent`; one below 0 is 0.
[[nodiscard]] int powerNextTo(double exponent);

/// The power as it is written: "O(1)", "O(N)", "O(N^2)".
[[nodiscard]] std::string textOfPower(int power);

}  // namespace nidus
