#include "nidus/CommandLine.h"
#include "nidus/Completion/CommandOutline.h"
#include "nidus/ProgramTest.h"
#include "nidus/Workspace.h"

namespace nidus {
namespace {

using ::testing::HasSubstr;
using ::testing::IsEmpty;

struct HelpCase {
  std::vector<std::string> command;
  std::vector<std::string> mentions;
};

TEST_F(ProgramTest, HelpsOnEachLevel) {
  const HelpCase table[] = {
      {{},
       {"--data", "--locked", "--version", "home", "perform", "sync", "records", "replay", "demo",
        "doctor", "Exit status"}},
      {{"home"}, {"import", "export", "show", "check", "--data"}},
      {{"home", "import"}, {"FILE", "--merge", "--data"}},
      {{"home", "export"}, {"FILE"}},
      {{"home", "show"}, {"tree"}},
      {{"home", "check"}, {"FILE"}},
      {{"home", "add"}, {"room", "scene", "Examples"}},
      {{"home", "add", "home"}, {"NAME", "--primary", "Example", "Exit status"}},
      {{"home", "add", "zone"}, {"--room ROOM", "repeated", "--home", "Example"}},
      {{"home", "add", "service"}, {"--type TYPE", "--attribute", "required", "nidus vocabulary"}},
      {{"home", "add", "scene"}, {"--set SETTING", "Example"}},
      {{"home", "rename"}, {"room", "service", "Examples"}},
      {{"home", "rename", "room"}, {"NAME", "NEWNAME", "--home", "Exit status"}},
      {{"home", "move"}, {"accessory", "room", "service", "Example"}},
      {{"home", "move", "accessory"}, {"--to ROOM", "--to-no-room", "Exit status"}},
      {{"home", "move", "room"}, {"--to-zone", "--from-zone", "Example", "Exit status"}},
      {{"home", "move", "service"}, {"--to-group", "--from-group", "ACCESSORY/NAME"}},
      {{"home", "remove"}, {"--yes", "scene", "Examples"}},
      {{"home", "remove", "room"}, {"NAME", "--home", "--yes", "Exit status"}},
      {{"home", "edit"}, {"EDITOR", "VISUAL", "--yes", "Examples", "Exit status"}},
      {{"perform"}, {"FILE", "standard input", "Exit status", "\"filter\""}},
      {{"sync"}, {"reset"}},
      {{"records"}, {"record a line"}},
      {{"vocabulary"}, {"WORD", "--json", "Exit status"}},
      {{"preferences"}, {"list", "get", "set", "unset", "preferences.json"}},
      {{"preferences", "set"}, {"KEY", "VALUE", "Exit status"}},
      {{"explain"}, {"ORDER", "--command", "--json", "--room", "Exit status"}},
      {{"replay"}, {"SCENARIO"}},
      {{"completion"}, {"bash, zsh or fish", "Exit status"}},
      {{"shell"}, {"history", "Example", "Exit status"}},
      {{"demo"}, {"temporary folder"}},
      {{"doctor"}, {"--json", "Example", "Exit status"}},
      {{"watch"}, {"--json", "--room", "Example", "Exit status"}},
  };
  for (const HelpCase& help : table) {
    std::vector<std::string> arguments = help.command;
    arguments.emplace_back("--help");
    const ProgramEnd end = runProgram({arguments});
    SCOPED_TRACE(end.output);
    EXPECT_EQ(end.exitStatus, 0);
    EXPECT_THAT(end.errors, IsEmpty());
    for (const std::string& mention : help.mentions) EXPECT_THAT(end.output, HasSubstr(mention));
  }
}

TEST_F(ProgramTest, TellsItsVersion) {
  const ProgramEnd end = runProgram({{"--version"}});
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_THAT(end.output, ::testing::MatchesRegex("nidus [0-9]+\\.[0-9]+\\.[0-9]+\n"));
}

TEST_F(ProgramTest, RefusesBadUsageOnOneLine) {
  const std::vector<std::vector<std::string>> table = {
      {},
      {"dance"},
      {"home"},
      {"home", "dance"},
      {"home", "import"},
      {"home", "import", "a", "b"},
      {"home", "check"},
      {"replay"},
      {"sync", "extra"},
      {"--frobnicate"},
      {"perform", "--merge"},
      {"--data"},
  };
  for (const std::vector<std::string>& arguments : table) {
    const ProgramEnd end = runProgram({arguments});
    SCOPED_TRACE(::testing::PrintToString(arguments) + end.errors);
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.output, IsEmpty());
    EXPECT_THAT(end.errors, IsOneFailure(""));
    EXPECT_THAT(end.errors, HasSubstr("--help"));
  }
}

struct UsageCase {
  std::vector<std::string> arguments;
  std::string errors;
};

TEST_F(ProgramTest, TellsWhatIsWrongWithItsArguments) {
  const UsageCase table[] = {
      {{"dance"}, "there is no command dance; see nidus --help"},
      {{"gett", "power"}, "there is no command gett; did you mean get?"},
      {{"home", "shw"}, "there is no command shw; did you mean show?"},
      {{"--dance"}, "there is no option --dance; see nidus --help"},
      {{"get", "power", "--rom", "K"}, "there is no option --rom; did you mean --room?"},
      {{"home", "import", "--merg=1"}, "there is no option --merg; did you mean --merge?"},
      {{"sync", "--dat", "x"}, "there is no option --dat; did you mean --data?"},
      {{"home", "add", "room", "A", "B"},
       "there is no place for the argument B; see nidus home add room --help"},
      {{"home", "add", "service", "Lamp", "Floor lamp", "light"},
       "there is no place for the argument Floor lamp; see nidus home add service --help"},
      {{"home"}, "a command is missing; see nidus home --help"},
      {{"home", "import"}, "FILE is missing; see nidus home import --help"},
      {{"home", "add", "service", "Lamp"},
       "--accessory is missing; see nidus home add service --help"},
      {{"--data"}, "--data has no value after it; see nidus --help"},
      {{"home", "show", "--data"}, "--data has no value after it; see nidus home show --help"},
      {{"get", "power", "--room", "A", "--room", "B"},
       "--room is given more than once; see nidus get --help"},
      {{"--data", ""}, "--data: the value is empty; see nidus --help"},
  };
  for (const UsageCase& usage : table) {
    EXPECT_EQ(runProgram({usage.arguments}).errors, "nidus: " + usage.errors + '\n');
  }
}

/// The words of `command` and of all below it, each with the option for help.
std::vector<std::vector<std::string>> helpsOf(const CommandOutline& command,
                                              std::vector<std::string> words = {}) {
  std::vector<std::vector<std::string>> helps;
  for (const auto& below : command.commands()) {
    if (below->isHidden()) continue;
    std::vector<std::string> longer = words;
    longer.push_back(below->name());
    const auto more = helpsOf(*below, longer);
    helps.insert(helps.end(), more.begin(), more.end());
  }
  words.emplace_back("--help");
  helps.push_back(words);
  return helps;
}

TEST_F(ProgramTest, TellsExamplesAndExitStatusesOfEachCommand) {
  Workspace workspace;
  CommandOutline program;
  declareProgram(program, workspace);
  for (const auto& arguments : helpsOf(program)) {
    const std::string help = runProgram({arguments}).output;
    SCOPED_TRACE(::testing::PrintToString(arguments));
    EXPECT_THAT(help, HasSubstr("\nExit status: "));
    EXPECT_THAT(help, HasSubstr(arguments.size() > 1 ? "Example" : "nidus demo"));
  }
}

TEST_F(ProgramTest, ReportsAnOutputThatIsFull) {
  for (const std::vector<std::string>& arguments :
       {std::vector<std::string>{"--help"}, {"demo"}, {"home", "show"}, {"home", "export"}}) {
    ProgramStart full = start(arguments);
    full.outputFile = "/dev/full";
    const ProgramEnd end = runProgram(full);
    SCOPED_TRACE(::testing::PrintToString(arguments) + end.errors);
    EXPECT_EQ(end.exitStatus, 4);
    EXPECT_THAT(end.errors, IsOneFailure("standard output: "));
  }
}

}  // namespace
}  // namespace nidus
