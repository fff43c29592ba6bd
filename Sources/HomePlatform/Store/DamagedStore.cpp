#include "HomePlatform/Store/DamagedStore.h"

#include <fcntl.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <optional>
#include <string>
#include <system_error>
#include <utility>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/DatabaseFile.h"
#include "HomePlatform/Store/NumberedFiles.h"
#include "HomePlatform/Store/StoreBackup.h"
#include "HomePlatform/Store/StoreExamination.h"
#include "HomePlatform/Store/StoreFailures.h"
#include "HomePlatform/System/FileDescriptor.h"
#include "HomePlatform/System/FilePlacing.h"
#include "HomePlatform/System/PrivateFiles.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;

using Kept = std::optional<fs::path>;

/// What belongs to a database and is found by its name: left behind, it would be taken for the log
/// of the restored one, and the index of it.
constexpr std::array kLogs = {"-wal", "-journal", "-shm"};

Failure failure(const fs::path& file, const std::string& problem, const std::string& remedy) {
  return {Failure::Kind::platform, file.string() + ": " + problem + "; " + remedy};
}

Failure failure(const fs::path& file, const std::string& problem, int error) {
  return failure(file, problem + " (" + std::generic_category().message(error) + ")",
                 "see to the folder and the disk and restore again");
}

/// Locks all that a connection locks while it has the database open: the places that the engine has
/// for it, which are the same in all its versions. Nobody else has it open then. Gives none when
/// somebody has.
Result<std::optional<FileDescriptor>> takeAlone(const fs::path& file) {
  using Alone = std::optional<FileDescriptor>;
  constexpr off_t kFirstPlace = 0x40000000;
  constexpr off_t kPlaces = 512;
  FileDescriptor opened(::open(file.c_str(), O_RDWR | O_CLOEXEC));
  if (!opened) return failure(file, "the database cannot be opened", errno);
  struct flock places = {};
  places.l_type = F_WRLCK;
  places.l_whence = SEEK_SET;
  places.l_start = kFirstPlace;
  places.l_len = kPlaces;
  if (::fcntl(opened.get(), F_OFD_SETLK, &places) == 0) {
    return Alone(std::move(opened));
  }
  if (errno == EAGAIN || errno == EACCES) return Alone();
  return failure(file, "the database cannot be locked", errno);
}

/// Copies the database with its log, which nobody may have open.
Status copyFiles(const fs::path& file, const fs::path& copy) {
  for (const char* suffix : {"", "-wal", "-journal"}) {
    std::error_code error;
    const fs::path from = file.string() + suffix;
    if (!fs::exists(from, error)) continue;
    const fs::path to = copy.string() + suffix;
    const int problem = makePrivateFile(to);
    if (problem != 0) return failure(to, "the database cannot be copied to look at it", problem);
    fs::copy_file(from, to, fs::copy_options::overwrite_existing, error);
    if (error) return failure(from, "the database cannot be copied to look at it", error.value());
  }
  return std::nullopt;
}

/// Looks at a copy: the engine would bring the log into the file itself, or remove it, before
/// anybody knows whether they are damaged.
Result<bool> isDamagedAlone(const fs::path& file, std::chrono::milliseconds lockTimeout) {
  const fs::path copy = file.string() + ".examined";
  removeDatabaseFile(copy);
  const Status failed = copyFiles(file, copy);
  const bool isDamaged = !failed && examineStore(copy, lockTimeout).isDamaged;
  removeDatabaseFile(copy);
  return failed ? Result<bool>(*failed) : Result<bool>(isDamaged);
}

/// The answer where another process has the database open, which brings the log into the file when
/// it ends.
Result<Kept> refuseIfDamaged(const fs::path& file, std::chrono::milliseconds lockTimeout) {
  if (!examineStore(file, lockTimeout).isDamaged) return Kept();
  return failure(file, "the database is damaged, and another process has it open",
                 "end that process, such as nidus watch or nidus shell, and restore again");
}

/// Gives the damaged files a second name, by which they stay.
Status linkDamaged(const fs::path& file, const fs::path& kept) {
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

Status keepDamaged(const fs::path& file, const fs::path& kept) {
  Status failed = linkDamaged(file, kept);
  if (failed) removeDatabaseFile(kept);
  return failed;
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
  const int error = putInPlace(restored, file);
  if (error == 0) return std::nullopt;
  return failure(file, "the backup cannot be put in its place", error);
}

Result<Kept> replace(const fs::path& file, const fs::path& backup,
                     std::chrono::milliseconds lockTimeout) {
  const fs::path kept = nextNumberedFile(file, "damaged");
  const fs::path restored = file.string() + ".restored";
  Status failed = copyOf(backup, restored, lockTimeout);
  if (!failed) failed = keepDamaged(file, kept);
  if (!failed) failed = putCopyInPlace(restored, file);
  if (!failed) return Kept(kept);
  removeDatabaseFile(restored);
  return *failed;
}

}  // namespace

Result<Kept> replaceDamagedStore(const fs::path& file, const fs::path& backup,
                                 std::chrono::milliseconds lockTimeout) {
  const auto alone = takeAlone(file);
  if (!alone) return alone.failure();
  if (!*alone) return refuseIfDamaged(file, lockTimeout);
  const auto isDamaged = isDamagedAlone(file, lockTimeout);
  if (!isDamaged) return isDamaged.failure();
  return *isDamaged ? replace(file, backup, lockTimeout) : Result<Kept>(Kept());
}

}  // namespace nidus
