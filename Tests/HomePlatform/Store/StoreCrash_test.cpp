#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <csignal>
#include <cstdint>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <random>
#include <string>

#include "HomePlatform/HomeRestoration.h"
#include "HomePlatform/SampleHome.h"
#include "HomePlatform/Store/BackupList.h"
#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeStore.h"
#include "Support/ReportedCount.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;

/// The long form kills many more times.
int countOfKills() { return std::getenv("NIDUS_EVERY_FAULT") ? 2000 : 60; }
int countOfRestoringKills() { return std::getenv("NIDUS_EVERY_FAULT") ? 500 : 15; }

HomeData homeAt(std::int64_t number) {
  HomeData home = sampleHome();
  home.name = std::to_string(number);
  brightnessOf(home).metadata.reset();
  brightnessOf(home).value = NDValue::integer(number);
  brightnessOf(home).deviceValue = NDValue::integer(number);
  return home;
}

/// Changes the database for ever, from `number` on: a value by each change, the whole home by each
/// fourth. Tells each number that was answered as written.
[[noreturn]] void writeForEver(const std::string& file, std::int64_t number, int answers) {
  const auto store = HomeStore::open(file);
  while (store) {
    ++number;
    const NDValueRef value = NDValue::integer(number);
    const Status failure =
        number % 4 == 0
            ? (*store)->replaceHomes({homeAt(number)})
            : (*store)->writeValues({{uuidOf(kHomeID), brightnessAddress(), value, value}});
    if (failure || ::write(answers, &number, sizeof number) != sizeof number) break;
  }
  std::_Exit(1);
}

bool isImportRefused(const std::string& file, std::int64_t number) {
  const auto store = HomeStore::open(file);
  return !store || (*store)->replaceHomes({homeAt(number)});
}

/// Imports homes and restores the backups of them for ever, from `number` on, every second time
/// after a damage. Tells each number that was answered as restored.
[[noreturn]] void restoreForEver(const std::string& file, std::int64_t number, int answers) {
  while (!isImportRefused(file, ++number)) {
    if (number % 2 == 0) std::fstream(file) << std::string(8192, 'x');
    const auto backup = newestGoodBackupOf(file);
    if (!backup || !restoreHomes(fs::path(file).parent_path(), *backup)) break;
    if (::write(answers, &number, sizeof number) != sizeof number) break;
  }
  std::_Exit(1);
}

using ForEver = void (*)(const std::string& file, std::int64_t number, int answers);

/// A process that works until it is killed.
class Writer {
 public:
  Writer(ForEver work, const std::string& file, std::int64_t number) {
    std::array<int, 2> ends{};
    EXPECT_EQ(::pipe(ends.data()), 0);
    process_ = ::fork();
    if (process_ == 0) work(file, number, ends[1]);
    ::close(ends[1]);
    answers_ = ends[0];
  }
  ~Writer() { ::close(answers_); }
  Writer(const Writer&) = delete;
  Writer& operator=(const Writer&) = delete;

  /// Waits for an answer; false when the writer has ended.
  bool takeAnswer() { return ::read(answers_, &written_, sizeof written_) == sizeof written_; }
  /// Kills the writer, takes the answers that it still gave, and gives the last of all, or
  /// `otherwise` when there was none.
  std::int64_t kill(std::int64_t otherwise) {
    ::kill(process_, SIGKILL);
    while (takeAnswer()) {
    }
    int status = 0;
    ::waitpid(process_, &status, 0);
    EXPECT_TRUE(WIFSIGNALED(status)) << "the writer failed";
    return written_ == 0 ? otherwise : written_;
  }

 private:
  pid_t process_ = -1;
  int answers_ = -1;
  std::int64_t written_ = 0;
};

/// Takes a moment that differs from kill to kill.
void spin(std::uint64_t turns) {
  volatile std::uint64_t turn = 0;
  while (turn < turns) turn = turn + 1;
}

std::string integrityOf(const std::string& file) {
  Database database(file, std::chrono::milliseconds(0));
  Statement check(database, "PRAGMA integrity_check");
  check.step();
  return std::string(check.text(0));
}

TEST(StoreCrashTest, KeepsAllThatWasAnswered) {
  const TestFolder folder;
  const std::string file = folder.file("home.db");
  std::mt19937 random(7);  // NOLINT(cert-msc32-c,cert-msc51-cpp): the same moments each time
  ASSERT_FALSE((*HomeStore::open(file))->replaceHomes({homeAt(0)}));
  std::int64_t number = 0;
  for (int kill = 0; kill < countOfKills(); ++kill) {
    Writer writer(writeForEver, file, number);
    for (std::uint64_t answers = random() % 6; answers > 0 && writer.takeAnswer(); --answers) {
    }
    spin(random() % 300'000);
    const std::int64_t written = writer.kill(number);
    ASSERT_EQ(integrityOf(file), "ok");
    HomeData home = (*HomeStore::open(file))->loadHomes()->at(0);
    number = brightnessOf(home).value->integerValue();
    // The change that was under way may have been made, none that was answered may be missing, and
    // a home stands with the number of its import and the value of that or a later change.
    ASSERT_TRUE(number == written || number == written + 1) << number << " after " << written;
    ASSERT_EQ(brightnessOf(home).deviceValue->integerValue(), number);
    ASSERT_EQ(home.name.str(), std::to_string(number / 4 * 4));
  }
  EXPECT_GT(number, countOfKills());
  reportCount("kills", countOfKills());
  reportCount("changes", number);
}

/// The home of a store that was opened, which must be a whole one.
void expectWholeHome(const std::vector<HomeData>& homes) {
  ASSERT_EQ(homes.size(), 1U);
  HomeData home = homes.front();
  EXPECT_EQ(home.name.str(), std::to_string(brightnessOf(home).value->integerValue()));
}

TEST(StoreCrashTest, RestoresWholeHomesAtLast) {
  const TestFolder folder;
  const std::string file = folder.file("home.db");
  std::mt19937 random(8);  // NOLINT(cert-msc32-c,cert-msc51-cpp): the same moments each time
  ASSERT_FALSE((*HomeStore::open(file))->replaceHomes({homeAt(0)}));
  std::int64_t number = 0;
  std::int64_t damaged = 0;
  for (int kill = 0; kill < countOfRestoringKills(); ++kill) {
    Writer writer(restoreForEver, file, number);
    for (std::uint64_t answers = random() % 3; answers > 0 && writer.takeAnswer(); --answers) {
    }
    spin(random() % 3'000'000);
    number = writer.kill(number);
    if (!HomeStore::open(file)) {
      ++damaged;
      const auto done = restoreHomes(folder.path(), newestGoodBackupOf(file).value());
      ASSERT_TRUE(done) << done.failure().message;
    }
    ASSERT_EQ(integrityOf(file), "ok");
    expectWholeHome(*(*HomeStore::open(file))->loadHomes());
    for (const auto& backup : backupsOf(file)) expectWholeHome(homesOfBackup(backup).value());
    if (testing::Test::HasFailure()) break;
  }
  reportCount("kills", countOfRestoringKills());
  reportCount("restorations", number);
  reportCount("found damaged", damaged);
}

}  // namespace
}  // namespace nidus
