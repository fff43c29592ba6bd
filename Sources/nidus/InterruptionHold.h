#pragma once

#include <array>
#include <csignal>

namespace nidus {

/// Holds back the signals that ask the program to end (interrupt, terminate, hang up) while it
/// lives, so that what must be done whole is done whole. A signal that came meanwhile takes effect
/// when this is destroyed; a second one ends the program at once. A signal that is ignored stays
/// so. Holds may be nested; they are made and destroyed by one thread.
///
///     const InterruptionHold hold;
///     writeBoth();
class InterruptionHold {
 public:
  InterruptionHold();
  ~InterruptionHold();
  InterruptionHold(const InterruptionHold&) = delete;
  InterruptionHold& operator=(const InterruptionHold&) = delete;

 private:
  static constexpr std::array kSignals = {SIGINT, SIGTERM, SIGHUP};

  std::array<struct sigaction, kSignals.size()> earlier_ = {};
};

}  // namespace nidus
