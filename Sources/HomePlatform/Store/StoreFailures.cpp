#include "HomePlatform/Store/StoreFailures.h"

namespace nidus {
namespace {

Failure failure(const std::string& name, const std::string& problem, const std::string& remedy) {
  return {Failure::Kind::platform, name + ": " + problem + "; " + remedy};
}

}  // namespace

Failure failureOf(const DatabaseError& error, const std::string& name) {
  const std::string cause = " (" + error.message + ")";
  switch (error.kind) {
    case DatabaseError::Kind::locked:
      return failure(name, "the database is locked: another process is using it" + cause,
                     "try again when that one has finished");
    case DatabaseError::Kind::damaged:
      return failure(name, "the database is damaged" + cause,
                     "restore it from a backup, or move it away and import the homes again");
    case DatabaseError::Kind::notADatabase:
      return failure(name, "the file is damaged or no database" + cause,
                     "restore it from a backup, or move it away and import the homes again");
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

Failure failureOf(SchemaProblem problem, const std::string& name) {
  if (problem == SchemaProblem::newer) {
    return failure(name, "the database was written by a newer version of this program",
                   "use that version, or another data folder");
  }
  return failure(name, "the file is a database of another program", "use another data folder");
}

}  // namespace nidus
