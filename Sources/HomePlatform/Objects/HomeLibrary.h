#pragma once

#include <memory>
#include <vector>

#include "HomePlatform/Drivers/ValueKeeper.h"
#include "HomePlatform/Objects/HomeEdition.h"
#include "HomePlatform/Result.h"
#include "HomePlatform/Store/HomeStore.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {

class HomeCalls;

/// The homes of the database as objects, read again only when the database has changed. May be used
/// from any thread.
///
/// The cached values of every home that is still in use follow the database as far as it has been
/// read: those of an earlier edition too.
class HomeLibrary final : public ValueKeeper {
 public:
  /// `store` is never null.
  explicit HomeLibrary(std::shared_ptr<HomeStore> store) : store_(std::move(store)) {}

  /// Where the calls of the homes go that are loaded from now on.
  void setCalls(std::weak_ptr<HomeCalls> calls);

  /// The homes as the database has them now; the edition is the same as before when the database
  /// is. May block while they are read.
  [[nodiscard]] Result<std::shared_ptr<const HomeEdition>> current();

  [[nodiscard]] Status keep(const std::vector<ValueChange>& changes) override;

 private:
  [[nodiscard]] Status load(std::uint64_t version) ND_REQUIRES(mutex_);
  void bringEarlierHomesUpToDate() ND_REQUIRES(mutex_);

  const std::shared_ptr<HomeStore> store_;
  /// Also held while the database is read or a write is committed: what is loaded must not miss
  /// what is kept at the same time. Not while a write waits for another process, so that homes are
  /// delivered meanwhile.
  NDMutex mutex_;
  std::weak_ptr<HomeCalls> calls_ ND_GUARDED_BY(mutex_);
  std::shared_ptr<const HomeEdition> current_ ND_GUARDED_BY(mutex_);
  /// The homes of all editions; those that nobody uses any more are dropped at the next load.
  std::vector<std::weak_ptr<const HomeObject>> inUse_ ND_GUARDED_BY(mutex_);
};

}  // namespace nidus
