#include "nidus/InterruptionHold.h"

#include <atomic>
#include <cstddef>

namespace nidus {
namespace {

std::atomic<int> heldSignal = 0;
static_assert(std::atomic<int>::is_always_lock_free, "a signal handler writes it");

void keep(int signal) { heldSignal.store(signal); }

}  // namespace

InterruptionHold::InterruptionHold() {
  struct sigaction holding = {};
  holding.sa_handler = keep;
  // The second of its kind meets the default; calls that wait go on.
  holding.sa_flags = static_cast<int>(SA_RESETHAND | SA_RESTART);
  for (std::size_t i = 0; i < kSignals.size(); ++i) {
    sigaction(kSignals.at(i), nullptr, &earlier_.at(i));
    const bool isIgnored = earlier_.at(i).sa_handler == SIG_IGN;
    if (!isIgnored) sigaction(kSignals.at(i), &holding, nullptr);
  }
}

InterruptionHold::~InterruptionHold() {
  for (std::size_t i = 0; i < kSignals.size(); ++i) {
    sigaction(kSignals.at(i), &earlier_.at(i), nullptr);
  }
  if (const int signal = heldSignal.exchange(0); signal != 0) raise(signal);
}

}  // namespace nidus
