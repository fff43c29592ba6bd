#include "nidus/StandardStreams.h"

#include <unistd.h>

#include <cerrno>
#include <cstddef>
#include <system_error>

namespace nidus {
std::string onOneLine(std::string_view text) {
  constexpr char kDigits[] = "0123456789abcdef";
  std::string line;
  for (const char c : text) {
    const auto byte = static_cast<unsigned char>(c);
    if (byte >= 0x20 && byte != 0x7f) {
      line += c;
    } else {
      line.append("\\x").append(1, kDigits[byte >> 4]).append(1, kDigits[byte & 15]);
    }
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
  static_cast<void>(writeWhole(STDERR_FILENO, "nidus: " + onOneLine(message) + '\n'));
}

}  // namespace nidus
