#include "nidus/Doctor/DoctorTest.h"
#include "nidus/Doctor/Remedy.h"
#include "nidus/HomeDataBuilder.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::ElementsAre;
using ::testing::EndsWith;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;

using NamesCheckTest = DoctorCheckTest;

TEST_F(NamesCheckTest, FindsNothingWhereNamesDiffer) {
  examination_.homes = {HomeDataBuilder("Cottage").room("Kitchen").light("Lamp").build(),
                        HomeDataBuilder("Flat").room("kitchen").light("Lamp").build()};
  EXPECT_THAT(findingsOf(checkNames), IsEmpty());
}

TEST_F(NamesCheckTest, FindsHomesOfOneName) {
  examination_.homes = {HomeDataBuilder("Cottage").build(), HomeDataBuilder("Cottage").build()};
  const std::string second = (*examination_.homes)[1].uuid.UUIDString().str();
  EXPECT_THAT(findingsOf(checkNames),
              ElementsAre(NeedsAttention(
                  "Cottage", AllOf(HasSubstr("an order that names it fails"),
                                   EndsWith("; nidus home rename home " + second + " NEWNAME")))));
  examination_.homes->front().primary = true;
  EXPECT_THAT(findingsOf(checkNames),
              ElementsAre(NeedsAttention("Cottage", HasSubstr("for the primary one alone"))));
}

TEST_F(NamesCheckTest, FindsRoomsOfOneNameInTwoHomes) {
  examination_.homes = {HomeDataBuilder("Cottage").primary().room("Café").build(),
                        HomeDataBuilder("Flat").room("Cafe").build()};
  EXPECT_THAT(
      findingsOf(checkNames),
      ElementsAre(NeedsAttention(
          "Café", AllOf(HasSubstr("the rooms Cottage / Café and Flat / Cafe share their name"),
                        HasSubstr("each of its objects 2 times;")))));
  examination_.homes->front().primary = false;
  EXPECT_THAT(findingsOf(checkNames),
              ElementsAre(NeedsAttention("Café", HasSubstr("without a home it is for all"))));
}

TEST_F(NamesCheckTest, FindsARoomNamedLikeItsHome) {
  examination_.homes = {HomeDataBuilder("Cottage").room("Cottage").light("Lamp").build()};
  EXPECT_THAT(findingsOf(checkNames),
              ElementsAre(NeedsAttention("Cottage / Cottage", HasSubstr("in no room"))));
  examination_.homes = {HomeDataBuilder("Cottage").room("Cottage").build()};
  EXPECT_THAT(findingsOf(checkNames), IsEmpty());
}

TEST_F(NamesCheckTest, FindsZonesGroupsAndScenesOfOneName) {
  examination_.homes = {HomeDataBuilder("Cottage")
                            .zone("Uptown", {})
                            .zone("Uptówn", {})
                            .group("Corner", {})
                            .group("Corner", {})
                            .group("Cörner", {})
                            .scene("Night", {})
                            .scene("Night", {})
                            .build()};
  EXPECT_THAT(findingsOf(checkNames),
              ElementsAre(NeedsAttention("Uptown", HasSubstr("the rooms of all of them")),
                          NeedsAttention("Corner", AllOf(HasSubstr("the services of all of them"),
                                                         Not(HasSubstr("Cörner")))),
                          NeedsAttention("Night", HasSubstr("only the first"))));
}

TEST_F(NamesCheckTest, TellsServicesOfOneRoomFromThoseOfTwo) {
  examination_.homes = {
      HomeDataBuilder("Cottage").room("Hall").light("Lamp").light("Lamp").build()};
  const AccessoryData& second = examination_.homes->front().accessories[1];
  EXPECT_THAT(findingsOf(checkNames),
              ElementsAre(NeedsAttention(
                  "Lamp", AllOf(HasSubstr("the services Cottage / Hall / Lamp / Lamp and "),
                                HasSubstr("rename service " + second.uuid.UUIDString().str() +
                                          "/1 NEWNAME")))));
  examination_.homes = {
      HomeDataBuilder("Cottage").room("Hall").light("Lamp").room("Attic").light("Lamp").build()};
  EXPECT_THAT(findingsOf(checkNames),
              ElementsAre(IsNote("Lamp", HasSubstr("an order that names no room"))));
}

