#pragma once

#include <string>

#include "HomePlatform/HomePlatform.h"

namespace nidus {

/// Why no order can find anything, and the remedy, as a sentence without its end: there are no
/// homes, as `hasHomes` says, or the plug-in does not look for them. Empty when it sees homes.
[[nodiscard]] std::string missingHomesText(bool hasHomes, HomePlatform& platform);

}  // namespace nidus
