#include "HomePlatform/Store/Database.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

class DatabaseTest : public testing::Test {
 protected:
  DatabaseTest() { database_.run("CREATE TABLE item (number ANY) STRICT"); }

  std::int64_t count() { return database_.number("SELECT count(*) FROM item"); }

  DatabaseError errorOf(const std::string& statement) {
    try {
      database_.run(statement);
    } catch (const DatabaseError& error) {
      return error;
    }
    ADD_FAILURE() << "was accepted: " << statement;
    return {};
  }

  Database database_{Database::kInMemory, std::chrono::milliseconds(0)};
};

TEST_F(DatabaseTest, TransactionUndoesUnlessCommitted) {
  {
    const Transaction transaction(database_, Transaction::Kind::writing);
    database_.run("INSERT INTO item VALUES (1)");
  }
  EXPECT_EQ(count(), 0);
  Transaction transaction(database_, Transaction::Kind::writing);
  database_.run("INSERT INTO item VALUES (1)");
  transaction.commit();
  EXPECT_EQ(count(), 1);
}

TEST_F(DatabaseTest, StatementsAreUsedAgain) {
  Statement insert(database_, "INSERT INTO item VALUES (?)");
  insert.run(std::int64_t{1});
  insert.run(NDString("two"));
  insert.run(NDString());
  EXPECT_EQ(count(), 3);
  EXPECT_EQ(database_.lastRow(), 3);
  EXPECT_EQ(database_.number("SELECT count(*) FROM item WHERE number IS NULL"), 1);
}

TEST_F(DatabaseTest, StatementForgetsParametersOfLastRun) {
  Statement insert(database_, "INSERT INTO item VALUES (?)");
  insert.run(std::int64_t{1});
  insert.run();
  EXPECT_EQ(database_.number("SELECT count(*) FROM item WHERE number IS NULL"), 1);
}

TEST_F(DatabaseTest, ErrorsCarryTheEnginesWords) {
  const DatabaseError error = errorOf("INSERT INTO missing VALUES (1)");
  EXPECT_EQ(error.kind, DatabaseError::Kind::other);
  EXPECT_EQ(error.message, "no such table: missing");
}

TEST_F(DatabaseTest, TellsAFullDatabase) {
  database_.run("PRAGMA max_page_count = 3");
  EXPECT_EQ(errorOf("INSERT INTO item VALUES (zeroblob(100000))").kind, DatabaseError::Kind::full);
}

TEST_F(DatabaseTest, EnforcesReferences) {
  database_.run("CREATE TABLE owner (id INTEGER PRIMARY KEY)");
  database_.run("CREATE TABLE owned (owner INTEGER REFERENCES owner)");
  EXPECT_EQ(errorOf("INSERT INTO owned VALUES (5)").message, "FOREIGN KEY constraint failed");
}

}  // namespace
}  // namespace nidus
