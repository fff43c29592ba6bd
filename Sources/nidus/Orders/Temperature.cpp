#include "nidus/Orders/Temperature.h"

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Home/NDCharacteristicConstants.h"

namespace nidus {
namespace {

const NDString& celsius() {
  static const NDString kCelsius = NDCharacteristicMetadataUnitsCelsius;
  return kCelsius;
}

const NDString& fahrenheit() {
  static const NDString kFahrenheit = NDCharacteristicMetadataUnitsFahrenheit;
  return kFahrenheit;
}

Degrees converted(const Degrees& degrees, const NDString& unit) {
  if (degrees.unit == unit) return degrees;
  if (unit == celsius()) return {(degrees.number - 32.0) * 5.0 / 9.0, unit};
  return {degrees.number * 1.8 + 32.0, unit};
}

Degrees convertedDifference(const Degrees& degrees, const NDString& unit) {
  if (degrees.unit == unit) return degrees;
  if (unit == celsius()) return {degrees.number * 5.0 / 9.0, unit};
  return {degrees.number * 1.8, unit};
}

/// The unit in which the device tells and takes values of an attribute.
const NDString& ownUnit(const CharacteristicEntry& entry, bool isMetric) {
  if (!entry.localized) return entry.unit;
  return isMetric ? celsius() : fahrenheit();
}

Degrees differenceToSend(const Degrees& said, const CharacteristicEntry& entry, bool isMetric) {
  if (!isOwnUnitUnderstood(entry, isMetric)) return convertedDifference(said, entry.unit);
  return {convertedDifference(said, ownUnit(entry, isMetric)).number, nullptr};
}

}  // namespace

bool isTemperatureUnit(const NDString& unit) { return unit == celsius() || unit == fahrenheit(); }

bool isTemperature(const CharacteristicEntry& entry) { return isTemperatureUnit(entry.unit); }

bool isOwnUnitUnderstood(const CharacteristicEntry& entry, bool isMetric) {
  return isMetric || !entry.localized || entry.assistantName == VAHAAttributeTEMPERATUREValue;
}

Degrees degreesToSend(const Degrees& degrees, ValueUse use, const CharacteristicEntry& entry,
                      bool isMetric) {
  const bool isAsked = use == ValueUse::question;
  const bool hasUnit = static_cast<bool>(degrees.unit);
  if (!hasUnit && (isAsked || isOwnUnitUnderstood(entry, isMetric))) return degrees;
  // What is read is converted to the unit of the question before the two are compared.
  if (isAsked && entry.localized) return degrees;
  const Degrees said = {degrees.number, hasUnit ? degrees.unit : ownUnit(entry, isMetric)};
  if (use == ValueUse::difference) return differenceToSend(said, entry, isMetric);
  return converted(said, entry.unit);
}

}  // namespace nidus
