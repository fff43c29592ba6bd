#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <utility>
#include <vector>

#include "Assistant/CommandTest.h"
#include "PlatformModel/NDPlatform.h"
#include "Support/InlineQueue.h"
#include "Support/TestTypes.h"

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;
using testing::UnorderedElementsAre;

class GetTest : public CommandTest {
 protected:
  /// Asks for an attribute of all services.
  void get(const char* attribute, const char* type = "GET", VAHAValueRef value = nullptr) {
    perform(makeCommand({.entityType = "SERVICE"},
                        {{.type = type, .attribute = attribute, .value = std::move(value)}}));
  }
};

TEST_F(GetTest, AnswersEveryObjectWithoutAttribute) {
  const auto home = useHome(HomeBuilder("Cottage").room("Hall").light("Lamp"));
  perform(makeCommand(Search(), {{.type = "GET"}}));
  EXPECT_THAT(replies(),
              ElementsAre("COMMAND_SUCCESS; Cottage SUCCESS; Lamp SUCCESS; Hall SUCCESS"));
  EXPECT_THAT(home->reads(), IsEmpty());
}

TEST_F(GetTest, ReadsTheValueFromTheAccessory) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40)}));
  home->characteristic("Lamp", kBrightness)->setDeviceValue(NDValue::integer(55));
  get("BRIGHTNESS");
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=55 PERCENTAGE"));
}

