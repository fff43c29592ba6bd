#include "HomePlatform/System/OneLine.h"

#include <algorithm>
#include <cstddef>

namespace nidus {
namespace {

constexpr unsigned char byteOf(char c) { return static_cast<unsigned char>(c); }

/// How many bytes of a control character `text` begins with; 0 when it begins with another one.
std::size_t controlSize(std::string_view text) {
  const unsigned char first = byteOf(text[0]);
  if (first < 0x20 || first == 0x7f) return 1;
  // U+0080 to U+009F, which terminals obey too.
  const bool isSecondSet = first == 0xc2 && text.size() > 1 && byteOf(text[1]) < 0xa0;
  return isSecondSet ? 2 : 0;
}

std::string escapeOf(std::string_view bytes) {
  constexpr std::string_view kDigits = "0123456789abcdef";
  std::string escape;
  for (const char c : bytes) {
    escape.append("\\x").append(1, kDigits[byteOf(c) >> 4U]).append(1, kDigits[byteOf(c) & 15U]);
  }
  return escape;
}

}  // namespace

std::string onOneLine(std::string_view text) {
  std::string line;
  while (!text.empty()) {
    const std::size_t control = controlSize(text);
    const std::string_view next = text.substr(0, std::max<std::size_t>(control, 1));
    line += control == 0 ? std::string(next) : escapeOf(next);
    text.remove_prefix(next.size());
  }
  return line;
}

}  // namespace nidus
