#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <csignal>
#include <filesystem>
#include <string>
#include <vector>

#include "Replay/ReplayRun.h"
#include "Replay/TranscriptComparison.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

using testing::HasSubstr;
using testing::IsEmpty;

const std::string kHome =
    R"({"format": "nidus-home/1", "homes": [{"uuid": "9E01A3C4-0000-4000-8000-000000000001", )"
    R"("name": "Beach House"}]})";

/// A scenario with `kHome` and these steps, configured.
std::string scenarioWithSteps(const std::string& steps) {
  return R"({"format": "nidus-scenario/1", "preferences": {"kHomesConfigured": true}, "home": )" +
         kHome + R"(, "steps": [)" + steps + "]}";
}

struct BadScenario {
  std::string label;
  std::string text;
};

void PrintTo(const BadScenario& scenario, std::ostream* out) { *out << scenario.label; }

class BadScenarioTest : public testing::TestWithParam<BadScenario> {};

TEST_P(BadScenarioTest, EndsWithStatusTwoAndNoOutput) {
  const TestFolder folder;
  const ReplayRun run = runReplay(folder.write("bad.json", GetParam().text));
  EXPECT_EQ(run.exitStatus, 2);
  EXPECT_THAT(run.output, IsEmpty());
  EXPECT_THAT(run.errors, HasSubstr("bad.json"));
  EXPECT_EQ(run.errors.find('\n'), run.errors.size() - 1) << run.errors;
}

std::vector<BadScenario> badScenarios() {
  const std::string start = R"({"format": "nidus-scenario/1", )";
  const std::string home = R"("home": )" + kHome;
  const std::string good = R"({"records": {}}, )";
  return {
      {"EmptyFile", ""},
      {"NotJson", "records"},
      {"NotAnObject", "[]"},
      {"TrailingText", scenarioWithSteps("") + " x"},
      {"UnknownKey", start + home + R"(, "steps": [], "extra": 1})"},
      {"KeyTwice", start + home + R"(, "steps": [], "locked": true, "locked": true})"},
      {"NoFormat", "{" + home + R"(, "steps": []})"},
      {"OtherFormat", R"({"format": "nidus-scenario/2", )" + home + R"(, "steps": []})"},
      {"HomeDocumentAsScenario", kHome},
      {"NoHome", start + R"("steps": []})"},
      {"HomeOfAnotherType", start + R"("home": [], "steps": []})"},
      {"HomeOfAnotherFormat",
       start + R"("home": {"format": "nidus-home/9", "homes": []}, "steps": []})"},
      {"LockedOfAnotherType", start + home + R"(, "steps": [], "locked": 1})"},
      {"MetricOfAnotherType", start + home + R"(, "steps": [], "metric": "yes"})"},
      {"PreferencesOfAnotherType", start + home + R"(, "steps": [], "preferences": []})"},
      {"StepsOfAnotherType", start + home + R"(, "steps": {}})"},
      {"EmptyStep", scenarioWithSteps(good + "{}")},
      {"StepWithTwoKeys", scenarioWithSteps(good + R"({"records": {}, "export": {}})")},
      {"UnknownStep", scenarioWithSteps(good + R"({"wait": {}})")},
      {"KeyInRecords", scenarioWithSteps(good + R"({"records": {"home": 1}})")},
      {"KeyInExport", scenarioWithSteps(good + R"({"export": {"file": "x"}})")},
      {"UnknownKeyOfSet", scenarioWithSteps(good + R"({"set": {"metric": true}})")},
      {"LockedTextInSet", scenarioWithSteps(good + R"({"set": {"locked": "no"}})")},
      {"SyncWithoutKey", scenarioWithSteps(good + R"({"sync": {}})")},
      {"SyncAfterANumber", scenarioWithSteps(good + R"({"sync": {"key": "k", "after": [1]}})")},
      {"UnknownKeyOfCommand", scenarioWithSteps(good + R"({"perform": {"action": []}})")},
      {"UnknownKeyOfSearch",
       scenarioWithSteps(good + R"({"perform": {"filter": {"search": {"name": "x"}}}})")},
      {"FilterWithBothKeys",
       scenarioWithSteps(good + R"({"perform": {"filter": {"search": {}, "identifiers": []}}})")},
      {"FilterWithNoKey", scenarioWithSteps(good + R"({"perform": {"filter": {}}})")},
      {"ActionsOfAnotherType", scenarioWithSteps(good + R"({"perform": {"actions": {}}})")},
      {"ValueWithoutKind",
       scenarioWithSteps(good + R"({"perform": {"actions": [{"value": {}}]}})")},
      {"ValueOfTwoKinds",
       scenarioWithSteps(
           good + R"({"perform": {"actions": [{"value": {"boolean": true, "integer": 1}}]}})")},
      {"NullBoolean",
       scenarioWithSteps(good + R"({"perform": {"actions": [{"value": {"boolean": null}}]}})")},
      {"IntegerWithFraction",
       scenarioWithSteps(good + R"({"perform": {"actions": [{"value": {"integer": 1.5}}]}})")},
      {"IntegerTooGreat",
       scenarioWithSteps(
           good + R"({"perform": {"actions": [{"value": {"integer": 9223372036854775808}}]}})")},
      {"FloatTooGreat",
       scenarioWithSteps(good + R"({"perform": {"actions": [{"value": {"float": 1e39}}]}})")},
      {"InvalidUtf8", scenarioWithSteps(good + "{\"sync\": {\"key\": \"\xC3\x28\"}}")},
      {"DeepNesting", start + home + R"(, "steps": [], "preferences": {"x": )" +
                          std::string(5000, '[') + std::string(5000, ']') + "}}"},
  };
}

