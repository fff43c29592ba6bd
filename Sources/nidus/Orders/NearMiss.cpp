#include "nidus/Orders/NearMiss.h"

#include <algorithm>
#include <cstddef>
#include <numeric>
#include <string>

#include "PlatformModel/System/NDTextMatching.h"

namespace nidus {
namespace {

/// How many letters must be put in, left out or changed to make `b` out of `a`.
std::size_t editDistance(std::u32string_view a, std::u32string_view b) {
  std::vector<std::size_t> row(b.size() + 1);
  std::iota(row.begin(), row.end(), std::size_t{0});
  for (std::size_t i = 0; i < a.size(); ++i) {
    std::size_t diagonal = row[0];
    row[0] = i + 1;
    for (std::size_t j = 0; j < b.size(); ++j) {
      const std::size_t changed = diagonal + (a[i] == b[j] ? 0 : 1);
      diagonal = row[j + 1];
      row[j + 1] = std::min({changed, diagonal + 1, row[j] + 1});
    }
  }
  return row.back();
}

/// The letters of a word, without their accents and in one case.
std::u32string lettersOf(std::string_view word) {
  std::u32string letters = withoutDiacritics(word);
  for (char32_t& c : letters) {
    if (c >= U'A' && c <= U'Z') c += U'a' - U'A';
  }
  return letters;
}

}  // namespace

std::string_view nearMiss(std::string_view word, const std::vector<std::string_view>& known) {
  std::string_view nearest;
  const std::u32string written = lettersOf(word);
  std::size_t least = std::min<std::size_t>(1 + written.size() / 4, 3) + 1;
  for (const std::string_view candidate : known) {
    const std::u32string letters = lettersOf(candidate);
    const std::size_t distance = editDistance(written, letters);
    if (distance >= std::min(least, letters.size())) continue;
    nearest = candidate;
    least = distance;
  }
  return nearest;
}

}  // namespace nidus
