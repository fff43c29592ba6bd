#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "HomePlatform/Result.h"

namespace nidus {

/// A word as the vocabulary writes its own: "air purifier" and "air-purifier" are "AIR_PURIFIER".
[[nodiscard]] std::string vocabularyWord(std::string_view word);

/// A person's word as it begins a message: itself, or two quotation marks for the empty one.
[[nodiscard]] std::string shownWord(const std::string& word);

/// Gives the one of `known` that `word` is, or is apart from its writing; null when it is none.
[[nodiscard]] const std::string_view* findWord(std::string_view word,
                                               const std::vector<std::string_view>& known);

/// The failure for a word that is none of `known`: suggests a near miss, else says `otherwise`.
[[nodiscard]] Failure unknownWord(const std::string& word,
                                  const std::vector<std::string_view>& known,
                                  const std::string& otherwise);

/// Both in one: the word of `known`, or the failure.
[[nodiscard]] Result<std::string> chooseWord(const std::string& word,
                                             const std::vector<std::string_view>& known,
                                             const std::string& otherwise);

}  // namespace nidus
