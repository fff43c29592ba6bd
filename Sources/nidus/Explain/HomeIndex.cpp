#include "nidus/Explain/HomeIndex.h"

#include <algorithm>

#include "nidus/StandardStreams.h"

namespace nidus {

HomeCharacteristic PlacedCharacteristic::place() const {
  return {home->uuid, {accessory->uuid, service->instanceID, characteristic->instanceID}};
}

std::string PlacedCharacteristic::objectName() const {
  return onOneLine(service->name ? service->name.view() : accessory->name.view());
}

std::string PlacedCharacteristic::roomName() const {
  const auto room =
      std::find_if(home->rooms.begin(), home->rooms.end(),
                   [this](const RoomData& candidate) { return accessory->room == candidate.uuid; });
  return room == home->rooms.end() ? "" : onOneLine(room->name.view());
}

HomeIndex::HomeIndex(const std::vector<HomeData>& homes) : homes_(homes) {
  for (const HomeData& home : homes) {
    for (const AccessoryData& accessory : home.accessories) {
      for (const ServiceData& service : accessory.services) {
        for (const CharacteristicData& characteristic : service.characteristics) {
          all_.push_back({&home, &accessory, &service, &characteristic});
          places_.emplace(all_.back().place(), all_.size() - 1);
        }
      }
    }
  }
}

const PlacedCharacteristic* HomeIndex::find(const HomeCharacteristic& place) const {
  const auto found = places_.find(place);
  return found == places_.end() ? nullptr : &all_[found->second];
}

const HomeData* HomeIndex::findHome(const NDUUID& home) const {
  const auto found = std::find_if(homes_.begin(), homes_.end(), [&home](const HomeData& candidate) {
    return candidate.uuid == home;
  });
  return found == homes_.end() ? nullptr : &*found;
}

}  // namespace nidus
