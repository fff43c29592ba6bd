#pragma once

#include <cstdint>
#include <memory>
#include <vector>

#include "PlatformModel/Home/NDCharacteristicMetadata.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

class NDService;

/// One readable or writable value of a service. Implemented by the platform; owned by its service;
/// may be read from any thread. Only the cached value changes.
class ND_EXPORT NDCharacteristic {
 public:
  virtual ~NDCharacteristic();
  /// Unique among the characteristics of the accessory, from 1 to 2^63-1.
  [[nodiscard]] virtual std::int64_t instanceID() const = 0;
  /// The platform's type text, never null.
  [[nodiscard]] virtual const NDString& characteristicType() const = 0;
  /// The property words, such as `NDCharacteristicPropertyWritable`; none is null.
  [[nodiscard]] virtual const std::vector<NDString>& properties() const = 0;
  /// Null when the characteristic has no metadata.
  [[nodiscard]] virtual const std::shared_ptr<const NDCharacteristicMetadata>& metadata() const = 0;
  /// The cached value: what the platform knew last; may be null. Reads and writes that succeed
  /// change it before their completion runs.
  [[nodiscard]] virtual NDValueRef value() const = 0;
  /// The service that holds the characteristic; null once its home is gone.
  [[nodiscard]] virtual std::shared_ptr<NDService> service() const = 0;
};

}  // namespace nidus
