#include "HomePlatform/HomeRestoration.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "HomePlatform/SampleHome.h"
#include "HomePlatform/Store/BackupList.h"
#include "HomePlatform/Store/Database.h"
#include "HomePlatform/System/Preferences.h"
#include "Support/FileModes.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;

/// A data folder with homes named "Second" and a backup of homes named "First".
class HomeRestorationTest : public testing::Test {
 protected:
  void SetUp() override {
    const auto store = open();
    for (const char* name : {"First", "Second"}) {
      HomeData home = sampleHome();
      home.name = name;
      ASSERT_FALSE(store->replaceHomes({home}));
    }
    backup_ = backupsOf(file()).front();
  }

  [[nodiscard]] fs::path file() const { return folder_.path() / "home.db"; }
  [[nodiscard]] std::unique_ptr<HomeStore> open() const {
    auto store = HomeStore::open(file(), kNoWaiting);
    EXPECT_TRUE(store) << store.failure().message;
    return std::move(*store);
  }
  [[nodiscard]] std::string homeName() const { return open()->loadHomes()->front().name.str(); }
  [[nodiscard]] Result<HomeRestoration> restore() const {
    return restoreHomes(folder_.path(), backup_, kNoWaiting);
  }
  /// Why nothing was restored.
  [[nodiscard]] std::string refusal() const {
    const auto done = restore();
    return done ? "restored" : done.failure().message;
  }
  void change(const std::string& statements) const {
    Database(file().string(), kNoWaiting).run(statements);
  }
  void makeReferencesDangle() const {
    change("PRAGMA foreign_keys = OFF; UPDATE room SET home = 77");
  }
  /// The bytes of the database with a page torn that its log, if there is one, has too.
  [[nodiscard]] std::string withoutAPageOfRooms() const {
    constexpr std::size_t kPageLength = 4096;
    const std::int64_t page = Database(file().string(), kNoWaiting)
                                  .number(
                                      "SELECT rootpage FROM sqlite_schema WHERE tbl_name = 'room' "
                                      "AND type = 'index'");
    std::string bytes = contentOfFile(file());
    return bytes.replace((static_cast<std::size_t>(page) - 1) * kPageLength, kPageLength,
                         kPageLength, 'x');
  }
  [[nodiscard]] bool isConfigured() const {
    const auto preferences = Preferences::open(folder_.path(), [](const Failure&) {});
    return (*preferences)->values()[Preferences::kHomesConfigured] == JsonValue{true};
  }

  const TestFolder folder_;
  fs::path backup_;
};

TEST_F(HomeRestorationTest, BringsBackTheHomesOfTheBackup) {
  const auto done = restore();
  ASSERT_TRUE(done) << done.failure().message;
  EXPECT_FALSE(done->damaged);
  EXPECT_EQ(done->homes.front().name, "First");
  EXPECT_EQ(homeName(), "First");
  EXPECT_TRUE(isConfigured());
}

TEST_F(HomeRestorationTest, KeepsWhatItReplacesAsABackup) {
  ASSERT_TRUE(restore());
  EXPECT_EQ(homesOfBackup(backupsOf(file()).front())->front().name, "Second");
}

TEST_F(HomeRestorationTest, OthersMayHaveASoundDatabaseOpen) {
  const auto other = open();
  const std::uint64_t before = *other->version();
  ASSERT_TRUE(restore());
  EXPECT_NE(*other->version(), before);
  EXPECT_EQ(other->loadHomes()->front().name, "First");
}

TEST_F(HomeRestorationTest, ReplacesADamagedDatabase) {
  const std::string damage(8192, 'x');
  folder_.write("home.db", damage);
  const auto done = restore();
  ASSERT_TRUE(done) << done.failure().message;
  ASSERT_TRUE(done->damaged);
  EXPECT_EQ(done->damaged->filename(), "home-damaged-000001.db");
  EXPECT_EQ(contentOfFile(*done->damaged), damage);
  EXPECT_EQ(homeName(), "First");
  EXPECT_TRUE(isConfigured());
}

