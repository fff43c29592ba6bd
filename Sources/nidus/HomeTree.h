#pragma once

#include <string>

#include "HomePlatform/Store/HomeData.h"
#include "PlatformModel/Home/NDNAPMetadata.h"

namespace nidus {

/// Draws a home as a tree for people, several lines each with its end: the rooms with their
/// accessories, the services with the values that the platform knew last, and the zones, groups,
/// scenes and triggers. `metadata` gives the names that the assistant uses.
[[nodiscard]] std::string homeTree(const HomeData& home, const NDNAPMetadata& metadata);

}  // namespace nidus
