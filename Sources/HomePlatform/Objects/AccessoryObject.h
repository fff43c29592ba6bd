#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <utility>
#include <vector>

#include "HomePlatform/Objects/HomePart.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

class AccessoryObject;
class CharacteristicObject;
class ServiceObject;

/// A characteristic with all that holds it; all null when there is none. They live as long as the
/// accessory.
struct FoundCharacteristic {
  const AccessoryObject* accessory = nullptr;
  const ServiceObject* service = nullptr;
  CharacteristicObject* characteristic = nullptr;
};

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

  /// The service of that instance ID; null when there is none. Valid as long as the accessory.
  [[nodiscard]] const std::shared_ptr<NDService>& findService(std::int64_t instanceID) const;
  /// The characteristic of those instance IDs.
  [[nodiscard]] FoundCharacteristic find(std::int64_t service, std::int64_t characteristic) const;

 private:
  void sortParts();

  const std::weak_ptr<NDRoom> room_;
  // Complete when `make` returns.
  NDArray<NDService> services_;
  std::vector<std::pair<std::int64_t, std::size_t>> serviceIndexes_;  ///< By instance ID, sorted.
  /// All characteristics side by side, because batches look up one after the other; sorted.
  struct Place {
    std::int64_t serviceID;
    std::int64_t characteristicID;
    FoundCharacteristic found;

    static bool isBefore(const Place& a, const Place& b) {
      return std::pair(a.serviceID, a.characteristicID) <
             std::pair(b.serviceID, b.characteristicID);
    }
  };
  std::vector<Place> places_;
};

}  // namespace nidus
