#pragma once

#include <filesystem>
#include <string>

#include "HomePlatform/Result.h"
#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/Schema.h"

namespace nidus {

/// Whether `error` says that the contents of a file are not what they have to be.
[[nodiscard]] bool isDamage(const DatabaseError& error);

/// What people see when the database in `file` fails: the file, what is wrong with it and the
/// remedy. For one that is damaged that is the newest good backup, which is looked for.
[[nodiscard]] Failure failureOf(const DatabaseError& error, const std::filesystem::path& file);
[[nodiscard]] Failure failureOf(SchemaProblem problem, const std::filesystem::path& file);

/// The same for a database that has no file.
[[nodiscard]] Failure failureInMemory(const DatabaseError& error);

}  // namespace nidus
