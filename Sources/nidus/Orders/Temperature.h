#pragma once

#include "HomePlatform/Metadata/Vocabulary.h"

namespace nidus {

/// What the value of an order is for, as a temperature is sent differently for each.
enum class ValueUse {
  value,       ///< To be set.
  question,    ///< To be compared with what is read.
  difference,  ///< To be added to what is read, or taken from it.
};

/// A temperature, or a difference of two.
struct Degrees {
  double number = 0;
  NDString unit;  ///< The platform's name; null when none is said.
};

/// Whether a platform's unit, which may be null, is one of temperatures.
[[nodiscard]] bool isTemperatureUnit(const NDString& unit);
/// Whether the values of an attribute are temperatures.
[[nodiscard]] bool isTemperature(const CharacteristicEntry& entry);

/// Whether the plug-in takes a value of this attribute that comes without a unit in the device's
/// own unit. It does so for temperatures in general, but on a device that speaks Fahrenheit it
/// knows TEMPERATURE alone.
[[nodiscard]] bool isOwnUnitUnderstood(const CharacteristicEntry& entry, bool isMetric);

/// How to send what a person meant by `degrees`, without a unit in the device's own: as it stands
/// where the plug-in understands it, else in the unit of the attribute or, for a difference that it
/// does understand, in that of the device.
[[nodiscard]] Degrees degreesToSend(const Degrees& degrees, ValueUse use,
                                    const CharacteristicEntry& entry, bool isMetric);

}  // namespace nidus
