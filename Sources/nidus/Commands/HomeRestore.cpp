#include <sys/stat.h>

#include <algorithm>
#include <ctime>
#include <memory>
#include <string>

#include "HomePlatform/HomeRestoration.h"
#include "HomePlatform/Store/BackupList.h"
#include "HomePlatform/System/DataFolder.h"
#include "nidus/CommandSyntax.h"
#include "nidus/Commands/Commands.h"
#include "nidus/Commands/ExitStatusText.h"
#include "nidus/Commands/HomeInput.h"
#include "nidus/InterruptionHold.h"
#include "nidus/StandardStreams.h"
#include "nidus/Terminal/TextTable.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;

struct RestoreOptions {
  std::string backup;  ///< Empty: the newest good one.
  bool lists = false;
};

/// When a backup was made, in the local time; empty when it is gone.
std::string timeOf(const fs::path& backup) {
  struct stat status = {};
  std::tm local = {};
  if (::stat(backup.c_str(), &status) != 0) return {};
  if (!::localtime_r(&status.st_mtim.tv_sec, &local)) return {};
  std::string text(sizeof "2026-01-31 12:00:00", '\0');
  text.resize(std::strftime(text.data(), text.size(), "%Y-%m-%d %H:%M:%S", &local));
  return text;
}

ExitStatus listBackups(const fs::path& folder) {
  TextTable table({"BACKUP", "TIME", "HOMES", "ACCESSORIES", "STATE"});
  for (const fs::path& backup : backupsOf(folder / kDatabaseFile)) {
    const std::string name = backup.filename().string();
    if (const auto homes = homesOfBackup(backup)) {
      table.addRow({name, timeOf(backup), std::to_string(homes->size()),
                    std::to_string(accessoriesOf(*homes)), TextCell("good", Colour::good)});
    } else {
      table.addRow({name, timeOf(backup), "", "", TextCell("damaged", Colour::bad)});
    }
  }
  if (table.empty()) return printText("there are no backups of the homes yet\n");
  return printText(table.text(standardOutputStyle()));
}

/// Whether `word` is the name of `backup`, or the number in it.
bool isMeant(const fs::path& backup, const std::string& word) {
  const std::string name = backup.filename().string();
  if (name == word) return true;
  const std::string stem = backup.stem().string();
  const std::string number = stem.substr(stem.rfind('-') + 1);
  return number.substr(number.find_first_not_of('0')) == word;
}

Result<fs::path> choose(const fs::path& folder, const std::string& word) {
  const fs::path file = folder / kDatabaseFile;
  if (word.empty()) {
    auto newest = newestGoodBackupOf(file);
    if (newest) return std::move(*newest);
    return Failure{Failure::Kind::platform, folder.string() +
                                                ": there is no good backup of the homes; import "
                                                "them with nidus home import FILE"};
  }
  const auto all = backupsOf(file);
  const auto found = std::find_if(
      all.begin(), all.end(), [&word](const fs::path& backup) { return isMeant(backup, word); });
  if (found != all.end()) return *found;
  return Failure{Failure::Kind::badInput, "there is no backup " + word +
                                              "; nidus home restore --list shows those that there "
                                              "are"};
}

ExitStatus restore(const RestoreOptions& options, Workspace& workspace) {
  const auto folder = dataFolderOf(workspace.settings());
  if (!folder) return report(folder.failure());
  if (Status failed = prepareDataFolder(*folder)) return report(*failed);
  if (options.lists) return listBackups(*folder);
  const auto backup = choose(*folder, options.backup);
  if (!backup) return report(backup.failure());
  workspace.close();  // a damaged database is replaced only when nobody has it open
  const InterruptionHold hold;
  const auto done = restoreHomes(*folder, *backup);
  if (!done) return report(done.failure());
  const std::string kept =
      done->damaged ? "; the damaged database is kept as " + done->damaged->filename().string()
                    : "";
  return printText("restored " + backup->filename().string() + ": " + sizeOf(done->homes) + kept +
                   '\n');
}

}  // namespace

void declareHomeRestore(CommandSyntax& home, Workspace& workspace) {
  const auto options = std::make_shared<RestoreOptions>();
  CommandSyntax& syntax = home.command(
      "restore", "Brings the homes back as a backup has them",
      std::string(
          "Before an import, a restoration or a change of the database's form the homes are kept "
          "in a\n"
          "backup, the last five of them. What is replaced is kept too: the homes as the newest "
          "backup,\n"
          "a damaged database under a name of its own.\n\n"
          "Examples:\n"
          "  nidus home restore --list\n"
          "  nidus home restore home-backup-000003.db") +
          kExitStatuses);
  syntax.argument("BACKUP", options->backup,
                  "A backup, by its name or number; the newest good one when it is left out");
  syntax.candidates("BACKUP", {{CandidateKind::backups}});
  syntax.flag("--list", options->lists, "List the backups and restore nothing");
  syntax.run([options, &workspace] { return restore(*options, workspace); });
}

}  // namespace nidus
