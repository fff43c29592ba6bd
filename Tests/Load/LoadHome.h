#pragma once

#include <cstddef>
#include <vector>

#include "HomePlatform/Store/HomeData.h"
#include "Load/Random.h"

namespace nidus {

/// What the load runs on: homes of numbered rooms. In each room stand `kLampsPerRoom` lamps, of
/// which the last cannot be switched, a lamp that is locked and one that cannot be reached, and it
/// has a scene; a group holds the first lamp of each room, a zone all rooms.
inline constexpr std::size_t kLampsPerRoom = 3;
/// How many homes there are, and how many rooms those have that change.
inline constexpr std::size_t kLoadHomes = 3;
inline constexpr std::size_t kLoadRooms = 3;

/// The home as it is when nobody has changed it; number 0 is the primary one.
[[nodiscard]] HomeData loadHome(std::size_t home, std::size_t rooms);
/// The same after a life: some things are renamed, others are gone.
[[nodiscard]] HomeData changedHome(std::size_t home, std::size_t rooms, Random& random);
/// The number of entities that a sync publishes for an unchanged home.
[[nodiscard]] std::size_t entityCount(std::size_t rooms);

[[nodiscard]] NDString homeName(std::size_t home);
[[nodiscard]] NDString roomName(std::size_t home, std::size_t room);
[[nodiscard]] NDString lampName(std::size_t home, std::size_t room, std::size_t lamp);
[[nodiscard]] NDString lockedLampName(std::size_t home, std::size_t room);
[[nodiscard]] NDString unreachableLampName(std::size_t home, std::size_t room);
[[nodiscard]] NDString sceneName(std::size_t home, std::size_t room);
[[nodiscard]] NDString groupName(std::size_t home);

/// The name of the same object after it was renamed.
[[nodiscard]] NDString renamed(const NDString& name);
/// Whether both are names of the same object, before or after it was renamed.
[[nodiscard]] bool isSameObject(const NDString& a, const NDString& b);
/// Whether a lamp of that name belongs to the group of that name.
[[nodiscard]] bool isInGroup(const NDString& lamp, const NDString& group);

/// Where the values of a lamp are.
[[nodiscard]] CharacteristicAddress powerOf(std::size_t home, std::size_t room, std::size_t lamp);
[[nodiscard]] CharacteristicAddress brightnessOf(std::size_t home, std::size_t room,
                                                 std::size_t lamp);

}  // namespace nidus
