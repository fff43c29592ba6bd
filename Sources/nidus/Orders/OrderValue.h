#pragma once

#include <string>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "HomePlatform/Result.h"
#include "PlatformModel/Assistant/VAHAValue.h"
#include "nidus/Orders/Temperature.h"

namespace nidus {

/// Reads the values of orders as people write them.
///
///     const OrderValueReader values(vocabulary, isMetric);
///     auto value = values.read("70F", temperature, ValueUse::value);  // 21.11…, CELSIUS
class OrderValueReader {
 public:
  /// `vocabulary` must outlive this.
  OrderValueReader(const Vocabulary& vocabulary, bool isMetric)
      : vocabulary_(vocabulary), isMetric_(isMetric) {}

  /// The value of the class, and a temperature in the unit, in which the plug-in takes what
  /// `text` means as a value of the attribute of `entry`; never null. A failure is bad input and
  /// says what was expected.
  [[nodiscard]] Result<VAHAValueRef> read(const std::string& text, const CharacteristicEntry& entry,
                                          ValueUse use) const;

  /// The value that sets to a limit, which is in the attribute's own unit. `number`, never null,
  /// is of the attribute's value type.
  [[nodiscard]] VAHAValueRef ofLimit(const NDValueRef& number,
                                     const CharacteristicEntry& entry) const;

 private:
  [[nodiscard]] VAHAValueRef readNumber(const std::string& text, const CharacteristicEntry& entry,
                                        ValueUse use) const;
  [[nodiscard]] VAHAValueRef temperature(double number, const NDString& unit,
                                         const CharacteristicEntry& entry, ValueUse use) const;
  [[nodiscard]] NDString assistantUnit(const NDString& unit) const;

  const Vocabulary& vocabulary_;
  const bool isMetric_;
};

/// Whether values of the attribute are numbers.
[[nodiscard]] bool isNumeric(const CharacteristicEntry& entry);

}  // namespace nidus
