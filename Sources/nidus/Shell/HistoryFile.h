#pragma once

#include <cstddef>
#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include "HomePlatform/Result.h"

namespace nidus {

/// The lines that a person has typed into the shell, one a line of a file, kept from run to run.
/// The file, and the folder above it, is made with the first line, for its owner alone. Several
/// shells may add to it at once.
class HistoryFile {
 public:
  /// How many lines are kept from run to run.
  static constexpr std::size_t kLines = 1000;

  explicit HistoryFile(std::filesystem::path file) : file_(std::move(file)) {}

  /// The last lines, the oldest first; none when there is no file. A file that has grown long is
  /// cut to them.
  [[nodiscard]] std::vector<std::string> lines() const;
  /// Adds a line, which has no end, and has it in the file when this returns.
  [[nodiscard]] Status add(const std::string& line) const;

 private:
  std::filesystem::path file_;
};

/// Where the history is by the rules of the machine: $XDG_STATE_HOME/nidus/history, else
/// ~/.local/state/nidus/history; none when neither is known.
[[nodiscard]] std::optional<std::filesystem::path> historyPath();

}  // namespace nidus
