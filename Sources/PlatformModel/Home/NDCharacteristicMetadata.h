#pragma once

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// What a characteristic says of its own values. Implemented by the platform; immutable; may be
/// read from any thread. Each property may be null.
class ND_EXPORT NDCharacteristicMetadata {
 public:
  virtual ~NDCharacteristicMetadata();
  [[nodiscard]] virtual const NDString& format() const = 0;
  [[nodiscard]] virtual const NDString& units() const = 0;
  [[nodiscard]] virtual const NDValueRef& minimumValue() const = 0;
  [[nodiscard]] virtual const NDValueRef& maximumValue() const = 0;
  [[nodiscard]] virtual const NDValueRef& stepValue() const = 0;
};

}  // namespace nidus
