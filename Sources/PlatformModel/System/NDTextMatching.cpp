#include "PlatformModel/System/NDTextMatching.h"

#include <algorithm>

namespace nidus {
namespace {

constexpr char asciiLowerCase(char c) noexcept {
  return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

}  // namespace

bool containsIgnoringCase(std::string_view text, std::string_view part) {
  const auto isSame = [](char a, char b) { return asciiLowerCase(a) == asciiLowerCase(b); };
  return std::search(text.begin(), text.end(), part.begin(), part.end(), isSame) != text.end() ||
         part.empty();
}

}  // namespace nidus
