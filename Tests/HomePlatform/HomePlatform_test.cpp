#include "HomePlatform/HomePlatform.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <atomic>
#include <fstream>
#include <thread>

#include "HomePlatform/PlatformProbe.h"
#include "HomePlatform/Store/Database.h"
#include "PlatformModel/System/NDDeliveryHold.h"
#include "PlatformModel/System/NDWaitGroup.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

HomePlatformOptions onCaller() { return {.drainsOnCaller = true}; }

HomePlatformOptions inFolder(const TestFolder& folder, bool drainsOnCaller = true) {
  return {.dataFolder = folder.path() / "data", .drainsOnCaller = drainsOnCaller};
}

std::string refusalOf(HomePlatformOptions options) {
  const auto platform = HomePlatform::open(std::move(options));
  return platform ? "opened" : platform.failure().message;
}

TEST(HomePlatformTest, MakesOwnersFolder) {
  const TestFolder folder;
  const OpenPlatform platform(inFolder(folder));
  struct stat status = {};
  ASSERT_EQ(::stat((folder.path() / "data").c_str(), &status), 0);
  EXPECT_EQ(status.st_mode & 0777U, 0700U);
}

TEST(HomePlatformTest, RefusesFileAsFolder) {
  const TestFolder folder;
  folder.write("data", "");
  EXPECT_THAT(refusalOf(inFolder(folder)), StartsWith((folder.path() / "data").string() + ": "));
}

TEST(HomePlatformTest, RefusesDamagedFilesWithTheirNames) {
  for (const char* name : {"preferences.json", "vocabulary.json", "home.db"}) {
    SCOPED_TRACE(name);
    const TestFolder folder;
    std::filesystem::create_directory(folder.path() / "data");
    folder.write(std::string("data/") + name, "{ nonsense, and more of it than a header has bytes");
    EXPECT_THAT(refusalOf(inFolder(folder)), HasSubstr(name));
  }
}

TEST(HomePlatformTest, RegistersNothingByItself) {
  const OpenPlatform platform(onCaller());
  EXPECT_FALSE(NDPlatform::registered());
}

TEST(HomePlatformTest, ReportsHomesInOrder) {
  const OpenPlatform platform(onCaller());
  HomeData second = sampleHome();
  second.uuid = uuidOf(kRoomID);
  ASSERT_FALSE(platform->importHomes({sampleHome(), second}, false));
  const auto homes = platform.homes();
  ASSERT_EQ(homes.size(), 2U);
  EXPECT_EQ(homes[0]->uuid(), uuidOf(kHomeID));
  EXPECT_EQ(homes[1]->uuid(), uuidOf(kRoomID));
}

TEST(HomePlatformTest, ManagersShareUnchangedHomes) {
  const OpenPlatform platform(onCaller());
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  const auto first = platform.homes();
  EXPECT_EQ(platform.homes()[0], first[0]);
  static_cast<void>(write(*platform, first[0], {{powerAddress(), NDValue::boolean(true)}}));
  EXPECT_EQ(platform.homes()[0], first[0]);
}

TEST(HomePlatformTest, ChangedHomesComeAsNewList) {
  const OpenPlatform platform(onCaller());
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  const auto before = platform.homes();
  ASSERT_FALSE(platform->importHomes({sampleHome()}, true));
  EXPECT_NE(platform.homes()[0], before[0]);
  EXPECT_EQ(before[0]->accessories().size(), 2U);
}

TEST(HomePlatformTest, EmptyManagerHasNoHomesBeforeReport) {
  const OpenPlatform platform(onCaller());
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  const auto manager = platform->createHomeManager();
  EXPECT_TRUE(manager->homes().empty());
  platform->drain();
  EXPECT_EQ(manager->homes().size(), 1U);
}

TEST(HomePlatformTest, HoldKeepsHomesBack) {
  const OpenPlatform platform(onCaller());
  const auto delegate = std::make_shared<DelegateProbe>();
  std::shared_ptr<NDHomeManager> manager;
  {
    const NDDeliveryHold hold;
    manager = platform->createHomeManager();
    manager->setDelegate(delegate);
    EXPECT_EQ(delegate->updates, 0);
  }
  platform->drain();
  EXPECT_EQ(delegate->updates, 1);
}

TEST(HomePlatformTest, DrainLetsHeldHomesGo) {
  const OpenPlatform platform({});
  const NDDeliveryHold hold;
  const auto delegate = std::make_shared<DelegateProbe>();
  const auto manager = platform->createHomeManager();
  manager->setDelegate(delegate);
  platform->drain();
  EXPECT_EQ(delegate->updates, 1);
}

