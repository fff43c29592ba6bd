#pragma once

#include <vector>

#include "HomePlatform/Store/HomeData.h"
#include "PlugIn/Choices.h"

namespace nidus {

/// Makes up to three homes as a home document may hold them, with accessories of every behaviour:
/// unreachable, to be unlocked, with faults, without properties, of any format and limits.
[[nodiscard]] std::vector<HomeData> chooseHomes(Choices& choices);

}  // namespace nidus
