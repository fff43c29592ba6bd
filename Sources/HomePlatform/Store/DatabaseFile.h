#pragma once

#include <filesystem>

#include "HomePlatform/Result.h"

namespace nidus {

/// Makes the folder of `file` and an empty `file` where they are missing, for their owner alone,
/// and checks that both may be written. Gives none when all is well.
[[nodiscard]] Status prepareDatabaseFile(const std::filesystem::path& file);

/// Removes `file`, if it is there, and what the engine keeps beside it. Nobody may be using it.
void removeDatabaseFile(const std::filesystem::path& file);

}  // namespace nidus
