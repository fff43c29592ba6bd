#include "HomePlatform/Objects/PendingManagers.h"

#include "HomePlatform/Objects/HomeManagerObject.h"

namespace nidus {

bool PendingManagers::add(const std::shared_ptr<HomeManagerObject>& manager) {
  const NDLock lock(mutex_);
  if (!isClosed_) managers_.emplace(manager.get(), manager);
  return !isClosed_;
}

void PendingManagers::remove(const HomeManagerObject* manager) {
  const NDLock lock(mutex_);
  managers_.erase(manager);
}

void PendingManagers::close() {
  decltype(managers_) told;
  {
    const NDLock lock(mutex_);
    isClosed_ = true;
    told.swap(managers_);
  }
  for (const auto& entry : told) {
    if (const auto manager = entry.second.lock()) manager->reportNever();
  }
}

}  // namespace nidus
