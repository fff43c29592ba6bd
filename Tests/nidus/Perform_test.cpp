#include <algorithm>

#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

std::size_t linesOf(const std::string& text) {
  return static_cast<std::size_t>(std::count(text.begin(), text.end(), '\n'));
}

class PerformTest : public ProgramTest {
 protected:
  void SetUp() override { importSmallHome(); }
};

TEST_F(PerformTest, SucceedsWithAReply) {
  const ProgramEnd end = run({"perform"}, readCommandLine("Lamp") + "\n");
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_EQ(linesOf(end.output), 1U);
  EXPECT_THAT(end.output, AllOf(HasSubstr("COMMAND_SUCCESS"), HasSubstr("\"boolean\": true")));
  EXPECT_THAT(end.errors, IsEmpty());
}

TEST_F(PerformTest, TellsAnotherOutcome) {
  const ProgramEnd end = run({"perform"}, readCommandLine("Chandelier"));
  EXPECT_EQ(end.exitStatus, 1);
  EXPECT_THAT(end.output, HasSubstr("FOUND_NO_MATCHING_ENTITIES"));
}

TEST_F(PerformTest, CallsAnUnreachableLampASuccess) {
  const ProgramEnd end = run({"perform"}, setCommandLine("Away", true));
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, HasSubstr("UNREACHABLE"));
}

TEST_F(PerformTest, KnowsWhetherTheDeviceIsLocked) {
  const ProgramEnd locked = run({"--locked", "perform"}, setCommandLine("Door", true));
  EXPECT_EQ(locked.exitStatus, 1);
  EXPECT_THAT(locked.output, HasSubstr("REQUIRES_UNLOCK"));
  EXPECT_EQ(run({"perform", "--locked"}, setCommandLine("Door", true)).exitStatus, 1);
  EXPECT_EQ(run({"perform"}, setCommandLine("Door", true)).exitStatus, 0);
}

TEST_F(PerformTest, KeepsWhatItHasWritten) {
  EXPECT_EQ(run({"perform"}, setCommandLine("Lamp", false)).exitStatus, 0);
  EXPECT_THAT(run({"perform"}, readCommandLine("Lamp")).output, HasSubstr("\"boolean\": false"));
}

TEST_F(PerformTest, AnswersInOrderWithTheHighestStatus) {
  const ProgramEnd end =
      run({"perform"}, setCommandLine("Lamp", false) + "\n" + readCommandLine("Chandelier") + "\n" +
                           readCommandLine("Lamp") + "\n");
  EXPECT_EQ(end.exitStatus, 1);
  ASSERT_EQ(linesOf(end.output), 3U);
  EXPECT_LT(end.output.find("FOUND_NO_MATCHING"), end.output.rfind("COMMAND_SUCCESS"));
}

TEST_F(PerformTest, GoesOnAfterABadLine) {
  const ProgramEnd end = run({"perform"}, readCommandLine("Lamp") + "\n{\"filters\": {}}\n\n" +
                                              setCommandLine("Lamp", false) + "\n");
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_EQ(linesOf(end.output), 2U);
  EXPECT_THAT(end.errors, IsOneFailure("standard input: line 2: /filters: "));
  EXPECT_THAT(exported(), HasSubstr("\"value\": false"));
}

TEST_F(PerformTest, CountsBlankLines) {
  const ProgramEnd end = run({"perform", "-"}, "\n  \r\nx\n");
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, IsOneFailure("standard input: line 3"));
}

TEST_F(PerformTest, AnswersALineBeforeTheNext) {
  ProgramProcess process(start({"perform"}));
  process.write(setCommandLine("Lamp", false) + "\n");
  EXPECT_THAT(process.readLine().value_or(""), HasSubstr("\"boolean\": false"));
  process.write(setCommandLine("Lamp", true) + "\n");
  EXPECT_THAT(process.readLine().value_or(""), HasSubstr("\"boolean\": true"));
  const ProgramEnd end = process.finish();
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, IsEmpty());
}

TEST_F(PerformTest, ReadsAFileOfLines) {
  const auto file = folder_.write(
      "commands.jsonl", readCommandLine("Lamp") + "\nx\n" + readCommandLine("Lamp") + "\n");
  const ProgramEnd end = run({"perform", file});
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_EQ(linesOf(end.output), 2U);
  EXPECT_THAT(end.errors, IsOneFailure(file + ": line 2"));
}

TEST_F(PerformTest, ReadsAFileWhoseFirstLineIsBad) {
  const auto file =
      folder_.write("commands.jsonl", "{\"filter\": \n" + readCommandLine("Lamp") + "\n");
  const ProgramEnd end = run({"perform", file});
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_EQ(linesOf(end.output), 1U);
  EXPECT_THAT(end.errors, IsOneFailure(file + ": line 1, column 12: "));
}

