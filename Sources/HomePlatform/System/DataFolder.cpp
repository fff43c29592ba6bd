#include "HomePlatform/System/DataFolder.h"

#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdlib>
#include <string>
#include <system_error>

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

/// The log of the database and its index hold values of the home like the database itself.
std::array<std::string, 5> ownFiles() {
  const std::string database = kDatabaseFile;
  return {database, database + "-wal", database + "-shm", Preferences::kFileName, kVocabularyFile};
}

Status checkFiles(const std::filesystem::path& folder) {
  for (const std::string& name : ownFiles()) {
    const auto file = folder / name;
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
