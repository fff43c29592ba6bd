#include <algorithm>

#include "nidus/ProgramTest.h"
#include "nidus/TerminalProcess.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::ContainsRegex;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;
using ::testing::StartsWith;

/// Gives orders for the demonstration home.
class OrdersTest : public ProgramTest {
 protected:
  void SetUp() override {
    const ProgramEnd end = run({"home", "import", NIDUS_RESOURCES "/demonstration-home.json"});
    ASSERT_EQ(end.exitStatus, 0) << end.errors;
  }
  [[nodiscard]] ProgramEnd runWithLocale(const std::string& locale,
                                         std::vector<std::string> arguments) const {
    ProgramStart order = start(std::move(arguments));
    order.environment = {{"LC_ALL", locale}};
    return runProgram(order);
  }
  /// The reply to an order, as JSON.
  [[nodiscard]] std::string replyTo(std::vector<std::string> arguments) const {
    arguments.emplace_back("--json");
    return run(std::move(arguments)).output;
  }
};

TEST_F(OrdersTest, TellsValues) {
  const ProgramEnd end = run({"get", "brightness", "--service", "Desk Lamp"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, AllOf(HasSubstr("Desk Lamp"), HasSubstr("90"), HasSubstr("1 light")));
  EXPECT_THAT(end.errors, IsEmpty());
}

TEST_F(OrdersTest, TellsWhichObjectsHaveAValue) {
  const ProgramEnd end = run({"get", "power", "is", "on", "--room", "Living Room"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, AllOf(HasSubstr("Ceiling Light"), HasSubstr("Floor Lamp")));
  EXPECT_THAT(end.output, Not(HasSubstr("Window Lamp")));
}

TEST_F(OrdersTest, TellsWhatWasSet) {
  EXPECT_THAT(replyTo({"get", "temperature", "--service", "Thermostat"}), HasSubstr("21.5"));
  EXPECT_THAT(replyTo({"get", "temperature", "--target", "--service", "Thermostat"}),
              HasSubstr("22.0"));
}

TEST_F(OrdersTest, TellsTheObjectsAlone) {
  const std::string reply = replyTo({"get", "--entity", "zone"});
  EXPECT_THAT(reply, AllOf(HasSubstr("Downstairs"), HasSubstr("Upstairs"), HasSubstr("ZONE")));
  EXPECT_THAT(reply, Not(HasSubstr("resultValue")));
}

TEST_F(OrdersTest, SetsAValue) {
  EXPECT_EQ(run({"set", "brightness", "40%", "--service", "Desk Lamp"}).exitStatus, 0);
  EXPECT_THAT(replyTo({"get", "brightness", "--service", "Desk Lamp"}), HasSubstr("40"));
}

TEST_F(OrdersTest, SetsWhatAnAttributeNames) {
  EXPECT_EQ(run({"set", "climate", "mode", "cool", "--type", "thermostat"}).exitStatus, 0);
  EXPECT_THAT(replyTo({"get", "climate-mode", "--service", "Thermostat"}), HasSubstr("COOL"));
}

TEST_F(OrdersTest, TakesANegativeNumberAsAValue) {
  const ProgramEnd end = run({"set", "temperature", "-5", "--service", "Thermostat"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, HasSubstr("1 failed"));
  EXPECT_THAT(replyTo({"get", "temperature", "--target", "--service", "Thermostat"}),
              HasSubstr("22.0"));
}

TEST_F(OrdersTest, RaisesAndLowersWithinTheLimits) {
  EXPECT_THAT(replyTo({"raise", "brightness", "30", "--service", "Desk Lamp"}), HasSubstr("100"));
  EXPECT_THAT(replyTo({"lower", "brightness", "25%", "--service", "Desk Lamp"}), HasSubstr("75"));
  EXPECT_THAT(replyTo({"lower", "brightness", "--service", "Desk Lamp"}), HasSubstr("70"));
}

TEST_F(OrdersTest, Toggles) {
  EXPECT_EQ(run({"toggle", "power", "--service", "Desk Lamp"}).exitStatus, 0);
  EXPECT_THAT(replyTo({"get", "power", "--service", "Desk Lamp"}), HasSubstr("false"));
}

TEST_F(OrdersTest, TellsLimits) {
  const std::string replies = replyTo({"limits", "temperature", "--service", "Thermostat"});
  EXPECT_EQ(std::count(replies.begin(), replies.end(), '\n'), 3);
  EXPECT_THAT(replies, ContainsRegex("10\\.0(.|\n)*30\\.0(.|\n)*0\\.5"));
}

TEST_F(OrdersTest, NeedsOneLimitOnly) {
  EXPECT_EQ(run({"limits", "color", "temperature"}).exitStatus, 0);
  EXPECT_EQ(run({"limits", "power"}).exitStatus, 1);
}

TEST_F(OrdersTest, RunsAScene) {
  EXPECT_EQ(run({"run", "Soiree"}).exitStatus, 0);
  EXPECT_EQ(run({"run", "Good", "Night", "--home", "Lake Cabin"}).exitStatus, 0);
  EXPECT_EQ(run({"run", "Breakfast"}).exitStatus, 1);
}

TEST_F(OrdersTest, LeavesObjectsWithoutTheAttributeAlone) {
  const ProgramEnd end = run({"set", "brightness", "20", "--room", "Living Room"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, HasSubstr("2 lights set"));
  EXPECT_THAT(end.errors, IsEmpty());
}

TEST_F(OrdersTest, AnswersWithTheRepliesThemselves) {
  const ProgramEnd end = run({"get", "power", "--service", "Desk Lamp", "--json"});
  EXPECT_EQ(end.output.find(R"({"commandOutcome": "COMMAND_SUCCESS", "actionResults": [)"), 0U);
  EXPECT_EQ(std::count(end.output.begin(), end.output.end(), '\n'), 1);
}

TEST_F(OrdersTest, CanSayNothing) {
  const ProgramEnd done = run({"get", "power", "is", "on", "--service", "Desk Lamp", "--quiet"});
  EXPECT_EQ(done.exitStatus, 0);
  EXPECT_THAT(done.output + done.errors, IsEmpty());
  const ProgramEnd none = run({"get", "power", "is", "off", "--service", "Desk Lamp", "--quiet"});
  EXPECT_EQ(none.exitStatus, 1);
  EXPECT_THAT(none.output + none.errors, IsEmpty());
  EXPECT_EQ(run({"get", "power", "--quiet", "--json"}).exitStatus, 2);
}

TEST_F(OrdersTest, TellsThatTheDeviceMustBeUnlocked) {
  const ProgramEnd end = run({"--locked", "set", "locked", "unlocked", "--service", "Front Door"});
  EXPECT_EQ(end.exitStatus, 1);
  EXPECT_THAT(end.output, AllOf(HasSubstr("Reply 1 of 2"), HasSubstr("unlock")));
  EXPECT_THAT(replyTo({"get", "locked", "--service", "Front Door"}), HasSubstr("true"));
}

TEST_F(OrdersTest, ChangesNothingForABadOrder) {
  const std::string before = exported();
  const std::vector<std::vector<std::string>> orders = {
      {"set", "brightness", "blue"},
      {"set", "temperature", "40%"},
      {"set", "BRIGTNESS", "3"},
      {"set", "brightness", "20C"},
      {"set", "power", "on", "--type", "ligth"},
      {"toggle", "brightness"},
      {"raise", "power"},
      {"set", "brightness", "20", "--entity", "rom"}};
  for (const auto& order : orders) {
    SCOPED_TRACE(order[0] + ' ' + order[1]);
    const ProgramEnd end = run(order);
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.output, IsEmpty());
    EXPECT_THAT(end.errors, IsOneFailure(""));
  }
  EXPECT_EQ(exported(), before);
}

TEST_F(OrdersTest, RefusesAnEmptyNameOfARoom) {
  const std::string before = exported();
  const ProgramEnd end = run({"set", "power", "off", "--room", ""});
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, IsOneFailure("--room: the value is empty"));
  EXPECT_EQ(exported(), before);
}

TEST_F(OrdersTest, SuggestsTheWordThatWasMeant) {
  EXPECT_EQ(run({"get", "BRIGTNESS"}).errors, "nidus: BRIGTNESS: did you mean BRIGHTNESS?\n");
}

TEST_F(OrdersTest, SetsTheTemperatureThatWasMeantOnEveryDevice) {
  for (const char* locale : {"en_US.UTF-8", "de_DE.UTF-8"}) {
    SCOPED_TRACE(locale);
    const auto order = [&](std::vector<std::string> words) {
      words.insert(words.end(), {"--service", "Thermostat", "--json"});
      return runWithLocale(locale, std::move(words)).output;
    };
    EXPECT_THAT(order({"set", "temperature", "68F"}), HasSubstr("20.0"));
    EXPECT_THAT(exported(), HasSubstr("\"value\": 20.0"));
    EXPECT_THAT(order({"get", "temperature", "is", "70.7F"}), HasSubstr("70.7"));
    EXPECT_THAT(order({"get", "temperature", "is", "21.5C"}), HasSubstr("21.5"));
    EXPECT_THAT(order({"raise", "temperature", "4.5F"}), HasSubstr("SUCCESS"));
    EXPECT_THAT(order({"get", "temperature", "is", "4.5F"}), HasSubstr("NO_MATCHING"));
    EXPECT_THAT(exported(), HasSubstr("\"value\": 24.0"));
    EXPECT_THAT(order({"set", "heating_threshold", "59F"}), HasSubstr("15.0"));
    EXPECT_THAT(order({"raise", "heating_threshold", "3.6F"}), HasSubstr("17.0"));
  }
}

TEST_F(OrdersTest, TakesATemperatureWithoutAUnitInTheUnitOfTheDevice) {
  const std::vector<std::string> order = {"set", "temperature", "68", "--service", "Thermostat"};
  EXPECT_THAT(runWithLocale("de_DE.UTF-8", order).output, HasSubstr("1 failed"));
  EXPECT_THAT(runWithLocale("en_US.UTF-8", order).output, HasSubstr("1 thermostat set"));
  EXPECT_THAT(exported(), HasSubstr("\"value\": 20.0"));
}

TEST_F(OrdersTest, SetsToTheLimitOfTheDevice) {
  for (const char* locale : {"en_US.UTF-8", "de_DE.UTF-8"}) {
    const ProgramEnd end =
        runWithLocale(locale, {"set", "temperature", "maximum", "--service", "Thermostat"});
    EXPECT_EQ(end.exitStatus, 0);
    EXPECT_THAT(end.output, HasSubstr("1 thermostat set"));
    EXPECT_THAT(replyTo({"get", "temperature", "--target", "--service", "Thermostat"}),
                HasSubstr("30.0"));
    EXPECT_EQ(run({"set", "temperature", "min", "--service", "Thermostat"}).exitStatus, 0);
    EXPECT_THAT(replyTo({"get", "temperature", "--target", "--service", "Thermostat"}),
                HasSubstr("10.0"));
  }
}

TEST_F(OrdersTest, SetsToOneLimitByOneCommand) {
  const std::string replies = replyTo({"set", "color", "temperature", "maximum"});
  EXPECT_EQ(std::count(replies.begin(), replies.end(), '\n'), 1);
  EXPECT_THAT(replies, AllOf(HasSubstr("Floor Lamp"), HasSubstr("Desk Lamp"), HasSubstr("500")));
}

TEST_F(OrdersTest, FindsNoLimitWhereThereIsNone) {
  EXPECT_EQ(run({"set", "brightness", "maximum", "--service", "Kettle"}).exitStatus, 1);
}

TEST_F(OrdersTest, HasColourOnATerminalAlone) {
  const std::vector<std::string> order = {"get", "brightness", "--service", "Garage Light"};
  const ProgramEnd shown = runOnTerminal(start(order));
  EXPECT_EQ(shown.exitStatus, 0);
  EXPECT_THAT(shown.output, AllOf(HasSubstr("unreachable"), HasSubstr("\x1b[")));
  const ProgramEnd piped = run(order);
  EXPECT_THAT(piped.output, AllOf(HasSubstr("unreachable"), Not(HasSubstr("\x1b["))));
}

TEST_F(OrdersTest, KeepsRepliesPlainOnATerminal) {
  const ProgramEnd end =
      runOnTerminal(start({"get", "power", "--service", "Desk Lamp", "--json"}), 20);
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_EQ(end.output.find("{\"commandOutcome\""), 0U);
  EXPECT_THAT(end.output, Not(HasSubstr("\x1b")));
}

TEST_F(OrdersTest, CanSayNothingOnATerminal) {
  const ProgramEnd end = runOnTerminal(start({"set", "power", "off", "--quiet"}));
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, IsEmpty());
}

using MissingHomesTest = ProgramTest;

TEST_F(MissingHomesTest, SaysHowToBeginWithoutHomes) {
  for (const std::vector<std::string>& order :
       {std::vector<std::string>{"get", "power"}, {"limits", "hue"}, {"run", "Night"}}) {
    const ProgramEnd end = run(order);
    EXPECT_EQ(end.exitStatus, 1);
    EXPECT_THAT(end.output,
                AllOf(StartsWith("There are no homes yet; "), HasSubstr("nidus home import FILE"),
                      HasSubstr("nidus demo --home"), HasSubstr("nidus home add home NAME")));
    EXPECT_THAT(end.errors, IsEmpty());
  }
}

TEST_F(MissingHomesTest, SaysThatHomesAreNotLookedFor) {
  importSmallHome();
  ASSERT_EQ(run({"preferences", "set", "kHomesConfigured", "false"}).exitStatus, 0);
  const ProgramEnd end = run({"set", "power", "on"});
  EXPECT_EQ(end.exitStatus, 1);
  EXPECT_EQ(end.output,
            "The plug-in does not look for homes, as kHomesConfigured is not true; change that "
            "with nidus preferences set kHomesConfigured true\n");
}

TEST_F(MissingHomesTest, LeavesTheRepliesAndOtherReasonsAlone) {
  EXPECT_THAT(run({"get", "power", "--json"}).output, StartsWith("{\"commandOutcome\""));
  EXPECT_THAT(run({"get", "power", "--quiet"}).output, IsEmpty());
  importSmallHome();
  EXPECT_THAT(run({"get", "power", "--room", "Attic"}).output, StartsWith("Nothing matches; "));
}

/// Two lamps whose brightness has different limits.
class DifferentLimitsTest : public ProgramTest {
 protected:
  void importLamps(const std::string& first, const std::string& second) const {
    import(documentOf({R"({"uuid": "AA00AA00-0000-4000-8000-000000000001", "name": "Hut",
      "accessories": [)" +
                       lamp('1', first, 100) + ',' + lamp('2', second, 50) + "]}"}));
  }

 private:
  static std::string lamp(char number, const std::string& name, int maximum) {
    return std::string(R"({"uuid": "DD00DD00-0000-4000-8000-00000000000)") + number +
           R"(", "name": "Lamp", "services": [{"instanceID": 8, "name": ")" + name +
           R"(", "serviceType": "com.corvane.nidus.service.light", "characteristics": [
             {"instanceID": 9, "characteristicType": "com.corvane.nidus.characteristic.brightness",
              "properties": ["readable", "writable"], "value": 40,
              "metadata": {"format": "int", "minimumValue": 0, "maximumValue": )" +
           std::to_string(maximum) + "}}]}]}";
  }
};

TEST_F(DifferentLimitsTest, AreSetOneByOne) {
  importLamps("Tall", "Small");
  const ProgramEnd end = run({"set", "brightness", "maximum", "--json"});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_EQ(std::count(end.output.begin(), end.output.end(), '\n'), 2);
  const std::string home = exported();
  EXPECT_THAT(home, AllOf(HasSubstr("\"value\": 100"), HasSubstr("\"value\": 50")));
}

TEST_F(DifferentLimitsTest, NeedNamesToBeToldApart) {
  for (const char* second : {"Lamp", ""}) {
    importLamps("Lamp", second);
    const std::string before = exported();
    const ProgramEnd end = run({"set", "brightness", "maximum"});
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.errors, IsOneFailure("BRIGHTNESS: the limits of these objects differ"));
    EXPECT_EQ(exported(), before);
  }
}

TEST_F(DifferentLimitsTest, AreToldWithoutAStep) {
  importLamps("Tall", "Small");
  const ProgramEnd end = run({"limits", "brightness"});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, AllOf(HasSubstr("100"), HasSubstr("50"), HasSubstr("none")));
}

using OrderHelpTest = ProgramTest;

TEST_F(OrderHelpTest, ShowsAnExampleOfEachVerb) {
  for (const std::string verb : {"get", "set", "raise", "lower", "toggle", "limits", "run"}) {
    SCOPED_TRACE(verb);
    const ProgramEnd end = run({verb, "--help"});
    EXPECT_EQ(end.exitStatus, 0);
    EXPECT_THAT(end.output, AllOf(HasSubstr("  nidus " + verb + ' '), HasSubstr("--room NAME"),
                                  HasSubstr("Exit status: 0 success")));
  }
}

}  // namespace
}  // namespace nidus
