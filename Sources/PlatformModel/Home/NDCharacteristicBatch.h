#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <vector>

#include "PlatformModel/Home/NDCharacteristic.h"
#include "PlatformModel/Home/NDError.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// One value to be written.
struct NDCharacteristicWriteRequestTuple {
  std::shared_ptr<NDCharacteristic> characteristic;  ///< Never null.
  NDValueRef value;                                  ///< May be null.

  [[nodiscard]] static NDCharacteristicWriteRequestTuple tupleWithCharacteristic_value(
      std::shared_ptr<NDCharacteristic> characteristic, NDValueRef value) {
    return {std::move(characteristic), std::move(value)};
  }
};

/// What became of one characteristic of a batch.
struct NDCharacteristicResponse {
  std::shared_ptr<NDCharacteristic> characteristic;  ///< Never null.
  std::optional<NDError> error;                      ///< None on success.
};

/// Receives the end of a batch, exactly once, on a thread of the platform: an error of the batch as
/// a whole, or none, and one response per characteristic in the order asked (none with an error).
using NDBatchCompletion = std::function<void(
    const std::optional<NDError>& error, const std::vector<NDCharacteristicResponse>& responses)>;

/// Receives the end of a scene, exactly once, on a thread of the platform.
using NDExecuteCompletion = std::function<void(const std::optional<NDError>& error)>;

}  // namespace nidus
