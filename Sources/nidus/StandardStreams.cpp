#include "nidus/StandardStreams.h"

#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstddef>
#include <system_error>
#include <utility>

#include "PlatformModel/System/NDMutex.h"

namespace nidus {
namespace {

constexpr unsigned char byteOf(char c) { return static_cast<unsigned char>(c); }

/// How many bytes of a control character `text` begins with; 0 when it begins with another one.
std::size_t controlSize(std::string_view text) {
  const unsigned char first = byteOf(text[0]);
  if (first < 0x20 || first == 0x7f) return 1;
  // U+0080 to U+009F, which terminals obey too.
  const bool isSecondSet = first == 0xc2 && text.size() > 1 && byteOf(text[1]) < 0xa0;
  return isSecondSet ? 2 : 0;
}

std::string escapeOf(std::string_view bytes) {
  constexpr std::string_view kDigits = "0123456789abcdef";
  std::string escape;
  for (const char c : bytes) {
    escape.append("\\x").append(1, kDigits[byteOf(c) >> 4U]).append(1, kDigits[byteOf(c) & 15U]);
  }
  return escape;
}

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

std::string onOneLine(std::string_view text) {
  std::string line;
  while (!text.empty()) {
    const std::size_t control = controlSize(text);
    const std::string_view next = text.substr(0, std::max<std::size_t>(control, 1));
    line += control == 0 ? std::string(next) : escapeOf(next);
    text.remove_prefix(next.size());
  }
  return line;
}

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
