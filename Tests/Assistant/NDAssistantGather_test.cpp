#include "Assistant/NDAssistantGather.h"

#include <gmock/gmock.h>

#include <atomic>
#include <string>
#include <thread>
#include <vector>

#include "Assistant/ObjectURL.h"
#include "PlatformModel/Assistant/VAHAConstants.h"
#include "Support/PlatformTest.h"
#include "Support/TestTypes.h"

namespace nidus {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

using Counts = std::vector<long>;

class NDAssistantGatherTest : public PlatformTest {
 protected:
  /// A gatherer that has heard of the homes of the platform.
  static std::shared_ptr<NDAssistantGather> gathered() {
    auto gather = NDAssistantGather::init();
    platform().runUntilIdle();
    return gather;
  }

  static HomeObjectRecords records() { return gathered()->gatherNidusObjects(); }

  /// The record of that name; one without any field when there is none.
  static HomeObjectRecord recordOf(const char* name) {
    for (const HomeObjectRecord& record : records()) {
      if (record.objectName == name) return record;
    }
    return {};
  }

  /// Each record as "HOME Cabin".
  static std::vector<std::string> summaries() {
    std::vector<std::string> texts;
    for (const HomeObjectRecord& record : records()) {
      texts.push_back(record.objectType.str() + " " +
                      (record.objectName ? record.objectName.str() : "-"));
    }
    return texts;
  }

  NDAssistantGather::CompletionHandler countingHandler() {
    return [this](long count) { counts_.push_back(count); };
  }

