#include <algorithm>
#include <cstddef>
#include <memory>

#include "HomePlatform/Store/BackupList.h"
#include "HomePlatform/System/DataFolder.h"
#include "HomePlatform/System/OneLine.h"
#include "nidus/CommandLine.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Completion/Completion.h"
#include "nidus/Shell/LineWords.h"
#include "nidus/StandardStreams.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

/// What a shell asks to complete.
struct Request {
  /// Without the name of the program; or, when `isTyped`, the line as it was typed up to the cursor
  /// and the end of it that the shell is going to replace.
  std::vector<std::string> words;
  bool isTyped = false;
};

/// The backups of the data folder, which are wanted most when its homes cannot be read.
std::vector<HomeName> backupNames(const Workspace& workspace) {
  std::vector<HomeName> names;
  const auto folder = dataFolderOf(workspace.settings());
  if (!folder) return names;
  for (const auto& backup : backupsOf(*folder / kDatabaseFile)) {
    names.push_back({CandidateKind::backups, backup.filename().string(), {}});
  }
  return names;
}

/// The names are those of the data folder, if it has a database; without one nothing is made.
Result<Completion> completeAt(const std::vector<std::string>& words, Workspace& workspace) {
  CommandOutline program;
  declareProgram(program, workspace);
  const CompletionPoint point = completionPointOf(program, words);
  if (!needsHome(point)) return completionAt(point, backupNames(workspace), {});
  HomePlatformOptions options;
  options.drainsOnCaller = true;
  const auto folder = dataFolderOf(workspace.settings());
  if (folder && HomePlatform::hasDatabase(*folder)) options.dataFolder = *folder;
  const auto platform = HomePlatform::open(std::move(options));
  if (!platform) return platform.failure();
  const auto homes = (*platform)->exportHomes();
  if (!homes) return homes.failure();
  return completionAt(point, namesIn(*homes), (*platform)->vocabulary());
}

/// The words as they go in place of what the shell replaces; none that would change what is before.
void replaceEndOf(const UnfinishedLine& line, std::size_t replacedSize, Completion& completion) {
  const std::size_t size = line.typed.size();
  const std::string kept = line.typed.substr(0, size - std::min(size, replacedSize));
  std::vector<std::string> ends;
  for (const std::string& word : completion.words) {
    const std::string typed = typedFormOf(word, line);
    if (typed.compare(0, kept.size(), kept) == 0) ends.push_back(typed.substr(kept.size()));
  }
  completion.words = std::move(ends);
}

ExitStatus printCompletion(const Completion& completion) {
  std::string lines;
  for (const std::string& word : completion.words) lines += onOneLine(word) + '\n';
  if (completion.isFile) lines += '\n';
  return printText(lines);
}

ExitStatus completeWords(const std::vector<std::string>& words, Workspace& workspace) {
  const auto completion = completeAt(words, workspace);
  return completion ? printCompletion(*completion) : report(completion.failure());
}

ExitStatus completeLine(const std::string& typed, std::size_t replacedSize, Workspace& workspace) {
  const UnfinishedLine line = unfinishedLineOf(typed);
  auto completion = completeAt({line.words.begin() + 1, line.words.end()}, workspace);
  if (!completion) return report(completion.failure());
  replaceEndOf(line, replacedSize, *completion);
  return printCompletion(*completion);
}

ExitStatus complete(const Request& request, Workspace& workspace) {
  const auto& words = request.words;
  if (!request.isTyped) return completeWords(words, workspace);
  return completeLine(words.front(), words.size() < 2 ? 0 : words[1].size(), workspace);
}

}  // namespace

void declareComplete(CommandSyntax& program, Workspace& workspace) {
  const auto request = std::make_shared<Request>();
  CommandSyntax& syntax = program.command(
      "complete", "Prints what an unfinished command can become",
      "One word a line; an empty line stands for the names of files. For the scripts that\n"
      "nidus completion prints.");
  syntax.flag("--typed", request->isTyped,
              "WORDS are the line as it was typed and the end of it that is replaced");
  syntax.requiredArguments("WORDS", request->words, "The words so far; the last is unfinished");
  syntax.hide();
  syntax.run([request, &workspace] { return complete(*request, workspace); });
}

}  // namespace nidus
