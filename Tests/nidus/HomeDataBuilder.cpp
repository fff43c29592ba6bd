#include "nidus/HomeDataBuilder.h"

#include <string>
#include <utility>

namespace nidus {

NDString serviceTypeOf(const char* name) {
  return std::string("com.corvane.nidus.service.") + name;
}

NDString characteristicTypeOf(const char* name) {
  return std::string("com.corvane.nidus.characteristic.") + name;
}

HomeDataBuilder::HomeDataBuilder(const char* name) {
  home_.uuid = NDUUID::random();
  home_.name = name;
}

HomeDataBuilder& HomeDataBuilder::primary() {
  home_.primary = true;
  return *this;
}

HomeDataBuilder& HomeDataBuilder::room(const char* name) {
  room_ = NDUUID::random();
  home_.rooms.push_back({*room_, name});
  return *this;
}

HomeDataBuilder& HomeDataBuilder::inNoRoom() {
  room_.reset();
  return *this;
}

HomeDataBuilder& HomeDataBuilder::accessory(const char* name) {
  AccessoryData& accessory = home_.accessories.emplace_back();
  accessory.uuid = NDUUID::random();
  accessory.name = name;
  accessory.room = room_;
  return *this;
}

HomeDataBuilder& HomeDataBuilder::unreachable() {
  home_.accessories.back().reachable = false;
  return *this;
}

HomeDataBuilder& HomeDataBuilder::service(const char* name, const NDString& type) {
  std::vector<ServiceData>& services = home_.accessories.back().services;
  ServiceData& service = services.emplace_back();
  service.instanceID = static_cast<std::int64_t>(services.size());
  if (name) service.name = name;
  service.serviceType = type;
  return *this;
}

HomeDataBuilder& HomeDataBuilder::characteristic(const NDString& type, NDValueRef value,
                                                 const std::optional<MetadataData>& metadata) {
  ServiceData& service = home_.accessories.back().services.back();
  CharacteristicData& characteristic = service.characteristics.emplace_back();
  constexpr std::int64_t kPerService = 100;
  characteristic.instanceID =
      service.instanceID * kPerService + static_cast<std::int64_t>(service.characteristics.size());
  characteristic.characteristicType = type;
  characteristic.properties = {"readable", "writable"};
  characteristic.value = value;
  characteristic.deviceValue = std::move(value);
  characteristic.metadata = metadata;
  return *this;
}

HomeDataBuilder& HomeDataBuilder::light(const char* name) {
  return accessory(name)
      .service(name, serviceTypeOf("light"))
      .characteristic(characteristicTypeOf("power"), NDValue::boolean(false));
}

HomeDataBuilder& HomeDataBuilder::zone(const char* name, const std::vector<std::size_t>& rooms) {
  ZoneData& zone = home_.zones.emplace_back();
  zone.uuid = NDUUID::random();
  zone.name = name;
  for (const std::size_t room : rooms) zone.rooms.push_back(home_.rooms[room].uuid);
  return *this;
}

HomeDataBuilder& HomeDataBuilder::group(const char* name,
                                        const std::vector<std::size_t>& accessories) {
  ServiceGroupData& group = home_.serviceGroups.emplace_back();
  group.uuid = NDUUID::random();
  group.name = name;
  for (const std::size_t index : accessories) {
    const AccessoryData& accessory = home_.accessories[index];
    group.services.push_back({accessory.uuid, accessory.services.front().instanceID});
  }
  return *this;
}

HomeDataBuilder& HomeDataBuilder::scene(const char* name,
                                        const std::vector<std::size_t>& accessories) {
  ActionSetData& scene = home_.actionSets.emplace_back();
  scene.uuid = NDUUID::random();
  scene.name = name;
  for (const std::size_t index : accessories) {
    const AccessoryData& accessory = home_.accessories[index];
    const ServiceData& service = accessory.services.front();
    scene.actions.push_back(
        {{accessory.uuid, service.instanceID, service.characteristics.front().instanceID},
         NDValue::boolean(true)});
  }
  return *this;
}

}  // namespace nidus
