#pragma once

#include <atomic>
#include <cstddef>
#include <memory>

#include "PlatformModel/System/NDMainQueue.h"

namespace nidus {

/// Counts the work of a platform that waits, runs, or is held back. May be used from any thread.
class WorkTracker {
 public:
  /// `main` is woken each time the count falls to zero; it is not kept alive.
  explicit WorkTracker(std::weak_ptr<NDMainQueue> main) : main_(std::move(main)) {}

  void begin() noexcept { count_.fetch_add(1); }
  void end();
  [[nodiscard]] bool isIdle() const noexcept { return count_.load() == 0; }

 private:
  const std::weak_ptr<NDMainQueue> main_;
  std::atomic<std::size_t> count_{0};
};

/// One piece of work that has not ended: held by whatever will end it. A token without a tracker
/// counts nothing.
class WorkToken {
 public:
  explicit WorkToken(std::shared_ptr<WorkTracker> tracker) : tracker_(std::move(tracker)) {
    if (tracker_) tracker_->begin();
  }
  WorkToken(const WorkToken& other) : WorkToken(other.tracker_) {}
  WorkToken(WorkToken&&) noexcept = default;
  WorkToken& operator=(const WorkToken&) = delete;
  WorkToken& operator=(WorkToken&&) = delete;
  ~WorkToken() {
    if (tracker_) tracker_->end();
  }

 private:
  std::shared_ptr<WorkTracker> tracker_;
};

}  // namespace nidus
