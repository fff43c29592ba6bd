#include "PlatformModel/System/NDNumberText.h"

#include <array>
#include <charconv>

namespace nidus {
namespace {

// Enough for any 64-bit integer and for the shortest form of any 32-bit float.
constexpr std::size_t kLongestText = 32;

template <class Number>
std::string shortestText(Number number) {
  std::array<char, kLongestText> text{};
  const auto result = std::to_chars(text.data(), text.data() + text.size(), number);
  return {text.data(), result.ptr};
}

}  // namespace

std::string numberText(std::int64_t number) { return shortestText(number); }

std::string numberText(float number) { return shortestText(number); }

}  // namespace nidus
