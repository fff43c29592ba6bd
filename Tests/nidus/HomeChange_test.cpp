#include <csignal>

#include "nidus/HomeEditing/SampleHomes.h"
#include "nidus/ProgramTest.h"
#include "nidus/TerminalProcess.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Not;

constexpr const char kKitchenGoes[] =
    "the room Kitchen of Beach House, putting its 1 accessory into no room and taking it out of 1 "
    "zone";

/// Commands that change the sample homes.
class HomeChangeTest : public ProgramTest {
 protected:
  void SetUp() override {
    import(sampleDocument());
    before_ = exported();
  }

  /// Whether the command is refused, in one line that has `reason`, and changes nothing.
  void expectRefusal(const std::vector<std::string>& arguments, const std::string& reason) const {
    const ProgramEnd end = run(arguments);
    SCOPED_TRACE(::testing::PrintToString(arguments));
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.output, IsEmpty());
    EXPECT_THAT(end.errors, AllOf(IsOneFailure(""), HasSubstr(reason)));
    EXPECT_EQ(exported(), before_);
  }

  std::string before_;
};

TEST_F(HomeChangeTest, Renames) {
  const ProgramEnd end = run({"home", "rename", "room", "Kitchen", "home", "--home", "Cottage"});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_EQ(end.output, "renamed the room Kitchen of Cottage to home\n");
  EXPECT_THAT(run({"home", "show"}).output, HasSubstr("Cottage\n└─ home\n"));
}

TEST_F(HomeChangeTest, RefusesToRename) {
  expectRefusal({"home", "rename", "room", "Kitchen", "Galley"}, "2 rooms named Kitchen");
  expectRefusal({"home", "rename", "room", "Attic", "Galley"}, "no room Attic");
  expectRefusal({"home", "rename", "room", "Study", ""}, "empty");
  expectRefusal({"home", "rename", "room", "Study"}, "--help");
  expectRefusal({"home", "rename", "house", "Study", "Den"}, "did you mean home?");
  expectRefusal({"home", "rename", "home", "Cottage", "Hut", "--home", "Cottage"}, "--help");
}

TEST_F(HomeChangeTest, MovesAccessories) {
  const ProgramEnd end = run({"home", "move", "accessory", "Floor lamp", "--to", "Study"});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_EQ(end.output, "moved the accessory Floor lamp of Beach House into the room Study\n");
  EXPECT_EQ(run({"home", "move", "accessory", "Floor lamp", "--to-no-room"}).exitStatus, 0);
  EXPECT_EQ(exported(), before_);
}

TEST_F(HomeChangeTest, MovesRoomsAndServices) {
  EXPECT_EQ(run({"home", "move", "room", "Study", "--to-zone", "Upstairs"}).output,
            "moved the room Study of Beach House into the zone Upstairs\n");
  EXPECT_EQ(run({"home", "move", "service", "Floor lamp/Lamp", "--to-group", "Rest"}).output,
            "moved the service Floor lamp/Lamp of Beach House into the group Rest\n");
  EXPECT_THAT(run({"home", "show"}).output,
              AllOf(HasSubstr("Upstairs: Study"), HasSubstr("Rest: Lamp")));
}

TEST_F(HomeChangeTest, RefusesToMove) {
  expectRefusal({"home", "move", "accessory", "Floor lamp"}, "--to ROOM");
  expectRefusal({"home", "move", "accessory", "Floor lamp", "--to", "Study", "--to-no-room"},
                "--to ROOM");
  expectRefusal({"home", "move", "room", "Study"}, "--to-zone");
  expectRefusal({"home", "move", "service", "Floor lamp/Lamp", "--from-group", "Corner"},
                "is not in the group Corner");
}

TEST_F(HomeChangeTest, RemovesWithYesInAPipe) {
  const ProgramEnd end =
      run({"home", "remove", "room", "Kitchen", "--home", "Beach House", "--yes"});
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_EQ(end.output, std::string("removed ") + kKitchenGoes + '\n');
  EXPECT_THAT(end.errors, IsEmpty());
  EXPECT_THAT(run({"home", "show"}).output, HasSubstr("in no room\n│  ├─ Ceiling lamp"));
}

