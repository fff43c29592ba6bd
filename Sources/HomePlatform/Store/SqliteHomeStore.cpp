#include "HomePlatform/Store/SqliteHomeStore.h"

#include "HomePlatform/Store/HomeChanges.h"
#include "HomePlatform/Store/HomeLoader.h"

namespace nidus {

Status SqliteHomeStore::replaceHomes(const std::vector<HomeData>& homes,
                                     const StoreProgress& progress) {
  return change(Backup::first, [&](Database& database) {
    replaceStoredHomes(database, homes, progress);
    return Status();
  });
}

Status SqliteHomeStore::mergeHomes(const std::vector<HomeData>& homes,
                                   const StoreProgress& progress) {
  return change(Backup::first, [&](Database& database) {
    mergeStoredHomes(database, homes, progress);
    return Status();
  });
}

Status SqliteHomeStore::editHomes(const HomeEdit& edit) {
  return change(Backup::none, [&](Database& database) { return editStoredHomes(database, edit); });
}

Result<std::vector<HomeData>> SqliteHomeStore::loadHomes() {
  return load<std::vector<HomeData>>(&loadHomesFrom);
}

Result<std::int64_t> SqliteHomeStore::countHomes() {
  return load<std::int64_t>([](Database& database) {
    const WorkLimit limit(database);
    return database.number("SELECT count(*) FROM home");
  });
}

}  // namespace nidus
