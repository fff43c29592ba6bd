#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "Assistant/CommandTest.h"
#include "Support/InlineQueue.h"
#include "Support/TestTypes.h"

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

class UpdateTest : public CommandTest {
 protected:
  void update(const char* type, const char* attribute, VAHAValueRef value = nullptr) {
    perform(makeCommand({.entityType = "SERVICE"},
                        {{.type = type, .attribute = attribute, .value = std::move(value)}}));
  }
};

TEST_F(UpdateTest, AnswersEveryObjectWithoutAttribute) {
  const auto home = useHome(HomeBuilder("Cottage").room("Hall").light("Lamp"));
  perform(makeCommand(Search(), {{.type = "TOGGLE"}}));
  EXPECT_THAT(replies(),
              ElementsAre("COMMAND_SUCCESS; Cottage SUCCESS; Lamp SUCCESS; Hall SUCCESS"));
  EXPECT_THAT(home->reads(), IsEmpty());
}

TEST_F(UpdateTest, FindsNoMatchWithoutCharacteristic) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  update("INCREASE", "BRIGHTNESS");
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(UpdateTest, MovesByFiveWithoutValue) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40)}));
  update("INCREASE", "BRIGHTNESS");
  update("DECREASE", "BRIGHTNESS");
  ASSERT_THAT(home->writes(), SizeIs(2));
  EXPECT_TRUE(home->writes()[0][0].value->isFloating());
  EXPECT_EQ(home->writes()[0][0].value->floatValue(), 45.0F);
  EXPECT_EQ(home->writes()[1][0].value->floatValue(), 40.0F);
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=45 PERCENTAGE",
                                     "COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=40 PERCENTAGE"));
}

TEST_F(UpdateTest, StartsFromWhatTheAccessorySays) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40)}));
  home->characteristic("Lamp", kBrightness)->setDeviceValue(NDValue::integer(60));
  update("INCREASE", "BRIGHTNESS");
  EXPECT_THAT(written(*home), ElementsAre("Lamp=65"));
}

TEST_F(UpdateTest, MovesByTheValue) {
  struct Case {
    const char* label;
    VAHAValueRef value;
    const char* written;
  };
  const Case cases[] = {{"integer", integerValue(10), "Lamp=50"},
                        {"negative integer", integerValue(-10), "Lamp=30"},
                        {"float", floatValue(2.5F), "Lamp=42.5"},
                        {"boolean", booleanValue(true), "Lamp=45"},
                        {"string", stringValue("10"), "Lamp=45"}};
  for (const Case& test : cases) {
    SCOPED_TRACE(test.label);
    const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40)}));
    update("INCREASE", "BRIGHTNESS", test.value);
    EXPECT_THAT(written(*home), ElementsAre(test.written));
  }
}

TEST_F(UpdateTest, WritesTheLimitItself) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {brightness(98)}));
  const auto metadata = home->characteristic("Lamp", kBrightness)->metadata();
  update("INCREASE", "BRIGHTNESS");
  ASSERT_THAT(home->writes(), SizeIs(1));
  EXPECT_EQ(home->writes()[0][0].value, metadata->maximumValue());
  EXPECT_TRUE(home->writes()[0][0].value->isInteger());
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=100 PERCENTAGE"));
}

TEST_F(UpdateTest, KeepsTheSumThatEqualsTheLimit) {
  for (const auto& [light, type] :
       {std::pair(brightness(95), "INCREASE"), std::pair(brightness(5), "DECREASE")}) {
    SCOPED_TRACE(type);
    const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {light}));
    update(type, "BRIGHTNESS");
    ASSERT_THAT(home->writes(), SizeIs(1));
    EXPECT_FALSE(home->writes()[0][0].value->isInteger());  // as the limits are
  }
}

