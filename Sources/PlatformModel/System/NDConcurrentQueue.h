#pragma once

#include <cstddef>
#include <memory>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDQueue.h"

namespace nidus {

/// A queue with threads of its own: work starts in order and runs on up to `width` threads at once.
///
/// Threads are started as work arrives, not before. `shutDown` (or the destructor) ends them:
/// running work ends, waiting work is destroyed without being run. With a width of one it is a
/// serial queue that owns a thread. Work may shut down or destroy the queue that runs it.
///
///     auto queue = std::make_shared<NDConcurrentQueue>(2);
///     queue->async([] { work(); });
///     queue->waitUntilIdle();
class ND_EXPORT NDConcurrentQueue final : public NDQueue {
 public:
  /// `width` is the greatest number of threads, at least 1.
  explicit NDConcurrentQueue(std::size_t width);
  ~NDConcurrentQueue() override;

  void async(NDTask task) override;

  /// Ends the threads and drops waiting work; work added later is dropped. Waits for running work,
  /// unless it is called by a thread of this queue: then each thread ends when its work returns.
  void shutDown();

  /// Blocks until no work is waiting or running. Not to be called by a thread of this queue.
  void waitUntilIdle();

 private:
  struct State;
  // Shared with the threads, so that work may destroy the queue that runs it.
  std::shared_ptr<State> state_;
};

}  // namespace nidus
