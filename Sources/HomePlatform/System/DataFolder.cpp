#include "HomePlatform/System/DataFolder.h"

#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <string>
#include <system_error>
#include <vector>

#include "HomePlatform/Store/BackupList.h"
#include "HomePlatform/System/Preferences.h"
#include "HomePlatform/System/PrivateFiles.h"
#include "HomePlatform/System/TrustedPlace.h"

namespace nidus {
namespace {

Failure folderFailure(const std::filesystem::path& folder, const std::string& what, int error) {
  return {Failure::Kind::platform, folder.string() + ": " + what + ": " +
                                       std::generic_category().message(error) +
                                       "; give another data folder or mend its permissions"};
}

Failure makeFailure(const std::filesystem::path& folder, int error) {
  return folderFailure(folder, "the data folder cannot be made", error);
}

/// A folder in which there is something already may have to be readable for what else is in it.
void keepFolderPrivate(const std::filesystem::path& folder) {
  std::error_code ignored;
  if (!isOpenToOthers(folder)) return;
  if (std::filesystem::is_empty(folder, ignored)) keepPrivate(folder);
}

/// The log of the database, its index and the backups hold values of the home like the database
/// itself.
std::vector<std::filesystem::path> ownFiles(const std::filesystem::path& folder) {
  const std::filesystem::path database = folder / kDatabaseFile;
  std::vector<std::filesystem::path> files = backupsOf(database);
  for (const char* suffix : {"", "-wal", "-shm", "-journal"}) {
    files.emplace_back(database.string() + suffix);
  }
  files.push_back(folder / Preferences::kFileName);
  files.push_back(folder / kVocabularyFile);
  return files;
}

Status checkFiles(const std::filesystem::path& folder) {
  for (const std::filesystem::path& file : ownFiles(folder)) {
    if (Status failure = checkTrusted(file)) return failure;
    keepPrivate(file);
  }
  return std::nullopt;
}

}  // namespace

Status prepareDataFolder(const std::filesystem::path& folder) {
  std::error_code error;
  const bool exists = std::filesystem::exists(folder, error);
  if (error) return folderFailure(folder, "the data folder cannot be opened", error.value());
  if (!exists) {
    if (const int problem = makePrivateFolder(folder)) return makeFailure(folder, problem);
  }
  if (!std::filesystem::is_directory(folder, error)) {
    return folderFailure(folder, "the data folder cannot be opened", ENOTDIR);
  }
  if (Status failure = checkTrustedWay(folder)) return failure;
  if (::access(folder.c_str(), R_OK | W_OK | X_OK) != 0) {
    return folderFailure(folder, "the data folder cannot be written", errno);
  }
  keepFolderPrivate(folder);
  return checkFiles(folder);
}

Status tryDataFolder(const std::filesystem::path& folder) {
  std::error_code error;
  std::filesystem::path above = std::filesystem::absolute(folder, error).parent_path();
  while (above.has_relative_path() && !std::filesystem::exists(above, error)) {
    above = above.parent_path();
  }
  std::string trial = above / ".nidus-XXXXXX";
  if (!::mkdtemp(trial.data())) return makeFailure(folder, errno);
  ::rmdir(trial.c_str());
  return std::nullopt;
}

Result<FolderLock> FolderLock::take(const std::filesystem::path& folder) {
  FileDescriptor opened(::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
  if (!opened) return folderFailure(folder, "the data folder cannot be opened", errno);
  while (::flock(opened.get(), LOCK_EX) != 0) {
    if (errno != EINTR) return folderFailure(folder, "the data folder cannot be locked", errno);
  }
  return FolderLock(std::move(opened));
}

}  // namespace nidus
