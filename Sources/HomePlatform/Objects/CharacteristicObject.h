#pragma once

#include <atomic>
#include <memory>
#include <optional>

#include "HomePlatform/Objects/MetadataObject.h"
#include "HomePlatform/Store/HomeData.h"
#include "PlatformModel/Home/NDCharacteristic.h"
#include "PlatformModel/Home/NDService.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {

/// One characteristic of a loaded home. All but its two values is immutable.
class CharacteristicObject final : public NDCharacteristic {
 public:
  CharacteristicObject(std::shared_ptr<const CharacteristicData> data,
                       const CharacteristicAddress& address, std::weak_ptr<NDService> service);

  [[nodiscard]] std::int64_t instanceID() const override { return data_->instanceID; }
  [[nodiscard]] const NDString& characteristicType() const override {
    return data_->characteristicType;
  }
  [[nodiscard]] const std::vector<NDString>& properties() const override {
    return data_->properties;
  }
  [[nodiscard]] const std::shared_ptr<const NDCharacteristicMetadata>& metadata() const override {
    return metadata_;
  }
  [[nodiscard]] NDValueRef value() const override;
  [[nodiscard]] std::shared_ptr<NDService> service() const override { return service_.lock(); }

  /// As it was loaded: its values are out of date.
  [[nodiscard]] const CharacteristicData& data() const { return *data_; }
  [[nodiscard]] const CharacteristicAddress& address() const { return address_; }

  [[nodiscard]] bool isReadable() const noexcept { return isReadable_; }
  [[nodiscard]] bool isWritable() const noexcept { return isWritable_; }

  /// The cached value and what the accessory would answer now.
  struct Values {
    NDValueRef value;
    NDValueRef deviceValue;
  };
  [[nodiscard]] Values values() const;
  /// Takes the values that there are.
  void setValues(std::optional<NDValueRef> value, std::optional<NDValueRef> deviceValue);
  /// Whether the accessory would answer with the cached value; takes no lock.
  [[nodiscard]] bool isCurrent() const noexcept { return isCurrent_; }

 private:
  const std::shared_ptr<const CharacteristicData> data_;
  const CharacteristicAddress address_;
  const std::weak_ptr<NDService> service_;
  const std::shared_ptr<const NDCharacteristicMetadata> metadata_;
  // As the properties say.
  const bool isReadable_;
  const bool isWritable_;
  mutable NDMutex mutex_;
  Values values_ ND_GUARDED_BY(mutex_);
  std::atomic<bool> isCurrent_;
};

}  // namespace nidus
