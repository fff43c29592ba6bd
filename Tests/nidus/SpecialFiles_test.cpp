#include <sys/stat.h>

#include "nidus/ProgramTest.h"
#include "nidus/Shell/HistoryFile.h"

namespace nidus {
namespace {

using ::testing::AllOf;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

/// Files that are no files, where documents are expected.
class SpecialFilesTest : public ProgramTest {
 protected:
  void SetUp() override { std::filesystem::create_directory(data()); }

  /// Expects that each command that reads a document refuses `file` with what is wrong about it.
  void expectRefused(const std::string& file, const std::string& problem) const {
    const std::vector<std::vector<std::string>> commands = {
        {"home", "check", file},        {"home", "import", file}, {"perform", file},
        {"explain", "--command", file}, {"replay", file},
    };
    for (const auto& command : commands) {
      SCOPED_TRACE(command.front());
      const ProgramEnd end = run(command);
      EXPECT_EQ(end.exitStatus, 2);
      EXPECT_THAT(end.output, IsEmpty());
      EXPECT_THAT(end.errors, AllOf(IsOneFailure(file + ": "), HasSubstr(problem)));
    }
  }
  /// Expects that `command` refuses whatever stands in place of `file`, a file of the data folder.
  void expectRefusedInData(const std::vector<std::string>& command, const std::string& file) const {
    const std::string path = data() + '/' + file;
    ASSERT_EQ(::mkfifo(path.c_str(), 0600), 0);
    EXPECT_THAT(run(command).errors, IsOneFailure(path + ": a named pipe is where the "));
    std::filesystem::remove(path);
    std::filesystem::create_symlink("/dev/zero", path);
    const ProgramEnd end = run(command);
    EXPECT_EQ(end.exitStatus, 4);
    EXPECT_THAT(end.errors, IsOneFailure(""));
  }
};

TEST_F(SpecialFilesTest, NamedPipesAreNotWaitedFor) {
  const std::string pipe = folder_.file("pipe");
  ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0);
  expectRefused(pipe, "cannot be read (a named pipe)");
}

TEST_F(SpecialFilesTest, EndlessDevicesAreNotReadWithoutEnd) { expectRefused("/dev/zero", ": "); }

TEST_F(SpecialFilesTest, FoldersAreNoDocuments) {
  expectRefused(folder_.path().string(), "cannot be read (a folder)");
}

TEST_F(SpecialFilesTest, PipesOfTheShellAreRead) {
  ProgramStart piped;
  piped.program = "/bin/sh";
  piped.arguments = {"-c", "printf '%s' \"$1\" | " NIDUS_PROGRAM " home check /dev/stdin", "sh",
                     documentOf({smallHome()})};
  const ProgramEnd end = runProgram(piped);
  EXPECT_EQ(end.exitStatus, 0) << end.errors;
  EXPECT_THAT(end.output, HasSubstr("1 home"));
}

TEST_F(SpecialFilesTest, AreNoPreferences) {
  expectRefusedInData({"preferences", "list"}, "preferences.json");
}

TEST_F(SpecialFilesTest, AreNoVocabulary) {
  expectRefusedInData({"vocabulary"}, "vocabulary.json");
}

TEST_F(SpecialFilesTest, AreNoHistory) {
  std::filesystem::create_directory(folder_.file("nidus"));
  ASSERT_EQ(::mkfifo(folder_.file("nidus/history").c_str(), 0600), 0);
  const HistoryFile history(folder_.file("nidus/history"));
  EXPECT_THAT(history.lines(), IsEmpty());
  const Status failure = history.add("home show");
  ASSERT_TRUE(failure);
  EXPECT_THAT(failure->message, HasSubstr("history: the history cannot be written ("));
}

}  // namespace
}  // namespace nidus
