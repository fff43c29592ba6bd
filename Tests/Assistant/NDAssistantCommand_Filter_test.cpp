#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "Assistant/CommandTest.h"
#include "Support/TestTypes.h"

namespace nidus {
namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;

HomeObjectRecord record(std::string_view type, const NDString& name, const NDString& home) {
  HomeObjectRecord made;
  made.objectType = type;
  made.objectName = name;
  made.objectHome = home;
  made.objectIdentifier = NDURL::make("x-corvane-nidus", "local", "/object?id=" + name.str());
  return made;
}

HomeObjectRecord homeRecord(const NDString& name) {
  return record(VAHAEntityTypeHOMEValue, name, nullptr);
}

HomeObjectRecord roomRecord(const NDString& name, const NDString& zone = nullptr) {
  auto made = record(VAHAEntityTypeROOMValue, name, "Cottage");
  made.objectZone = zone;
  return made;
}

HomeObjectRecord serviceRecord(const NDString& name, const NDString& home = "Cottage") {
  auto made = record(VAHAEntityTypeSERVICEValue, name, home);
  made.objectServiceType = kLightService;
  made.objectCharacteristics = {kPower};
  return made;
}

HomeObjectRecord serviceInRoom(const NDString& name, const NDString& room) {
  auto made = serviceRecord(name);
  made.objectRoom = room;
  return made;
}

HomeObjectRecord serviceOfHome(const NDString& name, const NDString& home, const NDString& homeID) {
  auto made = serviceRecord(name, home);
  made.objectIdentifier =
      NDURL::make("x-corvane-nidus", "local", "/service?id=1&home=" + homeID.str());
  return made;
}

std::vector<std::string> names(const NDAssistantCommand::ObjectList& objects) {
  std::vector<std::string> made;
  for (const HomeObjectRecord* object : objects) made.push_back(object->objectName.str());
  return made;
}

/// Filters hand-made snapshots.
class FilterTest : public CommandTest {
 protected:
  void snapshot(HomeObjectRecords records) {
    command_->setNidusObjects(std::move(records));
    command_->setMetadata(NDNAPMetadata::getSharedInstance());
  }

  void primaryHome(const NDString& name, const NDString& identifier) {
    command_->setPrimaryHomeName(name);
    command_->setPrimaryHomeID(identifier);
  }

  /// The names that a search leaves; "null" alone when it gives no list.
  std::vector<std::string> find(const Search& search, const NDString& homeName = nullptr) {
    const auto found = command_->objectsWithSearchFilter_inHome(*searchFilter(search), homeName);
    return found ? names(*found) : std::vector<std::string>{"null"};
  }

