#pragma once

#include <sys/types.h>

#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Support/TestFolder.h"

namespace nidus {

/// How a program is started.
struct ProgramStart {
  std::vector<std::string> arguments;
  std::string input = {};  ///< All of standard input.
  /// Environment variables that differ from those of the test; none removes one.
  std::map<std::string, std::optional<std::string>> environment = {};
  std::string program = NIDUS_PROGRAM;
  std::string outputFile = {};  ///< Takes standard output when it is not empty.
};

/// What a program did.
struct ProgramEnd {
  int exitStatus = -1;  ///< -1 when a signal ended the process.
  int signal = 0;       ///< The signal that ended the process; 0 for none.
  /// The most memory that was resident, no less than the test had when it started the program.
  std::int64_t peakBytes = 0;
  std::string output;  ///< All of standard output, unless a file took it.
  std::string errors;  ///< All of standard error.
};

/// A program that runs beside the test. Its standard input and output are pipes of the test.
class ProgramProcess {
 public:
  /// Starts the program; what `start` says of its input and output is not looked at.
  explicit ProgramProcess(const ProgramStart& start);
  /// Ends the input and waits for the program.
  ~ProgramProcess();
  ProgramProcess(const ProgramProcess&) = delete;
  ProgramProcess& operator=(const ProgramProcess&) = delete;

  void write(std::string_view text) const;
  /// Waits for the next line of its output and gives it without its end; none when the output has
  /// ended or nothing comes for a minute.
  [[nodiscard]] std::optional<std::string> readLine();
  void sendSignal(int signal) const;
  /// Goes away as the reader of its output.
  void closeOutput();
  /// Ends the input, and gives what is left of the output.
  [[nodiscard]] ProgramEnd finish();

 private:
  const TestFolder folder_;
  pid_t process_ = -1;
  int input_ = -1;
  int output_ = -1;
};

/// Runs a program to its end.
[[nodiscard]] ProgramEnd runProgram(const ProgramStart& start);

}  // namespace nidus
