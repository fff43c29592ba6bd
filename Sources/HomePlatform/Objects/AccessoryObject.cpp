#include "HomePlatform/Objects/AccessoryObject.h"

#include <algorithm>
#include <utility>
#include <vector>

#include "HomePlatform/Objects/CharacteristicObject.h"
#include "HomePlatform/Objects/ServiceObject.h"

namespace nidus {

std::shared_ptr<AccessoryObject> AccessoryObject::make(
    const std::shared_ptr<const AccessoryData>& data, std::weak_ptr<NDHome> home,
    std::weak_ptr<NDRoom> room) {
  auto accessory = std::make_shared<AccessoryObject>(data, std::move(home), std::move(room));
  std::vector<std::shared_ptr<NDService>> services;
  services.reserve(data->services.size());
  for (const ServiceData& service : data->services) {
    services.push_back(ServiceObject::make(std::shared_ptr<const ServiceData>(data, &service),
                                           data->uuid, accessory));
  }
  accessory->services_ = NDArray<NDService>(std::move(services));
  accessory->sortParts();
  return accessory;
}

AccessoryObject::AccessoryObject(std::shared_ptr<const AccessoryData> data,
                                 std::weak_ptr<NDHome> home, std::weak_ptr<NDRoom> room)
    : HomePart(std::move(data), std::move(home)), room_(std::move(room)) {}

const std::shared_ptr<NDService>& AccessoryObject::findService(std::int64_t instanceID) const {
  static const std::shared_ptr<NDService> kNone;
  const auto found = std::lower_bound(serviceIndexes_.begin(), serviceIndexes_.end(),
                                      std::pair(instanceID, std::size_t{0}));
  const bool isThere = found != serviceIndexes_.end() && found->first == instanceID;
  return isThere ? services_[found->second] : kNone;
}

FoundCharacteristic AccessoryObject::find(std::int64_t service, std::int64_t characteristic) const {
  const auto found = std::lower_bound(places_.begin(), places_.end(),
                                      Place{service, characteristic, {}}, &Place::isBefore);
  const bool isThere = found != places_.end() && found->serviceID == service &&
                       found->characteristicID == characteristic;
  return isThere ? found->found : FoundCharacteristic();
}

/// Makes the tables of the look-ups: a bridge may have very many parts.
void AccessoryObject::sortParts() {
  for (std::size_t index = 0; index < services_.size(); ++index) {
    const auto& service = static_cast<const ServiceObject&>(*services_[index]);
    serviceIndexes_.emplace_back(service.instanceID(), index);
    for (const auto& each : service.characteristics()) {
      auto& characteristic = static_cast<CharacteristicObject&>(*each);
      places_.push_back(
          {service.instanceID(), each->instanceID(), {this, &service, &characteristic}});
    }
  }
  std::sort(serviceIndexes_.begin(), serviceIndexes_.end());
  std::sort(places_.begin(), places_.end(), &Place::isBefore);
}

}  // namespace nidus
