#pragma once

#include <chrono>
#include <cstdint>
#include <filesystem>
#include <functional>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeData.h"
#include "HomePlatform/Store/HomeEdit.h"
#include "HomePlatform/Store/StoreProgress.h"

namespace nidus {

/// One value that changes in the database.
struct ValueChange {
  NDUUID home;
  CharacteristicAddress address;
  std::optional<NDValueRef> value;        ///< The new cached value; none leaves it.
  std::optional<NDValueRef> deviceValue;  ///< The new device value; none leaves it.
};

/// Calls `write`, which writes values and makes them lasting, in the midst of what has to be done
/// at the same moment. Nobody else can write meanwhile.
using AroundWrite = std::function<Status(const std::function<Status()>& write)>;

/// The home database: one SQLite file, or one in memory.
///
/// May be used from any thread and by several processes; every change is one transaction that is
/// on disk when the call returns. What only reads does not wait for a change that another process
/// is making, not even when a change of this one does. A failure's message names the file and the
/// remedy.
///
/// Before the homes are replaced or merged, or an earlier schema is migrated, a backup of the homes
/// that there are is kept beside the file, and the last `kBackupsKept` of them stay. An edit, which
/// is small and frequent, makes none: it would push out those that matter.
class HomeStore {
 public:
  /// How long a call waits for another process that is changing the database.
  static constexpr std::chrono::milliseconds kLockTimeout{30'000};

  /// Opens the database in `file`; none opens one in memory. Folder and file are made, for their
  /// owner alone, when they are missing, and an earlier schema is migrated. Fails when the file is
  /// damaged, locked for longer than `lockTimeout`, not to be written, from a newer version of the
  /// program or no database of ours; it is left as it was.
  [[nodiscard]] static Result<std::unique_ptr<HomeStore>> open(
      const std::optional<std::filesystem::path>& file,
      std::chrono::milliseconds lockTimeout = kLockTimeout);
  virtual ~HomeStore() = default;

  /// Replaces all homes. `homes` hold what a home document may hold. `progress` may be empty.
  [[nodiscard]] virtual Status replaceHomes(const std::vector<HomeData>& homes,
                                            const StoreProgress& progress = nullptr) = 0;
  /// Replaces the homes of the same UUID in their places and adds the others at the end.
  [[nodiscard]] virtual Status mergeHomes(const std::vector<HomeData>& homes,
                                          const StoreProgress& progress = nullptr) = 0;
  /// Lets `edit`, which is not empty, change the homes as they are, and stores what it leaves if it
  /// is what a home document may hold. Nobody else writes meanwhile: `edit` must be quick and must
  /// not call the store. The failure is that of `edit`, or bad input with the place of what is
  /// wrong in the changed homes; it leaves everything as it was.
  [[nodiscard]] virtual Status editHomes(const HomeEdit& edit) = 0;
  /// Reads all homes in order, within one transaction.
  [[nodiscard]] virtual Result<std::vector<HomeData>> loadHomes() = 0;
  [[nodiscard]] virtual Result<std::int64_t> countHomes() = 0;
  /// Writes all of `changes`, or none; an address that is no longer there is passed over. `around`,
  /// which may be empty, is called once it is this process's turn to write, and gives what is
  /// given back; it must not change the store.
  [[nodiscard]] virtual Status writeValues(const std::vector<ValueChange>& changes,
                                           const AroundWrite& around = nullptr) = 0;
  /// A number that differs after each change of the database by another connection or process, and
  /// after each `replaceHomes`, `mergeHomes` and `editHomes` of this one; `writeValues` of this one
  /// keeps it.
  [[nodiscard]] virtual Result<std::uint64_t> version() = 0;
  /// Waits until nobody is in the midst of a change, so that all that was written up to now can be
  /// seen. False when somebody still was after the lock timeout.
  [[nodiscard]] virtual Result<bool> waitForWriter() = 0;
};

}  // namespace nidus
