#include <algorithm>

#include "nidus/ProgramTest.h"
#include "nidus/TerminalProcess.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;
using ::testing::StartsWith;

/// A home whose heater would answer 22.5 now, while 19.0 was known last.
std::string warmHome() {
  return R"({"uuid": "AA00AA00-0000-4000-8000-000000000002", "name": "Lodge",
      "rooms": [{"uuid": "BB00BB00-0000-4000-8000-000000000002", "name": "Kitchen"}],
      "accessories": [{"uuid": "DD00DD00-0000-4000-8000-000000000009", "name": "Heater",
        "room": "BB00BB00-0000-4000-8000-000000000002", "services": [{"instanceID": 8,
        "name": "Heater", "serviceType": "com.corvane.nidus.service.heater", "characteristics": [
          {"instanceID": 9,
           "characteristicType": "com.corvane.nidus.characteristic.current-temperature",
           "properties": ["readable"], "value": 19.0, "deviceValue": 22.5,
           "metadata": {"format": "float", "units": "celsius"}},
          {"instanceID": 10,
           "characteristicType": "com.corvane.nidus.characteristic.target-temperature",
           "properties": ["readable", "writable"], "value": 20.0,
           "metadata": {"format": "float", "units": "celsius", "minimumValue": 10.0,
                        "maximumValue": 30.0}}]}]}],
      "actionSets": [{"uuid": "FF00FF00-0000-4000-8000-000000000002", "name": "Soirée",
        "actions": [{"accessory": "DD00DD00-0000-4000-8000-000000000009", "service": 8,
                     "characteristic": 10, "value": 18}]}]})";
}

class ExplainTest : public ProgramTest {
 protected:
  void SetUp() override { import(documentOf({smallHome(), warmHome()})); }

  /// Explains an order; it must work and must not change anything.
  [[nodiscard]] std::string explained(std::vector<std::string> arguments,
                                      const std::string& input = "") const {
    const std::string before = exported();
    arguments.insert(arguments.begin(), "explain");
    const ProgramEnd end = run(std::move(arguments), input);
    EXPECT_EQ(end.exitStatus, 0) << end.errors;
    EXPECT_THAT(end.errors, IsEmpty());
    EXPECT_EQ(exported(), before);
    return end.output;
  }
};

TEST_F(ExplainTest, ShowsWhatEachStepKeeps) {
  const std::string text = explained({"get", "brightness", "--room", "Kitchen"});
  EXPECT_THAT(text, StartsWith("The filter\nSTEP "));
  EXPECT_THAT(text, HasSubstr("all objects "));
  EXPECT_THAT(text, HasSubstr("the primary home, as none is named "));
  EXPECT_THAT(text, HasSubstr("room and zone  Kitchen "));
  EXPECT_THAT(text, HasSubstr("It keeps: Lamp, Away, Lamp, Away.\n"
                              "Some are kept more than once, as several rooms have this name"));
}

TEST_F(ExplainTest, ReadsWhatWasKnownLast) {
  const std::string text = explained({"get", "temperature", "--home", "Lodge"});
  EXPECT_THAT(text, HasSubstr("It would read, in one batch of Lodge:\n"));
  EXPECT_THAT(text, AllOf(HasSubstr("19 °C"), Not(HasSubstr("22.5 °C"))));
  EXPECT_THAT(text, HasSubstr("Nothing was done: no device was asked or set."));
  const ProgramEnd done = run({"perform"}, R"({"filter": {"search": {"homeName": "Lodge"}}, )"
                                           R"("actions": [{"attribute": "TEMPERATURE"}]})");
  EXPECT_NE(exported().find("\"value\": 22.5"), std::string::npos) << done.output;
}

TEST_F(ExplainTest, TellsWhatWouldBeWritten) {
  const std::string text = explained({"set", "temperature", "68F", "--home", "Lodge"});
  EXPECT_THAT(text, HasSubstr("It would write, in one batch of Lodge:\n"));
  EXPECT_THAT(text, HasSubstr("TEMPERATURE target  20 °C       20 °C     10 °C to 30 °C\n"));
  EXPECT_THAT(text, HasSubstr("No value would be another one afterwards.\n"));
  EXPECT_THAT(explained({"set", "temperature", "25C", "--home", "Lodge"}),
              HasSubstr("TEMPERATURE target  20 °C       25 °C\n"));
}

