#pragma once

#include <chrono>
#include <string_view>
#include <vector>

#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// A small home for the tests of the platform: two accessories in one room. Tests change what
/// matters to them.

inline constexpr std::string_view kHomeID = "9E01A3C4-0000-4000-8000-000000000001";
inline constexpr std::string_view kRoomID = "9E01A3C4-0000-4000-8000-000000000002";
inline constexpr std::string_view kLampID = "9E01A3C4-0000-4000-8000-000000000003";
inline constexpr std::string_view kDoorID = "9E01A3C4-0000-4000-8000-000000000004";
inline constexpr std::string_view kSceneID = "9E01A3C4-0000-4000-8000-000000000005";

/// For tests that are alone with their database, or want to hear at once that they are not.
inline constexpr std::chrono::milliseconds kNoWaiting{0};

/// The UUID of that text, which must be one.
[[nodiscard]] NDUUID uuidOf(std::string_view text);

/// A lamp (power: bool, brightness: int from 0 to 100), a door lock (its target and, following it,
/// its current state: uint8) and a scene without actions.
[[nodiscard]] HomeData sampleHome();

/// The accessories of `sampleHome`.
[[nodiscard]] AccessoryData& lampOf(HomeData& home);
[[nodiscard]] AccessoryData& doorOf(HomeData& home);

/// The characteristics of `sampleHome`, and where they are.
[[nodiscard]] CharacteristicData& powerOf(HomeData& home);
[[nodiscard]] CharacteristicData& brightnessOf(HomeData& home);
[[nodiscard]] CharacteristicData& lockTargetOf(HomeData& home);
[[nodiscard]] CharacteristicData& lockStateOf(HomeData& home);
[[nodiscard]] CharacteristicAddress powerAddress();
[[nodiscard]] CharacteristicAddress brightnessAddress();
[[nodiscard]] CharacteristicAddress lockTargetAddress();
[[nodiscard]] CharacteristicAddress lockStateAddress();

}  // namespace nidus
