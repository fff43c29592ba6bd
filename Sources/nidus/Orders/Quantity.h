#pragma once

#include <optional>
#include <string>

#include "HomePlatform/Metadata/Vocabulary.h"

namespace nidus {

/// A number as a person writes it, with or without a unit: "40", "40%", "21.5 °C".
struct Quantity {
  std::string number;  ///< A decimal number, without a plus sign.
  NDString unit;       ///< The platform's name of the unit; null when none was written.
};

/// Reads `text`; none when it does not begin with a number or its unit is not in the vocabulary.
[[nodiscard]] std::optional<Quantity> readQuantity(const std::string& text,
                                                   const Vocabulary& vocabulary);

}  // namespace nidus
