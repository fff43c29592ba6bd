#include "HomePlatform/System/FolderWatch.h"

#include <poll.h>
#include <sys/eventfd.h>
#include <sys/inotify.h>

#include <cerrno>
#include <cstring>
#include <system_error>
#include <utility>

namespace nidus {
namespace {

constexpr std::uint32_t kChanges =
    IN_CLOSE_WRITE | IN_MOVED_TO | IN_MOVED_FROM | IN_DELETE | IN_ONLYDIR;

Failure watchFailure(const std::filesystem::path& folder, int error) {
  return {Failure::Kind::platform,
          folder.string() +
              ": changes cannot be watched: " + std::generic_category().message(error) +
              "; preferences that change are seen by programs started later"};
}

}  // namespace

Result<std::unique_ptr<FolderWatch>> FolderWatch::start(const std::filesystem::path& folder,
                                                        std::string name,
                                                        std::function<void()> onChange) {
  FileDescriptor events(::inotify_init1(IN_CLOEXEC | IN_NONBLOCK));
  if (!events) return watchFailure(folder, errno);
  FileDescriptor stop(::eventfd(0, EFD_CLOEXEC));
  if (!stop) return watchFailure(folder, errno);
  if (::inotify_add_watch(events.get(), folder.c_str(), kChanges) < 0) {
    return watchFailure(folder, errno);
  }
  return std::unique_ptr<FolderWatch>(
      new FolderWatch(std::move(events), std::move(stop), std::move(name), std::move(onChange)));
}

FolderWatch::FolderWatch(FileDescriptor events, FileDescriptor stop, std::string name,
                         std::function<void()> onChange)
    : events_(std::move(events)),
      stop_(std::move(stop)),
      name_(std::move(name)),
      onChange_(std::move(onChange)),
      thread_([this] { run(); }) {}

FolderWatch::~FolderWatch() {
  ::eventfd_write(stop_.get(), 1);
  thread_.join();
}

void FolderWatch::run() {
  onChange_();
  while (waitForEvents()) {
    if (readEvents()) onChange_();
  }
}

/// False when the watch ends.
bool FolderWatch::waitForEvents() const {
  pollfd waited[] = {{events_.get(), POLLIN, 0}, {stop_.get(), POLLIN, 0}};
  while (::poll(waited, 2, -1) < 0) {
    if (errno != EINTR) return false;
  }
  return waited[1].revents == 0;
}

/// Says whether one of the events that wait concerns the file.
bool FolderWatch::readEvents() const {
  alignas(inotify_event) char block[4096];
  bool isConcerned = false;
  for (;;) {
    const ssize_t size = ::read(events_.get(), block, sizeof block);
    if (size <= 0) return isConcerned;
    for (ssize_t at = 0; at < size;) {
      inotify_event event = {};
      std::memcpy(&event, block + at, sizeof event);
      const char* name = block + at + sizeof event;
      const bool isLost = (event.mask & IN_Q_OVERFLOW) != 0;
      if (isLost || (event.len > 0 && name_ == name)) isConcerned = true;
      at += static_cast<ssize_t>(sizeof event + event.len);
    }
  }
}

}  // namespace nidus
