#pragma once

#include <cstddef>
#include <vector>

#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// One home of `services` lights, ten to a room, each with power, brightness and hue.
[[nodiscard]] std::vector<HomeData> benchmarkHomes(std::size_t services);

}  // namespace nidus
