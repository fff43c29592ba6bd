#pragma once

#include <memory>

#include "HomePlatform/Store/HomeData.h"
#include "PlatformModel/Home/NDHome.h"

namespace nidus {

/// Makes a home in memory that costs as little as the model's interfaces allow, so that what a
/// benchmark measures is the plug-in's own share: properties are members, and reads, writes and
/// scenes succeed, by way of the platform's main queue, without changing anything. Scenes and
/// triggers of `data` are left out. May be used from any thread.
[[nodiscard]] std::shared_ptr<NDHome> makeLightHome(const HomeData& data);

}  // namespace nidus
