#pragma once

#include <chrono>
#include <filesystem>
#include <optional>

#include "HomePlatform/Result.h"

namespace nidus {

/// Puts a copy of `backup` in the place of the database `file` when the contents of that are
/// damaged. Gives the name under which the damaged one, with its log, is kept beside it, byte for
/// byte; none when it is not known to be damaged: it is sound, or cannot be looked at. At each
/// moment, also after a power cut, `file` is the damaged database or the restored one.
///
/// The caller holds the lock of the folder, so that nobody opens the database meanwhile, and does
/// not have it open. Fails, and leaves all as it was, where another process has a damaged one open:
/// it would go on with the damaged file, and might take the log of one for that of the other.
[[nodiscard]] Result<std::optional<std::filesystem::path>> replaceDamagedStore(
    const std::filesystem::path& file, const std::filesystem::path& backup,
    std::chrono::milliseconds lockTimeout);

}  // namespace nidus
