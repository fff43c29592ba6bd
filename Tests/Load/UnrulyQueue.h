#pragma once

#include <condition_variable>
#include <cstddef>
#include <cstdint>
#include <thread>
#include <vector>

#include "Load/Random.h"
#include "PlatformModel/System/NDMutex.h"
#include "PlatformModel/System/NDQueue.h"

namespace nidus {

/// A queue without manners: runs its work late and in no order, on several threads at once, and
/// parks some of it, which is then never run.
///
/// Work that is parked stays until the shutdown and is destroyed then, as is all that waits.
/// Whoever adds work that is parked finds it in the current `Ledger`.
class UnrulyQueue final : public NDQueue {
 public:
  struct Habits {
    std::uint64_t seed = 0;
    std::size_t threads = 3;
    std::size_t parksOneIn = 200;
  };
  explicit UnrulyQueue(const Habits& habits);
  ~UnrulyQueue() override;

  void async(NDTask task) override;
  /// Blocks while more than `count` pieces of work wait.
  void waitUntilFewer(std::size_t count);
  /// Blocks until nothing waits or runs but what is parked.
  void waitUntilIdle();
  /// Ends the threads and destroys all work, parked or not; work that is added later is destroyed
  /// at once. Not to be called by work.
  void shutDown();

 private:
  void work();
  [[nodiscard]] bool takeAny(NDTask& task);
  void finish();

  const std::size_t parksOneIn_;
  NDMutex mutex_;
  std::condition_variable workAdded_;
  std::condition_variable workDone_;
  Random random_ ND_GUARDED_BY(mutex_);
  std::vector<NDTask> waiting_ ND_GUARDED_BY(mutex_);
  std::vector<NDTask> parked_ ND_GUARDED_BY(mutex_);
  std::size_t running_ ND_GUARDED_BY(mutex_) = 0;
  bool isShutDown_ ND_GUARDED_BY(mutex_) = false;
  std::vector<std::thread> threads_;
};

}  // namespace nidus
