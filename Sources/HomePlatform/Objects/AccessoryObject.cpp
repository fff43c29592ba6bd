#include "HomePlatform/Objects/AccessoryObject.h"

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
  accessory->listCharacteristics();
  return accessory;
}

AccessoryObject::AccessoryObject(std::shared_ptr<const AccessoryData> data,
                                 std::weak_ptr<NDHome> home, std::weak_ptr<NDRoom> room)
    : HomePart(std::move(data), std::move(home)), room_(std::move(room)) {}

const std::shared_ptr<NDService>& AccessoryObject::findService(std::int64_t instanceID) const {
  static const std::shared_ptr<NDService> kNone;
  const auto& all = data().services;
  for (std::size_t index = 0; index < all.size(); ++index) {
    if (all[index].instanceID == instanceID) return services_[index];
  }
  return kNone;
}

FoundCharacteristic AccessoryObject::find(std::int64_t service, std::int64_t characteristic) const {
  for (const Place& place : places_) {
    if (place.serviceID == service && place.characteristicID == characteristic) return place.found;
  }
  return {};
}

void AccessoryObject::listCharacteristics() {
  for (const auto& element : services_) {
    const auto& service = static_cast<const ServiceObject&>(*element);
    for (const auto& each : service.characteristics()) {
      auto& characteristic = static_cast<CharacteristicObject&>(*each);
      places_.push_back(
          {service.instanceID(), each->instanceID(), {this, &service, &characteristic}});
    }
  }
}

}  // namespace nidus
