#include "HomePlatform/HomeRestoration.h"

#include <system_error>
#include <utility>

#include "HomePlatform/HomePlatform.h"
#include "HomePlatform/Store/BackupList.h"
#include "HomePlatform/Store/DamagedStore.h"
#include "HomePlatform/System/DataFolder.h"
#include "HomePlatform/System/Preferences.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;

/// The preferences of the folder, if they can be changed.
Result<std::shared_ptr<Preferences>> preferencesOf(const fs::path& folder) {
  return Preferences::open(folder, [](const Failure& /*said when it is opened*/) {});
}

/// Replaces the database if it is damaged, and gives where it is kept; none when it is not, or when
/// nobody can tell: then an import says why.
Result<std::optional<fs::path>> replaceIfDamaged(const fs::path& folder, const fs::path& backup,
                                                 std::chrono::milliseconds lockTimeout) {
  using Kept = std::optional<fs::path>;
  const fs::path file = folder / kDatabaseFile;
  const Result<FolderLock> lock = FolderLock::take(folder);
  if (!lock) return lock.failure();
  if (std::error_code ignored; !fs::exists(file, ignored)) return Kept();
  const auto preferences = preferencesOf(folder);
  if (!preferences) return preferences.failure();
  auto kept = replaceDamagedStore(file, backup, lockTimeout);
  if (!kept || !*kept) return kept;
  const Status failed = (*preferences)->change({{Preferences::kHomesConfigured, JsonValue{true}}});
  return failed ? Result<Kept>(*failed) : kept;
}

Status import(const fs::path& folder, const std::vector<HomeData>& homes,
              std::chrono::milliseconds lockTimeout) {
  HomePlatformOptions options;
  options.dataFolder = folder;
  options.drainsOnCaller = true;
  options.lockTimeout = lockTimeout;
  const auto platform = HomePlatform::open(std::move(options));
  if (!platform) return platform.failure();
  return (*platform)->importHomes(homes, false);
}

}  // namespace

Result<HomeRestoration> restoreHomes(const fs::path& folder, const fs::path& backup,
                                     std::chrono::milliseconds lockTimeout) {
  if (Status failed = prepareDataFolder(folder)) return *failed;
  auto homes = homesOfBackup(backup);
  if (!homes) {
    return Failure{Failure::Kind::platform,
                   backup.string() +
                       ": the backup is damaged; nidus home restore --list shows the "
                       "good ones"};
  }
  auto damaged = replaceIfDamaged(folder, backup, lockTimeout);
  if (!damaged) return damaged.failure();
  if (!*damaged) {
    if (Status failed = import(folder, *homes, lockTimeout)) return *failed;
  }
  return HomeRestoration{std::move(*homes), std::move(*damaged)};
}

}  // namespace nidus
