#pragma once

#include <string_view>

#include "PlatformModel/Home/NDHome.h"
#include "PlatformModel/System/NDURL.h"

namespace nidus {

/// The scheme and the host of every identifier that the plug-in makes.
inline constexpr std::string_view kIdentifierScheme = "x-corvane-nidus";
inline constexpr std::string_view kIdentifierHost = "local";

/// Builds the identifier URL of a platform object from its UUIDs (and a service's instance ID).
/// Each call gives a new object, never null. May be called from any thread.
[[nodiscard]] NDURL url(const NDHome& home);
[[nodiscard]] NDURL url(const NDService& service);
/// The same for a service whose accessory and home have been asked for; either may be null.
[[nodiscard]] NDURL url(const NDService& service, const NDAccessory* accessory, const NDHome* home);
[[nodiscard]] NDURL url(const NDRoom& room);
[[nodiscard]] NDURL url(const NDZone& zone);
[[nodiscard]] NDURL url(const NDServiceGroup& group);
[[nodiscard]] NDURL url(const NDActionSet& actionSet);
[[nodiscard]] NDURL url(const NDTrigger& trigger);

}  // namespace nidus
