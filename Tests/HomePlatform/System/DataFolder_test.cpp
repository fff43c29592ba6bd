#include "HomePlatform/System/DataFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <atomic>
#include <optional>
#include <thread>

#include "Support/TestFolder.h"

namespace nidus {
namespace {

using testing::StartsWith;

unsigned permissionsOf(const std::filesystem::path& folder) {
  struct stat status = {};
  return ::stat(folder.c_str(), &status) == 0 ? status.st_mode & 0777U : 0;
}

TEST(DataFolderTest, MakesFolderWithItsParents) {
  const TestFolder folder;
  const auto made = folder.path() / "a" / "b";
  EXPECT_FALSE(prepareDataFolder(made));
  EXPECT_EQ(permissionsOf(made), 0700U);
}

TEST(DataFolderTest, LeavesExistingFolderAsItIs) {
  const TestFolder folder;
  ASSERT_EQ(::chmod(folder.path().c_str(), 0755), 0);
  EXPECT_FALSE(prepareDataFolder(folder.path()));
  EXPECT_EQ(permissionsOf(folder.path()), 0755U);
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
