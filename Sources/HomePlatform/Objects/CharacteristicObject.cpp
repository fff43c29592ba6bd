#include "HomePlatform/Objects/CharacteristicObject.h"

#include <algorithm>
#include <string_view>
#include <utility>

#include "HomePlatform/Store/ValueConversion.h"
#include "PlatformModel/Home/NDCharacteristicConstants.h"

namespace nidus {
namespace {

std::shared_ptr<const NDCharacteristicMetadata> makeMetadata(
    const std::shared_ptr<const CharacteristicData>& data) {
  if (!data->metadata) return nullptr;
  return std::make_shared<MetadataObject>(
      std::shared_ptr<const MetadataData>(data, &*data->metadata));
}

bool hasProperty(const CharacteristicData& characteristic, std::string_view property) {
  const auto& properties = characteristic.properties;
  return std::find(properties.begin(), properties.end(), property) != properties.end();
}

}  // namespace

CharacteristicObject::CharacteristicObject(std::shared_ptr<const CharacteristicData> data,
                                           const CharacteristicAddress& address,
                                           std::weak_ptr<NDService> service)
    : data_(std::move(data)),
      address_(address),
      service_(std::move(service)),
      metadata_(makeMetadata(data_)),
      isReadable_(hasProperty(*data_, NDCharacteristicPropertyReadable)),
      isWritable_(hasProperty(*data_, NDCharacteristicPropertyWritable)),
      values_{data_->value, data_->deviceValue},
      isCurrent_(isSameValue(data_->value, data_->deviceValue)) {}

NDValueRef CharacteristicObject::value() const {
  const NDLock lock(mutex_);
  return values_.value;
}

CharacteristicObject::Values CharacteristicObject::values() const {
  const NDLock lock(mutex_);
  return values_;
}

void CharacteristicObject::setValues(std::optional<NDValueRef> value,
                                     std::optional<NDValueRef> deviceValue) {
  const NDLock lock(mutex_);
  // What was there is destroyed with the parameters, after the lock.
  if (value) values_.value.swap(*value);
  if (deviceValue) values_.deviceValue.swap(*deviceValue);
  isCurrent_ = isSameValue(values_.value, values_.deviceValue);
}

}  // namespace nidus
