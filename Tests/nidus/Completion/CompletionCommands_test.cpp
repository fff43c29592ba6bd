#include <filesystem>

#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

using ::testing::HasSubstr;
using ::testing::IsEmpty;

using CompleteCommandTest = ProgramTest;
using CompletionCommandTest = ProgramTest;

TEST_F(CompleteCommandTest, PrintsOneWordPerLine) {
  const ProgramEnd end = run({"complete", "--", "home", "e"});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, HasSubstr("export\n"));
}

TEST_F(CompleteCommandTest, MarksFilesByAnEmptyLine) {
  EXPECT_EQ(run({"complete", "--", "home", "import", ""}).output, "\n");
  EXPECT_EQ(run({"complete", "--", "--data", ""}).output, "\n");
}

TEST_F(CompleteCommandTest, KnowsTheWordsWithoutADataFolder) {
  EXPECT_EQ(run({"complete", "--", "vocabulary", "brigh"}).output, "brightness\n");
  EXPECT_FALSE(std::filesystem::exists(data()));
}

TEST_F(CompleteCommandTest, TellsOfAHomeThatCannotBeRead) {
  std::filesystem::create_directories(data());
  folder_.write("data/home.db", "no database at all, but something else of some length");
  const ProgramEnd end = run({"complete", "--", "vocabulary", ""});
  EXPECT_EQ(end.exitStatus, 4);
  EXPECT_THAT(end.output, IsEmpty());
  EXPECT_THAT(end.errors, IsOneFailure(data()));
}

TEST_F(CompleteCommandTest, IsForProgramsAlone) {
  EXPECT_THAT(run({"--help"}).output, ::testing::Not(HasSubstr("complete ")));
  EXPECT_THAT(run({"complete", "--", "complet"}).output, "completion\n");
}

TEST_F(CompletionCommandTest, PrintsAScriptForEachShell) {
  for (const char* shell : {"bash", "zsh", "fish"}) {
    const ProgramEnd end = run({"completion", shell});
    SCOPED_TRACE(shell);
    EXPECT_EQ(end.exitStatus, 0) << end.errors;
    EXPECT_THAT(end.output, HasSubstr(std::string("nidus completion ") + shell));
    const ProgramEnd check = runProgram({.arguments = {"-n", folder_.write(shell, end.output)},
                                         .program = std::string("/usr/bin/") + shell});
    EXPECT_EQ(check.exitStatus, 0) << check.errors;
    EXPECT_THAT(check.errors, IsEmpty());
  }
}

TEST_F(CompletionCommandTest, RefusesAnotherShell) {
  const ProgramEnd end = run({"completion", "pwsh"});
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, IsOneFailure("completion: there is no script for pwsh"));
}

}  // namespace
}  // namespace nidus
