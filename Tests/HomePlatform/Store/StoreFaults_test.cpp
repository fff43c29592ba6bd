#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <string>

#include "HomePlatform/HomeRestoration.h"
#include "HomePlatform/PlatformProbe.h"
#include "HomePlatform/SampleHome.h"
#include "HomePlatform/Store/BackupList.h"
#include "HomePlatform/Store/Database.h"
#include "HomePlatform/Store/HomeStore.h"
#include "HomePlatform/Store/NumberedFiles.h"
#include "HomePlatform/Store/Schema.h"
#include "HomePlatform/Store/StoreBackup.h"
#include "HomePlatform/Support/RandomHome.h"
#include "Support/FaultyDisk.h"
#include "Support/FaultyMemory.h"
#include "Support/ReportedCount.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;

std::string databaseIn(const fs::path& folder) { return (folder / "home.db").string(); }

/// What the engine finds wrong with the file; "ok" when there is nothing.
std::string integrityOf(const fs::path& folder) {
  Database database(databaseIn(folder), kNoWaiting);
  Statement check(database, "PRAGMA integrity_check");
  check.step();
  const std::string result(check.text(0));
  Statement references(database, "PRAGMA foreign_key_check");
  return references.step() ? "a reference to nothing" : result;
}

std::string homesIn(const fs::path& folder) {
  const auto store = HomeStore::open(databaseIn(folder), kNoWaiting);
  if (!store) return store.failure().message;
  const auto homes = (*store)->loadHomes();
  return homes ? documentOf(*homes) : homes.failure().message;
}

/// A change of the database that has to be made whole or not at all.
struct Change {
  const char* name;
  /// Makes the state before the change; empty for a folder without a database.
  std::function<void(const fs::path& folder)> begin;
  /// Opens the database and changes it; gives whether it was answered as done.
  std::function<bool(const fs::path& folder)> make;
  std::function<std::string(const fs::path& folder)> contents = homesIn;
  std::size_t backups = 0;  ///< How many there are after it.
  std::size_t aside = 0;    ///< How many damaged databases it moves aside.
};

void PrintTo(const Change& change, std::ostream* out) { *out << change.name; }

using StoreAction = std::function<Status(HomeStore& store)>;

std::function<bool(const fs::path&)> withStore(StoreAction action) {
  return [action = std::move(action)](const fs::path& folder) {
    const auto store = HomeStore::open(databaseIn(folder), kNoWaiting);
    return store && !action(**store);
  };
}

/// The sample home, with a scene that writes two values.
HomeData homeWithScene() {
  HomeData home = sampleHome();
  home.actionSets.at(0).actions = {{powerAddress(), NDValue::boolean(true)},
                                   {brightnessAddress(), NDValue::integer(77)}};
  return home;
}

void beginWithHome(const fs::path& folder) {
  const auto store = HomeStore::open(databaseIn(folder));
  ASSERT_TRUE(store) << store.failure().message;
  ASSERT_FALSE((*store)->replaceHomes({homeWithScene(), RandomHome(1).home()}));
}

Status importRandomHomes(HomeStore& store) {
  return store.replaceHomes({RandomHome(2).home(), RandomHome(3).home()});
}

Status mergeRandomHome(HomeStore& store) {
  HomeData changed = sampleHome();
  changed.name = "Renamed";
  return store.mergeHomes({changed, RandomHome(4).home()});
}

Status renameTheHome(HomeStore& store) {
  return store.editHomes([](std::vector<HomeData>& homes) {
    homes.at(0).name = "Renamed";
    return Status();
  });
}

Status writeTwoValues(HomeStore& store) {
  const NDUUID home = uuidOf(kHomeID);
  const NDValueRef brightness = NDValue::integer(13);
  const NDValueRef power = NDValue::boolean(true);
  return store.writeValues(
      {{home, brightnessAddress(), brightness, brightness}, {home, powerAddress(), power, power}});
}

