#include "nidus/Orders/NearMiss.h"

#include <algorithm>
#include <cstddef>
#include <numeric>

namespace nidus {
namespace {

/// How many letters must be put in, left out or changed to make `b` out of `a`.
std::size_t editDistance(std::string_view a, std::string_view b) {
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

}  // namespace

std::string_view nearMiss(std::string_view word, const std::vector<std::string_view>& known) {
  std::string_view nearest;
  std::size_t least = std::min<std::size_t>(1 + word.size() / 4, 3) + 1;
  for (const std::string_view candidate : known) {
    const std::size_t distance = editDistance(word, candidate);
    if (distance >= std::min(least, candidate.size())) continue;
    nearest = candidate;
    least = distance;
  }
  return nearest;
}

}  // namespace nidus
