#include "HomePlatform/Objects/HomeLibrary.h"

#include <utility>

namespace nidus {

void HomeLibrary::setCalls(std::weak_ptr<HomeCalls> calls) {
  const NDLock lock(mutex_);
  calls_ = std::move(calls);
}

Result<std::shared_ptr<const HomeEdition>> HomeLibrary::current() {
  const NDLock lock(mutex_);
  const Result<std::uint64_t> version = store_->version();
  if (!version) return version.failure();
  if (!current_ || current_->version != *version) {
    if (Status failure = load(*version)) return *failure;
  }
  return current_;
}

Status HomeLibrary::keep(const std::vector<ValueChange>& changes) {
  return store_->writeValues(changes, [this, &changes](const std::function<Status()>& write) {
    const NDLock lock(mutex_);
    if (Status failure = write()) return failure;
    for (const auto& weak : inUse_) {
      const auto home = weak.lock();
      if (!home) continue;
      for (const ValueChange& change : changes) home->apply(change);
    }
    return Status();
  });
}

/// `version` was read before, so that a change in between is seen as one the next time.
Status HomeLibrary::load(std::uint64_t version) {
  Result<std::vector<HomeData>> loaded = store_->loadHomes();
  if (!loaded) return loaded.failure();
  const auto all = std::make_shared<const std::vector<HomeData>>(std::move(*loaded));
  std::vector<std::shared_ptr<NDHome>> homes;
  homes.reserve(all->size());
  for (const HomeData& data : *all) {
    homes.push_back(HomeObject::make(std::shared_ptr<const HomeData>(all, &data), calls_));
  }
  current_ =
      std::make_shared<const HomeEdition>(HomeEdition{version, NDArray<NDHome>(std::move(homes))});
  bringEarlierHomesUpToDate();
  return std::nullopt;
}

void HomeLibrary::bringEarlierHomesUpToDate() {
  std::vector<std::weak_ptr<const HomeObject>> inUse;
  for (const auto& weak : inUse_) {
    const auto home = weak.lock();
    if (!home) continue;
    if (const auto newer = current_->find(home->uuid())) home->takeValues(*newer);
    inUse.push_back(weak);
  }
  for (const auto& home : current_->homes) {
    inUse.push_back(std::static_pointer_cast<const HomeObject>(home));
  }
  inUse_ = std::move(inUse);
}

}  // namespace nidus
