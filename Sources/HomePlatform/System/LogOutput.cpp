#include "HomePlatform/System/LogOutput.h"

#include <fcntl.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <syslog.h>
#include <unistd.h>

#include <cstdint>
#include <cstring>
#include <string_view>

#include "HomePlatform/System/FileDescriptor.h"
#include "HomePlatform/System/OneLine.h"

namespace nidus {
namespace {

constexpr const char* kClassicSocket = "/dev/log";
constexpr std::string_view kLevelNames[] = {"emergency", "alert",  "critical", "error",
                                            "warning",   "notice", "info",     "debug"};

/// The level as a number from 0 to 7; a level that is none of these counts as debug.
int levelOf(const NDSystemLogMessage& message) {
  const std::string& level = logField(message, "Level");
  const bool isKnown = level.size() == 1 && level[0] >= '0' && level[0] <= '7';
  return isKnown ? level[0] - '0' : LOG_DEBUG;
}

class StandardErrorLog final : public LogOutput {
 public:
  void write(const NDSystemLogMessage& message) override {
    const std::string line = logLine(message);
    const ssize_t written = ::write(STDERR_FILENO, line.data(), line.size());
    static_cast<void>(written);  // there is no place left to complain to
  }
};

/// Appends a field in the journal's own form, which takes any text as it is.
void appendJournalField(std::string& out, std::string_view name, std::string_view text) {
  out += name;
  out += '\n';
  for (std::uint64_t size = text.size(), byte = 0; byte < sizeof size; ++byte) {
    out += static_cast<char>(size >> (8 * byte) & 0xFFU);
  }
  out += text;
  out += '\n';
}

class JournalLog final : public LogOutput {
 public:
  explicit JournalLog(FileDescriptor socket) : socket_(std::move(socket)) {}

  void write(const NDSystemLogMessage& message) override {
    std::string datagram;
    appendJournalField(datagram, "MESSAGE", logField(message, "Message"));
    appendJournalField(datagram, "PRIORITY", std::to_string(levelOf(message)));
    appendJournalField(datagram, "NIDUS_FACILITY", logField(message, "Facility"));
    appendJournalField(datagram, "SYSLOG_IDENTIFIER", "nidus");
    ::send(socket_.get(), datagram.data(), datagram.size(), MSG_NOSIGNAL | MSG_DONTWAIT);
  }

 private:
  const FileDescriptor socket_;
};

class ClassicLog final : public LogOutput {
 public:
  void write(const NDSystemLogMessage& message) override {
    const std::string line =
        onOneLine(logField(message, "Facility") + ": " + logField(message, "Message"));
    ::syslog(LOG_USER | levelOf(message), "%s", line.c_str());
  }
};

FileDescriptor connectTo(const std::string& path) {
  sockaddr_un address = {};
  address.sun_family = AF_UNIX;
  if (path.size() >= sizeof address.sun_path) return FileDescriptor();
  std::memcpy(address.sun_path, path.c_str(), path.size());
  FileDescriptor socket(::socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0));
  if (!socket) return socket;
  const auto* generic = reinterpret_cast<const sockaddr*>(&address);
  if (::connect(socket.get(), generic, sizeof address) != 0) return FileDescriptor();
  return socket;
}

}  // namespace

const std::string& logField(const NDSystemLogMessage& message, const char* name) {
  static const std::string kNone;
  const auto field = message.fields().find(name);
  return field == message.fields().end() ? kNone : field->second;
}

std::string logLine(const NDSystemLogMessage& message) {
  std::string line(kLevelNames[levelOf(message)]);
  line += " (" + std::to_string(levelOf(message)) + ") ";
  line += onOneLine(logField(message, "Facility") + ": " + logField(message, "Message"));
  return line + '\n';
}

std::unique_ptr<LogOutput> makeStandardErrorLog() { return std::make_unique<StandardErrorLog>(); }

std::unique_ptr<LogOutput> makeSystemLog(const std::string& journalSocket) {
  if (FileDescriptor journal = connectTo(journalSocket)) {
    return std::make_unique<JournalLog>(std::move(journal));
  }
  if (::access(kClassicSocket, W_OK) == 0) return std::make_unique<ClassicLog>();
  return nullptr;
}

}  // namespace nidus
