#include <algorithm>
#include <cerrno>
#include <fstream>
#include <iterator>
#include <memory>
#include <optional>
#include <utility>

#include "HomePlatform/Store/HomeDocument.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/HomeInput.h"
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

Status writeDocument(const std::filesystem::path& file, const std::vector<HomeData>& homes) {
  std::ofstream out(file, std::ios::binary);
  writeHomeDocument(out, homes, true);
  out.close();
  return out ? Status() : unwritable(file, errno);
}

/// Whether two files are there and say the same.
bool isSameContent(const std::filesystem::path& a, const std::filesystem::path& b) {
  std::error_code error;
  if (file_size(a, error) != file_size(b, error) || error) return false;
  using Bytes = std::istreambuf_iterator<char>;
  std::ifstream one(a, std::ios::binary);
  std::ifstream other(b, std::ios::binary);
  return std::equal(Bytes(one), Bytes(), Bytes(other), Bytes());
}

/// One edit of the homes, from the document to the database. Of a large home no document is held
/// as a text: they are written to files, and compared there.
class HomeEditor {
 public:
  HomeEditor(HomePlatform& platform, TemporaryFolder folder, TemporaryFolder compared,
             bool isConfirmed)
      : platform_(platform),
        folder_(std::move(folder)),
        compared_(std::move(compared)),
        isConfirmed_(isConfirmed) {}

  ExitStatus run() {
    if (auto failure = writeDocuments()) return report(*failure);
    // As it will be read again: a document tells less than the database in one or two places.
    auto exported = readHomes(file_);
    if (!exported) return report(exported.failure());
    exported_ = std::move(*exported);
    for (;;) {
      if (auto failure = editInForeground(file_)) return giveUp(*failure);
      if (isSameContent(file_, before_)) return sayUnchanged();
      auto edited = readHomes(file_);
      if (edited) return finish(std::move(*edited));
      if (!canAsk()) return giveUp(edited.failure());
      reportLine(edited.failure().message);
      if (!ask("Edit it again?", EmptyAnswer::yes, unchanged_)) {
        return giveUp({Failure::Kind::badInput, "nothing was changed"});
      }
    }
  }

 private:
  /// Writes the homes as they are, once to be edited and once to be compared.
  [[nodiscard]] Status writeDocuments() const {
    const auto homes = platform_.exportHomes();
    if (!homes) return homes.failure();
    if (auto failure = writeDocument(before_, *homes)) return failure;
    if (auto failure = writeDocument(file_, *homes)) return failure;
    std::error_code error;
    std::filesystem::permissions(file_, std::filesystem::perms(0600), error);
    return std::nullopt;
  }

  static ExitStatus sayUnchanged() { return printText("nothing was changed\n"); }

  /// Shows what the person did to the document, and imports it.
  ExitStatus finish(std::vector<HomeData> edited) {
    if (auto failure = writeDocument(after_, edited)) return giveUp(*failure);
    if (isSameContent(after_, before_)) return sayUnchanged();
    const std::string summary = summaryOf(edited);
    showDifference();
    if (auto failure = writeOutput(summary + '\n')) return giveUp(*failure);
    if (!isConfirmed_ && !ask("Import this?", EmptyAnswer::no, unchanged_)) {
      return std::max(ExitStatus::otherOutcome, sayKept());
    }
    std::optional<InterruptionHold> hold;
    const auto failure = platform_.editHomes([&](std::vector<HomeData>& homes) {
      hold.emplace();  // until the change is lasting and the preferences suit it
      auto merged = mergeEdit(std::move(exported_), std::move(edited), std::move(homes));
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
  void showDifference() {
    static_cast<void>(runInForeground({"diff", "-u", "--label", "homes as they are", "--label",
                                       "homes as edited", before_.string(), after_.string()}));
    compared_.reset();
  }

  /// Ends without a change; what the person wrote is kept, if it is anything.
  ExitStatus giveUp(const Failure& failure) {
    std::error_code error;
    const auto size = file_size(file_, error);
    if (error || size == 0 || isSameContent(file_, before_)) return report(failure);
    folder_.keep();
    return report({failure.kind, failure.message + "; " + kept_});
  }

  ExitStatus sayKept() {
    folder_.keep();
    return printText(unchanged_ + '\n');
  }

  HomePlatform& platform_;
  TemporaryFolder folder_;
  std::optional<TemporaryFolder> compared_;  ///< Gone once the difference was shown.
  const bool isConfirmed_;
  const std::filesystem::path file_ = folder_.path() / "homes.json";
  const std::filesystem::path before_ = compared_->path() / "before.json";  ///< As it was exported.
  const std::filesystem::path after_ = compared_->path() / "after.json";    ///< As it was edited.
  const std::string kept_ = "what you edited is kept as " + file_.string();
  const std::string unchanged_ = "nothing was changed; " + kept_;
  std::vector<HomeData> exported_;  ///< What the document said.
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
  auto compared = TemporaryFolder::make();
  if (!compared) return report(compared.failure());
  return HomeEditor((*session)->platform(), std::move(*folder), std::move(*compared), isConfirmed)
      .run();
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
