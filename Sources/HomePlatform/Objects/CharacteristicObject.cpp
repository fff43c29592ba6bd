#include "HomePlatform/Objects/CharacteristicObject.h"

namespace nidus {
namespace {

std::shared_ptr<const NDCharacteristicMetadata> makeMetadata(
    const std::shared_ptr<const CharacteristicData>& data) {
  if (!data->metadata) return nullptr;
  return std::make_shared<MetadataObject>(
      std::shared_ptr<const MetadataData>(data, &*data->metadata));
}

}  // namespace

CharacteristicObject::CharacteristicObject(std::shared_ptr<const CharacteristicData> data,
                                           const CharacteristicAddress& address,
                                           std::weak_ptr<NDService> service)
    : data_(std::move(data)),
      address_(address),
      service_(std::move(service)),
      metadata_(makeMetadata(data_)),
      values_{data_->value, data_->deviceValue} {}

NDValueRef CharacteristicObject::value() const {
  const NDLock lock(mutex_);
  return values_.value;
}

CharacteristicObject::Values CharacteristicObject::values() const {
  const NDLock lock(mutex_);
  return values_;
}

void CharacteristicObject::setValue(NDValueRef value) {
  const NDLock lock(mutex_);
  values_.value.swap(value);
}

void CharacteristicObject::setDeviceValue(NDValueRef deviceValue) {
  const NDLock lock(mutex_);
  values_.deviceValue.swap(deviceValue);
}

}  // namespace nidus