TEST_F(NamesCheckTest, AllowsOneNameForDifferentThings) {
  examination_.homes = {HomeDataBuilder("Cottage")
                            .light("Door")
                            .service("Door", serviceTypeOf("battery"))
                            .characteristic(characteristicTypeOf("battery-level"), nullptr)
                            .build()};
  EXPECT_THAT(findingsOf(checkNames), IsEmpty());
}

using AddressesCheckTest = DoctorCheckTest;

TEST_F(AddressesCheckTest, FindsNothingWrongWithALight) {
  examination_.homes = {HomeDataBuilder("Cottage").light("Lamp").build()};
  EXPECT_THAT(findingsOf(checkAddresses), IsEmpty());
}

TEST_F(AddressesCheckTest, FindsServicesWithoutKnownCharacteristics) {
  examination_.homes = {HomeDataBuilder("Cottage")
                            .accessory("Box")
                            .service("Empty", serviceTypeOf("light"))
                            .service("Odd", serviceTypeOf("light"))
                            .characteristic("odd", nullptr)
                            .build()};
  EXPECT_THAT(findingsOf(checkAddresses),
              ElementsAre(NeedsAttention("Cottage / Box / Empty", HasSubstr("no characteristics")),
                          NeedsAttention("Cottage / Box / Odd",
                                         AllOf(HasSubstr("such as odd, is in the vocabulary"),
                                               HasSubstr("vocabulary.json")))));
}

TEST_F(AddressesCheckTest, NotesServicesThatOnlyIdentify) {
  examination_.homes = {HomeDataBuilder("Cottage")
                            .accessory("Hub")
                            .service("Hub", "hub")
                            .characteristic(characteristicTypeOf("identify"), nullptr)
                            .build()};
  EXPECT_THAT(findingsOf(checkAddresses),
              ElementsAre(IsNote("Cottage / Hub / Hub", HasSubstr("identify itself"))));
}

TEST_F(AddressesCheckTest, FindsServicesWithoutAName) {
  examination_.homes = {HomeDataBuilder("Cottage")
                            .accessory("Box")
                            .service(nullptr, serviceTypeOf("light"))
                            .characteristic(characteristicTypeOf("power"), nullptr)
                            .build()};
  EXPECT_THAT(
      findingsOf(checkAddresses),
      ElementsAre(NeedsAttention("Cottage / Box / (no name)",
                                 AllOf(HasSubstr("it has no name"), HasSubstr("/1 NEWNAME")))));
}

TEST_F(AddressesCheckTest, FindsTypesThatNobodyKnows) {
  HomeData home = HomeDataBuilder("Cottage")
                      .accessory("Box")
                      .service("Box", "box")
                      .characteristic(characteristicTypeOf("power"), nullptr)
                      .build();
  examination_.homes = {home};
  EXPECT_THAT(findingsOf(checkAddresses),
              ElementsAre(NeedsAttention("Box", HasSubstr("its type box is not in the voc"))));
  home.accessories.front().services.front().associatedServiceType = serviceTypeOf("light");
  examination_.homes = {home};
  EXPECT_THAT(findingsOf(checkAddresses), IsEmpty());
}

class MetadataCheckTest : public DoctorCheckTest {
 protected:
  /// The findings about one characteristic of the given type.
  [[nodiscard]] Findings findingsOn(const char* type, NDValueRef value,
                                    const MetadataData& metadata) {
    examination_.homes = {
        HomeDataBuilder("Cottage")
            .light("Lamp")
            .characteristic(characteristicTypeOf(type), std::move(value), metadata)
            .build()};
    return findingsOf(checkMetadata);
  }
  static MetadataData limits(NDValueRef least, NDValueRef greatest, NDValueRef step = nullptr) {
    return {"int", "percentage", std::move(least), std::move(greatest), std::move(step)};
  }
  static NDValueRef integer(std::int64_t value) { return NDValue::integer(value); }
};

