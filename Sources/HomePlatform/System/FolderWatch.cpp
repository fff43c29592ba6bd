#include "HomePlatform/System/FolderWatch.h"

#include <poll.h>
#include <sys/eventfd.h>
#include <sys/inotify.h>

#include <algorithm>
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
              "; end other programs that watch files, or raise the limits in /proc/sys/fs/inotify"};
}

}  // namespace

Result<std::unique_ptr<FolderWatch>> FolderWatch::start(const std::filesystem::path& folder,
                                                        WatchedFiles files,
                                                        std::function<void()> onChange) {
  FileDescriptor events(::inotify_init1(IN_CLOEXEC | IN_NONBLOCK));
  if (!events) return watchFailure(folder, errno);
  FileDescriptor stop(::eventfd(0, EFD_CLOEXEC));
  if (!stop) return watchFailure(folder, errno);
  const std::uint32_t changes = kChanges | (files.eachWrite ? std::uint32_t{IN_MODIFY} : 0);
  if (::inotify_add_watch(events.get(), folder.c_str(), changes) < 0) {
    return watchFailure(folder, errno);
  }
  return std::unique_ptr<FolderWatch>(new FolderWatch(std::move(events), std::move(stop),
                                                      std::move(files.names), std::move(onChange)));
}

FolderWatch::FolderWatch(FileDescriptor events, FileDescriptor stop, std::vector<std::string> names,
                         std::function<void()> onChange)
    : events_(std::move(events)),
      stop_(std::move(stop)),
      names_(std::move(names)),
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

bool FolderWatch::isWatched(std::string_view name) const {
  return std::find(names_.begin(), names_.end(), name) != names_.end();
}

/// Says whether one of the events that wait concerns the files.
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
      const bool isForAll = (event.mask & (IN_Q_OVERFLOW | IN_IGNORED)) != 0;
      if (isForAll || (event.len > 0 && isWatched(name))) isConcerned = true;
      at += static_cast<ssize_t>(sizeof event + event.len);
    }
  }
}

}  // namespace nidus