TEST_F(ExplainTest, TellsWhatADeviceRefuses) {
  const std::string text = explained({"set", "temperature", "40C", "--home", "Lodge"});
  EXPECT_THAT(text, HasSubstr("No value would be another one afterwards.\n"));
  EXPECT_THAT(text, HasSubstr("1 x FAILURE, because the device answers with another error"));
}

TEST_F(ExplainTest, TogglesOnlyTheCopy) {
  const std::string text = explained({"toggle", "power", "--service", "Lamp"});
  EXPECT_THAT(text, AllOf(HasSubstr("It would read"), HasSubstr("It would write")));
  EXPECT_THAT(text, HasSubstr("POWER      on          off"));
  EXPECT_THAT(text, HasSubstr("1 light toggled\nCOMMAND_SUCCESS, because there is a result"));
}

TEST_F(ExplainTest, ListsWhatASceneSets) {
  const std::string text = explained({"run", "Soiree", "--home", "Lodge"});
  EXPECT_THAT(text, HasSubstr("It would run the scene Soirée of Lodge, which writes:\n"));
  EXPECT_THAT(text, HasSubstr("TEMPERATURE target  20 °C       18 °C "));
  EXPECT_THAT(explained({"run", "Night"}),
              HasSubstr("It would run the scene Night of Cottage, which sets nothing.\n"));
}

TEST_F(ExplainTest, TellsUnreachableDevices) {
  const std::string text = explained({"get", "power", "--service", "Away"});
  EXPECT_THAT(text, HasSubstr("1 x UNREACHABLE, because the device answers that it can not be"));
  EXPECT_THAT(text, HasSubstr("COMMAND_SUCCESS, because there is a result"));
}

TEST_F(ExplainTest, KnowsWhetherTheDeviceIsLocked) {
  const std::string locked = explained({"set", "power", "on", "--service", "Door", "--locked"});
  EXPECT_THAT(locked, AllOf(HasSubstr("REQUIRES_UNLOCK, because"),
                            HasSubstr("FOUND_NO_MATCHING_ENTITIES, because there is no result")));
  EXPECT_THAT(explained({"set", "power", "on", "--service", "Door"}),
              HasSubstr("COMMAND_SUCCESS, because"));
}

TEST_F(ExplainTest, NamesTheStepThatLeavesNothing) {
  const std::string text = explained({"get", "power", "--room", "Kitchn"});
  EXPECT_THAT(text, HasSubstr("Nothing is left; the step \"room and zone\" had: Lamp, Away, Door"));
  EXPECT_THAT(text, HasSubstr("There is no room Kitchn here; did you mean Kitchen? There are: "
                              "Kitchen.\n"));
  EXPECT_THAT(text, HasSubstr("The action\nThere is nothing to act on.\n"));
  EXPECT_THAT(text, Not(HasSubstr("see why with nidus explain")));
}

TEST_F(ExplainTest, NamesAttributesThatThereAre) {
  EXPECT_THAT(explained({"get", "humidity", "--service", "Lamp"}),
              HasSubstr("There is no attribute HUMIDITY here. There are: POWER, BRIGHTNESS.\n"));
}

TEST_F(ExplainTest, TellsThatAQuestionDropsValues) {
  const std::string text = explained({"get", "power", "is", "off", "--service", "Lamp"});
  EXPECT_THAT(text, HasSubstr("Of what is read, only what has the value"));
  EXPECT_THAT(text, HasSubstr("FOUND_NO_MATCHING_ENTITIES, because there is no result.\n"));
}

TEST_F(ExplainTest, TakesLimitsFromTheHomesAlone) {
  const std::string text = explained({"limits", "brightness", "--service", "Lamp"});
  EXPECT_THAT(text, HasSubstr("BRIGHTNESS  40 %        0 % to 100 %\n"));
  EXPECT_THAT(text, HasSubstr("No device would be asked or set.\n"));
  EXPECT_THAT(text, HasSubstr("1 light with limits\n"));
}

TEST_F(ExplainTest, TellsThatNothingReachedStatesLimits) {
  const std::string text = explained({"limits", "power", "--service", "Lamp"});
  EXPECT_THAT(text, HasSubstr("there is no result.\nOf what is reached, only what states a "
                              "minimum of its own gives a result.\n"));
}

TEST_F(ExplainTest, TakesACommandFromAnywhere) {
  const std::string command = readCommandLine("Lamp");
  const std::string text = explained({"--command", command});
  EXPECT_THAT(text, HasSubstr("name of service  Lamp "));
  EXPECT_EQ(explained({"--command", "-"}, command), text);
  EXPECT_EQ(explained({"--command", folder_.write("command.json", command)}), text);
}

