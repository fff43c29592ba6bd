#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <string>
#include <thread>
#include <vector>

#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeStore.h"
#include "HomePlatform/Store/Schema.h"
#include "HomePlatform/Support/RandomHome.h"
#include "HomePlatform/Support/Unprivileged.h"
#include "Support/FileModes.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::StartsWith;

/// Opening a database that is not as it should be.
class OpenHomeStoreTest : public testing::Test {
 protected:
  [[nodiscard]] fs::path file() const { return folder_.path() / "home.db"; }
  [[nodiscard]] const fs::path& folder() const { return folder_.path(); }

  [[nodiscard]] std::string problem() const {
    const auto store = HomeStore::open(file(), std::chrono::milliseconds(1));
    if (store) return {};
    EXPECT_EQ(store.failure().kind, Failure::Kind::platform);
    return store.failure().message;
  }

  void writeFile(const std::string& contents) const { folder_.write("home.db", contents); }
  [[nodiscard]] std::string readFile() const { return contentOfFile(file()); }

  /// Makes a database with some homes and closes it.
  void fill() const {
    auto store = HomeStore::open(file());
    ASSERT_TRUE(store);
    ASSERT_FALSE((*store)->replaceHomes({RandomHome(1).home(), RandomHome(2).home()}));
  }

 private:
  TestFolder folder_;
};

TEST_F(OpenHomeStoreTest, MakesFolderAndFilesForTheirOwner) {
  const fs::path nested = folder() / "a" / "b" / "home.db";
  const auto store = HomeStore::open(nested);
  ASSERT_TRUE(store);
  ASSERT_FALSE((*store)->replaceHomes({}));
  EXPECT_EQ(permissionsOf(folder() / "a"), 0700U);
  EXPECT_EQ(permissionsOf(folder() / "a" / "b"), 0700U);
  EXPECT_EQ(permissionsOf(nested), 0600U);
  EXPECT_EQ(permissionsOf(nested.string() + "-wal"), 0600U);
  EXPECT_EQ(permissionsOf(nested.string() + "-shm"), 0600U);
}

TEST_F(OpenHomeStoreTest, UsesWriteAheadLogAndForeignKeys) {
  fill();
  Database database(file().string(), std::chrono::milliseconds(0));
  Statement mode(database, "PRAGMA journal_mode");
  ASSERT_TRUE(mode.step());
  EXPECT_EQ(mode.text(0), "wal");
  EXPECT_EQ(database.number("PRAGMA foreign_keys"), 1);
  constexpr std::int64_t kFull = 2;
  EXPECT_EQ(database.number("PRAGMA synchronous"), kFull);
}

TEST_F(OpenHomeStoreTest, TakesAnEmptyFileForNew) {
  writeFile("");
  EXPECT_EQ(problem(), "");
}

TEST_F(OpenHomeStoreTest, SaysWhenTheFileIsNoDatabase) {
  writeFile(
      "a shopping list, and longer than a header of a database is, all in all; "
      "milk, bread, butter, cheese, and six eggs");
  EXPECT_THAT(problem(), StartsWith(file().string() + ": the file is damaged or no database"));
  EXPECT_THAT(problem(), HasSubstr("; there is no good backup of it"));
  EXPECT_THAT(readFile(), StartsWith("a shopping list"));
}

TEST_F(OpenHomeStoreTest, SaysWhenTheSchemaIsDamaged) {
  fill();
  std::string bytes = readFile();
  constexpr std::size_t kHeaderLength = 100;
  constexpr std::size_t kPageLength = 4096;
  std::fill(bytes.begin() + kHeaderLength, bytes.begin() + kPageLength, '\x7f');
  writeFile(bytes);
  EXPECT_THAT(problem(), StartsWith(file().string() + ": the database is damaged"));
  EXPECT_EQ(readFile(), bytes);
}

