#pragma once

#include <vector>

#include "HomePlatform/Store/Database.h"

namespace nidus {

/// Looks at every page, index and reference of `database` and gives what is wrong with them, or why
/// it cannot be read; empty when all is sound.
[[nodiscard]] std::vector<DatabaseError> findDamage(Database& database);

}  // namespace nidus