bool runScene(const fs::path& folder) {
  HomePlatformOptions options;
  options.dataFolder = folder;
  options.drainsOnCaller = true;
  options.failureHandler = [](const Failure& /*failure*/) {};
  const auto platform = HomePlatform::open(std::move(options));
  if (!platform) return false;
  const auto manager = (*platform)->createHomeManager();
  const auto delegate = std::make_shared<DelegateProbe>();
  manager->setDelegate(delegate);
  (*platform)->drain();
  const bool isDone = !delegate->homes.empty() && execute(**platform, delegate->homes[0]) == 0;
  (*platform)->shutDown();
  return isDone;
}

/// The steps of a schema that has a later version than the database.
std::vector<std::string> stepsWithMigration() {
  std::vector<std::string> steps = schemaSteps();
  steps.emplace_back(
      "ALTER TABLE room ADD COLUMN colour TEXT NOT NULL DEFAULT 'white';"
      "CREATE TABLE note (home INTEGER NOT NULL REFERENCES home ON DELETE CASCADE, text TEXT);"
      "INSERT INTO note SELECT id, name FROM home;"
      "UPDATE accessory SET name = name || '!'");
  return steps;
}

bool migrate(const fs::path& folder) {
  try {
    const std::string file = databaseIn(folder);
    Database database(file, kNoWaiting);
    return !migrateStore(database, file, stepsWithMigration(), kNoWaiting);
  } catch (const DatabaseError&) {
    return false;
  }
}

std::string migratedContents(const fs::path& folder) {
  Database database(databaseIn(folder), kNoWaiting);
  Statement names(database, "SELECT group_concat(name) FROM accessory");
  names.step();
  const std::int64_t columns =
      database.number("SELECT count(*) FROM pragma_table_info('room') WHERE name = 'colour'");
  return std::to_string(database.number("PRAGMA user_version")) + ' ' + std::to_string(columns) +
         ' ' + std::string(names.text(0));
}

constexpr const char* kDamaged = "damaged";

/// The homes of each backup, the newest first.
std::vector<std::string> backupsIn(const fs::path& folder) {
  std::vector<std::string> states;
  for (const fs::path& backup : backupsOf(databaseIn(folder))) {
    const auto homes = homesOfBackup(backup);
    states.push_back(homes ? documentOf(*homes) : kDamaged);
  }
  return states;
}

void beginWithBackup(const fs::path& folder) {
  beginWithHome(folder);
  const auto store = HomeStore::open(databaseIn(folder));
  ASSERT_FALSE(importRandomHomes(**store));
}

const std::string& damagedBytes() {
  static const std::string bytes(8192, 'x');
  return bytes;
}

void beginWithDamage(const fs::path& folder) {
  beginWithBackup(folder);
  std::ofstream(databaseIn(folder)) << damagedBytes();
}

bool restore(const fs::path& folder) {
  return static_cast<bool>(restoreHomes(folder, backupsOf(databaseIn(folder)).front(), kNoWaiting));
}

std::string damagedOrHomesIn(const fs::path& folder) {
  return contentOfFile(databaseIn(folder)) == damagedBytes() ? kDamaged : homesIn(folder);
}

const Change kChanges[] = {
    {"creation", nullptr, withStore([](HomeStore& /*store*/) { return std::nullopt; })},
    {"firstImport", nullptr, withStore(importRandomHomes)},
    {"import", beginWithHome, withStore(importRandomHomes), homesIn, 1},
    {"merge", beginWithHome, withStore(mergeRandomHome), homesIn, 1},
    {"edit", beginWithHome, withStore(renameTheHome)},
    {"write", beginWithHome, withStore(writeTwoValues)},
    {"scene", beginWithHome, runScene},
    {"migration", beginWithHome, migrate, migratedContents, 1},
    {"restoration", beginWithBackup, restore, homesIn, 2, 0},
    {"restorationOfDamaged", beginWithDamage, restore, damagedOrHomesIn, 1, 1},
};

