#include "Assistant/Entities.h"

#include <gmock/gmock.h>

#include <string>

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "Support/PlatformTest.h"
#include "Support/TestTypes.h"

namespace nidus {
namespace {

using ::testing::MatchesRegex;

/// The fields of an entity but its identifier: name, entity type, service type, room, home, zone.
std::string textOf(const VAHAEntity& entity) {
  std::string text;
  for (const NDString& field : {entity.name(), entity.entityType(), entity.serviceType(),
                                entity.room(), entity.home(), entity.zone()}) {
    text += (text.empty() ? "" : ", ") + (field ? field.str() : "-");
  }
  return text;
}

class EntitiesTest : public PlatformTest {
 protected:
  static HomeObjectRecord serviceRecord(const NDString& room) {
    HomeObjectRecord record;
    record.objectType = VAHAEntityTypeSERVICEValue;
    record.objectName = "Lamp";
    record.objectHome = "Beach House";
    record.objectRoom = room;
    record.objectServiceType = kLightService;
    return record;
  }
};

TEST_F(EntitiesTest, ServiceRecordHasARoom) {
  EXPECT_EQ(textOf(*entityFromObject(serviceRecord("Kitchen"))),
            "Lamp, SERVICE, LIGHT, Kitchen, Beach House, -");
}

TEST_F(EntitiesTest, RoomOfTheHomesNameIsLeftOut) {
  EXPECT_EQ(textOf(*entityFromObject(serviceRecord("Beach House"))),
            "Lamp, SERVICE, LIGHT, -, Beach House, -");
  EXPECT_EQ(textOf(*entityFromObject(serviceRecord("beach house"))),
            "Lamp, SERVICE, LIGHT, beach house, Beach House, -");
}

TEST_F(EntitiesTest, ServiceRecordWithoutRoomHasNone) {
  EXPECT_EQ(textOf(*entityFromObject(serviceRecord(nullptr))),
            "Lamp, SERVICE, LIGHT, -, Beach House, -");
}

TEST_F(EntitiesTest, UnknownServiceTypeIsCustom) {
  HomeObjectRecord record = serviceRecord("Kitchen");
  record.objectServiceType = kUnknownService;
  EXPECT_EQ(entityFromObject(record)->serviceType(), "CUSTOM");
}

TEST_F(EntitiesTest, RoomRecordHasNoRoomOrServiceType) {
  HomeObjectRecord record = serviceRecord("Kitchen");
  record.objectType = VAHAEntityTypeROOMValue;
  record.objectZone = "Ground floor";
  EXPECT_EQ(textOf(*entityFromObject(record)), "Lamp, ROOM, -, -, Beach House, Ground floor");
}

TEST_F(EntitiesTest, EmptyRecordLeavesFieldsUnset) {
  EXPECT_EQ(textOf(*entityFromObject({})), "-, -, -, -, -, -");
}

TEST_F(EntitiesTest, EachEntityHasAnIdentifierOfItsOwn) {
  const HomeObjectRecord record = serviceRecord("Kitchen");
  const NDString first = entityFromObject(record)->identifier().text();
  EXPECT_NE(first, entityFromObject(record)->identifier().text());
  EXPECT_THAT(first.str(), MatchesRegex("x-corvane-nidus://local/[0-9A-F]{8}-[0-9A-F]{4}-"
                                        "[0-9A-F]{4}-[0-9A-F]{4}-[0-9A-F]{12}"));
  EXPECT_EQ(first.view().size(), 60U);  // with nothing behind a zero, which ends what is matched
}

TEST_F(EntitiesTest, ServiceTypeThatWasAskedForWins) {
  struct Case {
    const char* label;
    std::string_view serviceType;
    const char* asked;
    const char* expected;
  };
  const Case cases[] = {{"nothing asked", kLightService, nullptr, "LIGHT"},
                        {"the same asked", kLightService, "LIGHT", "LIGHT"},
                        {"another asked", kLightService, "OUTLET", "OUTLET"},
                        {"unknown", kUnknownService, nullptr, "CUSTOM"},
                        {"unknown, asked", kUnknownService, "FAN", "FAN"}};
  for (const Case& each : cases) {
    SCOPED_TRACE(each.label);
    const auto home =
        HomeBuilder("Cabin").accessory("Box").service("Lamp", each.serviceType, {}).build();
    EXPECT_EQ(entityFromService(home->service("Lamp"), each.asked)->serviceType(), each.expected);
  }
}

TEST_F(EntitiesTest, ServiceIsInItsAccessorysRoom) {
  const auto home = HomeBuilder("Cabin")
                        .room("Kitchen")
                        .light("Lamp")
                        .room("Cabin")
                        .light("Fan")
                        .zone("Ground floor", {"Kitchen"})
                        .build();
  EXPECT_EQ(textOf(*entityFromService(home->service("Lamp"), nullptr)),
            "Lamp, SERVICE, LIGHT, Kitchen, Cabin, -");
  EXPECT_EQ(textOf(*entityFromService(home->service("Fan"), nullptr)),
            "Fan, SERVICE, LIGHT, -, Cabin, -");
}

TEST_F(EntitiesTest, ServiceHasAFreshIdentifier) {
  const auto home = HomeBuilder("Cabin").light("Lamp").build();
  const auto identifier = [&home] {
    return entityFromService(home->service("Lamp"), nullptr)->identifier().text();
  };
  EXPECT_NE(identifier(), identifier());
}

TEST_F(EntitiesTest, ActionSetHasNameAndType) {
  const auto home = HomeBuilder("Cabin").scene("Good night").build();
  const auto entity = entityFromActionSet(home->scene("Good night"));
  EXPECT_EQ(textOf(*entity), "Good night, SCENE, -, -, -, -");
  EXPECT_NE(entity->identifier().text(),
            entityFromActionSet(home->scene("Good night"))->identifier().text());
}

TEST_F(EntitiesTest, TriggerHasNameAndType) {
  const auto home = HomeBuilder("Cabin").trigger("Sunset").build();
  const auto entity = entityFromTrigger(home->trigger("Sunset"));
  EXPECT_EQ(textOf(*entity), "Sunset, TRIGGER, -, -, -, -");
  EXPECT_NE(entity->identifier().text(),
            entityFromTrigger(home->trigger("Sunset"))->identifier().text());
}

TEST_F(EntitiesTest, AbsentObjectsLeaveFieldsUnset) {
  EXPECT_EQ(textOf(*entityFromService(nullptr, nullptr)), "-, SERVICE, CUSTOM, -, -, -");
  EXPECT_EQ(textOf(*entityFromActionSet(nullptr)), "-, SCENE, -, -, -, -");
  EXPECT_EQ(textOf(*entityFromTrigger(nullptr)), "-, TRIGGER, -, -, -, -");
}

}  // namespace
}  // namespace nidus