TEST_F(ExplainTest, SaysWhatTheFilterImplies) {
  EXPECT_THAT(explained({"--command", R"({"filter": {"search": {"attribute": "POWER"}}})"}),
              HasSubstr("SERVICE, as the filter has an attribute"));
}

TEST_F(ExplainTest, KnowsWordsThatNobodyHas) {
  const std::string text =
      explained({"--command", R"({"filter": {"search": {"serviceType": "LIGTH"}}})"});
  EXPECT_THAT(text, HasSubstr("as the vocabulary does not have the type.\n"));
  EXPECT_THAT(text, HasSubstr("There is no service type LIGTH here; did you mean LIGHT?"));
}

TEST_F(ExplainTest, GivesThePlugInsReasons) {
  const std::string text =
      explained({"--command", R"({"filter": {"search": {"serviceName": "Lamp"}},
                                  "actions": [{"actionType": "DANCE"}]})"});
  EXPECT_THAT(text, HasSubstr("sent an unsupported action type: DANCE\n"));
  EXPECT_THAT(text, HasSubstr("COMMAND_FAILURE, because the plug-in refuses the command"));
}

TEST_F(ExplainTest, TellsThatOnlySearchesFind) {
  EXPECT_THAT(explained({"--command", R"({"actions": []})"}),
              HasSubstr("only a filter that searches finds objects"));
}

TEST_F(ExplainTest, TellsWhyNoStepRan) {
  import(documentOf({emptyHome("One", 1), emptyHome("Two", 2)}));
  EXPECT_THAT(explained({"get", "power"}), HasSubstr("there are several homes, the filter names"));
  ASSERT_EQ(run({"preferences", "set", "kHomesConfigured", "false"}).exitStatus, 0);
  EXPECT_THAT(explained({"get", "power"}), HasSubstr("The plug-in does not look for homes, as"));
  import(documentOf({}));
  EXPECT_THAT(explained({"get", "power"}), HasSubstr("There are no homes yet; import some"));
}

TEST_F(ExplainTest, WritesJson) {
  const std::string line = explained({"--json", "toggle", "power", "--service", "Lamp"});
  EXPECT_EQ(std::count(line.begin(), line.end(), '\n'), 1);
  EXPECT_THAT(line, StartsWith(R"({"filter": [{"step": "snapshot", "kept": [{"objectType": )"));
  EXPECT_THAT(line,
              HasSubstr(R"("home": "AA00AA00-0000-4000-8000-000000000001", "value": true}])"));
  EXPECT_THAT(line, HasSubstr(R"("platform": [{"call": "read", )"));
  EXPECT_THAT(line, HasSubstr(R"("before": true, "after": false}], "log": [{"Level": "6", )"));
  EXPECT_THAT(line, HasSubstr(R"("replies": [{"commandOutcome": "COMMAND_SUCCESS", )"));
}

TEST_F(ExplainTest, WritesALineForEachCommand) {
  const std::string lines = explained({"limits", "brightness", "--json"});
  EXPECT_EQ(std::count(lines.begin(), lines.end(), '\n'), 3);
}

TEST_F(ExplainTest, HasTitlesOnATerminal) {
  const ProgramEnd end = runOnTerminal(start({"explain", "get", "power"}), 60);
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, AllOf(HasSubstr("\x1b["), HasSubstr("The filter")));
}

TEST_F(ExplainTest, RefusesBadInput) {
  const std::vector<std::pair<std::vector<std::string>, std::string>> table = {
      {{"explain"}, "explain takes either an order"},
      {{"explain", "get", "power", "--command", "{}"}, "explain takes either an order"},
      {{"explain", "dance"}, "dance: an order begins with"},
      {{"explain", "get power --room Kitchen"},
       "get power --room Kitchen: write the order without quotes around the whole"},
      {{"explain", "dance on"}, "dance on: an order begins with"},
      {{"explain", "get", "powr"}, "powr: did you mean POWER?"},
      {{"explain", "--command", "{\"filters\": 1}"}, "--command: /filters: "},
      {{"explain", "--command", "/nowhere.json"}, "/nowhere.json: "},
  };
  for (const auto& [arguments, reason] : table) {
    const ProgramEnd end = run(arguments);
    SCOPED_TRACE(reason);
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.output, IsEmpty());
    EXPECT_THAT(end.errors, IsOneFailure(reason));
  }
}

}  // namespace
}  // namespace nidus
