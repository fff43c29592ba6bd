#pragma once

#include <memory>

#include "HomePlatform/Objects/HomePart.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

class ServiceObject;

/// One accessory of a loaded home.
class AccessoryObject final : public HomePart<NDAccessory, AccessoryData> {
 public:
  /// Makes the accessory and all that is in it.
  [[nodiscard]] static std::shared_ptr<AccessoryObject> make(
      const std::shared_ptr<const AccessoryData>& data, std::weak_ptr<NDHome> home,
      std::weak_ptr<NDRoom> room);
  /// For `make` alone.
  AccessoryObject(std::shared_ptr<const AccessoryData> data, std::weak_ptr<NDHome> home,
                  std::weak_ptr<NDRoom> room);

  [[nodiscard]] const NDArray<NDService>& services() const override { return services_; }
  [[nodiscard]] std::shared_ptr<NDRoom> room() const override { return room_.lock(); }

  /// The service of that instance ID; null when there is none.
  [[nodiscard]] std::shared_ptr<NDService> find(std::int64_t instanceID) const;

 private:
  const std::weak_ptr<NDRoom> room_;
  NDArray<NDService> services_;  ///< Complete when `make` returns.
};

}  // namespace nidus
