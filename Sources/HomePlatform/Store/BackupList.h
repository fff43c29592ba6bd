#pragma once

#include <filesystem>
#include <optional>
#include <vector>

#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// The backups of the database `file`, which stand beside it, the newest first; good or not.
[[nodiscard]] std::vector<std::filesystem::path> backupsOf(const std::filesystem::path& file);

/// The name that the next backup gets.
[[nodiscard]] std::filesystem::path nextBackupOf(const std::filesystem::path& file);

/// The homes that can be restored from a backup, as they would be after its migration; at least
/// one. None when it is not good: it cannot be read, its contents are not sound, or it is of
/// another program or a newer version of this one. Leaves it as it is.
[[nodiscard]] std::optional<std::vector<HomeData>> homesOfBackup(
    const std::filesystem::path& backup);

/// The newest of the backups of the database `file` that are good.
[[nodiscard]] std::optional<std::filesystem::path> newestGoodBackupOf(
    const std::filesystem::path& file);

}  // namespace nidus