TEST(HomePlatformTest, WaitRunsDeliveriesOnCaller) {
  const OpenPlatform platform(onCaller());
  NDWaitGroup group(platform->clock());
  group.enter();
  platform->sharedQueue()->async([&group] { group.leave(); });
  EXPECT_TRUE(group.wait(std::chrono::seconds(2)));
}

TEST(HomePlatformTest, HopelessWaitEndsAtOnceOnCaller) {
  const OpenPlatform platform(onCaller());
  const auto start = platform->clock()->now();
  NDWaitGroup group(platform->clock());
  group.enter();
  EXPECT_FALSE(group.wait(std::chrono::seconds(2)));
  EXPECT_EQ(platform->clock()->now() - start, std::chrono::seconds(2));
}

TEST(HomePlatformTest, WaitLeavesMainQueueAlone) {
  const OpenPlatform platform(onCaller());
  bool hasRun = false;
  platform->mainQueue()->async([&hasRun] { hasRun = true; });
  NDWaitGroup group(platform->clock());
  group.enter();
  EXPECT_FALSE(group.wait(std::chrono::seconds(2)));
  EXPECT_FALSE(hasRun);
}

TEST(HomePlatformTest, SilentManagerNeverReports) {
  const OpenPlatform platform(onCaller());
  platform->setSilent(true);
  const auto delegate = std::make_shared<DelegateProbe>();
  const auto manager = platform->createHomeManager();
  manager->setDelegate(delegate);
  platform->setSilent(false);
  platform->drain();
  EXPECT_EQ(delegate->updates, 0);
  EXPECT_EQ(platform.homes().size(), 0U);
  platform->shutDown();
  EXPECT_EQ(delegate->refusals, 1);
}

TEST(HomePlatformTest, ShutDownTellsThoseStillWaiting) {
  const OpenPlatform platform(onCaller());
  const auto waiting = std::make_shared<DelegateProbe>();
  const auto served = std::make_shared<DelegateProbe>();
  const auto servedManager = platform->createHomeManager();
  servedManager->setDelegate(served);
  platform->drain();
  const auto waitingManager = platform->createHomeManager();
  waitingManager->setDelegate(waiting);
  platform->shutDown();
  platform->shutDown();
  EXPECT_EQ(waiting->refusals, 1);
  EXPECT_EQ(served->refusals, 0);
  EXPECT_EQ(served->updates, 1);
}

TEST(HomePlatformTest, ManagerAfterShutDownIsTold) {
  const OpenPlatform platform(onCaller());
  platform->shutDown();
  const auto delegate = std::make_shared<DelegateProbe>();
  std::shared_ptr<NDHomeManager> manager;
  {
    const NDDeliveryHold hold;
    manager = platform->createHomeManager();
    manager->setDelegate(delegate);
    EXPECT_EQ(delegate->refusals, 0);
  }
  EXPECT_EQ(delegate->refusals, 1);
}

TEST(HomePlatformTest, ShutDownFreesPendingBatches) {
  const OpenPlatform platform({});
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  const auto home = platform.homes()[0];
  const auto kept = std::make_shared<int>(0);
  for (int batch = 0; batch < 100; ++batch) {
    home->readCharacteristicValues_withCompletionHandler({characteristicAt(home, powerAddress())},
                                                         [kept](const auto&, const auto&) {});
  }
  platform->shutDown();
  EXPECT_EQ(kept.use_count(), 1);
}

TEST(HomePlatformTest, NothingOutlivesThePlatform) {
  std::weak_ptr<NDHome> home;
  std::weak_ptr<NDHomeManager> manager;
  {
    const OpenPlatform platform({});
    ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
    home = platform.homes()[0];
    manager = platform->createHomeManager();
  }
  EXPECT_TRUE(home.expired());
  EXPECT_TRUE(manager.expired());
}

TEST(HomePlatformTest, ReportsNoHomesWhenDatabaseFails) {
  const TestFolder folder;
  std::vector<std::string> failures;
  auto options = inFolder(folder);
  options.failureHandler = [&failures](const auto& failure) {
    failures.push_back(failure.message);
  };
  const OpenPlatform platform(options);
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  {
    // Written over in place, its log included, so that the open database meets it.
    for (const char* name : {"data/home.db", "data/home.db-wal"}) {
      std::fstream file(folder.path() / name);
      file << std::string(1U << 16U, 'x');
    }
  }
  EXPECT_TRUE(platform.homes().empty());
  ASSERT_EQ(failures.size(), 1U);
  EXPECT_THAT(failures[0], HasSubstr("home.db"));
}

