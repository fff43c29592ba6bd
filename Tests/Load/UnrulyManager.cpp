#include "Load/UnrulyManager.h"

#include <utility>

namespace nidus {

UnrulyManager::UnrulyManager(std::shared_ptr<Ledger> ledger, Show show)
    : ledger_(std::move(ledger)), show_(std::move(show)) {}

NDArray<NDHome> UnrulyManager::homes() const {
  NDArray<NDHome> former;  // its homes may end here, after the lock
  const NDLock lock(mutex_);
  if (show_.later && show_.looks-- == 0) {
    former = std::exchange(show_.homes, std::exchange(show_.later, nullptr)());
    if (ledger_) ledger_->homesChanged();
  }
  if (std::exchange(isFirstLook_, false) && ledger_) ledger_->homesReported(show_.homes.size());
  return show_.homes;
}

void UnrulyManager::setDelegate(std::weak_ptr<NDHomeManagerDelegate> delegate) {
  const NDLock lock(mutex_);
  delegate_ = std::move(delegate);
}

std::shared_ptr<NDHomeManagerDelegate> UnrulyManager::delegate() const {
  const NDLock lock(mutex_);
  return delegate_.lock();
}

void UnrulyManager::report() {
  const Ledger::Scope scope(ledger_);
  if (const auto heard = delegate()) heard->homeManagerDidUpdateHomes(shared_from_this());
}

void UnrulyManager::reportNever() {
  if (const auto heard = delegate()) heard->homeManagerWillNotUpdateHomes(shared_from_this());
}

}  // namespace nidus
