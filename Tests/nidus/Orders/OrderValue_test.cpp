#include <gtest/gtest.h>

#include <vector>

#include "nidus/Orders/OrderTexts.h"

namespace nidus {
namespace {

struct ValueCase {
  std::string line;
  std::string expected;
};

void expectValues(const std::vector<ValueCase>& cases, bool isMetric = true) {
  for (const ValueCase& tried : cases) {
    SCOPED_TRACE(tried.line);
    EXPECT_EQ(actionsOf(tried.line, isMetric), tried.expected);
  }
}

TEST(OrderValueTest, ReadsWordsForYesAndNo) {
  expectValues({
      {"set power on", "SET POWER boolean 1"},
      {"set power OFF", "SET POWER boolean 0"},
      {"set power yes", "SET POWER boolean 1"},
      {"set power no", "SET POWER boolean 0"},
      {"set power True", "SET POWER boolean 1"},
      {"set power false", "SET POWER boolean 0"},
      {"set locked locked", "SET LOCKED boolean 1"},
      {"set locked unlocked", "SET LOCKED boolean 0"},
      {"set open open", "SET OPEN boolean 1"},
      {"set open closed", "SET OPEN boolean 0"},
      {"get contact is open", "GET CONTACT boolean 0"},
      {"get contact is closed", "GET CONTACT boolean 1"},
      {"set mute muted", "SET MUTE boolean 1"},
      {"set mute unmuted", "SET MUTE boolean 0"},
  });
}

TEST(OrderValueTest, ReadsNumbersInTheClassOfTheAttribute) {
  expectValues({
      {"set brightness 40", "SET BRIGHTNESS 40"},
      {"set brightness +40", "SET BRIGHTNESS 40"},
      {"set brightness -5", "SET BRIGHTNESS -5"},
      {"set brightness 2147483647", "SET BRIGHTNESS 2147483647"},
      {"set hue 40", "SET HUE float 40"},
      {"set hue -0.5", "SET HUE float -0.5"},
      {"set hue .5", "SET HUE float 0.5"},
      {"get brightness is 40", "GET BRIGHTNESS 40"},
      {"get hue is 40", "GET HUE float 40"},
  });
}

TEST(OrderValueTest, TakesTheUnitOfTheAttribute) {
  expectValues({
      {"set brightness 40%", "SET BRIGHTNESS 40"},
      {"set brightness 40 %", "SET BRIGHTNESS 40"},
      {"set brightness 40 percent", "SET BRIGHTNESS 40"},
      {"set brightness 40 percentage", "SET BRIGHTNESS 40"},
      {"set hue 120°", "SET HUE float 120"},
      {"set color_temperature 250mired", "SET COLOR_TEMPERATURE 250"},
      {"get light_level is 180.5lx", "GET LIGHT_LEVEL float 180.5"},
      {"get carbon_dioxide_level is 640 PPM", "GET CARBON_DIOXIDE_LEVEL float 640"},
  });
}

TEST(OrderValueTest, ReadsTheWordsOfTheAttribute) {
  expectValues({
      {"set climate_mode heat", "SET CLIMATE_MODE text HEAT"},
      {"set climate_mode OFF", "SET CLIMATE_MODE text OFF"},
      {"get security_mode is Away", "GET SECURITY_MODE text AWAY"},
      {"set climate_mode heet", "heet: did you mean HEAT?"},
      {"set climate_mode purple", "purple: CLIMATE_MODE takes one of OFF, HEAT, COOL, AUTO"},
  });
}

TEST(OrderValueTest, RefusesWhatTheAttributeDoesNotTake) {
  const std::string wholeNumber = ": BRIGHTNESS takes a whole number, such as 40 or 40%";
  const std::string temperature = ": TEMPERATURE takes a temperature, such as 21.5C, 70F or 21.5";
  expectValues({
      {"set brightness blue", "blue" + wholeNumber},
      {"set brightness on", "on" + wholeNumber},
      {"set brightness 40.5", "40.5" + wholeNumber},
      {"set brightness 20C", "20C" + wholeNumber},
      {"set brightness 2147483648", "2147483648" + wholeNumber},
      {"set brightness 99999999999999999999", "99999999999999999999" + wholeNumber},
      {"set brightness 40x", "40x" + wholeNumber},
      {"set brightness -", "-" + wholeNumber},
      {"set temperature 40%", "40%" + temperature},
      {"set temperature nan", "nan" + temperature},
      {"set temperature warm", "warm" + temperature},
      {"raise temperature 3%", "3%" + temperature},
      {"set hue 4e1", "4e1: HUE takes a number, such as 40 or 40.5"},
      {"set hue 20F", "20F: HUE takes a number, such as 40 or 40.5"},
      {"set speed fast", "fast: SPEED takes a number, such as 40 or 40% or 40.5"},
      {"set power maximum", "maximum: POWER takes on or off, yes or no, true or false"},
      {"set power locked", "locked: POWER takes on or off, yes or no, true or false"},
      {"set locked 1", "1: LOCKED takes locked or unlocked, on or off, yes or no, true or false"},
      {"set climate_mode max", "max: CLIMATE_MODE takes one of OFF, HEAT, COOL, AUTO"},
      {"set hue 1" + std::string(60, '0'),
       "1" + std::string(60, '0') + ": HUE takes a number, such as 40 or 40.5"},
  });
}

TEST(OrderValueTest, SendsATemperatureWithAUnitInCelsius) {
  const std::vector<ValueCase> cases = {
      {"set temperature 21.5C", "SET TEMPERATURE float 21.5 CELSIUS"},
      {"set temperature 21.5°C", "SET TEMPERATURE float 21.5 CELSIUS"},
      {"set temperature 21.5 celsius", "SET TEMPERATURE float 21.5 CELSIUS"},
      {"set temperature 70F", "SET TEMPERATURE float 21.11111 CELSIUS"},
      {"set temperature 70°f", "SET TEMPERATURE float 21.11111 CELSIUS"},
      {"set temperature -40 fahrenheit", "SET TEMPERATURE float -40 CELSIUS"},
      {"set heating_threshold 68F", "SET HEATING_THRESHOLD float 20 CELSIUS"},
      {"set cooling_threshold 26C", "SET COOLING_THRESHOLD float 26 CELSIUS"},
  };
  expectValues(cases, true);
  expectValues(cases, false);
}

TEST(OrderValueTest, SendsADifferenceInTheUnitOfTheDevice) {
  expectValues({{"raise temperature 5F", "INCREASE TEMPERATURE float 2.7777777"},
                {"lower temperature 2C", "DECREASE TEMPERATURE float 2"},
                {"raise heating_threshold 9F", "INCREASE HEATING_THRESHOLD float 5"}},
               true);
  expectValues({{"raise temperature 5F", "INCREASE TEMPERATURE float 5"},
                {"lower temperature 2C", "DECREASE TEMPERATURE float 3.6"}},
               false);
}

TEST(OrderValueTest, AsksInTheUnitOfThePerson) {
  for (const bool isMetric : {true, false}) {
    expectValues({{"get temperature is 70F", "GET TEMPERATURE float 70 FAHRENHEIT"},
                  {"get temperature is 21.5C", "GET TEMPERATURE float 21.5 CELSIUS"},
                  {"get temperature is 70", "GET TEMPERATURE float 70"}},
                 isMetric);
  }
}

TEST(OrderValueTest, SendsATemperatureWithoutAUnitAsItIs) {
  for (const bool isMetric : {true, false}) {
    expectValues({{"set temperature 20", "SET TEMPERATURE float 20"},
                  {"raise temperature 3", "INCREASE TEMPERATURE float 3"},
                  {"lower temperature", "DECREASE TEMPERATURE"}},
                 isMetric);
  }
}

TEST(OrderValueTest, SendsThresholdsSoThatFahrenheitIsUnderstood) {
  expectValues({{"set heating_threshold 20", "SET HEATING_THRESHOLD float 20"},
                {"raise heating_threshold", "INCREASE HEATING_THRESHOLD"}},
               true);
  expectValues({{"set heating_threshold 68", "SET HEATING_THRESHOLD float 20 CELSIUS"},
                {"raise heating_threshold 9F", "INCREASE HEATING_THRESHOLD float 5 CELSIUS"},
                {"lower heating_threshold 9", "DECREASE HEATING_THRESHOLD float 5 CELSIUS"},
                {"raise heating_threshold", "INCREASE HEATING_THRESHOLD float 2.7777777 CELSIUS"},
                {"get heating_threshold is 68", "GET HEATING_THRESHOLD float 68"}},
               false);
}

/// Attributes of a kind that the built-in vocabulary does not have.
class OwnVocabularyTest : public ::testing::Test {
 protected:
  OwnVocabularyTest() {
    add("NOTE", "string", nullptr);
    add("level", "uint8", nullptr);
    add("DATA", "tlv8", nullptr);
    add("OVEN", "float", "fahrenheit");
    add("BOILER", "int", "celsius");
    vocabulary_.units = {{"FAHRENHEIT", "fahrenheit"}, {"CELSIUS", "celsius"}};
  }
  void add(const char* name, const char* valueType, const NDString& unit) {
    CharacteristicEntry entry;
    entry.assistantName = name;
    entry.read = name;
    entry.write = name;
    entry.valueType = valueType;
    entry.unit = unit;
    vocabulary_.characteristics.push_back(entry);
  }
  void expectValues(const std::vector<ValueCase>& cases) const {
    for (const ValueCase& tried : cases) {
      SCOPED_TRACE(tried.line);
      EXPECT_EQ(actionsOf(tried.line, vocabulary_), tried.expected);
    }
  }

