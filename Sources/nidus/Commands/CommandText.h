#pragma once

#include <string_view>

namespace nidus {

/// Whether there is nothing but white space in `line`.
[[nodiscard]] bool isBlank(std::string_view line);

/// Whether a file of commands, given as its first `kBytesToJudge` bytes, is to be read as one
/// command over several lines, not line by line: it is one whole JSON text, or it was meant to be
/// one, as its first line leaves a bracket open and no line is a command of its own.
[[nodiscard]] bool isOneDocument(std::string_view text);

}  // namespace nidus
