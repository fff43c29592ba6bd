#pragma once

#include <filesystem>
#include <string>

namespace nidus {

/// What one run of `nidus replay` did.
struct ReplayRun {
  int exitStatus = -1;  ///< -1 when a signal ended the process.
  int signal = 0;       ///< The signal that ended the process; 0 for none.
  std::string output;   ///< All of standard output.
  std::string errors;   ///< All of standard error.
};

/// Runs `nidus replay scenario` to its end. `environment` may hold assignments for it, such as
/// "LC_ALL=C".
[[nodiscard]] ReplayRun runReplay(const std::filesystem::path& scenario,
                                  const std::string& environment = "");

}  // namespace nidus
