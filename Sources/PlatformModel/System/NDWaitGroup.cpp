#include "PlatformModel/System/NDWaitGroup.h"

#include <cassert>

#include "PlatformModel/System/NDDeliveryHold.h"

namespace nidus {
namespace {

/// The end of `timeout`, or the end of time for a timeout that reaches beyond it.
NDClock::TimePoint deadlineAfter(NDClock::TimePoint now, NDClock::Duration timeout) {
  const NDClock::TimePoint end = NDClock::TimePoint::max();
  return timeout > NDClock::Duration::zero() && now > end - timeout ? end : now + timeout;
}

}  // namespace

NDWaitGroup::NDWaitGroup(std::shared_ptr<NDClock> clock) : clock_(std::move(clock)) {}

void NDWaitGroup::enter() {
  const NDLock lock(mutex_);
  ++entered_;
}

void NDWaitGroup::leave() {
  std::vector<Notification> due;
  {
    const NDLock lock(mutex_);
    assert(entered_ > 0);
    if (--entered_ > 0) return;
    due.swap(notifications_);
    // Under the lock: a waiter may destroy the group as soon as it has seen it empty.
    changed_.notify_all();
  }
  for (auto& [queue, task] : due) queue->async(std::move(task));
}

void NDWaitGroup::notify(std::shared_ptr<NDQueue> queue, NDTask task) {
  {
    const NDLock lock(mutex_);
    if (entered_ > 0) {
      notifications_.emplace_back(std::move(queue), std::move(task));
      return;
    }
  }
  queue->async(std::move(task));
}

bool NDWaitGroup::wait(NDClock::Duration timeout) {
  NDDeliveryHold::releaseForWait();
  const NDClock::TimePoint deadline = deadlineAfter(clock_->now(), timeout);
  NDLock lock(mutex_);
  const auto isEmpty = [this]() ND_REQUIRES(mutex_) { return entered_ == 0; };
  return clock_->waitUntil(lock.native(), changed_, deadline, isEmpty);
}

}  // namespace nidus
