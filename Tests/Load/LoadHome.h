#pragma once

#include <cstddef>
#include <vector>

#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// What the load runs on: one home in which each thread has a room of its own with
/// `kLampsPerRoom` lamps, a locked lamp and an unreachable one, and a scene.
inline constexpr std::size_t kLampsPerRoom = 3;

[[nodiscard]] std::vector<HomeData> loadHomes(std::size_t rooms);
/// The number of entities that a sync of these homes publishes.
[[nodiscard]] std::size_t entityCount(std::size_t rooms);

[[nodiscard]] NDString roomName(std::size_t room);
[[nodiscard]] NDString lampName(std::size_t room, std::size_t lamp);
[[nodiscard]] NDString lockedLampName(std::size_t room);
[[nodiscard]] NDString unreachableLampName(std::size_t room);
[[nodiscard]] NDString sceneName(std::size_t room);

}  // namespace nidus
