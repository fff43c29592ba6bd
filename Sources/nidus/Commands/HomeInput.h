#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Reads the home document in `file`, or on standard input for "-".
[[nodiscard]] Result<std::vector<HomeData>> readHomes(const std::string& file);

/// Says how much `homes` are, such as "2 homes, 11 rooms, 55 accessories, 60 services".
[[nodiscard]] std::string sizeOf(const std::vector<HomeData>& homes);

}  // namespace nidus
