#include "PlatformModel/Assistant/NDAssistantModule.h"

#include <dlfcn.h>
#include <gmock/gmock.h>

#include <cstdlib>
#include <filesystem>
#include <iterator>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

#include "Module/ScarceMemory.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/Assistant/VAHAFilter.h"
#include "Support/ElfFile.h"
#include "Support/FreshProcess.h"
#include "Support/HomeBuilder.h"
#include "Support/PulledChange.h"
#include "Support/TestPlatform.h"

namespace nidus {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

using Texts = std::vector<std::string>;

/// The module that is tried: the one that was built, unless the environment names another.
const char* moduleFile() {
  const char* const given = std::getenv("NIDUS_MODULE_FILE");
  return given ? given : NIDUS_MODULE_FILE;
}

void* openLibrary() {
  void* const library = dlopen(moduleFile(), RTLD_NOW | RTLD_LOCAL);
  if (!library) throw std::runtime_error(dlerror());
  return library;
}

/// Opens the module as a host does and gives what it offers; never null.
const NDAssistantModule& openModule() {
  void* const entry = dlsym(openLibrary(), kNDAssistantModuleEntryName);
  if (!entry) throw std::runtime_error(dlerror());
  return *reinterpret_cast<NDAssistantModuleEntryFunction*>(entry)();
}

std::ptrdiff_t threadCount() {
  return std::distance(std::filesystem::directory_iterator("/proc/self/task"), {});
}

std::string textAt(const NDDictionary& dictionary, const char* key) {
  const NDDictionaryValue* value = dictionary.find(key);
  return value ? std::get<NDString>(value->content()).str() : "none";
}

class Request final : public VAHACommand {};

class BeginInfo final : public AFSyncBeginInfo {
 public:
  void resetWithValidity(const NDString& validity) override { resets.push_back(validity); }
  std::vector<NDString> resets;
};

TEST(NDAssistantModuleTest, TellsItsVersions) {
  EXPECT_EQ(openModule().interfaceVersion, kNDAssistantModuleInterfaceVersion);
  EXPECT_STREQ(openModule().abi, kNDAssistantModuleABI);
}

TEST(NDAssistantModuleTest, ExportsItsEntryAndTheLogAlone) {
  EXPECT_THAT(ElfFile(moduleFile()).exportedSymbols(),
              ElementsAre("NDAssistantModuleEntry", "WLOLog", "WLOLogV", "WLOShouldLogAtLevel",
                          "kWLOLogLevelKey"));
}

TEST(NDAssistantModuleTest, ExportsTheKeyOfTheLogLevel) {
  EXPECT_STREQ(static_cast<const char*>(dlsym(openLibrary(), "kWLOLogLevelKey")), "NidusLogLevel");
}

TEST(NDAssistantModuleTest, IsNotUnloaded) {
  EXPECT_EQ(dlclose(openLibrary()), 0);
  EXPECT_TRUE(dlopen(moduleFile(), RTLD_NOW | RTLD_NOLOAD));
}

TEST(NDAssistantModuleTest, WithoutPlatformFactoriesSayWhy) {
  const NDAssistantModule& module = openModule();
  Texts messages(4);
  bool isReceived = false;
  NDLogThreshold threshold;
  EXPECT_FALSE(module.makeCommand(Request(), nullptr, messages[0]));
  EXPECT_FALSE(module.makeSyncHandler(messages[1]));
  EXPECT_FALSE(module.gatherRecords([&](const auto&) { isReceived = true; }, messages[2]));
  EXPECT_FALSE(module.readLogThreshold(threshold, messages[3]));
  EXPECT_THAT(messages, ::testing::Each("no home platform is registered; register one before "
                                        "the plug-in is used"));
  EXPECT_FALSE(isReceived);
}

/// Uses the module with a platform that has one home.
class OpenModuleTest : public ::testing::Test {
 protected:
  OpenModuleTest() {
    EXPECT_EQ(NDPlatform::registerPlatform(TestPlatform::shared()), "");
    platform().configureHomes(true);
    platform().setReporting(TestPlatform::Reporting::queued);
    platform().setHomes(
        {HomeBuilder("Cabin").room("Kitchen").light("Lamp", {power(true)}).build()});
  }
  ~OpenModuleTest() override {
    platform().runUntilIdle();
    platform().setHomes({});
    NDPlatform::unregisterPlatform(TestPlatform::shared());
  }

