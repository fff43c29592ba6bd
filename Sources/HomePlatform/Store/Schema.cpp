#include "HomePlatform/Store/Schema.h"

#include <set>
#include <sstream>

namespace nidus {
namespace {

/// Every table but `home` hangs on the object that it belongs to, and goes with it; `position` is
/// the place in its list. A column of type ANY holds a boxed value: an integer, a float or a text
/// as it is, a boolean as one byte.
constexpr const char* kVersion1 = R"sql(
CREATE TABLE home (
  id INTEGER PRIMARY KEY,
  position INTEGER NOT NULL UNIQUE,
  uuid BLOB NOT NULL UNIQUE,
  name TEXT NOT NULL,
  is_primary INTEGER NOT NULL,
  read_fault INTEGER NOT NULL,
  write_fault INTEGER NOT NULL
) STRICT;

CREATE TABLE room (
  id INTEGER PRIMARY KEY,
  home INTEGER NOT NULL REFERENCES home ON DELETE CASCADE,
  position INTEGER NOT NULL,
  uuid BLOB NOT NULL,
  name TEXT NOT NULL,
  UNIQUE (home, position),
  UNIQUE (home, uuid)
) STRICT;

CREATE TABLE zone (
  id INTEGER PRIMARY KEY,
  home INTEGER NOT NULL REFERENCES home ON DELETE CASCADE,
  position INTEGER NOT NULL,
  uuid BLOB NOT NULL,
  name TEXT NOT NULL,
  UNIQUE (home, position),
  UNIQUE (home, uuid)
) STRICT;

CREATE TABLE zone_room (
  zone INTEGER NOT NULL REFERENCES zone ON DELETE CASCADE,
  position INTEGER NOT NULL,
  room INTEGER NOT NULL REFERENCES room ON DELETE CASCADE,
  PRIMARY KEY (zone, position)
) STRICT, WITHOUT ROWID;
CREATE INDEX zone_room_by_room ON zone_room (room);

CREATE TABLE accessory (
  id INTEGER PRIMARY KEY,
  home INTEGER NOT NULL REFERENCES home ON DELETE CASCADE,
  position INTEGER NOT NULL,
  uuid BLOB NOT NULL,
  name TEXT NOT NULL,
  room INTEGER REFERENCES room ON DELETE SET NULL,
  reachable INTEGER NOT NULL,
  requires_unlock INTEGER NOT NULL,
  read_fault INTEGER NOT NULL,
  write_fault INTEGER NOT NULL,
  UNIQUE (home, position),
  UNIQUE (home, uuid)
) STRICT;
CREATE INDEX accessory_by_room ON accessory (room);

CREATE TABLE service (
  id INTEGER PRIMARY KEY,
  accessory INTEGER NOT NULL REFERENCES accessory ON DELETE CASCADE,
  position INTEGER NOT NULL,
  instance_id INTEGER NOT NULL,
  name TEXT,
  service_type TEXT NOT NULL,
  associated_service_type TEXT,
  UNIQUE (accessory, position),
  UNIQUE (accessory, instance_id)
) STRICT;

CREATE TABLE characteristic (
  id INTEGER PRIMARY KEY,
  service INTEGER NOT NULL REFERENCES service ON DELETE CASCADE,
  position INTEGER NOT NULL,
  instance_id INTEGER NOT NULL,
  characteristic_type TEXT NOT NULL,
  properties TEXT NOT NULL,
  value ANY,
  device_value ANY,
  has_metadata INTEGER NOT NULL,
  format TEXT,
  units TEXT,
  minimum_value ANY,
  maximum_value ANY,
  step_value ANY,
  read_fault INTEGER NOT NULL,
  write_fault INTEGER NOT NULL,
  UNIQUE (service, position),
  UNIQUE (service, instance_id)
) STRICT;

CREATE TABLE service_group (
  id INTEGER PRIMARY KEY,
  home INTEGER NOT NULL REFERENCES home ON DELETE CASCADE,
  position INTEGER NOT NULL,
  uuid BLOB NOT NULL,
  name TEXT NOT NULL,
  UNIQUE (home, position),
  UNIQUE (home, uuid)
) STRICT;

CREATE TABLE service_group_member (
  service_group INTEGER NOT NULL REFERENCES service_group ON DELETE CASCADE,
  position INTEGER NOT NULL,
  service INTEGER NOT NULL REFERENCES service ON DELETE CASCADE,
  PRIMARY KEY (service_group, position),
  UNIQUE (service_group, service)
) STRICT, WITHOUT ROWID;
CREATE INDEX service_group_member_by_service ON service_group_member (service);

CREATE TABLE action_set (
  id INTEGER PRIMARY KEY,
  home INTEGER NOT NULL REFERENCES home ON DELETE CASCADE,
  position INTEGER NOT NULL,
  uuid BLOB NOT NULL,
  name TEXT NOT NULL,
  execute_fault INTEGER NOT NULL,
  UNIQUE (home, position),
  UNIQUE (home, uuid)
) STRICT;

CREATE TABLE scene_action (
  action_set INTEGER NOT NULL REFERENCES action_set ON DELETE CASCADE,
  position INTEGER NOT NULL,
  characteristic INTEGER NOT NULL REFERENCES characteristic ON DELETE CASCADE,
  value ANY NOT NULL,
  PRIMARY KEY (action_set, position)
) STRICT, WITHOUT ROWID;
CREATE INDEX scene_action_by_characteristic ON scene_action (characteristic);

CREATE TABLE event_trigger (
  id INTEGER PRIMARY KEY,
  home INTEGER NOT NULL REFERENCES home ON DELETE CASCADE,
  position INTEGER NOT NULL,
  uuid BLOB NOT NULL,
  name TEXT NOT NULL,
  UNIQUE (home, position),
  UNIQUE (home, uuid)
) STRICT;
)sql";

bool isEmpty(Database& database) {
  return database.number("SELECT count(*) FROM sqlite_schema") == 0;
}

/// All statements that a database's tables are made of, in an order that depends on nothing else.
std::string statementsOf(Database& database) {
  Statement all(database,
                "SELECT group_concat(sql, ';') FROM "
                "(SELECT sql FROM sqlite_schema WHERE sql IS NOT NULL ORDER BY sql)");
  all.step();
  return std::string(all.text(0));
}

/// The statements of the first steps in the same order: those of the tables, as long as no step
/// changes what an earlier one has made.
std::string statementsOf(const std::vector<std::string>& steps, std::size_t version) {
  std::set<std::string> statements;
  for (std::size_t step = 0; step < version; ++step) {
    std::istringstream all(steps[step]);
    for (std::string statement; std::getline(all >> std::ws, statement, ';');) {
      statements.insert(statement);
    }
  }
  std::string joined;
  for (const std::string& statement : statements) {
    joined += (joined.empty() ? "" : ";") + statement;
  }
  return joined;
}

/// Refuses tables that are not exactly those of `version`: views and triggers in a database that
/// somebody else has made could let a statement do anything, or never end.
void checkTables(Database& database, const std::vector<std::string>& steps, std::size_t version) {
  const std::string found = statementsOf(database);
  if (found == statementsOf(steps, version)) return;  // without the work of making them
  Database sound(Database::kInMemory, std::chrono::milliseconds(0));
  for (std::size_t step = 0; step < version; ++step) sound.run(steps[step]);
  if (found == statementsOf(sound)) return;
  throw DatabaseError{DatabaseError::Kind::damaged, "its tables are not those of this program"};
}

}  // namespace

