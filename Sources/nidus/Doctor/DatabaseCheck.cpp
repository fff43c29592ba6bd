#include "HomePlatform/System/DataFolder.h"
#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"

namespace nidus {

void checkDatabase(const Examination& examination, Findings& findings) {
  if (!examination.hasDatabase) {
    findings.push_back({Severity::note, (examination.folder / kDatabaseFile).string(),
                        "there is none yet", "the first home makes it"});
  }
  for (const Failure& failure : examination.databaseFailures) {
    findings.push_back(findingOf(failure));
  }
}

}  // namespace nidus
