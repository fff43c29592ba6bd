#include "Load/LoadHome.h"

#include <string>
#include <utility>

namespace nidus {
namespace {

constexpr std::uint8_t kHomeKind = 1;
constexpr std::uint8_t kRoomKind = 2;
constexpr std::uint8_t kLampKind = 3;
constexpr std::uint8_t kSceneKind = 4;
constexpr std::size_t kLockedLamp = kLampsPerRoom;
constexpr std::size_t kUnreachableLamp = kLampsPerRoom + 1;
constexpr std::size_t kAllLamps = kLampsPerRoom + 2;

NDUUID makeUUID(std::uint8_t kind, std::size_t room, std::size_t lamp = 0) {
  std::array<std::uint8_t, 16> bytes{};
  bytes[0] = kind;
  bytes[1] = static_cast<std::uint8_t>(room);
  bytes[2] = static_cast<std::uint8_t>(lamp);
  return NDUUID(bytes);
}

NDString numbered(const char* word, std::size_t number) {
  return std::string(word) + " " + std::to_string(number);
}

CharacteristicData power() {
  CharacteristicData power;
  power.instanceID = 9;
  power.characteristicType = "com.corvane.nidus.characteristic.power";
  power.properties = {"readable", "writable"};
  power.value = power.deviceValue = NDValue::boolean(false);
  power.metadata.emplace().format = "bool";
  return power;
}

CharacteristicData brightness() {
  CharacteristicData brightness;
  brightness.instanceID = 10;
  brightness.characteristicType = "com.corvane.nidus.characteristic.brightness";
  brightness.properties = {"readable", "writable"};
  brightness.value = brightness.deviceValue = NDValue::integer(40);
  MetadataData& metadata = brightness.metadata.emplace();
  metadata.format = "int";
  metadata.units = "percentage";
  metadata.minimumValue = NDValue::integer(0);
  metadata.maximumValue = NDValue::integer(100);
  return brightness;
}

AccessoryData lamp(std::size_t room, std::size_t number) {
  ServiceData light;
  light.instanceID = 8;
  light.name = lampName(room, number);
  light.serviceType = "com.corvane.nidus.service.light";
  light.characteristics = {power(), brightness()};
  AccessoryData lamp;
  lamp.uuid = makeUUID(kLampKind, room, number);
  lamp.name = light.name;
  lamp.room = makeUUID(kRoomKind, room);
  lamp.requiresUnlock = number == kLockedLamp;
  lamp.reachable = number != kUnreachableLamp;
  lamp.services = {std::move(light)};
  return lamp;
}

ActionSetData scene(std::size_t room) {
  ActionSetData scene;
  scene.uuid = makeUUID(kSceneKind, room);
  scene.name = sceneName(room);
  scene.actions = {
      {.target = {.accessory = makeUUID(kLampKind, room, 0), .service = 8, .characteristic = 9},
       .value = NDValue::boolean(true)}};
  return scene;
}

}  // namespace

NDString roomName(std::size_t room) { return numbered("Room", room); }
NDString lampName(std::size_t room, std::size_t lamp) {
  return numbered("Lamp", room * kAllLamps + lamp);
}
NDString lockedLampName(std::size_t room) { return lampName(room, kLockedLamp); }
NDString unreachableLampName(std::size_t room) { return lampName(room, kUnreachableLamp); }
NDString sceneName(std::size_t room) { return numbered("Scene", room); }

std::vector<HomeData> loadHomes(std::size_t rooms) {
  HomeData home;
  home.uuid = makeUUID(kHomeKind, 0);
  home.name = "Load";
  home.primary = true;
  for (std::size_t room = 0; room < rooms; ++room) {
    home.rooms.push_back({.uuid = makeUUID(kRoomKind, room), .name = roomName(room)});
    for (std::size_t number = 0; number < kAllLamps; ++number) {
      home.accessories.push_back(lamp(room, number));
    }
    home.actionSets.push_back(scene(room));
  }
  return {std::move(home)};
}

std::size_t entityCount(std::size_t rooms) { return 1 + rooms * (kAllLamps + 2); }

}  // namespace nidus
