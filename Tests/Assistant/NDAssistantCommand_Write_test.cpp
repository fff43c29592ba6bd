#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <utility>

#include "Assistant/CommandTest.h"
#include "Support/InlineQueue.h"
#include "Support/TestTypes.h"

namespace nidus {
namespace {

using testing::Contains;
using testing::Each;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;
using testing::StartsWith;

class SetTest : public CommandTest {
 protected:
  /// Sets an attribute of all objects of the one home.
  void set(const char* attribute, VAHAValueRef value, const char* type = "SET") {
    perform(makeCommand({.entityType = "SERVICE"},
                        {{.type = type, .attribute = attribute, .value = std::move(value)}}));
  }
};

TEST_F(SetTest, AnswersEveryObjectWithoutAttribute) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  set(nullptr, booleanValue(true));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS"));
  EXPECT_THAT(home->writes(), IsEmpty());
}

TEST_F(SetTest, WritesTheValueAndReadsItBack) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  set("POWER", booleanValue(true));
  EXPECT_THAT(written(*home), ElementsAre("Lamp=1"));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER=true"));
  EXPECT_THAT(log(),
              ElementsAre("6 Incoming Filter: ", "6 Incoming Action: SET/attribute=POWER/value=1"));
}

TEST_F(SetTest, WritesOncePerHome) {
  const auto cottage = HomeBuilder("Cottage").light("Lamp").light("Bulb").build();
  const auto flat = HomeBuilder("Flat").light("Fan").build();
  useHomes({cottage, flat});
  actInAllHomes({.type = "SET", .attribute = "POWER", .value = booleanValue(true)});
  EXPECT_THAT(cottage->writes(), ElementsAre(SizeIs(2)));
  EXPECT_THAT(flat->writes(), ElementsAre(SizeIs(1)));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER=true; Bulb SUCCESS "
                                     "POWER=true; Fan SUCCESS POWER=true"));
}

TEST_F(SetTest, WritesEachCharacteristicOnce) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp").associated(kLightService));
  perform(makeCommand({.serviceType = "LIGHT"},
                      {{.type = "SET", .attribute = "POWER", .value = booleanValue(true)}}));
  EXPECT_THAT(written(*home), ElementsAre("Lamp=1"));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER=true"));
}

TEST_F(SetTest, RefusesEachReadOnlyDuplicate) {
  const auto home = useHome(
      HomeBuilder("Cottage").light("Lamp", {power(false).readOnly()}).associated(kLightService));
  perform(makeCommand({.serviceType = "LIGHT"},
                      {{.type = "SET", .attribute = "POWER", .value = booleanValue(true)}}));
  EXPECT_THAT(home->writes(), IsEmpty());
  EXPECT_THAT(replies(),
              ElementsAre("COMMAND_SUCCESS; Lamp READ_ONLY POWER; Lamp READ_ONLY POWER"));
}

TEST_F(SetTest, WritesTheWriteType) {
  const auto home = useHome(HomeBuilder("Cottage").thermostat(
      "Stove", {currentTemperature(19.5F), targetTemperature(21.0F)}));
  set("TEMPERATURE", floatValue(22.5F));
  ASSERT_THAT(home->writes(), ElementsAre(SizeIs(1)));
  EXPECT_EQ(home->writes()[0][0].characteristic, home->characteristic("Stove", kTargetTemperature));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Stove SUCCESS TEMPERATURE=22.5 CELSIUS"));
}

TEST_F(SetTest, DoesNotNeedTheReadType) {
  const auto home =
      useHome(HomeBuilder("Cottage").thermostat("Radiator", {targetTemperature(21.0F)}));
  set("TEMPERATURE", floatValue(22.5F));
  EXPECT_THAT(written(*home), ElementsAre("Radiator=22.5"));
}

TEST_F(SetTest, MapsWordsToThePlatformsValues) {
  const auto home = useHome(HomeBuilder("Cottage").thermostat(
      "Stove", {CharacteristicSpec(kTargetClimateMode).value(0).format("int")}));
  set("CLIMATE_MODE", stringValue("HEAT"));
  EXPECT_THAT(written(*home), ElementsAre("Stove=1"));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Stove SUCCESS CLIMATE_MODE='HEAT'"));
}

TEST_F(SetTest, TakesFahrenheitOffTheMetricSystemOnce) {
  inProcessWithLocale(false, [this] {
    const auto home = useHome(HomeBuilder("Cottage")
                                  .thermostat("Stove", {targetTemperature(21.0F)})
                                  .thermostat("Radiator", {targetTemperature(21.0F)}));
    set("TEMPERATURE", integerValue(72));
    EXPECT_THAT(written(*home), ElementsAre("Stove=22.222221", "Radiator=22.222221"));
    EXPECT_THAT(log(),
                Contains(StartsWith("6 adjustSet: Attribute TEMPERATURE value 72 ")).Times(1));
  });
}

