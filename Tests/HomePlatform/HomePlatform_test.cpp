#include "HomePlatform/HomePlatform.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>

#include <atomic>
#include <fstream>
#include <thread>

#include "HomePlatform/PlatformProbe.h"
#include "HomePlatform/Store/Database.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

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
