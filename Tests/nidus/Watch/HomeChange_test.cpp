#include "nidus/Watch/HomeChange.h"

#include <gmock/gmock.h>

#include <cstdlib>

#include "HomePlatform/Metadata/VocabularyReader.h"
#include "nidus/HomeDataBuilder.h"
#include "nidus/Watch/ChangeText.h"
#include "nidus/Watch/WatchFilter.h"

namespace nidus {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

/// Compares a home with what a test makes of it; shows the lines of the changes without the time.
class ChangesBetweenTest : public ::testing::Test {
 protected:
  using Lines = std::vector<std::string>;

  [[nodiscard]] std::vector<HomeChange> changes() const {
    return changesBetween(before_, after_, metadata_);
  }
  [[nodiscard]] Lines lines(const WatchFilter& filter = {}) const {
    constexpr std::size_t kTimeSize = 10;
    Lines lines;
    for (const HomeChange& change : changes()) {
      if (!isWatched(change, filter)) continue;
      std::string line = changeText(change, 0, metadata_.vocabulary(), {}).substr(kTimeSize);
      line.pop_back();
      lines.push_back(line);
    }
    return lines;
  }
  AccessoryData& accessory(std::size_t index) { return after_[0].accessories[index]; }
  CharacteristicData& characteristic() { return accessory(0).services[0].characteristics[0]; }

  static std::vector<HomeData> someHomes() {
    return {
        HomeDataBuilder("Cottage").room("Café").light("Lamp").room("Attic").light("Spot").build()};
  }

