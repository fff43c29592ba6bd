#pragma once

#include <vector>

#include "HomePlatform/Store/Database.h"

namespace nidus {

/// Looks at every page, index and reference of `database` and gives what is wrong with them, or why
/// it cannot be read; empty when all is sound. Only what is wrong with the contents is `damaged`:
/// a disk that fails or memory that runs out is not.
[[nodiscard]] std::vector<DatabaseError> findDamage(Database& database);

}  // namespace nidus
