#include "HomePlatform/Store/MemoryHomeStore.h"

#include "HomePlatform/Store/Schema.h"
#include "HomePlatform/Store/StoreFailures.h"

namespace nidus {

MemoryHomeStore::MemoryHomeStore() : database_(Database::kInMemory, std::chrono::milliseconds(0)) {
  static_cast<void>(applySchema(database_, schemaSteps()));  // nothing is in the way of a new one
}

Status MemoryHomeStore::writeValues(const std::vector<ValueChange>& changes,
                                    const AroundWrite& around) {
  const auto write = [&] { return writeAtOnce(changes); };
  return around ? around(write) : write();
}

Status MemoryHomeStore::writeAtOnce(const std::vector<ValueChange>& changes) {
  const NDLock lock(mutex_);
  try {
    Transaction transaction(database_, Transaction::Kind::writing);
    if (!values_) values_.emplace(database_);
    values_->write(changes);
    transaction.commit();
    return std::nullopt;
  } catch (const DatabaseError& error) {
    return failureInMemory(error);
  }
}

Result<std::uint64_t> MemoryHomeStore::version() {
  const NDLock lock(mutex_);
  return version_;
}

Status MemoryHomeStore::change(Backup /*backup*/, const Change& change) {
  const NDLock lock(mutex_);
  try {
    Transaction transaction(database_, Transaction::Kind::writing);
    if (Status failed = change(database_)) return failed;
    transaction.commit();
    ++version_;
    return std::nullopt;
  } catch (const DatabaseError& error) {
    return failureInMemory(error);
  }
}

Status MemoryHomeStore::read(const Read& read) {
  const NDLock lock(mutex_);
  try {
    read(database_);
    return std::nullopt;
  } catch (const DatabaseError& error) {
    return failureInMemory(error);
  }
}

}  // namespace nidus
