#include <string>
#include <utility>
#include <vector>

#include "nidus/ProgramTest.h"
#include "nidus/TerminalProcess.h"

namespace nidus {
namespace {

using OnTerminalTest = ProgramTest;

TEST_F(OnTerminalTest, EachCommandShowsItsText) {
  importSmallHome();
  const std::vector<std::pair<std::vector<std::string>, std::string>> table = {
      {{"vocabulary", "brightness"}, "value type"},
      {{"preferences", "list"}, "kHomesConfigured"},
      {{"preferences", "set", "NidusLogLevel", "5"}, ""},
      {{"preferences", "get", "NidusLogLevel"}, "5"},
      {{"home", "rename", "room", "Kitchen", "Galley"}, "Galley"},
      {{"home", "move", "room", "Galley", "--from-zone", "Downstairs"}, "Galley"},
      {{"completion", "fish"}, "complete"},
      {{"records"}, "Galley"},
      {{"sync"}, "reset"},
      {{"demo"}, "What to try next"},
  };
  for (const auto& [arguments, text] : table) {
    const ProgramEnd end = runOnTerminal(start(arguments));
    EXPECT_EQ(end.exitStatus, 0) << arguments.front() << end.output;
    EXPECT_THAT(end.output, testing::HasSubstr(text)) << arguments.front();
  }
}

}  // namespace
}  // namespace nidus
