#pragma once

#include <condition_variable>
#include <cstddef>
#include <deque>
#include <thread>
#include <vector>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDMutex.h"
#include "PlatformModel/System/NDQueue.h"

namespace nidus {

/// A queue with threads of its own: work starts in order and runs on up to `width` threads at once.
///
/// Threads are started as work arrives, not before. `shutDown` (or the destructor) ends them:
/// running work ends, waiting work is destroyed without being run. With a width of one it is a
/// serial queue that owns a thread.
class ND_EXPORT NDConcurrentQueue final : public NDQueue {
 public:
  /// `width` is the greatest number of threads, at least 1.
  explicit NDConcurrentQueue(std::size_t width);
  ~NDConcurrentQueue() override;

  void async(NDTask task) override;

  /// Ends the threads and drops waiting work; work added later is dropped. Waits for running work,
  /// unless it is called by a thread of this queue, which is then ended when its work returns.
  void shutDown();

  /// Blocks until no work is waiting or running. Not to be called by a thread of this queue.
  void waitUntilIdle();

 private:
  void work();

  const std::size_t width_;
  NDMutex mutex_;
  std::condition_variable changed_;
  std::deque<NDTask> tasks_ ND_GUARDED_BY(mutex_);
  std::vector<std::thread> threads_ ND_GUARDED_BY(mutex_);
  std::size_t idle_ ND_GUARDED_BY(mutex_) = 0;
  std::size_t running_ ND_GUARDED_BY(mutex_) = 0;
  bool isShutDown_ ND_GUARDED_BY(mutex_) = false;
};

}  // namespace nidus
