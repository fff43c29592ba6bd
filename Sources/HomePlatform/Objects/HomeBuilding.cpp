#include "HomePlatform/Objects/HomeBuilding.h"

#include <utility>

#include "HomePlatform/Objects/AccessoryObject.h"
#include "HomePlatform/Objects/HomeParts.h"
#include "HomePlatform/Objects/ServiceGroupObject.h"
#include "HomePlatform/Objects/ZoneObject.h"

namespace nidus {

void HomeBuilding::build() {
  buildRooms();
  buildZones();
  buildAccessories();
  buildGroups();
  buildScenesAndTriggers();
}

template <class Object, class Interface, class Data>
NDArray<Interface> HomeBuilding::makeAll(const std::vector<Data>& list) const {
  std::vector<std::shared_ptr<Interface>> objects;
  objects.reserve(list.size());
  for (const Data& element : list) {
    objects.push_back(
        std::make_shared<Object>(std::shared_ptr<const Data>(data_, &element), home_));
  }
  return NDArray<Interface>(std::move(objects));
}

void HomeBuilding::buildRooms() {
  // The default room bears the home's UUID, so that it is the same each time the home is loaded.
  const auto defaultRoom = std::make_shared<const RoomData>(RoomData{data_->uuid, data_->name});
  home_->defaultRoom_ = std::make_shared<RoomObject>(defaultRoom, home_);
  home_->rooms_ = makeAll<RoomObject, NDRoom>(data_->rooms);
  for (const auto& room : home_->rooms_) roomsByID_.emplace(room->uuid(), room);
}

void HomeBuilding::buildZones() {
  std::vector<std::shared_ptr<NDZone>> zones;
  zones.reserve(data_->zones.size());
  for (const ZoneData& zone : data_->zones) {
    std::vector<std::shared_ptr<NDRoom>> rooms;
    for (const NDUUID& id : zone.rooms) {
      const auto room = roomsByID_.find(id);
      if (room != roomsByID_.end()) rooms.push_back(room->second);
    }
    zones.push_back(std::make_shared<ZoneObject>(std::shared_ptr<const ZoneData>(data_, &zone),
                                                 home_, NDArray<NDRoom>(std::move(rooms))));
  }
  home_->zones_ = NDArray<NDZone>(std::move(zones));
}

std::shared_ptr<NDRoom> HomeBuilding::roomOf(const AccessoryData& accessory) const {
  const auto room = accessory.room ? roomsByID_.find(*accessory.room) : roomsByID_.end();
  return room == roomsByID_.end() ? home_->defaultRoom_ : room->second;
}

void HomeBuilding::buildAccessories() {
  std::vector<std::shared_ptr<NDAccessory>> accessories;
  accessories.reserve(data_->accessories.size());
  home_->accessoryIndexes_.reserve(data_->accessories.size());
  for (const AccessoryData& data : data_->accessories) {
    auto accessory = AccessoryObject::make(std::shared_ptr<const AccessoryData>(data_, &data),
                                           home_, roomOf(data));
    home_->accessoryIndexes_.emplace(data.uuid, accessories.size());
    accessories.push_back(std::move(accessory));
  }
  home_->accessories_ = NDArray<NDAccessory>(std::move(accessories));
}

void HomeBuilding::buildGroups() {
  std::vector<std::shared_ptr<NDServiceGroup>> groups;
  groups.reserve(data_->serviceGroups.size());
  for (const ServiceGroupData& group : data_->serviceGroups) {
    std::vector<std::shared_ptr<NDService>> services;
    for (const ServiceAddress& address : group.services) {
      const auto accessory = home_->accessoryIndexes_.find(address.accessory);
      if (accessory == home_->accessoryIndexes_.end()) continue;
      const auto& service = home_->accessory(accessory->second).findService(address.service);
      if (service) services.push_back(service);
    }
    groups.push_back(
        std::make_shared<ServiceGroupObject>(std::shared_ptr<const ServiceGroupData>(data_, &group),
                                             home_, NDArray<NDService>(std::move(services))));
  }
  home_->groups_ = NDArray<NDServiceGroup>(std::move(groups));
}

void HomeBuilding::buildScenesAndTriggers() {
  home_->actionSets_ = makeAll<ActionSetObject, NDActionSet>(data_->actionSets);
  home_->triggers_ = makeAll<TriggerObject, NDTrigger>(data_->triggers);
}

}  // namespace nidus
