#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace nidus {

/// Ends the process as a crash would, so that the input is kept: something that must hold for every
/// input does not. `what` is for people and may have several lines.
[[noreturn]] void reportFinding(const std::string& what);

/// Reports a finding that shows both texts unless they are equal; `what` says what they are.
void expectSameText(std::string_view what, std::string_view expected, std::string_view actual);

/// An input as text.
[[nodiscard]] inline std::string_view textOf(const std::uint8_t* data, std::size_t size) {
  return {reinterpret_cast<const char*>(data), size};
}

}  // namespace nidus