TEST_F(GetTest, ReadsOnceForAllServicesOfHome) {
  const auto home =
      useHome(HomeBuilder("Cottage").light("Lamp").light("Bulb").light("Strip", {brightness(1)}));
  get("POWER");
  ASSERT_THAT(home->reads(), SizeIs(1));
  EXPECT_THAT(batchesRead(*home)[0], ElementsAre(home->characteristic("Lamp", kPower),
                                                 home->characteristic("Bulb", kPower)));
  EXPECT_THAT(replies(),
              ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER=false; Bulb SUCCESS POWER=false"));
}

TEST_F(GetTest, KeepsDuplicatesInTheBatch) {
  const auto home =
      useHome(HomeBuilder("Cottage").light("Lamp").associated(NDString(kLightService)));
  perform(makeCommand({.serviceType = "LIGHT"}, {{.type = "GET", .attribute = "POWER"}}));
  EXPECT_THAT(home->reads(), ElementsAre(SizeIs(2)));
  EXPECT_THAT(replies(),
              ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER=false; Lamp SUCCESS POWER=false"));
}

TEST_F(GetTest, ReadsEachHomeAndReportsOnce) {
  const auto cottage = HomeBuilder("Cottage").light("Lamp").build();
  const auto flat = HomeBuilder("Flat").light("Fan").build();
  useHomes({cottage, flat});
  actInAllHomes({.type = "GET", .attribute = "POWER"});
  EXPECT_THAT(cottage->reads(), ElementsAre(SizeIs(1)));
  EXPECT_THAT(flat->reads(), ElementsAre(SizeIs(1)));
  EXPECT_THAT(replies(),
              ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER=false; Fan SUCCESS POWER=false"));
}

TEST_F(GetTest, FindsNoMatchWithoutCharacteristic) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  get("BRIGHTNESS");
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES"));
  EXPECT_THAT(home->reads(), IsEmpty());
}

TEST_F(GetTest, FindsNoMatchForUnknownAttribute) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  get("TASTE");
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(GetTest, ReadsTheReadType) {
  const auto home = useHome(HomeBuilder("Cottage").thermostat(
      "Stove", {currentTemperature(19.5F), targetTemperature(21.0F)}));
  get("TEMPERATURE");
  EXPECT_THAT(batchesRead(*home),
              ElementsAre(ElementsAre(home->characteristic("Stove", kCurrentTemperature))));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Stove SUCCESS TEMPERATURE=19.5 CELSIUS"));
}

TEST_F(GetTest, ReadsTheWriteTypeForTargetValue) {
  const auto home = useHome(HomeBuilder("Cottage").thermostat(
      "Stove", {currentTemperature(19.5F), targetTemperature(21.0F)}));
  get("TEMPERATURE", "GET_TARGET_VALUE");
  EXPECT_THAT(batchesRead(*home),
              ElementsAre(ElementsAre(home->characteristic("Stove", kTargetTemperature))));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Stove SUCCESS TEMPERATURE=21 CELSIUS"));
}

TEST_F(GetTest, NeedsTheReadTypeForTargetValueToo) {
  useHome(HomeBuilder("Cottage").thermostat("Stove", {targetTemperature(21.0F)}));
  get("TEMPERATURE", "GET_TARGET_VALUE");
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(GetTest, LeavesOutWhatDoesNotMatchTheValue) {
  useHome(HomeBuilder("Cottage").light("Lamp", {power(true)}).light("Bulb", {power(false)}));
  get("POWER", "GET", booleanValue(true));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER=true"));
}

TEST_F(GetTest, FindsNoMatchWhenNoValueMatches) {
  useHome(HomeBuilder("Cottage").light("Lamp", {power(false)}));
  get("POWER", "GET", booleanValue(true));
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(GetTest, TellsErrorsApart) {
  const auto home =
      useHome(HomeBuilder("Cottage").light("Lamp").light("Bulb").light("Strip").light("Spot"));
  home->characteristic("Lamp", kPower)->failReads(kNDErrorUnreachable);
  home->characteristic("Bulb", kPower)->failReads(kNDErrorNotWritable);
  home->characteristic("Strip", kPower)->failReads(kNDErrorNotReadable);
  get("POWER", "GET", booleanValue(false));
  EXPECT_THAT(replies(),
              ElementsAre("COMMAND_SUCCESS; Lamp UNREACHABLE POWER; Bulb FAILURE POWER; Strip "
                          "FAILURE POWER; Spot SUCCESS POWER=false"));
}

TEST_F(GetTest, FindsNoMatchWhenTheBatchFails) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->failReads(kNDErrorUnreachable);
  get("POWER");
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(GetTest, ReportsUnlockAndThenWhatWasRead) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp").light("Bulb").light("Strip"));
  home->characteristic("Bulb", kPower)->failReads(kNDErrorMustUnlock);
  get("POWER");
  EXPECT_THAT(replies(),
              ElementsAre("REQUIRES_UNLOCK", "COMMAND_SUCCESS; Lamp SUCCESS POWER=false"));
}

TEST_F(GetTest, ReportsUnlockOfTheWholeBatch) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->failReads(kNDErrorMustUnlock);
  get("POWER");
  EXPECT_THAT(replies(), ElementsAre("REQUIRES_UNLOCK", "FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(GetTest, ReportsUnlockOfEachHome) {
  const auto cottage = HomeBuilder("Cottage").light("Lamp").light("Strip").build();
  const auto flat = HomeBuilder("Flat").light("Fan").build();
  useHomes({cottage, flat});
  cottage->characteristic("Strip", kPower)->failReads(kNDErrorMustUnlock);
  flat->failReads(kNDErrorMustUnlock);
  actInAllHomes({.type = "GET", .attribute = "POWER"});
  EXPECT_THAT(replies(), ElementsAre("REQUIRES_UNLOCK", "REQUIRES_UNLOCK",
                                     "COMMAND_SUCCESS; Lamp SUCCESS POWER=false"));
}

TEST_F(GetTest, LeavesTheGroupBeforeItReportsTheUnlock) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->failReads(kNDErrorMustUnlock);
  bool isReportWaiting = false;
  onReply([&] { isReportWaiting = isReportWaiting || runOneOfMainQueue(); });
  get("POWER");
  EXPECT_TRUE(isReportWaiting);
  EXPECT_THAT(replies(), UnorderedElementsAre("REQUIRES_UNLOCK", "FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(GetTest, WaitsForTheLastHome) {
  const auto cottage = HomeBuilder("Cottage").light("Lamp").build();
  const auto flat = HomeBuilder("Flat").light("Fan").build();
  useHomes({cottage, flat});
  cottage->holdAnswers();
  actInAllHomes({.type = "GET", .attribute = "POWER"});
  EXPECT_THAT(replies(), IsEmpty());
  cottage->releaseAnswers();
  runUntilIdle();
  EXPECT_THAT(replies(),
              ElementsAre("COMMAND_SUCCESS; Fan SUCCESS POWER=false; Lamp SUCCESS POWER=false"));
}

TEST_F(GetTest, ReportsOnTheMainQueue) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->holdAnswers();
  get("POWER");
  home->releaseAnswers();
  EXPECT_THAT(replies(), IsEmpty());
  EXPECT_TRUE(runOneOfMainQueue());
  EXPECT_THAT(replies(), SizeIs(1));
}

TEST_F(GetTest, HomeMayAnswerAtOnce) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->answerOn(std::make_shared<InlineQueue>());
  get("POWER");
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS POWER=false"));
}

TEST_F(GetTest, RepliesNothingWithoutAnswer) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->holdAnswers();
  get("POWER");
  EXPECT_THAT(replies(), IsEmpty());
  EXPECT_FALSE(isHandlerReleased());
  home->dropAnswers();
  runUntilIdle();
  EXPECT_THAT(replies(), IsEmpty());
  EXPECT_TRUE(isHandlerReleased());
}

TEST_F(GetTest, LetsGoOfTheHandlerAfterEachReply) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp").light("Bulb"));
  get("POWER");
  EXPECT_TRUE(isHandlerReleased());
  get("BRIGHTNESS");
  EXPECT_TRUE(isHandlerReleased());
  home->characteristic("Bulb", kPower)->failReads(kNDErrorMustUnlock);
  get("POWER");
  EXPECT_TRUE(isHandlerReleased());
}

TEST_F(GetTest, LetsGoOfTheHandlerOnceThePlatformIsGone) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp"));
  home->holdAnswers();
  const auto command = performed(makeCommand(nullptr, {}));
  NDPlatform::unregisterPlatform(NDPlatform::registered());
  command->handleGetActionTypes_serviceType_forObjects_completionHandler(
      makeAction({.type = "GET", .attribute = "POWER"}), nullptr, command->allObjects(), handler());
  home->releaseAnswers();
  runUntilIdle();
  EXPECT_THAT(replies(), IsEmpty());
  EXPECT_TRUE(isHandlerReleased());
}

