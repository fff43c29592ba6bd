#include "Assistant/NDAssistantSyncHome.h"

#include <gmock/gmock.h>

#include <chrono>
#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "PlatformModel/System/NDSerialQueue.h"
#include "Support/InlineQueue.h"
#include "Support/PlatformTest.h"
#include "Support/PulledChange.h"
#include "Support/TestTypes.h"

namespace nidus {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

using Texts = std::vector<std::string>;

constexpr const char* kKey = "com.corvane.nidus.name";

std::string textOf(const NDString& text) { return text ? text.str() : "none"; }

class BeginInfo final : public AFSyncBeginInfo {
 public:
  void resetWithValidity(const NDString& validity) override {
    resets.push_back(textOf(validity));
    if (onReset) onReset();
  }
  Texts resets;
  std::function<void()> onReset;
};

class NDAssistantSyncHomeTest : public PlatformTest {
 protected:
  NDAssistantSyncHomeTest() : sync_(NDAssistantSyncHome::init()) {}

  /// Begins a sync with `key`; gives the info that was handed in.
  std::shared_ptr<BeginInfo> begin(const NDString& key = kKey) {
    auto info = std::make_shared<BeginInfo>();
    info->onReset = onReset_;
    sync_->beginSyncWithAnchor_validity_forKey_beginInfo("17", "old", key, info);
    return info;
  }

  /// Begins a sync whose homes come while it waits, but are read after that.
  std::shared_ptr<BeginInfo> beginAnsweredTooLate() {
    useHome(fourObjects());
    platform().setSilent(true);
    sync_->setQueue(platform().mainQueue());  // which a wait does not run
    platform().sharedQueue()->async([] { platform().lastManager()->report(); });
    return begin();
  }

  /// What follows `anchor`: "Lamp 3", or "end 3" at the end of the data.
  std::string change(const NDString& anchor) {
    PulledChange info;
    sync_->getChangeAfterAnchor_changeInfo(anchor, info);
    return (info.entity ? info.entity->name().str() : "end") + " " + textOf(info.postAnchor);
  }

  /// All that the assistant pulls, the end included.
  Texts allChanges() {
    Texts changes;
    NDString anchor;
    do {
      changes.push_back(change(anchor));
      anchor = changes.back().substr(changes.back().rfind(' ') + 1);
    } while (!changes.back().starts_with("end"));
    return changes;
  }

  static HomeBuilder fourObjects() {
    return HomeBuilder("E0").room("E1").room("E2").scene("E3").trigger("Sunset");
  }

