#include "HomePlatform/Objects/ServiceObject.h"

#include <utility>
#include <vector>

#include "HomePlatform/Objects/CharacteristicObject.h"

namespace nidus {

std::shared_ptr<ServiceObject> ServiceObject::make(const std::shared_ptr<const ServiceData>& data,
                                                   const NDUUID& accessoryID,
                                                   std::weak_ptr<NDAccessory> accessory) {
  auto service = std::make_shared<ServiceObject>(data, std::move(accessory));
  std::vector<std::shared_ptr<NDCharacteristic>> characteristics;
  characteristics.reserve(data->characteristics.size());
  for (const CharacteristicData& characteristic : data->characteristics) {
    characteristics.push_back(std::make_shared<CharacteristicObject>(
        std::shared_ptr<const CharacteristicData>(data, &characteristic),
        CharacteristicAddress{accessoryID, data->instanceID, characteristic.instanceID}, service));
  }
  service->characteristics_ = NDArray<NDCharacteristic>(std::move(characteristics));
  return service;
}

ServiceObject::ServiceObject(std::shared_ptr<const ServiceData> data,
                             std::weak_ptr<NDAccessory> accessory)
    : data_(std::move(data)), accessory_(std::move(accessory)) {}

}  // namespace nidus
