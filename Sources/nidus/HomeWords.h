#pragma once

#include <string>

#include "HomePlatform/HomePlatform.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Says what services and characteristics are and have, in the words of orders and answers.
///
///     const HomeWords words(platform);
///     words.attributeOf(lamp.characteristicType);  // "BRIGHTNESS"
///     words.valueOf(lamp, lamp.value);             // "65 %"
class HomeWords {
 public:
  /// `platform` must outlive this.
  explicit HomeWords(HomePlatform& platform);

  /// The type of a service; one that the vocabulary does not have is given as it is.
  [[nodiscard]] std::string serviceTypeOf(const NDString& type) const;
  /// The attribute of a characteristic type; what is only written is its target. A type that the
  /// vocabulary does not have is given as it is.
  [[nodiscard]] std::string attributeOf(const NDString& type) const;
  /// A value, which may be null, of `characteristic` in its own unit.
  [[nodiscard]] std::string valueOf(const CharacteristicData& characteristic,
                                    const NDValueRef& value) const;
  /// Its limits, such as "0 % to 100 %"; empty when it has none.
  [[nodiscard]] std::string limitsOf(const CharacteristicData& characteristic) const;

 private:
  const Vocabulary& vocabulary_;
  const std::shared_ptr<NDNAPMetadata> metadata_;
};

}  // namespace nidus
