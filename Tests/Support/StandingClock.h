#pragma once

#include <condition_variable>
#include <functional>
#include <mutex>

#include "PlatformModel/System/NDClock.h"

namespace nidus {

/// A clock that stands still: no wait of the plug-in can time out, however loaded the machine is.
class StandingClock final : public NDClock {
 public:
  [[nodiscard]] TimePoint now() override { return TimePoint(); }
  bool waitUntil(std::unique_lock<std::mutex>& lock, std::condition_variable& changed,
                 TimePoint /*deadline*/, const std::function<bool()>& isDone) override {
    changed.wait(lock, isDone);
    return true;
  }
};

}  // namespace nidus