  Vocabulary vocabulary_;
};

TEST_F(OwnVocabularyTest, TakesAnyText) {
  expectValues({
      {"set note Back at noon", "SET NOTE text Back at noon"},
      {"set note maximum", "SET NOTE text maximum"},
      {"get note is 40%", "GET NOTE text 40%"},
  });
}

TEST_F(OwnVocabularyTest, KeepsWholeNumbersInTheirRange) {
  expectValues({
      {"set LEVEL 255", "SET level 255"},
      {"set Level 256", "256: level takes a whole number, such as 40"},
      {"set level -1", "-1: level takes a whole number, such as 40"},
      {"set level max", "SET_TO_MAXIMUM level"},
      {"raise level", "raise level: it is no number that can be raised or lowered; use nidus set"},
  });
}

TEST_F(OwnVocabularyTest, RefusesValuesThatAreNoWords) {
  expectValues({
      {"get data", "GET DATA"},
      {"set data 1", "1: values of DATA can not be written in words; use nidus perform"},
  });
}

TEST_F(OwnVocabularyTest, ConvertsToAUnitThatDoesNotFollowTheDevice) {
  expectValues({
      {"set oven 100C", "SET OVEN float 212 FAHRENHEIT"},
      {"set oven 350F", "SET OVEN float 350 FAHRENHEIT"},
      {"set oven 350", "SET OVEN float 350"},
      {"get oven is 100C", "GET OVEN float 212 FAHRENHEIT"},
      {"raise oven 10C", "INCREASE OVEN float 18"},
      {"set boiler 140F", "SET BOILER 60 CELSIUS"},
      {"raise boiler 9F", "INCREASE BOILER 5"},
  });
}

}  // namespace
}  // namespace nidus
