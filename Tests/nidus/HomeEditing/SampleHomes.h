#pragma once

#include <gmock/gmock.h>

#include <string>
#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// A document of two homes, each with a Kitchen: Beach House has two lamps, each with a service
/// Lamp, a zone, a group, a scene and a trigger; Cottage has nothing else.
[[nodiscard]] std::string sampleDocument();

/// The homes of that document.
[[nodiscard]] std::vector<HomeData> sampleHomes();

/// The document of `homes`, as a text that can be compared.
[[nodiscard]] std::string textOf(const std::vector<HomeData>& homes);

inline constexpr const char kBeachHouseID[] = "AA000000-0000-4000-8000-000000000001";
inline constexpr const char kBeachKitchenID[] = "BB000000-0000-4000-8000-000000000001";
inline constexpr const char kCottageKitchenID[] = "BB000000-0000-4000-8000-000000000009";
inline constexpr const char kCeilingLampID[] = "DD000000-0000-4000-8000-000000000001";

/// Bad input whose message contains `text`.
MATCHER_P(IsBadInput, text, "") {
  if (arg) return false;
  *result_listener << arg.failure().message;
  return arg.failure().kind == Failure::Kind::badInput &&
         arg.failure().message.find(text) != std::string::npos;
}

/// A value that is equal to `expected`.
MATCHER_P(IsDone, expected, "") {
  *result_listener << (arg ? std::string(*arg) : arg.failure().message);
  return arg && *arg == expected;
}

}  // namespace nidus
