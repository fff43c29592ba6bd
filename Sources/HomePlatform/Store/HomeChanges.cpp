#include "HomePlatform/Store/HomeChanges.h"

#include "HomePlatform/Store/HomeChecks.h"
#include "HomePlatform/Store/HomeInserter.h"
#include "HomePlatform/Store/HomeLoader.h"

namespace nidus {
namespace {

constexpr const char* kUpdate =
    "UPDATE characteristic SET value = iif(?5, ?6, value), "
    "device_value = iif(?7, ?8, device_value) "
    "WHERE id = (SELECT characteristic.id FROM home "
    "JOIN accessory ON accessory.home = home.id AND accessory.uuid = ?2 "
    "JOIN service ON service.accessory = accessory.id AND service.instance_id = ?3 "
    "JOIN characteristic ON characteristic.service = service.id "
    "AND characteristic.instance_id = ?4 WHERE home.uuid = ?1)";

std::int64_t positionAtEnd(Database& database) {
  return database.number("SELECT ifnull(max(position) + 1, 0) FROM home");
}

}  // namespace

void replaceStoredHomes(Database& database, const std::vector<HomeData>& homes,
                        const StoreProgress& progress) {
  database.run("DELETE FROM home");
  HomeInserter inserter(database, progress);
  std::int64_t position = 0;
  for (const HomeData& home : homes) inserter.insert(home, position++);
}

void mergeStoredHomes(Database& database, const std::vector<HomeData>& homes,
                      const StoreProgress& progress) {
  Statement find(database, "SELECT position FROM home WHERE uuid = ?");
  Statement remove(database, "DELETE FROM home WHERE uuid = ?");
  HomeInserter inserter(database, progress);
  for (const HomeData& home : homes) {
    find.bindAll(home.uuid);
    const bool isKnown = find.step();
    const std::int64_t position = isKnown ? find.integer(0) : positionAtEnd(database);
    find.reset();
    remove.run(home.uuid);
    inserter.insert(home, position);
  }
}

Status editStoredHomes(Database& database, const HomeEdit& edit) {
  std::vector<HomeData> homes = loadHomesFrom(database);
  Status failed = edit(homes);
  if (!failed) failed = checkHomes(homes, "the changed homes");
  if (!failed) replaceStoredHomes(database, homes, nullptr);
  return failed;
}

ValueWriter::ValueWriter(Database& database) : update_(database, kUpdate) {}

void ValueWriter::write(const std::vector<ValueChange>& changes) {
  for (const ValueChange& change : changes) {
    update_.run(change.home, change.address.accessory, change.address.service,
                change.address.characteristic, change.value.has_value(),
                change.value.value_or(nullptr), change.deviceValue.has_value(),
                change.deviceValue.value_or(nullptr));
  }
}

}  // namespace nidus
