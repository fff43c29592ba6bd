#include "BenchmarkHome.h"

#include <string>
#include <utility>

namespace nidus {
namespace {

constexpr std::size_t kServicesPerRoom = 10;

NDUUID makeUUID(std::uint8_t kind, std::size_t number) {
  std::array<std::uint8_t, 16> bytes{};
  bytes[0] = kind;
  for (std::size_t i = 0; i < sizeof number; ++i) {
    bytes[15 - i] = static_cast<std::uint8_t>(number >> (8 * i));
  }
  return NDUUID(bytes);
}

CharacteristicData characteristic(std::int64_t instanceID, const char* type, const char* format,
                                  NDValueRef value) {
  CharacteristicData characteristic;
  characteristic.instanceID = instanceID;
  characteristic.characteristicType = std::string("com.corvane.nidus.characteristic.") + type;
  characteristic.properties = {"readable", "writable"};
  characteristic.value = characteristic.deviceValue = std::move(value);
  characteristic.metadata.emplace().format = format;
  return characteristic;
}

AccessoryData light(std::size_t number) {
  ServiceData service;
  service.instanceID = 8;
  service.name = "Lamp " + std::to_string(number);
  service.serviceType = "com.corvane.nidus.service.light";
  service.characteristics = {characteristic(9, "power", "bool", NDValue::boolean(number % 2 == 0)),
                             characteristic(10, "brightness", "int", NDValue::integer(40)),
                             characteristic(11, "hue", "float", NDValue::floating(120))};
  AccessoryData light;
  light.uuid = makeUUID(3, number);
  light.name = service.name;
  light.room = makeUUID(2, number / kServicesPerRoom);
  light.services = {std::move(service)};
  return light;
}

}  // namespace

std::vector<HomeData> benchmarkHomes(std::size_t services) {
  HomeData home;
  home.uuid = makeUUID(1, 0);
  home.name = "Home";
  home.primary = true;
  for (std::size_t room = 0; room * kServicesPerRoom < services; ++room) {
    home.rooms.push_back({.uuid = makeUUID(2, room), .name = "Room " + std::to_string(room)});
  }
  for (std::size_t number = 0; number < services; ++number) {
    home.accessories.push_back(light(number));
  }
  return {std::move(home)};
}

}  // namespace nidus
