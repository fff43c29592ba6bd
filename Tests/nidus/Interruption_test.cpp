#include <csignal>

#include "nidus/ProgramTest.h"
#include "nidus/TerminalProcess.h"

namespace nidus {
namespace {

using ::testing::AnyOf;

using InterruptionTest = ProgramTest;

TEST_F(InterruptionTest, LeavesNoFolderOfTheDemonstration) {
  std::filesystem::create_directory(folder_.path() / "temporary");
  ProgramStart demo = {{"demo"}};
  demo.environment["TMPDIR"] = folder_.file("temporary");
  TerminalProcess terminal(demo);
  ASSERT_TRUE(terminal.waitFor("#")) << terminal.output();
  terminal.interrupt();
  const ProgramEnd end = terminal.finish();
  EXPECT_TRUE(end.signal == SIGINT || end.exitStatus == 0) << end.output;
  EXPECT_TRUE(std::filesystem::is_empty(folder_.path() / "temporary"));
}

TEST_F(InterruptionTest, LeavesTheOldExportOrTheNewOne) {
  importSmallHome();
  std::filesystem::create_directory(folder_.path() / "out");
  const auto file = folder_.write("out/homes.json", "old");
  TerminalProcess terminal(start({"home", "export", file}));
  terminal.interrupt();
  static_cast<void>(terminal.finish());
  EXPECT_THAT(contentOfFile(file), AnyOf("old", exported()));
  const std::filesystem::directory_iterator files(folder_.path() / "out");
  EXPECT_EQ(std::distance(begin(files), end(files)), 1);
}

TEST_F(InterruptionTest, LeavesAValueAsBeforeOrAsAfter) {
  importSmallHome();
  const std::string before = exported();
  TerminalProcess terminal(start({"perform"}));
  terminal.write(setCommandLine("Lamp", false) + "\n");
  terminal.interrupt();
  EXPECT_EQ(terminal.finish().signal, SIGINT);
  const std::string now = exported();
  EXPECT_EQ(run({"perform"}, setCommandLine("Lamp", false)).exitStatus, 0);
  EXPECT_THAT(now, AnyOf(before, exported()));
}

}  // namespace
}  // namespace nidus