TEST_F(HomeChangeTest, WantsYesInAPipe) {
  expectRefusal({"home", "remove", "room", "Kitchen", "--home", "Beach House"},
                std::string("give --yes to remove ") + kKitchenGoes);
  expectRefusal({"home", "remove", "room", "Attic"}, "no room Attic");
  expectRefusal({"home", "remove", "room", "Attic", "--yes"}, "no room Attic");
}

TEST_F(HomeChangeTest, ForgetsTheHomesWithTheLastOne) {
  EXPECT_EQ(run({"home", "remove", "home", "Cottage", "--yes"}).exitStatus, 0);
  EXPECT_EQ(run({"home", "remove", "home", "Beach House", "--yes"}).exitStatus, 0);
  EXPECT_THAT(run({"records"}).output, IsEmpty());
}

TEST_F(HomeChangeTest, RemovesAfterAYesOnATerminal) {
  for (const char* answer : {"y\n", "Yes\n"}) {
    import(sampleDocument());
    TerminalProcess terminal(start({"home", "remove", "room", kBeachKitchenID}));
    ASSERT_TRUE(terminal.waitFor(std::string("Remove ") + kKitchenGoes + "? [y/N] "));
    terminal.write(answer);
    const ProgramEnd end = terminal.finish();
    EXPECT_EQ(end.exitStatus, 0) << end.output;
    EXPECT_THAT(end.output, HasSubstr("removed the room Kitchen of Beach House"));
    EXPECT_THAT(exported(), Not(HasSubstr(kBeachKitchenID)));
  }
}

TEST_F(HomeChangeTest, KeepsAfterAnyOtherAnswer) {
  for (const char* answer : {"n\n", "\n", "yellow\n", "\x04"}) {
    TerminalProcess terminal(start({"home", "remove", "home", "Cottage"}));
    ASSERT_TRUE(terminal.waitFor("[y/N] "));
    terminal.write(answer);
    const ProgramEnd end = terminal.finish();
    EXPECT_EQ(end.exitStatus, 1) << end.output;
    EXPECT_THAT(end.output, HasSubstr("nothing was removed"));
    EXPECT_EQ(exported(), before_);
  }
}

TEST_F(HomeChangeTest, KeepsWhenInterrupted) {
  TerminalProcess terminal(start({"home", "remove", "home", "Cottage"}));
  ASSERT_TRUE(terminal.waitFor("[y/N] "));
  terminal.interrupt();
  const ProgramEnd end = terminal.finish();
  EXPECT_EQ(end.signal, SIGINT);
  EXPECT_THAT(end.output, ::testing::EndsWith("[y/N] ^C\n"));
  EXPECT_EQ(exported(), before_);
}

TEST_F(HomeChangeTest, AnswersTheEndOfInputOnALineOfItsOwn) {
  TerminalProcess terminal(start({"home", "remove", "home", "Cottage"}));
  ASSERT_TRUE(terminal.waitFor("[y/N] "));
  terminal.write("\x04");
  EXPECT_THAT(terminal.finish().output, HasSubstr("\nnothing was removed\n"));
}

TEST_F(HomeChangeTest, AsksNothingWithYesOnATerminal) {
  const ProgramEnd end = runOnTerminal(start({"home", "remove", "home", "Cottage", "--yes"}));
  EXPECT_EQ(end.exitStatus, 0);
  EXPECT_EQ(end.output, "removed the home Cottage, with its 1 room\n");
}

TEST_F(HomeChangeTest, RefusesWhatWasChangedMeanwhile) {
  TerminalProcess terminal(start({"home", "remove", "room", kBeachKitchenID}));
  ASSERT_TRUE(terminal.waitFor("[y/N] "));
  ASSERT_EQ(run({"home", "move", "accessory", "Floor lamp", "--to", "Kitchen"}).exitStatus, 0);
  const std::string changed = exported();
  terminal.write("y\n");
  const ProgramEnd end = terminal.finish();
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.output, HasSubstr("changed meanwhile, this would remove the room Kitchen of "
                                    "Beach House, putting its 2 accessories into no room"));
  EXPECT_EQ(exported(), changed);
}

}  // namespace
}  // namespace nidus
