#include "HomePlatform/Store/FileHomeStore.h"

#include <utility>

#include "HomePlatform/Store/Schema.h"
#include "HomePlatform/Store/StoreBackup.h"
#include "HomePlatform/Store/StoreFailures.h"

namespace nidus {

FileHomeStore::FileHomeStore(std::filesystem::path file, std::chrono::milliseconds lockTimeout)
    : file_(std::move(file)), lockTimeout_(lockTimeout), reader_(file_, lockTimeout_) {}

Status FileHomeStore::prepare() {
  const NDLock lock(mutex_);
  if (const auto problem = migrateStore(reader_.database, file_, schemaSteps(), lockTimeout_)) {
    return failureOf(*problem, file_);
  }
  reader_.database.useWriteAheadLog();
  return std::nullopt;
}

Status FileHomeStore::writeValues(const std::vector<ValueChange>& changes,
                                  const AroundWrite& around) {
  const NDLock turn(turn_);
  try {
    Connection& writing = writer();
    Transaction transaction(writing.database, Transaction::Kind::writing);  // waits for others
    const auto write = [&] { return commitValues(writing, transaction, changes); };
    return around ? around(write) : write();
  } catch (const DatabaseError& error) {
    return failureOf(error, file_);
  }
}

/// A commit of this process leaves the version as it is. Those of others must not be lost among
/// them: none is made during the transaction, and what follows it at once shows in the commits that
/// the writing connection sees of others.
Status FileHomeStore::commitValues(Connection& writer, Transaction& transaction,
                                   const std::vector<ValueChange>& changes) {
  const NDLock lock(mutex_);
  try {
    noticeCommits();
    if (!writer.values) writer.values.emplace(writer.database);
    writer.values->write(changes);
    const std::int64_t before = writer.commitsOfOthers();
    transaction.commit();
    seenCommits_ = reader_.commitsOfOthers();
    if (writer.commitsOfOthers() != before) ++version_;
    return std::nullopt;
  } catch (const DatabaseError& error) {
    return failureOf(error, file_);
  }
}

Result<std::uint64_t> FileHomeStore::version() {
  const NDLock lock(mutex_);
  try {
    noticeCommits();
    return version_;
  } catch (const DatabaseError& error) {
    return failureOf(error, file_);
  }
}

void FileHomeStore::noticeCommits() {
  const std::int64_t commits = reader_.commitsOfOthers();
  if (commits != seenCommits_) ++version_;
  seenCommits_ = commits;
}

Result<bool> FileHomeStore::waitForWriter() {
  const NDLock turn(turn_);
  try {
    // Who has the only writing transaction there can be knows that no other one is open.
    const Transaction transaction(writer().database, Transaction::Kind::writing);
    return true;
  } catch (const DatabaseError& error) {
    if (error.kind == DatabaseError::Kind::locked) return false;
    return failureOf(error, file_);
  }
}

Status FileHomeStore::change(Backup backup, const Change& change) {
  const NDLock turn(turn_);
  try {
    Database& database = writer().database;
    Transaction transaction(database, Transaction::Kind::writing);
    std::optional<StoreBackup> before;
    if (backup == Backup::first) before.emplace(file_, lockTimeout_);
    if (Status failed = change(database)) return failed;
    if (before) before->keep();
    transaction.commit();
    if (before) removeOldBackups(file_);
    return std::nullopt;
  } catch (const DatabaseError& error) {
    return failureOf(error, file_);
  }
}

Status FileHomeStore::read(const Read& read) {
  const NDLock lock(mutex_);
  try {
    Transaction transaction(reader_.database, Transaction::Kind::reading);
    read(reader_.database);
    transaction.commit();
    return std::nullopt;
  } catch (const DatabaseError& error) {
    return failureOf(error, file_);
  }
}

FileHomeStore::Connection& FileHomeStore::writer() {
  if (!writer_) writer_.emplace(file_, lockTimeout_);
  return *writer_;
}

std::int64_t FileHomeStore::Connection::commitsOfOthers() {
  if (!dataVersion) dataVersion.emplace(database, "PRAGMA data_version");
  dataVersion->step();
  const std::int64_t number = dataVersion->integer(0);
  dataVersion->reset();
  return number;
}

}  // namespace nidus
