#pragma once

#include <cstdint>
#include <memory>
#include <optional>

#include "PlatformModel/Home/NDCharacteristic.h"
#include "PlatformModel/System/NDArray.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDUUID.h"

namespace nidus {

/// Finds the first element of `list` with that UUID; null when there is none, or no UUID.
template <class T>
[[nodiscard]] std::shared_ptr<T> findInArrayByUUID(const NDArray<T>& list,
                                                   const std::optional<NDUUID>& uuid) {
  if (!uuid) return nullptr;
  for (const auto& element : list) {
    if (element->uuid() == *uuid) return element;
  }
  return nullptr;
}

/// Finds the first element of `list` with that instance ID; null when there is none, or no number.
template <class T>
[[nodiscard]] std::shared_ptr<T> findInArrayByInstanceID(
    const NDArray<T>& list, const std::optional<std::int64_t>& instanceID) {
  if (!instanceID) return nullptr;
  for (const auto& element : list) {
    if (element->instanceID() == *instanceID) return element;
  }
  return nullptr;
}

/// Finds the first characteristic of that type; null when there is none, or no type.
[[nodiscard]] inline std::shared_ptr<NDCharacteristic> findInArrayByCharacteristicType(
    const NDArray<NDCharacteristic>& list, const NDString& type) {
  if (!type) return nullptr;
  for (const auto& characteristic : list) {
    if (characteristic->characteristicType() == type) return characteristic;
  }
  return nullptr;
}

}  // namespace nidus
