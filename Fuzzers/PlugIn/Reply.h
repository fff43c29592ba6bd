#pragma once

#include <map>
#include <string>
#include <string_view>

#include "PlatformModel/System/NDDictionary.h"
#include "PlatformModel/System/NDString.h"

namespace nidus {

// Replies and records are read in their dictionary form, as an assistant reads them.

/// The text under `key`; null when there is none.
[[nodiscard]] NDString textAt(const NDDictionary& form, std::string_view key);
/// The list under `key`; empty when there is none.
[[nodiscard]] const NDDictionaryList& listAt(const NDDictionary& form, std::string_view key);
/// The dictionary under `key`; empty when there is none.
[[nodiscard]] const NDDictionary& formAt(const NDDictionary& form, std::string_view key);
/// An element of a list of dictionaries.
[[nodiscard]] const NDDictionary& formOf(const NDDictionaryValue& value);

/// How often each outcome stands among results.
using OutcomeCounts = std::map<std::string, std::size_t>;
[[nodiscard]] OutcomeCounts outcomesOf(const NDDictionary& reply);
/// The counts on one line.
[[nodiscard]] std::string description(const OutcomeCounts& counts);

}  // namespace nidus
