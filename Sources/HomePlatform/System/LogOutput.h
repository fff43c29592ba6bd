#pragma once

#include <memory>
#include <string>

#include "PlatformModel/System/NDSystemLog.h"

namespace nidus {

/// Where the messages of the log go. May be used from any thread.
class LogOutput {
 public:
  virtual ~LogOutput() = default;
  /// Writes one message; what cannot be written is dropped.
  virtual void write(const NDSystemLogMessage& message) = 0;
};

/// The field of that name; empty when it is not there.
[[nodiscard]] const std::string& logField(const NDSystemLogMessage& message, const char* name);

/// A message as one line for people, with its end: its level, its facility and its text. Control
/// characters are written as escapes, so that no text can pass for a line of its own.
[[nodiscard]] std::string logLine(const NDSystemLogMessage& message);

/// Writes lines to standard error, each at once.
[[nodiscard]] std::unique_ptr<LogOutput> makeStandardErrorLog();

/// Writes to the machine's system log, with the level, the facility and the text as fields: to the
/// journal whose socket is `journalSocket`, else, when the machine has one, to the classic log
/// behind `/dev/log`; null when there is neither.
[[nodiscard]] std::unique_ptr<LogOutput> makeSystemLog(const std::string& journalSocket);

inline constexpr const char* kJournalSocket = "/run/systemd/journal/socket";

}  // namespace nidus