TEST_F(UpdateTest, KeepsValuesWithinTheLimits) {
  struct Case {
    const char* label;
    CharacteristicSpec light;
    const char* type;
    const char* written;
  };
  const auto none = NDValueRef();
  const Case cases[] = {
      {"below the minimum", brightness(2), "DECREASE", "Lamp=0"},
      {"at the maximum", brightness(95), "INCREASE", "Lamp=100"},
      {"past the maximum", brightness(96), "INCREASE", "Lamp=100"},
      {"no maximum", brightness(98).limits(NDValue::integer(0), none), "INCREASE", "Lamp=103"},
      {"no minimum", brightness(2).limits(none, NDValue::integer(100)), "DECREASE", "Lamp=-3"},
      {"no metadata", brightness(98).withoutMetadata(), "INCREASE", "Lamp=103"},
      {"minimum above maximum", brightness(40).limits(60, 30, 1), "INCREASE", "Lamp=60"},
      {"words for limits", brightness(98).limits(NDValue::text("0"), NDValue::text("1")),
       "INCREASE", "Lamp=103"}};
  for (const Case& test : cases) {
    SCOPED_TRACE(test.label);
    const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {test.light}));
    update(test.type, "BRIGHTNESS");
    EXPECT_THAT(written(*home), ElementsAre(test.written));
  }
}

TEST_F(UpdateTest, CutsCurrentValueOfIntegers) {
  const auto home = useHome(
      HomeBuilder("Cottage").light("Lamp", {brightness(40).value(NDValue::floating(40.9F))}));
  update("INCREASE", "BRIGHTNESS");
  EXPECT_THAT(written(*home), ElementsAre("Lamp=45"));
}

TEST_F(UpdateTest, ReadsMissingValueAsZero) {
  const auto home =
      useHome(HomeBuilder("Cottage").light("Lamp", {brightness(0).value(NDValueRef())}));
  update("INCREASE", "BRIGHTNESS");
  EXPECT_THAT(written(*home), ElementsAre("Lamp=5"));
}

TEST_F(UpdateTest, ReadsOneTypeAndWritesTheOther) {
  const auto home = useHome(HomeBuilder("Cottage").thermostat(
      "Stove", {currentTemperature(19.5F), targetTemperature(21.0F)}));
  update("INCREASE", "TEMPERATURE", floatValue(1.5F));
  EXPECT_THAT(batchesRead(*home),
              ElementsAre(ElementsAre(home->characteristic("Stove", kCurrentTemperature))));
  ASSERT_THAT(home->writes(), ElementsAre(SizeIs(1)));
  EXPECT_EQ(home->writes()[0][0].characteristic, home->characteristic("Stove", kTargetTemperature));
  EXPECT_EQ(home->writes()[0][0].value->floatValue(), 21.0F);
}

TEST_F(UpdateTest, TakesLimitsOfTheWriteType) {
  const auto home = useHome(HomeBuilder("Cottage").thermostat(
      "Stove", {currentTemperature(37.0F), targetTemperature(21.0F)}));
  update("INCREASE", "TEMPERATURE");
  EXPECT_THAT(written(*home), ElementsAre("Stove=38"));
}

TEST_F(UpdateTest, TogglesTheValue) {
  const auto home =
      useHome(HomeBuilder("Cottage").light("Lamp", {power(true)}).light("Bulb", {power(false)}));
  update("TOGGLE", "POWER");
  EXPECT_THAT(written(*home), ElementsAre("Lamp=0", "Bulb=1"));
  EXPECT_TRUE(home->writes()[0][0].value->isBoolean());
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER; Bulb SUCCESS POWER"));
}

TEST_F(UpdateTest, TogglesMissingValueToTrue) {
  const auto home =
      useHome(HomeBuilder("Cottage").light("Lamp", {power(true).value(NDValueRef())}));
  update("TOGGLE", "POWER");
  EXPECT_THAT(written(*home), ElementsAre("Lamp=1"));
}

TEST_F(UpdateTest, TogglesAgainstTheLimits) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {power(false).limits(0, 0, 0)}));
  update("TOGGLE", "POWER");
  EXPECT_THAT(written(*home), ElementsAre("Lamp=1"));
}

