#include "HomePlatform/Store/HomeInserter.h"

#include <string>
#include <utility>

namespace nidus {
namespace {

/// The words of a list of properties as one text; their order is kept.
NDString joined(const std::vector<NDString>& words) {
  std::string text;
  for (const NDString& word : words) {
    if (!text.empty()) text += ' ';
    text += word.view();
  }
  return text;
}

}  // namespace

HomeInserter::HomeInserter(Database& database, StoreProgress progress)
    : database_(database), progress_(std::move(progress)) {
  if (progress_) progress_(0);
}

void HomeInserter::insert(const HomeData& home, std::int64_t position) {
  home_.run(position, home.uuid, home.name, home.primary, home.faults.read, home.faults.write);
  homeRow_ = database_.lastRow();
  rooms_.clear();
  accessories_.clear();
  insertRooms(home);
  insertZones(home);
  insertAccessories(home);
  insertServiceGroups(home);
  insertActionSets(home);
  insertTriggers(home);
}

void HomeInserter::insertRooms(const HomeData& home) {
  for (std::size_t i = 0; i < home.rooms.size(); ++i) {
    room_.run(homeRow_, i, home.rooms[i].uuid, home.rooms[i].name);
    rooms_[home.rooms[i].uuid] = database_.lastRow();
  }
}

void HomeInserter::insertZones(const HomeData& home) {
  for (std::size_t i = 0; i < home.zones.size(); ++i) {
    const ZoneData& zone = home.zones[i];
    zone_.run(homeRow_, i, zone.uuid, zone.name);
    const std::int64_t zoneRow = database_.lastRow();
    for (std::size_t room = 0; room < zone.rooms.size(); ++room) {
      zoneRoom_.run(zoneRow, room, rooms_.at(zone.rooms[room]));
    }
  }
}

void HomeInserter::insertAccessories(const HomeData& home) {
  for (std::size_t i = 0; i < home.accessories.size(); ++i) {
    const AccessoryData& accessory = home.accessories[i];
    const auto room = accessory.room ? std::optional(rooms_.at(*accessory.room)) : std::nullopt;
    accessory_.run(homeRow_, i, accessory.uuid, accessory.name, room, accessory.reachable,
                   accessory.requiresUnlock, accessory.faults.read, accessory.faults.write);
    const std::int64_t accessoryRow = database_.lastRow();
    accessories_[accessory.uuid] = accessoryRow;
    insertServices(accessory, accessoryRow);
    ++storedAccessories_;
    if (progress_) progress_(storedAccessories_);
  }
}

void HomeInserter::insertServices(const AccessoryData& accessory, std::int64_t accessoryRow) {
  for (std::size_t i = 0; i < accessory.services.size(); ++i) {
    const ServiceData& service = accessory.services[i];
    service_.run(accessoryRow, i, service.instanceID, service.name, service.serviceType,
                 service.associatedServiceType);
    insertCharacteristics(service, database_.lastRow());
  }
}

void HomeInserter::insertCharacteristics(const ServiceData& service, std::int64_t serviceRow) {
  static const MetadataData kNoMetadata;
  for (std::size_t i = 0; i < service.characteristics.size(); ++i) {
    const CharacteristicData& data = service.characteristics[i];
    const MetadataData& metadata = data.metadata ? *data.metadata : kNoMetadata;
    characteristic_.run(serviceRow, i, data.instanceID, data.characteristicType,
                        joined(data.properties), data.value, data.deviceValue, data.faults.read,
                        data.faults.write, data.metadata.has_value(), metadata.format,
                        metadata.units, metadata.minimumValue, metadata.maximumValue,
                        metadata.stepValue);
  }
}

void HomeInserter::insertServiceGroups(const HomeData& home) {
  for (std::size_t i = 0; i < home.serviceGroups.size(); ++i) {
    const ServiceGroupData& group = home.serviceGroups[i];
    serviceGroup_.run(homeRow_, i, group.uuid, group.name);
    const std::int64_t groupRow = database_.lastRow();
    for (std::size_t member = 0; member < group.services.size(); ++member) {
      const ServiceAddress& address = group.services[member];
      serviceGroupMember_.run(groupRow, member, accessories_.at(address.accessory),
                              address.service);
    }
  }
}

void HomeInserter::insertActionSets(const HomeData& home) {
  for (std::size_t i = 0; i < home.actionSets.size(); ++i) {
    const ActionSetData& actionSet = home.actionSets[i];
    actionSet_.run(homeRow_, i, actionSet.uuid, actionSet.name, actionSet.executeFault);
    const std::int64_t actionSetRow = database_.lastRow();
    for (std::size_t action = 0; action < actionSet.actions.size(); ++action) {
      const auto& [target, value] = actionSet.actions[action];
      sceneAction_.run(actionSetRow, action, accessories_.at(target.accessory), target.service,
                       target.characteristic, value);
    }
  }
}

void HomeInserter::insertTriggers(const HomeData& home) {
  for (std::size_t i = 0; i < home.triggers.size(); ++i) {
    trigger_.run(homeRow_, i, home.triggers[i].uuid, home.triggers[i].name);
  }
}

}  // namespace nidus