TEST_F(SetTest, KeepsCelsiusOffTheMetricSystem) {
  inProcessWithLocale(false, [this] {
    const auto home =
        useHome(HomeBuilder("Cottage").thermostat("Stove", {targetTemperature(21.0F)}));
    set("TEMPERATURE", integerValue(22, "CELSIUS"));
    EXPECT_THAT(written(*home), ElementsAre("Stove=22"));
  });
}

TEST_F(SetTest, LogsAndSkipsWhatIsNoService) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp").room("Hall"));
  perform(
      makeCommand(Search(), {{.type = "SET", .attribute = "POWER", .value = booleanValue(true)}}));
  EXPECT_THAT(written(*home), ElementsAre("Lamp=1"));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER=true"));
  EXPECT_THAT(log(4), SizeIs(2));
  EXPECT_THAT(log(4), Each(testing::MatchesRegex("4 Filtered object .* not a service")));
}

TEST_F(SetTest, FindsNoMatchWithoutCharacteristic) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  set("BRIGHTNESS", integerValue(5));
  set("TASTE", integerValue(5));
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES", "FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(SetTest, RefusesReadOnlyWithoutAskingThePlatform) {
  const auto home = useHome(HomeBuilder("Cottage")
                                .light("Lamp", {power(false).readOnly()})
                                .light("Bulb", {power(false)}));
  set("POWER", booleanValue(true));
  EXPECT_THAT(written(*home), ElementsAre("Bulb=1"));
  EXPECT_THAT(replies(),
              ElementsAre("COMMAND_SUCCESS; Lamp READ_ONLY POWER; Bulb SUCCESS POWER=true"));
}

TEST_F(SetTest, ReportsReadOnlyAlone) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {power(false).readOnly()}));
  set("POWER", booleanValue(true));
  EXPECT_THAT(home->writes(), IsEmpty());
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp READ_ONLY POWER"));
}

TEST_F(SetTest, WritesUnclampedValues) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40)}));
  set("BRIGHTNESS", integerValue(150));
  set("BRIGHTNESS", integerValue(-5));
  EXPECT_THAT(written(*home), ElementsAre("Lamp=150", "Lamp=-5"));
}

TEST_F(SetTest, WritesNullWithoutValue) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  set("POWER", nullptr);
  EXPECT_THAT(written(*home), ElementsAre("Lamp=(null)"));
}

TEST_F(SetTest, WritesTheActionsValueToWhatHasTheMaximum) {
  const auto home =
      useHome(HomeBuilder("Cottage")
                  .light("Lamp", {brightness(40)})
                  .light("Bulb", {brightness(40).withoutMetadata()})
                  .light("Strip", {brightness(40).limits(NDValue::integer(1), nullptr)})
                  .light("Spot", {brightness(40).limits(nullptr, NDValue::integer(9))}));
  set("BRIGHTNESS", integerValue(7), "SET_TO_MAXIMUM");
  EXPECT_THAT(written(*home), ElementsAre("Lamp=7", "Spot=7"));
  EXPECT_THAT(replies(),
              ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=100 percentage; Spot "
                          "SUCCESS BRIGHTNESS=9 percentage"));
}

TEST_F(SetTest, WritesTheActionsValueToWhatHasTheMinimum) {
  const auto home =
      useHome(HomeBuilder("Cottage")
                  .light("Lamp", {brightness(40)})
                  .light("Strip", {brightness(40).limits(NDValue::integer(1), nullptr)})
                  .light("Spot", {brightness(40).limits(nullptr, NDValue::integer(9))}));
  set("BRIGHTNESS", nullptr, "SET_TO_MINIMUM");
  EXPECT_THAT(written(*home), ElementsAre("Lamp=(null)", "Strip=(null)"));
}

TEST_F(SetTest, FindsNoMatchWithoutTheLimit) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  set("POWER", nullptr, "SET_TO_MAXIMUM");
  EXPECT_THAT(home->writes(), IsEmpty());
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(SetTest, RefusesReadOnlyForLimitsToo) {
  useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40).readOnly()}));
  set("BRIGHTNESS", nullptr, "SET_TO_MAXIMUM");
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp READ_ONLY BRIGHTNESS"));
}

