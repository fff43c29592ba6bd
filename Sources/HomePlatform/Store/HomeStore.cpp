#include "HomePlatform/Store/HomeStore.h"

#include <string>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/DatabaseFile.h"
#include "HomePlatform/Store/HomeChecks.h"
#include "HomePlatform/Store/HomeInserter.h"
#include "HomePlatform/Store/HomeLoader.h"
#include "HomePlatform/Store/Schema.h"
#include "HomePlatform/Store/StoreFailures.h"
#include "HomePlatform/System/DataFolder.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {
namespace {

/// The store over one connection. Every operation is a transaction under the lock.
class SqliteHomeStore final : public HomeStore {
 public:
  SqliteHomeStore(const std::string& path, std::string name, std::chrono::milliseconds lockTimeout)
      : name_(std::move(name)), database_(path, lockTimeout) {}

  /// Makes the database ready for use.
  [[nodiscard]] Status prepare(bool isFile) {
    NDLock lock(mutex_);
    if (const auto problem = applySchema(database_, schemaSteps())) {
      return failureOf(*problem, name_);
    }
    if (isFile) database_.useWriteAheadLog();
    return std::nullopt;
  }

  Status replaceHomes(const std::vector<HomeData>& homes, const StoreProgress& progress) override {
    return change([&homes, &progress](Database& database) {
      putInPlaceOfAll(database, homes, progress);
      return Status();
    });
  }

  Status mergeHomes(const std::vector<HomeData>& homes, const StoreProgress& progress) override {
    return change([&homes, &progress](Database& database) {
      Statement find(database, "SELECT position FROM home WHERE uuid = ?");
      Statement remove(database, "DELETE FROM home WHERE uuid = ?");
      HomeInserter inserter(database, progress);
      for (const HomeData& home : homes) {
        find.bindAll(home.uuid);
        const bool isKnown = find.step();
        const std::int64_t position = isKnown ? find.integer(0) : positionAtEnd(database);
        find.reset();
        remove.run(home.uuid);
        inserter.insert(home, position);
      }
      return Status();
    });
  }

  Status editHomes(const HomeEdit& edit) override {
    return change([&edit](Database& database) {
      std::vector<HomeData> homes = loadHomesFrom(database);
      Status failed = edit(homes);
      if (!failed) failed = checkHomes(homes, "the changed homes");
      if (!failed) putInPlaceOfAll(database, homes, nullptr);
      return failed;
    });
  }

  Result<std::vector<HomeData>> loadHomes() override {
    return read<std::vector<HomeData>>(&loadHomesFrom);
  }

  Result<std::int64_t> countHomes() override {
    return read<std::int64_t>(
        [](Database& database) { return database.number("SELECT count(*) FROM home"); });
  }

  Status writeValues(const std::vector<ValueChange>& changes) override {
    NDLock lock(mutex_);
    try {
      Transaction transaction(database_, Transaction::Kind::writing);
      if (!update_) update_ = std::make_unique<Statement>(database_, kUpdate);
      for (const ValueChange& change : changes) {
        update_->run(change.home, change.address.accessory, change.address.service,
                     change.address.characteristic, change.value.has_value(),
                     change.value.value_or(nullptr), change.deviceValue.has_value(),
                     change.deviceValue.value_or(nullptr));
      }
      transaction.commit();
    } catch (const DatabaseError& error) {
      return failureOf(error, name_);
    }
    return std::nullopt;
  }

  Result<bool> waitForWriter() override {
    NDLock lock(mutex_);
    try {
      // Who has the only writing transaction there can be knows that no other one is open.
      const Transaction turn(database_, Transaction::Kind::writing);
      return true;
    } catch (const DatabaseError& error) {
      if (error.kind == DatabaseError::Kind::locked) return false;
      return failureOf(error, name_);
    }
  }

  Result<std::uint64_t> version() override {
    NDLock lock(mutex_);
    try {
      constexpr int kHalf = 32;
      if (!dataVersion_) {
        dataVersion_ = std::make_unique<Statement>(database_, "PRAGMA data_version");
      }
      dataVersion_->step();
      const auto byOthers = static_cast<std::uint64_t>(dataVersion_->integer(0));
      dataVersion_->reset();
      return byOthers << kHalf | ownChanges_;
    } catch (const DatabaseError& error) {
      return failureOf(error, name_);
    }
  }

 private:
  static constexpr const char* kUpdate =
      "UPDATE characteristic SET value = iif(?5, ?6, value), "
      "device_value = iif(?7, ?8, device_value) "
      "WHERE id = (SELECT characteristic.id FROM home "
      "JOIN accessory ON accessory.home = home.id AND accessory.uuid = ?2 "
      "JOIN service ON service.accessory = accessory.id AND service.instance_id = ?3 "
      "JOIN characteristic ON characteristic.service = service.id "
      "AND characteristic.instance_id = ?4 WHERE home.uuid = ?1)";

  static void putInPlaceOfAll(Database& database, const std::vector<HomeData>& homes,
                              const StoreProgress& progress) {
    database.run("DELETE FROM home");
    HomeInserter inserter(database, progress);
    std::int64_t position = 0;
    for (const HomeData& home : homes) inserter.insert(home, position++);
  }

  static std::int64_t positionAtEnd(Database& database) {
    return database.number("SELECT ifnull(max(position) + 1, 0) FROM home");
  }

  /// Makes a change of the homes, whole or not at all.
  template <class Change>
  Status change(const Change& change) {
    NDLock lock(mutex_);
    try {
      Transaction transaction(database_, Transaction::Kind::writing);
      if (Status failed = change(database_)) return failed;
      transaction.commit();
    } catch (const DatabaseError& error) {
      return failureOf(error, name_);
    }
    ++ownChanges_;
    return std::nullopt;
  }

  /// Reads one state of the database.
  template <class Value, class Read>
  Result<Value> read(const Read& read) {
    NDLock lock(mutex_);
    try {
      Transaction transaction(database_, Transaction::Kind::reading);
      Value value = read(database_);
      transaction.commit();
      return value;
    } catch (const DatabaseError& error) {
      return failureOf(error, name_);
    }
  }

  const std::string name_;
  NDMutex mutex_;
  Database database_ ND_GUARDED_BY(mutex_);
  std::unique_ptr<Statement> update_ ND_GUARDED_BY(mutex_);
  std::unique_ptr<Statement> dataVersion_ ND_GUARDED_BY(mutex_);
  std::uint32_t ownChanges_ ND_GUARDED_BY(mutex_) = 0;
};

Result<std::unique_ptr<HomeStore>> openStore(const std::string& path, const std::string& name,
                                             bool isFile, std::chrono::milliseconds lockTimeout) {
  try {
    auto store = std::make_unique<SqliteHomeStore>(path, name, lockTimeout);
    if (Status failed = store->prepare(isFile)) return *failed;
    return std::unique_ptr<HomeStore>(std::move(store));
  } catch (const DatabaseError& error) {
    return failureOf(error, name);
  }
}

}  // namespace

Result<std::unique_ptr<HomeStore>> HomeStore::open(const std::optional<std::filesystem::path>& file,
                                                   std::chrono::milliseconds lockTimeout) {
  if (!file) return openStore(Database::kInMemory, "the database in memory", false, lockTimeout);
  if (Status failed = prepareDatabaseFile(*file)) return *failed;
  // One process at a time makes or migrates the databases of a folder.
  const auto folder = file->parent_path();
  const Result<FolderLock> lock = FolderLock::take(folder.empty() ? "." : folder);
  if (!lock) return lock.failure();
  return openStore(file->string(), file->string(), true, lockTimeout);
}

}  // namespace nidus