TEST_F(UpdateTest, RefusesActionsThatDoNotSuitTheType) {
  logLevel(3);
  struct Case {
    const char* type;
    const char* attribute;
    const char* valueType;
  };
  const auto home = useHome(HomeBuilder("Cottage").light(
      "Lamp", {power(true), brightness(40), currentTemperature(20.0F),
               CharacteristicSpec(kCurrentClimateMode).value(1).format("int")}));
  for (const Case& test :
       {Case{"TOGGLE", "BRIGHTNESS", "int"}, Case{"TOGGLE", "TEMPERATURE", "float"},
        Case{"TOGGLE", "CLIMATE_MODE", "string"}, Case{"INCREASE", "POWER", "bool"},
        Case{"DECREASE", "POWER", "bool"}, Case{"INCREASE", "CLIMATE_MODE", "string"}}) {
    SCOPED_TRACE(std::string(test.type) + " " + test.attribute);
    clearReplies();
    clearLog();
    update(test.type, test.attribute);
    EXPECT_THAT(replies(), ElementsAre("COMMAND_FAILURE"));
    EXPECT_THAT(log(3), ElementsAre(std::string("3 -[NDAssistantCommand handleUpdateActionTypes:"
                                                "serviceType:forObjects:completionHandler:] ### "
                                                "Vela passed an incorrect action (") +
                                    test.type + ") to a " + test.valueType + " value type."));
  }
  EXPECT_THAT(home->reads(), IsEmpty());
}

TEST_F(UpdateTest, LogsWhatDoesNotSuitBeforeItReplies) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  std::vector<std::string> logged;
  onReply([&] { logged = log(3); });
  update("INCREASE", "POWER");
  EXPECT_THAT(logged, SizeIs(1));
}

TEST_F(UpdateTest, AcceptsOtherActionTypes) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40)}));
  const auto command = performed(makeCommand(nullptr, {}));
  command->handleUpdateActionTypes_serviceType_forObjects_completionHandler(
      makeAction({.type = "SET", .attribute = "BRIGHTNESS"}), nullptr, command->allObjects(),
      handler());
  runUntilIdle();
  EXPECT_THAT(written(*home), ElementsAre("Lamp=40"));
}

TEST_F(UpdateTest, KeepsResultsThatAreNoAnswer) {
  useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40)}));
  const auto command = performed(makeCommand(nullptr, {}));
  command->handleUpdateActionTypes_serviceType_forObjects_completionHandler(
      makeAction({.type = "GET", .attribute = "BRIGHTNESS", .value = integerValue(7)}), nullptr,
      command->allObjects(), handler());
  runUntilIdle();
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=40 PERCENTAGE"));
}

TEST_F(UpdateTest, ReadsTheWriteTypeForTargetValue) {
  const auto home = useHome(HomeBuilder("Cottage").thermostat(
      "Stove", {currentTemperature(19.5F), targetTemperature(21.0F)}));
  actInAllHomes({.type = "GET_TARGET_VALUE", .attribute = "TEMPERATURE"});
  EXPECT_THAT(batchesRead(*home),
              ElementsAre(ElementsAre(home->characteristic("Stove", kTargetTemperature))));
  EXPECT_THAT(written(*home), ElementsAre("Stove=21"));
}

TEST_F(UpdateTest, RefusesReadOnlyWithoutReading) {
  const auto home = useHome(HomeBuilder("Cottage")
                                .light("Lamp", {brightness(40).readOnly()})
                                .light("Bulb", {brightness(20)}));
  update("INCREASE", "BRIGHTNESS");
  EXPECT_THAT(batchesRead(*home),
              ElementsAre(ElementsAre(home->characteristic("Bulb", kBrightness))));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp READ_ONLY BRIGHTNESS; Bulb SUCCESS "
                                     "BRIGHTNESS=25 PERCENTAGE"));
}

