#include "HomePlatform/System/PrivateFiles.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>
#include <system_error>

#include "HomePlatform/System/FileDescriptor.h"

namespace nidus {
namespace {

constexpr mode_t kOwnerFolder = S_IRWXU;
constexpr mode_t kOwnerFile = S_IRUSR | S_IWUSR;
constexpr mode_t kOthers = S_IRWXG | S_IRWXO;

/// The permissions of a file or folder that is no link.
mode_t permissionsOf(const std::filesystem::path& path) {
  constexpr mode_t kPermissions = 07777;
  struct stat status = {};
  if (::lstat(path.c_str(), &status) != 0 || S_ISLNK(status.st_mode)) return 0;
  return status.st_mode & kPermissions;
}

}  // namespace

int makePrivateFolder(const std::filesystem::path& folder) {
  std::error_code ignored;
  if (folder.empty() || std::filesystem::is_directory(folder, ignored)) return 0;
  if (folder.has_parent_path() && folder.parent_path() != folder) {
    if (const int error = makePrivateFolder(folder.parent_path())) return error;
  }
  // The mask can take even the owner's permissions away.
  if (::mkdir(folder.c_str(), kOwnerFolder) == 0) {
    return ::chmod(folder.c_str(), kOwnerFolder) == 0 ? 0 : errno;
  }
  return errno == EEXIST ? 0 : errno;
}

int makePrivateFile(const std::filesystem::path& file) {
  const FileDescriptor made(
      ::open(file.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, kOwnerFile));
  if (made) return ::fchmod(made.get(), kOwnerFile) == 0 ? 0 : errno;
  return errno == EEXIST ? 0 : errno;
}

bool isOpenToOthers(const std::filesystem::path& path) {
  return (permissionsOf(path) & kOthers) != 0;
}

void keepPrivate(const std::filesystem::path& path) {
  if (isOpenToOthers(path)) ::chmod(path.c_str(), permissionsOf(path) & ~kOthers);
}

}  // namespace nidus
