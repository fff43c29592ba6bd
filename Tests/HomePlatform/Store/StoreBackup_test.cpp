#include "HomePlatform/Store/StoreBackup.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <string>
#include <vector>

#include "HomePlatform/SampleHome.h"
#include "HomePlatform/Store/BackupList.h"
#include "HomePlatform/Store/HomeStore.h"
#include "HomePlatform/Support/RandomHome.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

/// A database in a folder of its own, and its backups.
class StoreBackupTest : public testing::Test {
 protected:
  [[nodiscard]] fs::path file() const { return folder_.path() / "home.db"; }
  [[nodiscard]] std::unique_ptr<HomeStore> open() const {
    auto store = HomeStore::open(file(), kNoWaiting);
    EXPECT_TRUE(store) << store.failure().message;
    return std::move(*store);
  }
  static HomeData named(const std::string& name) {
    HomeData home = sampleHome();
    home.name = name;
    return home;
  }
  /// Imports a home of each name.
  void import(const std::vector<std::string>& names) const {
    const auto store = open();
    for (const std::string& name : names) ASSERT_FALSE(store->replaceHomes({named(name)}));
  }
  /// The name of the first home of each backup, the newest first; of a bad one what it is.
  [[nodiscard]] std::vector<std::string> backups() const {
    std::vector<std::string> names;
    for (const fs::path& backup : backupsOf(file())) {
      const auto homes = homesOfBackup(backup);
      names.push_back(homes ? homes->front().name.str() : "bad");
    }
    return names;
  }
  [[nodiscard]] std::vector<std::string> filesInFolder() const {
    std::vector<std::string> names;
    for (const auto& entry : fs::directory_iterator(folder_.path())) {
      names.push_back(entry.path().filename().string());
    }
    return names;
  }
  /// Lets the index of the rooms miss what the table has.
  void damage() const {
    Database database(file().string(), kNoWaiting);
    const std::int64_t page = database.number(
        "SELECT rootpage FROM sqlite_schema WHERE tbl_name = 'room' AND type = 'index'");
    database.run("PRAGMA wal_checkpoint(TRUNCATE)");
    std::string bytes = contentOfFile(file());
    constexpr std::size_t kPageLength = 4096;
    bytes.replace((static_cast<std::size_t>(page) - 1) * kPageLength, kPageLength,
                  std::string("\x0a\0\0\0\0\x10\0\0", 8) + std::string(kPageLength - 8, '\0'));
    folder_.write("home.db", bytes);
  }

  const TestFolder folder_;
};

TEST_F(StoreBackupTest, KeepsTheHomesBeforeAnImport) {
  import({"First", "Second"});
  EXPECT_THAT(backups(), ElementsAre("First"));
  ASSERT_FALSE(open()->mergeHomes({named("Third")}));
  EXPECT_THAT(backups(), ElementsAre("Second", "First"));
}

TEST_F(StoreBackupTest, MakesNoneOfNothing) {
  import({"First"});
  EXPECT_THAT(backups(), IsEmpty());
  ASSERT_FALSE(open()->replaceHomes({}));
  import({"Second"});
  EXPECT_THAT(backups(), ElementsAre("First"));
}

TEST_F(StoreBackupTest, MakesNoneForEditsAndValues) {
  import({"First"});
  const auto store = open();
  ASSERT_FALSE(store->editHomes([](auto& homes) {
    homes.at(0).name = "Renamed";
    return Status();
  }));
  const NDValueRef value = NDValue::integer(3);
  ASSERT_FALSE(store->writeValues({{uuidOf(kHomeID), brightnessAddress(), value, value}}));
  EXPECT_THAT(backups(), IsEmpty());
}

TEST_F(StoreBackupTest, KeepsTheLastFive) {
  import({"1", "2", "3", "4", "5", "6", "7", "8"});
  EXPECT_THAT(backups(), ElementsAre("7", "6", "5", "4", "3"));
  EXPECT_EQ(backupsOf(file()).front().filename(), "home-backup-000007.db");
}

