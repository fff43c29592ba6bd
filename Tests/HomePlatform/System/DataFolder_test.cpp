#include "HomePlatform/System/DataFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <array>
#include <atomic>
#include <optional>
#include <thread>

#include "Support/FileModes.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

using testing::StartsWith;

TEST(DataFolderTest, MakesFolderWithItsParents) {
  const TestFolder folder;
  const auto made = folder.path() / "a" / "b";
  EXPECT_FALSE(prepareDataFolder(made));
  EXPECT_EQ(permissionsOf(made), 0700U);
}

TEST(DataFolderTest, ClosesAnEmptyFolderToOthers) {
  const TestFolder folder;
  ASSERT_EQ(::chmod(folder.path().c_str(), 0755), 0);
  EXPECT_FALSE(prepareDataFolder(folder.path()));
  EXPECT_EQ(permissionsOf(folder.path()), 0700U);
}

TEST(DataFolderTest, LeavesAFolderWithSomethingInItAsItIs) {
  const TestFolder folder;
  folder.write("page.html", "");
  ASSERT_EQ(::chmod(folder.path().c_str(), 0755), 0);
  EXPECT_FALSE(prepareDataFolder(folder.path()));
  EXPECT_EQ(permissionsOf(folder.path()), 0755U);
}

constexpr std::array kFiles = {"home.db", "home.db-wal", "home.db-shm", "preferences.json",
                               "vocabulary.json"};

TEST(DataFolderTest, ClosesItsFilesToOthers) {
  const TestFolder folder;
  for (const char* name : kFiles) ::chmod(folder.write(name, "").c_str(), 0644);
  EXPECT_FALSE(prepareDataFolder(folder.path()));
  for (const char* name : kFiles) EXPECT_EQ(permissionsOf(folder.path() / name), 0600U) << name;
}

TEST(DataFolderTest, RefusesFilesThatOthersMayChange) {
  for (const char* name : kFiles) {
    const TestFolder folder;
    ::chmod(folder.write(name, "").c_str(), 0660);
    const Status failure = prepareDataFolder(folder.path());
    ASSERT_TRUE(failure) << name;
    EXPECT_THAT(failure->message, StartsWith(folder.file(name) + ": others may change it"));
  }
}

TEST(DataFolderTest, RefusesAFolderThatOthersMayChange) {
  const TestFolder folder;
  const auto data = folder.path() / "data";
  EXPECT_FALSE(prepareDataFolder(data));
  for (const auto& place : {data, folder.path()}) {
    ASSERT_EQ(::chmod(place.c_str(), 0770), 0);
    const Status failure = prepareDataFolder(data);
    ASSERT_TRUE(failure);
    EXPECT_THAT(failure->message, StartsWith(place.string() + ": others may change it"));
    EXPECT_EQ(permissionsOf(place), 0770U);
    ASSERT_EQ(::chmod(place.c_str(), 0700), 0);
  }
}

TEST(DataFolderTest, RefusesWhatIsNoFolder) {
  const TestFolder folder;
  const std::string file = folder.write("file", "");
  for (const std::string& path : {file, file + "/below"}) {
    const Status failure = prepareDataFolder(path);
    ASSERT_TRUE(failure);
    EXPECT_THAT(failure->message, StartsWith(path + ": the data folder cannot be "));
  }
}

TEST(DataFolderTest, IsTriedWithoutATrace) {
  const TestFolder folder;
  EXPECT_FALSE(tryDataFolder(folder.path() / "a" / "b"));
  EXPECT_TRUE(std::filesystem::is_empty(folder.path()));
}

TEST(DataFolderTest, IsTriedWhereItCannotBeMade) {
  const TestFolder folder;
  const std::string below = folder.write("file", "") + "/below";
  for (const std::string& path : {below, std::string("/proc/nidus")}) {
    const Status failure = tryDataFolder(path);
    ASSERT_TRUE(failure);
    EXPECT_THAT(failure->message, StartsWith(path + ": the data folder cannot be made: "));
  }
}

TEST(FolderLockTest, KeepsOthersOut) {
  const TestFolder folder;
  auto lock = FolderLock::take(folder.path());
  ASSERT_TRUE(lock);
  std::atomic<bool> isReleased{false};
  std::thread other([&] {
    const auto second = FolderLock::take(folder.path());
    EXPECT_TRUE(second && isReleased.load());
  });
  isReleased = true;
  lock = Failure{};
  other.join();
}

}  // namespace
}  // namespace nidus