TEST(HomePlatformTest, ChangeEndsWithTheLockTimeout) {
  const TestFolder folder;
  auto options = inFolder(folder);
  options.lockTimeout = std::chrono::milliseconds(1);
  const OpenPlatform platform(options);
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  Database other(folder.file("data/home.db"), std::chrono::milliseconds(0));
  other.run("BEGIN IMMEDIATE");
  const Status failure = platform->importHomes({}, false);
  ASSERT_TRUE(failure);
  EXPECT_THAT(failure->message, HasSubstr("home.db: the database is locked"));
  other.run("ROLLBACK");
  EXPECT_EQ(platform->exportHomes()->size(), 1U);
}

bool isConfigured(HomePlatform& platform) {
  return platform.preferences()
      ->booleanForKey_domain_container("kHomesConfigured", "com.corvane.nidusd",
                                       platform.homeConfigurationPath())
      .value;
}

TEST(HomePlatformTest, ImportSaysWhetherHomesAreConfigured) {
  const TestFolder folder;
  for (const auto& options : {onCaller(), inFolder(folder)}) {
    const OpenPlatform platform(options);
    EXPECT_FALSE(isConfigured(*platform));
    ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
    EXPECT_TRUE(isConfigured(*platform));
    ASSERT_FALSE(platform->importHomes({}, true));
    EXPECT_TRUE(isConfigured(*platform));
    ASSERT_FALSE(platform->importHomes({}, false));
    EXPECT_FALSE(isConfigured(*platform));
  }
}

TEST(HomePlatformTest, EditSaysWhetherHomesAreConfigured) {
  const TestFolder folder;
  for (const auto& options : {onCaller(), inFolder(folder)}) {
    const OpenPlatform platform(options);
    ASSERT_FALSE(platform->editHomes([](std::vector<HomeData>& homes) {
      homes.push_back(sampleHome());
      return Status();
    }));
    EXPECT_TRUE(isConfigured(*platform));
    ASSERT_FALSE(platform->editHomes([](std::vector<HomeData>& homes) {
      homes.clear();
      return Status();
    }));
    EXPECT_FALSE(isConfigured(*platform));
  }
}

TEST(HomePlatformTest, EditedHomesComeAsNewList) {
  const OpenPlatform platform(onCaller());
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  const auto before = platform.homes();
  ASSERT_FALSE(platform->editHomes([](std::vector<HomeData>& homes) {
    homes.at(0).name = "Loft";
    return Status();
  }));
  EXPECT_EQ(platform.homes()[0]->name(), "Loft");
  EXPECT_NE(before[0]->name(), "Loft");
}

TEST(HomePlatformTest, FailedEditChangesNothing) {
  const OpenPlatform platform(onCaller());
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  const Status failure = platform->editHomes([](std::vector<HomeData>& homes) {
    homes.clear();
    return Status({Failure::Kind::badInput, "no"});
  });
  ASSERT_TRUE(failure);
  EXPECT_EQ(platform->exportHomes()->size(), 1U);
  EXPECT_TRUE(isConfigured(*platform));
}

TEST(HomePlatformTest, MemoryHoldsGivenHomesAndWords) {
  HomePlatformOptions options = onCaller();
  options.homes = {sampleHome()};
  options.vocabulary = Vocabulary{{{"SAUNA", "my.sauna"}}, {}, {}};
  options.preferences = {{"kHomesConfigured", JsonValue{false}}};
  const OpenPlatform platform(options);
  EXPECT_EQ(platform.homes().size(), 1U);
  EXPECT_EQ(platform->metadata()->mapToAssistantServiceName("my.sauna"), "SAUNA");
  EXPECT_FALSE(platform->metadata()->mapFromAssistantServiceName("LIGHT"));
  EXPECT_FALSE(isConfigured(*platform));
}

TEST(HomePlatformTest, HomesInMemoryCannotBeWatched) {
  const OpenPlatform platform(onCaller());
  const auto watch = platform->watchHomes([](const auto&) { FAIL() << "nothing is watched"; });
  ASSERT_FALSE(watch);
  EXPECT_EQ(watch.failure().kind, Failure::Kind::badInput);
  EXPECT_THAT(watch.failure().message, HasSubstr("open those of a data folder"));
}