  std::shared_ptr<NDAssistantCommand> command_ = makeCommand(Search(), {});
};

TEST_F(FilterTest, KeepsEverythingWithoutFields) {
  snapshot({homeRecord("Cottage"), roomRecord("Hall"), serviceRecord("Lamp")});
  EXPECT_THAT(find({}), ElementsAre("Cottage", "Hall", "Lamp"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: "));
}

TEST_F(FilterTest, KeepsObjectsOfTheHome) {
  snapshot({homeRecord("Cottage"), serviceRecord("Lamp"), homeRecord("Flat"),
            serviceRecord("Fan", "Flat"), serviceRecord("Heater")});
  EXPECT_THAT(find({}, "Cottage"), ElementsAre("Lamp", "Heater"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: home=Cottage/"));
}

TEST_F(FilterTest, ComparesHomeNamesExactly) {
  snapshot({serviceRecord("Lamp", "Chalet"), serviceRecord("Fan", "chalet"),
            serviceRecord("Heater", "ch\u00e2let")});
  EXPECT_THAT(find({}, "chalet"), ElementsAre("Fan"));
}

TEST_F(FilterTest, FindsNothingInUnknownHome) {
  snapshot({homeRecord("Cottage"), serviceRecord("Lamp")});
  EXPECT_THAT(find({.room = "Hall"}, "Castle"), IsEmpty());
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: home=Castle/"));
}

TEST_F(FilterTest, WritesNoPieceOnEmptySnapshot) {
  EXPECT_THAT(find({.attribute = "POWER", .room = "Hall"}, "Cottage"), IsEmpty());
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: "));
}

TEST_F(FilterTest, TellsHomesOfOneNameApartByTheirID) {
  snapshot({homeRecord("Home"), serviceOfHome("Lamp", "Home", "9E01-AB"), homeRecord("Home"),
            serviceOfHome("Fan", "Home", "77-CD"), serviceOfHome("Bulb", "Home", "9e01-ab")});
  primaryHome("Home", "9E01-AB");
  EXPECT_THAT(find({}, "Home"), ElementsAre("Lamp", "Bulb"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: home=Home/"));
}

TEST_F(FilterTest, KeepsTheHomeItselfWhenHomesShareAName) {
  auto primary = homeRecord("Home");
  primary.objectIdentifier = NDURL::make("x-corvane-nidus", "local", "/home?id=9E01-AB");
  snapshot({primary, homeRecord("Home")});
  primaryHome("Home", "9E01-AB");
  EXPECT_EQ(find({}, "Home").size(), 1U);
}

TEST_F(FilterTest, FindsNoListWithoutPrimaryHomeOfTheName) {
  logLevel(4);
  snapshot({homeRecord("Home"), homeRecord("Home"), serviceRecord("Lamp", "Home")});
  primaryHome("Flat", "9E01-AB");
  EXPECT_THAT(find({}, "Home"), ElementsAre("null"));
  EXPECT_THAT(log(), ElementsAre("4 Multiple homes with same name but no primary home"));
}

TEST_F(FilterTest, FindsNoListWithoutAnyPrimaryHome) {
  snapshot({homeRecord("Home"), homeRecord("Home")});
  EXPECT_THAT(find({}, "Home"), ElementsAre("null"));
}

TEST_F(FilterTest, CountsHomesOnlyAsHomes) {
  snapshot({homeRecord("Home"), roomRecord("Home"), serviceRecord("Home", "Home")});
  EXPECT_THAT(find({}, "Home"), ElementsAre("Home"));
}

TEST_F(FilterTest, TakesAttributeForServices) {
  auto dimmer = serviceRecord("Dimmer");
  dimmer.objectCharacteristics = {kPower, kBrightness};
  snapshot({homeRecord("Cottage"), roomRecord("Hall"), serviceRecord("Lamp"), dimmer});
  EXPECT_THAT(find({.attribute = "BRIGHTNESS"}), ElementsAre("Dimmer"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: attribute=BRIGHTNESS/"));
}

TEST_F(FilterTest, LogsEntityTypeBesideAttribute) {
  snapshot({homeRecord("Cottage"), serviceRecord("Lamp")});
  EXPECT_THAT(find({.entityType = "SERVICE", .attribute = "POWER"}), ElementsAre("Lamp"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: attribute=POWER/entity=SERVICE/"));
}

TEST_F(FilterTest, WarnsOfAttributeOfOtherEntityType) {
  snapshot({roomRecord("Hall"), serviceRecord("Lamp")});
  const Search search{.entityType = "ROOM", .attribute = "POWER"};
  EXPECT_THAT(find(search), IsEmpty());
  EXPECT_THAT(log(),
              ElementsAre("4 Attribute specified in search filter with entityType not SERVICE(" +
                              searchFilter(search)->description() + ")",
                          "6 Incoming Filter: attribute=POWER/entity=ROOM/"));
}

TEST_F(FilterTest, WarnsWithoutTellingTheFilter) {
  logLevel(4);
  snapshot({roomRecord("Hall"), serviceRecord("Lamp")});
  EXPECT_THAT(find({.entityType = "ROOM", .attribute = "POWER"}), IsEmpty());
  EXPECT_EQ(log().size(), 1U);
}

TEST_F(FilterTest, NarrowsToEntityTypeWithoutLoggingIt) {
  snapshot({homeRecord("Cottage"), roomRecord("Hall"), serviceRecord("Lamp")});
  EXPECT_THAT(find({.entityType = "ROOM"}), ElementsAre("Hall"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: "));
}

TEST_F(FilterTest, ListsAssociatedServicesFirstAndTwice) {
  auto outlet = serviceRecord("Outlet");
  outlet.objectServiceType = kOutletService;
  outlet.objectAssociatedServiceType = kLightService;
  auto both = serviceRecord("Both");
  both.objectAssociatedServiceType = kLightService;
  snapshot({serviceRecord("Lamp"), both, outlet});
  EXPECT_THAT(find({.serviceType = "LIGHT"}), ElementsAre("Both", "Outlet", "Lamp", "Both"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: serviceType=LIGHT/"));
}

TEST_F(FilterTest, FindsNoListForUnknownServiceType) {
  snapshot({serviceRecord("Lamp")});
  EXPECT_THAT(find({.serviceType = "WARP_DRIVE"}), ElementsAre("null"));
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(FilterTest, DoesNotMapServiceTypeOfNothing) {
  snapshot({serviceRecord("Lamp")});
  EXPECT_THAT(find({.entityType = "ZONE", .serviceType = "WARP_DRIVE"}), IsEmpty());
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: "));
}

TEST_F(FilterTest, MatchesRoomWithoutItsAccents) {
  snapshot({roomRecord("Caf\u00e9"), roomRecord("cafe"), serviceInRoom("Lamp", "Caf\u00e9"),
            serviceInRoom("Fan", "cafe"), serviceInRoom("Heater", "Cafe\u0301")});
  EXPECT_THAT(find({.room = "Cafe"}), ElementsAre("Lamp", "Heater"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: room=Cafe/"));
}

TEST_F(FilterTest, FindsRoomsOfNoASCII) {
  snapshot({roomRecord("\u53f0\u6240"), serviceInRoom("Lamp", "\u53f0\u6240"),
            serviceInRoom("Fan", "\u6240")});
  EXPECT_THAT(find({.room = "\u53f0\u6240"}), ElementsAre("Lamp"));
}

TEST_F(FilterTest, WritesZoneBeforeRoom) {
  snapshot({roomRecord("Hall", "Upstairs"), serviceInRoom("Lamp", "Hall")});
  EXPECT_THAT(find({.room = "Hall", .zone = "Upstairs"}), ElementsAre("Lamp"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: zone=Upstairs/room=Hall/"));
}

TEST_F(FilterTest, FindsRoomsOfZoneWithoutItsAccents) {
  snapshot({roomRecord("Hall", "\u00c9tage"), roomRecord("Den"), roomRecord("Attic", "Etage"),
            serviceInRoom("Lamp", "Attic"), serviceInRoom("Fan", "Den"),
            serviceInRoom("Heater", "Hall")});
  EXPECT_THAT(find({.zone = "Etage"}), ElementsAre("Heater", "Lamp"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: zone=Etage/"));
}

TEST_F(FilterTest, NeedsRoomAndZoneTogether) {
  snapshot({roomRecord("Hall", "Upstairs"), roomRecord("Den", "Downstairs"),
            serviceInRoom("Lamp", "Hall"), serviceInRoom("Fan", "Den")});
  EXPECT_THAT(find({.room = "Den", .zone = "Upstairs"}), IsEmpty());
}

TEST_F(FilterTest, NeedsRoomRecord) {
  snapshot({serviceInRoom("Lamp", "Hall"), serviceRecord("Hall")});
  EXPECT_THAT(find({.room = "Hall"}), IsEmpty());
}

TEST_F(FilterTest, RepeatsObjectsForRoomsOfOneName) {
  snapshot({serviceInRoom("Lamp", "Hall"), serviceInRoom("Fan", "Hall"), roomRecord("Hall"),
            roomRecord("Hall")});
  EXPECT_THAT(find({.room = "Hall"}), ElementsAre("Lamp", "Fan", "Lamp", "Fan"));
}

TEST_F(FilterTest, LooksRoomsUpInEveryHome) {
  auto lamp = serviceInRoom("Lamp", "Hall");
  auto otherRoom = roomRecord("Hall");
  otherRoom.objectHome = "Flat";
  snapshot({homeRecord("Cottage"), lamp, homeRecord("Flat"), otherRoom});
  EXPECT_THAT(find({.room = "Hall"}, "Cottage"), ElementsAre("Lamp"));
}

TEST_F(FilterTest, GoesRoomByRoom) {
  snapshot({roomRecord("Den", "Ground"), roomRecord("Hall", "Ground"),
            serviceInRoom("Lamp", "Hall"), serviceInRoom("Fan", "Den"),
            serviceInRoom("Heater", "Hall")});
  const auto found =
      command_->filterObjects_forRoom_andZone(command_->allObjects(), nullptr, "Ground");
  EXPECT_THAT(names(found), ElementsAre("Fan", "Lamp", "Heater"));
}

TEST_F(FilterTest, TellsMixedRoomsApart) {
  snapshot({roomRecord("Hall", "Ground"), roomRecord("Attic", "Top"), roomRecord("Den", "Ground"),
            serviceInRoom("Lamp", "Hall"), serviceInRoom("Fan", "Attic"),
            serviceInRoom("Radio", nullptr), serviceInRoom("Heater", "H\u00e0ll"),
            serviceInRoom("Blind", "Den"), serviceInRoom("Vent", "hall"),
            serviceInRoom("Lock", "Hall")});
  const auto kept =
      command_->filterObjects_forRoom_andZone(command_->allObjects(), nullptr, "Ground");
  EXPECT_THAT(names(kept), ElementsAre("Lamp", "Heater", "Lock", "Blind"));
}

TEST_F(FilterTest, FindsObjectsOfOneRoomThatShareItsName) {
  const NDString hall = "Hall";
  const NDString attic = "Attic";
  snapshot({roomRecord(hall), roomRecord(attic), serviceInRoom("Lamp", attic),
            serviceInRoom("Fan", attic), serviceInRoom("Heater", hall),
            serviceInRoom("Radio", nullptr), serviceInRoom("Blind", hall)});
  const auto kept =
      command_->filterObjects_forRoom_andZone(command_->allObjects(), "Hall", nullptr);
  EXPECT_THAT(names(kept), ElementsAre("Heater", "Blind"));
}

TEST_F(FilterTest, FindsObjectsOfEveryRoomWithoutNames) {
  snapshot({roomRecord("Hall"), serviceInRoom("Lamp", "Hall"), serviceRecord("Fan")});
  const auto found =
      command_->filterObjects_forRoom_andZone(command_->allObjects(), nullptr, nullptr);
  EXPECT_THAT(names(found), ElementsAre("Lamp"));
}

TEST_F(FilterTest, FindsNothingInRoomsWithoutName) {
  snapshot({roomRecord(nullptr, "Ground"), serviceInRoom("Lamp", ""), serviceRecord("Fan")});
  EXPECT_THAT(find({.zone = "Ground"}), IsEmpty());
}

TEST_F(FilterTest, ObjectWithoutRoomIsInNoRoom) {
  snapshot({roomRecord(""), serviceInRoom("Lamp", ""), serviceRecord("Fan")});
  EXPECT_THAT(find({.room = ""}), ElementsAre("Lamp"));
}

TEST_F(FilterTest, LooksRoomsUpInTheSnapshotNotTheList) {
  snapshot({roomRecord("Hall"), serviceInRoom("Lamp", "Hall"), serviceInRoom("Fan", "Hall")});
  const NDAssistantCommand::ObjectList list = {&command_->nidusObjects()[2],
                                               &command_->nidusObjects()[2]};
  EXPECT_THAT(names(command_->filterObjects_forRoom_andZone(list, "Hall", nullptr)),
              ElementsAre("Fan", "Fan"));
}

TEST_F(FilterTest, ComparesGroupNamesExactly) {
  auto lamp = serviceRecord("Lamp");
  lamp.objectGroups = {"Evening", "So\u0301le"};
  auto fan = serviceRecord("Fan");
  fan.objectGroups = {"evening", "Sole"};
  snapshot({lamp, fan, serviceRecord("Heater")});
  EXPECT_THAT(find({.group = "Evening"}), ElementsAre("Lamp"));
  EXPECT_THAT(find({.group = "Sole"}), ElementsAre("Fan"));
  EXPECT_THAT(log(), Contains("6 Incoming Filter: group=Evening/"));
}

TEST_F(FilterTest, MatchesServiceNameWithoutAccents) {
  snapshot({serviceRecord("Th\u00e9i\u00e8re"), serviceRecord("theiere"), serviceRecord("Theiere"),
            serviceRecord(nullptr)});
  EXPECT_THAT(find({.service = "Theiere"}), ElementsAre("Th\u00e9i\u00e8re", "Theiere"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: service=Theiere/"));
}

TEST_F(FilterTest, MatchesSceneNameWithoutAccents) {
  snapshot({record(VAHAEntityTypeSCENEValue, "Caf\u00e9", "Cottage"),
            record(VAHAEntityTypeSCENEValue, "caf\u00e9", "Cottage")});
  EXPECT_THAT(find({.scene = "Cafe"}), ElementsAre("Caf\u00e9"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: scene=Cafe/"));
}

TEST_F(FilterTest, AppliesAllFieldsInOrder) {
  auto lamp = serviceInRoom("Lamp", "Hall");
  lamp.objectGroups = {"Evening"};
  snapshot({homeRecord("Cottage"), lamp, roomRecord("Hall", "Upstairs")});
  EXPECT_THAT(find({.entityType = "SERVICE",
                    .attribute = "POWER",
                    .serviceType = "LIGHT",
                    .room = "Hall",
                    .zone = "Upstairs",
                    .group = "Evening",
                    .service = "Lamp",
                    .scene = "Lamp"},
                   "Cottage"),
              ElementsAre("Lamp"));
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: home=Cottage/attribute=POWER/entity=SERVICE/"
                                 "serviceType=LIGHT/zone=Upstairs/room=Hall/group=Evening/"
                                 "service=Lamp/scene=Lamp/"));
}

TEST_F(FilterTest, StopsWhereNothingIsLeft) {
  snapshot({serviceRecord("Lamp")});
  EXPECT_THAT(find({.group = "Evening", .service = "Lamp"}), IsEmpty());
  EXPECT_THAT(log(), ElementsAre("6 Incoming Filter: group=Evening/"));
}

TEST_F(FilterTest, LogsNothingBelowItsLevel) {
  logLevel(5);
  snapshot({serviceRecord("Lamp")});
  EXPECT_THAT(find({.service = "Lamp"}), ElementsAre("Lamp"));
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(FilterTest, WarnsOfNothingBelowItsLevel) {
  logLevel(3);
  snapshot({homeRecord("Home"), homeRecord("Home"), serviceRecord("Lamp")});
  EXPECT_THAT(find({}, "Home"), ElementsAre("null"));
  EXPECT_THAT(find({.entityType = "ROOM", .attribute = "POWER"}), IsEmpty());
  EXPECT_THAT(log(), IsEmpty());
}

TEST_F(FilterTest, ByAttributeKeepsServicesOfTheReadType) {
  auto thermostat = serviceRecord("Thermostat");
  thermostat.objectCharacteristics = {kCurrentTemperature};
  auto written = serviceRecord("Radiator");
  written.objectCharacteristics = {kTargetTemperature};
  auto room = roomRecord("Hall");
  room.objectCharacteristics = {kCurrentTemperature};
  snapshot({thermostat, written, room, thermostat});
  EXPECT_THAT(names(command_->filterObjects_byAttribute(command_->allObjects(), "TEMPERATURE")),
              ElementsAre("Thermostat", "Thermostat"));
}

TEST_F(FilterTest, ByAttributeKeepsNothingForUnmapped) {
  snapshot({serviceRecord("Lamp")});
  EXPECT_THAT(command_->filterObjects_byAttribute(command_->allObjects(), "TASTE"), IsEmpty());
  EXPECT_THAT(command_->filterObjects_byAttribute(command_->allObjects(), nullptr), IsEmpty());
  command_->setMetadata(nullptr);
  EXPECT_THAT(command_->filterObjects_byAttribute(command_->allObjects(), "POWER"), IsEmpty());
}

TEST_F(FilterTest, IdentifiersFindNothing) {
  snapshot({homeRecord("Cottage"), serviceRecord("Lamp")});
  std::vector<NDURL> identifiers;
  for (const auto& object : command_->nidusObjects()) {
    identifiers.push_back(object.objectIdentifier);
  }
  EXPECT_THAT(command_->objectsWithIdentifierList(identifiers), IsEmpty());
  EXPECT_THAT(command_->objectsWithIdentifierList({}), IsEmpty());
  EXPECT_THAT(log(), IsEmpty());
}

/// Keeps what it is told of the steps.
class StepObserver final : public NDAssistantCommandObserver {
 public:
  void filterDidRunStep(std::string_view step, const NDDictionaryList& kept) override {
    steps.emplace_back(step, kept.size());
    last = kept;
  }
  void actionDidReach(const std::vector<std::shared_ptr<NDCharacteristic>>& /*reached*/) override {}

  std::vector<std::pair<std::string, std::size_t>> steps;
  NDDictionaryList last;
};

/// The same with an observer.
class ObservedFilterTest : public FilterTest {
 protected:
  ObservedFilterTest() { command_ = makeCommand(Search(), {}, observer_); }
  const std::shared_ptr<StepObserver> observer_ = std::make_shared<StepObserver>();
};

TEST_F(ObservedFilterTest, HearsOfTheHomeAmongEqualNames) {
  snapshot({homeRecord("Home"), serviceOfHome("Lamp", "Home", "9E01-AB"), homeRecord("Home")});
  primaryHome("Home", "9E01-AB");
  static_cast<void>(find({}, "Home"));
  EXPECT_THAT(observer_->steps, ElementsAre(Pair("snapshot", 3), Pair("home", 1)));
}

TEST_F(ObservedFilterTest, HearsOfEachStepThatRan) {
  auto lamp = serviceInRoom("Lamp", "Hall");
  lamp.objectGroups = {"Evening"};
  snapshot({homeRecord("Cottage"), lamp, roomRecord("Hall"), serviceRecord("Fan")});
  static_cast<void>(find({.attribute = "POWER",
                          .serviceType = "LIGHT",
                          .room = "Hall",
                          .group = "Evening",
                          .service = "Lamp",
                          .scene = "Lamp"},
                         "Cottage"));
  EXPECT_THAT(observer_->steps,
              ElementsAre(Pair("snapshot", 4), Pair("home", 3), Pair("entityType", 2),
                          Pair("serviceType", 2), Pair("room and zone", 1), Pair("group", 1),
                          Pair("serviceName", 1), Pair("sceneName", 1), Pair("attribute", 1)));
  EXPECT_EQ(observer_->last, NDDictionaryList{NDDictionaryValue(lamp.dictionary())});
}

TEST_F(ObservedFilterTest, HearsNothingOfStepsNotReached) {
  snapshot({serviceRecord("Lamp")});
  static_cast<void>(find({.group = "Evening", .service = "Lamp"}));
  EXPECT_THAT(observer_->steps, ElementsAre(Pair("snapshot", 1), Pair("group", 0)));
}

}  // namespace
}  // namespace nidus
