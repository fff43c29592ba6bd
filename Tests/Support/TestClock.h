#pragma once

#include <algorithm>
#include <memory>
#include <utility>

#include "PlatformModel/System/NDClock.h"
#include "PlatformModel/System/NDMainQueue.h"

namespace nidus {

/// A clock for one thread, which is moved by waiting: a wait runs the work of a queue and, if that
/// does not end it, goes on to its deadline at once.
class TestClock final : public NDClock {
 public:
  /// `queue` is never null.
  explicit TestClock(std::shared_ptr<NDMainQueue> queue) : queue_(std::move(queue)) {}

  [[nodiscard]] TimePoint now() override { return now_; }

  bool waitUntil(std::unique_lock<std::mutex>& lock, std::condition_variable& /*changed*/,
                 TimePoint deadline, const std::function<bool()>& isDone) override {
    lock.unlock();
    queue_->drain();
    lock.lock();
    const bool answer = isDone();
    if (!answer) now_ = std::max(now_, deadline);
    return answer;
  }

 private:
  const std::shared_ptr<NDMainQueue> queue_;
  TimePoint now_{};
};

}  // namespace nidus
