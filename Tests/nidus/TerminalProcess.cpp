#include "nidus/TerminalProcess.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/ioctl.h>
#include <termios.h>
#include <unistd.h>

#include <array>
#include <csignal>
#include <cstdlib>
#include <stdexcept>
#include <utility>

#include "nidus/ProgramSpawn.h"

namespace nidus {
namespace {

constexpr unsigned short kRows = 24;

int openTerminal() {
  const int terminal = posix_openpt(O_RDWR | O_NOCTTY | O_CLOEXEC);
  if (terminal < 0 || grantpt(terminal) != 0 || unlockpt(terminal) != 0) {
    throw std::runtime_error("this machine has no pseudo-terminals; mount devpts at /dev/pts");
  }
  return terminal;
}

std::string deviceOf(int terminal) {
  std::array<char, 64> name = {};
  if (ptsname_r(terminal, name.data(), name.size()) != 0) throw std::runtime_error("no device");
  return name.data();
}

/// Opens the program's side and gives it a size and plain ends of lines.
int openDevice(const std::string& name, unsigned short columns) {
  const int device = open(name.c_str(), O_RDWR | O_NOCTTY | O_CLOEXEC);
  const winsize size = {kRows, columns, 0, 0};
  termios modes = {};
  if (device < 0 || ioctl(device, TIOCSWINSZ, &size) != 0 || tcgetattr(device, &modes) != 0) {
    throw std::runtime_error("can not set up " + name);
  }
  modes.c_oflag &= ~static_cast<tcflag_t>(ONLCR);
  tcsetattr(device, TCSANOW, &modes);
  return device;
}

}  // namespace

TerminalProcess::TerminalProcess(ProgramStart start, unsigned short columns)
    : terminal_(openTerminal()) {
  start.environment.try_emplace("TERM", "xterm-256color");
  start.environment.try_emplace("NO_COLOR", std::nullopt);
  start.environment.try_emplace("COLUMNS", std::nullopt);
  const std::string name = deviceOf(terminal_);
  const int device = openDevice(name, columns);
  process_ = spawnOnTerminal(start, name);
  close(device);
}

TerminalProcess::~TerminalProcess() {
  if (process_ >= 0) {
    kill(process_, SIGKILL);
    static_cast<void>(waitForEnd(process_));
  }
  close(terminal_);
}

void TerminalProcess::write(std::string_view text) const {
  while (!text.empty()) {
    const ssize_t written = ::write(terminal_, text.data(), text.size());
    if (written < 0) return;
    text.remove_prefix(static_cast<std::size_t>(written));
  }
}

bool TerminalProcess::readMore() {
  std::array<char, 4096> part = {};
  pollfd waiting = {terminal_, POLLIN, 0};
  if (poll(&waiting, 1, kPatienceMs) <= 0) return false;
  const ssize_t size = read(terminal_, part.data(), part.size());
  if (size <= 0) return false;
  output_.append(part.data(), static_cast<std::size_t>(size));
  return true;
}

bool TerminalProcess::waitFor(std::string_view text) {
  std::size_t found = output_.find(text, awaited_);
  while (found == std::string::npos && readMore()) found = output_.find(text, awaited_);
  if (found == std::string::npos) return false;
  awaited_ = found + text.size();
  return true;
}

ProgramEnd TerminalProcess::finish() {
  while (readMore()) {
  }
  // A program that neither writes nor ends is not waited for.
  pollfd ended = {terminal_, POLLIN, 0};
  if (poll(&ended, 1, 0) == 0) kill(process_, SIGKILL);
  ProgramEnd end = waitForEnd(std::exchange(process_, -1));
  end.output = output_;
  return end;
}

ProgramEnd runOnTerminal(ProgramStart start, unsigned short columns) {
  return TerminalProcess(std::move(start), columns).finish();
}

}  // namespace nidus
