#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sqlite3.h>
#include <sys/stat.h>

#include <array>
#include <filesystem>
#include <string>

#include "HomePlatform/Store/BackupList.h"
#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeStore.h"
#include "HomePlatform/Store/StoreExamination.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::SizeIs;
using testing::StartsWith;

constexpr std::chrono::milliseconds kNoPatience{0};

/// A database that somebody has changed so that it does harm where it can.
class HostileStoreTest : public testing::Test {
 protected:
  void SetUp() override { fill(); }

  void fill() const {
    HomeData home;
    home.name = "Cottage";
    home.rooms.push_back({NDUUID::random(), "Kitchen"});
    const auto store = HomeStore::open(file());
    ASSERT_TRUE(store);
    ASSERT_FALSE((*store)->replaceHomes({home}));
  }

  [[nodiscard]] fs::path file() const { return folder_.path() / "home.db"; }
  /// Changes the database without any of the limits that the program sets itself.
  void change(const char* statements) const {
    sqlite3* connection = nullptr;
    ASSERT_EQ(sqlite3_open(file().c_str(), &connection), SQLITE_OK);
    EXPECT_EQ(sqlite3_exec(connection, statements, nullptr, nullptr, nullptr), SQLITE_OK)
        << sqlite3_errmsg(connection);
    sqlite3_close(connection);
  }
  [[nodiscard]] std::string openingProblem() const {
    const auto store = HomeStore::open(file(), kNoPatience);
    return store ? "" : store.failure().message;
  }
  [[nodiscard]] std::string loadingProblem() const {
    const auto store = HomeStore::open(file(), kNoPatience);
    if (!store) return "not opened: " + store.failure().message;
    const auto homes = (*store)->loadHomes();
    return homes ? "" : homes.failure().message;
  }
  [[nodiscard]] std::string damage(const std::string& cause) const {
    return file().string() + ": the database is damaged (" + cause + ")";
  }

  const TestFolder folder_;
};

/// A view whose rows have no end.
constexpr const char* kEndlessTriggers =
    "DROP TABLE event_trigger;"
    "CREATE VIEW event_trigger (id, home, position, uuid, name) AS "
    "WITH RECURSIVE endless (n) AS (SELECT 1 UNION ALL SELECT n + 1 FROM endless) "
    "SELECT n, 1, n, zeroblob(16), 'a' FROM endless;";

TEST_F(HostileStoreTest, RefusesTablesOfAnotherMake) {
  const std::array changes = {
      kEndlessTriggers,
      "CREATE TRIGGER t AFTER UPDATE ON characteristic BEGIN DELETE FROM home; END",
      "CREATE VIEW more AS SELECT 1",
      "CREATE TABLE more (a)",
      "CREATE INDEX more ON room (name)",
      "ALTER TABLE room ADD COLUMN more ANY",
      "ALTER TABLE room DROP COLUMN name",
      "DROP INDEX accessory_by_room",
      "DROP TABLE event_trigger; CREATE TABLE event_trigger (id, home, position, uuid, name)",
      "DROP TABLE event_trigger",
  };
  for (const char* changed : changes) {
    SCOPED_TRACE(changed);
    fill();
    change(changed);
    EXPECT_THAT(openingProblem(), StartsWith(damage("its tables are not those of this program")));
    fs::remove(file());
  }
}

TEST_F(HostileStoreTest, ExaminesNoTablesOfAnotherMake) {
  change(kEndlessTriggers);
  const StoreExamination found = examineStore(file(), kNoPatience);
  EXPECT_TRUE(found.isDamaged);
  EXPECT_THAT(found.failures, SizeIs(1));
  EXPECT_FALSE(homesOfBackup(file()));
}

TEST_F(HostileStoreTest, ReadsNoTextOfAbsurdLength) {
  change("UPDATE room SET name = replace(hex(zeroblob(8000001)), '0', 'a')");
  EXPECT_THAT(loadingProblem(), StartsWith(damage("string or blob too big")));
  EXPECT_TRUE(examineStore(file(), kNoPatience).isDamaged);
}

TEST_F(HostileStoreTest, ReadsNoBytesOfAbsurdLength) {
  change("UPDATE home SET uuid = zeroblob(100000000)");
  EXPECT_THAT(loadingProblem(), StartsWith(damage("string or blob too big")));
  change("UPDATE home SET uuid = zeroblob(1000000)");
  EXPECT_THAT(loadingProblem(), StartsWith(damage("unexpected contents of column uuid")));
}

TEST_F(HostileStoreTest, ReadsNoStatementOfAbsurdLength) {
  std::string table = "CREATE TABLE more (a";
  for (int i = 0; i < 1500; ++i) table += ", column" + std::to_string(i);
  change((table + ")").c_str());
  EXPECT_THAT(openingProblem(), StartsWith(file().string() + ": the database is damaged ("));
}

TEST_F(HostileStoreTest, RefusesWhatIsNoFile) {
  fs::remove(file());
  ASSERT_EQ(::mkfifo(file().c_str(), 0600), 0);
  EXPECT_THAT(openingProblem(),
              HasSubstr("home.db: a device or pipe is where the database has to be"));
  fs::remove(file());
  fs::create_symlink("/dev/zero", file());
  EXPECT_THAT(openingProblem(),
              HasSubstr("home.db: a device or pipe is where the database has to be"));
}

}  // namespace
}  // namespace nidus
