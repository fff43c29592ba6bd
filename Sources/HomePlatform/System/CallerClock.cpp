#include "HomePlatform/System/CallerClock.h"

namespace nidus {

bool CallerClock::waitUntil(std::unique_lock<std::mutex>& lock,
                            std::condition_variable& /*changed*/, TimePoint deadline,
                            const std::function<bool()>& isDone) {
  while (!isDone()) {
    lock.unlock();
    const bool hasRun = queue_->runOne();
    lock.lock();
    if (hasRun) continue;
    jumpTo(deadline);
    return isDone();
  }
  return true;
}

void CallerClock::jumpTo(TimePoint deadline) {
  const Duration::rep target = deadline.time_since_epoch().count();
  Duration::rep time = time_.load();
  while (time < target && !time_.compare_exchange_weak(time, target)) {
  }
}

}  // namespace nidus
