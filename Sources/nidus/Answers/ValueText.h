#pragma once

#include <string>
#include <string_view>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "PlatformModel/System/NDDictionary.h"

namespace nidus {

/// A unit behind a number: " %", " °C", "°", " lx". `unit` is the name that the assistant or the
/// platform uses, in either case; of a unit without a sign the name; nothing for an empty name.
[[nodiscard]] std::string unitSuffix(std::string_view unit);

/// A boolean as people say it: "on" or "off" of what is switched, else "yes" or "no".
[[nodiscard]] std::string booleanText(bool value, std::string_view attribute);

/// A number of people: at most two digits behind the point, where that leaves something.
[[nodiscard]] std::string shortNumberText(float number);

/// The entry of the attribute; null when the vocabulary has none.
[[nodiscard]] const CharacteristicEntry* entryOfAttribute(const Vocabulary& vocabulary,
                                                          std::string_view attribute);

/// A value of `attribute` for people, such as "65 %", "21.5 °C", "on", "heat". `value` is in
/// dictionary form, as in replies; without units of its own it has those of the attribute, unless
/// they depend on the locale. Empty for an empty `value`, "unknown" for a text that is null.
[[nodiscard]] std::string valueText(const NDDictionary& value, std::string_view attribute,
                                    const Vocabulary& vocabulary);

/// The same of a limit, whose units are always those of the device.
[[nodiscard]] std::string limitText(const NDDictionary& limit, std::string_view attribute,
                                    const Vocabulary& vocabulary);

}  // namespace nidus
