#include "HomePlatform/Store/Schema.h"

#include <gtest/gtest.h>

#include <string>

namespace nidus {
namespace {

constexpr std::chrono::milliseconds kNoTimeout{0};

std::vector<std::string> steps(std::size_t count) {
  const std::vector<std::string> all = {
      "CREATE TABLE lamp (name TEXT); INSERT INTO lamp VALUES ('old')",
      "ALTER TABLE lamp ADD COLUMN level INTEGER NOT NULL DEFAULT 5",
      "UPDATE lamp SET level = level + 1; INSERT INTO lamp VALUES ('new', 0)",
  };
  return {all.begin(), all.begin() + static_cast<std::ptrdiff_t>(count)};
}

std::int64_t version(Database& database) { return database.number("PRAGMA user_version"); }

TEST(ApplySchemaTest, RunsAllStepsOnANewDatabase) {
  Database database(Database::kInMemory, kNoTimeout);
  EXPECT_FALSE(applySchema(database, steps(3)));
  EXPECT_EQ(version(database), 3);
  EXPECT_EQ(database.number("PRAGMA application_id"), kSchemaApplicationID);
  EXPECT_EQ(database.number("SELECT level FROM lamp WHERE name = 'old'"), 6);
}

TEST(ApplySchemaTest, MigratesEachEarlierVersion) {
  for (std::size_t earlier = 1; earlier <= 3; ++earlier) {
    Database database(Database::kInMemory, kNoTimeout);
    ASSERT_FALSE(applySchema(database, steps(earlier)));
    EXPECT_EQ(version(database), static_cast<std::int64_t>(earlier));
    EXPECT_FALSE(applySchema(database, steps(3)));
    EXPECT_EQ(version(database), 3);
    EXPECT_EQ(database.number("SELECT sum(level) FROM lamp"), 6);
  }
}

TEST(ApplySchemaTest, LeavesNewerVersionsAlone) {
  Database database(Database::kInMemory, kNoTimeout);
  ASSERT_FALSE(applySchema(database, steps(3)));
  EXPECT_EQ(applySchema(database, steps(2)), SchemaProblem::newer);
  EXPECT_EQ(version(database), 3);
}

TEST(ApplySchemaTest, LeavesForeignDatabasesAlone) {
  Database database(Database::kInMemory, kNoTimeout);
  database.run("CREATE TABLE recipe (name TEXT); PRAGMA user_version = 1");
  EXPECT_EQ(applySchema(database, steps(1)), SchemaProblem::notOurs);
  EXPECT_EQ(database.number("PRAGMA application_id"), 0);
}

TEST(ApplySchemaTest, UndoesAMigrationThatFails) {
  Database database(Database::kInMemory, kNoTimeout);
  ASSERT_FALSE(applySchema(database, steps(1)));
  std::vector<std::string> broken = steps(2);
  broken.emplace_back("INSERT INTO missing VALUES (1)");
  EXPECT_THROW((void)applySchema(database, broken), DatabaseError);
  EXPECT_EQ(version(database), 1);
  EXPECT_EQ(database.number("SELECT count(*) FROM pragma_table_info('lamp')"), 1);
}

TEST(SchemaStepsTest, LeadToTheTablesOfToday) {
  Database database(Database::kInMemory, kNoTimeout);
  ASSERT_FALSE(applySchema(database, schemaSteps()));
  EXPECT_EQ(database.number("SELECT count(*) FROM sqlite_schema WHERE type = 'table'"), 12);
  EXPECT_EQ(version(database), static_cast<std::int64_t>(schemaSteps().size()));
}

TEST(SchemaStepsTest, IndexEveryReference) {
  Database database(Database::kInMemory, kNoTimeout);
  ASSERT_FALSE(applySchema(database, schemaSteps()));
  Statement references(database,
                       "SELECT t.name, f.\"from\" FROM sqlite_schema AS t, "
                       "pragma_foreign_key_list(t.name) AS f WHERE t.type = 'table' AND NOT EXISTS "
                       "(SELECT 1 FROM pragma_index_list(t.name) AS i, "
                       "pragma_index_info(i.name) AS c WHERE c.seqno = 0 AND c.name = f.\"from\")");
  while (references.step()) {
    ADD_FAILURE() << references.text(0) << '.' << references.text(1) << " has no index";
  }
}

}  // namespace
}  // namespace nidus
