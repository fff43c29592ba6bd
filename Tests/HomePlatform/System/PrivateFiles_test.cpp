#include "HomePlatform/System/PrivateFiles.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <cerrno>

#include "Support/FileModes.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

class PrivateFilesTest : public testing::Test {
 protected:
  [[nodiscard]] std::filesystem::path at(const char* name) const { return folder_.path() / name; }

  const TestFolder folder_;
};

TEST_F(PrivateFilesTest, AreMadeWhateverTheMask) {
  for (const mode_t mask : {0000U, 0022U, 0077U, 0777U}) {
    SCOPED_TRACE(mask);
    const TestFolder folder;
    const FileCreationMask set(mask);
    EXPECT_EQ(makePrivateFolder(folder.path() / "a" / "b"), 0);
    EXPECT_EQ(makePrivateFile(folder.path() / "a" / "b" / "file"), 0);
    EXPECT_EQ(permissionsOf(folder.path() / "a"), 0700U);
    EXPECT_EQ(permissionsOf(folder.path() / "a" / "b"), 0700U);
    EXPECT_EQ(permissionsOf(folder.path() / "a" / "b" / "file"), 0600U);
  }
}

TEST_F(PrivateFilesTest, AreLeftWhenTheyAreThere) {
  const std::string file = folder_.write("file", "content");
  ::chmod(file.c_str(), 0640);
  ::chmod(folder_.path().c_str(), 0750);
  EXPECT_EQ(makePrivateFile(file), 0);
  EXPECT_EQ(makePrivateFolder(folder_.path()), 0);
  EXPECT_EQ(permissionsOf(file), 0640U);
  EXPECT_EQ(permissionsOf(folder_.path()), 0750U);
  EXPECT_EQ(contentOfFile(file), "content");
}

TEST_F(PrivateFilesTest, GiveTheErrorWhereTheyCannotBe) {
  folder_.write("file", "");
  EXPECT_EQ(makePrivateFolder(at("file") / "below"), ENOTDIR);
  EXPECT_EQ(makePrivateFile(at("missing") / "file"), ENOENT);
}

TEST_F(PrivateFilesTest, AreTakenFromOthersAlone) {
  const std::string file = folder_.write("file", "");
  ::chmod(file.c_str(), 0744);
  EXPECT_TRUE(isOpenToOthers(file));
  keepPrivate(file);
  EXPECT_EQ(permissionsOf(file), 0700U);
  EXPECT_FALSE(isOpenToOthers(file));
}

TEST_F(PrivateFilesTest, AreNotWhatALinkLeadsTo) {
  const std::string file = folder_.write("file", "");
  ::chmod(file.c_str(), 0644);
  std::filesystem::create_symlink("file", at("link"));
  keepPrivate(at("link"));
  EXPECT_EQ(permissionsOf(file), 0644U);
  EXPECT_FALSE(isOpenToOthers(at("link")));
  EXPECT_FALSE(isOpenToOthers(at("missing")));
}

}  // namespace
}  // namespace nidus
