#include "AssistantHost/Scenario.h"

#include <gmock/gmock.h>

#include "Support/TestFolder.h"

namespace nidus {
namespace {

using ::testing::HasSubstr;

constexpr const char kNoHomes[] = R"("home": {"format": "nidus-home/1", "homes": []})";

/// A scenario without homes that has `members` besides.
std::string scenarioWith(const std::string& members) {
  return std::string(R"({"format": "nidus-scenario/1", )") + kNoHomes + ", " + members + "}";
}

std::string scenarioOf(const std::string& step) {
  return scenarioWith("\"steps\": [" + step + "]");
}

class ScenarioTest : public ::testing::Test {
 protected:
  Result<Scenario> read(const std::string& text) {
    return readScenario(folder_.write("test.json", text));
  }
  /// The one step of a good scenario.
  template <class Step>
  Step step(const std::string& text) {
    const auto scenario = read(scenarioOf(text));
    EXPECT_TRUE(scenario) << scenario.failure().message;
    return scenario ? std::get<Step>(scenario->steps.at(0)) : Step();
  }

  const TestFolder folder_;
};

TEST_F(ScenarioTest, HasDefaults) {
  const auto scenario = read(scenarioOf(""));
  ASSERT_TRUE(scenario) << scenario.failure().message;
  EXPECT_TRUE(scenario->preferences.empty());
  EXPECT_FALSE(scenario->internalBuild);
  EXPECT_TRUE(scenario->metric);
  EXPECT_FALSE(scenario->locked);
  EXPECT_TRUE(scenario->homes.empty());
  EXPECT_TRUE(scenario->steps.empty());
}

TEST_F(ScenarioTest, ReadsStartValues) {
  const auto scenario = read(scenarioWith(
      R"("preferences": {"a": true, "b": [1]}, "internalBuild": true, "metric": false,
         "locked": true, "steps": [])"));
  ASSERT_TRUE(scenario) << scenario.failure().message;
  EXPECT_EQ(scenario->preferences.size(), 2U);
  EXPECT_EQ(scenario->preferences.at("a").content, JsonValue{true}.content);
  EXPECT_TRUE(scenario->internalBuild);
  EXPECT_FALSE(scenario->metric);
  EXPECT_TRUE(scenario->locked);
}

TEST_F(ScenarioTest, KeepsTheOrderOfSteps) {
  const auto scenario = read(scenarioOf(R"({"export": {}}, {"records": {}}, {"perform": {}})"));
  ASSERT_TRUE(scenario) << scenario.failure().message;
  ASSERT_EQ(scenario->steps.size(), 3U);
  EXPECT_TRUE(std::holds_alternative<ExportStep>(scenario->steps[0]));
  EXPECT_TRUE(std::holds_alternative<RecordsStep>(scenario->steps[1]));
  EXPECT_TRUE(std::holds_alternative<PerformStep>(scenario->steps[2]));
}

TEST_F(ScenarioTest, ReadsASync) {
  const auto sync = step<SyncStep>(
      R"({"sync": {"key": "k", "anchor": "a", "validity": "v", "after": [null, "1"]}})");
  EXPECT_EQ(sync.key, "k");
  EXPECT_EQ(sync.anchor, "a");
  EXPECT_EQ(sync.validity, "v");
  EXPECT_EQ(sync.after, (std::vector<NDString>{nullptr, "1"}));
}

TEST_F(ScenarioTest, KeepsNoAnchorsApartFromAll) {
  EXPECT_FALSE(step<SyncStep>(R"({"sync": {"key": "k"}})").after);
  EXPECT_EQ(step<SyncStep>(R"({"sync": {"key": "k", "after": []}})").after,
            std::vector<NDString>());
}

TEST_F(ScenarioTest, ReadsASet) {
  const auto set =
      step<SetStep>(R"({"set": {"locked": true, "silent": false, "preferences": {"a": null}}})");
  EXPECT_EQ(set.locked, true);
  EXPECT_EQ(set.silent, false);
  ASSERT_TRUE(set.preferences);
  EXPECT_EQ(set.preferences->at("a").content, JsonValue().content);
}

TEST_F(ScenarioTest, KeepsNoPreferencesApartFromNoChange) {
  EXPECT_FALSE(step<SetStep>(R"({"set": {}})").preferences);
  EXPECT_TRUE(step<SetStep>(R"({"set": {"preferences": {}}})").preferences);
}

TEST_F(ScenarioTest, ReadsHomesOfAnotherFile) {
  folder_.write("homes.json",
                R"({"format": "nidus-home/1", "homes": [
                    {"uuid": "AA00AA00-0000-4000-8000-000000000001", "name": "Cottage"}]})");
  const auto scenario =
      read(R"({"format": "nidus-scenario/1", "homeFile": "homes.json", "steps": []})");
  ASSERT_TRUE(scenario) << scenario.failure().message;
  ASSERT_EQ(scenario->homes.size(), 1U);
  EXPECT_EQ(scenario->homes[0].name, "Cottage");
}

TEST_F(ScenarioTest, NamesTheHomeFileThatIsWrong) {
  folder_.write("homes.json", R"({"format": "nidus-home/1", "homes": [{}]})");
  const auto scenario =
      read(R"({"format": "nidus-scenario/1", "homeFile": "homes.json", "steps": []})");
  ASSERT_FALSE(scenario);
  EXPECT_EQ(scenario.failure().kind, Failure::Kind::badInput);
  EXPECT_THAT(scenario.failure().message, HasSubstr(folder_.file("homes.json") + ": /homes/0"));
}

TEST_F(ScenarioTest, NamesFilesThatAreNotThere) {
  const auto missing = readScenario(folder_.file("missing.json"));
  ASSERT_FALSE(missing);
  EXPECT_EQ(missing.failure().kind, Failure::Kind::badInput);
  EXPECT_THAT(missing.failure().message, HasSubstr(folder_.file("missing.json") + ": "));
  const auto homes =
      read(R"({"format": "nidus-scenario/1", "homeFile": "missing.json", "steps": []})");
  ASSERT_FALSE(homes);
  EXPECT_THAT(homes.failure().message, HasSubstr(folder_.file("missing.json") + ": "));
}

TEST_F(ScenarioTest, RefusesAFolder) {
  const auto scenario = readScenario(folder_.path());
  ASSERT_FALSE(scenario);
  EXPECT_EQ(scenario.failure().kind, Failure::Kind::badInput);
}

TEST_F(ScenarioTest, ReadsHomesAfterTheSteps) {
  const auto scenario = read(
      R"({"steps": [{"records": {}}], "format": "nidus-scenario/1", "home": {"homes": [
          {"uuid": "AA00AA00-0000-4000-8000-000000000001", "name": "Cottage"}],
          "format": "nidus-home/1"}, "locked": true})");
  ASSERT_TRUE(scenario) << scenario.failure().message;
  EXPECT_EQ(scenario->steps.size(), 1U);
  ASSERT_EQ(scenario->homes.size(), 1U);
  EXPECT_EQ(scenario->homes[0].name, "Cottage");
  EXPECT_TRUE(scenario->locked);
}

