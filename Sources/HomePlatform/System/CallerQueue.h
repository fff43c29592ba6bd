#pragma once

#include <deque>

#include "PlatformModel/System/NDMutex.h"
#include "PlatformModel/System/NDQueue.h"

namespace nidus {

/// A queue without threads: its work runs, in order, on the thread that asks for it.
class CallerQueue final : public NDQueue {
 public:
  void async(NDTask task) override;
  /// Runs one piece of work on the calling thread; false when there was none.
  bool runOne();
  /// Drops waiting work, and all that is added later.
  void shutDown();

 private:
  NDTask take();

  NDMutex mutex_;
  std::deque<NDTask> tasks_ ND_GUARDED_BY(mutex_);
  bool isShutDown_ ND_GUARDED_BY(mutex_) = false;
};

}  // namespace nidus
