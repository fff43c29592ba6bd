#pragma once

#include <memory>
#include <optional>

#include "HomePlatform/Store/HomeChanges.h"
#include "HomePlatform/Store/SqliteHomeStore.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {

/// The store in memory, over one connection that nobody else has. Nothing of it is kept, so that
/// there are no backups.
class MemoryHomeStore final : public SqliteHomeStore {
 public:
  /// Throws `DatabaseError`.
  MemoryHomeStore();

  Status writeValues(const std::vector<ValueChange>& changes, const AroundWrite& around) override;
  Result<std::uint64_t> version() override;
  Result<bool> waitForWriter() override { return true; }

 protected:
  Status change(Backup backup, const Change& change) override;
  Status read(const Read& read) override;

 private:
  Status writeAtOnce(const std::vector<ValueChange>& changes);

  NDMutex mutex_;
  Database database_ ND_GUARDED_BY(mutex_);
  std::optional<ValueWriter> values_ ND_GUARDED_BY(mutex_);
  std::uint64_t version_ ND_GUARDED_BY(mutex_) = 0;
};

}  // namespace nidus
