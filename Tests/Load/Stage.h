#pragma once

#include <cstddef>
#include <functional>

#include "Load/Random.h"

namespace nidus {

/// A platform under load, and what callers do on it. A round is begun and ended by one thread, on
/// which the main queue runs; callers are other threads, each with a number and numbers to draw.
class Stage {
 public:
  virtual ~Stage() = default;

  /// `commands` is how many will be given.
  virtual void beginRound(std::size_t commands, Random& random) = 0;
  /// A command; may return before it is answered.
  virtual void command(std::size_t caller, Random& random) = 0;
  virtual void sync(std::size_t caller, Random& random) = 0;
  /// A change of the homes, at the same time as what the others do.
  virtual void change(std::size_t caller, Random& random) = 0;
  /// Runs the main queue until all callers have gone home, of which `wakeMainQueue` tells.
  virtual void runMainQueue(const std::function<bool()>& haveCallersGone) = 0;
  virtual void wakeMainQueue() = 0;
  /// Brings everything to rest, and complains of what is left.
  virtual void endRound() = 0;
};

}  // namespace nidus
