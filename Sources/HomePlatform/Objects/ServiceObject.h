#pragma once

#include <memory>

#include "HomePlatform/Store/HomeData.h"
#include "PlatformModel/Home/NDAccessory.h"
#include "PlatformModel/Home/NDService.h"

namespace nidus {

/// One service of a loaded home.
class ServiceObject final : public NDService {
 public:
  /// Makes the service and all that is in it. `accessoryID` is the UUID of `accessory`.
  [[nodiscard]] static std::shared_ptr<ServiceObject> make(
      const std::shared_ptr<const ServiceData>& data, const NDUUID& accessoryID,
      std::weak_ptr<NDAccessory> accessory);
  /// For `make` alone.
  ServiceObject(std::shared_ptr<const ServiceData> data, std::weak_ptr<NDAccessory> accessory);

  [[nodiscard]] std::int64_t instanceID() const override { return data_->instanceID; }
  [[nodiscard]] const NDString& name() const override { return data_->name; }
  [[nodiscard]] const NDString& serviceType() const override { return data_->serviceType; }
  [[nodiscard]] const NDString& associatedServiceType() const override {
    return data_->associatedServiceType;
  }
  [[nodiscard]] const NDArray<NDCharacteristic>& characteristics() const override {
    return characteristics_;
  }
  [[nodiscard]] std::shared_ptr<NDAccessory> accessory() const override {
    return accessory_.lock();
  }

 private:
  const std::shared_ptr<const ServiceData> data_;
  const std::weak_ptr<NDAccessory> accessory_;
  NDArray<NDCharacteristic> characteristics_;  ///< Complete when `make` returns.
};

}  // namespace nidus
