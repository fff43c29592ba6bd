#include "HomePlatform/Store/BackupList.h"

#include <algorithm>
#include <chrono>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeLoader.h"
#include "HomePlatform/Store/NumberedFiles.h"
#include "HomePlatform/Store/Schema.h"
#include "HomePlatform/Store/StoreDamage.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;

constexpr const char* kWord = "backup";

/// For others that look at a backup at the same time; nobody changes one.
constexpr std::chrono::seconds kPatience{1};

}  // namespace

std::vector<fs::path> backupsOf(const fs::path& file) { return numberedFiles(file, kWord); }

fs::path nextBackupOf(const fs::path& file) { return nextNumberedFile(file, kWord); }

std::optional<std::vector<HomeData>> homesOfBackup(const fs::path& backup) {
  try {
    Database database(backup.string(), kPatience, Database::MissingFile::isAnError);
    if (schemaProblemOf(database, schemaSteps())) return std::nullopt;
    if (!findDamage(database).empty()) return std::nullopt;
    std::vector<HomeData> homes = loadMigratedHomes(database);
    if (homes.empty()) return std::nullopt;
    return homes;
  } catch (const DatabaseError&) {
    return std::nullopt;
  }
}

std::optional<fs::path> newestGoodBackupOf(const fs::path& file) {
  const std::vector<fs::path> all = backupsOf(file);
  const auto good = std::find_if(all.begin(), all.end(), [](const fs::path& backup) {
    return homesOfBackup(backup).has_value();
  });
  return good == all.end() ? std::nullopt : std::optional(*good);
}

}  // namespace nidus
