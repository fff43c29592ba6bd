#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "HomePlatform/Metadata/Vocabulary.h"
#include "nidus/Terminal/Terminal.h"

namespace nidus {

/// The entries whose assistant name is `word` or, when there is none, those whose assistant name or
/// one of whose values contains it; the case of ASCII letters does not matter.
[[nodiscard]] Vocabulary entriesMatching(const Vocabulary& vocabulary, std::string_view word);

/// The assistant names of all entries; they point into `vocabulary`.
[[nodiscard]] std::vector<std::string_view> wordsOf(const Vocabulary& vocabulary);

/// All words of a vocabulary for people who write orders: the attributes with their values, and the
/// types and units.
[[nodiscard]] std::string vocabularyText(const Vocabulary& vocabulary, const TerminalStyle& style);

/// Everything about each entry of a vocabulary, several lines each, the platform's types included.
[[nodiscard]] std::string vocabularyDetails(const Vocabulary& vocabulary);

}  // namespace nidus
