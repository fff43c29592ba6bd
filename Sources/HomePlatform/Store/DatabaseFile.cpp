#include "HomePlatform/Store/DatabaseFile.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <string>
#include <system_error>

namespace nidus {
namespace {

namespace fs = std::filesystem;

constexpr mode_t kOwnerFolder = 0700;
constexpr mode_t kOwnerFile = 0600;

Failure failure(const fs::path& path, const std::string& problem, int error,
                const std::string& remedy) {
  return {Failure::Kind::platform, path.string() + ": " + problem + " (" +
                                       std::system_category().message(error) + "); " + remedy};
}

/// Makes the missing folders from the outermost inwards.
Status makeFolder(const fs::path& folder) {
  std::error_code ignored;
  if (folder.empty() || fs::is_directory(folder, ignored)) return std::nullopt;
  if (folder.has_parent_path() && folder.parent_path() != folder) {
    if (Status failed = makeFolder(folder.parent_path())) return failed;
  }
  if (::mkdir(folder.c_str(), kOwnerFolder) == 0 || errno == EEXIST) return std::nullopt;
  return failure(folder, "the folder cannot be made", errno,
                 "give yourself write permission on the folder above it, or choose another place");
}

bool mayWrite(const fs::path& path, int further) {
  return ::faccessat(AT_FDCWD, path.c_str(), R_OK | W_OK | further, AT_EACCESS) == 0;
}

/// A file that is there is left alone: closing it would drop the locks of another connection of
/// this process.
Status makeFile(const fs::path& file) {
  const int made = ::open(file.c_str(), O_RDWR | O_CREAT | O_EXCL | O_CLOEXEC, kOwnerFile);
  if (made >= 0) {
    ::close(made);
    return std::nullopt;
  }
  if (errno == EEXIST) return std::nullopt;
  return failure(file, "the database cannot be made", errno,
                 "give yourself write permission on its folder");
}

}  // namespace

Status prepareDatabaseFile(const fs::path& file) {
  const fs::path folder = file.has_parent_path() ? file.parent_path() : fs::path(".");
  if (Status failed = makeFolder(folder)) return failed;
  if (!mayWrite(folder, X_OK)) {
    return failure(folder, "the folder of the database cannot be written", errno,
                   "give yourself write permission on it, or choose another one");
  }
  if (Status failed = makeFile(file)) return failed;
  if (std::error_code ignored; fs::is_directory(file, ignored)) {
    return failure(file, "a folder is where the database has to be", EISDIR, "move it away");
  }
  if (mayWrite(file, 0)) return std::nullopt;
  return failure(file, "the database cannot be written", errno,
                 "give yourself write permission on the file");
}

}  // namespace nidus
