#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sqlite3.h>
#include <sys/stat.h>

#include <array>
#include <filesystem>
#include <fstream>
#include <string>

#include "HomePlatform/Store/BackupList.h"
#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeStore.h"
#include "HomePlatform/Store/StoreExamination.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;
using testing::AllOf;
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

/// A database of many rooms, in which the pages of a table or an index lead to one another.
class CircularStoreTest : public HostileStoreTest {
 protected:
  void SetUp() override {
    home_.uuid = NDUUID::random();
    home_.name = "Manor";
    home_.rooms.clear();
    for (int i = 0; i < 2000; ++i) home_.rooms.push_back({NDUUID::random(), "Kitchen"});
    const auto store = HomeStore::open(file());
    ASSERT_TRUE(store);
    ASSERT_FALSE((*store)->replaceHomes({home_}));
  }

  /// Has each child of the first page of `tree` be the next one of `more` pages like it, and those
  /// of the last one be `last`; the first page itself without one.
  void redirect(const std::string& tree, std::size_t more, bool endsInLeaf) const {
    const std::size_t root = rootOf(tree);
    std::string bytes = contentOfFile(file());
    const std::string page = bytes.substr((root - 1) * kPage, kPage);
    const std::size_t count = bytes.size() / kPage;
    const std::size_t last = endsInLeaf ? number(page, number(page, 12, 2), 4) : root;
    bytes.replace((root - 1) * kPage, kPage, leadingTo(more > 0 ? count + 1 : last, page));
    for (std::size_t i = 1; i <= more; ++i) {
      bytes += leadingTo(i < more ? count + i + 1 : last, page);
    }
    put(bytes, 28, count + more);
    std::ofstream(file(), std::ios::binary) << bytes;
  }

  HomeData home_;

 private:
  static constexpr std::size_t kPage = 4096;

  [[nodiscard]] std::size_t rootOf(const std::string& tree) const {
    Database database(file().string(), kNoPatience);
    const std::string query = "SELECT rootpage FROM sqlite_schema WHERE name = '" + tree + "'";
    return static_cast<std::size_t>(database.number(query.c_str()));
  }
  /// A big-endian number.
  static std::size_t number(const std::string& bytes, std::size_t place, std::size_t length) {
    std::size_t value = 0;
    for (std::size_t i = 0; i < length; ++i) {
      value = value << 8U | static_cast<unsigned char>(bytes[place + i]);
    }
    return value;
  }
  static void put(std::string& bytes, std::size_t place, std::size_t value) {
    for (std::size_t i = 4; i-- > 0; value >>= 8U) bytes[place + i] = static_cast<char>(value);
  }
  /// The page with `child` in place of all its children.
  static std::string leadingTo(std::size_t child, std::string page) {
    const std::size_t cells = number(page, 3, 2);
    for (std::size_t i = 0; i < cells; ++i) put(page, number(page, 12 + 2 * i, 2), child);
    put(page, 8, child);
    return page;
  }
};

TEST_F(CircularStoreTest, ReadsNoPageWithinItself) {
  redirect("sqlite_autoindex_room_1", 0, false);
  EXPECT_THAT(loadingProblem(), StartsWith(damage("database disk image is malformed")));
  EXPECT_TRUE(examineStore(file(), kNoPatience).isDamaged);
}

TEST_F(CircularStoreTest, ReadsNoPagesAgainAndAgain) {
  redirect("sqlite_autoindex_room_1", 10, true);
  EXPECT_THAT(loadingProblem(),
              StartsWith(damage("its pages lead to one another again and again")));
}

TEST_F(CircularStoreTest, ChangesNothingOfPagesAgainAndAgain) {
  redirect("sqlite_autoindex_room_1", 10, true);
  const auto store = HomeStore::open(file(), kNoPatience);
  ASSERT_TRUE(store);
  for (const auto& failure :
       {(*store)->replaceHomes({}), (*store)->mergeHomes({home_}),
        (*store)->editHomes([](std::vector<HomeData>& /*homes*/) { return Status(); })}) {
    ASSERT_TRUE(failure);
    EXPECT_THAT(failure->message,
                AllOf(StartsWith(file().string() + ": the database is damaged ("),
                      HasSubstr("its pages lead to one another again and again")));
  }
}

TEST_F(CircularStoreTest, ExaminesNoPagesAgainAndAgain) {
  for (const char* tree : {"room", "sqlite_autoindex_room_1", "sqlite_autoindex_room_2"}) {
    SetUp();
    redirect(tree, 10, true);
    EXPECT_TRUE(examineStore(file(), kNoPatience).isDamaged) << tree;
    EXPECT_FALSE(homesOfBackup(file())) << tree;
    fs::remove(file());
  }
}

TEST_F(HostileStoreTest, ReadsNoTextBesideUTF8) {
  change("UPDATE room SET name = CAST(x'4BFF' AS TEXT)");
  EXPECT_THAT(loadingProblem(), StartsWith(damage("unexpected contents of column name")));
  EXPECT_TRUE(examineStore(file(), kNoPatience).isDamaged);
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
