#pragma once

#include <cstdint>

namespace nidus {

/// A disk that fails when a test wants it to: the default file system of SQLite in the process that
/// makes one, for connections opened while it lives. Calls that read, write, sync, cut, open,
/// delete, measure or map a file are counted; the counted calls fail from `Fault::firstCall` on.
///
/// One at a time, used by one thread.
///
///     FaultyDisk disk;
///     disk.arm({FaultyDisk::Kind::full, 3, true});
///     write();
///     disk.disarm();
class FaultyDisk {
 public:
  enum class Kind {
    error,      ///< The call does nothing and reports an error.
    shortStep,  ///< Half of what was to be written is written, or read, before the error.
    full,       ///< A call that writes reports that there is no room; others work.
  };
  struct Fault {
    Kind kind = Kind::error;
    std::int64_t firstCall = 1;  ///< Counted from 1.
    bool lasts = false;          ///< All further calls fail too.
  };

  FaultyDisk();
  ~FaultyDisk();
  FaultyDisk(const FaultyDisk&) = delete;
  FaultyDisk& operator=(const FaultyDisk&) = delete;

  /// Counts from 0 and lets the calls fail as `fault` says.
  void arm(const Fault& fault);
  /// Lets all calls work; returns whether one has failed since `arm`.
  bool disarm();
};

}  // namespace nidus
