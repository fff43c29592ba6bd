#include "BenchmarkHome.h"

#include <algorithm>
#include <string>
#include <utility>

namespace nidus {
namespace {

constexpr std::size_t kServicesPerRoom = 10;
constexpr std::size_t kRoomsPerZone = 5;
constexpr std::size_t kServicesPerGroup = 20;
constexpr std::size_t kMembersOfGroup = 10;
constexpr std::int64_t kServiceID = 8;
constexpr std::int64_t kBrightnessID = 10;

NDUUID makeUUID(std::uint8_t kind, std::size_t number) {
  std::array<std::uint8_t, 16> bytes{};
  bytes[0] = kind;
  for (std::size_t i = 0; i < sizeof number; ++i) {
    bytes[15 - i] = static_cast<std::uint8_t>(number >> (8 * i));
  }
  return NDUUID(bytes);
}

NDUUID roomID(std::size_t number) { return makeUUID(2, number); }
NDUUID accessoryID(std::size_t number) { return makeUUID(3, number); }

/// The service that all lights are copies of, so that they share its texts.
ServiceData lightService() {
  const std::vector<NDString> properties = {"readable", "writable"};
  const auto characteristic = [&](std::int64_t instanceID, const std::string& type,
                                  const char* format, const NDValueRef& value) {
    CharacteristicData data;
    data.instanceID = instanceID;
    data.characteristicType = "com.corvane.nidus.characteristic." + type;
    data.properties = properties;
    data.value = data.deviceValue = value;
    data.metadata.emplace().format = format;
    return data;
  };
  ServiceData service;
  service.instanceID = kServiceID;
  service.serviceType = "com.corvane.nidus.service.light";
  service.characteristics = {
      characteristic(9, "power", "bool", NDValue::boolean(true)),
      characteristic(kBrightnessID, "brightness", "int", NDValue::integer(40)),
      characteristic(11, "hue", "float", NDValue::floating(120))};
  return service;
}

void addAccessories(HomeData& home, const HomeShape& shape) {
  const ServiceData light = lightService();
  const char* word = shape.hasAccents ? kAccentedServiceWord : kServiceWord;
  for (std::size_t number = 0; number < shape.services; ++number) {
    AccessoryData& accessory = home.accessories.emplace_back();
    accessory.uuid = accessoryID(number);
    accessory.name = numberedName(word, number, shape.nameLength);
    accessory.room = roomID(number / kServicesPerRoom);
    accessory.services = {light};
    accessory.services.front().name = accessory.name;
  }
}

void addRoomsAndZones(HomeData& home, const HomeShape& shape) {
  for (std::size_t room = 0; room * kServicesPerRoom < shape.services; ++room) {
    home.rooms.push_back({roomID(room), numberedName("Room", room, shape.nameLength)});
    if (room % kRoomsPerZone == 0) {
      const std::size_t zone = room / kRoomsPerZone;
      home.zones.push_back({makeUUID(4, zone), numberedName("Zone", zone, shape.nameLength), {}});
    }
    home.zones.back().rooms.push_back(roomID(room));
  }
}

void addGroups(HomeData& home, const HomeShape& shape) {
  for (std::size_t first = 0; first < shape.services; first += kServicesPerGroup) {
    const std::size_t group = first / kServicesPerGroup;
    auto& members = home.serviceGroups
                        .emplace_back(ServiceGroupData{
                            makeUUID(5, group), numberedName("Group", group, shape.nameLength), {}})
                        .services;
    const std::size_t end = std::min(first + kMembersOfGroup, shape.services);
    for (std::size_t number = first; number < end; ++number) {
      members.push_back({accessoryID(number), kServiceID});
    }
  }
}

void addScene(HomeData& home, const HomeShape& shape) {
  ActionSetData& scene = home.actionSets.emplace_back();
  scene.uuid = makeUUID(6, 0);
  scene.name = kSceneName;
  for (std::size_t number = 0; number < std::min(kServicesPerRoom, shape.services); ++number) {
    scene.actions.push_back(
        {{accessoryID(number), kServiceID, kBrightnessID}, NDValue::integer(20)});
  }
}

}  // namespace

NDString numberedName(const std::string& word, std::size_t number, std::size_t length) {
  const std::string digits = std::to_string(number);
  return word + ' ' + std::string(length - word.size() - 1 - digits.size(), '0') + digits;
}

HomeData benchmarkHome(const HomeShape& shape) {
  HomeData home;
  home.uuid = makeUUID(1, 0);
  home.name = numberedName("Home", 0, shape.nameLength);
  home.primary = true;
  addRoomsAndZones(home, shape);
  addAccessories(home, shape);
  addGroups(home, shape);
  if (shape.hasScene) addScene(home, shape);
  return home;
}

}  // namespace nidus
