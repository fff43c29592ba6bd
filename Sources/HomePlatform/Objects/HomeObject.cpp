#include "HomePlatform/Objects/HomeObject.h"

#include <cstring>
#include <utility>

#include "HomePlatform/Objects/AccessoryObject.h"
#include "HomePlatform/Objects/CharacteristicObject.h"
#include "HomePlatform/Objects/HomeBuilding.h"
#include "HomePlatform/Objects/HomeCalls.h"
#include "HomePlatform/Objects/ServiceObject.h"

namespace nidus {

std::shared_ptr<HomeObject> HomeObject::make(const std::shared_ptr<const HomeData>& data,
                                             std::weak_ptr<HomeCalls> calls) {
  auto home = std::make_shared<HomeObject>(data, std::move(calls));
  HomeBuilding(home, data).build();
  return home;
}

HomeObject::HomeObject(std::shared_ptr<const HomeData> data, std::weak_ptr<HomeCalls> calls)
    : data_(std::move(data)), calls_(std::move(calls)) {}

HomeObject::~HomeObject() = default;

void HomeObject::readCharacteristicValues_withCompletionHandler(
    NDArray<NDCharacteristic> characteristics, NDBatchCompletion completion) {
  if (const auto calls = calls_.lock()) {
    calls->read(uuid(), characteristics, std::move(completion));
  }
}

void HomeObject::writeCharacteristicValues_withCompletionHandler(
    std::vector<NDCharacteristicWriteRequestTuple> writes, NDBatchCompletion completion) {
  if (const auto calls = calls_.lock()) {
    calls->write(uuid(), std::move(writes), std::move(completion));
  }
}

void HomeObject::executeActionSet_completionHandler(std::shared_ptr<NDActionSet> actionSet,
                                                    NDExecuteCompletion completion) {
  if (const auto calls = calls_.lock()) {
    calls->execute(uuid(), actionSet->uuid(), std::move(completion));
  }
}

FoundCharacteristic HomeObject::find(const CharacteristicAddress& address) const {
  const auto accessory = accessoriesByID_.find(address.accessory);
  if (accessory == accessoriesByID_.end()) return {};
  const auto service = accessory->second->find(address.service);
  if (!service) return {};
  const auto& object = static_cast<const ServiceObject&>(*service);
  CharacteristicObject* characteristic = object.find(address.characteristic);
  if (!characteristic) return {};
  return {accessory->second, &object, characteristic};
}

void HomeObject::apply(const ValueChange& change) const {
  if (change.home != uuid()) return;
  CharacteristicObject* characteristic = find(change.address).characteristic;
  if (!characteristic) return;
  if (change.value) characteristic->setValue(*change.value);
  if (change.deviceValue) characteristic->setDeviceValue(*change.deviceValue);
}

void HomeObject::takeValues(const HomeObject& newer) const {
  for (const auto& accessory : accessories_) {
    for (const auto& service : accessory->services()) {
      for (const auto& element : service->characteristics()) {
        auto& own = static_cast<CharacteristicObject&>(*element);
        const CharacteristicObject* other = newer.find(own.address()).characteristic;
        if (!other) continue;
        CharacteristicObject::Values values = other->values();
        own.setValue(std::move(values.value));
        own.setDeviceValue(std::move(values.deviceValue));
      }
    }
  }
}

}  // namespace nidus
