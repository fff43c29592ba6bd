#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace nidus {

/// What one run of `nidus replay` did.
struct ReplayRun {
  int exitStatus = -1;  ///< -1 when a signal ended the process.
  int signal = 0;       ///< The signal that ended the process; 0 for none.
  std::string output;   ///< All of standard output.
  std::string errors;   ///< All of standard error.
};

/// A folder for the files of one test, removed with all that is in it.
class ScratchFolder {
 public:
  ScratchFolder();
  ~ScratchFolder();
  ScratchFolder(const ScratchFolder&) = delete;
  ScratchFolder& operator=(const ScratchFolder&) = delete;

  [[nodiscard]] const std::filesystem::path& path() const { return path_; }
  /// Makes or replaces a file and returns its path.
  std::filesystem::path write(const std::string& name, std::string_view content) const;

 private:
  std::filesystem::path path_;
};

/// The content of a file; empty when it cannot be read.
[[nodiscard]] std::string contentOf(const std::filesystem::path& file);

/// Runs `nidus replay scenario` to its end. `environment` may hold assignments for it, such as
/// "LC_ALL=C".
[[nodiscard]] ReplayRun runReplay(const std::filesystem::path& scenario,
                                  const std::string& environment = "");

}  // namespace nidus
