#include <sys/stat.h>
#include <unistd.h>

#include "nidus/ProgramTest.h"

namespace nidus {
namespace {

using ::testing::EndsWith;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

/// The program in an installation of the test's own, beside a module that the test chooses.
class InstalledModuleTest : public ProgramTest {
 protected:
  InstalledModuleTest() {
    std::filesystem::create_directories(folder_.path() / "bin");
    std::filesystem::create_directories(folder_.path() / "lib/nidus");
    std::filesystem::copy_file(NIDUS_PROGRAM, program());
  }

  [[nodiscard]] std::string program() const { return folder_.file("bin/nidus"); }
  [[nodiscard]] std::string module() const { return folder_.file("lib/nidus/NidusAssistant.so"); }
  void install(const char* module) const { std::filesystem::copy_file(module, this->module()); }
  [[nodiscard]] ProgramEnd runInstalled(std::vector<std::string> arguments,
                                        const std::string& input = "") const {
    ProgramStart installed = start(std::move(arguments), input);
    installed.program = program();
    installed.environment = {{"LD_LIBRARY_PATH", NIDUS_LIBRARIES}};
    return runProgram(installed);
  }
  void expectModuleFailure(const std::string& reason) const {
    const ProgramEnd end = runInstalled({"records"});
    EXPECT_EQ(end.exitStatus, 4);
    EXPECT_THAT(end.output, IsEmpty());
    EXPECT_THAT(end.errors, IsOneFailure(module() + ": " + reason));
    EXPECT_THAT(end.errors, HasSubstr("; install the program and the module of one release"));
  }
};

TEST_F(InstalledModuleTest, MustBeThere) { expectModuleFailure("the plug-in module is not there"); }

TEST_F(InstalledModuleTest, MustBeALibrary) {
  folder_.write("lib/nidus/NidusAssistant.so", "no library");
  expectModuleFailure("cannot be opened");
}

TEST_F(InstalledModuleTest, MustHaveTheInterface) {
  install(NIDUS_OTHER_INTERFACE_MODULE);
  expectModuleFailure("offers interface");
}

TEST_F(InstalledModuleTest, MustNotBeOthersToChange) {
  install(NIDUS_SILENT_MODULE);
  for (const char* name : {"lib/nidus/NidusAssistant.so", "lib/nidus", "lib"}) {
    const std::string place = folder_.file(name);
    ::chmod(place.c_str(), 0775);
    const ProgramEnd end = runInstalled({"sync"});
    EXPECT_EQ(end.exitStatus, 4);
    EXPECT_THAT(end.output, IsEmpty());
    EXPECT_THAT(end.errors, IsOneFailure(place + ": others may change it"));
    EXPECT_THAT(end.errors, EndsWith("; chmod go-w " + place + "\n"));
    EXPECT_THAT(runInstalled({"doctor"}).output,
                HasSubstr("attention  plug-in\n  attention  " + place + ": others may change it"));
    ::chmod(place.c_str(), 0755);
  }
}

TEST_F(InstalledModuleTest, MayBelongToTheOwnerOfTheProgram) {
  if (::geteuid() != 0) GTEST_SKIP() << "only an administrator can give files away";
  constexpr uid_t kSomebody = 12345;
  install(NIDUS_SILENT_MODULE);
  ASSERT_EQ(::chown(module().c_str(), kSomebody, kSomebody), 0);
  EXPECT_THAT(runInstalled({"sync"}).errors,
              IsOneFailure(module() + ": it belongs to another user"));
  ASSERT_EQ(::chown(program().c_str(), kSomebody, kSomebody), 0);
  EXPECT_THAT(runInstalled({"perform"}, "{}\n").errors,
              IsOneFailure("standard input: line 1: the plug-in gave no reply"));
}

TEST_F(InstalledModuleTest, IsNotLookedForInTheWorkingFolder) {
  const std::filesystem::path old = std::filesystem::current_path();
  std::filesystem::create_directories(folder_.path() / "work/lib/nidus");
  std::filesystem::create_directories(folder_.path() / "work/bin");
  std::filesystem::copy_file(NIDUS_SILENT_MODULE,
                             folder_.path() / "work/lib/nidus/NidusAssistant.so");
  std::filesystem::current_path(folder_.path() / "work/bin");
  expectModuleFailure("the plug-in module is not there");
  std::filesystem::current_path(old);
}

TEST_F(InstalledModuleTest, IsNotLookedForWhereTheEnvironmentPoints) {
  const std::string other = folder_.file("other");
  std::filesystem::create_directories(other + "/lib/nidus");
  for (const std::string below : {"/", "/lib/nidus/"}) {
    std::filesystem::copy_file(NIDUS_SILENT_MODULE, other + below + "NidusAssistant.so");
  }
  ProgramStart installed = start({"records"});
  installed.program = program();
  installed.environment = {{"LD_LIBRARY_PATH", NIDUS_LIBRARIES ":" + other}};
  for (const char* variable : {"HOME", "NIDUS_DATA", "NIDUS_HOME", "NIDUS_MODULE", "PATH", "PWD",
                               "XDG_DATA_HOME", "XDG_CONFIG_HOME"}) {
    installed.environment[variable] = other;
  }
  EXPECT_THAT(runProgram(installed).errors,
              IsOneFailure(module() + ": the plug-in module is not there"));
}

TEST_F(InstalledModuleTest, IsLoadedWithTheLibrariesOfTheInstallation) {
  folder_.write("libPlatformModel.so", "no library");
  ProgramStart built = start({"records"});
  built.environment = {{"LD_LIBRARY_PATH", folder_.path().string()}};
  EXPECT_EQ(runProgram(built).errors, "");
}

TEST_F(InstalledModuleTest, MayGiveNoReply) {
  install(NIDUS_SILENT_MODULE);
  const ProgramEnd end = runInstalled({"perform"}, "{}\n");
  EXPECT_EQ(end.exitStatus, 3);
  EXPECT_THAT(end.output, IsEmpty());
  EXPECT_THAT(end.errors, IsOneFailure("standard input: line 1: the plug-in gave no reply"));
}

TEST_F(InstalledModuleTest, MayGiveNoReplyToAnOrder) {
  install(NIDUS_SILENT_MODULE);
  for (const char* form : {"--json", "--locked"}) {
    const ProgramEnd end = runInstalled({"set", "brightness", "maximum", form});
    EXPECT_EQ(end.exitStatus, 3);
    EXPECT_THAT(end.output, IsEmpty());
    EXPECT_THAT(end.errors, IsOneFailure("the plug-in gave no reply"));
  }
  const ProgramEnd quiet = runInstalled({"limits", "brightness", "--quiet"});
  EXPECT_EQ(quiet.exitStatus, 3);
  EXPECT_THAT(quiet.errors, IsEmpty());
}

TEST_F(InstalledModuleTest, MayNotAnswerASync) {
  install(NIDUS_SILENT_MODULE);
  const ProgramEnd end = runInstalled({"sync"});
  EXPECT_EQ(end.exitStatus, 3);
  EXPECT_THAT(end.output, IsEmpty());
  EXPECT_THAT(end.errors, IsOneFailure("the plug-in did not answer the sync"));
}

TEST_F(InstalledModuleTest, CountsNoReplyAboveBadInput) {
  install(NIDUS_SILENT_MODULE);
  EXPECT_EQ(runInstalled({"perform"}, "x\n{}\nx\n").exitStatus, 3);
}

TEST_F(InstalledModuleTest, MakesADemonstrationFail) {
  install(NIDUS_SILENT_MODULE);
  const ProgramEnd end = runInstalled({"demo"});
  EXPECT_EQ(end.exitStatus, 1);
  EXPECT_THAT(end.errors, HasSubstr("nidus: demo: this answer is not the expected one"));
}

}  // namespace
}  // namespace nidus
