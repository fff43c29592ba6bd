#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "HomePlatform/Store/Database.h"

namespace nidus {

/// The number in the file's header that says that a database is one of ours.
inline constexpr std::int64_t kSchemaApplicationID = 0x4E494455;

/// What leads from each version of the schema to the next, first from an empty database to version
/// 1. A step, once released, never changes; a change of the schema is one more step.
[[nodiscard]] const std::vector<std::string>& schemaSteps();

/// Why a database cannot be used with a list of steps.
enum class SchemaProblem {
  notOurs,  ///< It is a database of some other program.
  newer,    ///< It has been written by a version of the program that knows more steps.
};

/// Whether `database` has the version that `steps` lead to. Throws `DatabaseError`.
[[nodiscard]] bool isSchemaCurrent(Database& database, const std::vector<std::string>& steps);

/// Why `steps` cannot be run on `database`; none when they can, or when there is nothing to do.
/// Throws `DatabaseError`.
[[nodiscard]] std::optional<SchemaProblem> schemaProblemOf(Database& database,
                                                           const std::vector<std::string>& steps);

/// Runs those of `steps` that `database` lacks, within a writing transaction of the caller; only
/// when there is no problem. Throws `DatabaseError`.
void runSchemaSteps(Database& database, const std::vector<std::string>& steps);

/// What goes with a migration, within its transaction; either may be empty.
struct MigrationHooks {
  std::function<void()> before = nullptr;        ///< Before a database with contents is changed.
  std::function<void()> beforeCommit = nullptr;  ///< When that is done, before it is lasting.
};

/// Brings `database` to the version that `steps` lead to, in one transaction; several processes may
/// do so at the same time. Gives what is in the way, none when it is done. Throws `DatabaseError`.
[[nodiscard]] std::optional<SchemaProblem> applySchema(Database& database,
                                                       const std::vector<std::string>& steps,
                                                       const MigrationHooks& hooks = {});

}  // namespace nidus
