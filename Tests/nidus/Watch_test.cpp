#include <csignal>

#include "nidus/ProgramTest.h"
#include "nidus/TerminalProcess.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::MatchesRegex;

class WatchTest : public ProgramTest {
 protected:
  void SetUp() override { importSmallHome(); }

  /// How to start a watch whose messages come with its output.
  [[nodiscard]] ProgramStart watch(const std::string& options = "") const {
    ProgramStart shell{{"-c", std::string("exec " NIDUS_PROGRAM " --data ") + data() + " watch " +
                                  options + " 2>&1"}};
    shell.program = "/bin/sh";
    return shell;
  }
  /// Waits until the watch has begun.
  static void begin(ProgramProcess& process, const std::string& extent) {
    ASSERT_EQ(process.readLine(), "nidus: watching " + extent + "; stop with Ctrl-C");
  }
  void setPower(const std::string& service, bool isOn) const {
    ASSERT_EQ(run({"perform"}, setCommandLine(service, isOn)).exitStatus, 0);
  }
  /// What a watch says and how it ends once it is told to.
  static void endBy(int signal, ProgramProcess& process) {
    process.sendSignal(signal);
    const ProgramEnd end = process.finish();
    EXPECT_EQ(end.exitStatus, 0);
    EXPECT_THAT(end.output, IsEmpty());
  }
};

TEST_F(WatchTest, TellsWhatAnotherProcessSets) {
  ProgramProcess process(watch());
  begin(process, "3 services of 1 home");
  setPower("Lamp", false);
  EXPECT_THAT(process.readLine().value_or(""),
              MatchesRegex("[0-2][0-9]:[0-5][0-9]:[0-6][0-9]  Cottage / Kitchen / Lamp / Lamp  "
                           "POWER  on -> off"));
  setPower("Lamp", true);
  EXPECT_THAT(process.readLine().value_or(""), HasSubstr("POWER  off -> on"));
  endBy(SIGINT, process);
}

TEST_F(WatchTest, TellsProgramsInJson) {
  ProgramProcess process(watch("--json"));
  begin(process, "3 services of 1 home");
  setPower("Lamp", false);
  EXPECT_THAT(process.readLine().value_or(""),
              AllOf(HasSubstr(R"("change": "changed", "home": "Cottage", "room": "Kitchen")"),
                    HasSubstr(R"("before": {"boolean": true}, "after": {"boolean": false}})")));
  endBy(SIGTERM, process);
}

TEST_F(WatchTest, TellsWhatAnImportChanges) {
  ProgramProcess process(watch());
  begin(process, "3 services of 1 home");
  import(documentOf({emptyHome("Other", 2)}));
  EXPECT_THAT(process.readLine().value_or(""), HasSubstr("  Other  added"));
  EXPECT_THAT(process.readLine().value_or(""), HasSubstr("  Cottage  removed"));
  endBy(SIGINT, process);
}

TEST_F(WatchTest, TellsWhatAChangeOfTheHomeRemoves) {
  ProgramProcess process(watch());
  begin(process, "3 services of 1 home");
  ASSERT_EQ(run({"home", "remove", "accessory", "Lamp", "--yes"}).exitStatus, 0);
  EXPECT_THAT(process.readLine().value_or(""), HasSubstr("Cottage / Kitchen / Lamp  removed"));
  endBy(SIGINT, process);
}

TEST_F(WatchTest, PassesOverWhatIsNotAskedFor) {
  ProgramProcess process(watch("--home Cottage --service Door"));
  begin(process, "1 service of 1 home");
  setPower("Lamp", false);
  setPower("Door", true);
  EXPECT_THAT(process.readLine().value_or(""), HasSubstr("Cottage / Door / Door  POWER"));
  endBy(SIGINT, process);
}

TEST_F(WatchTest, RefusesNamesThatNothingHas) {
  const ProgramEnd home = run({"watch", "--home", "Cotage"});
  EXPECT_EQ(home.exitStatus, 2);
  EXPECT_EQ(home.errors, "nidus: there is no home Cotage; did you mean Cottage?\n");
  const ProgramEnd room = run({"watch", "--room", "kitchn"});
  EXPECT_EQ(room.exitStatus, 2);
  EXPECT_EQ(room.errors, "nidus: there is no room kitchn; did you mean Kitchen?\n");
}

TEST_F(WatchTest, TellsThatARoomIsRenamed) {
  ProgramProcess process(watch("--room Kitchen"));
  begin(process, "2 services of 1 home");
  ASSERT_EQ(run({"home", "rename", "room", "Kitchen", "Galley"}).exitStatus, 0);
  EXPECT_THAT(process.readLine().value_or(""),
              HasSubstr("  Cottage / Galley  name  Kitchen -> Galley"));
  endBy(SIGINT, process);
}

TEST_F(WatchTest, WaitsForTheFirstHome) {
  std::filesystem::remove_all(data());
  ProgramProcess process(watch());
  begin(process,
        "for the first home, which nidus home add home NAME or nidus home import FILE adds");
  importSmallHome();
  EXPECT_THAT(process.readLine().value_or(""), HasSubstr("  Cottage  added"));
  endBy(SIGINT, process);
}

TEST_F(WatchTest, EndsWhenItsReaderHasGone) {
  ProgramProcess process(watch());
  begin(process, "3 services of 1 home");
  process.closeOutput();
  EXPECT_EQ(process.finish().exitStatus, 0);
}

TEST_F(WatchTest, EndsWhenTheDatabaseIsGone) {
  ProgramProcess process(watch());
  begin(process, "3 services of 1 home");
  std::filesystem::remove_all(data());
  const ProgramEnd end = process.finish();
  EXPECT_EQ(end.exitStatus, 4);
  EXPECT_THAT(end.output, IsOneFailure(data() + "/home.db: the database is gone; "));
}

TEST_F(WatchTest, FailsWhereItCannotPrint) {
  ProgramStart full = start({"watch"});
  full.program = "/bin/sh";
  full.arguments = {"-c", "exec " NIDUS_PROGRAM " --data " + data() + " watch 2>&1 >/dev/full"};
  ProgramProcess process(full);
  begin(process, "3 services of 1 home");
  setPower("Lamp", false);
  const ProgramEnd end = process.finish();
  EXPECT_EQ(end.exitStatus, 4);
  EXPECT_THAT(end.output, IsOneFailure("standard output: "));
}

TEST_F(WatchTest, IsInterruptedFromTheKeyboard) {
  TerminalProcess terminal(start({"watch"}));
  ASSERT_TRUE(terminal.waitFor("stop with Ctrl-C"));
  setPower("Lamp", false);
  ASSERT_TRUE(terminal.waitFor("POWER  on -> off"));
  terminal.interrupt();
  const ProgramEnd end = terminal.finish();
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_EQ(end.signal, 0);
}

}  // namespace
}  // namespace nidus