TEST_F(MetadataCheckTest, FindsNothingWithinTheLimits) {
  const MetadataData whole = limits(integer(0), integer(100), integer(1));
  EXPECT_THAT(findingsOn("brightness", integer(0), whole), IsEmpty());
  EXPECT_THAT(findingsOn("brightness", integer(100), whole), IsEmpty());
  EXPECT_THAT(findingsOn("brightness", nullptr, whole), IsEmpty());
  EXPECT_THAT(findingsOn("brightness", integer(7), {}), IsEmpty());
}

TEST_F(MetadataCheckTest, FindsValuesOutsideTheLimits) {
  const MetadataData tight = limits(integer(10), integer(20));
  EXPECT_THAT(findingsOn("brightness", integer(9), tight),
              ElementsAre(NeedsAttention("Cottage / Lamp / Lamp: BRIGHTNESS",
                                         HasSubstr("its value 9 is below its minimum 10"))));
  EXPECT_THAT(findingsOn("brightness", integer(21), tight),
              ElementsAre(NeedsAttention("BRIGHTNESS", HasSubstr("above its maximum 20"))));
}

TEST_F(MetadataCheckTest, FindsLimitsTheWrongWayRound) {
  EXPECT_THAT(findingsOn("brightness", nullptr, limits(integer(9), integer(8))),
              ElementsAre(NeedsAttention("BRIGHTNESS", HasSubstr("minimum 9 is above its max"))));
}

TEST_F(MetadataCheckTest, FindsStepsThatLeadNowhere) {
  for (const std::int64_t step : {0, -1}) {
    EXPECT_THAT(findingsOn("brightness", nullptr, limits(nullptr, nullptr, integer(step))),
                ElementsAre(NeedsAttention("BRIGHTNESS", HasSubstr("is not above zero"))));
  }
}

TEST_F(MetadataCheckTest, FindsUnitsThatDiffer) {
  EXPECT_THAT(
      findingsOn("current-temperature", nullptr, {"float", "fahrenheit", {}, {}, {}}),
      ElementsAre(NeedsAttention("TEMPERATURE", HasSubstr("its unit fahrenheit is not celsius"))));
  EXPECT_THAT(findingsOn("power", nullptr, {"bool", "percentage", {}, {}, {}}), IsEmpty());
}

TEST_F(MetadataCheckTest, ComparesFormatsWithTheVocabulary) {
  struct FormatCase {
    const char* type;
    const char* format;
    bool fits;
  };
  constexpr FormatCase kTable[] = {
      {"power", "bool", true},
      {"power", "uint8", true},
      {"power", "string", false},
      {"brightness", "int", true},
      {"brightness", "float", true},
      {"brightness", "bool", false},
      {"brightness", "string", false},
      {"swing", "bool", true},
      {"target-lock-state", "uint8", true},
      {"target-lock-state", "bool", false},
      {"air-quality", "string", false},
      {"power", "double", false},
      {"unheard-of", "string", true},
  };
  for (const FormatCase& row : kTable) {
    SCOPED_TRACE(std::string(row.type) + ' ' + row.format);
    const Findings findings = findingsOn(row.type, nullptr, {row.format, {}, {}, {}, {}});
    EXPECT_EQ(findings.empty(), row.fits);
  }
}

using RoomsCheckTest = DoctorCheckTest;

TEST_F(RoomsCheckTest, FindsNothingInUsedRooms) {
  examination_.homes = {
      HomeDataBuilder("Cottage").room("Kitchen").light("Lamp").zone("Down", {0}).build()};
  EXPECT_THAT(findingsOf(checkRooms), IsEmpty());
}

TEST_F(RoomsCheckTest, FindsZonesWithoutRooms) {
  examination_.homes = {HomeDataBuilder("Cottage").zone("Up There", {}).build()};
  const std::string zone = wordsOf(examination_.homes->front().zones[0]);
  EXPECT_THAT(findingsOf(checkRooms),
              ElementsAre(NeedsAttention(
                  "Cottage / Up There",
                  AllOf(HasSubstr("has no rooms"), EndsWith("nidus home remove zone " + zone)))));
}

