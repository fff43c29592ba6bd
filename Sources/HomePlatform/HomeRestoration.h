#pragma once

#include <chrono>
#include <filesystem>
#include <optional>
#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"
#include "HomePlatform/Store/HomeStore.h"

namespace nidus {

/// What a restoration has done.
struct HomeRestoration {
  std::vector<HomeData> homes;  ///< The homes as they are now.
  /// Where the damaged database is kept; none when it was sound: then its homes, if there were any,
  /// are the newest backup now.
  std::optional<std::filesystem::path> damaged = std::nullopt;
};

/// Puts the homes of `backup`, one of the backups in the data folder, in place of all homes, and
/// sets "kHomesConfigured" as an import does.
///
/// A sound database is changed in one transaction, whoever has it open. A damaged one is replaced
/// as a file, and only when nobody has it open; this process must not. Fails and leaves all as it
/// was when the backup is not good, or when the database is of another program or a newer version.
[[nodiscard]] Result<HomeRestoration> restoreHomes(
    const std::filesystem::path& folder, const std::filesystem::path& backup,
    std::chrono::milliseconds lockTimeout = HomeStore::kLockTimeout);

}  // namespace nidus
