#pragma once

#include <algorithm>

#include "PlatformModel/Home/NDCharacteristic.h"
#include "PlatformModel/Home/NDCharacteristicConstants.h"

namespace nidus {

/// Says whether the properties of `characteristic` let it be written.
[[nodiscard]] inline bool isWritable(const NDCharacteristic& characteristic) {
  const auto& properties = characteristic.properties();
  return std::any_of(properties.begin(), properties.end(),
                     [](const NDString& word) { return word == NDCharacteristicPropertyWritable; });
}

}  // namespace nidus