TEST_F(PerformTest, NamesTheColumnOfALine) {
  const ProgramEnd end = run({"perform"}, readCommandLine("Lamp") + "\n\n[,\n");
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, IsOneFailure("standard input: line 3, column 2: "));
}

TEST_F(PerformTest, ReadsAFileThatIsOneDocument) {
  const auto file =
      folder_.write("command.json",
                    "{\n  \"filter\": {\n    \"search\": {\"serviceName\": \"Lamp\"}\n"
                    "  },\n  \"actions\": [\n    {\"attribute\": \"POWER\"}\n  ]\n}\n");
  const ProgramEnd end = run({"perform", file});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_EQ(linesOf(end.output), 1U);
}

TEST_F(PerformTest, NamesThePlaceInADocument) {
  const auto file =
      folder_.write("command.json", "{\n  \"filter\": {\n    \"search\": {\"lamp\": 1}\n  }\n}\n");
  const ProgramEnd end = run({"perform", file});
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.output, IsEmpty());
  EXPECT_THAT(end.errors, IsOneFailure(file + ": /filter/search/lamp: "));
}

TEST_F(PerformTest, ReportsABrokenDocumentOnce) {
  const auto file =
      folder_.write("command.json", "{\n  \"filter\": {\n    \"search\": {,}\n  }\n}\n");
  const ProgramEnd end = run({"perform", file});
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, IsOneFailure(file + ": "));
}

TEST_F(PerformTest, RefusesAnInputWithoutCommands) {
  EXPECT_THAT(run({"perform"}, "").errors, IsOneFailure("standard input: "));
  for (const char* text : {"", "\n \n"}) {
    const auto file = folder_.write("empty.json", text);
    const ProgramEnd end = run({"perform", file});
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.errors, IsOneFailure(file + ": "));
  }
}

TEST_F(PerformTest, LeavesTheHomesOnBadInput) {
  const std::string before = exported();
  const std::string nested(100000, '[');
  const std::vector<std::string> table = {
      "x",
      "[]",
      "5",
      "{",
      "{} {}",
      nested,
      "{\"filter\": {\"search\": {\"roomName\": \"\xff\"}}}",
      "{\"actions\": [], \"actions\": []}",
      "{\"filter\": {\"search\": {}, \"identifiers\": []}}",
      "{\"actions\": [{\"value\": {\"integer\": 1.5}}]}",
  };
  for (const std::string& text : table) {
    const ProgramEnd end = run({"perform"}, text + "\n");
    SCOPED_TRACE(end.errors);
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.output, IsEmpty());
    EXPECT_THAT(end.errors, IsOneFailure("standard input: line 1"));
  }
  EXPECT_EQ(exported(), before);
}

TEST_F(PerformTest, NamesAFileThatIsNotThere) {
  const ProgramEnd end = run({"perform", folder_.file("missing.json")});
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, IsOneFailure(folder_.file("missing.json") + ": "));
}

TEST_F(PerformTest, StopsWhenNobodyReadsTheReplies) {
  ProgramStart full =
      start({"perform"}, readCommandLine("Lamp") + "\n" + setCommandLine("Lamp", false) + "\n");
  full.outputFile = "/dev/full";
  const ProgramEnd end = runProgram(full);
  EXPECT_EQ(end.exitStatus, 4);
  EXPECT_THAT(end.errors, IsOneFailure("standard output: "));
  EXPECT_THAT(run({"perform"}, readCommandLine("Lamp")).output, HasSubstr("\"boolean\": true"));
}

TEST_F(PerformTest, SharesOneDataFolderAmongProcesses) {
  ProgramProcess first(start({"perform"}));
  ProgramProcess second(start({"perform"}));
  for (const bool isOn : {false, true, false}) {
    first.write(setCommandLine("Lamp", isOn) + "\n");
    ASSERT_TRUE(first.readLine());
    second.write(readCommandLine("Lamp") + "\n");
    EXPECT_THAT(second.readLine().value_or(""),
                HasSubstr(isOn ? "\"boolean\": true" : "\"boolean\": false"));
  }
}

TEST_F(PerformTest, SeesAnImportOfAnotherProcess) {
  ProgramProcess process(start({"perform"}));
  process.write(readCommandLine("Lamp") + "\n");
  EXPECT_THAT(process.readLine().value_or(""), HasSubstr("COMMAND_SUCCESS"));
  import(documentOf({emptyHome("Empty", 5)}));
  process.write(readCommandLine("Lamp") + "\n");
  EXPECT_THAT(process.readLine().value_or(""), HasSubstr("FOUND_NO_MATCHING_ENTITIES"));
}

}  // namespace
}  // namespace nidus