  std::shared_ptr<NDAssistantSyncHome> sync_;
  std::function<void()> onReset_;
};

TEST_F(NDAssistantSyncHomeTest, StartsEmpty) {
  EXPECT_FALSE(sync_->done());
  EXPECT_FALSE(sync_->finalAnchor());
  EXPECT_FALSE(sync_->postAnchors());
  EXPECT_FALSE(sync_->entities());
  EXPECT_FALSE(sync_->gather());
  EXPECT_FALSE(sync_->manager());
  EXPECT_TRUE(sync_->group()->wait({}));
  EXPECT_EQ(std::dynamic_pointer_cast<NDSerialQueue>(sync_->queue())->label(), "NDAssistant");
}

TEST_F(NDAssistantSyncHomeTest, NoPlatformMakesNone) {
  NDPlatform::unregisterPlatform(TestPlatform::shared());
  EXPECT_FALSE(NDAssistantSyncHome::init());
  EXPECT_EQ(NDPlatform::registerPlatform(TestPlatform::shared()), "");
}

TEST_F(NDAssistantSyncHomeTest, FieldsAreSetAndRead) {
  const auto group = std::make_shared<NDWaitGroup>(platform().clock());
  const auto gather = NDAssistantGather::init();
  sync_->setDone(true);
  sync_->setFinalAnchor("9");
  sync_->setPostAnchors(NDAssistantSyncHome::Anchors{"9"});
  sync_->setEntities(NDAssistantSyncHome::Entities{nullptr});
  sync_->setGroup(group);
  sync_->setGather(gather);
  sync_->setQueue(platform().sharedQueue());
  sync_->setManager(gather->manager());
  EXPECT_TRUE(sync_->done());
  EXPECT_EQ(sync_->finalAnchor(), "9");
  EXPECT_THAT(*sync_->postAnchors(), ElementsAre("9"));
  EXPECT_EQ(sync_->entities()->size(), 1U);
  EXPECT_EQ(sync_->group(), group);
  EXPECT_EQ(sync_->gather(), gather);
  EXPECT_EQ(sync_->queue(), platform().sharedQueue());
  EXPECT_EQ(sync_->manager(), gather->manager());
}

TEST_F(NDAssistantSyncHomeTest, FinalAnchorIsConstant) {
  EXPECT_EQ(sync_->calculateFinalAnchorForHomeObjects({}), "3405691582");
  EXPECT_EQ(sync_->calculateFinalAnchorForHomeObjects({nullptr, nullptr}), "3405691582");
}

TEST_F(NDAssistantSyncHomeTest, BeginResetsBeforeItReturns) {
  useHome(fourObjects());
  EXPECT_THAT(begin()->resets, ElementsAre("3405691582"));
  EXPECT_TRUE(sync_->done());
  EXPECT_EQ(sync_->finalAnchor(), "3405691582");
  EXPECT_THAT(*sync_->postAnchors(), ElementsAre("1", "2", "3", "3405691582"));
  EXPECT_EQ(sync_->entities()->size(), 4U);
}

TEST_F(NDAssistantSyncHomeTest, AnsweredSyncLogsNothing) {
  useHome(fourObjects());
  const auto before = platform().clock()->now();
  begin();
  platform().runUntilIdle();
  EXPECT_EQ(platform().clock()->now(), before);
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(NDAssistantSyncHomeTest, EntitiesComeOnePerRequest) {
  useHome(fourObjects());
  begin();
  EXPECT_THAT(allChanges(), ElementsAre("E0 1", "E1 2", "E2 3", "E3 3405691582", "end 3405691582"));
}

TEST_F(NDAssistantSyncHomeTest, AnchorSaysWhatFollows) {
  useHome(fourObjects());
  begin();
  EXPECT_EQ(change(nullptr), "E0 1");
  EXPECT_EQ(change("2"), "E2 3");
  EXPECT_EQ(change("3"), "E3 3405691582");
  EXPECT_EQ(change("3405691582"), "end 3405691582");
  EXPECT_EQ(change("17"), "end 17");
  EXPECT_EQ(change("4"), "end 4");
  EXPECT_EQ(change("0"), "end 0");
  EXPECT_EQ(change(""), "end ");
}

TEST_F(NDAssistantSyncHomeTest, FinalAnchorEndsTheDataWherever) {
  useHome(fourObjects());
  begin();
  sync_->setFinalAnchor("2");
  EXPECT_EQ(change("1"), "E1 2");
  EXPECT_EQ(change("2"), "end 2");
  sync_->setFinalAnchor(nullptr);
  EXPECT_EQ(change(nullptr), "E0 1");
}

TEST_F(NDAssistantSyncHomeTest, OtherSpellingsOfAnAnchorAreUnknown) {
  useHome(fourObjects());
  begin();
  for (const std::string anchor : {"02", "+2", "2 ", " 2", "2x", "-2", "18446744073709551618"}) {
    EXPECT_EQ(change(anchor), "end " + anchor);
  }
}

TEST_F(NDAssistantSyncHomeTest, FirstOfEqualAnchorsThatAreSetCounts) {
  useHome(fourObjects());
  begin();
  sync_->setPostAnchors(NDAssistantSyncHome::Anchors{"2", "2", "2", "1"});
  EXPECT_EQ(change("2"), "E1 2");
  EXPECT_EQ(change("1"), "end 1");
  EXPECT_EQ(change("3"), "end 3");
}

TEST_F(NDAssistantSyncHomeTest, SyncCountsAgainAfterAListThatWasSet) {
  useHome(fourObjects());
  sync_->setPostAnchors(NDAssistantSyncHome::Anchors{"3"});
  begin();
  EXPECT_EQ(change("3"), "E3 3405691582");
}

TEST_F(NDAssistantSyncHomeTest, OneEntityHasTheFinalAnchor) {
  useHome(HomeBuilder("Cabin"));
  EXPECT_THAT(begin()->resets, ElementsAre("3405691582"));
  EXPECT_THAT(allChanges(), ElementsAre("Cabin 3405691582", "end 3405691582"));
}

TEST_F(NDAssistantSyncHomeTest, NoHomesGiveNoEntities) {
  EXPECT_THAT(begin()->resets, ElementsAre("none"));
  EXPECT_TRUE(sync_->entities()->empty());
  EXPECT_TRUE(sync_->postAnchors()->empty());
  EXPECT_FALSE(sync_->finalAnchor());
  EXPECT_EQ(change(nullptr), "end none");
  EXPECT_EQ(change("3"), "end 3");
}

TEST_F(NDAssistantSyncHomeTest, TriggersAreNotPublished) {
  useHome(HomeBuilder("Cabin").trigger("Sunset").trigger("Sunrise"));
  begin();
  EXPECT_THAT(allChanges(), ElementsAre("Cabin 3405691582", "end 3405691582"));
}

TEST_F(NDAssistantSyncHomeTest, NamelessServiceIsNotPublished) {
  useHome(HomeBuilder("Cabin")
              .accessory("Box")
              .service(nullptr, kLightService, {power(true)})
              .service("Lamp", kLightService, {power(true)}));
  begin();
  EXPECT_THAT(allChanges(), ElementsAre("Cabin 1", "Lamp 3405691582", "end 3405691582"));
}

TEST_F(NDAssistantSyncHomeTest, EndDropsTheLists) {
  useHome(fourObjects());
  begin();
  sync_->syncDidEnd();
  EXPECT_FALSE(sync_->finalAnchor());
  EXPECT_FALSE(sync_->postAnchors());
  EXPECT_FALSE(sync_->entities());
  EXPECT_EQ(change("1"), "end 1");
}

TEST_F(NDAssistantSyncHomeTest, UnconfiguredHomesAreLogged) {
  platform().configureHomes(false);
  EXPECT_THAT(begin()->resets, ElementsAre("none"));
  EXPECT_THAT(log(), ElementsAre("6 No homes configured - short-circuiting sync"));
  EXPECT_FALSE(sync_->gather());
  EXPECT_FALSE(sync_->entities());
  EXPECT_EQ(change(nullptr), "end none");
}

TEST_F(NDAssistantSyncHomeTest, UnconfiguredHomesDropTheFormerSync) {
  useHome(fourObjects());
  begin();
  platform().configureHomes(std::nullopt);
  EXPECT_THAT(begin()->resets, ElementsAre("none"));
  EXPECT_EQ(change(nullptr), "end none");
}

TEST_F(NDAssistantSyncHomeTest, HoldsTheReportUntilItWaits) {
  useHome(fourObjects());
  platform().setReporting(TestPlatform::Reporting::prompt);
  EXPECT_THAT(begin()->resets, ElementsAre("3405691582"));
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(NDAssistantSyncHomeTest, QueueMayBuildAtOnce) {
  useHome(fourObjects());
  platform().setReporting(TestPlatform::Reporting::early);
  sync_->setQueue(std::make_shared<InlineQueue>());
  EXPECT_THAT(begin()->resets, ElementsAre("3405691582"));
  EXPECT_EQ(allChanges().size(), 5U);
}

TEST_F(NDAssistantSyncHomeTest, ResetFindsTheListsPublished) {
  useHome(fourObjects());
  Texts changes;
  onReset_ = [&] { changes = allChanges(); };
  begin();
  EXPECT_EQ(changes.size(), 5U);
}

TEST_F(NDAssistantSyncHomeTest, ReasonIsLoggedBeforeTheReset) {
  platform().configureHomes(false);
  Texts logged;
  onReset_ = [&] { logged = log(); };
  begin();
  EXPECT_THAT(logged, ElementsAre("6 No homes configured - short-circuiting sync"));
}

TEST_F(NDAssistantSyncHomeTest, SilentPlatformEndsTheWait) {
  useHome(fourObjects());
  platform().setSilent(true);
  const auto before = platform().clock()->now();
  EXPECT_THAT(begin()->resets, IsEmpty());
  EXPECT_EQ(platform().clock()->now() - before, std::chrono::seconds(2));
  EXPECT_THAT(log(), ElementsAre("6 Timed out waiting for nidusd"));
  EXPECT_FALSE(sync_->done());
  EXPECT_EQ(change("1"), "end 1");
}

TEST_F(NDAssistantSyncHomeTest, WatchdogEndsASilentSync) {
  platform().setSilent(true);
  begin();
  platform().runUntilIdle();
  EXPECT_THAT(log(), ElementsAre("6 Timed out waiting for nidusd", "6 nidusd did not respond"));
  EXPECT_TRUE(sync_->done());
  EXPECT_TRUE(sync_->group()->wait({}));
}

TEST_F(NDAssistantSyncHomeTest, IsDoneBeforeTheGroupIsLeft) {
  platform().setSilent(true);
  begin();
  bool wasDone = false;
  sync_->group()->notify(std::make_shared<InlineQueue>(), [&] { wasDone = sync_->done(); });
  platform().runUntilIdle();
  EXPECT_TRUE(wasDone);
}

TEST_F(NDAssistantSyncHomeTest, WatchdogLogsBeforeTheGroupIsLeft) {
  platform().setSilent(true);
  begin();
  Texts logged;
  sync_->group()->notify(std::make_shared<InlineQueue>(), [&] { logged = log(); });
  platform().runUntilIdle();
  EXPECT_THAT(logged, ElementsAre("6 Timed out waiting for nidusd", "6 nidusd did not respond"));
}

TEST_F(NDAssistantSyncHomeTest, LowerLogLevelHidesTheMessages) {
  platform().setLogLevel(5);
  platform().setSilent(true);
  begin();
  platform().runUntilIdle();
  platform().configureHomes(false);
  begin();
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(NDAssistantSyncHomeTest, LateSnapshotResetsAllTheSame) {
  useHome(fourObjects());
  platform().setSilent(true);
  const auto info = begin();
  platform().runUntilIdle();
  platform().lastManager()->report();
  platform().runUntilIdle();
  EXPECT_THAT(info->resets, ElementsAre("3405691582"));
  EXPECT_EQ(allChanges().size(), 5U);
  EXPECT_TRUE(sync_->done());
}

TEST_F(NDAssistantSyncHomeTest, SnapshotAfterTheTimeOutSilencesTheWatchdog) {
  const auto info = beginAnsweredTooLate();
  EXPECT_THAT(info->resets, IsEmpty());
  platform().runUntilIdle();
  EXPECT_THAT(info->resets, ElementsAre("3405691582"));
  EXPECT_THAT(log(), ElementsAre("6 Timed out waiting for nidusd"));
}

TEST_F(NDAssistantSyncHomeTest, ResetsBeforeTheGroupIsLeft) {
  const auto info = beginAnsweredTooLate();
  Texts resets;
  sync_->group()->notify(std::make_shared<InlineQueue>(), [&] { resets = info->resets; });
  platform().runUntilIdle();
  EXPECT_THAT(resets, ElementsAre("3405691582"));
}

TEST_F(NDAssistantSyncHomeTest, SecondBeginTakesANewSnapshot) {
  useHome(fourObjects());
  begin();
  const auto gather = sync_->gather();
  useHome(HomeBuilder("Cabin"));
  EXPECT_THAT(begin()->resets, ElementsAre("3405691582"));
  EXPECT_NE(sync_->gather(), gather);
  EXPECT_THAT(allChanges(), ElementsAre("Cabin 3405691582", "end 3405691582"));
}

TEST_F(NDAssistantSyncHomeTest, LateBuildLeavesTheNextSyncAlone) {
  useHome(fourObjects());
  platform().setSilent(true);
  const auto first = begin();
  platform().lastManager()->report();  // queues the build task
  useHome(HomeBuilder("Cabin"));
  platform().setSilent(false);
  const auto second = begin();
  EXPECT_THAT(first->resets, ElementsAre("3405691582"));
  EXPECT_THAT(second->resets, ElementsAre("3405691582"));
  EXPECT_THAT(allChanges(), ElementsAre("Cabin 3405691582", "end 3405691582"));
}

TEST_F(NDAssistantSyncHomeTest, LateBuildLeavesAnUnconfiguredSyncEmpty) {
  useHome(fourObjects());
  platform().setSilent(true);
  const auto first = begin();
  platform().lastManager()->report();  // queues the build task
  platform().configureHomes(false);
  begin();
  platform().runUntilIdle();
  EXPECT_THAT(first->resets, ElementsAre("3405691582"));
  EXPECT_FALSE(sync_->finalAnchor());
  EXPECT_EQ(change(nullptr), "end none");
}

TEST_F(NDAssistantSyncHomeTest, SnapshotOfAFormerSyncIsIgnored) {
  useHome(fourObjects());
  platform().setSilent(true);
  const auto first = begin();
  platform().runUntilIdle();
  const auto gather = sync_->gather();
  const auto manager = platform().lastManager();
  begin();
  platform().runUntilIdle();
  manager->report();
  platform().runUntilIdle();
  EXPECT_THAT(first->resets, IsEmpty());
}

TEST_F(NDAssistantSyncHomeTest, DestroyedHandlerIgnoresTheSnapshot) {
  useHome(fourObjects());
  platform().setSilent(true);
  const auto info = begin();
  platform().runUntilIdle();
  const auto gather = sync_->gather();
  sync_.reset();
  platform().lastManager()->report();
  platform().runUntilIdle();
  EXPECT_THAT(info->resets, IsEmpty());
}

TEST_F(NDAssistantSyncHomeTest, WaitingGathererDoesNotOwnTheHandler) {
  platform().setSilent(true);
  const auto info = begin();
  platform().runUntilIdle();
  EXPECT_EQ(info.use_count(), 2);  // the gatherer's handler holds it
  const std::weak_ptr<NDAssistantSyncHome> handler = sync_;
  sync_.reset();
  EXPECT_TRUE(handler.expired());
  EXPECT_FALSE(platform().lastManager());
  EXPECT_EQ(info.use_count(), 1);
}

using NDAssistantSyncHomeDeathTest = NDAssistantSyncHomeTest;

TEST_F(NDAssistantSyncHomeDeathTest, WrongKeyStopsTheProcess) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  EXPECT_DEATH(begin("com.corvane.nidus.other"),
               "Assertion failure in -\\[NDAssistantSyncHome "
               "beginSyncWithAnchor:validity:forKey:beginInfo:\\], "
               "Sources/Assistant/NDAssistantSyncHome:80: key == \"com.corvane.nidus.name\"\n$");
}

TEST_F(NDAssistantSyncHomeDeathTest, MissingKeyStopsTheProcess) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  EXPECT_DEATH(begin(nullptr), "NDAssistantSyncHome:80");
}

TEST_F(NDAssistantSyncHomeDeathTest, WrongKeyStopsTheSecondSync) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  begin();
  EXPECT_DEATH(begin("Com.corvane.nidus.name"), "NDAssistantSyncHome:80");
}

TEST_F(NDAssistantSyncHomeDeathTest, UnequalListsStopTheProcess) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  sync_->setPostAnchors(NDAssistantSyncHome::Anchors{"1"});
  EXPECT_DEATH(
      change(nullptr),
      "Assertion failure in -\\[NDAssistantSyncHome "
      "getChangeAfterAnchor:changeInfo:\\], "
      "Sources/Assistant/NDAssistantSyncHome:173: _postAnchors.count == _entities.count\n$");
}

}  // namespace
}  // namespace nidus
