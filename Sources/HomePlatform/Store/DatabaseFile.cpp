#include "HomePlatform/Store/DatabaseFile.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>
#include <string>
#include <system_error>

#include "HomePlatform/System/PrivateFiles.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;

Failure failure(const fs::path& path, const std::string& problem, int error,
                const std::string& remedy) {
  return {Failure::Kind::platform, path.string() + ": " + problem + " (" +
                                       std::system_category().message(error) + "); " + remedy};
}

bool mayWrite(const fs::path& path, int further) {
  return ::faccessat(AT_FDCWD, path.c_str(), R_OK | W_OK | further, AT_EACCESS) == 0;
}

}  // namespace

Status prepareDatabaseFile(const fs::path& file) {
  const fs::path folder = file.has_parent_path() ? file.parent_path() : fs::path(".");
  if (const int error = makePrivateFolder(folder)) {
    return failure(
        folder, "the folder cannot be made", error,
        "give yourself write permission on the folder above it, or choose another place");
  }
  if (!mayWrite(folder, X_OK)) {
    return failure(folder, "the folder of the database cannot be written", errno,
                   "give yourself write permission on it, or choose another one");
  }
  if (const int error = makePrivateFile(file)) {
    return failure(file, "the database cannot be made", error,
                   "give yourself write permission on its folder");
  }
  std::error_code ignored;
  if (fs::is_directory(file, ignored)) {
    return failure(file, "a folder is where the database has to be", EISDIR, "move it away");
  }
  if (fs::is_other(file, ignored)) {
    return failure(file, "a device or pipe is where the database has to be", EINVAL,
                   "move it away");
  }
  if (mayWrite(file, 0)) return std::nullopt;
  return failure(file, "the database cannot be written", errno,
                 "give yourself write permission on the file");
}

void removeDatabaseFile(const fs::path& file) {
  for (const char* suffix : {"", "-journal", "-wal", "-shm"}) {
    ::unlink((file.string() + suffix).c_str());
  }
}

}  // namespace nidus
