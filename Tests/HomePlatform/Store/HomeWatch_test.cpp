#include "HomePlatform/Store/HomeWatch.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

#include "HomePlatform/Store/Database.h"
#include "PlatformModel/System/NDMainQueue.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

HomeData homeOf(const char* name) {
  HomeData home;
  home.uuid = NDUUID::random();
  home.name = name;
  return home;
}

/// Notes what the watch tells on the queue of the test, which waits for it.
class HomeWatchTest : public testing::Test {
 protected:
  void SetUp() override {
    auto opened = HomeStore::open(file());
    ASSERT_TRUE(opened);
    store_ = std::move(*opened);
  }
  void start() {
    auto started = HomeWatch::start(file(), [this](Result<std::vector<HomeData>> homes) {
      queue_.async([this, homes = std::move(homes)] { told_.push_back(textOf(homes)); });
    });
    ASSERT_TRUE(started) << started.failure().message;
    watch_ = std::move(*started);
  }
  static std::string textOf(const Result<std::vector<HomeData>>& homes) {
    if (!homes) return homes.failure().message;
    std::string text;
    for (const HomeData& home : *homes) text += home.name.str() + ' ';
    return text;
  }
  void replaceHomes(const char* name) const {
    ASSERT_EQ(store_->replaceHomes({homeOf(name)}), std::nullopt);
  }
  /// Waits until the watch tells `text`, after others or at once.
  void waitFor(const std::string& text) {
    queue_.runUntil([this, &text] { return !told_.empty() && told_.back() == text; });
  }
  [[nodiscard]] std::filesystem::path file() const { return folder_.path() / "home.db"; }

  const TestFolder folder_;
  std::unique_ptr<HomeStore> store_;
  NDMainQueue queue_;
  std::vector<std::string> told_;
  std::unique_ptr<HomeWatch> watch_;
};

TEST_F(HomeWatchTest, TellsTheHomesAtTheStart) {
  replaceHomes("Cottage");
  start();
  waitFor("Cottage ");
  EXPECT_THAT(told_, ElementsAre("Cottage "));
}

TEST_F(HomeWatchTest, TellsEachChangeOfAnotherConnection) {
  start();
  waitFor("");
  for (const char* name : {"Cottage", "Flat", "Cabin"}) {
    replaceHomes(name);
    waitFor(std::string(name) + ' ');
  }
}

TEST_F(HomeWatchTest, MissesNoLastChange) {
  start();
  for (int i = 0; i < 50; ++i) replaceHomes(std::to_string(i).c_str());
  waitFor("49 ");
}

TEST_F(HomeWatchTest, SeesChangesOnceTheyAreCommitted) {
  start();
  waitFor("");
  Database other(file().string(), HomeStore::kLockTimeout);
  other.run("PRAGMA cache_size = 1; BEGIN IMMEDIATE");
  for (int i = 0; i < 200; ++i) {
    other.run(
        "INSERT INTO home (position, uuid, name, is_primary, read_fault, write_fault) "
        "VALUES (" +
        std::to_string(i) + ", randomblob(16), 'x', 0, 0, 0)");
  }
  other.run("DELETE FROM home WHERE position > 1; COMMIT");
  waitFor("x x ");
  EXPECT_THAT(told_, ElementsAre("", "x x "));
}

TEST_F(HomeWatchTest, IsSilentWhereNothingChanges) {
  start();
  waitFor("");
  Database other(file().string(), HomeStore::kLockTimeout);
  other.run("BEGIN IMMEDIATE; DELETE FROM home; ROLLBACK");
  static_cast<void>(other.number("PRAGMA wal_checkpoint"));
  replaceHomes("Cottage");
  waitFor("Cottage ");
  EXPECT_THAT(told_, ElementsAre("", "Cottage "));
}

TEST_F(HomeWatchTest, FollowsAFileThatTakesThePlace) {
  start();
  waitFor("");
  const TestFolder elsewhere;
  {
    const auto other = HomeStore::open(elsewhere.path() / "home.db");
    ASSERT_TRUE(other);
    ASSERT_EQ((*other)->replaceHomes({homeOf("Restored")}), std::nullopt);
  }
  std::filesystem::rename(elsewhere.path() / "home.db", file());
  waitFor("Restored ");
}

TEST_F(HomeWatchTest, EndsWhenTheDatabaseIsGone) {
  start();
  waitFor("");
  std::filesystem::remove(file());
  waitFor(file().string() + ": the database is gone; restore it, or import the homes again");
  told_.clear();
  folder_.write("home.db", "");
  watch_.reset();
  queue_.drain();
  EXPECT_THAT(told_, IsEmpty());
}

TEST_F(HomeWatchTest, EndsWhenTheDatabaseCannotBeRead) {
  start();
  waitFor("");
  Database(file().string(), HomeStore::kLockTimeout).run("DROP TABLE event_trigger");
  queue_.runUntil([this] { return told_.size() == 2; });
  EXPECT_THAT(told_.back(), HasSubstr("no such table: event_trigger"));
}

TEST(HomeWatchFailureTest, NeedsAFolder) {
  const auto watch = HomeWatch::start("/nonexistent/home.db", [](const auto&) {});
  ASSERT_FALSE(watch);
  EXPECT_THAT(watch.failure().message, HasSubstr("/nonexistent"));
}

}  // namespace
}  // namespace nidus
