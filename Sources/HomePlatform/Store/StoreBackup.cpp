#include "HomePlatform/Store/StoreBackup.h"

#include <cerrno>
#include <system_error>

#include "HomePlatform/Store/BackupList.h"
#include "HomePlatform/Store/DatabaseFile.h"
#include "HomePlatform/Store/StoreDamage.h"
#include "HomePlatform/System/FilePlacing.h"
#include "HomePlatform/System/PrivateFiles.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;

DatabaseError systemError(int error) {
  const std::string message = std::generic_category().message(error);
  switch (error) {
    case ENOSPC:
    case EDQUOT:
      return {DatabaseError::Kind::full, message};
    case EACCES:
    case EPERM:
    case EROFS:
      return {DatabaseError::Kind::notWritable, message};
    default:
      return {DatabaseError::Kind::other, message};
  }
}

bool holdsHomes(const fs::path& file, std::chrono::milliseconds lockTimeout) {
  Database database(file.string(), lockTimeout, Database::MissingFile::isAnError);
  return database.number("SELECT EXISTS (SELECT 1 FROM home)") != 0;
}

void copyAndCheck(const fs::path& from, const fs::path& to, std::chrono::milliseconds lockTimeout) {
  {
    Database source(from.string(), lockTimeout, Database::MissingFile::isAnError);
    const WorkLimit limit(source);
    Statement(source, "VACUUM INTO ?").run(NDString(to.string()));
  }
  Database copy(to.string(), lockTimeout, Database::MissingFile::isAnError);
  if (const auto damage = findDamage(copy); !damage.empty()) throw damage.front();
}

/// Gives the copy the name of the next backup, once it is sound and on disk.
fs::path makeBackup(const fs::path& file, std::chrono::milliseconds lockTimeout) {
  fs::path backup = nextBackupOf(file);
  const fs::path temporary = file.string() + ".backup";
  try {
    copyDatabase(file, temporary, lockTimeout);
    if (const int error = putInPlace(temporary, backup)) throw systemError(error);
  } catch (...) {
    removeDatabaseFile(temporary);
    throw;
  }
  return backup;
}

}  // namespace

StoreBackup::StoreBackup(const fs::path& file, std::chrono::milliseconds lockTimeout) {
  try {
    if (holdsHomes(file, lockTimeout)) backup_ = makeBackup(file, lockTimeout);
  } catch (const DatabaseError& error) {
    throw DatabaseError{error.kind, "while a backup was made: " + error.message};
  }
}

StoreBackup::~StoreBackup() {
  if (backup_) removeDatabaseFile(*backup_);
}

void removeOldBackups(const fs::path& file) {
  const std::vector<fs::path> all = backupsOf(file);
  for (std::size_t index = kBackupsKept; index < all.size(); ++index) {
    removeDatabaseFile(all[index]);
  }
}

void copyDatabase(const fs::path& from, const fs::path& to, std::chrono::milliseconds lockTimeout) {
  removeDatabaseFile(to);
  if (const int error = makePrivateFile(to)) throw systemError(error);
  copyAndCheck(from, to, lockTimeout);
}

std::optional<SchemaProblem> migrateStore(Database& database, const fs::path& file,
                                          const std::vector<std::string>& steps,
                                          std::chrono::milliseconds lockTimeout) {
  std::optional<StoreBackup> backup;
  const MigrationHooks hooks{[&] { backup.emplace(file, lockTimeout); }, [&] { backup->keep(); }};
  const auto problem = applySchema(database, steps, hooks);
  if (backup) removeOldBackups(file);
  return problem;
}

}  // namespace nidus
