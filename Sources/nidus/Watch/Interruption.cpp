#include "nidus/Watch/Interruption.h"

#include <sys/eventfd.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <cstdint>
#include <system_error>
#include <utility>

namespace nidus {
namespace {

/// Where the handler tells of a signal; negative for nowhere.
std::atomic<int> toldDescriptor{-1};
static_assert(std::atomic<int>::is_always_lock_free, "a signal handler must not wait");

extern "C" void tellSignal(int /*signal*/) {
  const int error = errno;
  const std::uint64_t one = 1;
  // A counter that is full has been told already.
  [[maybe_unused]] const auto written = ::write(toldDescriptor.load(), &one, sizeof one);
  errno = error;
}

}  // namespace

Result<std::unique_ptr<Interruption>> Interruption::await() {
  FileDescriptor event(::eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK));
  if (event) return std::unique_ptr<Interruption>(new Interruption(std::move(event)));
  return Failure{Failure::Kind::platform,
                 "interruptions cannot be waited for: " + std::generic_category().message(errno) +
                     "; end other programs and try again"};
}

Interruption::Interruption(FileDescriptor event) : event_(std::move(event)) {
  toldDescriptor.store(event_.get());
  struct sigaction telling = {};
  telling.sa_handler = tellSignal;
  telling.sa_flags = SA_RESTART;
  sigaction(SIGINT, &telling, &interruptBefore_);
  sigaction(SIGTERM, &telling, &terminationBefore_);
}

Interruption::~Interruption() {
  sigaction(SIGINT, &interruptBefore_, nullptr);
  sigaction(SIGTERM, &terminationBefore_, nullptr);
  toldDescriptor.store(-1);
}

}  // namespace nidus
