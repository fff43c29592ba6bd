#include "HomePlatform/System/DataFolder.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <string>
#include <system_error>

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

Status makeFolder(const std::filesystem::path& folder) {
  std::error_code error;
  const std::filesystem::path parent = std::filesystem::absolute(folder, error).parent_path();
  if (!error) std::filesystem::create_directories(parent, error);
  if (error) return makeFailure(folder, error.value());
  if (::mkdir(folder.c_str(), S_IRWXU) == 0 || errno == EEXIST) return std::nullopt;
  return makeFailure(folder, errno);
}

}  // namespace

Status prepareDataFolder(const std::filesystem::path& folder) {
  std::error_code error;
  const bool exists = std::filesystem::exists(folder, error);
  if (error) return folderFailure(folder, "the data folder cannot be opened", error.value());
  if (!exists) {
    if (Status failure = makeFolder(folder)) return failure;
  }
  if (!std::filesystem::is_directory(folder, error)) {
    return folderFailure(folder, "the data folder cannot be opened", ENOTDIR);
  }
  if (::access(folder.c_str(), R_OK | W_OK | X_OK) == 0) return std::nullopt;
  return folderFailure(folder, "the data folder cannot be written", errno);
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
