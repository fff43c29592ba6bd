#include "nidus/ProgramSpawn.h"

#include <fcntl.h>
#include <spawn.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <stdexcept>
#include <string_view>
#include <vector>

namespace nidus {
namespace {

std::vector<char*> pointersTo(std::vector<std::string>& texts) {
  std::vector<char*> pointers;
  for (std::string& text : texts) pointers.push_back(text.data());
  pointers.push_back(nullptr);
  return pointers;
}

std::vector<std::string> environmentOf(const ProgramStart& start) {
  std::vector<std::string> environment;
  for (char** entry = environ; *entry; ++entry) {
    const std::string_view text = *entry;
    if (!start.environment.contains(std::string(text.substr(0, text.find('='))))) {
      environment.emplace_back(text);
    }
  }
  for (const auto& [name, value] : start.environment) {
    if (value) environment.push_back(name + '=' + *value);
  }
  return environment;
}

/// What happens in the new process before the program begins.
class SpawnSettings {
 public:
  SpawnSettings() {
    posix_spawn_file_actions_init(&actions_);
    posix_spawnattr_init(&attributes_);
  }
  SpawnSettings(const SpawnSettings&) = delete;
  SpawnSettings& operator=(const SpawnSettings&) = delete;
  ~SpawnSettings() {
    posix_spawnattr_destroy(&attributes_);
    posix_spawn_file_actions_destroy(&actions_);
  }

  void copyFile(int from, int to) { posix_spawn_file_actions_adddup2(&actions_, from, to); }
  void openFile(int number, const std::string& file, int flags) {
    posix_spawn_file_actions_addopen(&actions_, number, file.c_str(), flags, 0600);
  }
  /// Begins a session; the first terminal that is opened becomes its own. An interrupt ends the
  /// program, whatever it does to the test.
  void beginSession() {
    sigset_t signals = {};
    sigemptyset(&signals);
    sigaddset(&signals, SIGINT);
    posix_spawnattr_setsigdefault(&attributes_, &signals);
    posix_spawnattr_setflags(&attributes_, POSIX_SPAWN_SETSID | POSIX_SPAWN_SETSIGDEF);
  }
  [[nodiscard]] pid_t spawn(const ProgramStart& start) const {
    std::vector<std::string> arguments = {start.program};
    arguments.insert(arguments.end(), start.arguments.begin(), start.arguments.end());
    std::vector<std::string> environment = environmentOf(start);
    pid_t process = -1;
    const int error = posix_spawn(&process, start.program.c_str(), &actions_, &attributes_,
                                  pointersTo(arguments).data(), pointersTo(environment).data());
    if (error != 0) throw std::runtime_error("can not start " + start.program);
    return process;
  }

 private:
  posix_spawn_file_actions_t actions_ = {};
  posix_spawnattr_t attributes_ = {};
};

}  // namespace

pid_t spawnProgram(const ProgramStart& start, const std::array<int, 3>& files) {
  SpawnSettings settings;
  int target = 0;
  for (const int file : files) settings.copyFile(file, target++);
  return settings.spawn(start);
}

pid_t spawnOnTerminal(const ProgramStart& start, const std::string& terminal) {
  SpawnSettings settings;
  settings.beginSession();
  settings.openFile(STDIN_FILENO, terminal, O_RDWR);
  settings.copyFile(STDIN_FILENO, STDOUT_FILENO);
  settings.copyFile(STDIN_FILENO, STDERR_FILENO);
  if (!start.outputFile.empty()) {
    settings.openFile(STDOUT_FILENO, start.outputFile, O_WRONLY | O_CREAT | O_APPEND);
  }
  return settings.spawn(start);
}

ProgramEnd waitForEnd(pid_t process) {
  int status = 0;
  rusage usage = {};
  wait4(process, &status, 0, &usage);
  ProgramEnd end;
  constexpr std::int64_t kKilobyte = 1024;
  end.peakBytes = usage.ru_maxrss * kKilobyte;
  if (WIFEXITED(status)) end.exitStatus = WEXITSTATUS(status);
  if (WIFSIGNALED(status)) end.signal = WTERMSIG(status);
  return end;
}

}  // namespace nidus
