#pragma once

#include <atomic>
#include <memory>

#include "HomePlatform/System/CallerQueue.h"
#include "PlatformModel/System/NDClock.h"

namespace nidus {

/// The time of a platform without threads: it stands still, and a wait that no work can end jumps
/// to its deadline.
class CallerClock final : public NDClock {
 public:
  /// `queue` is the work that a wait runs on the waiting thread; never null.
  explicit CallerClock(std::shared_ptr<CallerQueue> queue) : queue_(std::move(queue)) {}

  [[nodiscard]] TimePoint now() override { return TimePoint(Duration(time_.load())); }
  bool waitUntil(std::unique_lock<std::mutex>& lock, std::condition_variable& changed,
                 TimePoint deadline, const std::function<bool()>& isDone) override;

 private:
  void jumpTo(TimePoint deadline);

  const std::shared_ptr<CallerQueue> queue_;
  std::atomic<Duration::rep> time_{0};
};

}  // namespace nidus
