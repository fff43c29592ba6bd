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

constexpr const char kRename[] = "sed -i 's/Study/Den/' \"$1\"";
constexpr const char kSpoil[] = "sed -i 's/\"Study\"/7/' \"$1\"";

/// `nidus home edit` with editors that are scripts of the shell; the document is their "$1".
class HomeEditTest : public ProgramTest {
 protected:
  void SetUp() override {
    import(sampleDocument());
    before_ = exported();
    std::filesystem::create_directory(temporary());
  }

  [[nodiscard]] ProgramStart editing(const std::string& script, bool isConfirmed) const {
    ProgramStart edit = start({"home", "edit"});
    if (isConfirmed) edit.arguments.emplace_back("--yes");
    edit.environment = {{"EDITOR", "sh -e " + folder_.write("editor", script)},
                        {"VISUAL", std::nullopt},
                        {"TMPDIR", temporary()}};
    return edit;
  }
  [[nodiscard]] std::string temporary() const { return folder_.file("temporary"); }
  [[nodiscard]] bool isNothingLeft() const { return std::filesystem::is_empty(temporary()); }
  /// The only document that was kept.
  [[nodiscard]] std::string kept() const {
    for (const auto& entry : std::filesystem::recursive_directory_iterator(temporary())) {
      if (entry.is_regular_file()) return entry.path().string();
    }
    return "nothing was kept";
  }

  std::string before_;
};

TEST_F(HomeEditTest, ImportsWhatTheEditorLeaves) {
  const ProgramEnd end = runProgram(editing(kRename, true));
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, AllOf(HasSubstr("-"), HasSubstr("+"), HasSubstr("\"name\": \"Den\""),
                                HasSubstr("1 room renamed\n"), HasSubstr("imported\n")));
  EXPECT_THAT(exported(), AllOf(HasSubstr("\"Den\""), Not(HasSubstr("\"Study\""))));
  EXPECT_TRUE(isNothingLeft());
}

TEST_F(HomeEditTest, ShowsTheDocumentToItsOwnerAlone) {
  const ProgramEnd end = runProgram(editing("stat -c 'mode %a' \"$1\"", true));
  EXPECT_THAT(end.output, HasSubstr("mode 600\n"));
}

TEST_F(HomeEditTest, MustNotLieWhereOthersMayExchangeIt) {
  std::filesystem::permissions(temporary(), std::filesystem::perms(0777));
  const ProgramEnd end = runProgram(editing(kRename, true));
  EXPECT_EQ(end.exitStatus, 4);
  EXPECT_THAT(end.errors, IsOneFailure(temporary() + ": others may change it"));
  EXPECT_EQ(exported(), before_);
  EXPECT_TRUE(isNothingLeft());
}

TEST_F(HomeEditTest, ChangesNothingWithoutAnEdit) {
  for (const char* script : {"true", "echo >> \"$1\""}) {
    const ProgramEnd end = runProgram(editing(script, true));
    EXPECT_EQ(end.exitStatus, 0) << end.errors;
    EXPECT_EQ(end.output, "nothing was changed\n");
    EXPECT_TRUE(isNothingLeft());
  }
  EXPECT_EQ(exported(), before_);
}

TEST_F(HomeEditTest, WantsYesInAPipe) {
  const ProgramEnd end = runProgram(editing("echo edited", false));
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.output, IsEmpty());
  EXPECT_THAT(end.errors, AllOf(IsOneFailure(""), HasSubstr("--yes")));
}

TEST_F(HomeEditTest, KeepsABadDocumentInAPipe) {
  const ProgramEnd end = runProgram(editing(kSpoil, true));
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, AllOf(IsOneFailure(kept() + ": /homes/0/rooms/1/name: "),
                                HasSubstr("kept as " + kept())));
  EXPECT_EQ(exported(), before_);
  EXPECT_EQ(run({"home", "check", kept()}).exitStatus, 2);
}

TEST_F(HomeEditTest, ReportsAnEditorThatFails) {
  const ProgramEnd end = runProgram(editing("exit 3", true));
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, AllOf(IsOneFailure("the editor ended with status 3"), HasSubstr("EDITOR"),
                                Not(HasSubstr("kept"))));
  EXPECT_TRUE(isNothingLeft());
}

TEST_F(HomeEditTest, KeepsWhatAFailedEditorWrote) {
  const ProgramEnd end = runProgram(editing(std::string(kRename) + "\nkill -9 $$", true));
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, HasSubstr("kept as " + kept()));
  EXPECT_THAT(contentOfFile(kept()), HasSubstr("\"Den\""));
  EXPECT_EQ(exported(), before_);
}