TEST_F(RoomsCheckTest, FindsZonesThatLoseTheirRooms) {
  examination_.homes = {HomeDataBuilder("Cottage")
                            .room("Hall")
                            .light("A")
                            .room("Attic")
                            .light("B")
                            .zone("All", {0, 1})
                            .zone("Top", {1})
                            .build()};
  EXPECT_THAT(findingsOf(checkRooms),
              ElementsAre(NeedsAttention("Cottage / All", HasSubstr("does not reach Attic:"))));
}

TEST_F(RoomsCheckTest, AdvisesOnAllRoomsThatAreLost) {
  examination_.homes = {HomeDataBuilder("Cottage")
                            .room("Hall")
                            .light("A")
                            .room("Attic")
                            .light("B")
                            .zone("All", {0, 1})
                            .zone("Low", {0})
                            .zone("Top", {1})
                            .build()};
  const HomeData& home = examination_.homes->front();
  EXPECT_THAT(findingsOf(checkRooms),
              ElementsAre(NeedsAttention(
                  "Cottage / All",
                  EndsWith("nidus home move room " + wordsOf(home.rooms[0]) + " --from-zone " +
                           wordsOf(home.zones[1]) + " && nidus home move room " +
                           wordsOf(home.rooms[1]) + " --from-zone " + wordsOf(home.zones[2])))));
}

TEST_F(RoomsCheckTest, NotesRoomsWithoutAccessories) {
  examination_.homes = {HomeDataBuilder("Cottage").room("Hall").build()};
  const std::string room = wordsOf(examination_.homes->front().rooms[0]);
  EXPECT_THAT(findingsOf(checkRooms),
              ElementsAre(IsNote("Cottage / Hall", EndsWith("--to " + room))));
}

using TargetsCheckTest = DoctorCheckTest;

TEST_F(TargetsCheckTest, FindsNothingWhereOneCanBeReached) {
  examination_.homes = {HomeDataBuilder("Cottage")
                            .light("Lamp")
                            .light("Away")
                            .unreachable()
                            .group("Corner", {0, 1})
                            .scene("Night", {0, 1})
                            .build()};
  EXPECT_THAT(findingsOf(checkTargets), IsEmpty());
}

TEST_F(TargetsCheckTest, FindsEmptyGroupsAndScenes) {
  examination_.homes = {HomeDataBuilder("Cottage").group("Corner", {}).scene("Night", {}).build()};
  const HomeData& home = examination_.homes->front();
  EXPECT_THAT(
      findingsOf(checkTargets),
      ElementsAre(NeedsAttention("Cottage / Corner", EndsWith("nidus home remove group " +
                                                              wordsOf(home.serviceGroups[0]))),
                  NeedsAttention("Cottage / Night", EndsWith("nidus home remove scene " +
                                                             wordsOf(home.actionSets[0])))));
}

TEST_F(TargetsCheckTest, FindsGroupsAndScenesBeyondReach) {
  examination_.homes = {HomeDataBuilder("Cottage")
                            .light("Away")
                            .unreachable()
                            .group("Corner", {0})
                            .scene("Night", {0})
                            .build()};
  EXPECT_THAT(findingsOf(checkTargets),
              ElementsAre(NeedsAttention("Cottage / Corner", HasSubstr("can be reached")),
                          NeedsAttention("Cottage / Night", HasSubstr("can be reached"))));
}

using AccessoriesCheckTest = DoctorCheckTest;

TEST_F(AccessoriesCheckTest, FindsThoseBeyondReach) {
  examination_.homes = {HomeDataBuilder("Cottage")
                            .room("Hall")
                            .light("Lamp")
                            .light("Far Away")
                            .unreachable()
                            .build()};
  const std::string away = wordsOf(examination_.homes->front().accessories[1]);
  EXPECT_THAT(findingsOf(checkAccessories),
              ElementsAre(NeedsAttention("Cottage / Hall / Far Away",
                                         EndsWith("nidus home remove accessory " + away))));
}

}  // namespace
}  // namespace nidus
