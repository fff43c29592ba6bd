#include "HomePlatform/Store/StoreFailures.h"

#include "HomePlatform/Store/BackupList.h"

namespace nidus {
namespace {

Failure failure(const std::string& name, const std::string& problem, const std::string& remedy) {
  return {Failure::Kind::platform, name + ": " + problem + "; " + remedy};
}

/// What is wrong, and the remedy where it is the same for all databases.
Failure failureOf(const DatabaseError& error, const std::string& name,
                  const std::string& remedyOfDamage) {
  const std::string cause = " (" + error.message + ")";
  switch (error.kind) {
    case DatabaseError::Kind::locked:
      return failure(name, "the database is locked: another process is using it" + cause,
                     "try again when that one has finished");
    case DatabaseError::Kind::damaged:
      return failure(name, "the database is damaged" + cause, remedyOfDamage);
    case DatabaseError::Kind::notADatabase:
      return failure(name, "the file is damaged or no database" + cause, remedyOfDamage);
    case DatabaseError::Kind::notWritable:
      return failure(name, "the database cannot be opened for writing" + cause,
                     "give yourself write permission on the file and its folder");
    case DatabaseError::Kind::full:
      return failure(name, "the disk is full" + cause, "make room on it and try again");
    case DatabaseError::Kind::other:
      break;
  }
  return failure(name, "the database failed" + cause, "check the disk and try again");
}

std::string remedyOfDamage(const std::filesystem::path& file) {
  const auto backup = newestGoodBackupOf(file);
  if (!backup) {
    return "there is no good backup of it, so move it away and import the homes again";
  }
  return "nidus home restore brings back " + backup->filename().string() +
         ", its newest good backup";
}

}  // namespace

bool isDamage(const DatabaseError& error) {
  return error.kind == DatabaseError::Kind::damaged ||
         error.kind == DatabaseError::Kind::notADatabase;
}

Failure failureOf(const DatabaseError& error, const std::filesystem::path& file) {
  return failureOf(error, file.string(), isDamage(error) ? remedyOfDamage(file) : "");
}

Failure failureOf(SchemaProblem problem, const std::filesystem::path& file) {
  if (problem == SchemaProblem::newer) {
    return failure(file.string(), "the database was written by a newer version of this program",
                   "use that version, or another data folder");
  }
  return failure(file.string(), "the file is a database of another program",
                 "use another data folder");
}

Failure failureInMemory(const DatabaseError& error) {
  return failureOf(error, "the database in memory", "start again");
}

}  // namespace nidus
