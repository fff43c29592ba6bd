#include <cstddef>
#include <string>

#include "HomePlatform/System/DataFolder.h"
#include "HomePlatform/System/ShellWord.h"
#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"

namespace nidus {
namespace {

void checkBackups(const Examination& examination, Findings& findings) {
  for (const auto& backup : examination.badBackups) {
    findings.push_back({Severity::attention, backup.string(),
                        "the backup is damaged and cannot be restored",
                        "rm " + shellWord(backup.string())});
  }
  if (examination.backups.empty()) return;
  const std::size_t count = examination.backups.size();
  findings.push_back(
      {Severity::note, examination.backups.front().string(),
       count == 1 ? "it is a good backup of the homes"
                  : "it is the newest of " + std::to_string(count) + " good backups of the homes",
       "nidus home restore --list shows what can be restored"});
}

}  // namespace

void checkDatabase(const Examination& examination, Findings& findings) {
  if (!examination.hasDatabase) {
    findings.push_back({Severity::note, (examination.folder / kDatabaseFile).string(),
                        "there is none yet", "the first home makes it"});
  }
  for (const Failure& failure : examination.databaseFailures) {
    findings.push_back(findingOf(failure));
  }
  checkBackups(examination, findings);
}

}  // namespace nidus
