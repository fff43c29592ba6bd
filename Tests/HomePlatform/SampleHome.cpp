#include "HomePlatform/SampleHome.h"

#include <utility>

namespace nidus {
namespace {

constexpr std::int64_t kServiceID = 8;
constexpr std::int64_t kFirstID = 9;
constexpr std::int64_t kSecondID = 10;

CharacteristicData characteristic(std::int64_t id, const char* type, NDValueRef value,
                                  MetadataData metadata) {
  CharacteristicData data;
  data.instanceID = id;
  data.characteristicType = std::string("com.corvane.nidus.characteristic.") + type;
  data.properties = {"readable", "writable"};
  data.value = value;
  data.deviceValue = std::move(value);
  data.metadata = std::move(metadata);
  return data;
}

AccessoryData accessory(std::string_view id, const char* name, const char* serviceType,
                        std::vector<CharacteristicData> characteristics) {
  AccessoryData data;
  data.uuid = uuidOf(id);
  data.name = name;
  data.room = uuidOf(kRoomID);
  data.services.push_back({kServiceID, name,
                           std::string("com.corvane.nidus.service.") + serviceType, nullptr,
                           std::move(characteristics)});
  return data;
}

MetadataData format(const char* name) { return {name, nullptr, nullptr, nullptr, nullptr}; }

}  // namespace

NDUUID uuidOf(std::string_view text) { return NDUUID::fromText(text).value(); }

HomeData sampleHome() {
  HomeData home;
  home.uuid = uuidOf(kHomeID);
  home.name = "Cabin";
  home.rooms.push_back({uuidOf(kRoomID), "Kitchen"});
  home.accessories.push_back(
      accessory(kLampID, "Lamp", "light",
                {characteristic(kFirstID, "power", NDValue::boolean(false), format("bool")),
                 characteristic(
                     kSecondID, "brightness", NDValue::integer(40),
                     {"int", "percentage", NDValue::integer(0), NDValue::integer(100), nullptr})}));
  home.accessories.push_back(accessory(
      kDoorID, "Door", "lock",
      {characteristic(kFirstID, "target-lock-state", NDValue::integer(0), format("uint8")),
       characteristic(kSecondID, "current-lock-state", NDValue::integer(0), format("uint8"))}));
  ActionSetData scene;
  scene.uuid = uuidOf(kSceneID);
  scene.name = "Good night";
  home.actionSets.push_back(std::move(scene));
  return home;
}

AccessoryData& lampOf(HomeData& home) { return home.accessories[0]; }
AccessoryData& doorOf(HomeData& home) { return home.accessories[1]; }

CharacteristicData& powerOf(HomeData& home) { return lampOf(home).services[0].characteristics[0]; }
CharacteristicData& brightnessOf(HomeData& home) {
  return lampOf(home).services[0].characteristics[1];
}
CharacteristicData& lockTargetOf(HomeData& home) {
  return doorOf(home).services[0].characteristics[0];
}
CharacteristicData& lockStateOf(HomeData& home) {
  return doorOf(home).services[0].characteristics[1];
}

CharacteristicAddress powerAddress() { return {uuidOf(kLampID), kServiceID, kFirstID}; }
CharacteristicAddress brightnessAddress() { return {uuidOf(kLampID), kServiceID, kSecondID}; }
CharacteristicAddress lockTargetAddress() { return {uuidOf(kDoorID), kServiceID, kFirstID}; }
CharacteristicAddress lockStateAddress() { return {uuidOf(kDoorID), kServiceID, kSecondID}; }

}  // namespace nidus
