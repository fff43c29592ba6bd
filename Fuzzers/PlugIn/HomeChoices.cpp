#include "PlugIn/HomeChoices.h"

#include <array>
#include <cstdint>
#include <string_view>
#include <utility>

#include "HomePlatform/Store/ValueConversion.h"
#include "PlugIn/Words.h"

namespace nidus {
namespace {

constexpr std::array kFormats = {"bool",   "int",    "float",  "uint8", "uint16",
                                 "uint32", "uint64", "string", "tlv8"};
constexpr std::array<std::int32_t, 6> kCodes = {4, 5, 6, 82, -1, 1000};
constexpr const char* kUnmappedType = "com.corvane.nidus.characteristic.of-another-make";

/// Makes one home after the other; no two objects have the same UUID.
class HomeChooser {
 public:
  explicit HomeChooser(Choices& choices) : choices_(choices) {}

  HomeData home();

 private:
  NDUUID nextUUID();
  NDString name() { return choices_.oneOf(kNames); }
  std::int32_t code(int percent) { return choices_.chance(percent) ? choices_.oneOf(kCodes) : 0; }
  FaultData faults(int percent) { return {code(percent), code(percent)}; }
  NDValueRef valueOf(const NDString& format);
  MetadataData metadata(const CharacteristicEntry* entry);
  CharacteristicData characteristic(NDString type, const CharacteristicEntry* entry);
  void addCharacteristics(ServiceData& service);
  ServiceData service();
  AccessoryData accessory(const std::vector<RoomData>& rooms);
  void addRooms(HomeData& home);
  void addGroup(HomeData& home);
  void addScene(HomeData& home);

