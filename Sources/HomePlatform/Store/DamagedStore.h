#pragma once

#include <chrono>
#include <filesystem>

#include "HomePlatform/Result.h"

namespace nidus {

/// Puts a copy of `backup` in the place of the database `file`, whose contents are damaged. Gives
/// the name under which the damaged one, with its log, is kept beside it. At each moment, also
/// after a power cut, `file` is the damaged database or the restored one.
///
/// The caller holds the lock of the folder, so that nobody opens the database meanwhile. Fails, and
/// leaves all as it was, where a process has it open: it would go on with the damaged file, and
/// might take the log of one for that of the other.
[[nodiscard]] Result<std::filesystem::path> replaceDamagedStore(
    const std::filesystem::path& file, const std::filesystem::path& backup,
    std::chrono::milliseconds lockTimeout);

}  // namespace nidus
