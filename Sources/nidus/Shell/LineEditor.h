#pragma once

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "nidus/Shell/LineCompletion.h"

namespace nidus {

/// Reads lines from a person on the terminal of the program, who can edit them, go back to earlier
/// ones and have them completed. An interrupt throws the line away. One at a time, used by one
/// thread.
///
///     LineEditor editor("nidus> ", complete);
///     while (const auto line = editor.readLine()) run(*line);
class LineEditor {
 public:
  /// Completes a line that ends at the cursor.
  using Completer = std::function<LineCompletion(std::string_view line)>;

  LineEditor(std::string prompt, Completer completer);
  ~LineEditor();
  LineEditor(const LineEditor&) = delete;
  LineEditor& operator=(const LineEditor&) = delete;

  /// Adds an earlier line, which the person can go back to.
  void remember(const std::string& line);
  /// The next line without its end, empty for one that was thrown away; none at the end of the
  /// input.
  [[nodiscard]] std::optional<std::string> readLine();

 private:
  class Terminal;
  const std::unique_ptr<Terminal> terminal_;
};

}  // namespace nidus
