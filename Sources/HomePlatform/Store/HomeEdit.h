#pragma once

#include <functional>
#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Changes homes in place, or fails; what it has changed by then counts for nothing.
using HomeEdit = std::function<Status(std::vector<HomeData>& homes)>;

}  // namespace nidus
