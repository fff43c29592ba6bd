#pragma once

#include <cstdint>
#include <memory>

#include "PlatformModel/Home/NDCharacteristic.h"
#include "PlatformModel/System/NDArray.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

class NDAccessory;

/// One function of an accessory, such as a light. Implemented by the platform; owned by its
/// accessory; immutable; may be read from any thread. Equality is identity.
class ND_EXPORT NDService {
 public:
  virtual ~NDService();
  /// Unique among the services of the accessory, from 1 to 2^63-1.
  [[nodiscard]] virtual std::int64_t instanceID() const = 0;
  /// May be null.
  [[nodiscard]] virtual const NDString& name() const = 0;
  /// The platform's type text, never null.
  [[nodiscard]] virtual const NDString& serviceType() const = 0;
  /// The type of what is plugged into the service, such as a light in an outlet; may be null.
  [[nodiscard]] virtual const NDString& associatedServiceType() const = 0;
  [[nodiscard]] virtual const NDArray<NDCharacteristic>& characteristics() const = 0;
  /// The accessory that holds the service; null once its home is gone.
  [[nodiscard]] virtual std::shared_ptr<NDAccessory> accessory() const = 0;
};

}  // namespace nidus
