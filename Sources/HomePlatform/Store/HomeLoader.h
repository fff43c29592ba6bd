#pragma once

#include <vector>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeData.h"

namespace nidus {

/// Reads all homes out of the tables, each in one pass. To be called within one transaction. Throws
/// `DatabaseError`.
[[nodiscard]] std::vector<HomeData> loadHomesFrom(Database& database);

}  // namespace nidus
