#include <algorithm>
#include <memory>
#include <optional>
#include <sstream>
#include <utility>

#include "AssistantHost/InputFile.h"
#include "HomePlatform/Store/HomeDocument.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/FileReplacement.h"
#include "nidus/HomeEditing/HomeDifference.h"
#include "nidus/HomeEditing/HomeMerge.h"
#include "nidus/InterruptionHold.h"
#include "nidus/StandardStreams.h"
#include "nidus/TemporaryFolder.h"
#include "nidus/Terminal/Editor.h"
#include "nidus/Terminal/ForegroundProgram.h"
#include "nidus/Terminal/Question.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

std::string documentOf(const std::vector<HomeData>& homes) {
  std::ostringstream out;
  writeHomeDocument(out, homes, true);
  return out.str();
}

/// As much of the file as a document may have, and a byte more if it has more.
std::string contentOf(const std::filesystem::path& file) {
  auto in = openInput(file);
  if (!in) return {};
  auto content = readUpTo(kHomeDocumentLimits.documentBytes + 1, *in, file.string());
  return content ? std::move(*content) : std::string();
}

Result<std::vector<HomeData>> read(const std::string& document, const std::string& name) {
  std::istringstream in(document);
  return readHomeDocument(in, name);
}

/// One edit of the homes, from the document to the database.
class HomeEditor {
 public:
  HomeEditor(HomePlatform& platform, TemporaryFolder folder, bool isConfirmed)
      : platform_(platform), folder_(std::move(folder)), isConfirmed_(isConfirmed) {}

  ExitStatus run() {
    if (auto failure = writeDocument()) return report(*failure);
    for (;;) {
      if (auto failure = editInForeground(file_)) return giveUp(*failure);
      const std::string text = contentOf(file_);
      if (text == before_) return sayUnchanged();
      auto edited = read(text, file_.string());
      if (edited) return finish(std::move(*edited));
      if (!canAsk()) return giveUp(edited.failure());
      reportLine(edited.failure().message);
      if (!ask("Edit it again?", EmptyAnswer::yes)) {
        return giveUp({Failure::Kind::badInput, "nothing was changed"});
      }
    }
  }

 private:
  [[nodiscard]] Status writeDocument() {
    const auto homes = platform_.exportHomes();
    if (!homes) return homes.failure();
    before_ = documentOf(*homes);
    // As it will be read again: a document tells less than the database in one or two places.
    auto exported = read(before_, file_.string());
    if (!exported) return exported.failure();
    exported_ = std::move(*exported);
    if (auto failure = replaceFile(file_, before_)) return failure;
    std::error_code error;
    std::filesystem::permissions(file_, std::filesystem::perms(0600), error);
    return std::nullopt;
  }

  static ExitStatus sayUnchanged() { return printText("nothing was changed\n"); }

  /// Shows what the person did to the document, and imports it.
  ExitStatus finish(std::vector<HomeData> edited) {
    const std::string after = documentOf(edited);
    if (after == before_) return sayUnchanged();
    const std::string summary = summaryOf(edited);
    if (auto failure = showDifference(after)) return giveUp(*failure);
    if (auto failure = writeOutput(summary + '\n')) return giveUp(*failure);
    if (!isConfirmed_ && !ask("Import this?")) {
      return std::max(ExitStatus::otherOutcome, sayKept("nothing was changed; "));
    }
    std::optional<InterruptionHold> hold;
    const auto failure = platform_.editHomes([&](std::vector<HomeData>& homes) {
      hold.emplace();  // until the change is lasting and the preferences suit it
      auto merged = mergeEdit(exported_, std::move(edited), homes);
      if (!merged) return Status(merged.failure());
      homes = std::move(*merged);
      return Status();
    });
    return failure ? giveUp(*failure) : printText("imported\n");
  }

  [[nodiscard]] std::string summaryOf(const std::vector<HomeData>& edited) const {
    const std::string summary = differenceText(exported_, edited);
    return summary.empty() ? "the order changed" : summary;
  }

  /// Has the two documents compared line by line; without a program that can, the summary has to
  /// do.
  [[nodiscard]] Status showDifference(const std::string& after) const {
    const auto was = folder_.path() / "before.json";
    const auto is = folder_.path() / "after.json";
    if (auto failure = replaceFile(was, before_)) return failure;
    if (auto failure = replaceFile(is, after)) return failure;
    static_cast<void>(runInForeground({"diff", "-u", "--label", "homes as they are", "--label",
                                       "homes as edited", was.string(), is.string()}));
    std::error_code ignored;
    std::filesystem::remove(was, ignored);
    std::filesystem::remove(is, ignored);
    return std::nullopt;
  }

  /// Ends without a change; what the person wrote is kept, if it is anything.
  ExitStatus giveUp(const Failure& failure) {
    const std::string text = contentOf(file_);
    if (text.empty() || text == before_) return report(failure);
    folder_.keep();
    return report(
        {failure.kind, failure.message + "; what you edited is kept as " + file_.string()});
  }

  ExitStatus sayKept(const std::string& outcome) {
    folder_.keep();
    return printText(outcome + "what you edited is kept as " + file_.string() + '\n');
  }

  HomePlatform& platform_;
  TemporaryFolder folder_;
  const bool isConfirmed_;
  const std::filesystem::path file_ = folder_.path() / "homes.json";
  std::string before_;              ///< The document as it was exported.
  std::vector<HomeData> exported_;  ///< What it says.
};

ExitStatus editHomes(bool isConfirmed, Workspace& workspace) {
  if (!isConfirmed && !canAsk()) {
    return report({Failure::Kind::badInput,
                   "there is no terminal to ask on; give --yes to import what the editor leaves"});
  }
  const auto session = workspace.home();
  if (!session) return report(session.failure());
  auto folder = TemporaryFolder::make();
  if (!folder) return report(folder.failure());
  return HomeEditor((*session)->platform(), std::move(*folder), isConfirmed).run();
}

}  // namespace

void declareHomeEdit(CommandSyntax& home, Workspace& workspace) {
  const auto isConfirmed = std::make_shared<bool>(false);
  CommandSyntax& syntax = home.command(
      "edit", "Opens the homes as a document in an editor and imports what it leaves",
      "The editor is that of the environment variable VISUAL, else EDITOR, else the machine's "
      "own.\n"
      "The document is checked, the difference is shown, and nothing is imported without a yes.\n"
      "Values that others change meanwhile and that you leave alone stay as they are then. A\n"
      "document that is not imported is kept, and its place is told.\n\n"
      "Examples:\n"
      "  nidus home edit\n"
      "  EDITOR=nano nidus home edit\n\n"
      "Exit status: 0 imported or nothing to import, 1 the answer was no, 2 bad input, 4 the\n"
      "platform failed.");
  syntax.flag("--yes", *isConfirmed, "Import without a question");
  syntax.run([isConfirmed, &workspace] { return editHomes(*isConfirmed, workspace); });
}

}  // namespace nidus
