#include <algorithm>
#include <csignal>

#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;
using ::testing::StartsWith;

using SyncCommandTest = ProgramTest;
using RecordsCommandTest = ProgramTest;
using ReplayCommandTest = ProgramTest;
using DemoCommandTest = ProgramTest;

TEST_F(SyncCommandTest, PrintsTheResetThenEachName) {
  importSmallHome();
  const ProgramEnd end = run({"sync"});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, StartsWith("{\"reset\": \"3405691582\"}\n{\"object\": {"));
  EXPECT_THAT(end.output, AllOf(HasSubstr("\"postAnchor\": \"1\"}\n"), HasSubstr("Downstairs"),
                                HasSubstr("Night"), Not(HasSubstr("\"object\": null"))));
  EXPECT_THAT(end.output, ::testing::EndsWith("\"postAnchor\": \"3405691582\"}\n"));
}

TEST_F(SyncCommandTest, ResetsWithoutValidityWithoutHomes) {
  const ProgramEnd end = run({"sync"});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_EQ(end.output, "{\"reset\": null}\n");
}

TEST_F(RecordsCommandTest, PrintsOneRecordPerLine) {
  importSmallHome();
  const ProgramEnd end = run({"records"});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, StartsWith("{\"objectType\": \"HOME\""));
  // The home, three services, a group, a room, a zone and a scene.
  EXPECT_EQ(std::count(end.output.begin(), end.output.end(), '\n'), 8);
}

TEST_F(RecordsCommandTest, PrintsNothingWithoutHomes) {
  const ProgramEnd end = run({"records"});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, IsEmpty());
}

std::string scenarioOf(const std::string& steps) {
  return R"({"format": "nidus-scenario/1", "preferences": {"kHomesConfigured": true},
             "home": )" +
         documentOf({smallHome()}) + ", \"steps\": [" + steps + "]}";
}

TEST_F(ReplayCommandTest, PrintsOneLinePerStep) {
  const auto file =
      folder_.write("a.json", scenarioOf(R"({"set": {"locked": true}}, {"perform": )" +
                                         setCommandLine("Lamp", false) + R"(}, {"export": {}})"));
  const ProgramEnd end = run({"replay", file});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, StartsWith("{\"step\": 0}\n{\"step\": 1, \"replies\": [{"));
  EXPECT_THAT(end.output, AllOf(HasSubstr("\"call\": \"write\""), HasSubstr("\"log\": []}\n"),
                                HasSubstr("{\"step\": 2, \"home\": {\"format\"")));
}

TEST_F(ReplayCommandTest, LeavesTheDataFolderAlone) {
  const auto file = folder_.write("a.json", scenarioOf(R"({"records": {}})"));
  EXPECT_EQ(run({"replay", file}).exitStatus, 0);
  EXPECT_FALSE(std::filesystem::exists(data()));
}

TEST_F(ReplayCommandTest, RunsNothingOfABadScenario) {
  const auto file = folder_.write("a.json", scenarioOf(R"({"records": {}}, {"dance": {}})"));
  const ProgramEnd end = run({"replay", file});
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.output, IsEmpty());
  EXPECT_THAT(end.errors, IsOneFailure(file + ": /steps/1: "));
}

TEST_F(ReplayCommandTest, HasWrittenTheLinesBeforeAnAbort) {
  const auto file =
      folder_.write("a.json", scenarioOf(R"({"set": {}}, {"sync": {"key": "other"}})"));
  const ProgramEnd end = run({"replay", file});
  EXPECT_EQ(end.signal, SIGABRT);
  EXPECT_EQ(end.output, "{\"step\": 0}\n");
  EXPECT_THAT(end.errors, HasSubstr("com.corvane.nidus.name"));
}

TEST_F(ReplayCommandTest, EndsWithAPendingCommand) {
  const auto file = folder_.write(
      "a.json",
      scenarioOf(R"({"set": {"silent": true}}, {"perform": )" + readCommandLine("Lamp") + "}"));
  const ProgramEnd end = run({"replay", file});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output,
              HasSubstr("{\"step\": 1, \"replies\": [], \"platform\": [], \"log\": []}"));
}

TEST_F(DemoCommandTest, ShowsWhatIsExpected) {
  ProgramStart demo{{"demo"}};
  demo.environment = {{"HOME", folder_.path().string()}, {"TMPDIR", folder_.path().string()}};
  const ProgramEnd end = runProgram(demo);
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, AllOf(HasSubstr("REQUIRES_UNLOCK"), HasSubstr("UNREACHABLE"),
                                HasSubstr("FOUND_NO_MATCHING_ENTITIES"), HasSubstr("\n# ")));
  EXPECT_TRUE(std::filesystem::is_empty(folder_.path()));
}

}  // namespace
}  // namespace nidus
