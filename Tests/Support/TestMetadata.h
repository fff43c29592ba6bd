#pragma once

#include <string_view>

#include "PlatformModel/Home/NDNAPMetadata.h"

namespace nidus {

/// A mapper that knows the few names and types that tests use, in tables.
class TestMetadata final : public NDNAPMetadata {
 public:
  [[nodiscard]] NDString mapFromAssistantServiceName(const NDString& name) const override;
  [[nodiscard]] NDString mapToAssistantServiceName(const NDString& type) const override;
  [[nodiscard]] NDString mapToAssistantCharacteristicName(const NDString& type) const override;
  [[nodiscard]] NDString mapReadCharcteristicFromAssistantName(const NDString& name) const override;
  [[nodiscard]] NDString mapWriteCharcteristicFromAssistantName(
      const NDString& name) const override;
  [[nodiscard]] NDString mapCharacteristicValueType(const NDString& name) const override;
  [[nodiscard]] NDString mapFromAssistantUnitName(const NDString& name) const override;
  [[nodiscard]] NDString mapToAssistantUnitName(const NDString& unit) const override;
  [[nodiscard]] NDString characteristicValueUnit(const NDString& type) const override;
  [[nodiscard]] bool supportsLocalization(const NDString& type) const override;
  [[nodiscard]] NDValueRef mapFromAssistantCharacteristicValue_name(
      const NDValueRef& value, const NDString& name) const override;
  [[nodiscard]] NDValueRef mapToAssistantCharacteristicValue_name(
      const NDValueRef& value, const NDString& name) const override;
};

}  // namespace nidus
