#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace nidus {

/// What the key for completion does to a line.
struct LineCompletion {
  std::size_t replaced = 0;          ///< How many bytes before the cursor go.
  std::string text;                  ///< What comes in their place.
  std::vector<std::string> choices;  ///< What to show instead, when there is nothing to add.
};

/// Completes the last word of `line`, which ends at the cursor, to one of `words`: the whole word,
/// its quote closed and a space behind it, when there is only one; else as far as they agree.
[[nodiscard]] LineCompletion lineCompletion(std::string_view line,
                                            const std::vector<std::string>& words);

/// The files and folders whose path begins with `start`; a folder ends with a slash. Hidden ones
/// only where their dot is in `start`.
[[nodiscard]] std::vector<std::string> filesThatBeginWith(const std::string& start);

}  // namespace nidus
