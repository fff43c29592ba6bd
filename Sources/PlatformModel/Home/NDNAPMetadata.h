#pragma once

#include <memory>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDString.h"
#include "PlatformModel/System/NDValue.h"

namespace nidus {

/// Translates between the assistant's vocabulary and the platform's types. Implemented by the
/// platform; may be called from any thread.
///
/// Every argument and result may be null; null and unknown names map to null. Wherever an assistant
/// attribute name is taken, a platform characteristic type is taken too.
class ND_EXPORT NDNAPMetadata {
 public:
  virtual ~NDNAPMetadata();

  /// The mapper of the registered platform; null when none is registered.
  [[nodiscard]] static std::shared_ptr<NDNAPMetadata> getSharedInstance();

  /// Service names and platform service types.
  [[nodiscard]] virtual NDString mapFromAssistantServiceName(const NDString& name) const = 0;
  [[nodiscard]] virtual NDString mapToAssistantServiceName(const NDString& type) const = 0;

  /// Attribute names and platform characteristic types.
  [[nodiscard]] virtual NDString mapToAssistantCharacteristicName(const NDString& type) const = 0;
  [[nodiscard]] virtual NDString mapReadCharcteristicFromAssistantName(
      const NDString& name) const = 0;
  [[nodiscard]] virtual NDString mapWriteCharcteristicFromAssistantName(
      const NDString& name) const = 0;
  /// The format name of the values that the assistant sees for an attribute.
  [[nodiscard]] virtual NDString mapCharacteristicValueType(const NDString& name) const = 0;

  /// Unit names.
  [[nodiscard]] virtual NDString mapFromAssistantUnitName(const NDString& name) const = 0;
  [[nodiscard]] virtual NDString mapToAssistantUnitName(const NDString& unit) const = 0;

  /// The platform unit of a characteristic type.
  [[nodiscard]] virtual NDString characteristicValueUnit(const NDString& type) const = 0;
  /// Whether the values of a characteristic type follow the user's unit system; false for null.
  [[nodiscard]] virtual bool supportsLocalization(const NDString& type) const = 0;

  /// A value as the other side expresses it; the very same object where nothing is mapped.
  [[nodiscard]] virtual NDValueRef mapFromAssistantCharacteristicValue_name(
      const NDValueRef& value, const NDString& name) const = 0;
  [[nodiscard]] virtual NDValueRef mapToAssistantCharacteristicValue_name(
      const NDValueRef& value, const NDString& name) const = 0;
};

}  // namespace nidus