class GetMetadataTest : public CommandTest {
 protected:
  void get(const char* type, const char* attribute, VAHAValueRef value = nullptr) {
    perform(makeCommand({.entityType = "SERVICE"},
                        {{.type = type, .attribute = attribute, .value = std::move(value)}}));
  }
};

TEST_F(GetMetadataTest, AnswersEveryObjectWithoutAttribute) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  get("GET_MINIMUM", nullptr);
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS"));
}

TEST_F(GetMetadataTest, TellsEachLimitWithoutReading) {
  const auto home = useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40)}));
  get("GET_MINIMUM", "BRIGHTNESS");
  get("GET_MAXIMUM", "BRIGHTNESS");
  get("GET_STEP_VALUE", "BRIGHTNESS");
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=0 percentage",
                                     "COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=100 percentage",
                                     "COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=1 percentage"));
  EXPECT_THAT(home->reads(), IsEmpty());
}

TEST_F(GetMetadataTest, ReportsBeforeItReturns) {
  useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40)}));
  const auto command = performed(makeCommand(nullptr, {}));
  command->handleGetMetadataActionTypes_serviceType_forObjects_completionHandler(
      makeAction({.type = "GET_MAXIMUM", .attribute = "BRIGHTNESS"}), nullptr,
      command->allObjects(), handler());
  EXPECT_THAT(replies(), SizeIs(1));
}

TEST_F(GetMetadataTest, FindsServicesByTheReadType) {
  useHome(HomeBuilder("Cottage")
              .thermostat("Sensor", {currentTemperature(19.0F)})
              .thermostat("Radiator", {targetTemperature(21.0F)}));
  get("GET_MINIMUM", "TEMPERATURE");
  // The sensor has no characteristic of the write type, whose limits would be told.
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Sensor SUCCESS TEMPERATURE"));
}

TEST_F(GetMetadataTest, LeavesOutOtherObjectsQuietly) {
  useHome(HomeBuilder("Cottage").light("Lamp", {brightness(40)}).room("Hall"));
  perform(makeCommand(Search(), {{.type = "GET_MAXIMUM", .attribute = "BRIGHTNESS"}}));
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=100 percentage"));
  EXPECT_THAT(log(4), IsEmpty());
}

TEST_F(GetMetadataTest, LeavesOutServicesWithoutTheLimit) {
  useHome(HomeBuilder("Cottage")
              .light("Lamp", {brightness(40)})
              .light("Bulb", {brightness(40).limits(nullptr, nullptr)})
              .light("Strip", {brightness(40).withoutMetadata()}));
  get("GET_MAXIMUM", "BRIGHTNESS");
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Lamp SUCCESS BRIGHTNESS=100 percentage"));
}

TEST_F(GetMetadataTest, FindsNoMatchWithoutCharacteristic) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  get("GET_MAXIMUM", "BRIGHTNESS");
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES"));
}

class ReturnResultsTest : public CommandTest {};

TEST_F(ReturnResultsTest, KeepsResultsThatAreNoAnswer) {
  useHome(HomeBuilder("Cottage").light("Lamp", {power(false)}));
  const auto command = performed(makeCommand(nullptr, {}));
  command->returnResults_serviceType_forAction_completionHandler(
      command->allObjects(), nullptr,
      makeAction({.type = "GET", .attribute = "POWER", .value = booleanValue(true)}), handler());
  EXPECT_THAT(replies(), ElementsAre("COMMAND_SUCCESS; Cottage SUCCESS POWER; Lamp SUCCESS "
                                     "POWER=false"));
}

TEST_F(ReturnResultsTest, FindsNoMatchForNoObjects) {
  useHome(HomeBuilder("Cottage"));
  const auto command = performed(makeCommand(nullptr, {}));
  command->returnResults_serviceType_forAction_completionHandler(std::nullopt, nullptr, nullptr,
                                                                 handler());
  command->returnResults_serviceType_forAction_completionHandler(NDAssistantCommand::ObjectList(),
                                                                 nullptr, nullptr, handler());
  EXPECT_THAT(replies(), ElementsAre("FOUND_NO_MATCHING_ENTITIES", "FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(ReturnResultsTest, NamesTheServiceTypeAskedFor) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  const auto command = performed(makeCommand(nullptr, {}));
  NDDictionary reply;
  command->returnResults_serviceType_forAction_completionHandler(
      NDAssistantCommand::ObjectList{command->allObjects().back()}, "OUTLET",
      makeAction({.type = "GET", .attribute = "POWER"}),
      [&reply](const NDDictionary& given) { reply = given; });
  EXPECT_THAT(entityTexts(reply, "serviceType"), ElementsAre("OUTLET"));
}

}  // namespace
}  // namespace nidus
