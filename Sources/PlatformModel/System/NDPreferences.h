#pragma once

#include <cstdint>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

/// The preference store of the device. Supplied by the platform; may be called from any thread.
class ND_EXPORT NDPreferences {
 public:
  /// What a boolean read found.
  struct BooleanReading {
    bool value = false;                ///< The value; false unless `keyExistsAndIsValid`.
    bool keyExistsAndIsValid = false;  ///< Whether the key exists and holds a boolean.
  };

  virtual ~NDPreferences();

  /// Reads a boolean of an application domain inside a container. All three texts are never null.
  [[nodiscard]] virtual BooleanReading booleanForKey_domain_container(
      const NDString& key, const NDString& domain, const NDString& containerPath) = 0;

  /// Takes in what other processes have changed in the host process's standard preferences.
  virtual void synchronize() = 0;

  /// Reads an integer of the standard preferences; 0 when the key is missing or holds no integer.
  [[nodiscard]] virtual std::int64_t integerForKey(const NDString& key) = 0;
};

}  // namespace nidus
