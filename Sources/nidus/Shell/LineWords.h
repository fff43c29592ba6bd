#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

#include "HomePlatform/Result.h"

namespace nidus {

/// Takes a line apart into words by the quoting rules of a shell: white space parts words; '...'
/// keeps everything; "..." keeps everything but a backslash before one of \ " $ `; elsewhere a
/// backslash keeps the character that follows; a # that begins a word begins a comment. Nothing is
/// expanded. Empty for a line without words. A failure, as bad input, names the open quote.
[[nodiscard]] Result<std::vector<std::string>> wordsOf(std::string_view line);

/// A line up to the place where it is being typed.
struct UnfinishedLine {
  std::vector<std::string> words;  ///< The last one is unfinished, may be empty, is always there.
  std::string typed;               ///< The last word as it was typed, with its quotes.
  char quote = 0;                  ///< The quote that is open at the end: ' or " or none.
};

[[nodiscard]] UnfinishedLine unfinishedLineOf(std::string_view line);

/// The last word of `line` as it has to be typed to become `word`; a quote that is open stays open.
[[nodiscard]] std::string typedFormOf(const std::string& word, const UnfinishedLine& line);

}  // namespace nidus
