#include "nidus/StandardStreams.h"

#include <unistd.h>

#include <cerrno>
#include <system_error>
#include <utility>

#include "HomePlatform/System/OneLine.h"
#include "PlatformModel/System/NDMutex.h"

namespace nidus {
namespace {

/// What every line on standard error begins with.
class Place {
 public:
  void set(std::string place) {
    const NDLock lock(mutex_);
    place_ = std::move(place);
  }
  [[nodiscard]] std::string get() {
    const NDLock lock(mutex_);
    return place_;
  }

 private:
  NDMutex mutex_;
  std::string place_ ND_GUARDED_BY(mutex_);
};

Place& reportPlace() {
  static Place place;
  return place;
}

}  // namespace

bool writeWhole(int file, std::string_view text) {
  while (!text.empty()) {
    const ssize_t written = write(file, text.data(), text.size());
    if (written >= 0) {
      text.remove_prefix(static_cast<std::size_t>(written));
    } else if (errno != EINTR) {
      return false;
    }
  }
  return true;
}

Status writeOutput(std::string_view text) {
  if (writeWhole(STDOUT_FILENO, text)) return std::nullopt;
  return Failure{Failure::Kind::platform, "standard output: cannot be written (" +
                                              std::generic_category().message(errno) +
                                              "); send it where there is room and a reader"};
}

ExitStatus printText(std::string_view text) {
  const auto failure = writeOutput(text);
  return failure ? report(*failure) : ExitStatus::success;
}

ExitStatus report(const Failure& failure) {
  reportLine(failure.message);
  return failure.kind == Failure::Kind::badInput ? ExitStatus::badInput
                                                 : ExitStatus::platformFailed;
}

void reportLine(std::string_view message) {
  // Where even this can not be written there is nobody left to tell.
  static_cast<void>(
      writeWhole(STDERR_FILENO, "nidus: " + reportPlace().get() + onOneLine(message) + '\n'));
}

ReportPlace::ReportPlace(std::string place) { reportPlace().set(std::move(place)); }

ReportPlace::~ReportPlace() { reportPlace().set(""); }

}  // namespace nidus
