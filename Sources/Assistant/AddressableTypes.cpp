#include "Assistant/AddressableTypes.h"

#include <algorithm>

namespace nidus {
namespace {

bool areOfTypes(const NDArray<NDCharacteristic>& characteristics,
                const std::vector<NDString>& types) {
  return std::equal(
      characteristics.begin(), characteristics.end(), types.begin(), types.end(),
      [](const std::shared_ptr<NDCharacteristic>& characteristic, const NDString& type) {
        return characteristic->characteristicType() == type;
      });
}

}  // namespace

TextList AddressableTypes::of(const NDService& service) {
  if (!metadata_) return {};
  const NDArray<NDCharacteristic>& characteristics = service.characteristics();
  Known& known = knownOf(service.serviceType());
  if (!areOfTypes(characteristics, known.all)) known = judged(characteristics);
  return known.addressable;
}

/// Services of one type often follow each other.
AddressableTypes::Known& AddressableTypes::knownOf(const NDString& serviceType) {
  if (!last_ || last_->first != serviceType)
    last_ = &*byServiceType_.try_emplace(serviceType).first;
  return last_->second;
}

AddressableTypes::Known AddressableTypes::judged(
    const NDArray<NDCharacteristic>& characteristics) const {
  Known known;
  for (const auto& characteristic : characteristics) {
    const NDString& type = characteristic->characteristicType();
    known.all.push_back(type);
    const NDString name = metadata_->mapToAssistantCharacteristicName(type);
    if (name && name != "IDENTIFY") known.addressable.append(type);
  }
  return known;
}

}  // namespace nidus
