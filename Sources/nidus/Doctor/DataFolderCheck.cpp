#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <system_error>

#include "HomePlatform/System/DataFolder.h"
#include "HomePlatform/System/Preferences.h"
#include "nidus/Doctor/Checks.h"
#include "nidus/Doctor/Remedy.h"

namespace nidus {
namespace {

/// A file or folder, and what its user must be allowed to do with it.
struct Place {
  std::filesystem::path path;
  int access;           ///< As of access(2).
  const char* granted;  ///< The same for chmod(1).
};

std::string commandOn(const std::string& command, const Place& place) {
  return command + ' ' + shellWord(place.path.string());
}

void checkOwner(const Place& place, const struct stat& status, Findings& findings) {
  if (status.st_uid == ::geteuid()) return;
  findings.push_back({Severity::attention, place.path.string(), "it belongs to another user",
                      commandOn("sudo chown \"$(id -un)\"", place)});
}

void checkPermissions(const Place& place, const struct stat& status, Findings& findings) {
  if (::faccessat(AT_FDCWD, place.path.c_str(), place.access, AT_EACCESS) != 0) {
    findings.push_back({Severity::attention, place.path.string(), "you may not read and change it",
                        commandOn(std::string("chmod u+") + place.granted, place)});
  }
  if ((status.st_mode & (S_IWGRP | S_IWOTH)) != 0) {
    findings.push_back({Severity::attention, place.path.string(),
                        "others may change it, and with it what the assistant does",
                        commandOn("chmod go-w", place)});
  }
}

void checkPlace(const Place& place, Findings& findings) {
  struct stat status = {};
  if (::stat(place.path.c_str(), &status) == 0) {
    checkOwner(place, status, findings);
    checkPermissions(place, status, findings);
  } else if (errno != ENOENT) {
    findings.push_back({Severity::attention, place.path.string(),
                        "it cannot be looked at: " + std::generic_category().message(errno),
                        "mend the permissions of the folders above it"});
  }
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
  checkPlace({folder, R_OK | W_OK | X_OK, "rwx"}, findings);
  for (const char* name : {kDatabaseFile, Preferences::kFileName, kVocabularyFile}) {
    checkPlace({folder / name, R_OK | W_OK, "rw"}, findings);
  }
}

}  // namespace nidus
