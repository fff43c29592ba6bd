#include "nidus/Terminal/ProgramSearch.h"

#include <gmock/gmock.h>

#include <cstdlib>

#include "Support/TestFolder.h"
#include "nidus/Terminal/ForegroundProgram.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;

/// A working folder with programs in it, and a PATH that the test chooses.
class ProgramSearchTest : public testing::Test {
 protected:
  ProgramSearchTest() {
    fs::current_path(folder_.path());
    fs::permissions(folder_.write("true", "#!/bin/sh\nexit 7\n"), fs::perms::owner_all);
    fs::permissions(folder_.write("only-here", "#!/bin/sh\nexit 7\n"), fs::perms::owner_all);
  }
  ~ProgramSearchTest() override {
    fs::current_path(before_);
    usePath(path_);
  }
  static void usePath(const std::string& path) { ::setenv("PATH", path.c_str(), 1); }

  const TestFolder folder_;

 private:
  const fs::path before_ = fs::current_path();
  const std::string path_ = std::getenv("PATH");
};

TEST_F(ProgramSearchTest, LeavesRelativeFoldersOut) {
  usePath(":.:/opt/tools::bin:/usr/bin:");
  EXPECT_EQ(programFolders(), "/opt/tools:/usr/bin");
}

TEST_F(ProgramSearchTest, FallsBackOnTheUsualFolders) {
  usePath(".:");
  EXPECT_EQ(programFolders(), "/usr/local/bin:/usr/bin:/bin");
  ::unsetenv("PATH");
  EXPECT_EQ(programFolders(), "/usr/local/bin:/usr/bin:/bin");
}

TEST_F(ProgramSearchTest, FindsTheFirst) {
  EXPECT_EQ(findProgram("true", "/missing:" + folder_.path().string() + ":/bin"),
            folder_.file("true"));
  EXPECT_EQ(findProgram("./true", "/bin"), "./true");
  EXPECT_EQ(findProgram("only-here", "/usr/bin:/bin"), "");
}

TEST_F(ProgramSearchTest, RunsNothingFromTheWorkingFolder) {
  usePath(".::/usr/bin:/bin");
  EXPECT_EQ(*runInForeground({"true"}), 0);
  EXPECT_FALSE(runInForeground({"only-here"}));
  EXPECT_EQ(*runInForeground({"/bin/sh", "-c", "true"}), 0);
  EXPECT_EQ(*runInForeground({"./only-here"}), 7);
}

TEST_F(ProgramSearchTest, HandsDownAllElse) {
  ::setenv("NIDUS_TRIAL", "a b", 1);
  EXPECT_EQ(*runInForeground({"sh", "-c", "test \"$NIDUS_TRIAL\" = 'a b'"}), 0);
  ::unsetenv("NIDUS_TRIAL");
}

}  // namespace
}  // namespace nidus