TEST_F(UpdateTest, ReportsReadOnlyAlone) {
  const auto home =
      useHome(HomeBuilder("Cottage").thermostat("Sensor", {currentTemperature(20.0F)}));
  update("INCREASE", "TEMPERATURE");
  EXPECT_THAT(home->reads(), IsEmpty());
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Sensor READ_ONLY TEMPERATURE"));
}

TEST_F(UpdateTest, UpdatesTwoHomesInOneReport) {
  const auto cottage = HomeBuilder("Cottage").light("Lamp").light("Bulb").build();
  const auto flat = HomeBuilder("Flat").light("Fan").build();
  useHomes({cottage, flat});
  actInAllHomes({.type = "TOGGLE", .attribute = "POWER"});
  for (const auto& home : {cottage, flat}) {
    EXPECT_THAT(home->reads(), SizeIs(1));
    EXPECT_THAT(home->writes(), SizeIs(1));
  }
  EXPECT_THAT(written(*cottage), ElementsAre("Lamp=1", "Bulb=1"));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER; Bulb SUCCESS POWER; Fan "
                                     "SUCCESS POWER"));
}

TEST_F(UpdateTest, TellsReadErrorsApart) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp").light("Bulb").light("Strip"));
  home->characteristic("Lamp", kPower)->failReads(kNDErrorUnreachable);
  home->characteristic("Bulb", kPower)->failReads(kNDErrorNotWritable);
  update("TOGGLE", "POWER");
  EXPECT_THAT(written(*home), ElementsAre("Strip=1"));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp UNREACHABLE POWER; Bulb FAILURE POWER; "
                                     "Strip SUCCESS POWER"));
}

TEST_F(UpdateTest, WritesNothingWhenNothingWasRead) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->characteristic("Lamp", kPower)->failReads(kNDErrorUnreachable);
  update("TOGGLE", "POWER");
  EXPECT_THAT(home->writes(), IsEmpty());
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp UNREACHABLE POWER"));
}

TEST_F(UpdateTest, FindsNoMatchWhenTheReadFails) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->failReads(kNDErrorUnreachable);
  update("TOGGLE", "POWER");
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(UpdateTest, TellsWriteErrorsApart) {
  const auto home =
      useHome(HomeBuilder("Cottage").light("Lamp").light("Bulb").light("Strip").light("Spot"));
  home->characteristic("Lamp", kPower)->failWrites(kNDErrorUnreachable);
  home->characteristic("Bulb", kPower)->failWrites(kNDErrorNotWritable);
  home->characteristic("Strip", kPower)->failWrites(kNDErrorMustUnlock);
  update("TOGGLE", "POWER");
  EXPECT_THAT(replies(),
              ElementsAre("COMMAND_SUCCESS; Lamp UNREACHABLE POWER; Bulb READ_ONLY POWER; "
                          "Strip FAILURE POWER; Spot SUCCESS POWER"));
}

TEST_F(UpdateTest, FindsNoMatchWhenTheWriteFails) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->failWrites(kNDErrorMustUnlock);
  update("TOGGLE", "POWER");
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES"));
  EXPECT_TRUE(isHandlerReleased());
}

TEST_F(UpdateTest, ReportsUnlockOfOneValueAlone) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp").light("Bulb").light("Strip"));
  home->characteristic("Bulb", kPower)->failReads(kNDErrorMustUnlock);
  update("TOGGLE", "POWER");
  EXPECT_THAT(home->writes(), IsEmpty());
  EXPECT_THAT(replies(), ElementsAre("REQUIRES_UNLOCK"));
}

TEST_F(UpdateTest, ReportsUnlockOfTheBatchAlone) {
  const auto home =
      useHome(HomeBuilder("Cottage").light("Lamp").light("Bulb", {power(true).readOnly()}));
  home->failReads(kNDErrorMustUnlock);
  update("TOGGLE", "POWER");
  EXPECT_THAT(replies(), ElementsAre("REQUIRES_UNLOCK"));
}

