#pragma once

#include <chrono>
#include <cstddef>
#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/Schema.h"

namespace nidus {

/// How many backups of a database are kept.
inline constexpr std::size_t kBackupsKept = 5;

/// A backup of a database, made before a change of it. Whoever makes one holds the writing
/// transaction of the change: nobody else writes then, so that the backup and the change together
/// miss nothing, and only one backup is in the making at a time.
///
///     Transaction transaction(database, Transaction::Kind::writing);
///     StoreBackup backup(file, kLockTimeout);
///     change(database);
///     backup.keep();
///     transaction.commit();
///     removeOldBackups(file);
class StoreBackup {
 public:
  /// Copies the database `file` with its log, as it was before the transaction. The copy is one
  /// file for its owner alone, and is found sound and on disk when this returns. Where no home is
  /// stored there is nothing to keep, and none is made. Throws `DatabaseError`, with `damaged` when
  /// the copy and so the database is not sound.
  StoreBackup(const std::filesystem::path& file, std::chrono::milliseconds lockTimeout);
  /// Removes the backup of a change that was given up: it would only push out others.
  ~StoreBackup();
  StoreBackup(const StoreBackup&) = delete;
  StoreBackup& operator=(const StoreBackup&) = delete;

  /// Lets the backup stay. To be called before the commit: of one that fails nobody knows whether
  /// it was made.
  void keep() { backup_.reset(); }

 private:
  std::optional<std::filesystem::path> backup_;  ///< What is to be removed again.
};

/// Removes all backups of the database `file` but the last ones.
void removeOldBackups(const std::filesystem::path& file);

/// Copies the database `from`, which others may be using, into the one file `to` for its owner
/// alone; what was there is removed. Throws `DatabaseError`, also when the copy is not sound.
void copyDatabase(const std::filesystem::path& from, const std::filesystem::path& to,
                  std::chrono::milliseconds lockTimeout);

/// Brings `database`, which is that of `file`, to the version that `steps` lead to, as
/// `applySchema` does, with a backup before a migration.
[[nodiscard]] std::optional<SchemaProblem> migrateStore(Database& database,
                                                        const std::filesystem::path& file,
                                                        const std::vector<std::string>& steps,
                                                        std::chrono::milliseconds lockTimeout);

}  // namespace nidus