TEST(HomePlatformTest, FolderIgnoresHomesForMemory) {
  const TestFolder folder;
  HomePlatformOptions options = inFolder(folder);
  options.homes = {sampleHome()};
  options.vocabulary = Vocabulary();
  const OpenPlatform platform(options);
  EXPECT_TRUE(platform->exportHomes()->empty());
  EXPECT_FALSE(platform->vocabulary().isEmpty());
}

TEST(HomePlatformTest, TellsAllPreferences) {
  const TestFolder folder;
  const OpenPlatform platform(inFolder(folder));
  ASSERT_FALSE(platform->changePreferences({{"NidusLogLevel", JsonValue{std::int64_t{7}}}}));
  EXPECT_EQ(platform->preferenceValues().at("NidusLogLevel"), JsonValue{std::int64_t{7}});
}

TEST(HomePlatformTest, DamagedPreferencesKeepHomesAsTheyAre) {
  const TestFolder folder;
  const OpenPlatform platform(inFolder(folder));
  folder.write("data/preferences.json", "[]");
  const Status failure = platform->importHomes({sampleHome()}, false);
  ASSERT_TRUE(failure);
  EXPECT_THAT(failure->message, HasSubstr("preferences.json"));
  EXPECT_TRUE(platform->exportHomes()->empty());
}

TEST(HomePlatformTest, PlatformsOnOneFolderSeeEachOther) {
  const TestFolder folder;
  const OpenPlatform one(inFolder(folder));
  const OpenPlatform other(inFolder(folder));
  ASSERT_FALSE(one->importHomes({sampleHome()}, false));
  EXPECT_TRUE(isConfigured(*other));
  const auto othersHome = other.homes()[0];
  const auto ownHome = one.homes()[0];
  static_cast<void>(write(*one, ownHome, {{brightnessAddress(), NDValue::integer(77)}}));
  EXPECT_THAT(read(*other, othersHome, {brightnessAddress()}).codes, ElementsAre(0));
  EXPECT_EQ(description(characteristicAt(othersHome, brightnessAddress())->value()), "77");
  static_cast<void>(write(*other, othersHome, {{brightnessAddress(), NDValue::integer(5)}}));
  EXPECT_EQ(description(characteristicAt(one.homes()[0], brightnessAddress())->value()), "5");
}

TEST(HomePlatformTest, AnswersInternalBuildOfMemory) {
  const OpenPlatform platform({.drainsOnCaller = true, .internalBuild = true});
  EXPECT_TRUE(platform->deviceInformation()->answerForQuery("InternalBuild")->boolValue());
  EXPECT_FALSE(platform->deviceInformation()->answerForQuery("Other"));
}

TEST(HomePlatformTest, AnswersInternalBuildAsItStands) {
  const TestFolder folder;
  const OpenPlatform platform(inFolder(folder));
  EXPECT_FALSE(platform->deviceInformation()->answerForQuery("InternalBuild"));
  ASSERT_FALSE(platform->changePreferences({{"InternalBuild", JsonValue{std::string("yes")}}}));
  EXPECT_EQ(platform->deviceInformation()->answerForQuery("InternalBuild")->stringValue(), "yes");
}

TEST(HomePlatformTest, TakesMetricFlagFromOptions) {
  for (const bool isMetric : {true, false}) {
    const OpenPlatform platform({.drainsOnCaller = true, .metric = isMetric});
    EXPECT_EQ(platform->locale()->usesMetricSystem(), isMetric);
  }
}

TEST(HomePlatformTest, ChangedPreferencesArePosted) {
  const OpenPlatform platform(onCaller());
  int posts = 0;
  const auto token = platform->notificationCenter()->registerForName_queue_handler(
      "com.corvane.managedconfiguration.defaultsdidchange", platform->sharedQueue(),
      [&posts] { ++posts; });
  ASSERT_FALSE(platform->changePreferences({{"NidusLogLevel", JsonValue{std::int64_t{6}}}}));
  platform->drain();
  EXPECT_EQ(posts, 1);
  EXPECT_EQ(platform->preferences()->integerForKey("NidusLogLevel"), 6);
}

