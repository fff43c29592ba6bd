#pragma once

#include <csignal>
#include <memory>

#include "HomePlatform/Result.h"
#include "HomePlatform/System/FileDescriptor.h"

namespace nidus {

/// As long as it lives, the signals that tell the process to end (SIGINT and SIGTERM) do not end it
/// but can be waited for. There is one at a time, used by the main thread.
///
///     auto interruption = Interruption::await();
///     poll({(*interruption)->descriptor(), POLLIN, 0});
class Interruption {
 public:
  [[nodiscard]] static Result<std::unique_ptr<Interruption>> await();
  /// The signals do again what they did before.
  ~Interruption();
  Interruption(const Interruption&) = delete;
  Interruption& operator=(const Interruption&) = delete;

  /// Can be read from the first such signal on.
  [[nodiscard]] int descriptor() const noexcept { return event_.get(); }

 private:
  explicit Interruption(FileDescriptor event);

  const FileDescriptor event_;
  struct sigaction interruptBefore_ = {};
  struct sigaction terminationBefore_ = {};
};

}  // namespace nidus