  const MetadataMapper metadata_{builtInVocabulary()};
  std::vector<HomeData> before_ = someHomes();
  std::vector<HomeData> after_ = before_;
};

TEST_F(ChangesBetweenTest, IsNoneBetweenEqualHomes) { EXPECT_THAT(changes(), IsEmpty()); }

TEST_F(ChangesBetweenTest, TellsValuesWithTheirPlace) {
  characteristic().value = NDValue::boolean(true);
  EXPECT_THAT(lines(), ElementsAre("Cottage / Café / Lamp / Lamp  POWER  off -> on"));
}

TEST_F(ChangesBetweenTest, TellsValuesThatBecomeKnown) {
  before_[0].accessories[0].services[0].characteristics[0].value = nullptr;
  EXPECT_THAT(lines(), ElementsAre("Cottage / Café / Lamp / Lamp  POWER  unknown -> off"));
}

TEST_F(ChangesBetweenTest, LeavesOutWhatNobodyKnowsYet) {
  characteristic().deviceValue = NDValue::boolean(true);
  EXPECT_THAT(changes(), IsEmpty());
}

TEST_F(ChangesBetweenTest, ShowsUnitsAndWordsOfTheVocabulary) {
  struct ShownValue {
    const char* type;
    NDValueRef before;
    NDValueRef after;
    const char* line;
  };
  const std::vector<ShownValue> table = {
      {"brightness", NDValue::integer(40), NDValue::integer(65), "BRIGHTNESS  40 % -> 65 %"},
      {"current-temperature", NDValue::floating(20.5F), NDValue::floating(21),
       "TEMPERATURE  20.5 °C -> 21 °C"},
      {"target-temperature", NDValue::floating(20), NDValue::floating(21),
       "TEMPERATURE target  20 °C -> 21 °C"},
      {"current-climate-mode", NDValue::integer(0), NDValue::integer(1),
       "CLIMATE_MODE  off -> heat"},
  };
  for (const ShownValue& row : table) {
    SCOPED_TRACE(row.line);
    HomeDataBuilder builder("Cottage");
    builder.light("Lamp").characteristic(characteristicTypeOf(row.type), row.before);
    before_ = {builder.build()};
    after_ = before_;
    accessory(0).services[0].characteristics[1].value = row.after;
    EXPECT_THAT(lines(), ElementsAre(std::string("Cottage / Lamp / Lamp  ") + row.line));
  }
}

TEST_F(ChangesBetweenTest, TellsAccessoriesThatComeAndGo) {
  after_[0].accessories.erase(after_[0].accessories.begin());
  EXPECT_THAT(lines(), ElementsAre("Cottage / Café / Lamp  removed"));
  std::swap(before_, after_);
  EXPECT_THAT(lines(), ElementsAre("Cottage / Café / Lamp  added"));
}

TEST_F(ChangesBetweenTest, TellsHomesAndServicesThatComeAndGo) {
  after_.push_back(HomeDataBuilder("Flat").light("Bulb").build());
  accessory(0).services.clear();
  EXPECT_THAT(lines(), ElementsAre("Cottage / Café / Lamp / Lamp  removed", "Flat  added"));
}

TEST_F(ChangesBetweenTest, TellsNamesRoomsAndReachability) {
  after_[0].name = "Villa";
  accessory(0).name = "Bulb";
  accessory(0).room.reset();
  accessory(1).room = after_[0].rooms[0].uuid;
  accessory(1).reachable = false;
  EXPECT_THAT(lines(),
              ElementsAre("Villa  name  Cottage -> Villa",  //
                          "Villa / Bulb  name  Lamp -> Bulb", "Villa / Bulb  room  Café -> no room",
                          "Villa / Café / Spot  room  Attic -> Café",
                          "Villa / Café / Spot  reachable  yes -> no"));
}

TEST_F(ChangesBetweenTest, TellsRoomsThatComeGoAndAreRenamed) {
  after_[0].rooms[0].name = "Bistro";
  after_[0].rooms.pop_back();
  accessory(1).room.reset();
  EXPECT_THAT(lines(),
              ElementsAre("Cottage / Bistro  name  Café -> Bistro", "Cottage / Attic  removed",
                          "Cottage / Spot  room  Attic -> no room"));
  std::swap(before_, after_);
  EXPECT_THAT(
      lines({"", "Attic", ""}),
      ElementsAre("Cottage / Attic  added", "Cottage / Attic / Spot  room  no room -> Attic"));
}

TEST_F(ChangesBetweenTest, IsWatchedWhereItWasAndWhereItIs) {
  accessory(1).room = after_[0].rooms[0].uuid;
  for (const char* room : {"Attic", "Café"}) {
    EXPECT_THAT(lines({"", room, ""}), ElementsAre("Cottage / Café / Spot  room  Attic -> Café"));
  }
  after_[0].name = "Villa";
  EXPECT_THAT(lines({"Cottage", "", ""}), ElementsAre("Villa  name  Cottage -> Villa",
                                                      "Villa / Café / Spot  room  Attic -> Café"));
}

TEST_F(ChangesBetweenTest, IsFilteredAsOrdersAre) {
  characteristic().value = NDValue::boolean(true);
  EXPECT_EQ(lines({"Cottage", "Cafe", "Lamp"}).size(), 1U);
  EXPECT_THAT(lines({"cottage", "", ""}), IsEmpty());
  EXPECT_THAT(lines({"", "Attic", ""}), IsEmpty());
  EXPECT_THAT(lines({"", "", "Spot"}), IsEmpty());
}

TEST_F(ChangesBetweenTest, IsToldToProgramsAsJson) {
  characteristic().value = NDValue::boolean(true);
  EXPECT_EQ(changeJson(changes().front(), 1795269787),
            R"({"time": "2026-11-21T14:03:07Z", "change": "changed", "home": "Cottage", )"
            R"("room": "Café", "accessory": "Lamp", "service": "Lamp", "attribute": "POWER", )"
            R"("before": {"boolean": false}, "after": {"boolean": true}})"
            "\n");
  after_[0].accessories.clear();
  EXPECT_THAT(changeJson(changes().front(), 0),
              ::testing::HasSubstr(R"("change": "removed", "home": "Cottage", "room": "Café", )"
                                   R"("accessory": "Lamp"})"));
}

TEST_F(ChangesBetweenTest, CountsWhatIsWatched) {
  EXPECT_EQ(extentOf(before_, {}), "2 services of 1 home");
  EXPECT_EQ(extentOf(before_, {"", "Attic", ""}), "1 service of 1 home");
  before_[0].accessories.clear();
  EXPECT_EQ(extentOf(before_, {"Cottage", "", ""}), "0 services of 0 homes");
}

TEST_F(ChangesBetweenTest, RefusesFiltersThatFitNothing) {
  EXPECT_FALSE(checkFilter(before_, {"Cottage", "Cafe", "Lamp"}));
  EXPECT_FALSE(checkFilter({}, {}));
  before_.push_back(HomeDataBuilder("Flat").room("Hall").build());
  EXPECT_FALSE(checkFilter(before_, {"Flat", "Hall", ""}));
  const std::vector<std::pair<WatchFilter, std::string>> table = {
      {{"cottage", "", ""}, "there is no home cottage; did you mean Cottage?"},
      {{"Flat", "Café", ""}, "there is no room Café; nidus home show lists what there is"},
      {{"", "Attic", "Lamp"}, "there is no service Lamp; nidus home show lists what there is"},
      {{"", "", "Lampp"}, "there is no service Lampp; did you mean Lamp?"},
  };
  for (const auto& [filter, message] : table) {
    const Status failure = checkFilter(before_, filter);
    ASSERT_TRUE(failure) << message;
    EXPECT_EQ(failure->message, message);
  }
}

}  // namespace
}  // namespace nidus
