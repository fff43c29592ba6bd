#pragma once

#include <sys/types.h>

#include <array>
#include <string>

#include "nidus/ProgramProcess.h"

namespace nidus {

/// How long a program that is alive may be silent, in milliseconds.
inline constexpr int kPatienceMs = 60000;

/// Starts a program with these files as its standard ones.
[[nodiscard]] pid_t spawnProgram(const ProgramStart& start, const std::array<int, 3>& files);

/// Starts a program in a session of its own, whose terminal is the device `terminal`. Its standard
/// files are the terminal, but for an output file of `start`.
[[nodiscard]] pid_t spawnOnTerminal(const ProgramStart& start, const std::string& terminal);

/// Waits for the end of a started program and says how it ended.
[[nodiscard]] ProgramEnd waitForEnd(pid_t process);

}  // namespace nidus
