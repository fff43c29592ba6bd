#include "HomePlatform/Store/DamagedStore.h"

#include <fcntl.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <string>
#include <system_error>
#include <utility>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/DatabaseFile.h"
#include "HomePlatform/Store/NumberedFiles.h"
#include "HomePlatform/Store/StoreBackup.h"
#include "HomePlatform/Store/StoreFailures.h"
#include "HomePlatform/System/FileDescriptor.h"
#include "HomePlatform/System/FilePlacing.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;

/// What belongs to a database and is found by its name: left behind, it would be taken for the log
/// of the restored one. The last is only an index of the log, which nobody needs to keep.
constexpr std::array kLogs = {"-wal", "-journal"};
constexpr const char* kIndexOfLog = "-shm";

Failure failure(const fs::path& file, const std::string& problem, const std::string& remedy) {
  return {Failure::Kind::platform, file.string() + ": " + problem + "; " + remedy};
}

Failure failure(const fs::path& file, const std::string& problem, int error) {
  return failure(file, problem + " (" + std::generic_category().message(error) + ")",
                 "see to the folder and the disk and restore again");
}

/// Locks all that a connection locks while it has the database open: the places that the engine has
/// for it, which are the same in all its versions. Nobody else has it open then.
Result<FileDescriptor> takeAlone(const fs::path& file) {
  constexpr off_t kFirstPlace = 0x40000000;
  constexpr off_t kPlaces = 512;
  FileDescriptor opened(::open(file.c_str(), O_RDWR | O_CLOEXEC));
  if (!opened) return failure(file, "the damaged database cannot be opened", errno);
  struct flock places = {};
  places.l_type = F_WRLCK;
  places.l_whence = SEEK_SET;
  places.l_start = kFirstPlace;
  places.l_len = kPlaces;
  if (::fcntl(opened.get(), F_OFD_SETLK, &places) == 0) {
    return Result<FileDescriptor>(std::move(opened));
  }
  if (errno != EAGAIN && errno != EACCES) {
    return failure(file, "the damaged database cannot be locked", errno);
  }
  return failure(file, "the database is damaged, and another process has it open",
                 "end that process, such as nidus watch or nidus shell, and restore again");
}

/// Gives the damaged files a second name, by which they stay.
Status keepDamaged(const fs::path& file, const fs::path& kept) {
  if (::link(file.c_str(), kept.c_str()) != 0) {
    return failure(file, "the damaged database cannot be kept aside", errno);
  }
  for (const char* log : kLogs) {
    const std::string name = file.string() + log;
    if (::link(name.c_str(), (kept.string() + log).c_str()) != 0 && errno != ENOENT) {
      return failure(name, "the log of the damaged database cannot be kept aside", errno);
    }
  }
  syncFolder(file.parent_path());
  return std::nullopt;
}

Status copyOf(const fs::path& backup, const fs::path& restored,
              std::chrono::milliseconds lockTimeout) {
  try {
    copyDatabase(backup, restored, lockTimeout);
    return std::nullopt;
  } catch (const DatabaseError& error) {
    return failureOf(error, backup);
  }
}

/// The logs go first: the file that is put in place must not find any.
Status putCopyInPlace(const fs::path& restored, const fs::path& file) {
  for (const char* log : kLogs) ::unlink((file.string() + log).c_str());
  ::unlink((file.string() + kIndexOfLog).c_str());
  const int error = putInPlace(restored, file);
  if (error == 0) return std::nullopt;
  return failure(file, "the backup cannot be put in its place", error);
}

}  // namespace

Result<fs::path> replaceDamagedStore(const fs::path& file, const fs::path& backup,
                                     std::chrono::milliseconds lockTimeout) {
  const auto alone = takeAlone(file);
  if (!alone) return alone.failure();
  const fs::path kept = nextNumberedFile(file, "damaged");
  const fs::path restored = file.string() + ".restored";
  Status failed = copyOf(backup, restored, lockTimeout);
  if (!failed) failed = keepDamaged(file, kept);
  if (!failed) failed = putCopyInPlace(restored, file);
  if (!failed) return kept;
  removeDatabaseFile(restored);
  return *failed;
}

}  // namespace nidus
