#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <system_error>

#include "HomePlatform/System/DataFolder.h"
#include "HomePlatform/System/Preferences.h"
#include "HomePlatform/System/PrivateFiles.h"
#include "HomePlatform/System/ShellWord.h"
#include "HomePlatform/System/TrustedPlace.h"
#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"

namespace nidus {
namespace {

/// A file or folder, and what its user must be allowed to do with it.
struct Place {
  std::filesystem::path path;
  int access;                                     ///< As of access(2).
  const char* granted;                            ///< The same for chmod(1).
  Status (*check)(const std::filesystem::path&);  ///< Whether others may change it.
};

void checkPermissions(const Place& place, Findings& findings) {
  if (Status failure = place.check(place.path)) findings.push_back(findingOf(*failure));
  if (::faccessat(AT_FDCWD, place.path.c_str(), place.access, AT_EACCESS) != 0) {
    findings.push_back(
        {Severity::attention, place.path.string(), "you may not read and change it",
         std::string("chmod u+") + place.granted + ' ' + shellWord(place.path.string())});
  }
}

void checkPlace(const Place& place, Findings& findings) {
  struct stat status = {};
  if (::stat(place.path.c_str(), &status) == 0) {
    checkPermissions(place, findings);
  } else if (errno != ENOENT) {
    findings.push_back({Severity::attention, place.path.string(),
                        "it cannot be looked at: " + std::generic_category().message(errno),
                        "mend the permissions of the folders above it"});
  }
}

/// An empty folder is closed to others when it is first used; one that holds something is not.
void checkPrivacy(const std::filesystem::path& folder, Findings& findings) {
  if (!findings.empty() || !isOpenToOthers(folder)) return;
  findings.push_back({Severity::attention, folder.string(), "others may look into it",
                      "chmod go-rwx " + shellWord(folder.string())});
}

}  // namespace

void checkDataFolder(const Examination& examination, Findings& findings) {
  if (examination.folderFailure) {
    findings.push_back(findingOf(*examination.folderFailure));
    return;
  }
  const std::filesystem::path& folder = examination.folder;
  std::error_code ignored;
  if (!std::filesystem::exists(folder, ignored)) {
    findings.push_back({Severity::note, folder.string(), "there is none yet",
                        "it is made when it is first needed"});
    return;
  }
  checkPlace({folder, R_OK | W_OK | X_OK, "rwx", checkTrustedWay}, findings);
  checkPrivacy(folder, findings);
  for (const char* name : {kDatabaseFile, Preferences::kFileName, kVocabularyFile}) {
    checkPlace({folder / name, R_OK | W_OK, "rw", checkTrusted}, findings);
  }
}

}  // namespace nidus
