#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Counts the objects in which two editions of the homes differ: "1 room renamed, 2 accessories
/// added". Objects are the same by their UUIDs, services by accessory and instance ID. What is in
/// an object is counted on its own. Empty when none differs.
[[nodiscard]] std::string differenceText(const std::vector<HomeData>& before,
                                         const std::vector<HomeData>& after);

/// Whether two editions of the homes say the same, in the same order.
[[nodiscard]] bool isSame(const std::vector<HomeData>& before, const std::vector<HomeData>& after);

}  // namespace nidus