TEST_F(SetTest, TellsErrorsApart) {
  const auto home =
      useHome(HomeBuilder("Cottage").light("Lamp").light("Bulb").light("Strip").light("Spot"));
  home->characteristic("Lamp", kPower)->failWrites(kNDErrorUnreachable);
  home->characteristic("Bulb", kPower)->failWrites(kNDErrorNotWritable);
  home->characteristic("Strip", kPower)->failWrites(kNDErrorOutOfRange);
  set("POWER", booleanValue(true));
  EXPECT_THAT(replies(),
              ElementsAre("COMMAND_SUCCESS; Lamp UNREACHABLE POWER; Bulb READ_ONLY POWER; Strip "
                          "FAILURE POWER; Spot SUCCESS POWER=true"));
}

TEST_F(SetTest, FindsNoMatchWhenTheBatchFails) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->failWrites(kNDErrorNotWritable);
  set("POWER", booleanValue(true));
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(SetTest, ReportsUnlockAndThenWhatWasWritten) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp").light("Bulb").light("Strip"));
  home->characteristic("Bulb", kPower)->failWrites(kNDErrorMustUnlock);
  set("POWER", booleanValue(true));
  EXPECT_THAT(replies(),
              ElementsAre("REQUIRES_UNLOCK", "COMMAND_SUCCESS; Lamp SUCCESS POWER=true"));
  EXPECT_TRUE(isHandlerReleased());
}

TEST_F(SetTest, ReportsUnlockOfEachHome) {
  const auto cottage =
      HomeBuilder("Cottage").light("Lamp", {power(false).readOnly()}).light("Bulb").build();
  const auto flat = HomeBuilder("Flat").light("Fan").build();
  useHomes({cottage, flat});
  cottage->failWrites(kNDErrorMustUnlock);
  flat->failWrites(kNDErrorMustUnlock);
  actInAllHomes({.type = "SET", .attribute = "POWER", .value = booleanValue(true)});
  EXPECT_THAT(replies(), ElementsAre("REQUIRES_UNLOCK", "REQUIRES_UNLOCK",
                                     "COMMAND_SUCCESS; Lamp READ_ONLY POWER"));
}

TEST_F(SetTest, LeavesTheGroupBeforeItReportsTheUnlock) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->failWrites(kNDErrorMustUnlock);
  bool isReportWaiting = false;
  onReply([&] { isReportWaiting = isReportWaiting || runOneOfMainQueue(); });
  set("POWER", booleanValue(true));
  EXPECT_TRUE(isReportWaiting);
}

TEST_F(SetTest, HomeMayAnswerAtOnce) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->answerOn(std::make_shared<InlineQueue>());
  set("POWER", booleanValue(true));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER=true"));
}

TEST_F(SetTest, ReportsInTheOrderOfTheAnswers) {
  const auto cottage = HomeBuilder("Cottage").light("Lamp").build();
  const auto flat = HomeBuilder("Flat").light("Fan").build();
  useHomes({cottage, flat});
  cottage->holdAnswers();
  actInAllHomes({.type = "SET", .attribute = "POWER", .value = booleanValue(true)});
  EXPECT_THAT(replies(), IsEmpty());
  cottage->releaseAnswers();
  runUntilIdle();
  EXPECT_THAT(replies(),
              ElementsAre("COMMAND_SUCCESS; Fan SUCCESS POWER=true; Lamp SUCCESS POWER=true"));
}

TEST_F(SetTest, RunsSceneInsteadOfWriting) {
  const auto home =
      useHome(HomeBuilder("Cottage").light("Lamp").scene("Good night").scene("Party"));
  perform(makeCommand(Search(),
                      {{.type = "SET", .attribute = "ENABLED", .value = booleanValue(true)}}));
  EXPECT_THAT(home->executions(), ElementsAre(home->scene("Good night")));
  EXPECT_THAT(home->writes(), IsEmpty());
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Good night SUCCESS ENABLED=true"));
  EXPECT_THAT(log(4), IsEmpty());
}

TEST_F(SetTest, RefusesToSetSceneToValue) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp").scene("Good night"));
  perform(
      makeCommand(Search(), {{.type = "SET", .attribute = "POWER", .value = booleanValue(true)}}));
  EXPECT_THAT(home->writes(), IsEmpty());
  EXPECT_THAT(replies(), ElementsAre("COMMAND_FAILURE"));
}

TEST_F(SetTest, FindsScenesWithoutTheirDiacritics) {
  useHome(HomeBuilder("Cottage").scene("Good night"));
  const auto command = performed(makeCommand(nullptr, {}));
  HomeObjectRecord scene = *command->allObjects().back();
  scene.objectType = "SC\u00c8NE";
  command->handleSetActionTypes_serviceType_forObjects_completionHandler(
      makeAction({.type = "SET", .attribute = "ENABLED", .value = booleanValue(true)}), nullptr,
      {&scene}, handler());
  runUntilIdle();
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Good night SUCCESS ENABLED=true"));
}

}  // namespace
}  // namespace nidus
