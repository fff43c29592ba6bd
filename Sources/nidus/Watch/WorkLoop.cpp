#include "nidus/Watch/WorkLoop.h"

#include <poll.h>
#include <sys/eventfd.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <system_error>

#include "HomePlatform/System/FileDescriptor.h"
#include "nidus/Watch/Interruption.h"

namespace nidus {
namespace {

Failure waitFailure() {
  return {Failure::Kind::platform,
          "changes cannot be waited for: " + std::generic_category().message(errno) +
              "; end other programs and try again"};
}

/// Lets a queue wake a thread that waits for a file.
class QueueWaker {
 public:
  explicit QueueWaker(NDMainQueue& queue)
      : queue_(queue),
        event_(std::make_shared<FileDescriptor>(::eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK))) {
    queue_.setWakeHandler([event = event_] { ::eventfd_write(event->get(), 1); });
  }
  ~QueueWaker() { queue_.setWakeHandler(nullptr); }
  QueueWaker(const QueueWaker&) = delete;
  QueueWaker& operator=(const QueueWaker&) = delete;

  [[nodiscard]] int descriptor() const { return event_->get(); }
  void reset() const {
    eventfd_t count = 0;
    ::eventfd_read(event_->get(), &count);
  }

 private:
  NDMainQueue& queue_;
  const std::shared_ptr<FileDescriptor> event_;
};

}  // namespace

Status runUntilInterrupted(NDMainQueue& queue, const std::function<bool()>& isDone) {
  const auto interruption = Interruption::await();
  if (!interruption) return interruption.failure();
  const QueueWaker waker(queue);
  std::array<pollfd, 3> waited = {{{(*interruption)->descriptor(), POLLIN, 0},
                                   {waker.descriptor(), POLLIN, 0},
                                   {STDOUT_FILENO, 0, 0}}};
  for (;;) {
    waker.reset();
    queue.drain();
    if (isDone()) return std::nullopt;
    if (::poll(waited.data(), waited.size(), -1) < 0 && errno != EINTR) return waitFailure();
    if (waited[0].revents != 0 || waited[2].revents != 0) return std::nullopt;
  }
}

bool hasReader() {
  pollfd output = {STDOUT_FILENO, 0, 0};
  return ::poll(&output, 1, 0) == 0;
}

}  // namespace nidus
