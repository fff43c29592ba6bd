#pragma once

#include <optional>
#include <span>
#include <string>

namespace nidus {

/// What was measured at one size.
struct ValueAtSize {
  double size = 0;
  double value = 0;
};

/// The power of the size that the values grow as over the greatest three sizes: the slope of their
/// logarithms over those of the sizes, by least squares, so that each size counts alike. What a
/// road costs whatever the size hides its growth in small homes. None without three different sizes
/// up to 10,000 at least, which `values` has in rising order, or where a value is not above 0.
///
/// From 1,000 to 100,000 a logarithm of the size as a further factor adds 0.11. So do caches that
/// end on the way, which is why no form with a logarithm is told apart here.
[[nodiscard]] std::optional<double> exponentOf(std::span<const ValueAtSize> values);

/// The whole power next to `exponent`; one below 0 is 0.
[[nodiscard]] int powerNextTo(double exponent);

/// The power as it is written: "O(1)", "O(N)", "O(N^2)".
[[nodiscard]] std::string textOfPower(int power);

}  // namespace nidus
