#pragma once

#include <vector>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Reads all homes out of the tables, each in one pass. To be called within one transaction. Throws
/// `DatabaseError`.
[[nodiscard]] std::vector<HomeData> loadHomesFrom(Database& database);

/// The same for a database that may have an earlier version: as the homes would be after its
/// migration, which is not made. Not within a transaction.
[[nodiscard]] std::vector<HomeData> loadMigratedHomes(Database& database);

}  // namespace nidus