struct BadScenario {
  const char* label;
  std::string text;
  const char* place;
};

TEST_F(ScenarioTest, NamesThePlaceOfWhatIsWrong) {
  const BadScenario table[] = {
      {"empty", "", ""},
      {"a list", "[]", ""},
      {"no format", std::string("{") + kNoHomes + R"(, "steps": []})", ""},
      {"other format",
       std::string(R"({"format": "nidus-scenario/2", )") + kNoHomes + R"(, "steps": []})",
       "/format"},
      {"no home", R"({"format": "nidus-scenario/1", "steps": []})", ""},
      {"home and home file", scenarioWith(R"("homeFile": "a", "steps": [])"), ""},
      {"bad home",
       R"({"format": "nidus-scenario/1", "home": {"format": "nidus-home/1"}, "steps": []})",
       "/home"},
      {"bad room of the home",
       R"({"format": "nidus-scenario/1", "steps": [], "home": {"format": "nidus-home/1", "homes": [
           {"uuid": "AA00AA00-0000-4000-8000-000000000001", "name": "Cottage",
            "rooms": [{"uuid": "AA00AA00-0000-4000-8000-000000000002"}]}]}})",
       "/home/homes/0/rooms/0: missing required key"},
      {"home no object", R"({"format": "nidus-scenario/1", "home": [], "steps": []})", "/home"},
      {"home a text", R"({"format": "nidus-scenario/1", "home": "a", "steps": []})", "/home"},
      {"null home", R"({"format": "nidus-scenario/1", "home": null, "steps": []})",
       "expected exactly one"},
      {"null steps", scenarioWith(R"("steps": null)"), "/steps"},
      {"object among the lists", R"([{"steps": {"home": [0, {}]}}])", "expected an object"},
      {"no steps", scenarioWith(R"("metric": true)"), ""},
      {"steps no list", scenarioWith(R"("steps": {})"), "/steps"},
      {"unknown key", scenarioWith(R"("more": 1, "steps": [])"), "/more"},
      {"metric no boolean", scenarioWith(R"("metric": 1, "steps": [])"), "/metric"},
      {"preferences no object", scenarioWith(R"("preferences": [], "steps": [])"), "/preferences"},
      {"number as a step", scenarioOf("{\"records\": {}}, 1"), "/steps/1"},
      {"list as a step", scenarioOf("[[]]"), "/steps/0"},
      {"step of no kind", scenarioOf("{}"), "/steps/0"},
      {"step of two kinds", scenarioOf(R"({"records": {}, "export": {}})"), "/steps/0"},
      {"step of an unknown kind", scenarioOf(R"({"dance": {}})"), "/steps/0"},
      {"key beside the kind", scenarioOf(R"({"records": {}, "log": 1})"), "/steps/0/log"},
      {"null records", scenarioOf(R"({"records": null})"), "/steps/0/records"},
      {"key in records", scenarioOf(R"({"records": {"a": 1}})"), "/steps/0/records/a"},
      {"key in export", scenarioOf(R"({"export": {"a": 1}})"), "/steps/0/export/a"},
      {"bad command in the second step", scenarioOf(R"({"export": {}}, {"perform": {"a": 1}})"),
       "/steps/1/perform/a"},
      {"sync without key", scenarioOf(R"({"sync": {}})"), "/steps/0/sync"},
      {"sync with a number as anchor", scenarioOf(R"({"sync": {"key": "k", "after": [1]}})"),
       "/steps/0/sync/after/0"},
      {"unknown key in sync", scenarioOf(R"({"sync": {"key": "k", "afer": []}})"),
       "/steps/0/sync/afer"},
      {"unknown key in set", scenarioOf(R"({"set": {"lock": true}})"), "/steps/0/set/lock"},
      {"locked no boolean", scenarioOf(R"({"set": {"locked": "yes"}})"), "/steps/0/set/locked"},
  };
  for (const BadScenario& bad : table) {
    SCOPED_TRACE(bad.label);
    const auto scenario = read(bad.text);
    ASSERT_FALSE(scenario);
    EXPECT_EQ(scenario.failure().kind, Failure::Kind::badInput);
    const std::string start = folder_.file("test.json") + ": " + bad.place;
    EXPECT_EQ(scenario.failure().message.substr(0, start.size()), start);
  }
}

}  // namespace
}  // namespace nidus