TEST_F(UpdateTest, ReportsUnlockButNotTheOtherHome) {
  const auto cottage = HomeBuilder("Cottage").light("Lamp").build();
  const auto flat = HomeBuilder("Flat").light("Fan").build();
  useHomes({cottage, flat});
  cottage->failReads(kNDErrorMustUnlock);
  actInAllHomes({.type = "TOGGLE", .attribute = "POWER"});
  EXPECT_THAT(written(*flat), ElementsAre("Fan=1"));
  EXPECT_THAT(replies(), ElementsAre("REQUIRES_UNLOCK"));
}

TEST_F(UpdateTest, ReportsUnlockOfEachHome) {
  const auto cottage = HomeBuilder("Cottage").light("Lamp").build();
  const auto flat = HomeBuilder("Flat").light("Fan").build();
  useHomes({cottage, flat});
  cottage->failReads(kNDErrorMustUnlock);
  flat->failReads(kNDErrorMustUnlock);
  actInAllHomes({.type = "TOGGLE", .attribute = "POWER"});
  EXPECT_THAT(replies(), ElementsAre("REQUIRES_UNLOCK", "REQUIRES_UNLOCK"));
}

TEST_F(UpdateTest, LetsGoOfEverythingAfterTheUnlock) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->failReads(kNDErrorMustUnlock);
  auto command = makeCommand({.service = "Lamp"}, {{.type = "TOGGLE", .attribute = "POWER"}});
  const std::weak_ptr<NDAssistantCommand> watched = command;
  perform(std::move(command));
  EXPECT_TRUE(isHandlerReleased());
  EXPECT_TRUE(watched.expired());
}

TEST_F(UpdateTest, HomeMayAnswerAtOnce) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40)}));
  home->answerOn(std::make_shared<InlineQueue>());
  update("INCREASE", "BRIGHTNESS");
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=45 PERCENTAGE"));
}

TEST_F(UpdateTest, WritesNothingToServicesThatAreGone) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40)}));
  home->holdAnswers();
  update("INCREASE", "BRIGHTNESS");
  home->removeAccessories();
  home->releaseAnswers();
  runUntilIdle();
  EXPECT_THAT(home->writes(), IsEmpty());
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(UpdateTest, RepliesNothingWithoutAnswer) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->holdAnswers();
  update("TOGGLE", "POWER");
  home->releaseAnswers();  // The read; the write stays unanswered.
  runUntilIdle();
  EXPECT_THAT(home->writes(), SizeIs(1));
  EXPECT_THAT(replies(), IsEmpty());
  home->dropAnswers();
  EXPECT_TRUE(isHandlerReleased());
}

TEST_F(UpdateTest, CollectsAnswersInAnyOrder) {
  const auto cottage = HomeBuilder("Cottage").light("Lamp").build();
  const auto flat = HomeBuilder("Flat").light("Fan").build();
  useHomes({cottage, flat});
  cottage->holdAnswers();
  actInAllHomes({.type = "TOGGLE", .attribute = "POWER"});
  EXPECT_THAT(replies(), IsEmpty());
  cottage->releaseAnswers();
  cottage->releaseAnswers();
  runUntilIdle();
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Fan SUCCESS POWER; Lamp SUCCESS POWER"));
}

/// Refuses the values of one service, as no command of the plug-in does.
class RefusingCommand final : public NDAssistantCommand {
 public:
  using NDAssistantCommand::NDAssistantCommand;

  [[nodiscard]] NDValueRef updateValue_forAction_outcome(
      const std::shared_ptr<NDCharacteristic>& characteristic, const VAHAActionRef& action,
      NDString* outcome) const override {
    EXPECT_FALSE(*outcome);
    if (characteristic->service()->name() == "Lamp") *outcome = "TOO_BRIGHT";
    return NDAssistantCommand::updateValue_forAction_outcome(characteristic, action, outcome);
  }
};

