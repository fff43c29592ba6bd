#pragma once

namespace nidus {

/// The system's random source of this process, whose next draws fail. One at a time, used by one
/// thread.
class FaultyRandomSource {
 public:
  /// Lets the next `draws` draws fail with `error`, a number such as ENOSYS.
  FaultyRandomSource(int error, int draws);
  ~FaultyRandomSource();
  FaultyRandomSource(const FaultyRandomSource&) = delete;
  FaultyRandomSource& operator=(const FaultyRandomSource&) = delete;

  /// How many of the draws are still to fail.
  [[nodiscard]] static int drawsLeft();
};

}  // namespace nidus
