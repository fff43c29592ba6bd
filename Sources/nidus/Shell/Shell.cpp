#include "nidus/Shell/Shell.h"

#include <algorithm>
#include <array>
#include <chrono>
#include <cstddef>
#include <cstdio>
#include <iomanip>
#include <iostream>
#include <sstream>
#include <utility>

#include "AssistantHost/InputLines.h"
#include "AssistantHost/SyncClient.h"
#include "nidus/CommandLine.h"
#include "nidus/Completion/Completion.h"
#include "nidus/Shell/HistoryFile.h"
#include "nidus/Shell/LineEditor.h"
#include "nidus/Shell/LineWords.h"
#include "nidus/StandardStreams.h"
#include "nidus/Terminal/Terminal.h"

namespace nidus {
namespace {

constexpr const char kGreeting[] =
    "Commands as outside, without nidus before them: get power --room Kitchen\n"
    "help lists them, exit leaves.\n";

/// What the shell does itself.
constexpr std::array<std::string_view, 3> kOwnCommands = {"help", "exit", "quit"};
constexpr std::array<std::string_view, 2> kLeaving = {"exit", "quit"};
/// Commands that work on homes of their own, never end, or are for shells.
constexpr std::array<std::string_view, 6> kRunOutside = {"demo",  "replay",   "shell",
                                                         "watch", "complete", "completion"};

template <typename Words>
bool isOneOf(std::string_view word, const Words& words) {
  return std::find(words.begin(), words.end(), word) != words.end();
}

/// Drops a first word that may be left out.
bool drop(std::string_view first, std::vector<std::string>& words) {
  if (words.empty() || words.front() != first) return false;
  words.erase(words.begin());
  return true;
}

std::vector<HomeName> namesOfSync(Session& session) {
  const auto sync = SyncClient::make(session.module());
  if (!sync) return {};
  (*sync)->begin(kSyncKey);
  std::vector<HomeName> names;
  for (const SyncChange& change : (*sync)->allChanges()) {
    if (!change.object) continue;
    if (auto name = nameOf(*change.object)) names.push_back(std::move(*name));
  }
  (*sync)->end();
  return names;
}

/// The lines of earlier runs and of this one.
class LineMemory {
 public:
  explicit LineMemory(LineEditor& editor) : editor_(editor) {
    const auto path = historyPath();
    if (!path) return;
    file_.emplace(*path);
    for (const std::string& line : file_->lines()) editor_.remember(line);
  }

  void add(const std::string& line) {
    editor_.remember(line);
    if (!file_) return;
    if (auto failure = file_->add(line)) {
      report(*failure);
      file_.reset();
    }
  }

 private:
  LineEditor& editor_;
  std::optional<HistoryFile> file_;  ///< None where there is no place for it.
};

}  // namespace

Shell::Shell(Workspace& workspace, std::function<void(CommandSyntax&)> declare)
    : workspace_(workspace), declare_(std::move(declare)) {}

ExitStatus Shell::runLines(std::istream& in) {
  ExitStatus highest = ExitStatus::success;
  InputLines lines(in);
  while (!isOver_ && lines.next()) {
    const ReportPlace place("line " + std::to_string(lines.number()) + ": ");
    highest = std::max(highest, runLine(lines.line()));
  }
  if (!lines.isTooLong()) return highest;
  const ReportPlace place("line " + std::to_string(lines.number()) + ": ");
  return std::max(highest, report({Failure::Kind::badInput, lines.tooLongText()}));
}

ExitStatus Shell::talk() {
  if (const auto failed = printText(kGreeting); failed != ExitStatus::success) return failed;
  LineEditor editor("nidus> ", [this](std::string_view line) { return complete(line); });
  LineMemory memory(editor);
  while (!isOver_) {
    const auto line = editor.readLine();
    if (!line) return printText("\n");
    if (line->find_first_not_of(" \t") == std::string::npos) continue;
    memory.add(*line);
    runTimed(*line);
  }
  return ExitStatus::success;
}

void Shell::runTimed(const std::string& line) {
  const auto begin = std::chrono::steady_clock::now();
  static_cast<void>(runLine(line));
  const std::chrono::duration<double, std::milli> took = std::chrono::steady_clock::now() - begin;
  if (isOver_) return;
  // A command may have read the input to its end; the next one can read again.
  std::clearerr(stdin);
  std::cin.clear();
  const std::string text =
      coloured(durationText(took.count()), Colour::faint, standardOutputStyle());
  static_cast<void>(printText(text + '\n'));
}

ExitStatus Shell::runLine(std::string_view line) {
  auto words = wordsOf(line);
  if (!words) return report(words.failure());
  if (words->empty()) return ExitStatus::success;
  drop("nidus", *words);
  const Settings outer = workspace_.settings();
  const ExitStatus status = runWords(std::move(*words));
  workspace_.settings() = outer;
  names_.reset();
  return status;
}

ExitStatus Shell::runWords(std::vector<std::string> words) {
  const std::string first = words.empty() ? "" : words.front();
  if (isOneOf(first, kLeaving) && words.size() == 1) {
    isOver_ = true;
    return ExitStatus::success;
  }
  if (isOneOf(first, kRunOutside)) {
    return report({Failure::Kind::badInput,
                   first + " is run outside of the shell; leave with exit, then nidus " + first});
  }
  if (drop("help", words)) words.emplace_back("--help");
  return runCommand(std::move(words), declare_, CommandPlace::shell);
}

LineCompletion Shell::complete(std::string_view line) {
  UnfinishedLine unfinished = unfinishedLineOf(line);
  std::vector<std::string>& words = unfinished.words;
  if (words.size() > 1) drop("nidus", words);
  const bool isFirst = words.size() == 1;
  if (!isFirst) drop("help", words);
  const Settings outer = workspace_.settings();
  CommandOutline program;
  declare_(program);
  CompletionPoint point = completionPointOf(program, words);
  workspace_.settings() = outer;
  if (isFirst) point.texts.insert(point.texts.end(), kOwnCommands.begin(), kOwnCommands.end());
  return lineCompletion(line, wordsAt(point));
}

std::vector<std::string> Shell::wordsAt(const CompletionPoint& point) {
  const auto session = workspace_.assistant();
  if (!session) return {};
  if (needsHome(point) && !names_) names_ = namesOfSync(**session);
  Completion completion = completionAt(point, names_.value_or(std::vector<HomeName>()),
                                       (*session)->platform().vocabulary());
  if (completion.isFile) {
    const std::string option = point.word.substr(0, point.valueStart);
    for (const auto& file : filesThatBeginWith(point.word.substr(point.valueStart))) {
      completion.words.push_back(option + file);
    }
  }
  return completion.words;
}

std::string durationText(double milliseconds) {
  std::ostringstream text;
  text << std::fixed;
  if (milliseconds < 9.95) {
    text << std::setprecision(1) << milliseconds << " ms";
  } else if (milliseconds < 999.5) {
    text << std::setprecision(0) << milliseconds << " ms";
  } else {
    text << std::setprecision(1) << milliseconds / 1000 << " s";
  }
  return text.str();
}

}  // namespace nidus
