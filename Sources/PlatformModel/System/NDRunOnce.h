#pragma once

#include <atomic>
#include <mutex>
#include <utility>

namespace nidus {

/// Runs a piece of work once, whoever asks first; the others wait for its end.
/// Constant-initialised, so a static one runs no code when it is loaded. May be used from any
/// thread.
class NDRunOnce {
 public:
  constexpr NDRunOnce() noexcept = default;

  /// Runs `work` unless it has run; a later call costs one load.
  template <class Work>
  void run(Work&& work) {
    if (hasRun()) return;
    std::call_once(flag_, [this, &work] {
      std::forward<Work>(work)();
      hasRun_.store(true, std::memory_order_release);
    });
  }

  /// Says whether the work has run to its end.
  [[nodiscard]] bool hasRun() const noexcept { return hasRun_.load(std::memory_order_acquire); }

 private:
  std::once_flag flag_;
  std::atomic<bool> hasRun_{false};
};

}  // namespace nidus
