#pragma once

#include <string>
#include <vector>

#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Where an accessory is, for people: "Cottage / Kitchen / Lamp", without a room when it stands in
/// none.
[[nodiscard]] std::string pathOf(const HomeData& home, const AccessoryData& accessory);

/// The same of one of its services: "Cottage / Kitchen / Lamp / Bulb".
[[nodiscard]] std::string pathOf(const HomeData& home, const AccessoryData& accessory,
                                 const ServiceData& service);

/// Calls `visit` with each service of `homes`, its accessory and its home, in their order.
template <class Visit>
void forEachService(const std::vector<HomeData>& homes, const Visit& visit) {
  for (const HomeData& home : homes) {
    for (const AccessoryData& accessory : home.accessories) {
      for (const ServiceData& service : accessory.services) visit(home, accessory, service);
    }
  }
}

/// The name of the room in which the accessory stands; null for none.
[[nodiscard]] NDString roomNameOf(const HomeData& home, const AccessoryData& accessory);

}  // namespace nidus
