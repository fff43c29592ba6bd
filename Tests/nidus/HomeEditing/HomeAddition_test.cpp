#include "nidus/HomeEditing/HomeAddition.h"

#include "HomePlatform/Metadata/VocabularyReader.h"
#include "HomePlatform/Store/HomeChecks.h"
#include "nidus/HomeEditing/SampleHomes.h"

namespace nidus {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

/// Whether `sentence` is `start` with the UUID in brackets.
MATCHER_P2(SaysAdded, start, uuid, "") {
  const std::string expected = std::string("added ") + start + " (" + uuid.UUIDString().str() + ")";
  *result_listener << (arg ? std::string(*arg) : arg.failure().message);
  return arg && *arg == expected;
}

class HomeAdditionTest : public ::testing::Test {
 protected:
  ~HomeAdditionTest() override { EXPECT_FALSE(checkHomes(homes_, "homes")); }
  [[nodiscard]] HomeData& beach() { return homes_[0]; }
  void expectUnchanged() const { EXPECT_EQ(textOf(homes_), textOf(sampleHomes())); }

  const Vocabulary vocabulary_ = builtInVocabulary();
  std::vector<HomeData> homes_ = sampleHomes();
};

TEST_F(HomeAdditionTest, AddsHomes) {
  const auto done = addHome(homes_, "Flat", true);
  ASSERT_EQ(homes_.size(), 3U);
  EXPECT_THAT(done, SaysAdded("the home Flat", homes_[2].uuid));
  EXPECT_TRUE(homes_[2].primary);
  ASSERT_TRUE(addHome(homes_, "Flat", false));
  EXPECT_FALSE(homes_[3].primary);
  EXPECT_NE(homes_[2].uuid, homes_[3].uuid);
}

TEST_F(HomeAdditionTest, AddsRoomsAndTriggers) {
  const auto room = addRoom(homes_, {"Attic", "Cottage"});
  EXPECT_THAT(room, SaysAdded("the room Attic of Cottage", homes_[1].rooms.back().uuid));
  const auto trigger = addTrigger(homes_, {"Noon", kBeachHouseID});
  EXPECT_THAT(trigger, SaysAdded("the trigger Noon of Beach House", beach().triggers[1].uuid));
}

TEST_F(HomeAdditionTest, WantsToKnowTheHome) {
  EXPECT_THAT(addRoom(homes_, {"Attic", ""}), IsBadInput("say which with --home"));
  EXPECT_THAT(addRoom(homes_, {"Attic", "Castle"}), IsBadInput("there is no home Castle"));
  expectUnchanged();
  homes_.pop_back();
  EXPECT_TRUE(addRoom(homes_, {"Attic", ""}));
}

TEST_F(HomeAdditionTest, AddsZonesOfRooms) {
  const auto done = addZone(homes_, {"All", ""}, {"Study", kBeachKitchenID, "Study"});
  const ZoneData& zone = beach().zones.back();
  EXPECT_THAT(done, SaysAdded("the zone All of Beach House", zone.uuid));
  EXPECT_THAT(zone.rooms, ElementsAre(beach().rooms[1].uuid, beach().rooms[0].uuid));
  ASSERT_TRUE(addZone(homes_, {"None", "Cottage"}, {}));
  EXPECT_THAT(homes_[1].zones[0].rooms, IsEmpty());
}

TEST_F(HomeAdditionTest, KeepsZonesWithinOneHome) {
  EXPECT_THAT(addZone(homes_, {"All", ""}, {"Study", kCottageKitchenID}),
              IsBadInput("there is no room BB000000"));
  EXPECT_THAT(addZone(homes_, {"All", ""}, {"Kitchen"}), IsBadInput("2 rooms named Kitchen"));
  EXPECT_THAT(addZone(homes_, {"All", "Cottage"}, {"Study"}), IsBadInput("no room Study"));
  expectUnchanged();
}

TEST_F(HomeAdditionTest, AddsAccessories) {
  const auto done = addAccessory(homes_, {"Door", ""}, {"Study", true});
  const AccessoryData& door = beach().accessories.back();
  EXPECT_THAT(done, SaysAdded("the accessory Door of Beach House", door.uuid));
  EXPECT_EQ(door.room, beach().rooms[1].uuid);
  EXPECT_TRUE(door.requiresUnlock);
  ASSERT_TRUE(addAccessory(homes_, {"Box", "Cottage"}, {"", false}));
  EXPECT_FALSE(homes_[1].accessories[0].room);
  EXPECT_FALSE(homes_[1].accessories[0].requiresUnlock);
}

TEST_F(HomeAdditionTest, AddsServices) {
  const ServiceWords glow{"Glow", "light", "", {"power"}};
  EXPECT_THAT(addService(homes_, {ObjectKind::accessory, "Ceiling lamp", ""}, glow, vocabulary_),
              IsDone("added the service Ceiling lamp/Glow of Beach House (" +
                     std::string(kCeilingLampID) + "/9)"));
  ASSERT_EQ(beach().accessories[0].services.size(), 2U);
  EXPECT_EQ(beach().accessories[0].services[1].characteristics[0].instanceID, 11);
}

TEST_F(HomeAdditionTest, AddsGroupsOfServices) {
  const auto done =
      addGroup(homes_, {"Both", ""}, {"Floor lamp/Lamp", "Ceiling lamp/8", "Floor lamp/8"});
  const ServiceGroupData& group = beach().serviceGroups.back();
  EXPECT_THAT(done, SaysAdded("the group Both of Beach House", group.uuid));
  EXPECT_THAT(group.services, ElementsAre(ServiceAddress{beach().accessories[1].uuid, 8},
                                          ServiceAddress{beach().accessories[0].uuid, 8}));
}

TEST_F(HomeAdditionTest, AddsScenesOfSettings) {
  const auto done =
      addScene(homes_, {"Day", ""},
               {"Floor lamp/Lamp power on", "Ceiling lamp/Lamp brightness 80%"}, vocabulary_, true);
  const ActionSetData& scene = beach().actionSets.back();
  EXPECT_THAT(done, SaysAdded("the scene Day of Beach House", scene.uuid));
  ASSERT_EQ(scene.actions.size(), 2U);
  EXPECT_TRUE(scene.actions[0].value->boolValue());
  EXPECT_EQ(scene.actions[1].target.characteristic, 10);
  EXPECT_TRUE(addScene(homes_, {"Nothing", "Cottage"}, {}, vocabulary_, true));
}

TEST_F(HomeAdditionTest, RefusesWithoutAChange) {
  const ObjectWords lamp{ObjectKind::accessory, "Floor lamp", ""};
  EXPECT_THAT(addHome(homes_, "", false), IsBadInput("empty"));
  EXPECT_THAT(addHome(homes_, "  ", false), IsBadInput("blank"));
  EXPECT_THAT(addRoom(homes_, {"\xff", "Cottage"}), IsBadInput("UTF-8"));
  EXPECT_THAT(addAccessory(homes_, {"Box", ""}, {"Attic", false}), IsBadInput("no room Attic"));
  EXPECT_THAT(addAccessory(homes_, {"Box", "Cottage"}, {"Study", false}), IsBadInput("no room"));
  EXPECT_THAT(addService(homes_, lamp, {"", "light", "", {}}, vocabulary_), IsBadInput("empty"));
  EXPECT_THAT(addService(homes_, lamp, {"A", "x", "", {}}, vocabulary_), IsBadInput("type"));
  EXPECT_THAT(
      addService(homes_, {ObjectKind::accessory, "Box", ""}, {"A", "light", "", {}}, vocabulary_),
      IsBadInput("no accessory Box"));
  EXPECT_THAT(addGroup(homes_, {"G", ""}, {"Lamp"}), IsBadInput("2 services named Lamp"));
  EXPECT_THAT(addGroup(homes_, {"G", ""}, {"Floor lamp/8", "Box/8"}), IsBadInput("no service"));
  for (const char* setting : {"power on", "Box/8 power on", "Floor lamp/8 hue 5"}) {
    EXPECT_THAT(addScene(homes_, {"S", "Beach House"}, {setting}, vocabulary_, true),
                IsBadInput(""));
  }
  expectUnchanged();
}

}  // namespace
}  // namespace nidus
