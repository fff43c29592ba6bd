#pragma once

#include <memory>

#include "HomePlatform/System/WorkTracker.h"
#include "PlatformModel/System/NDConcurrentQueue.h"
#include "PlatformModel/System/NDQueue.h"

namespace nidus {

/// A queue with threads of its own whose work is counted until it has ended and what it held is
/// released.
class TrackedQueue final : public NDQueue {
 public:
  /// `width` is the greatest number of threads; they are started as work arrives.
  TrackedQueue(std::size_t width, std::shared_ptr<WorkTracker> tracker)
      : queue_(width), tracker_(std::move(tracker)) {}

  void async(NDTask task) override;
  /// As `NDConcurrentQueue::shutDown`.
  void shutDown() { queue_.shutDown(); }

 private:
  NDConcurrentQueue queue_;
  const std::shared_ptr<WorkTracker> tracker_;
};

}  // namespace nidus
