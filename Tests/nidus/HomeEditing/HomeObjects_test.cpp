#include "nidus/HomeEditing/HomeObjects.h"

#include "nidus/HomeEditing/SampleHomes.h"

namespace nidus {
namespace {

using ::testing::AllOf;

struct FindCase {
  ObjectWords words;
  const char* description;
};

TEST(FindObjectTest, FindsByNameUUIDAndPath) {
  const FindCase table[] = {
      {{ObjectKind::home, "Cottage", ""}, "the home Cottage"},
      {{ObjectKind::home, kBeachHouseID, ""}, "the home Beach House"},
      {{ObjectKind::home, "aa000000-0000-4000-8000-000000000009", ""}, "the home Cottage"},
      {{ObjectKind::room, "Study", ""}, "the room Study of Beach House"},
      {{ObjectKind::room, "Kitchen", "Cottage"}, "the room Kitchen of Cottage"},
      {{ObjectKind::room, "Kitchen", kBeachHouseID}, "the room Kitchen of Beach House"},
      {{ObjectKind::room, kCottageKitchenID, ""}, "the room Kitchen of Cottage"},
      {{ObjectKind::zone, "Upstairs", ""}, "the zone Upstairs of Beach House"},
      {{ObjectKind::accessory, "Floor lamp", ""}, "the accessory Floor lamp of Beach House"},
      {{ObjectKind::service, "Floor lamp/Lamp", ""}, "the service Floor lamp/Lamp of Beach House"},
      {{ObjectKind::service, "Floor lamp/11", ""}, "the service Floor lamp/11 of Beach House"},
      {{ObjectKind::service, "dd000000-0000-4000-8000-000000000001/8", ""},
       "the service Ceiling lamp/Lamp of Beach House"},
      {{ObjectKind::group, "Corner", ""}, "the group Corner of Beach House"},
      {{ObjectKind::scene, "Night", ""}, "the scene Night of Beach House"},
      {{ObjectKind::trigger, "Sunset", "Beach House"}, "the trigger Sunset of Beach House"},
  };
  const auto homes = sampleHomes();
  for (const FindCase& test : table) {
    SCOPED_TRACE(test.description);
    const auto place = findObject(homes, test.words);
    ASSERT_TRUE(place) << place.failure().message;
    EXPECT_EQ(describe(homes, test.words.kind, *place), test.description);
  }
}

TEST(FindObjectTest, FindsNamesWithSlashes) {
  auto homes = sampleHomes();
  homes[0].accessories[0].name = "Up/down";
  homes[0].accessories[0].services[0].name = "On/off";
  for (const char* name : {"On/off", "Up/down/On/off", "Up/down/8"}) {
    EXPECT_TRUE(findObject(homes, {ObjectKind::service, name, ""})) << name;
  }
}

TEST(FindObjectTest, ListsAllOfOneName) {
  EXPECT_THAT(findObject(sampleHomes(), {ObjectKind::room, "Kitchen", ""}),
              AllOf(IsBadInput("2 rooms named Kitchen"), IsBadInput(kBeachKitchenID),
                    IsBadInput("Kitchen of Cottage ("), IsBadInput("--home")));
  EXPECT_THAT(findObject(sampleHomes(), {ObjectKind::service, "Lamp", ""}),
              AllOf(IsBadInput("Floor lamp/Lamp of Beach House"),
                    IsBadInput(std::string(kCeilingLampID) + "/8")));
}

TEST(FindObjectTest, ListsNoMoreThanAPersonReads) {
  auto homes = sampleHomes();
  for (RoomData room : std::vector(9, homes[1].rooms[0])) {
    room.uuid = NDUUID::random();
    homes[1].rooms.push_back(room);
  }
  const auto place = findObject(homes, {ObjectKind::room, "Kitchen", ""});
  EXPECT_THAT(place, AllOf(IsBadInput("there are 11 rooms"), IsBadInput(" and 3 more; say which")));
}

TEST(FindObjectTest, DoesNotOfferHomeForHomes) {
  auto homes = sampleHomes();
  homes[1].name = "Beach House";
  const auto place = findObject(homes, {ObjectKind::home, "Beach House", ""});
  ASSERT_THAT(place, IsBadInput("2 homes named Beach House"));
  EXPECT_THAT(place.failure().message, ::testing::Not(::testing::HasSubstr("--home")));
}

TEST(FindObjectTest, RefusesWhatIsNotThere) {
  const auto homes = sampleHomes();
  EXPECT_THAT(findObject(homes, {ObjectKind::room, "Attic", ""}),
              IsBadInput("there is no room Attic"));
  EXPECT_THAT(findObject(homes, {ObjectKind::room, "Study", "Cottage"}),
              IsBadInput("there is no room Study"));
  EXPECT_THAT(findObject(homes, {ObjectKind::room, "Study", "Castle"}),
              IsBadInput("there is no home Castle"));
  EXPECT_THAT(findObject(homes, {ObjectKind::service, "Floor lamp/12", ""}),
              IsBadInput("there is no service Floor lamp/12"));
}

TEST(FindObjectTest, SuggestsANearMiss) {
  const auto homes = sampleHomes();
  EXPECT_THAT(findObject(homes, {ObjectKind::room, "Kichen", ""}),
              IsBadInput("there is no room Kichen; did you mean Kitchen?"));
  EXPECT_THAT(findObject(homes, {ObjectKind::home, "Beach Hose", ""}),
              IsBadInput("did you mean Beach House?"));
  EXPECT_THAT(findObject(homes, {ObjectKind::service, "Flor lamp/Lamp", ""}),
              IsBadInput("did you mean Floor lamp/Lamp?"));
}

TEST(FindHomeTest, TakesTheOnlyOne) {
  auto homes = sampleHomes();
  EXPECT_THAT(findHome(homes, ""), IsBadInput("there are 2 homes; say which with --home"));
  homes.pop_back();
  EXPECT_EQ(*findHome(homes, ""), 0U);
  homes.pop_back();
  EXPECT_THAT(findHome(homes, ""), IsBadInput("nidus home add home NAME"));
}

TEST(CheckNameTest, RefusesEmptyAndBrokenNames) {
  EXPECT_FALSE(checkName("Café"));
  ASSERT_TRUE(checkName(""));
  const Status broken = checkName("Caf\xe9");
  ASSERT_TRUE(broken);
  EXPECT_THAT(broken->message, ::testing::HasSubstr("UTF-8"));
}

TEST(CheckNameTest, RefusesWhatNobodyCouldRead) {
  EXPECT_THAT(checkName("  ").value().message, ::testing::HasSubstr("blank"));
  for (const char* name : {"a\nb", "\x1b[31mred", "a\tb", "a\x7f", "a\xc2\x85"}) {
    const Status refused = checkName(name);
    ASSERT_TRUE(refused) << name;
    EXPECT_THAT(refused->message, ::testing::HasSubstr("control characters"));
  }
  EXPECT_FALSE(checkName("Café Corner 2"));
}

TEST(CountedTest, KnowsOneAndMany) {
  EXPECT_EQ(counted(1, ObjectKind::accessory), "1 accessory");
  EXPECT_EQ(counted(0, ObjectKind::accessory), "0 accessories");
}

}  // namespace
}  // namespace nidus