  Choices& choices_;
  std::uint8_t objects_ = 0;
  std::int64_t instanceID_ = 0;
};

NDUUID HomeChooser::nextUUID() {
  std::array<std::uint8_t, 16> bytes{};
  bytes.front() = 0x9E;
  bytes.back() = ++objects_;
  return NDUUID(bytes);
}

NDValueRef HomeChooser::valueOf(const NDString& format) {
  if (choices_.chance(15)) return nullptr;
  return convertToFormat(chooseValue(choices_), format);
}

/// Metadata as the vocabulary has it, or any.
MetadataData HomeChooser::metadata(const CharacteristicEntry* entry) {
  MetadataData metadata;
  const bool isUsual = entry && choices_.chance(70);
  if (isUsual) metadata.format = entry->values.empty() ? entry->valueType : "int";
  if (!isUsual && choices_.chance(80)) metadata.format = choices_.oneOf(kFormats);
  if (choices_.chance(30)) metadata.units = entry ? entry->unit : NDString("lux");
  if (choices_.chance(40)) metadata.minimumValue = valueOf(metadata.format);
  if (choices_.chance(40)) metadata.maximumValue = valueOf(metadata.format);
  if (choices_.chance(30)) metadata.stepValue = valueOf(metadata.format);
  return metadata;
}

CharacteristicData HomeChooser::characteristic(NDString type, const CharacteristicEntry* entry) {
  CharacteristicData data;
  data.instanceID = ++instanceID_;
  data.characteristicType = std::move(type);
  if (!choices_.chance(10)) data.properties.emplace_back("readable");
  if (!choices_.chance(20)) data.properties.emplace_back("writable");
  if (!choices_.chance(20)) data.metadata = metadata(entry);
  const NDString format = data.metadata ? data.metadata->format : NDString();
  data.value = valueOf(format);
  data.deviceValue = choices_.chance(50) ? valueOf(format) : nullptr;
  if (!data.deviceValue) data.deviceValue = data.value;
  data.faults = faults(6);
  return data;
}

/// Those of one attribute, some of them twice, or one that the assistant has no name for.
void HomeChooser::addCharacteristics(ServiceData& service) {
  auto& list = service.characteristics;
  if (choices_.chance(10)) return list.push_back(characteristic(kUnmappedType, nullptr));
  const CharacteristicEntry& entry = entryOf(choices_.oneOf(kAttributes));
  if (entry.read && !choices_.chance(10)) list.push_back(characteristic(entry.read, &entry));
  const bool isOther = entry.write && !(entry.write == entry.read);
  if (isOther || choices_.chance(10)) {
    if (entry.write) list.push_back(characteristic(entry.write, &entry));
  }
}

ServiceData HomeChooser::service() {
  ServiceData service;
  service.instanceID = ++instanceID_;
  if (!choices_.chance(10)) service.name = name();
  service.serviceType = platformServiceType(choices_.oneOf(kServiceTypes));
  if (choices_.chance(20)) service.serviceType = kUnmappedType;
  if (choices_.chance(20)) {
    service.associatedServiceType = platformServiceType(choices_.oneOf(kServiceTypes));
  }
  for (std::size_t count = choices_.upTo(3); count > 0; --count) addCharacteristics(service);
  return service;
}

AccessoryData HomeChooser::accessory(const std::vector<RoomData>& rooms) {
  AccessoryData accessory;
  accessory.uuid = nextUUID();
  accessory.name = name();
  if (!rooms.empty() && !choices_.chance(20)) accessory.room = choices_.oneOf(rooms).uuid;
  accessory.reachable = !choices_.chance(10);
  accessory.requiresUnlock = choices_.chance(20);
  accessory.faults = faults(6);
  for (std::size_t count = choices_.upTo(2); count > 0; --count) {
    accessory.services.push_back(service());
  }
  return accessory;
}

void HomeChooser::addRooms(HomeData& home) {
  for (std::size_t count = choices_.upTo(3); count > 0; --count) {
    home.rooms.push_back({nextUUID(), name()});
  }
  for (std::size_t count = choices_.upTo(2); count > 0; --count) {
    ZoneData zone = {nextUUID(), name(), {}};
    for (const RoomData& room : home.rooms) {
      if (choices_.chance(50)) zone.rooms.push_back(room.uuid);
    }
    home.zones.push_back(std::move(zone));
  }
}

void HomeChooser::addGroup(HomeData& home) {
  ServiceGroupData group = {nextUUID(), name(), {}};
  for (const AccessoryData& accessory : home.accessories) {
    for (const ServiceData& service : accessory.services) {
      if (choices_.chance(50)) group.services.push_back({accessory.uuid, service.instanceID});
    }
  }
  home.serviceGroups.push_back(std::move(group));
}

void HomeChooser::addScene(HomeData& home) {
  ActionSetData scene = {nextUUID(), name(), {}, code(15)};
  for (const AccessoryData& accessory : home.accessories) {
    for (const ServiceData& service : accessory.services) {
      for (const CharacteristicData& each : service.characteristics) {
        if (!choices_.chance(30)) continue;
        scene.actions.push_back(
            {{accessory.uuid, service.instanceID, each.instanceID}, chooseValue(choices_)});
      }
    }
  }
  home.actionSets.push_back(std::move(scene));
}

HomeData HomeChooser::home() {
  HomeData home;
  home.uuid = nextUUID();
  home.name = name();
  home.primary = choices_.chance(50);
  addRooms(home);
  for (std::size_t count = choices_.upTo(3); count > 0; --count) {
    home.accessories.push_back(accessory(home.rooms));
  }
  if (choices_.chance(40)) addGroup(home);
  if (choices_.chance(40)) addScene(home);
  if (choices_.chance(10)) home.triggers.push_back({nextUUID(), name()});
  home.faults = faults(6);
  return home;
}

}  // namespace

std::vector<HomeData> chooseHomes(Choices& choices) {
  HomeChooser chooser(choices);
  std::vector<HomeData> homes(choices.chance(95) ? 1 + choices.upTo(2) : 0);
  for (HomeData& home : homes) home = chooser.home();
  return homes;
}

}  // namespace nidus
