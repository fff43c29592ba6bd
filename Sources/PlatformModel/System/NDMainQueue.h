#pragma once

#include <condition_variable>
#include <cstddef>
#include <deque>
#include <functional>
#include <memory>

#include "PlatformModel/System/NDExport.h"
#include "PlatformModel/System/NDMutex.h"
#include "PlatformModel/System/NDQueue.h"

namespace nidus {

/// The queue of the process's main thread: work is kept in order until the host drains it.
///
/// The platform supplies it, the host drains it on one thread at a time; an embedder with a loop of
/// its own sets a wake handler and drains when its loop turns. Also serves as a queue that tests
/// and benchmarks drain on the calling thread. Who drains it keeps it alive meanwhile.
///
///     queue->setWakeHandler([&loop] { loop.wake(); });
///     queue->drain();
class ND_EXPORT NDMainQueue final : public NDQueue {
 public:
  NDMainQueue() = default;
  /// Destroys the work that is left, which may add work: that is destroyed too.
  ~NDMainQueue() override;

  void async(NDTask task) override;

  /// Runs one piece of work on the calling thread; false when there was none.
  bool runOne();

  /// Runs work on the calling thread until there is none, work added meanwhile included; gives the
  /// number of pieces run.
  std::size_t drain();

  /// Runs work on the calling thread and waits for more until `isDone`, which is asked before each
  /// piece and after each `wake()`, is true.
  void runUntil(const std::function<bool()>& isDone);

  /// Makes a `runUntil` on another thread ask its condition again.
  void wake();

  /// Sets what is called, on the adding thread and without a lock, after work was added to an empty
  /// queue, and at once when there is work already; an empty handler removes it. A thread that adds
  /// work at that moment may still call the earlier one, which therefore owns what it uses.
  void setWakeHandler(std::function<void()> handler);

 private:
  bool take(NDTask& task);
  std::size_t wakes();
  void waitForWorkOrWake(std::size_t wakesSeen);

  NDMutex mutex_;
  std::condition_variable changed_;
  std::deque<NDTask> tasks_ ND_GUARDED_BY(mutex_);
  std::function<void()> wakeHandler_ ND_GUARDED_BY(mutex_);
  std::size_t wakes_ ND_GUARDED_BY(mutex_) = 0;
};

}  // namespace nidus
