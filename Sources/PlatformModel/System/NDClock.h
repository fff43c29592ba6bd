#pragma once

#include <chrono>
#include <condition_variable>
#include <functional>
#include <mutex>

#include "PlatformModel/System/NDExport.h"

namespace nidus {

/// The time that waits are measured against. Supplied by the platform, so that a test or a replay
/// can move it. Implementations may be called from any thread.
class ND_EXPORT NDClock {
 public:
  using Duration = std::chrono::nanoseconds;
  /// Time since an arbitrary start that never goes back.
  using TimePoint = std::chrono::time_point<std::chrono::steady_clock, Duration>;

  virtual ~NDClock();

  [[nodiscard]] virtual TimePoint now() = 0;

  /// Blocks the calling thread until `isDone` is true or the clock reaches `deadline`; gives the
  /// last answer of `isDone`. `lock` is held on entry, whenever `isDone` is called, and on return;
  /// whoever makes `isDone` true does so under the same mutex and notifies `changed`.
  virtual bool waitUntil(std::unique_lock<std::mutex>& lock, std::condition_variable& changed,
                         TimePoint deadline, const std::function<bool()>& isDone) = 0;
};

/// The steady clock of the machine.
class ND_EXPORT NDSystemClock final : public NDClock {
 public:
  [[nodiscard]] TimePoint now() override;
  bool waitUntil(std::unique_lock<std::mutex>& lock, std::condition_variable& changed,
                 TimePoint deadline, const std::function<bool()>& isDone) override;
};

}  // namespace nidus
