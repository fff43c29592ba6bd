#pragma once

#include <unordered_map>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "PlatformModel/Home/NDNAPMetadata.h"

namespace nidus {

/// Translates by the tables of a vocabulary. Immutable; may be used from any thread.
class MetadataMapper final : public NDNAPMetadata {
 public:
  explicit MetadataMapper(Vocabulary vocabulary);
  MetadataMapper(const MetadataMapper&) = delete;
  MetadataMapper& operator=(const MetadataMapper&) = delete;

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

  /// The tables, for those who list them.
  [[nodiscard]] const Vocabulary& vocabulary() const noexcept { return vocabulary_; }

  /// The type whose characteristic on the same service follows what is written to one of type
  /// `writtenType`; null when none does.
  [[nodiscard]] NDString followingType(const NDString& writtenType) const;

 private:
  using Names = std::unordered_map<NDString, NDString>;
  using Entries = std::unordered_map<NDString, const CharacteristicEntry*>;

  /// The entry of an assistant name or a platform type, or of a type alone; null for none.
  [[nodiscard]] const CharacteristicEntry* entryOf(const NDString& nameOrType) const;
  [[nodiscard]] const CharacteristicEntry* entryOfType(const NDString& type) const;

  const Vocabulary vocabulary_;
  Names serviceTypesByName_;
  Names serviceNamesByType_;
  Names unitsByName_;
  Names unitNamesByUnit_;
  Entries entriesByName_;
  Entries entriesByType_;
};

}  // namespace nidus