TEST_F(HomeRestorationTest, KeepsTheLogWithTheDamagedDatabase) {
  const std::vector<std::string> logs = {"-wal", "-journal", "-shm"};
  folder_.write("home.db", std::string(8192, 'x'));
  for (const std::string& log : logs) folder_.write("home.db" + log, "the log" + log);
  const auto done = restore();
  ASSERT_TRUE(done) << done.failure().message;
  ASSERT_TRUE(done->damaged);
  for (const std::string& log : logs) {
    EXPECT_EQ(contentOfFile(done->damaged->string() + log), "the log" + log);
    EXPECT_FALSE(fs::exists(file().string() + log));
  }
  EXPECT_EQ(homeName(), "First");
}

TEST_F(HomeRestorationTest, TheLogMakesADatabaseWhole) {
  const auto store = open();
  ASSERT_FALSE(store->replaceHomes({sampleHome()}));
  const TestFolder other;  // as after a power cut in the middle of a checkpoint
  for (const char* name : {"home.db-wal", "home-backup-000001.db"}) {
    other.write(name, contentOfFile(folder_.path() / name));
  }
  other.write("home.db", withoutAPageOfRooms());
  const auto done = restoreHomes(other.path(), other.path() / "home-backup-000001.db", kNoWaiting);
  ASSERT_TRUE(done) << done.failure().message;
  EXPECT_FALSE(done->damaged);
}

TEST_F(HomeRestorationTest, RefusesAFolderThatOthersMayChange) {
  fs::permissions(folder_.path(), fs::perms::group_write, fs::perm_options::add);
  EXPECT_THAT(refusal(), HasSubstr(folder_.path().string()));
  fs::permissions(folder_.path(), fs::perms::group_write, fs::perm_options::remove);
  EXPECT_EQ(homeName(), "Second");
}

TEST_F(HomeRestorationTest, RefusesABackupThatOthersMayChange) {
  fs::permissions(backup_, fs::perms::others_write, fs::perm_options::add);
  EXPECT_THAT(refusal(), HasSubstr(backup_.string()));
}

TEST_F(HomeRestorationTest, TakesBackupsFromOthers) {
  fs::permissions(backup_, fs::perms::others_read, fs::perm_options::add);
  ASSERT_TRUE(restore());
  EXPECT_EQ(permissionsOf(backup_), 0600U);
}

TEST_F(HomeRestorationTest, KeepsEachDamagedDatabase) {
  for (const char* name : {"home-damaged-000001.db", "home-damaged-000002.db"}) {
    makeReferencesDangle();
    const auto done = restore();
    ASSERT_TRUE(done) << done.failure().message;
    EXPECT_EQ(done->damaged->filename(), name);
  }
}

TEST_F(HomeRestorationTest, RefusesWhileOthersHaveADamagedOneOpen) {
  makeReferencesDangle();
  auto other = open();
  ASSERT_TRUE(other->countHomes());
  EXPECT_THAT(refusal(), HasSubstr("home.db: the database is damaged, and another process has it "
                                   "open; end that process"));
  EXPECT_FALSE(fs::exists(file().string() + ".restored"));
  other.reset();
  EXPECT_TRUE(restore());
}

TEST_F(HomeRestorationTest, LeavesANewerDatabaseAlone) {
  change("PRAGMA user_version = 1000");
  EXPECT_THAT(refusal(), HasSubstr("newer version"));
}

TEST_F(HomeRestorationTest, RefusesADamagedBackup) {
  folder_.write(backup_.filename().string(), "half of it");
  EXPECT_THAT(refusal(), HasSubstr("home-backup-000001.db: the backup is damaged; "));
  EXPECT_EQ(homeName(), "Second");
}

TEST_F(HomeRestorationTest, MakesADatabaseThatIsGone) {
  fs::remove(file());
  ASSERT_TRUE(restore());
  EXPECT_EQ(homeName(), "First");
}

TEST_F(HomeRestorationTest, DamagedPreferencesKeepAllAsItIs) {
  folder_.write("preferences.json", "no JSON");
  folder_.write("home.db", std::string(8192, 'x'));
  EXPECT_THAT(refusal(), HasSubstr("preferences.json"));
  EXPECT_EQ(contentOfFile(file()), std::string(8192, 'x'));
}

}  // namespace
}  // namespace nidus
