#include "nidus/HomeEditing/HomeMoving.h"

#include "HomePlatform/Store/HomeChecks.h"
#include "nidus/HomeEditing/SampleHomes.h"

namespace nidus {
namespace {

using ::testing::IsEmpty;
using ::testing::SizeIs;

const ObjectWords kFloorLamp{ObjectKind::accessory, "Floor lamp", ""};
const ObjectWords kStudy{ObjectKind::room, "Study", ""};
const ObjectWords kBeachKitchen{ObjectKind::room, "Kitchen", "Beach House"};
const ObjectWords kFloorLight{ObjectKind::service, "Floor lamp/Lamp", ""};
const ObjectWords kCeilingLight{ObjectKind::service, "Ceiling lamp/Lamp", ""};

TEST(MoveAccessoryTest, GoesIntoARoom) {
  auto homes = sampleHomes();
  EXPECT_THAT(moveAccessory(homes, kFloorLamp, "Kitchen"),
              IsDone("moved the accessory Floor lamp of Beach House into the room Kitchen"));
  EXPECT_EQ(homes[0].accessories[1].room, homes[0].rooms[0].uuid);
}

TEST(MoveAccessoryTest, GoesIntoNoRoom) {
  auto homes = sampleHomes();
  EXPECT_THAT(moveAccessory(homes, {ObjectKind::accessory, "Ceiling lamp", ""}, ""),
              IsDone("moved the accessory Ceiling lamp of Beach House into no room"));
  EXPECT_FALSE(homes[0].accessories[0].room);
}

TEST(MoveAccessoryTest, StaysInItsHome) {
  auto homes = sampleHomes();
  EXPECT_THAT(moveAccessory(homes, kFloorLamp, kCottageKitchenID), IsBadInput("there is no room"));
  EXPECT_THAT(moveAccessory(homes, {ObjectKind::accessory, "Desk lamp", ""}, "Kitchen"),
              IsBadInput("there is no accessory Desk lamp"));
  EXPECT_EQ(textOf(homes), textOf(sampleHomes()));
}

TEST(MoveRoomTest, JoinsAZone) {
  auto homes = sampleHomes();
  EXPECT_THAT(moveRoom(homes, kStudy, {"", "Upstairs"}),
              IsDone("moved the room Study of Beach House into the zone Upstairs"));
  EXPECT_THAT(homes[0].zones[1].rooms, ::testing::ElementsAre(homes[0].rooms[1].uuid));
}

TEST(MoveRoomTest, ChangesZones) {
  auto homes = sampleHomes();
  EXPECT_THAT(moveRoom(homes, kBeachKitchen, {"Downstairs", "Upstairs"}),
              IsDone("moved the room Kitchen of Beach House out of the zone Downstairs into the "
                     "zone Upstairs"));
  EXPECT_THAT(homes[0].zones[0].rooms, IsEmpty());
  EXPECT_THAT(homes[0].zones[1].rooms, SizeIs(1));
}

TEST(MoveRoomTest, RefusesWhatMakesNoSense) {
  auto homes = sampleHomes();
  EXPECT_THAT(moveRoom(homes, kStudy, {"", ""}), IsBadInput("--to-zone, --from-zone or both"));
  EXPECT_THAT(moveRoom(homes, kStudy, {"Downstairs", ""}),
              IsBadInput("Study of Beach House is not in the zone Downstairs"));
  EXPECT_THAT(moveRoom(homes, kBeachKitchen, {"", "Downstairs"}),
              IsBadInput("is in the zone Downstairs already"));
  EXPECT_THAT(moveRoom(homes, kStudy, {"", "Attic"}), IsBadInput("there is no zone Attic"));
  EXPECT_THAT(moveRoom(homes, kStudy, {"Attic", ""}), IsBadInput("there is no zone Attic"));
  EXPECT_THAT(moveRoom(homes, {ObjectKind::room, "Attic", ""}, {"", "Upstairs"}),
              IsBadInput("there is no room Attic"));
  EXPECT_EQ(textOf(homes), textOf(sampleHomes()));
}

TEST(MoveServiceTest, ChangesGroups) {
  auto homes = sampleHomes();
  EXPECT_THAT(moveService(homes, kCeilingLight, {"Corner", "Rest"}),
              IsDone("moved the service Ceiling lamp/Lamp of Beach House out of the group Corner "
                     "into the group Rest"));
  EXPECT_THAT(homes[0].serviceGroups[0].services, IsEmpty());
  EXPECT_THAT(homes[0].serviceGroups[1].services, SizeIs(1));
  EXPECT_FALSE(checkHomes(homes, "homes"));
}

TEST(MoveServiceTest, RefusesWhatMakesNoSense) {
  auto homes = sampleHomes();
  EXPECT_THAT(moveService(homes, kFloorLight, {"", ""}), IsBadInput("--to-group"));
  EXPECT_THAT(moveService(homes, kFloorLight, {"Corner", ""}), IsBadInput("is not in the group"));
  EXPECT_THAT(moveService(homes, kCeilingLight, {"", "Corner"}), IsBadInput("already"));
  EXPECT_THAT(moveService(homes, {ObjectKind::service, "Lamp", ""}, {"", "Corner"}),
              IsBadInput("2 services named Lamp"));
  EXPECT_EQ(textOf(homes), textOf(sampleHomes()));
}

}  // namespace
}  // namespace nidus