const std::vector<std::string>& schemaSteps() {
  static const std::vector<std::string> kSteps = {kVersion1};
  return kSteps;
}

bool isSchemaCurrent(Database& database, const std::vector<std::string>& steps) {
  return database.number("PRAGMA application_id") == kSchemaApplicationID &&
         database.number("PRAGMA user_version") == static_cast<std::int64_t>(steps.size());
}

std::optional<SchemaProblem> schemaProblemOf(Database& database,
                                             const std::vector<std::string>& steps) {
  if (database.number("PRAGMA application_id") != kSchemaApplicationID && !isEmpty(database)) {
    return SchemaProblem::notOurs;
  }
  const std::int64_t version = database.number("PRAGMA user_version");
  if (version < 0 || version > static_cast<std::int64_t>(steps.size())) return SchemaProblem::newer;
  checkTables(database, steps, static_cast<std::size_t>(version));
  return std::nullopt;
}

void runSchemaSteps(Database& database, const std::vector<std::string>& steps) {
  const std::int64_t version = database.number("PRAGMA user_version");
  for (auto step = static_cast<std::size_t>(version); step < steps.size(); ++step) {
    database.run(steps[step]);
  }
  database.run("PRAGMA application_id = " + std::to_string(kSchemaApplicationID));
  database.run("PRAGMA user_version = " + std::to_string(steps.size()));
}

std::optional<SchemaProblem> applySchema(Database& database, const std::vector<std::string>& steps,
                                         const MigrationHooks& hooks) {
  if (isSchemaCurrent(database, steps)) {  // nearly always, and without a lock
    checkTables(database, steps, steps.size());
    return std::nullopt;
  }
  Transaction transaction(database, Transaction::Kind::writing);
  // Another process may have been the first.
  if (isSchemaCurrent(database, steps)) return std::nullopt;
  if (const auto problem = schemaProblemOf(database, steps)) return problem;
  const bool isMigration = !isEmpty(database);
  if (isMigration && hooks.before) hooks.before();
  runSchemaSteps(database, steps);
  if (isMigration && hooks.beforeCommit) hooks.beforeCommit();
  transaction.commit();
  return std::nullopt;
}

}  // namespace nidus
