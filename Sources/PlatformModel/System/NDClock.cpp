#include "PlatformModel/System/NDClock.h"

namespace nidus {

NDClock::~NDClock() = default;

NDClock::TimePoint NDSystemClock::now() { return std::chrono::steady_clock::now(); }

bool NDSystemClock::waitUntil(std::unique_lock<std::mutex>& lock, std::condition_variable& changed,
                              TimePoint deadline, const std::function<bool()>& isDone) {
  return changed.wait_until(lock, deadline, isDone);
}

}  // namespace nidus