TEST_F(HomeEditTest, ReportsADocumentThatIsGone) {
  const ProgramEnd end = runProgram(editing("rm \"$1\"", true));
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, IsOneFailure(""));
  EXPECT_TRUE(isNothingLeft());
}

TEST_F(HomeEditTest, PrefersVISUAL) {
  ProgramStart edit = editing("exit 3", true);
  edit.environment["VISUAL"] = "sh -e " + folder_.write("visual", kRename);
  EXPECT_EQ(runProgram(edit).exitStatus, 0);
  EXPECT_THAT(exported(), HasSubstr("\"Den\""));
}

/// Edits that find no programs but the shell's and those that are put into their folder.
class HomeEditWithoutProgramsTest : public HomeEditTest {
 protected:
  void SetUp() override {
    HomeEditTest::SetUp();
    std::filesystem::create_directory(folder_.path() / "bin");
    for (const std::string name : {"sh", "sed"}) {
      std::filesystem::create_symlink("/bin/" + name, folder_.path() / "bin" / name);
    }
  }

  /// An edit that finds `name` as an editor that renames a room.
  [[nodiscard]] ProgramEnd editWith(const std::string& name) const {
    const auto file = folder_.write("bin/" + name, std::string("#!/bin/sh\n") + kRename + '\n');
    std::filesystem::permissions(file, std::filesystem::perms(0700));
    ProgramStart edit = editing("", true);
    edit.environment["EDITOR"] = "";
    edit.environment["PATH"] = folder_.file("bin");
    return runProgram(edit);
  }
};

TEST_F(HomeEditWithoutProgramsTest, TakesTheEditorOfTheMachine) {
  for (const char* name : {"vi", "editor"}) {
    import(sampleDocument());
    EXPECT_EQ(editWith(name).exitStatus, 0) << name;
    EXPECT_THAT(exported(), HasSubstr("\"Den\"")) << name;
    folder_.write("bin/vi", "");
  }
}

TEST_F(HomeEditWithoutProgramsTest, ShowsTheSummaryWithoutDiff) {
  const ProgramEnd end = editWith("vi");
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_EQ(end.output, "1 room renamed\nimported\n");
}

TEST_F(HomeEditTest, KeepsValuesThatWereSetMeanwhile) {
  const std::string order =
      R"({"filter": {"search": {"serviceName": "Lamp"}}, "actions": [{"actionType": "SET",)"
      R"( "attribute": "BRIGHTNESS", "value": {"integer": 77}}]})";
  const std::string perform = std::string(NIDUS_PROGRAM) + " --data " + data() + " perform " +
                              folder_.write("order.json", order) + "\n";
  const ProgramEnd end = runProgram(editing(perform + kRename, true));
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(exported(), AllOf(HasSubstr("\"Den\""), HasSubstr("\"value\": 77")));
}

TEST_F(HomeEditTest, RefusesWhenHomesWereChangedMeanwhile) {
  const std::string remove =
      std::string(NIDUS_PROGRAM) + " --data " + data() + " home remove home Cottage --yes\n";
  const ProgramEnd end = runProgram(editing(remove + kRename, true));
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.errors, AllOf(IsOneFailure("the homes were changed meanwhile (1 home removed"),
                                HasSubstr("kept as " + kept())));
  EXPECT_THAT(exported(), AllOf(Not(HasSubstr("Cottage")), HasSubstr("\"Study\"")));
  EXPECT_THAT(contentOfFile(kept()), HasSubstr("\"Den\""));
}

TEST_F(HomeEditTest, ImportsAfterAYesOnATerminal) {
  TerminalProcess terminal(editing(kRename, false));
  ASSERT_TRUE(terminal.waitFor("1 room renamed\n"));
  ASSERT_TRUE(terminal.waitFor("Import this? [y/N] "));
  EXPECT_EQ(exported(), before_);
  terminal.write("y\n");
  const ProgramEnd end = terminal.finish();
  EXPECT_EQ(end.exitStatus, 0) << end.output;
  EXPECT_THAT(exported(), HasSubstr("\"Den\""));
  EXPECT_TRUE(isNothingLeft());
}

