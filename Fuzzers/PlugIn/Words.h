#pragma once

#include <array>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "PlugIn/Choices.h"

namespace nidus {

/// The few names that homes and commands share, so that commands find something, by its accents
/// or not, and so that names repeat.
inline constexpr std::array kNames = {"Home", "Küche", "Ku\u0308che", "Kuche", "", "home"};

/// Entries of the built-in vocabulary of each kind: of each value type, with one platform type or
/// two, followed or not, in the user's units or not, read alone, written alone, neither.
inline constexpr std::array kAttributes = {"POWER",        "BRIGHTNESS", "TEMPERATURE", "LOCKED",
                                           "CLIMATE_MODE", "POSITION",   "LIGHT_LEVEL", "IDENTIFY",
                                           "HUE",          "ENABLED"};
inline constexpr std::array kServiceTypes = {"LIGHT", "THERMOSTAT", "LOCK"};

/// The built-in vocabulary.
[[nodiscard]] const Vocabulary& words();
/// The built-in entry of `attribute`, which must be there.
[[nodiscard]] const CharacteristicEntry& entryOf(const NDString& attribute);
/// The platform's service type of one of `kServiceTypes`.
[[nodiscard]] NDString platformServiceType(const NDString& serviceType);

/// A boxed value of any kind, never null.
[[nodiscard]] NDValueRef chooseValue(Choices& choices);

}  // namespace nidus
