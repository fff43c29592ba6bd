#include "Load/LoadHome.h"

#include <algorithm>
#include <initializer_list>
#include <string>
#include <string_view>
#include <utility>

namespace nidus {
namespace {

constexpr std::uint8_t kHomeKind = 1;
constexpr std::uint8_t kRoomKind = 2;
constexpr std::uint8_t kLampKind = 3;
constexpr std::uint8_t kSceneKind = 4;
constexpr std::uint8_t kGroupKind = 5;
constexpr std::uint8_t kZoneKind = 6;
constexpr std::size_t kReadOnlyLamp = kLampsPerRoom - 1;
constexpr std::size_t kLockedLamp = kLampsPerRoom;
constexpr std::size_t kUnreachableLamp = kLampsPerRoom + 1;
constexpr std::size_t kAllLamps = kLampsPerRoom + 2;
constexpr std::int64_t kLightID = 8;
constexpr std::int64_t kPowerID = 9;
constexpr std::int64_t kBrightnessID = 10;
constexpr std::string_view kRenamed = " bis";

NDUUID makeUUID(std::uint8_t kind, std::size_t home, std::size_t room = 0, std::size_t lamp = 0) {
  std::array<std::uint8_t, 16> bytes{};
  bytes[0] = kind;
  bytes[1] = static_cast<std::uint8_t>(home);
  bytes[2] = static_cast<std::uint8_t>(room);
  bytes[3] = static_cast<std::uint8_t>(lamp);
  return NDUUID(bytes);
}

/// Such as "Lamp 0.3.1"; no such name is the beginning of another.
NDString numbered(std::string_view word, std::initializer_list<std::size_t> numbers) {
  std::string name(word);
  char separator = ' ';
  for (const std::size_t number : numbers) {
    name += std::exchange(separator, '.') + std::to_string(number);
  }
  return name;
}

std::string_view firstNameOf(const NDString& name) {
  std::string_view text = name.view();
  if (text.ends_with(kRenamed)) text.remove_suffix(kRenamed.size());
  return text;
}

CharacteristicData lampPower(bool isReadOnly) {
  CharacteristicData power;
  power.instanceID = kPowerID;
  power.characteristicType = "com.corvane.nidus.characteristic.power";
  power.properties = {"readable"};
  if (!isReadOnly) power.properties.emplace_back("writable");
  power.value = power.deviceValue = NDValue::boolean(false);
  power.metadata.emplace().format = "bool";
  return power;
}

CharacteristicData lampBrightness() {
  CharacteristicData brightness;
  brightness.instanceID = kBrightnessID;
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

/// Puts one home together; with `random` some things are renamed and others left out.
class HomeMaking {
 public:
  HomeMaking(std::size_t home, std::size_t rooms, Random* random)
      : number_(home), rooms_(rooms), random_(random) {}

  HomeData make() {
    home_.uuid = makeUUID(kHomeKind, number_);
    home_.name = named(homeName(number_));
    home_.primary = number_ == 0;
    home_.serviceGroups = {{makeUUID(kGroupKind, number_), groupName(number_), {}}};
    home_.zones = {{makeUUID(kZoneKind, number_), numbered("Zone", {number_}), {}}};
    for (std::size_t room = 0; room < rooms_; ++room) addRoom(room);
    return std::move(home_);
  }

 private:
  [[nodiscard]] bool isOne(std::size_t count) { return random_ && random_->oneIn(count); }
  [[nodiscard]] NDString named(const NDString& name) { return isOne(8) ? renamed(name) : name; }

  void addRoom(std::size_t room) {
    std::optional<NDUUID> uuid;
    if (!isOne(8)) {
      uuid = makeUUID(kRoomKind, number_, room);
      home_.rooms.push_back({.uuid = *uuid, .name = named(roomName(number_, room))});
      home_.zones.front().rooms.push_back(*uuid);
    }
    for (std::size_t lamp = 0; lamp < kAllLamps; ++lamp) {
      if (!isOne(6)) addLamp(room, lamp, uuid);
    }
    if (!isOne(4)) addScene(room);
  }

  void addLamp(std::size_t room, std::size_t number, const std::optional<NDUUID>& stands) {
    ServiceData light;
    light.instanceID = kLightID;
    light.name = named(lampName(number_, room, number));
    light.serviceType = "com.corvane.nidus.service.light";
    light.characteristics = {lampPower(number == kReadOnlyLamp), lampBrightness()};
    AccessoryData lamp;
    lamp.uuid = makeUUID(kLampKind, number_, room, number);
    lamp.name = light.name;
    lamp.room = stands;
    lamp.requiresUnlock = number == kLockedLamp;
    lamp.reachable = number != kUnreachableLamp;
    lamp.services = {std::move(light)};
    if (number == 0) home_.serviceGroups.front().services.push_back({lamp.uuid, kLightID});
    home_.accessories.push_back(std::move(lamp));
  }

  void addScene(std::size_t room) {
    ActionSetData scene;
    scene.uuid = makeUUID(kSceneKind, number_, room);
    scene.name = named(sceneName(number_, room));
    const CharacteristicAddress target = powerOf(number_, room, 0);
    const auto& lamps = home_.accessories;
    const bool hasTarget = std::any_of(lamps.begin(), lamps.end(), [&target](const auto& lamp) {
      return lamp.uuid == target.accessory;
    });
    if (hasTarget) scene.actions = {{.target = target, .value = NDValue::boolean(true)}};
    home_.actionSets.push_back(std::move(scene));
  }

  const std::size_t number_;
  const std::size_t rooms_;
  Random* const random_;
  HomeData home_;
};

}  // namespace

HomeData loadHome(std::size_t home, std::size_t rooms) {
  return HomeMaking(home, rooms, nullptr).make();
}

HomeData changedHome(std::size_t home, std::size_t rooms, Random& random) {
  return HomeMaking(home, rooms, &random).make();
}

std::size_t entityCount(std::size_t rooms) { return 3 + rooms * (kAllLamps + 2); }

NDString homeName(std::size_t home) { return numbered("Home", {home}); }
NDString roomName(std::size_t home, std::size_t room) { return numbered("Room", {home, room}); }
NDString lampName(std::size_t home, std::size_t room, std::size_t lamp) {
  return numbered("Lamp", {home, room, lamp});
}
NDString lockedLampName(std::size_t home, std::size_t room) {
  return lampName(home, room, kLockedLamp);
}
NDString unreachableLampName(std::size_t home, std::size_t room) {
  return lampName(home, room, kUnreachableLamp);
}
NDString sceneName(std::size_t home, std::size_t room) { return numbered("Scene", {home, room}); }
NDString groupName(std::size_t home) { return numbered("Group", {home}); }

NDString renamed(const NDString& name) { return name.str().append(kRenamed); }

bool isSameObject(const NDString& a, const NDString& b) {
  return a && b && firstNameOf(a) == firstNameOf(b);
}

bool isInGroup(const NDString& lamp, const NDString& group) {
  const std::string_view home = firstNameOf(group).substr(std::string_view("Group ").size());
  const std::string_view name = firstNameOf(lamp);
  return name.starts_with("Lamp " + std::string(home) + ".") && name.ends_with(".0");
}

CharacteristicAddress powerOf(std::size_t home, std::size_t room, std::size_t lamp) {
  return {makeUUID(kLampKind, home, room, lamp), kLightID, kPowerID};
}

CharacteristicAddress brightnessOf(std::size_t home, std::size_t room, std::size_t lamp) {
  return {makeUUID(kLampKind, home, room, lamp), kLightID, kBrightnessID};
}

}  // namespace nidus
