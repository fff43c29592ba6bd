#pragma once

#include <memory>

#include "HomePlatform/System/WorkTracker.h"
#include "PlatformModel/System/NDClock.h"
#include "PlatformModel/System/NDMainQueue.h"
#include "PlatformModel/System/NDQueue.h"

namespace nidus {

/// Where the work of a platform runs, and how its end is awaited. May be used from any thread.
class PlatformQueues {
 public:
  /// Queues with threads, which are started as work arrives. A null `clock` takes the machine's.
  [[nodiscard]] static std::unique_ptr<PlatformQueues> makeThreaded(std::shared_ptr<NDClock> clock);
  /// Queues without threads: their work runs on the thread that drains or waits. A null `clock`
  /// takes the one that jumps.
  [[nodiscard]] static std::unique_ptr<PlatformQueues> makeOnCaller(std::shared_ptr<NDClock> clock);
  virtual ~PlatformQueues() = default;

  [[nodiscard]] virtual std::shared_ptr<NDMainQueue> main() const = 0;
  /// The shared concurrent queue, on which accessories answer too.
  [[nodiscard]] virtual std::shared_ptr<NDQueue> shared() const = 0;
  /// On which homes are delivered: apart, so that work that blocks cannot starve it.
  [[nodiscard]] virtual std::shared_ptr<NDQueue> deliveries() const = 0;
  [[nodiscard]] virtual std::shared_ptr<NDClock> clock() const = 0;
  /// Keeps `drain` waiting as long as it, or a copy of it, lives.
  [[nodiscard]] virtual WorkToken token() const = 0;

  /// Runs work, that of the main queue on the calling thread, until there is none anywhere.
  virtual void drain() = 0;
  /// Ends the threads and drops waiting work, but for that of the main queue.
  virtual void shutDown() = 0;
};

}  // namespace nidus
