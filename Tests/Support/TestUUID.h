#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

#include "PlatformModel/System/NDUUID.h"

namespace nidus {

/// A fixed UUID for each pair of numbers; it contains hexadecimal letters.
[[nodiscard]] inline NDUUID testUUID(std::uint32_t number, std::uint32_t space = 0) {
  std::array<std::uint8_t, 16> bytes{0xAB, 0xCD, 0xEF};
  for (std::size_t i = 0; i < 4; ++i) {
    bytes[8 + i] = static_cast<std::uint8_t>(space >> (24 - 8 * i));
    bytes[12 + i] = static_cast<std::uint8_t>(number >> (24 - 8 * i));
  }
  return NDUUID(bytes);
}

}  // namespace nidus
