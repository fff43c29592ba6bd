#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "PlatformModel/System/NDDictionary.h"

namespace nidus {

/// Texts in the order in which they came, each once.
using DistinctTexts = std::vector<std::string>;

/// All texts under `key` in records of the plug-in, such as "objectRoom".
[[nodiscard]] DistinctTexts textsUnder(std::string_view key, const NDDictionaryList& records);

/// The records whose "objectType" is `type`.
[[nodiscard]] NDDictionaryList recordsOfType(std::string_view type,
                                             const NDDictionaryList& records);

/// The names of records for a sentence, each as often as it comes, the first ones of many: "Lamp,
/// Door and 7 more".
[[nodiscard]] std::string namesOf(const NDDictionaryList& records);

/// Texts for a sentence, the first ones of many.
[[nodiscard]] std::string enumeration(const std::vector<std::string>& texts);

}  // namespace nidus