/// One change, made in folders of its own with one fault after the other.
class StoreFaultTest : public testing::TestWithParam<Change> {
 protected:
  StoreFaultTest() {
    const TestFolder folder;
    begin(folder);
    before_ = GetParam().contents(folder.path());
    statesBefore_ = backupsIn(folder.path());
    statesBefore_.push_back(homesIn(folder.path()));
  }

  /// What the change leads to without faults.
  void makeWithoutFaults() {
    const TestFolder folder;
    begin(folder);
    ASSERT_TRUE(GetParam().make(folder.path()));
    after_ = GetParam().contents(folder.path());
  }

  /// Makes the change with `arm` before and `disarm` after it; false once no fault was met.
  bool isMetByFault(const std::function<void()>& arm, const std::function<bool()>& disarm) {
    const TestFolder folder;
    begin(folder);
    arm();
    const bool isDone = GetParam().make(folder.path());
    const bool wasMet = disarm();
    const std::string contents = GetParam().contents(folder.path());
    EXPECT_TRUE(contents == kDamaged || integrityOf(folder.path()) == "ok");
    EXPECT_TRUE(contents == after_ || (!isDone && contents == before_)) << contents;
    EXPECT_TRUE(isDone || wasMet);
    checkBackups(folder.path(), contents == after_);
    return wasMet;
  }

 private:
  static void begin(const TestFolder& folder) {
    if (GetParam().begin) GetParam().begin(folder.path());
  }

  /// Each backup holds a whole state of before, and a change that was made has kept what it
  /// replaced. Nothing is taken for damage that is not, and nothing half done stays.
  void checkBackups(const fs::path& folder, bool isChanged) const {
    const std::vector<std::string> backups = backupsIn(folder);
    for (const std::string& backup : backups) {
      EXPECT_THAT(statesBefore_, testing::Contains(backup));
    }
    EXPECT_LE(backups.size(), GetParam().backups);
    EXPECT_TRUE(!isChanged || backups.size() == GetParam().backups) << backups.size();
    EXPECT_EQ(numberedFiles(databaseIn(folder), "damaged").size(),
              isChanged ? GetParam().aside : 0);
    for (const char* suffix : {".backup", ".examined", ".restored"}) {
      EXPECT_FALSE(fs::exists(databaseIn(folder) + suffix)) << suffix;
    }
  }

  std::string before_;
  std::vector<std::string> statesBefore_;  ///< Of the database and of its backups.
  std::string after_;
};

/// Tries fault number `first`, then each `stride`th after it, until one is not met; gives how many
/// were. More than there are calls in any change is an endless loop.
std::int64_t countFaults(std::int64_t stride, const std::function<bool(std::int64_t)>& isMet) {
  constexpr std::int64_t kMostFaults = 100'000;
  std::int64_t faults = 0;
  std::int64_t number = 1;
  while (number < kMostFaults && !testing::Test::HasFailure() && isMet(number)) {
    number += stride;
    ++faults;
  }
  EXPECT_GT(faults, 0);
  EXPECT_LT(number, kMostFaults);
  return faults;
}

/// The long form tries each fault, the short one some of them.
std::int64_t strideOf(std::int64_t shortStride) {
  return std::getenv("NIDUS_EVERY_FAULT") ? 1 : shortStride;
}

/// Lets the calls to the disk fail in turn, once and for ever, while `isMet` does its work between
/// the two functions it is given.
using Attempt =
    std::function<bool(const std::function<void()>& arm, const std::function<bool()>& disarm)>;

void failDisk(FaultyDisk::Kind kind, const Attempt& isMet) {
  constexpr std::int64_t kShortStride = 5;
  FaultyDisk disk;
  std::int64_t faults = 0;
  for (const bool lasts : {false, true}) {
    faults += countFaults(strideOf(kShortStride), [&](std::int64_t number) {
      return isMet([&] { disk.arm({kind, number, lasts}); }, [&] { return disk.disarm(); });
    });
  }
  reportCount("faults", faults);
}