TEST_F(UpdateTest, ReportsWhatAnOverrideRefuses) {
  logLevel(4);
  const auto home =
      useHome(HomeBuilder("Cottage").light("Lamp").serviceID(12).light("Bulb").serviceID(13));
  const auto request =
      makeCommand({.serviceType = "LIGHT"}, {{.type = "TOGGLE", .attribute = "POWER"}});
  perform(std::make_shared<RefusingCommand>(*request));
  EXPECT_THAT(written(*home), ElementsAre("Bulb=1"));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp TOO_BRIGHT POWER; Bulb SUCCESS POWER"));
  EXPECT_THAT(log(4), ElementsAre("4 Update boundary error TOO_BRIGHT for service Lamp/12"));
}

TEST_F(UpdateTest, ReportsQuietlyWhatAnOverrideRefuses) {
  logLevel(3);
  useHome(HomeBuilder("Cottage").light("Lamp"));
  const auto request =
      makeCommand({.serviceType = "LIGHT"}, {{.type = "TOGGLE", .attribute = "POWER"}});
  perform(std::make_shared<RefusingCommand>(*request));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp TOO_BRIGHT POWER"));
  EXPECT_THAT(log(), IsEmpty());
}

class UpdateValueTest : public CommandTest {};

TEST_F(UpdateValueTest, NeverTouchesTheOutcome) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {power(true), brightness(98)}));
  const auto command = performed(makeCommand(nullptr, {}));
  NDString outcome = "untouched";
  for (const char* type : {"INCREASE", "DECREASE", "SET"}) {
    EXPECT_TRUE(command->updateValue_forAction_outcome(
        home->characteristic("Lamp", kBrightness),
        makeAction({.type = type, .attribute = "BRIGHTNESS"}), &outcome));
  }
  EXPECT_TRUE(command->updateValue_forAction_outcome(
      home->characteristic("Lamp", kPower), makeAction({.type = "TOGGLE", .attribute = "POWER"}),
      &outcome));
  EXPECT_EQ(outcome, "untouched");
}

TEST_F(UpdateValueTest, TakesStepInFahrenheitOffTheMetricSystem) {
  inProcessWithLocale(false, [this] {
    const auto home = useHome(HomeBuilder("Cottage").thermostat(
        "Stove", {currentTemperature(20.0F), targetTemperature(21.0F)}));
    perform(
        makeCommand({.service = "Stove"},
                    {{.type = "INCREASE", .attribute = "TEMPERATURE", .value = integerValue(4)}}));
    // 20 degrees Celsius are 68 degrees Fahrenheit; 72 go back to Celsius.
    EXPECT_THAT(written(*home), ElementsAre("Stove=22.222221"));
    EXPECT_THAT(
        log(),
        ElementsAre("6 Incoming Filter: service=Stove/",
                    "6 Incoming Action: INCREASE/attribute=TEMPERATURE/value=4",
                    std::string("6 adjustGet: Characteristic ") + std::string(kTargetTemperature) +
                        " value 20  locale-adjusted to 68",
                    "6 adjustSet: Attribute TEMPERATURE value 72  locale-adjusted to 22.222221"));
  });
}

// The way back looks for the units in the place of the value type, so a step that is said in
// Celsius is taken in Celsius and its sum taken for Fahrenheit.
TEST_F(UpdateValueTest, TakesSumForFahrenheitWhateverTheUnits) {
  inProcessWithLocale(false, [this] {
    const auto home = useHome(HomeBuilder("Cottage").thermostat(
        "Stove", {currentTemperature(48.0F), targetTemperature(21.0F).withoutMetadata()}));
    perform(makeCommand(
        {.service = "Stove"},
        {{.type = "INCREASE", .attribute = "TEMPERATURE", .value = integerValue(2, "CELSIUS")}}));
    EXPECT_THAT(written(*home), ElementsAre("Stove=10"));
  });
}

}  // namespace
}  // namespace nidus