  Counts counts_;
};

TEST_F(NDAssistantGatherTest, ConfiguredHomesMakeAGatherer) {
  const auto gather = NDAssistantGather::init();
  ASSERT_TRUE(gather);
  EXPECT_FALSE(gather->fetchComplete());
  EXPECT_FALSE(gather->completionHandler());
  EXPECT_EQ(gather->manager(), platform().lastManager());
  EXPECT_EQ(platform().lastManager()->delegate(), gather);
}

TEST_F(NDAssistantGatherTest, MissingConfigurationMakesNone) {
  useHome(HomeBuilder("Cabin"));
  platform().configureHomes(std::nullopt);
  EXPECT_FALSE(NDAssistantGather::init());
  EXPECT_FALSE(platform().lastManager());
}

TEST_F(NDAssistantGatherTest, ConfigurationSetToFalseMakesNone) {
  useHome(HomeBuilder("Cabin"));
  platform().configureHomes(false);
  EXPECT_FALSE(NDAssistantGather::init());
}

TEST_F(NDAssistantGatherTest, UnregisteredPlatformMakesNone) {
  NDPlatform::unregisterPlatform(TestPlatform::shared());
  EXPECT_FALSE(NDAssistantGather::init());
  EXPECT_EQ(NDPlatform::registerPlatform(TestPlatform::shared()), "");
}

TEST_F(NDAssistantGatherTest, FirstUpdateGivesTheNumberOfHomes) {
  platform().setHomes({HomeBuilder("Cabin").build(), HomeBuilder("Hut").build()});
  const auto gather = NDAssistantGather::init();
  gather->startWithCompletionHandler(countingHandler());
  EXPECT_THAT(counts_, IsEmpty());
  platform().runUntilIdle();
  EXPECT_THAT(counts_, ElementsAre(2));
  EXPECT_TRUE(gather->fetchComplete());
}

TEST_F(NDAssistantGatherTest, NoHomesGiveZero) {
  const auto gather = NDAssistantGather::init();
  gather->startWithCompletionHandler(countingHandler());
  platform().runUntilIdle();
  EXPECT_THAT(counts_, ElementsAre(0));
}

TEST_F(NDAssistantGatherTest, SecondUpdateIsIgnored) {
  useHome(HomeBuilder("Cabin"));
  const auto gather = NDAssistantGather::init();
  gather->startWithCompletionHandler(countingHandler());
  platform().runUntilIdle();
  platform().lastManager()->report();
  EXPECT_THAT(counts_, ElementsAre(1));
}

TEST_F(NDAssistantGatherTest, StartAfterTheUpdateGivesZero) {
  useHome(HomeBuilder("Cabin"));
  const auto gather = gathered();
  gather->startWithCompletionHandler(countingHandler());
  EXPECT_THAT(counts_, ElementsAre(0));
  EXPECT_FALSE(gather->completionHandler());
}

TEST_F(NDAssistantGatherTest, SecondStartReplacesTheFirst) {
  useHome(HomeBuilder("Cabin"));
  const auto gather = NDAssistantGather::init();
  gather->startWithCompletionHandler([this](long) { counts_.push_back(-1); });
  gather->startWithCompletionHandler(countingHandler());
  platform().runUntilIdle();
  EXPECT_THAT(counts_, ElementsAre(1));
}

TEST_F(NDAssistantGatherTest, UpdateAndStartAtOnceCallOnce) {
  platform().setSilent(true);
  useHome(HomeBuilder("Cabin"));
  for (int i = 0; i < 100; ++i) {
    const auto gather = NDAssistantGather::init();
    std::atomic<int> calls = 0;
    std::thread update([&gather] { gather->homeManagerDidUpdateHomes(gather->manager()); });
    gather->startWithCompletionHandler([&calls](long) { ++calls; });
    update.join();
    EXPECT_EQ(calls, 1);
  }
}

TEST_F(NDAssistantGatherTest, HandlerIsReleasedAfterItsCall) {
  auto life = std::make_shared<int>();
  const auto gather = NDAssistantGather::init();
  gather->startWithCompletionHandler([life](long) {});
  EXPECT_TRUE(gather->completionHandler());
  platform().runUntilIdle();
  EXPECT_FALSE(gather->completionHandler());
  EXPECT_EQ(life.use_count(), 1);
}

TEST_F(NDAssistantGatherTest, SilentPlatformNeverCalls) {
  platform().setSilent(true);
  const auto gather = NDAssistantGather::init();
  gather->startWithCompletionHandler(countingHandler());
  platform().runUntilIdle();
  EXPECT_THAT(counts_, IsEmpty());
  EXPECT_FALSE(gather->fetchComplete());
}

TEST_F(NDAssistantGatherTest, ManagerDoesNotOwnTheGatherer) {
  auto gather = NDAssistantGather::init();
  gather->startWithCompletionHandler(countingHandler());
  const auto manager = platform().lastManager();
  gather.reset();
  EXPECT_FALSE(manager->delegate());
  platform().runUntilIdle();
  EXPECT_THAT(counts_, IsEmpty());
}

TEST_F(NDAssistantGatherTest, EndOfThePlatformDropsTheHandler) {
  platform().setSilent(true);
  auto life = std::make_shared<int>();
  const auto gather = NDAssistantGather::init();
  gather->startWithCompletionHandler([life](long) { ADD_FAILURE() << "called"; });
  gather->homeManagerWillNotUpdateHomes(gather->manager());
  EXPECT_EQ(life.use_count(), 1);
  gather->startWithCompletionHandler([life](long) { ADD_FAILURE() << "called"; });
  EXPECT_EQ(life.use_count(), 1);
}

TEST_F(NDAssistantGatherTest, PrimaryHomeIsTheFirstMarked) {
  const auto home = HomeBuilder("Hut").primary().build();
  platform().setHomes({HomeBuilder("Cabin").build(), home, HomeBuilder("Flat").primary().build()});
  const auto gather = gathered();
  EXPECT_EQ(gather->getPrimaryHomeName(), "Hut");
  EXPECT_EQ(gather->getPrimaryHomeID(), home->uuid().UUIDString());
}

TEST_F(NDAssistantGatherTest, NoPrimaryHomeIsNull) {
  useHome(HomeBuilder("Cabin"));
  const auto gather = gathered();
  EXPECT_FALSE(gather->getPrimaryHomeName());
  EXPECT_FALSE(gather->getPrimaryHomeID());
}

TEST_F(NDAssistantGatherTest, NoHomesGiveAnEmptySnapshot) { EXPECT_THAT(summaries(), IsEmpty()); }

TEST_F(NDAssistantGatherTest, ObjectsOfAHomeComeInOrder) {
  useHome(HomeBuilder("Cabin")
              .room("Kitchen")
              .accessory("Box")
              .service("Lamp", kLightService, {power(true)})
              .service("Button", kLightService, {identify()})
              .group("Evening")
              .zone("Ground floor")
              .scene("Good night")
              .trigger("Sunset"));
  EXPECT_THAT(summaries(),
              ElementsAre("HOME Cabin", "SERVICE Lamp", "GROUP Evening", "ROOM Kitchen",
                          "ZONE Ground floor", "SCENE Good night", "TRIGGER Sunset"));
}

TEST_F(NDAssistantGatherTest, SnapshotFillsItsMemory) {
  platform().setHomes({HomeBuilder("Cabin").primary().room("Hall").build(), HomeBuilder("Cottage")
                                                                                .room("Kitchen")
                                                                                .room("Attic")
                                                                                .light("Lamp")
                                                                                .light("Fan")
                                                                                .light("Stove")
                                                                                .zone("Upstairs")
                                                                                .zone("Downstairs")
                                                                                .group("Evening")
                                                                                .group("Morning")
                                                                                .group("Noon")
                                                                                .scene("Good night")
                                                                                .scene("Movie")
                                                                                .trigger("Sunset")
                                                                                .trigger("Sunrise")
                                                                                .build()});
  const HomeObjectRecords list = records();
  EXPECT_EQ(list.size(), 17U);
  EXPECT_EQ(list.capacity(), list.size());
}

TEST_F(NDAssistantGatherTest, HomesComeOneAfterTheOther) {
  platform().setHomes({HomeBuilder("Hut").room("Attic").build(),
                       HomeBuilder("Cabin").room("Attic").room("Attic").build()});
  EXPECT_THAT(summaries(),
              ElementsAre("HOME Hut", "ROOM Attic", "HOME Cabin", "ROOM Attic", "ROOM Attic"));
}

TEST_F(NDAssistantGatherTest, HomeRecordHasThreeKeys) {
  const auto home = useHome(HomeBuilder("Cabin"));
  EXPECT_EQ(description(records()), "[{objectType: HOME, objectName: Cabin, objectIdentifier: " +
                                        url(*home).text().str() + "}]");
}

TEST_F(NDAssistantGatherTest, GenericRecordsHaveFourKeys) {
  const auto home = useHome(HomeBuilder("Cabin").scene("Good night"));
  EXPECT_EQ(description(recordOf("Good night")),
            "{objectType: SCENE, objectName: Good night, objectIdentifier: " +
                url(*home->scene("Good night")).text().str() + ", objectHome: Cabin}");
}

TEST_F(NDAssistantGatherTest, RoomIsInItsLastZone) {
  useHome(HomeBuilder("Cabin")
              .room("Kitchen")
              .room("Attic")
              .zone("A", {"Kitchen"})
              .zone("B", {"Kitchen"})
              .zone("C"));
  EXPECT_EQ(recordOf("Kitchen").objectZone, "B");
  EXPECT_EQ(recordOf("Kitchen").objectHome, "Cabin");
  EXPECT_FALSE(recordOf("Attic").objectZone);
}

TEST_F(NDAssistantGatherTest, ServiceRecordHasAllKeys) {
  const auto home = useHome(HomeBuilder("Cabin")
                                .room("Kitchen")
                                .light("Lamp", {identify(), brightness(4), unmapped(), power(true)})
                                .associated(kOutletService)
                                .zone("Ground floor", {"Kitchen"})
                                .group("Night", {"Lamp"})
                                .group("Empty")
                                .group("Evening", {"Lamp"}));
  EXPECT_EQ(description(recordOf("Lamp")),
            "{objectType: SERVICE, objectName: Lamp, objectIdentifier: " +
                url(*home->service("Lamp")).text().str() +
                ", objectHome: Cabin, objectRoom: Kitchen, objectGroups: [Night, Evening], "
                "objectServiceType: com.corvane.nidus.service.light, "
                "objectAssociatedServiceType: com.corvane.nidus.service.outlet, "
                "objectCharacteristics: [com.corvane.nidus.characteristic.brightness, "
                "com.corvane.nidus.characteristic.power]}");
}

TEST_F(NDAssistantGatherTest, GroupIsNamedOncePerMembership) {
  useHome(HomeBuilder("Cabin").light("Lamp").group("Evening", {"Lamp", "Lamp"}));
  EXPECT_THAT(recordOf("Lamp").objectGroups, ElementsAre("Evening", "Evening"));
}

TEST_F(NDAssistantGatherTest, WithoutPlatformNoServiceCanBeAddressed) {
  const auto home = useHome(HomeBuilder("Cabin").light("Lamp"));
  const auto gather = gathered();
  NDPlatform::unregisterPlatform(TestPlatform::shared());
  HomeObjectRecords list;
  gather->addToList_service(list, home->service("Lamp"));
  EXPECT_THAT(list, IsEmpty());
  EXPECT_EQ(NDPlatform::registerPlatform(TestPlatform::shared()), "");
}

TEST_F(NDAssistantGatherTest, ServicesOfOneMakeShareTheirLists) {
  useHome(HomeBuilder("Cabin").light("Lamp").light("Bulb").group("Evening", {"Lamp", "Bulb"}));
  const HomeObjectRecords all = records();
  ASSERT_EQ(all.size(), 4U);  // the home, both lights, the group
  EXPECT_EQ(all[1].objectCharacteristics.begin(), all[2].objectCharacteristics.begin());
  EXPECT_EQ(all[1].objectGroups.begin(), all[2].objectGroups.begin());
}

TEST_F(NDAssistantGatherTest, BareServiceLeavesKeysOut) {
  useHome(HomeBuilder("Cabin").light("Lamp"));
  const HomeObjectRecord record = recordOf("Lamp");
  EXPECT_THAT(record.objectGroups, IsEmpty());
  EXPECT_FALSE(record.objectRoom);
  EXPECT_FALSE(record.objectAssociatedServiceType);
}

TEST_F(NDAssistantGatherTest, RoomNamedLikeTheHomeIsNone) {
  useHome(HomeBuilder("Cabin").room("Cabin").light("Lamp").room("cabin").light("Fan"));
  EXPECT_FALSE(recordOf("Lamp").objectRoom);
  EXPECT_EQ(recordOf("Fan").objectRoom, "cabin");
}

TEST_F(NDAssistantGatherTest, ServiceWithoutAddressableCharacteristicIsSkipped) {
  useHome(
      HomeBuilder("Cabin").light("Lamp", {identify()}).light("Fan", {unmapped()}).light("TV", {}));
  EXPECT_THAT(summaries(), ElementsAre("HOME Cabin"));
}

TEST_F(NDAssistantGatherTest, NamelessServiceHasARecord) {
  useHome(HomeBuilder("Cabin").accessory("Box").service(nullptr, kLightService, {power(true)}));
  EXPECT_THAT(summaries(), ElementsAre("HOME Cabin", "SERVICE -"));
}

TEST_F(NDAssistantGatherTest, NamesAreKeptAsTheyAre) {
  useHome(HomeBuilder(" Caf\xC3\xA9 ").room("kITCHEN "));
  EXPECT_THAT(summaries(), ElementsAre("HOME  Caf\xC3\xA9 ", "ROOM kITCHEN "));
}

TEST_F(NDAssistantGatherTest, RecordsAreAppendedOneByOne) {
  const auto home = useHome(HomeBuilder("Cabin")
                                .room("Kitchen")
                                .light("Lamp")
                                .light("Fan", {identify()})
                                .zone("Ground floor", {"Kitchen"})
                                .group("Evening", {"Lamp"}));
  const auto gather = NDAssistantGather::init();
  HomeObjectRecords list;
  gather->addToList_objectWithName_type_home_andIdentifer(list, "Cabin", VAHAEntityTypeHOMEValue,
                                                          nullptr, url(*home));
  gather->addToList_service(list, home->service("Lamp"));
  gather->addToList_service(list, home->service("Fan"));
  gather->addToList_room(list, *home->room("Kitchen"));
  ASSERT_EQ(list.size(), 3U);
  EXPECT_EQ(description(list[0]), description(recordOf("Cabin")));
  EXPECT_EQ(description(list[1]), description(recordOf("Lamp")));
  EXPECT_EQ(description(list[2]), description(recordOf("Kitchen")));
}

}  // namespace
}  // namespace nidus