TEST_F(OpenHomeStoreTest, SaysWhenAPageIsDamaged) {
  fill();
  const std::int64_t page = Database(file().string(), std::chrono::milliseconds(0))
                                .number("SELECT rootpage FROM sqlite_schema WHERE name = 'room'");
  std::string bytes = readFile();
  constexpr std::ptrdiff_t kPageLength = 4096;
  std::fill_n(bytes.begin() + (page - 1) * kPageLength, kPageLength, '\x7f');
  writeFile(bytes);
  auto store = HomeStore::open(file());
  ASSERT_TRUE(store);
  const auto homes = (*store)->loadHomes();
  ASSERT_FALSE(homes);
  EXPECT_THAT(homes.failure().message, StartsWith(file().string() + ": the database is damaged"));
}

TEST_F(OpenHomeStoreTest, SaysWhenAValueCannotBe) {
  fill();
  Database database(file().string(), std::chrono::milliseconds(0));
  database.run("UPDATE home SET uuid = x'0102' WHERE position = 1");
  const auto homes = (*HomeStore::open(file()))->loadHomes();
  ASSERT_FALSE(homes);
  EXPECT_THAT(homes.failure().message, HasSubstr("unexpected contents of column uuid"));
}

TEST_F(OpenHomeStoreTest, SaysWhenTheSchemaIsNewer) {
  fill();
  Database database(file().string(), std::chrono::milliseconds(0));
  database.run("PRAGMA user_version = 1000");
  EXPECT_EQ(problem(), file().string() +
                           ": the database was written by a newer version of this program; use "
                           "that version, or another data folder");
}

TEST_F(OpenHomeStoreTest, SaysWhenTheDatabaseIsOfAnotherProgram) {
  Database database(file().string(), std::chrono::milliseconds(0));
  database.run("CREATE TABLE recipe (name TEXT)");
  EXPECT_EQ(problem(), file().string() +
                           ": the file is a database of another program; use another data folder");
  EXPECT_EQ(database.number("SELECT count(*) FROM sqlite_schema"), 1);
}

TEST_F(OpenHomeStoreTest, SaysWhenTheDatabaseIsLocked) {
  Database database(file().string(), std::chrono::milliseconds(0));
  database.run("BEGIN EXCLUSIVE");
  EXPECT_THAT(problem(), StartsWith(file().string() + ": the database is locked"));
  database.run("ROLLBACK");
  EXPECT_EQ(problem(), "");
}

TEST_F(OpenHomeStoreTest, SaysWhenTheFolderCannotBeMade) {
  writeFile("x");
  const auto store = HomeStore::open(file() / "folder" / "home.db");
  ASSERT_FALSE(store);
  EXPECT_THAT(store.failure().message, HasSubstr(": the folder cannot be made (Not a directory)"));
}

TEST_F(OpenHomeStoreTest, SaysWhenTheFolderMayNotBeWritten) {
  fs::permissions(folder(), fs::perms(0555));
  const Unprivileged unprivileged;
  EXPECT_EQ(problem(), folder().string() +
                           ": the folder of the database cannot be written (Permission denied); "
                           "give yourself write permission on it, or choose another one");
}

TEST_F(OpenHomeStoreTest, SaysWhenTheFileMayNotBeWritten) {
  fill();
  fs::permissions(folder(), fs::perms(0777));
  fs::permissions(file(), fs::perms(0444));
  const Unprivileged unprivileged;
  EXPECT_EQ(problem(), file().string() +
                           ": the database cannot be written (Permission denied); give yourself "
                           "write permission on the file");
}

TEST_F(OpenHomeStoreTest, SaysWhenTheFileIsAFolder) {
  fs::create_directory(file());
  EXPECT_EQ(problem(), file().string() +
                           ": a folder is where the database has to be (Is a directory); move it "
                           "away");
}

TEST_F(OpenHomeStoreTest, LetsManyMakeItAtOnce) {
  std::vector<std::thread> threads;
  std::vector<std::string> problems(8);
  for (std::string& each : problems) {
    threads.emplace_back([this, &each] {
      const auto store = HomeStore::open(file());
      if (!store) each = store.failure().message;
    });
  }
  for (std::thread& thread : threads) thread.join();
  EXPECT_THAT(problems, testing::Each(""));
}

}  // namespace
}  // namespace nidus
