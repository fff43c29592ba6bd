#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "HomePlatform/Metadata/Vocabulary.h"

namespace nidus {

/// The words for values, all that the help of the orders states.

/// Reads a word for yes or no, in either case: "on", "yes", "true" and their opposites for every
/// attribute, and those of the attribute itself, such as "locked". None for another word.
[[nodiscard]] std::optional<bool> booleanOf(std::string_view word, std::string_view attribute);

/// The texts that the attribute takes, in the order of the vocabulary; empty when it takes any.
[[nodiscard]] std::vector<std::string_view> textsOf(const CharacteristicEntry& entry);

/// What the attribute takes, for a message: "a whole number, such as 40 or 40%".
[[nodiscard]] std::string expectationOf(const CharacteristicEntry& entry);

}  // namespace nidus