  static TestPlatform& platform() { return *TestPlatform::shared(); }
  /// The types and names of the records that the module gathers, each list of them behind a "|".
  static Texts gatheredRecords() {
    Texts texts;
    std::string message;
    const auto receive = [&texts](const NDDictionaryList& records) {
      texts.emplace_back("|");
      for (const auto& record : records) {
        const auto& fields = std::get<NDDictionary>(record.content());
        texts.push_back(textAt(fields, "objectType") + " " + textAt(fields, "objectName"));
      }
    };
    EXPECT_TRUE(openModule().gatherRecords(receive, message));
    platform().runUntilIdle();
    EXPECT_EQ(message, "");
    return texts;
  }
};

TEST_F(OpenModuleTest, OpeningShowsNothing) {
  inFreshProcess([] {
    const auto threads = threadCount();
    ::testing::internal::CaptureStdout();
    ::testing::internal::CaptureStderr();
    (void)openModule();
    EXPECT_EQ(::testing::internal::GetCapturedStdout(), "");
    EXPECT_EQ(::testing::internal::GetCapturedStderr(), "");
    EXPECT_EQ(threadCount(), threads);
    EXPECT_EQ(platform().testPreferences().uses(), 0U);
    EXPECT_THAT(platform().testLog().openings(), IsEmpty());
    EXPECT_THAT(platform().testNotifications().registrations(), IsEmpty());
    EXPECT_EQ(platform().deviceQueries(), 0U);
  });
}

TEST_F(OpenModuleTest, TellsWhatItLogs) {
  inFreshProcess([] {
    NDLogThreshold threshold;
    std::string message;
    platform().testPreferences().setInteger("NidusLogLevel", 7);
    EXPECT_TRUE(openModule().readLogThreshold(threshold, message));
    EXPECT_EQ(threshold.level, 7);
    EXPECT_EQ(threshold.rule, NDLogThreshold::Rule::level);
  });
}

TEST_F(OpenModuleTest, CommandReadsALamp) {
  Request request;
  auto filter = std::make_shared<VAHASearchCriteriaFilter>();
  filter->setServiceName("Lamp");
  request.setFilter(filter);
  auto action = std::make_shared<VAHAAction>();
  action->setActionType(VAHAActionTypeGETValue);
  action->setAttribute("POWER");
  request.setActions({action});
  Texts outcomes;
  std::string message;
  const auto command = openModule().makeCommand(request, nullptr, message);
  ASSERT_TRUE(command) << message;
  command->performWithCompletion([&outcomes](const NDDictionary& reply) {
    outcomes.push_back(textAt(reply, "commandOutcome"));
  });
  platform().runUntilIdle();
  EXPECT_THAT(outcomes, ElementsAre(VAHACommandOutcomeCOMMAND_SUCCESSValue));
}

TEST_F(OpenModuleTest, SyncServesAnEntity) {
  std::string message;
  const auto handler = openModule().makeSyncHandler(message);
  ASSERT_TRUE(handler) << message;
  const auto begin = std::make_shared<BeginInfo>();
  handler->beginSyncWithAnchor_validity_forKey_beginInfo(nullptr, nullptr, "com.corvane.nidus.name",
                                                         begin);
  EXPECT_THAT(begin->resets, ElementsAre("3405691582"));
  PulledChange change;
  handler->getChangeAfterAnchor_changeInfo("1", change);
  ASSERT_TRUE(change.entity);
  EXPECT_EQ(change.entity->name(), "Lamp");
  EXPECT_EQ(change.postAnchor, "2");
}

TEST_F(OpenModuleTest, RecordsAreGathered) {
  EXPECT_THAT(gatheredRecords(), ElementsAre("|", "HOME Cabin", "SERVICE Lamp", "ROOM Kitchen"));
}

TEST_F(OpenModuleTest, RecordsWaitForThePlatform) {
  platform().setReporting(TestPlatform::Reporting::prompt);
  EXPECT_THAT(gatheredRecords(), ElementsAre("|", "HOME Cabin", "SERVICE Lamp", "ROOM Kitchen"));
}

TEST_F(OpenModuleTest, HomesReportedTooEarlyHaveNoRecords) {
  platform().setReporting(TestPlatform::Reporting::early);
  EXPECT_THAT(gatheredRecords(), ElementsAre("|"));
}

TEST_F(OpenModuleTest, WantOfMemoryIsAReason) {
  const NDAssistantModule& module = openModule();
  const Request request;
  NDLogThreshold threshold;
  Texts messages(4);
  {
    const ScarceMemory memory;
    EXPECT_FALSE(module.makeCommand(request, nullptr, messages[0]));
    EXPECT_FALSE(module.makeSyncHandler(messages[1]));
    EXPECT_FALSE(module.gatherRecords([](const auto&) {}, messages[2]));
    EXPECT_FALSE(module.readLogThreshold(threshold, messages[3]));
  }
  EXPECT_THAT(messages, ::testing::Each("std::bad_alloc"));
}

TEST_F(OpenModuleTest, UnconfiguredHomesHaveNoRecords) {
  platform().configureHomes(false);
  EXPECT_THAT(gatheredRecords(), ElementsAre("|"));
}

TEST_F(OpenModuleTest, MissingHomesHaveNoRecords) {
  platform().setHomes({});
  EXPECT_THAT(gatheredRecords(), ElementsAre("|"));
}

}  // namespace
}  // namespace nidus
