#include "nidus/Shell/Shell.h"

#include "nidus/ProgramTest.h"
#include "nidus/TerminalProcess.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;

/// Runs the shell on the small home, its history in the folder of the test.
class ShellCommandTest : public ProgramTest {
 protected:
  void SetUp() override { importSmallHome(); }

  [[nodiscard]] ProgramEnd runLines(const std::string& lines) const {
    return run({"shell"}, lines);
  }
  [[nodiscard]] ProgramStart startOnTerminal() const {
    ProgramStart started = start({"shell"});
    started.environment = {{"XDG_STATE_HOME", folder_.file("state")}};
    return started;
  }
};

TEST_F(ShellCommandTest, RunsTheLinesOfAPipe) {
  const ProgramEnd end = runLines("home show\n\n  # a comment\nnidus vocabulary \"brightness\"\n");
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.errors, IsEmpty());
  EXPECT_THAT(end.output, AllOf(HasSubstr("Cottage"), HasSubstr("BRIGHTNESS"),
                                Not(HasSubstr("nidus>")), Not(HasSubstr(" ms"))));
}

TEST_F(ShellCommandTest, NumbersBadLinesAndGoesOn) {
  const ProgramEnd end = runLines("vocabulary power\ndance\nrun 'Night\nhome show\n");
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, AllOf(HasSubstr("nidus: line 2: there is no command dance"),
                                HasSubstr("nidus: line 3: a quote is open")));
  EXPECT_THAT(end.output, HasSubstr("Cottage"));
}

TEST_F(ShellCommandTest, PointsToItsOwnHelp) {
  EXPECT_THAT(runLines("xyzzy\n").errors, HasSubstr("no command xyzzy; see help\n"));
  EXPECT_THAT(runLines("home xyzzy\n").errors, HasSubstr("no command xyzzy; see help home\n"));
  const std::string help = runLines("help\n").output;
  EXPECT_THAT(help, AllOf(HasSubstr("help COMMAND"), Not(HasSubstr("nidus demo"))));
}

TEST_F(ShellCommandTest, EndsWithTheHighestStatus) {
  const std::string silent = folder_.write("missing.json", readCommandLine("Attic"));
  EXPECT_EQ(runLines("perform '" + silent + "'\nhome show\n").exitStatus, 1);
  EXPECT_EQ(runLines("dance\nperform '" + silent + "'\n").exitStatus, 2);
  EXPECT_EQ(runLines("").exitStatus, 0);
}

TEST_F(ShellCommandTest, LeavesAtALineThatSaysSo) {
  for (const char* leaving : {"exit", "quit"}) {
    const ProgramEnd end = runLines(std::string(leaving) + "\nhome show\n");
    EXPECT_EQ(end.exitStatus, 0);
    EXPECT_THAT(end.output, IsEmpty());
  }
}

TEST_F(ShellCommandTest, HoldsAnOptionForOneLine) {
  const std::string file = folder_.write("door.json", setCommandLine("Door", true));
  const ProgramEnd end = runLines("--locked perform '" + file + "'\nperform '" + file + "'\n");
  // The two replies of the first line come in either order.
  EXPECT_THAT(end.output, HasSubstr("REQUIRES_UNLOCK"));
  EXPECT_THAT(end.output.substr(end.output.rfind("{\"commandOutcome")),
              HasSubstr("COMMAND_SUCCESS"));
}

TEST_F(ShellCommandTest, TellsWhatIsRunOutside) {
  for (const std::string command : {"demo", "shell", "replay"}) {
    const ProgramEnd end = runLines(command + "\n");
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.errors, IsOneFailure("line 1: " + command + " is run outside of the shell"));
  }
}

TEST_F(ShellCommandTest, HelpsOnItsCommands) {
  EXPECT_THAT(runLines("help\n").output, AllOf(HasSubstr("records"), Not(HasSubstr("replay"))));
  EXPECT_THAT(runLines("help home show\n").output, HasSubstr("Shows the homes as trees"));
}

