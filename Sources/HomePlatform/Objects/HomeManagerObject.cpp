#include "HomePlatform/Objects/HomeManagerObject.h"

#include <utility>

namespace nidus {

HomeManagerObject::HomeManagerObject(std::shared_ptr<PendingManagers> pending)
    : pending_(std::move(pending)) {}

HomeManagerObject::~HomeManagerObject() { pending_->remove(this); }

NDArray<NDHome> HomeManagerObject::homes() const {
  const NDLock lock(mutex_);
  return homes_;
}

void HomeManagerObject::setDelegate(std::weak_ptr<NDHomeManagerDelegate> delegate) {
  const NDLock lock(mutex_);
  delegate_ = std::move(delegate);
}

void HomeManagerObject::report(NDArray<NDHome> homes) {
  if (const auto delegate = beginReport(std::move(homes))) {
    delegate->homeManagerDidUpdateHomes(shared_from_this());
  }
}

void HomeManagerObject::reportNever() {
  if (const auto delegate = beginReport({})) {
    delegate->homeManagerWillNotUpdateHomes(shared_from_this());
  }
}

/// Gives whom to tell; null when all has been told, or when nobody asks.
std::shared_ptr<NDHomeManagerDelegate> HomeManagerObject::beginReport(NDArray<NDHome> homes) {
  pending_->remove(this);
  const NDLock lock(mutex_);
  if (std::exchange(hasReported_, true)) return nullptr;
  homes_ = std::move(homes);
  return delegate_.lock();
}

}  // namespace nidus