std::string labelOf(const testing::TestParamInfo<BadScenario>& scenario) {
  return scenario.param.label;
}

INSTANTIATE_TEST_SUITE_P(Replay, BadScenarioTest, testing::ValuesIn(badScenarios()), labelOf);

TEST(ReplayProgramTest, NamesThePlaceOfTheMistake) {
  const TestFolder folder;
  const ReplayRun run = runReplay(
      folder.write("bad.json", scenarioWithSteps(R"({"export": {}}, {"sync": {"key": 5}})")));
  EXPECT_THAT(run.errors, HasSubstr("/steps/1/sync/key"));
}

TEST(ReplayProgramTest, RefusesAFileThatIsNotThere) {
  const TestFolder folder;
  const ReplayRun run = runReplay(folder.path() / "nowhere.json");
  EXPECT_EQ(run.exitStatus, 2);
  EXPECT_THAT(run.output, IsEmpty());
  EXPECT_THAT(run.errors, HasSubstr("nowhere.json"));
}

TEST(ReplayProgramTest, NamesTheHomeFileThatIsNotThere) {
  const TestFolder folder;
  const ReplayRun run = runReplay(folder.write(
      "scenario.json", R"({"format": "nidus-scenario/1", "homeFile": "away.json", "steps": []})"));
  EXPECT_EQ(run.exitStatus, 2);
  EXPECT_THAT(run.output, IsEmpty());
  EXPECT_THAT(run.errors, HasSubstr((folder.path() / "away.json").string()));
}

TEST(ReplayProgramTest, FindsTheHomeFileBesideTheScenario) {
  const TestFolder folder;
  folder.write("beach.json", kHome);
  const ReplayRun run = runReplay(folder.write(
      "scenario.json",
      R"({"format": "nidus-scenario/1", "homeFile": "beach.json", "steps": [{"export": {}}]})"));
  EXPECT_EQ(run.exitStatus, 0) << run.errors;
  const auto difference = transcriptDifference(R"({"step": 0, "home": )" + kHome + "}", run.output);
  EXPECT_FALSE(difference.has_value()) << difference.value_or("");
}

TEST(ReplayProgramTest, NamesTheHomeFileThatIsWrong) {
  const TestFolder folder;
  folder.write("beach.json", R"({"format": "nidus-home/1", "homes": [{"name": "No UUID"}]})");
  const ReplayRun run = runReplay(folder.write(
      "scenario.json", R"({"format": "nidus-scenario/1", "homeFile": "beach.json", "steps": []})"));
  EXPECT_EQ(run.exitStatus, 2);
  EXPECT_THAT(run.errors, HasSubstr("beach.json: /homes/0"));
}

TEST(ReplayProgramTest, AbortsOnAWrongSyncKey) {
  const TestFolder folder;
  const ReplayRun run = runReplay(folder.write(
      "scenario.json",
      scenarioWithSteps(R"({"records": {}}, {"sync": {"key": "other"}}, {"records": {}})")));
  EXPECT_EQ(run.signal, SIGABRT);
  const auto difference = transcriptDifference(
      R"({"step": 0, "records": [{"objectType": "HOME", "objectName": "Beach House", )"
      R"("objectIdentifier": )"
      R"("x-corvane-nidus://local/home?id=9E01A3C4-0000-4000-8000-000000000001"}]})",
      run.output);
  EXPECT_FALSE(difference.has_value()) << difference.value_or("");
  EXPECT_THAT(run.errors, HasSubstr("-[NDAssistantSyncHome "
                                    "beginSyncWithAnchor:validity:forKey:beginInfo:]"));
  EXPECT_THAT(run.errors, HasSubstr("Sources/Assistant/NDAssistantSyncHome"));
  EXPECT_THAT(run.errors, HasSubstr("80"));
}

TEST(ReplayProgramTest, AbortsOnAWrongKeyAfterAGoodSync) {
  const TestFolder folder;
  const ReplayRun run = runReplay(folder.write(
      "scenario.json", scenarioWithSteps(R"({"sync": {"key": "com.corvane.nidus.name"}}, )"
                                         R"({"sync": {"key": "com.corvane.nidus.names"}})")));
  EXPECT_EQ(run.signal, SIGABRT);
  EXPECT_THAT(run.output, HasSubstr("3405691582"));
}

TEST(ReplayProgramTest, LeavesTheDataFolderAlone) {
  const TestFolder folder;
  const auto data = folder.path() / "data";
  const ReplayRun run =
      runReplay(folder.write("scenario.json", scenarioWithSteps(R"({"records": {}})")),
                "NIDUS_DATA='" + data.string() + "'");
  EXPECT_EQ(run.exitStatus, 0) << run.errors;
  EXPECT_FALSE(std::filesystem::exists(data));
}

TEST(ReplayProgramTest, TakesTheUnitsFromTheScenario) {
  for (const std::string name : {"read-temperature-metric", "write-temperature-non-metric"}) {
    for (const std::string locale : {"en_US.UTF-8", "de_DE.UTF-8"}) {
      SCOPED_TRACE(testing::Message() << name << " under " << locale);
      const auto file = std::filesystem::path(NIDUS_SCENARIOS) / name;
      const ReplayRun run = runReplay(file.string() + ".scenario.json", "LC_ALL=" + locale);
      const auto difference =
          transcriptDifference(contentOfFile(file.string() + ".expected.jsonl"), run.output);
      EXPECT_FALSE(difference.has_value()) << difference.value_or("");
    }
  }
}

}  // namespace
}  // namespace nidus
