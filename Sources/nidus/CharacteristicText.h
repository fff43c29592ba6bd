#pragma once

#include <string>

#include "HomePlatform/HomePlatform.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Says what characteristics are and have, in the words of orders and answers.
///
///     const CharacteristicText text(platform);
///     text.attributeOf(lamp.characteristicType);  // "BRIGHTNESS"
///     text.valueOf(lamp, lamp.value);             // "65 %"
class CharacteristicText {
 public:
  /// `platform` must outlive this.
  explicit CharacteristicText(HomePlatform& platform);

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
