#include "PlugIn/AccessoryModel.h"

#include <algorithm>
#include <compare>
#include <string_view>

#include "HomePlatform/Store/ValueConversion.h"
#include "PlatformModel/Home/NDError.h"
#include "PlugIn/Words.h"

namespace nidus {
namespace {

template <class List, class Test>
auto* findIn(List& list, const Test& test) {
  const auto found = std::find_if(list.begin(), list.end(), test);
  return found == list.end() ? nullptr : &*found;
}

bool has(const CharacteristicData& characteristic, std::string_view property) {
  return findIn(characteristic.properties,
                [property](const NDString& each) { return each == property; }) != nullptr;
}

NDValueRef converted(const CharacteristicData& characteristic, const NDValueRef& value) {
  const auto& metadata = characteristic.metadata;
  return convertToFormat(value, metadata ? metadata->format : NDString());
}

bool isOutside(const CharacteristicData& characteristic, const NDValue& value) {
  const auto& metadata = characteristic.metadata;
  return metadata && (std::is_lt(value.compare(metadata->minimumValue)) ||
                      std::is_gt(value.compare(metadata->maximumValue)));
}

/// The characteristic that takes what is written to `type`; null when none does.
CharacteristicData* followerOf(ServiceData& service, const NDString& type) {
  const auto* entry = findIn(words().characteristics, [&type](const CharacteristicEntry& each) {
    return each.follows && each.write == type;
  });
  if (!entry || entry->read == type) return nullptr;
  return findIn(service.characteristics, [entry](const CharacteristicData& each) {
    return each.characteristicType == entry->read;
  });
}

}  // namespace

ModelAnswer AccessoryModel::answer(const PlatformCall& call) {
  ModelAnswer answer;
  if (call.kind == PlatformCall::Kind::execute) {
    answer.batch = run(call.home, *call.actionSet);
    return answer;
  }
  const bool isRead = call.kind == PlatformCall::Kind::read;
  const FaultData& faults = findHome(call.home)->faults;
  answer.batch = isRead ? faults.read : faults.write;
  if (answer.batch != 0) return answer;
  for (std::size_t i = 0; i < call.characteristics.size(); ++i) {
    const Place asked = place(call.home, call.characteristics[i]);
    answer.codes.push_back(isRead ? read(asked) : write(asked, call.values[i]));
  }
  return answer;
}

const CharacteristicData* AccessoryModel::find(const NDUUID& home,
                                               const CharacteristicAddress& address) const {
  return place(home, address).characteristic;
}

HomeData* AccessoryModel::findHome(const NDUUID& home) const {
  return findIn(homes_, [&home](const HomeData& each) { return each.uuid == home; });
}

AccessoryModel::Place AccessoryModel::place(const NDUUID& home,
                                            const CharacteristicAddress& address) const {
  Place place;
  place.home = findHome(home);
  if (!place.home) return place;
  place.accessory = findIn(place.home->accessories, [&address](const AccessoryData& each) {
    return each.uuid == address.accessory;
  });
  if (!place.accessory) return place;
  place.service = findIn(place.accessory->services, [&address](const ServiceData& each) {
    return each.instanceID == address.service;
  });
  if (!place.service) return place;
  place.characteristic =
      findIn(place.service->characteristics, [&address](const CharacteristicData& each) {
        return each.instanceID == address.characteristic;
      });
  return place;
}

std::int32_t AccessoryModel::refusal(const Place& place, std::int32_t FaultData::*fault) const {
  if (place.characteristic->faults.*fault != 0) return place.characteristic->faults.*fault;
  if (place.accessory->faults.*fault != 0) return place.accessory->faults.*fault;
  if (!place.accessory->reachable) return kNDErrorUnreachable;
  return place.accessory->requiresUnlock && isLocked_ ? kNDErrorMustUnlock : 0;
}

std::int32_t AccessoryModel::read(const Place& place) const {
  if (const std::int32_t code = refusal(place, &FaultData::read)) return code;
  if (!has(*place.characteristic, "readable")) return kNDErrorNotReadable;
  place.characteristic->value = place.characteristic->deviceValue;
  return 0;
}

std::int32_t AccessoryModel::write(const Place& place, const NDValueRef& value) const {
  if (const std::int32_t code = refusal(place, &FaultData::write)) return code;
  CharacteristicData& target = *place.characteristic;
  if (!has(target, "writable")) return kNDErrorNotWritable;
  const NDValueRef kept = converted(target, value);
  if (!kept) return kNDErrorWrongType;
  if (isOutside(target, *kept)) return kNDErrorOutOfRange;
  target.value = target.deviceValue = kept;
  if (auto* follower = followerOf(*place.service, target.characteristicType)) {
    const NDValueRef followed = converted(*follower, kept);
    if (followed) follower->value = follower->deviceValue = followed;
  }
  return 0;
}

std::int32_t AccessoryModel::run(const NDUUID& home, const NDUUID& actionSet) const {
  const auto* scene = findIn(findHome(home)->actionSets, [&actionSet](const ActionSetData& each) {
    return each.uuid == actionSet;
  });
  if (!scene) return kNDErrorUnreachable;
  if (scene->executeFault != 0) return scene->executeFault;
  std::int32_t first = 0;
  for (const SceneActionData& action : scene->actions) {
    const std::int32_t code = write(place(home, action.target), action.value);
    if (first == 0) first = code;
  }
  return first;
}

}  // namespace nidus