TEST(HomePlatformTest, ChangeOnDiskIsPosted) {
  const TestFolder folder;
  const OpenPlatform platform(inFolder(folder, false));
  std::int64_t level = 0;
  const auto token = platform->notificationCenter()->registerForName_queue_handler(
      "com.corvane.managedconfiguration.defaultsdidchange", platform->mainQueue(),
      [&] { level = platform->preferences()->integerForKey("NidusLogLevel"); });
  folder.write("data/preferences.json", R"({"NidusLogLevel": 5})");
  platform->mainQueue()->runUntil([&level] { return level == 5; });
  std::filesystem::rename(folder.write("new.json", R"({"NidusLogLevel": 7})"),
                          folder.path() / "data/preferences.json");
  platform->mainQueue()->runUntil([&level] { return level == 7; });
  EXPECT_EQ(level, 7);
}

/// Commands of many threads, each of which asks for its homes under nested holds.
TEST(HomePlatformTest, EveryHeldManagerReportsAfterItsHold) {
  constexpr int kThreads = 4;
  constexpr int kRounds = 200;
  const OpenPlatform platform({});
  ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
  std::atomic<int> early{0};
  std::atomic<int> reported{0};
  class Delegate final : public NDHomeManagerDelegate {
   public:
    Delegate(std::atomic<int>& earlyCount, std::atomic<int>& reportCount)
        : early_(earlyCount), reported_(reportCount) {}
    void homeManagerDidUpdateHomes(const std::shared_ptr<NDHomeManager>& manager) override {
      if (!isAsked.load()) ++early_;
      if (manager->homes().size() == 1) ++reported_;
    }
    void homeManagerWillNotUpdateHomes(const std::shared_ptr<NDHomeManager>& /*manager*/) override {
      ADD_FAILURE() << "the platform was not shut down";
    }
    std::atomic<bool> isAsked{false};

   private:
    std::atomic<int>& early_;
    std::atomic<int>& reported_;
  };
  const auto work = [&] {
    std::vector<std::shared_ptr<Delegate>> delegates;
    std::vector<std::shared_ptr<NDHomeManager>> managers;
    for (int round = 0; round < kRounds; ++round) {
      const NDDeliveryHold outer;
      for (int nested = 0; nested < 2; ++nested) {
        const NDDeliveryHold inner;
        managers.push_back(platform->createHomeManager());
        delegates.push_back(std::make_shared<Delegate>(early, reported));
        managers.back()->setDelegate(delegates.back());
        std::this_thread::yield();
        delegates.back()->isAsked = true;
      }
    }
    platform->drain();
  };
  std::vector<std::thread> threads;
  for (int thread = 0; thread < kThreads; ++thread) threads.emplace_back(work);
  for (auto& thread : threads) thread.join();
  platform->drain();
  EXPECT_EQ(early.load(), 0);
  EXPECT_EQ(reported.load(), kThreads * kRounds * 2);
}

TEST(HomePlatformTest, DrainSeesTheLastOfAChain) {
  const OpenPlatform platform({});
  for (int round = 0; round < 200; ++round) {
    std::atomic<int> steps{0};
    platform->sharedQueue()->async([&] {
      ++steps;
      platform->mainQueue()->async([&] {
        ++steps;
        platform->sharedQueue()->async([&] { ++steps; });
      });
    });
    platform->drain();
    ASSERT_EQ(steps.load(), 3);
  }
}

TEST(HomePlatformTest, ShutsDownWhileBatchesRun) {
  for (int round = 0; round < 20; ++round) {
    const OpenPlatform platform({});
    ASSERT_FALSE(platform->importHomes({sampleHome()}, false));
    const auto home = platform.homes()[0];
    std::atomic<int> answers{0};
    std::thread writer([&] {
      for (int batch = 0; batch < 50; ++batch) {
        home->writeCharacteristicValues_withCompletionHandler(
            {{characteristicAt(home, powerAddress()), NDValue::boolean(batch % 2 == 0)}},
            [&answers](const auto&, const auto&) { ++answers; });
      }
    });
    platform->shutDown();
    writer.join();
    EXPECT_LE(answers.load(), 50);
  }
}

TEST(HomePlatformTest, LogGoesToTheSink) {
  std::vector<std::string> texts;
  const OpenPlatform platform({.drainsOnCaller = true, .logSink = [&texts](const auto& message) {
                                 texts.push_back(message.fields().at("Message"));
                               }});
  const auto client = platform->systemLog()->openClient(nullptr, "com.corvane.Nidus", 0);
  const auto message = platform->systemLog()->createMessage();
  message->set("Message", "hello");
  client->send(*message);
  EXPECT_THAT(texts, ElementsAre("hello"));
}

}  // namespace
}  // namespace nidus
