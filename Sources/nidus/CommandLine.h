#pragma once

namespace nidus {

/// Runs the program with its arguments; the result is the exit status of the process.
int runCommandLine(int argc, const char* const* argv);

}  // namespace nidus
