#pragma once

#include <condition_variable>
#include <cstddef>
#include <memory>
#include <utility>
#include <vector>

#include "PlatformModel/System/NDClock.h"
#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDMutex.h"
#include "PlatformModel/System/NDQueue.h"

namespace nidus {

/// Joins pieces of asynchronous work: entered once per piece, left once per piece.
///
/// May be used from any thread. Notifications that never come due are destroyed with the group.
class ND_EXPORT NDWaitGroup {
 public:
  /// `clock` measures `wait`; never null.
  explicit NDWaitGroup(std::shared_ptr<NDClock> clock);

  void enter();
  /// Leaves once; the group must have been entered.
  void leave();

  /// Queues `task` on `queue` when the group is empty: at once if it is empty now, else after the
  /// last leave.
  void notify(std::shared_ptr<NDQueue> queue, NDTask task);

  /// Blocks the calling thread until the group is empty, at most for `timeout`; true when it is
  /// empty. Deliveries held back by the calling thread are let go first (see NDDeliveryHold).
  [[nodiscard]] bool wait(NDClock::Duration timeout);

 private:
  using Notification = std::pair<std::shared_ptr<NDQueue>, NDTask>;

  const std::shared_ptr<NDClock> clock_;
  NDMutex mutex_;
  std::condition_variable changed_;
  std::size_t entered_ ND_GUARDED_BY(mutex_) = 0;
  std::vector<Notification> notifications_ ND_GUARDED_BY(mutex_);
};

}  // namespace nidus
