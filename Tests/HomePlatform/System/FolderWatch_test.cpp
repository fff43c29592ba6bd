#include "HomePlatform/System/FolderWatch.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <fstream>

#include "PlatformModel/System/NDMainQueue.h"
#include "Support/FileShortage.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

using testing::HasSubstr;

/// Counts the changes on the queue of the test, which waits for them.
class FolderWatchTest : public testing::Test {
 protected:
  void SetUp() override {
    auto started = FolderWatch::start(folder_.path(), {{"watched", "too"}},
                                      [this] { queue_.async([this] { ++changes_; }); });
    ASSERT_TRUE(started) << started.failure().message;
    watch_ = std::move(*started);
    waitFor(1);
  }
  void waitFor(int changes) {
    queue_.runUntil([this, changes] { return changes_ >= changes; });
  }

  const TestFolder folder_;
  NDMainQueue queue_;
  int changes_ = 0;
  std::unique_ptr<FolderWatch> watch_;
};

TEST_F(FolderWatchTest, SeesWrittenFile) {
  folder_.write("watched", "1");
  waitFor(2);
}

TEST_F(FolderWatchTest, SeesReplacedFile) {
  std::filesystem::rename(folder_.write("new", "1"), folder_.path() / "watched");
  waitFor(2);
}

TEST_F(FolderWatchTest, SeesRemovedFile) {
  folder_.write("watched", "1");
  waitFor(2);
  std::filesystem::remove(folder_.path() / "watched");
  waitFor(3);
}

TEST_F(FolderWatchTest, IgnoresOtherFiles) {
  folder_.write("other", "1");
  folder_.write("watched", "1");
  waitFor(2);
  watch_.reset();
  queue_.drain();
  EXPECT_EQ(changes_, 2);
}

TEST_F(FolderWatchTest, SeesEachOfTheFiles) {
  folder_.write("too", "1");
  waitFor(2);
}

TEST_F(FolderWatchTest, SeesTheFolderGo) {
  std::filesystem::remove(folder_.path());
  waitFor(2);
}

TEST(FolderWatchEachWriteTest, SeesWritesToAnOpenFile) {
  const TestFolder folder;
  NDMainQueue queue;
  int changes = 0;
  const auto watch = FolderWatch::start(folder.path(), {{"log"}, true},
                                        [&] { queue.async([&changes] { ++changes; }); });
  ASSERT_TRUE(watch);
  queue.runUntil([&changes] { return changes == 1; });
  std::ofstream log(folder.path() / "log");
  log << "1" << std::flush;
  queue.runUntil([&changes] { return changes >= 2; });
}

TEST(FolderWatchFailureTest, NamesTheFolder) {
  const auto started = FolderWatch::start("/nonexistent/folder", {{"watched"}}, [] {});
  ASSERT_FALSE(started);
  EXPECT_THAT(started.failure().message, HasSubstr("/nonexistent/folder"));
}

TEST(FolderWatchFailureTest, NeedsFilesToBeLeft) {
  const TestFolder folder;
  for (const std::size_t spare : {0U, 1U}) {
    SCOPED_TRACE(spare);
    const auto started = [&] {
      const FileShortage shortage(spare);
      return FolderWatch::start(folder.path(), {{"watched"}}, [] {});
    }();
    ASSERT_FALSE(started);
    EXPECT_THAT(started.failure().message,
                HasSubstr(": changes cannot be watched: Too many open files; end other programs"));
  }
}

}  // namespace
}  // namespace nidus
