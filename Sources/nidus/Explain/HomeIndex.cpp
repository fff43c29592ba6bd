#include "nidus/Explain/HomeIndex.h"

#include <algorithm>

#include "HomePlatform/System/OneLine.h"

namespace nidus {

HomeCharacteristic PlacedCharacteristic::place() const {
  return {home->uuid, {accessory->uuid, service->instanceID, characteristic->instanceID}};
}

std::string PlacedCharacteristic::objectName() const {
  return onOneLine(service->name ? service->name.view() : accessory->name.view());
}

std::string PlacedCharacteristic::roomName() const {
  return room ? onOneLine(room->name.view()) : "";
}

bool PlacedCharacteristic::hasValueOf(const PlacedCharacteristic& other) const {
  const NDValueRef& own = characteristic->value;
  const NDValueRef& others = other.characteristic->value;
  return own == others || (own && others && own->isEqual(*others));
}

HomeIndex::HomeIndex(const std::vector<HomeData>& homes) : homes_(homes) {
  for (const HomeData& home : homes) {
    std::map<NDUUID, const RoomData*> rooms;
    for (const RoomData& room : home.rooms) rooms.emplace(room.uuid, &room);
    for (const AccessoryData& accessory : home.accessories) {
      const auto room = accessory.room ? rooms.find(*accessory.room) : rooms.end();
      add(home, room == rooms.end() ? nullptr : room->second, accessory);
    }
  }
}

void HomeIndex::add(const HomeData& home, const RoomData* room, const AccessoryData& accessory) {
  for (const ServiceData& service : accessory.services) {
    for (const CharacteristicData& characteristic : service.characteristics) {
      all_.push_back({&home, room, &accessory, &service, &characteristic});
      places_.emplace(all_.back().place(), all_.size() - 1);
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
