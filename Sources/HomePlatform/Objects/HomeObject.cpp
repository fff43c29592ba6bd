#include "HomePlatform/Objects/HomeObject.h"

#include <algorithm>
#include <utility>

#include "HomePlatform/Objects/AccessoryObject.h"
#include "HomePlatform/Objects/CharacteristicObject.h"
#include "HomePlatform/Objects/HomeBuilding.h"
#include "HomePlatform/Objects/HomeCalls.h"

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

FoundCharacteristic HomeObject::find(const CharacteristicAddress& address,
                                     std::size_t& near) const {
  const AccessoryObject* found = findAccessory(address.accessory, near);
  if (!found) return {};
  return found->find(address.service, address.characteristic);
}

FoundCharacteristic HomeObject::find(const CharacteristicAddress& address) const {
  std::size_t near = 0;
  return find(address, near);
}

const AccessoryObject& HomeObject::accessory(std::size_t index) const {
  return static_cast<const AccessoryObject&>(*accessories_[index]);
}

const AccessoryObject* HomeObject::findAccessory(const NDUUID& id, std::size_t& near) const {
  const std::size_t end = std::min(near + 2, accessories_.size());
  for (std::size_t index = near; index < end; ++index) {
    if (accessory(index).data().uuid != id) continue;
    near = index;
    return &accessory(index);
  }
  const auto found = accessoryIndexes_.find(id);
  if (found == accessoryIndexes_.end()) return nullptr;
  near = found->second;
  return &accessory(near);
}

void HomeObject::apply(const ValueChange& change) const {
  if (change.home != uuid()) return;
  CharacteristicObject* characteristic = find(change.address).characteristic;
  if (characteristic) characteristic->setValues(change.value, change.deviceValue);
}

void HomeObject::takeValues(const HomeObject& newer) const {
  for (const auto& accessory : accessories_) {
    for (const auto& service : accessory->services()) {
      for (const auto& element : service->characteristics()) {
        auto& own = static_cast<CharacteristicObject&>(*element);
        const CharacteristicObject* other = newer.find(own.address()).characteristic;
        if (!other) continue;
        CharacteristicObject::Values values = other->values();
        own.setValues(std::move(values.value), std::move(values.deviceValue));
      }
    }
  }
}

}  // namespace nidus
