#include "nidus/Terminal/ForegroundProgram.h"

#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <csignal>
#include <system_error>

#include "nidus/Terminal/ProgramSearch.h"

namespace nidus {
namespace {

/// Leaves a signal to others for a while.
class IgnoredSignal {
 public:
  explicit IgnoredSignal(int signal) : signal_(signal) {
    struct sigaction ignore = {};
    ignore.sa_handler = SIG_IGN;
    sigaction(signal_, &ignore, &before_);
  }
  IgnoredSignal(const IgnoredSignal&) = delete;
  IgnoredSignal& operator=(const IgnoredSignal&) = delete;
  ~IgnoredSignal() { sigaction(signal_, &before_, nullptr); }

 private:
  const int signal_;
  struct sigaction before_ = {};
};

/// The attributes of a program that takes signals as usual, whatever this process does with them.
class UsualSignals {
 public:
  UsualSignals() {
    sigset_t signals;
    sigemptyset(&signals);
    for (const int signal : {SIGINT, SIGQUIT, SIGPIPE}) sigaddset(&signals, signal);
    posix_spawnattr_init(&attributes_);
    posix_spawnattr_setsigdefault(&attributes_, &signals);
    posix_spawnattr_setflags(&attributes_, POSIX_SPAWN_SETSIGDEF);
  }
  UsualSignals(const UsualSignals&) = delete;
  UsualSignals& operator=(const UsualSignals&) = delete;
  ~UsualSignals() { posix_spawnattr_destroy(&attributes_); }
  [[nodiscard]] const posix_spawnattr_t* attributes() const { return &attributes_; }

 private:
  posix_spawnattr_t attributes_ = {};
};

int waitForEnd(pid_t process) {
  constexpr int kSignalled = 128;
  int status = 0;
  while (waitpid(process, &status, 0) < 0 && errno == EINTR) {
  }
  return WIFEXITED(status) ? WEXITSTATUS(status) : kSignalled + WTERMSIG(status);
}

std::vector<char*> pointersTo(std::vector<std::string>& texts) {
  std::vector<char*> pointers;
  pointers.reserve(texts.size() + 1);
  for (std::string& text : texts) pointers.push_back(text.data());
  pointers.push_back(nullptr);
  return pointers;
}

}  // namespace

Result<int> runInForeground(std::vector<std::string> command) {
  const std::string folders = programFolders();
  const std::string program = findProgram(command[0], folders);
  std::vector<std::string> environment = environmentWith(folders);
  const IgnoredSignal interrupt(SIGINT);
  const IgnoredSignal quit(SIGQUIT);
  const UsualSignals signals;
  pid_t process = -1;
  const int error = posix_spawn(&process, program.c_str(), nullptr, signals.attributes(),
                                pointersTo(command).data(), pointersTo(environment).data());
  if (error != 0) {
    return Failure{Failure::Kind::platform, command[0] + ": cannot be started (" +
                                                std::generic_category().message(error) +
                                                "); see that it is installed"};
  }
  return waitForEnd(process);
}

}  // namespace nidus
