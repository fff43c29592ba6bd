#pragma once

#include <sys/types.h>

#include <cstddef>
#include <string>
#include <string_view>

#include "nidus/ProgramProcess.h"

namespace nidus {

/// A program that runs on a terminal of its own beside the test. The terminal echoes what is
/// written to it and turns control characters into signals, as a person's does; the ends of lines
/// are as the program writes them.
///
///     TerminalProcess terminal(start({"home", "remove", "room", "Attic"}));
///     ASSERT_TRUE(terminal.waitFor("[y/n]"));
///     terminal.write("y\n");
///     EXPECT_EQ(terminal.finish().exitStatus, 0);
class TerminalProcess {
 public:
  /// Starts the program on a terminal of `columns`; the input of `start` is not looked at. Unless
  /// `start` says something else, TERM is "xterm-256color" and NO_COLOR is not set.
  explicit TerminalProcess(ProgramStart start, unsigned short columns = 80);
  /// Kills the program unless it was finished.
  ~TerminalProcess();
  TerminalProcess(const TerminalProcess&) = delete;
  TerminalProcess& operator=(const TerminalProcess&) = delete;

  /// Types `text`; "\n" is the key for return, "\x04" ends the input.
  void write(std::string_view text) const;
  /// Types the key for an interrupt.
  void interrupt() const { write("\x03"); }
  /// Waits until `text` has come since the end of what was waited for before; false when the
  /// output has ended or nothing comes for a minute.
  [[nodiscard]] bool waitFor(std::string_view text);
  /// What was written to the terminal up to now, as far as it was waited for.
  [[nodiscard]] const std::string& output() const { return output_; }
  /// Waits for the program to end by itself. The output is all that came on the terminal.
  [[nodiscard]] ProgramEnd finish();

 private:
  /// Reads what comes next; false at the end of the output or when nothing comes for a minute.
  bool readMore();

  int terminal_ = -1;
  pid_t process_ = -1;
  std::string output_;
  std::size_t awaited_ = 0;
};

/// Runs a program to its end on a terminal.
[[nodiscard]] ProgramEnd runOnTerminal(ProgramStart start, unsigned short columns = 80);

}  // namespace nidus