TEST_F(StoreBackupTest, IsOneFileOfItsOwner) {
  import({"First", "Second"});
  EXPECT_THAT(filesInFolder(), testing::UnorderedElementsAre("home.db", "home-backup-000001.db"));
  struct stat status {};
  ASSERT_EQ(::stat(backupsOf(file()).front().c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 0777U, 0600U);
}

TEST_F(StoreBackupTest, HasValuesThatOnlyTheLogHolds) {
  import({"First"});
  const auto store = open();
  const NDValueRef value = NDValue::integer(3);
  ASSERT_FALSE(store->writeValues({{uuidOf(kHomeID), brightnessAddress(), value, value}}));
  ASSERT_FALSE(store->replaceHomes({named("Second")}));
  auto homes = homesOfBackup(backupsOf(file()).front());
  ASSERT_TRUE(homes);
  EXPECT_EQ(brightnessOf(homes->front()).value->integerValue(), 3);
}

TEST_F(StoreBackupTest, GoesWithAChangeThatFails) {
  import({"First"});
  EXPECT_TRUE(open()->replaceHomes({named("Twice"), named("Twice")}));
  EXPECT_THAT(backups(), IsEmpty());
}

TEST_F(StoreBackupTest, FailureLeavesTheHomes) {
  import({"First"});
  fs::create_directories(file().string() + ".backup/full");
  const Status failure = open()->replaceHomes({named("Second")});
  ASSERT_TRUE(failure);
  EXPECT_THAT(failure->message, HasSubstr("while a backup was made: "));
  EXPECT_EQ(open()->loadHomes()->front().name, "First");
}

TEST_F(StoreBackupTest, TakesNoTemporaryFileForOne) {
  import({"First"});
  for (const char* name : {"home.db.backup", "home-backup-1.db", "home-backup-000001.db-wal",
                           "home-backup-00000x.db", "home-backup-000001"}) {
    folder_.write(name, "half a backup");
  }
  EXPECT_THAT(backupsOf(file()), IsEmpty());
  import({"Second"});
  EXPECT_THAT(backups(), ElementsAre("First"));
}

TEST_F(StoreBackupTest, DamagedDatabaseIsNotReplaced) {
  import({"First", "Second"});
  damage();
  const Status failure = open()->replaceHomes({named("Third")});
  ASSERT_TRUE(failure);
  EXPECT_THAT(failure->message, HasSubstr(": the database is damaged (while a backup was made: "));
  EXPECT_THAT(failure->message, HasSubstr("; nidus home restore brings back "
                                          "home-backup-000001.db, its newest good backup"));
  EXPECT_EQ(open()->loadHomes()->front().name, "Second");
  EXPECT_THAT(backups(), ElementsAre("First"));
}

TEST_F(StoreBackupTest, DamageNamesTheNewestGoodOne) {
  import({"1", "2", "3", "4"});
  folder_.write("home-backup-000003.db", "not this one");
  folder_.write("home.db", std::string(8192, 'x'));
  const auto store = HomeStore::open(file(), kNoWaiting);
  ASSERT_FALSE(store);
  EXPECT_THAT(store.failure().message, HasSubstr(" brings back home-backup-000002.db,"));
}

TEST_F(StoreBackupTest, OneOfAnotherProgramIsNoGoodOne) {
  import({"First", "Second"});
  Database(backupsOf(file()).front().string(), kNoWaiting).run("PRAGMA application_id = 5");
  EXPECT_THAT(backups(), ElementsAre("bad"));
}

/// The steps of a schema with one more version.
std::vector<std::string> laterSteps() {
  std::vector<std::string> steps = schemaSteps();
  steps.emplace_back("UPDATE home SET name = name || ' migrated'");
  return steps;
}

TEST_F(StoreBackupTest, KeepsTheHomesBeforeAMigration) {
  import({"First"});
  Database database(file().string(), kNoWaiting);
  EXPECT_FALSE(migrateStore(database, file(), laterSteps(), kNoWaiting));
  EXPECT_THAT(backups(), ElementsAre("First"));
  EXPECT_EQ(database.number("SELECT count(*) FROM home WHERE name = 'First migrated'"), 1);
  EXPECT_FALSE(migrateStore(database, file(), laterSteps(), kNoWaiting));
  EXPECT_THAT(backups(), ElementsAre("First"));
}

TEST_F(StoreBackupTest, GoesWithAMigrationThatFails) {
  import({"First"});
  Database database(file().string(), kNoWaiting);
  std::vector<std::string> steps = laterSteps();
  steps.emplace_back("INSERT INTO missing VALUES (1)");
  EXPECT_THROW(static_cast<void>(migrateStore(database, file(), steps, kNoWaiting)), DatabaseError);
  EXPECT_THAT(backups(), IsEmpty());
}

}  // namespace
}  // namespace nidus
