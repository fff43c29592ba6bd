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

class DemoCommandTest : public ProgramTest {
 protected:
  [[nodiscard]] ProgramEnd runDemo(std::vector<std::string> arguments = {}) const {
    arguments.insert(arguments.begin(), "demo");
    ProgramStart demo{std::move(arguments)};
    const std::string folder = folder_.path().string();
    demo.environment = {{"HOME", folder}, {"TMPDIR", folder}, {"LC_ALL", "en_US.UTF-8"}};
    return runProgram(demo);
  }
};

TEST_F(DemoCommandTest, ShowsWhatIsExpected) {
  const ProgramEnd end = runDemo();
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_EQ(end.errors, "");
  EXPECT_THAT(end.output, AllOf(HasSubstr("The device must be unlocked"), HasSubstr("unreachable"),
                                HasSubstr("Nothing matches"), HasSubstr("What to try next")));
  EXPECT_TRUE(std::filesystem::is_empty(folder_.path()));
}

TEST_F(DemoCommandTest, GivesTheOutputInTheReadMe) {
  const std::string readMe = contentOfFile(std::string(NIDUS_DOCUMENTATION) + "/../README.md");
  const std::string begin = "```console\n$ nidus demo\n";
  const std::size_t start = readMe.find(begin);
  ASSERT_NE(start, std::string::npos);
  const std::size_t text = start + begin.size();
  EXPECT_EQ(readMe.substr(text, readMe.find("```\n", text) - text), runDemo().output);
}

TEST_F(DemoCommandTest, PrintsItsHome) {
  import(runDemo({"--home"}).output);
  EXPECT_THAT(run({"home", "show"}).output, HasSubstr("Lake Cabin"));
}

}  // namespace
}  // namespace nidus
