#include "Support/DataText.h"

#include <bit>
#include <concepts>
#include <cstdint>
#include <optional>

namespace nidus {
namespace {

// What one field says. Texts are set off by their lengths, so that no text can pass for two.

template <std::integral Number>
std::string text(Number number) {
  return std::to_string(number);
}

std::string text(const NDString& string) {
  return string ? std::to_string(string.view().size()) + ':' + string.str() : "none";
}

std::string text(const NDUUID& uuid) { return uuid.UUIDString().str(); }

std::string text(const NDValueRef& value) {
  if (!value) return "none";
  if (value->isBoolean()) return value->boolValue() ? "yes" : "no";
  if (value->isInteger()) return 'i' + std::to_string(value->integerValue());
  if (value->isText()) return text(value->stringValue());
  return 'f' + std::to_string(std::bit_cast<std::uint32_t>(value->floatValue()));
}

template <class Element>
std::string text(const std::vector<Element>& list);
template <class Content>
std::string text(const std::optional<Content>& content);

std::string text(const FaultData& faults);
std::string text(const MetadataData& metadata);
std::string text(const CharacteristicData& characteristic);
std::string text(const ServiceData& service);
std::string text(const AccessoryData& accessory);
std::string text(const RoomData& room);
std::string text(const ZoneData& zone);
std::string text(const ServiceAddress& address);
std::string text(const ServiceGroupData& group);
std::string text(const CharacteristicAddress& address);
std::string text(const SceneActionData& action);
std::string text(const ActionSetData& actionSet);
std::string text(const TriggerData& trigger);
std::string text(const HomeData& home);
std::string text(const ServiceEntry& entry);
std::string text(const ValuePair& pair);
std::string text(const CharacteristicEntry& entry);
std::string text(const UnitEntry& entry);

template <class... Fields>
std::string fields(const Fields&... all) {
  return '{' + ((text(all) + ' ') + ...) + "}\n";
}

template <class Element>
std::string text(const std::vector<Element>& list) {
  std::string joined = "[";
  for (const Element& element : list) joined += text(element) + ' ';
  return joined + ']';
}

template <class Content>
std::string text(const std::optional<Content>& content) {
  return content ? "some " + text(*content) : "none";
}

std::string text(const FaultData& faults) { return fields(faults.read, faults.write); }

std::string text(const MetadataData& metadata) {
  return fields(metadata.format, metadata.units, metadata.minimumValue, metadata.maximumValue,
                metadata.stepValue);
}

std::string text(const CharacteristicData& characteristic) {
  return fields(characteristic.instanceID, characteristic.characteristicType,
                characteristic.properties, characteristic.value, characteristic.deviceValue,
                characteristic.metadata, characteristic.faults);
}

std::string text(const ServiceData& service) {
  return fields(service.instanceID, service.name, service.serviceType,
                service.associatedServiceType, service.characteristics);
}

std::string text(const AccessoryData& accessory) {
  return fields(accessory.uuid, accessory.name, accessory.room, accessory.reachable,
                accessory.requiresUnlock, accessory.services, accessory.faults);
}

std::string text(const RoomData& room) { return fields(room.uuid, room.name); }

std::string text(const ZoneData& zone) { return fields(zone.uuid, zone.name, zone.rooms); }

std::string text(const ServiceAddress& address) {
  return fields(address.accessory, address.service);
}

std::string text(const ServiceGroupData& group) {
  return fields(group.uuid, group.name, group.services);
}

std::string text(const CharacteristicAddress& address) {
  return fields(address.accessory, address.service, address.characteristic);
}

std::string text(const SceneActionData& action) { return fields(action.target, action.value); }

std::string text(const ActionSetData& actionSet) {
  return fields(actionSet.uuid, actionSet.name, actionSet.actions, actionSet.executeFault);
}

std::string text(const TriggerData& trigger) { return fields(trigger.uuid, trigger.name); }

std::string text(const HomeData& home) {
  return fields(home.uuid, home.name, home.primary, home.rooms, home.zones, home.accessories,
                home.serviceGroups, home.actionSets, home.triggers, home.faults);
}

std::string text(const ServiceEntry& entry) {
  return fields(entry.assistantName, entry.serviceType);
}

std::string text(const ValuePair& pair) { return fields(pair.assistant, pair.platform); }

std::string text(const CharacteristicEntry& entry) {
  return fields(entry.assistantName, entry.read, entry.write, entry.valueType, entry.unit,
                entry.localized, entry.follows, entry.values);
}

std::string text(const UnitEntry& entry) { return fields(entry.assistantName, entry.unit); }

}  // namespace

std::string dataText(const std::vector<HomeData>& homes) { return text(homes); }

std::string dataText(const Vocabulary& vocabulary) {
  return fields(vocabulary.services, vocabulary.characteristics, vocabulary.units);
}

}  // namespace nidus
