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
[[nodiscard]] NDURLRef url(const NDHome& home);
[[nodiscard]] NDURLRef url(const NDService& service);
/// The same for a service whose accessory and home have been asked for; either may be null.
[[nodiscard]] NDURLRef url(const NDService& service, const NDAccessory* accessory,
                           const NDHome* home);
[[nodiscard]] NDURLRef url(const NDRoom& room);
[[nodiscard]] NDURLRef url(const NDZone& zone);
[[nodiscard]] NDURLRef url(const NDServiceGroup& group);
[[nodiscard]] NDURLRef url(const NDActionSet& actionSet);
[[nodiscard]] NDURLRef url(const NDTrigger& trigger);

}  // namespace nidus
