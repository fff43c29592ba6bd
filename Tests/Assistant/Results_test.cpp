#include "Assistant/Results.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <utility>

#include "Assistant/CommandTest.h"
#include "Assistant/Entities.h"
#include "Support/TestTypes.h"

namespace nidus {
namespace {

class ResultsTest : public CommandTest {
 protected:
  ResultsTest() { result_.setOutcome(VAHAActionOutcomeSUCCESSValue); }

  /// Fills the result for the first service called "Lamp" of `builder`'s home.
  bool fill(HomeBuilder& builder, const Action& action, const NDString& serviceType = nullptr) {
    home_ = builder.build();
    return populateResultWithService(result_, serviceType, makeAction(action),
                                     home_->service("Lamp"));
  }
  bool fill(HomeBuilder&& builder, const Action& action, const NDString& serviceType = nullptr) {
    return fill(builder, action, serviceType);
  }

  std::shared_ptr<TestHome> home_;
  VAHAActionResult result_;
};

TEST_F(ResultsTest, TellsTheEntityAloneWithoutAttribute) {
  EXPECT_TRUE(fill(HomeBuilder("Cottage").light("Lamp"), {.type = "GET"}));
  EXPECT_EQ(summary(result_), "Lamp SUCCESS");
  ASSERT_TRUE(result_.entity());
  EXPECT_EQ(result_.entity()->serviceType(), "LIGHT");
}

TEST_F(ResultsTest, NamesTheServiceTypeAskedFor) {
  EXPECT_TRUE(fill(HomeBuilder("Cottage").light("Lamp"), {.type = "GET"}, "SWITCH"));
  EXPECT_EQ(result_.entity()->serviceType(), "SWITCH");
}

TEST_F(ResultsTest, GivesNoValueToFailures) {
  for (const char* outcome : {"UNREACHABLE", "FAILURE", "READ_ONLY", "success"}) {
    SCOPED_TRACE(outcome);
    result_.setOutcome(outcome);
    EXPECT_TRUE(fill(HomeBuilder("Cottage").light("Lamp", {power(false)}),
                     {.type = "GET", .attribute = "POWER", .value = booleanValue(true)}));
    EXPECT_EQ(summary(result_), "Lamp " + std::string(outcome) + " POWER");
  }
}

TEST_F(ResultsTest, GivesNoValueWithoutOutcome) {
  result_.setOutcome(nullptr);
  EXPECT_TRUE(fill(HomeBuilder("Cottage").light("Lamp"), {.type = "GET", .attribute = "POWER"}));
  EXPECT_FALSE(result_.resultValue());
}

TEST_F(ResultsTest, ReadsTheTypeThatTheActionIsAbout) {
  struct Case {
    const char* type;
    const char* value;
  };
  const Case cases[] = {{nullptr, "=19.5 CELSIUS"},
                        {"GET", "=19.5 CELSIUS"},
                        {"GET_TARGET_VALUE", "=21 CELSIUS"},
                        {"SET", "=21 CELSIUS"},
                        {"INCREASE", "=21 CELSIUS"},
                        {"DECREASE", "=21 CELSIUS"},
                        {"SET_TO_MINIMUM", "=10 celsius"},
                        {"SET_TO_MAXIMUM", "=38 celsius"},
                        {"GET_MINIMUM", "=10 celsius"},
                        {"GET_MAXIMUM", "=38 celsius"},
                        {"GET_STEP_VALUE", "=0.5 celsius"},
                        {"TOGGLE", ""},
                        {"MELT", ""}};
  for (const Case& test : cases) {
    SCOPED_TRACE(test.type ? test.type : "none");
    result_ = VAHAActionResult();
    result_.setOutcome(VAHAActionOutcomeSUCCESSValue);
    EXPECT_TRUE(fill(HomeBuilder("Cottage").thermostat(
                         "Lamp", {currentTemperature(19.5F), targetTemperature(21.0F)}),
                     {.type = test.type, .attribute = "TEMPERATURE"}));
    EXPECT_EQ(summary(result_), "Lamp SUCCESS TEMPERATURE" + std::string(test.value));
  }
}

TEST_F(ResultsTest, GivesNoValueWithoutCharacteristic) {
  EXPECT_TRUE(fill(HomeBuilder("Cottage").light("Lamp"),
                   {.type = "GET", .attribute = "BRIGHTNESS", .value = integerValue(1)}));
  EXPECT_EQ(summary(result_), "Lamp SUCCESS BRIGHTNESS");
}

TEST_F(ResultsTest, GivesNoValueForUnknownAttribute) {
  EXPECT_TRUE(fill(HomeBuilder("Cottage").light("Lamp"), {.type = "GET", .attribute = "TASTE"}));
  EXPECT_EQ(summary(result_), "Lamp SUCCESS TASTE");
}

TEST_F(ResultsTest, ComparesQuestionsWithTheirValue) {
  struct Case {
    const char* type;
    bool isOn;
    bool isAnswer;
  };
  for (const Case& test :
       {Case{"GET", false, false}, Case{"GET", true, true}, Case{nullptr, false, false},
        Case{nullptr, true, true}, Case{"SET", false, true}, Case{"GET_TARGET_VALUE", false, true},
        Case{"INCREASE", false, true}}) {
    SCOPED_TRACE(std::string(test.type ? test.type : "none") + (test.isOn ? " on" : " off"));
    EXPECT_EQ(fill(HomeBuilder("Cottage").light("Lamp", {power(test.isOn)}),
                   {.type = test.type, .attribute = "POWER", .value = booleanValue(true)}),
              test.isAnswer);
    EXPECT_EQ(result_.outcome(), "SUCCESS");
  }
}

TEST_F(ResultsTest, ComparesTypeAndNumber) {
  EXPECT_FALSE(fill(HomeBuilder("Cottage").light("Lamp", {brightness(40)}),
                    {.type = "GET", .attribute = "BRIGHTNESS", .value = floatValue(40)}));
  EXPECT_TRUE(fill(HomeBuilder("Cottage").light("Lamp", {brightness(40)}),
                   {.type = "GET", .attribute = "BRIGHTNESS", .value = integerValue(40)}));
}

TEST_F(ResultsTest, SpeaksTheAssistantsWords) {
  EXPECT_TRUE(fill(HomeBuilder("Cottage").thermostat(
                       "Lamp", {CharacteristicSpec(kCurrentClimateMode).value(1).format("int")}),
                   {.type = "GET", .attribute = "CLIMATE_MODE"}));
  EXPECT_EQ(summary(result_), "Lamp SUCCESS CLIMATE_MODE='HEAT'");
}

TEST_F(ResultsTest, ReadsMissingValueAsNothing) {
  EXPECT_TRUE(fill(HomeBuilder("Cottage").light("Lamp", {power(true).value(NDValueRef())}),
                   {.type = "GET", .attribute = "POWER"}));
  EXPECT_EQ(summary(result_), "Lamp SUCCESS POWER=false");
}

TEST_F(ResultsTest, ReportsCelsiusInTheMetricSystem) {
  inProcessWithLocale(true, [this] {
    EXPECT_TRUE(fill(HomeBuilder("Cottage").thermostat("Lamp", {currentTemperature(22.5F)}),
                     {.type = "GET", .attribute = "TEMPERATURE"}));
    EXPECT_EQ(summary(result_), "Lamp SUCCESS TEMPERATURE=22.5 CELSIUS");
  });
}

TEST_F(ResultsTest, ReportsFahrenheitOffTheMetricSystem) {
  inProcessWithLocale(false, [this] {
    EXPECT_TRUE(fill(HomeBuilder("Cottage").thermostat("Lamp", {currentTemperature(22.5F)}),
                     {.type = "GET", .attribute = "TEMPERATURE"}));
    EXPECT_EQ(summary(result_), "Lamp SUCCESS TEMPERATURE=72.5 FAHRENHEIT");
  });
}

TEST_F(ResultsTest, ReportsInTheUnitsOfTheQuestion) {
  inProcessWithLocale(true, [this] {
    EXPECT_FALSE(fill(
        HomeBuilder("Cottage").thermostat("Lamp", {currentTemperature(22.5F)}),
        {.type = "GET", .attribute = "TEMPERATURE", .value = floatValue(72.0F, "FAHRENHEIT")}));
    EXPECT_EQ(summary(result_), "Lamp SUCCESS TEMPERATURE=72.5 FAHRENHEIT");
    EXPECT_TRUE(fill(
        HomeBuilder("Cottage").thermostat("Lamp", {currentTemperature(22.5F)}),
        {.type = "GET", .attribute = "TEMPERATURE", .value = floatValue(72.5F, "FAHRENHEIT")}));
  });
}

TEST_F(ResultsTest, KeepsLimitsInTheirOwnUnits) {
  inProcessWithLocale(false, [this] {
    EXPECT_TRUE(fill(HomeBuilder("Cottage").thermostat("Lamp", {targetTemperature(20.0F)}),
                     {.type = "GET_MAXIMUM", .attribute = "TEMPERATURE"}));
    EXPECT_EQ(summary(result_), "Lamp SUCCESS TEMPERATURE=38 celsius");
  });
}

TEST_F(ResultsTest, IsNoAnswerWithoutMetadata) {
  for (const char* type :
       {"GET_MINIMUM", "GET_MAXIMUM", "GET_STEP_VALUE", "SET_TO_MINIMUM", "SET_TO_MAXIMUM"}) {
    SCOPED_TRACE(type);
    EXPECT_FALSE(fill(HomeBuilder("Cottage").light("Lamp", {brightness(1).withoutMetadata()}),
                      {.type = type, .attribute = "BRIGHTNESS"}));
    EXPECT_EQ(summary(result_), "Lamp SUCCESS BRIGHTNESS");
  }
}

TEST_F(ResultsTest, MakesZeroOfMissingLimit) {
  for (const char* type :
       {"GET_MINIMUM", "GET_MAXIMUM", "GET_STEP_VALUE", "SET_TO_MINIMUM", "SET_TO_MAXIMUM"}) {
    SCOPED_TRACE(type);
    EXPECT_FALSE(
        fill(HomeBuilder("Cottage").light("Lamp", {brightness(1).limits(nullptr, nullptr)}),
             {.type = type, .attribute = "BRIGHTNESS"}));
    EXPECT_EQ(summary(result_), "Lamp SUCCESS BRIGHTNESS=0 percentage");
  }
}

TEST_F(ResultsTest, MakesStringWithoutStringOfMissingLimit) {
  EXPECT_FALSE(fill(HomeBuilder("Cottage").thermostat(
                        "Lamp", {CharacteristicSpec(kTargetClimateMode).value(1).format("int")}),
                    {.type = "GET_MAXIMUM", .attribute = "CLIMATE_MODE"}));
  EXPECT_EQ(summary(result_), "Lamp SUCCESS CLIMATE_MODE=null");
}

TEST_F(ResultsTest, TellsLimitsUnmapped) {
  EXPECT_TRUE(fill(
      HomeBuilder("Cottage").thermostat(
          "Lamp", {CharacteristicSpec(kTargetClimateMode).value(1).format("int").limits(0, 3, 1)}),
      {.type = "GET_MAXIMUM", .attribute = "CLIMATE_MODE"}));
  EXPECT_EQ(summary(result_), "Lamp SUCCESS CLIMATE_MODE='3'");
}

TEST_F(ResultsTest, ComparesLimitQueriesWithTheirValue) {
  const auto light = [] { return HomeBuilder("Cottage").light("Lamp", {brightness(1)}); };
  EXPECT_TRUE(fill(light(),
                   {.type = "GET_MAXIMUM", .attribute = "BRIGHTNESS", .value = integerValue(100)}));
  EXPECT_FALSE(
      fill(light(), {.type = "GET_MAXIMUM", .attribute = "BRIGHTNESS", .value = integerValue(99)}));
  EXPECT_TRUE(fill(
      light(), {.type = "SET_TO_MAXIMUM", .attribute = "BRIGHTNESS", .value = integerValue(99)}));
  EXPECT_TRUE(fill(
      light(), {.type = "SET_TO_MINIMUM", .attribute = "BRIGHTNESS", .value = integerValue(99)}));
}

// The value replaces what the missing limit has said.
TEST_F(ResultsTest, TakesZeroForMissingLimitInQuestions) {
  EXPECT_TRUE(fill(HomeBuilder("Cottage").light("Lamp", {brightness(1).limits(nullptr, nullptr)}),
                   {.type = "GET_MAXIMUM", .attribute = "BRIGHTNESS", .value = integerValue(0)}));
}

TEST_F(ResultsTest, CopesWithoutService) {
  EXPECT_TRUE(populateResultWithService(
      result_, nullptr, makeAction({.type = "GET", .attribute = "POWER"}), nullptr));
  EXPECT_EQ(summary(result_), "? SUCCESS POWER");
  EXPECT_EQ(result_.entity()->serviceType(), "CUSTOM");
  EXPECT_FALSE(result_.entity()->home());
  EXPECT_FALSE(result_.entity()->room());
}

TEST_F(ResultsTest, CopesWithoutAction) {
  const auto home = HomeBuilder("Cottage").light("Lamp").build();
  EXPECT_TRUE(populateResultWithService(result_, nullptr, nullptr, home->service("Lamp")));
  EXPECT_EQ(summary(result_), "Lamp SUCCESS");
}

class ResultOfObjectTest : public ResultsTest {
 protected:
  /// Fills the result for the record at `index` of the snapshot of `builder`'s home.
  bool fillRecord(HomeBuilder& builder, std::size_t index, const VAHAActionRef& action) {
    useHome(builder);
    command_ = performed(makeCommand(nullptr, {}));
    return populateResultWithObject(result_, nullptr, action, *command_->allObjects().at(index),
                                    command_->gather());
  }
  std::shared_ptr<NDAssistantCommand> command_;
};

TEST_F(ResultOfObjectTest, FillsServiceByItsLiveService) {
  EXPECT_FALSE(
      fillRecord(HomeBuilder("Cottage").light("Lamp", {power(false)}), 1,
                 makeAction({.type = "GET", .attribute = "POWER", .value = booleanValue(true)})));
  EXPECT_EQ(summary(result_), "Lamp SUCCESS POWER=false");
}

TEST_F(ResultOfObjectTest, FillsServiceByItsRecordWithoutAttribute) {
  EXPECT_TRUE(fillRecord(HomeBuilder("Cottage").light("Lamp"), 1, makeAction({.type = "GET"})));
  EXPECT_EQ(summary(result_), "Lamp SUCCESS");
  result_ = VAHAActionResult();
  EXPECT_TRUE(fillRecord(HomeBuilder("Cottage").light("Lamp"), 1, nullptr));
  EXPECT_EQ(result_.entity()->name(), "Lamp");
}

TEST_F(ResultOfObjectTest, CopesWithServiceThatIsGone) {
  useHome(HomeBuilder("Cottage").light("Lamp"));
  const auto command = performed(makeCommand(nullptr, {}));
  EXPECT_TRUE(populateResultWithObject(result_, nullptr,
                                       makeAction({.type = "GET", .attribute = "POWER"}),
                                       *command->allObjects().back(), nullptr));
  EXPECT_EQ(summary(result_), "? SUCCESS POWER");
}

TEST_F(ResultOfObjectTest, TakesNothingButTheAttributeForRooms) {
  EXPECT_TRUE(
      fillRecord(HomeBuilder("Cottage").room("Hall"), 1,
                 makeAction({.type = "GET", .attribute = "POWER", .value = booleanValue(true)})));
  EXPECT_EQ(summary(result_), "Hall SUCCESS POWER");
  EXPECT_EQ(result_.entity()->entityType(), "ROOM");
}

TEST_F(ResultsTest, FillsReadyEntity) {
  auto entity = VAHAEntity::entity();
  entity->setName("Good night");
  EXPECT_TRUE(populateResultWithEntity(result_, makeAction({.attribute = "ENABLED"}), entity));
  EXPECT_EQ(result_.entity(), entity);
  EXPECT_EQ(result_.resultAttribute(), "ENABLED");
  EXPECT_FALSE(result_.resultValue());
}

TEST_F(ResultsTest, FillsNullEntity) {
  EXPECT_TRUE(populateResultWithEntity(result_, nullptr, nullptr));
  EXPECT_FALSE(result_.resultAttribute());
  EXPECT_FALSE(result_.entity());
}

}  // namespace
}  // namespace nidus
