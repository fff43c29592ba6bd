#pragma once

#include <filesystem>
#include <string_view>

#include "HomePlatform/Result.h"

namespace nidus {

/// Puts `text` into `file` so that everybody, also after a power cut, finds there the old content
/// or the new, never a part. A new file gets the usual permissions, an old one keeps its own; a
/// link is followed. What is no ordinary file (a pipe, a terminal) is written to as it is. A
/// failure, as the platform's, names the file.
[[nodiscard]] Status replaceFile(const std::filesystem::path& file, std::string_view text);

/// The failure, as the platform's, that `file` could not be written; `error` is the number of the
/// reason.
[[nodiscard]] Failure unwritable(const std::filesystem::path& file, int error);

}  // namespace nidus
