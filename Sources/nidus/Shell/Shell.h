#pragma once

#include <functional>
#include <iosfwd>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "nidus/CommandSyntax.h"
#include "nidus/Completion/CompletionPoint.h"
#include "nidus/Completion/HomeNames.h"
#include "nidus/ExitStatus.h"
#include "nidus/Shell/LineCompletion.h"
#include "nidus/Workspace.h"

namespace nidus {

/// Runs commands line by line over one workspace: each line is read by a parser of its own, with
/// the same declarations as outside, and an option holds for its line alone.
class Shell {
 public:
  /// `declare` declares the commands that can be run here; `workspace` must outlive the shell.
  Shell(Workspace& workspace, std::function<void(CommandSyntax&)> declare);

  /// Runs the lines of `in`, each before the next is read, to the end or a line that leaves; the
  /// result is the highest of their statuses. A message names the line that it is about.
  ExitStatus runLines(std::istream& in);
  /// Talks with a person on the terminal: asks for lines, remembers and completes them, and says
  /// how long each took.
  ExitStatus talk();

  /// Runs the command in `line`, which may begin with the program's name; a failure is reported.
  ExitStatus runLine(std::string_view line);

  /// What completing the end of `line` does.
  [[nodiscard]] LineCompletion complete(std::string_view line);

 private:
  ExitStatus runWords(std::vector<std::string> words);
  void runTimed(const std::string& line);
  [[nodiscard]] std::vector<std::string> wordsAt(const CompletionPoint& point);

  Workspace& workspace_;
  const std::function<void(CommandSyntax&)> declare_;
  bool isOver_ = false;
  /// What the assistant learned in a sync since the last line was run; none: nothing yet.
  std::optional<std::vector<HomeName>> names_;
};

/// How long something took, for people: "0.4 ms", "12 ms", "1.5 s".
[[nodiscard]] std::string durationText(double milliseconds);

}  // namespace nidus