/// The same for memory.
void failMemory(const Attempt& isMet) {
  constexpr std::int64_t kShortStride = 97;
  FaultyMemory memory;
  const FaultyDisk fasterDisk;
  std::int64_t faults = 0;
  for (const bool lasts : {false, true}) {
    faults += countFaults(strideOf(kShortStride), [&](std::int64_t number) {
      return isMet([&] { memory.arm({number, lasts}); }, [&] { return memory.disarm(); });
    });
  }
  reportCount("faults", faults);
}

TEST_P(StoreFaultTest, SurvivesEachFailingCall) {
  makeWithoutFaults();
  failDisk(FaultyDisk::Kind::error,
           [this](const auto& arm, const auto& disarm) { return isMetByFault(arm, disarm); });
}

TEST_P(StoreFaultTest, SurvivesEachShortStep) {
  makeWithoutFaults();
  failDisk(FaultyDisk::Kind::shortStep,
           [this](const auto& arm, const auto& disarm) { return isMetByFault(arm, disarm); });
}

TEST_P(StoreFaultTest, SurvivesAFullDisk) {
  makeWithoutFaults();
  failDisk(FaultyDisk::Kind::full,
           [this](const auto& arm, const auto& disarm) { return isMetByFault(arm, disarm); });
}

TEST_P(StoreFaultTest, SurvivesFailingAllocations) {
  makeWithoutFaults();
  failMemory([this](const auto& arm, const auto& disarm) { return isMetByFault(arm, disarm); });
}

INSTANTIATE_TEST_SUITE_P(Changes, StoreFaultTest, testing::ValuesIn(kChanges),
                         [](const auto& instance) { return std::string(instance.param.name); });

/// Reads a database with faults and expects what it holds or a failure.
class StoreReadFaultTest : public testing::Test {
 protected:
  StoreReadFaultTest() { beginWithHome(folder_.path()); }

  bool isMetByFault(const std::function<void()>& arm, const std::function<bool()>& disarm) {
    arm();
    const auto store = HomeStore::open(databaseIn(folder_.path()), kNoWaiting);
    const auto homes = store ? (*store)->loadHomes() : store.failure();
    const bool wasMet = disarm();
    EXPECT_EQ(homes ? documentOf(*homes) : expected_, expected_);
    return wasMet;
  }

 private:
  const TestFolder folder_;
  const std::string expected_ = documentOf({homeWithScene(), RandomHome(1).home()});
};

TEST_F(StoreReadFaultTest, FailsOrIsRightOnADisk) {
  failDisk(FaultyDisk::Kind::error,
           [this](const auto& arm, const auto& disarm) { return isMetByFault(arm, disarm); });
}

TEST_F(StoreReadFaultTest, FailsOrIsRightWithoutMemory) {
  failMemory([this](const auto& arm, const auto& disarm) { return isMetByFault(arm, disarm); });
}

/// A store that has met a fault and lives on.
TEST(StoreAfterFaultTest, WritesAgain) {
  const TestFolder folder;
  beginWithHome(folder.path());
  FaultyDisk disk;
  const auto store = HomeStore::open(databaseIn(folder.path()), kNoWaiting);
  for (std::int64_t number = 1;; ++number) {
    disk.arm({FaultyDisk::Kind::error, number, false});
    static_cast<void>(importRandomHomes(**store));
    if (!disk.disarm()) break;
    const Status failure = (*store)->replaceHomes({homeWithScene()});
    ASSERT_FALSE(failure) << failure->message;
    ASSERT_EQ(homesIn(folder.path()), documentOf({homeWithScene()}));
  }
}

}  // namespace
}  // namespace nidus
