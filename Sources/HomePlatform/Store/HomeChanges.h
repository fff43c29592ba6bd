#pragma once

#include <vector>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeData.h"
#include "HomePlatform/Store/HomeEdit.h"
#include "HomePlatform/Store/HomeStore.h"
#include "HomePlatform/Store/StoreProgress.h"

namespace nidus {

/// The changes of the stored homes, each to be made within one writing transaction of the caller;
/// see `HomeStore` for what they do. They throw `DatabaseError`.
void replaceStoredHomes(Database& database, const std::vector<HomeData>& homes,
                        const StoreProgress& progress);
void mergeStoredHomes(Database& database, const std::vector<HomeData>& homes,
                      const StoreProgress& progress);
[[nodiscard]] Status editStoredHomes(Database& database, const HomeEdit& edit);

/// Writes values into the tables, with the statement prepared once. The database must outlive it.
class ValueWriter {
 public:
  explicit ValueWriter(Database& database);

  /// Writes `changes` within a writing transaction of the caller. Throws `DatabaseError`.
  void write(const std::vector<ValueChange>& changes);

 private:
  Statement update_;
};

}  // namespace nidus