TEST_F(HomeEditTest, KeepsTheDocumentAfterANo) {
  for (const char* answer : {"n\n", "\n"}) {
    TerminalProcess terminal(editing(kRename, false));
    ASSERT_TRUE(terminal.waitFor("Import this? [y/N] "));
    terminal.write(answer);
    const ProgramEnd end = terminal.finish();
    EXPECT_EQ(end.exitStatus, 1);
    EXPECT_THAT(end.output, HasSubstr("nothing was changed; what you edited is kept as "));
    EXPECT_EQ(exported(), before_);
    EXPECT_THAT(contentOfFile(kept()), HasSubstr("\"Den\""));
  }
}

TEST_F(HomeEditTest, OpensABadDocumentAgain) {
  const std::string script =
      std::string("if grep -q '\"name\": 7' \"$1\"; then sed -i 's/\"name\": 7/\"name\": ") +
      "\"Den\"/' \"$1\"; else " + kSpoil + "; fi";
  TerminalProcess terminal(editing(script, false));
  ASSERT_TRUE(terminal.waitFor("/homes/0/rooms/1/name: "));
  ASSERT_TRUE(terminal.waitFor("Edit it again? [Y/n] "));
  terminal.write("\n");
  ASSERT_TRUE(terminal.waitFor("Import this? [y/N] "));
  terminal.write("y\n");
  EXPECT_EQ(terminal.finish().exitStatus, 0);
  EXPECT_THAT(exported(), HasSubstr("\"Den\""));
}

TEST_F(HomeEditTest, KeepsABadDocumentThatIsGivenUp) {
  TerminalProcess terminal(editing(kSpoil, false));
  ASSERT_TRUE(terminal.waitFor("Edit it again? [Y/n] "));
  terminal.write("n\n");
  const ProgramEnd end = terminal.finish();
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.output, HasSubstr("what you edited is kept as " + kept()));
  EXPECT_EQ(exported(), before_);
}

TEST_F(HomeEditTest, SaysWhenNothingIsLeftToKeep) {
  TerminalProcess terminal(editing("truncate -s0 \"$1\"", false));
  ASSERT_TRUE(terminal.waitFor("Edit it again? [Y/n] "));
  terminal.write("n\n");
  const ProgramEnd end = terminal.finish();
  EXPECT_EQ(end.exitStatus, 2);
  EXPECT_THAT(end.output, ::testing::EndsWith("nidus: nothing was changed\n"));
  EXPECT_TRUE(isNothingLeft());
}

TEST_F(HomeEditTest, TellsOfAMissingEditorOnOneLine) {
  for (const char* editor : {"nosucheditor -w", "vi 'unclosed", "/no/such/vi"}) {
    ProgramStart edit = editing("", true);
    edit.environment["EDITOR"] = editor;
    const ProgramEnd end = runProgram(edit);
    EXPECT_EQ(end.exitStatus, 2);
    EXPECT_THAT(end.errors, AllOf(IsOneFailure("the editor " + std::string(editor) + " cannot be"),
                                  HasSubstr("set EDITOR")));
  }
}

TEST_F(HomeEditTest, TakesAnEditorWithAVariable) {
  ProgramStart edit = editing(kRename, true);
  edit.environment["EDITOR"] = "LANG=C " + *edit.environment["EDITOR"];
  EXPECT_EQ(runProgram(edit).exitStatus, 0);
  EXPECT_THAT(exported(), HasSubstr("\"Den\""));
}

TEST_F(HomeEditTest, LeavesInterruptsToTheEditor) {
  const std::string script = "trap 'exit 0' INT\necho ready\nread -r line || true\n";
  TerminalProcess terminal(editing(script, false));
  ASSERT_TRUE(terminal.waitFor("ready"));
  terminal.interrupt();
  const ProgramEnd end = terminal.finish();
  EXPECT_EQ(end.exitStatus, 0) << end.output;
  EXPECT_THAT(end.output, HasSubstr("nothing was changed"));
}

TEST_F(HomeEditTest, KeepsTheHomesWhenInterrupted) {
  TerminalProcess terminal(editing(kRename, false));
  ASSERT_TRUE(terminal.waitFor("Import this? [y/N] "));
  terminal.interrupt();
  const ProgramEnd end = terminal.finish();
  EXPECT_EQ(end.signal, SIGINT);
  EXPECT_THAT(end.output, HasSubstr("\nnidus: nothing was changed; what you edited is kept as " +
                                    kept() + '\n'));
  EXPECT_THAT(contentOfFile(kept()), HasSubstr("\"Den\""));
  EXPECT_EQ(exported(), before_);
}

}  // namespace
}  // namespace nidus