TEST_F(ShellCommandTest, GivesTheRestOfItsInputToAPerform) {
  const ProgramEnd end = runLines("perform\n" + readCommandLine("Lamp") + "\n");
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, HasSubstr("COMMAND_SUCCESS"));
}

TEST_F(ShellCommandTest, OutlivesAnExplanation) {
  const ProgramEnd end = runLines("explain get power\n");
  EXPECT_EQ(end.signal, 0);
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
}

TEST_F(ShellCommandTest, ShowsTheTimeOfALine) {
  TerminalProcess terminal(startOnTerminal());
  ASSERT_TRUE(terminal.waitFor("nidus> "));
  terminal.write("home show\n");
  ASSERT_TRUE(terminal.waitFor("Cottage"));
  ASSERT_TRUE(terminal.waitFor("s\x1b[0m"));
  terminal.write("exit\n");
  const ProgramEnd end = terminal.finish();
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, ::testing::ContainsRegex("\x1b\\[[0-9]+m[0-9.]+ m?s\x1b"));
}

TEST_F(ShellCommandTest, BringsBackLinesOfTheRunBefore) {
  for (const char* keys : {"vocabulary power\n", "\x1b[A\n"}) {
    TerminalProcess terminal(startOnTerminal());
    ASSERT_TRUE(terminal.waitFor("nidus> "));
    terminal.write(keys);
    ASSERT_TRUE(terminal.waitFor("POWER"));
    ASSERT_TRUE(terminal.waitFor("nidus> "));
    terminal.write("\x04");
    EXPECT_EQ(terminal.finish().exitStatus, 0);
  }
}

TEST_F(ShellCommandTest, ThrowsAnInterruptedLineAway) {
  TerminalProcess terminal(startOnTerminal());
  ASSERT_TRUE(terminal.waitFor("nidus> "));
  terminal.write("dance");
  terminal.interrupt();
  ASSERT_TRUE(terminal.waitFor("^C"));
  terminal.write("home show\n");
  ASSERT_TRUE(terminal.waitFor("Cottage"));
  terminal.write("quit\n");
  const ProgramEnd end = terminal.finish();
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, Not(HasSubstr("no command")));
}

TEST_F(ShellCommandTest, CompletesAtTheTabKey) {
  TerminalProcess terminal(startOnTerminal());
  ASSERT_TRUE(terminal.waitFor("nidus> "));
  terminal.write("voc\tBRIGH\t\n");
  ASSERT_TRUE(terminal.waitFor("BRIGHTNESS - an attribute"));
  terminal.write("home re\t");
  ASSERT_TRUE(terminal.waitFor("remove   rename   restore"));
  terminal.write(
      "\x15"
      "exit\n");
  EXPECT_EQ(terminal.finish().exitStatus, 0);
}

TEST_F(ShellCommandTest, CompletesARoomWithAnAccentAndASpace) {
  TerminalProcess terminal(startOnTerminal());
  ASSERT_TRUE(terminal.waitFor("nidus> "));
  // Not in this home, and in the one that takes its place.
  terminal.write("get power --room cafe\t\x15");
  terminal.write("home import " NIDUS_RESOURCES "/demonstration-home.json\n");
  ASSERT_TRUE(terminal.waitFor("imported"));
  ASSERT_TRUE(terminal.waitFor("nidus> "));
  terminal.write("get power --room cafe\t--type light\n");
  ASSERT_TRUE(terminal.waitFor(R"(Café\ Corner )"));
  ASSERT_TRUE(terminal.waitFor("Café Lamp"));
  ASSERT_TRUE(terminal.waitFor("nidus> "));
  terminal.write("exit\n");
  EXPECT_EQ(terminal.finish().exitStatus, 0);
}

TEST(ShellTest, SaysDurationsForPeople) {
  EXPECT_EQ(durationText(0.41), "0.4 ms");
  EXPECT_EQ(durationText(9.96), "10 ms");
  EXPECT_EQ(durationText(123.4), "123 ms");
  EXPECT_EQ(durationText(1500), "1.5 s");
}

}  // namespace
}  // namespace nidus
