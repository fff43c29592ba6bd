#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Reads the home document in `file`, or on standard input for "-". Shows on a terminal how far a
/// large file is read.
[[nodiscard]] Result<std::vector<HomeData>> readHomes(const std::string& file);

/// How many accessories stand in `homes`, and their number in words.
[[nodiscard]] std::size_t accessoriesOf(const std::vector<HomeData>& homes);
[[nodiscard]] std::string accessoriesText(std::size_t accessories);

/// Says how much `homes` are, such as "2 homes, 11 rooms, 55 accessories, 60 services".
[[nodiscard]] std::string sizeOf(const std::vector<HomeData>& homes);

}  // namespace nidus
