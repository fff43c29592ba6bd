#pragma once

#include <cstdint>

namespace nidus {

/// Memory of SQLite that runs out when a test wants it to. Made while no connection is open, one at
/// a time, used by one thread.
class FaultyMemory {
 public:
  struct Fault {
    std::int64_t firstAllocation = 1;  ///< Counted from 1.
    bool lasts = false;                ///< All further allocations fail too.
  };

  FaultyMemory();
  ~FaultyMemory();
  FaultyMemory(const FaultyMemory&) = delete;
  FaultyMemory& operator=(const FaultyMemory&) = delete;

  /// Counts from 0 and lets allocations fail as `fault` says.
  void arm(const Fault& fault);
  /// Lets all allocations work; returns whether one has failed since `arm`.
  bool disarm();
};

}  // namespace nidus
