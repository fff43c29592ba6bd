#include "nidus/HomeEditing/HomeRemoval.h"

#include "HomePlatform/Store/HomeChecks.h"
#include "nidus/HomeEditing/SampleHomes.h"

namespace nidus {
namespace {

using ::testing::IsEmpty;
using ::testing::SizeIs;

struct RemovalCase {
  ObjectWords words;
  const char* what;
};

TEST(RemoveObjectTest, SaysWhatElseIsTouched) {
  const RemovalCase table[] = {
      {{ObjectKind::home, "Beach House", ""},
       "the home Beach House, with its 2 rooms and with its 2 accessories"},
      {{ObjectKind::home, "Cottage", ""}, "the home Cottage, with its 1 room"},
      {{ObjectKind::room, "Kitchen", "Beach House"},
       "the room Kitchen of Beach House, putting its 1 accessory into no room and taking it out of "
       "1 zone"},
      {{ObjectKind::room, "Study", ""}, "the room Study of Beach House"},
      {{ObjectKind::zone, "Downstairs", ""}, "the zone Downstairs of Beach House"},
      {{ObjectKind::accessory, "Ceiling lamp", ""},
       "the accessory Ceiling lamp of Beach House, with its 1 service, taking it out of 1 group "
       "and "
       "dropping 2 actions of scenes"},
      {{ObjectKind::service, "Floor lamp/Lamp", ""},
       "the service Floor lamp/Lamp of Beach House, dropping 1 action of scenes"},
      {{ObjectKind::group, "Corner", ""}, "the group Corner of Beach House"},
      {{ObjectKind::scene, "Night", ""}, "the scene Night of Beach House"},
      {{ObjectKind::trigger, "Sunset", ""}, "the trigger Sunset of Beach House"},
  };
  for (const RemovalCase& test : table) {
    auto homes = sampleHomes();
    EXPECT_THAT(removeObject(homes, test.words), IsDone(test.what));
    EXPECT_FALSE(checkHomes(homes, "homes")) << test.what;
    EXPECT_THAT(findObject(homes, test.words), IsBadInput("there is no ")) << test.what;
  }
}

TEST(RemoveObjectTest, KeepsTheAccessoriesOfARoom) {
  auto homes = sampleHomes();
  ASSERT_TRUE(removeObject(homes, {ObjectKind::room, kBeachKitchenID, ""}));
  EXPECT_THAT(homes[0].rooms, SizeIs(1));
  EXPECT_THAT(homes[0].zones[0].rooms, IsEmpty());
  ASSERT_THAT(homes[0].accessories, SizeIs(2));
  EXPECT_FALSE(homes[0].accessories[0].room);
  EXPECT_THAT(homes[1].rooms, SizeIs(1));
}

TEST(RemoveObjectTest, LeavesOtherServicesInGroupsAndScenes) {
  auto homes = sampleHomes();
  ASSERT_TRUE(removeObject(homes, {ObjectKind::accessory, "Floor lamp", ""}));
  EXPECT_THAT(homes[0].serviceGroups[0].services, SizeIs(1));
  EXPECT_THAT(homes[0].actionSets[0].actions, SizeIs(2));
}

TEST(RemoveObjectTest, KeepsTheObjectsOfAGroup) {
  auto homes = sampleHomes();
  ASSERT_TRUE(removeObject(homes, {ObjectKind::group, "Corner", ""}));
  ASSERT_TRUE(removeObject(homes, {ObjectKind::zone, "Downstairs", ""}));
  EXPECT_THAT(homes[0].accessories, SizeIs(2));
  EXPECT_THAT(homes[0].rooms, SizeIs(2));
}

TEST(RemoveObjectTest, RefusesAmbiguousNames) {
  auto homes = sampleHomes();
  EXPECT_THAT(removeObject(homes, {ObjectKind::room, "Kitchen", ""}), IsBadInput("2 rooms"));
  EXPECT_EQ(textOf(homes), textOf(sampleHomes()));
}

}  // namespace
}  // namespace nidus
