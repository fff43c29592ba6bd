#include "HomePlatform/Support/RandomHome.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <limits>
#include <sstream>
#include <string>

#include "HomePlatform/Store/HomeDocument.h"
#include "HomePlatform/Store/ValueConversion.h"

namespace nidus {
namespace {

constexpr const char* kNames[] = {"Kitchen", "",       "Küche",          "Zoë's \"den\"",
                                  "a/b~c",   "日本 🏠", "tab\tand\nline", "e\u0301"};
constexpr const char* kFormats[] = {"bool",   "int",   "uint8",  "uint16", "uint32",
                                    "uint64", "float", "string", "tlv8"};
constexpr std::int64_t kIntegers[] = {0,
                                      1,
                                      -1,
                                      255,
                                      -2147483648LL,
                                      2147483647,
                                      4294967295LL,
                                      std::numeric_limits<std::int64_t>::min(),
                                      std::numeric_limits<std::int64_t>::max()};

}  // namespace

std::vector<HomeData> RandomHome::homes() {
  std::vector<HomeData> homes(upTo(3));
  for (HomeData& each : homes) each = home();
  return homes;
}

HomeData RandomHome::home() {
  HomeData home;
  home.uuid = uuid();
  home.name = name();
  home.primary = chance(50);
  home.rooms.resize(upTo(4));
  for (RoomData& room : home.rooms) room = {uuid(), name()};
  home.zones.resize(upTo(2));
  for (ZoneData& zone : home.zones) {
    zone = {uuid(), name(), {}};
    for (const RoomData& room : home.rooms) {
      if (chance(50)) zone.rooms.insert(zone.rooms.begin(), room.uuid);
    }
  }
  home.accessories.resize(upTo(5));
  for (AccessoryData& each : home.accessories) each = accessory(home.rooms);
  addGroups(home);
  addActionSets(home);
  home.triggers.resize(upTo(2));
  for (TriggerData& trigger : home.triggers) trigger = {uuid(), name()};
  home.faults = faults();
  return home;
}

std::size_t RandomHome::upTo(std::size_t greatest) { return random_() % (greatest + 1); }

bool RandomHome::chance(int percent) { return static_cast<int>(random_() % 100) < percent; }

NDUUID RandomHome::uuid() {
  std::array<std::uint8_t, 16> bytes;
  for (std::uint8_t& byte : bytes) byte = static_cast<std::uint8_t>(random_());
  return NDUUID(bytes);
}

NDString RandomHome::name() { return kNames[upTo(std::size(kNames) - 1)]; }

NDString RandomHome::maybeText() { return chance(50) ? name() : NDString(); }

std::int32_t RandomHome::code() {
  constexpr std::int32_t kCodes[] = {0,
                                     4,
                                     82,
                                     -1,
                                     std::numeric_limits<std::int32_t>::min(),
                                     std::numeric_limits<std::int32_t>::max()};
  return kCodes[upTo(std::size(kCodes) - 1)];
}

FaultData RandomHome::faults() {
  return chance(30) ? FaultData{.read = code(), .write = code()} : FaultData();
}

NDValueRef RandomHome::anyValue() {
  switch (upTo(3)) {
    case 0:
      return NDValue::boolean(chance(50));
    case 1:
      return NDValue::integer(kIntegers[upTo(std::size(kIntegers) - 1)]);
    case 2: {
      const auto number = std::bit_cast<float>(static_cast<std::uint32_t>(random_()));
      return NDValue::floating(std::isfinite(number) ? number : -0.0F);
    }
    default:
      return NDValue::text(name());
  }
}

NDValueRef RandomHome::valueOf(const NDString& format) {
  if (chance(20)) return nullptr;
  NDValueRef value;
  while (!value) value = convertToFormat(anyValue(), format);
  return value;
}

std::vector<NDString> RandomHome::properties() {
  std::vector<NDString> words = {"readable", "writable", "notifies"};
  std::shuffle(words.begin(), words.end(), random_);
  words.resize(upTo(words.size()));
  return words;
}

MetadataData RandomHome::metadata() {
  MetadataData metadata;
  if (chance(80)) metadata.format = kFormats[upTo(std::size(kFormats) - 1)];
  metadata.units = maybeText();
  metadata.minimumValue = valueOf(metadata.format);
  metadata.maximumValue = valueOf(metadata.format);
  metadata.stepValue = valueOf(metadata.format);
  return metadata;
}

CharacteristicData RandomHome::characteristic(std::int64_t instanceID) {
  CharacteristicData data;
  data.instanceID = instanceID;
  data.characteristicType = name();
  data.properties = properties();
  if (chance(60)) data.metadata = chance(20) ? MetadataData() : metadata();
  const NDString format = data.metadata ? data.metadata->format : NDString();
  data.value = valueOf(format);
  data.deviceValue = chance(50) ? valueOf(format) : data.value;
  if (!data.deviceValue) data.deviceValue = data.value;
  data.faults = faults();
  return data;
}

AccessoryData RandomHome::accessory(const std::vector<RoomData>& rooms) {
  AccessoryData accessory;
  accessory.uuid = uuid();
  accessory.name = name();
  if (!rooms.empty() && chance(70)) accessory.room = rooms[upTo(rooms.size() - 1)].uuid;
  accessory.reachable = chance(80);
  accessory.requiresUnlock = chance(20);
  accessory.faults = faults();
  // Both kinds of instance IDs fall, so that none of the orders is that of the IDs.
  std::int64_t instanceID = std::numeric_limits<std::int64_t>::max();
  accessory.services.resize(upTo(3));
  for (ServiceData& service : accessory.services) {
    service = {instanceID--, maybeText(), name(), maybeText(), {}};
    service.characteristics.resize(upTo(4));
    for (CharacteristicData& each : service.characteristics) each = characteristic(instanceID--);
  }
  return accessory;
}

void RandomHome::addGroups(HomeData& home) {
  home.serviceGroups.resize(upTo(2));
  for (ServiceGroupData& group : home.serviceGroups) {
    group = {uuid(), name(), {}};
    for (const AccessoryData& accessory : home.accessories) {
      for (const ServiceData& service : accessory.services) {
        if (chance(50)) group.services.push_back({accessory.uuid, service.instanceID});
      }
    }
    std::shuffle(group.services.begin(), group.services.end(), random_);
  }
}

void RandomHome::addActionSets(HomeData& home) {
  home.actionSets.resize(upTo(2));
  for (ActionSetData& actionSet : home.actionSets) {
    actionSet = {uuid(), name(), {}, chance(20) ? code() : 0};
    for (const AccessoryData& accessory : home.accessories) {
      for (const ServiceData& service : accessory.services) {
        for (const CharacteristicData& each : service.characteristics) {
          if (!chance(40)) continue;
          actionSet.actions.push_back(
              {{accessory.uuid, service.instanceID, each.instanceID}, anyValue()});
        }
      }
    }
  }
}

std::string documentOf(const std::vector<HomeData>& homes) {
  std::ostringstream out;
  writeHomeDocument(out, homes, true);
  return out.str();
}

}  // namespace nidus
