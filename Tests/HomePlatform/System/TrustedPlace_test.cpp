#include "HomePlatform/System/TrustedPlace.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include "HomePlatform/Support/Unprivileged.h"
#include "Support/TestFolder.h"

namespace nidus {
namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;

constexpr uid_t kSomebody = 12345;

std::string messageOf(const Status& status) { return status ? status->message : ""; }

class TrustedPlaceTest : public testing::Test {
 protected:
  [[nodiscard]] fs::path at(const char* name) const { return folder_.path() / name; }
  fs::path makeFolder(const char* name, mode_t mode) const {
    fs::create_directory(at(name));
    ::chmod(at(name).c_str(), mode);
    return at(name);
  }
  static std::string way(const fs::path& path) { return messageOf(checkTrustedWay(path)); }
  static std::string othersMayChange(const fs::path& place) {
    return place.string() + ": others may change it, and with it what the assistant does; " +
           "chmod go-w " + place.string();
  }

  const TestFolder folder_;
};

TEST_F(TrustedPlaceTest, MayBeMissing) {
  EXPECT_EQ(messageOf(checkTrusted(at("missing"))), "");
  EXPECT_EQ(way(at("missing") / "below"), "");
}

TEST_F(TrustedPlaceTest, MayBeReadByOthers) {
  const fs::path folder = makeFolder("folder", 0755);
  EXPECT_EQ(messageOf(checkTrusted(folder)), "");
  EXPECT_EQ(way(folder), "");
}

TEST_F(TrustedPlaceTest, MayNotBeWrittenByOthers) {
  for (const mode_t mode : {0720U, 0702U, 0777U, 01777U}) {
    SCOPED_TRACE(mode);
    const fs::path folder = makeFolder("folder", mode);
    EXPECT_EQ(messageOf(checkTrusted(folder)), othersMayChange(folder));
    EXPECT_EQ(way(folder), othersMayChange(folder));
  }
  const std::string file = folder_.write("file", "");
  ::chmod(file.c_str(), 0620);
  EXPECT_EQ(messageOf(checkTrusted(file)), othersMayChange(file));
}

TEST_F(TrustedPlaceTest, IsNamedAsAShellHasIt) {
  const fs::path folder = makeFolder("my folder", 0777);
  EXPECT_THAT(way(folder), HasSubstr("; chmod go-w '" + folder.string() + "'"));
}

TEST_F(TrustedPlaceTest, MayNotLieWhereOthersMayWrite) {
  const fs::path above = makeFolder("above", 0770);
  const fs::path below = makeFolder("above/below", 0700);
  EXPECT_EQ(messageOf(checkTrusted(below)), "");
  EXPECT_EQ(way(below), othersMayChange(above));
  EXPECT_EQ(way(above / "missing"), othersMayChange(above));
}

TEST_F(TrustedPlaceTest, MayLieInASharedFolderThatKeepsIt) {
  makeFolder("shared", 01777);
  EXPECT_EQ(way(makeFolder("shared/own", 0700)), "");
}

TEST_F(TrustedPlaceTest, IsWhatALinkLeadsTo) {
  const fs::path above = makeFolder("above", 0770);
  makeFolder("above/below", 0700);
  fs::create_symlink("above/below", at("link"));
  fs::create_symlink(at("link"), at("chain"));
  EXPECT_EQ(messageOf(checkTrusted(at("link"))), othersMayChange(above));
  EXPECT_EQ(way(at("chain")), othersMayChange(above));
  EXPECT_EQ(way(at("chain") / "missing"), othersMayChange(above));
  ::chmod(above.c_str(), 0700);
  EXPECT_EQ(way(at("chain")), "");
}

TEST_F(TrustedPlaceTest, MayBeALinkInCircles) {
  fs::create_symlink("circle", at("circle"));
  EXPECT_EQ(way(at("circle") / "below"), "");
}

TEST_F(TrustedPlaceTest, MayBeTheAdministrators) {
  makeFolder("folder", 0755);
  const Unprivileged unprivileged;
  EXPECT_EQ(messageOf(checkTrusted("/")), "");
  EXPECT_EQ(way("/usr"), "");
}

TEST_F(TrustedPlaceTest, MayNotBelongToAnotherUser) {
  if (::geteuid() != 0) GTEST_SKIP() << "only an administrator can give files away";
  const fs::path folder = makeFolder("folder", 01700);
  ASSERT_EQ(::chown(folder.c_str(), kSomebody, kSomebody), 0);
  const std::string expected = folder.string() +
                               ": it belongs to another user, who decides with it what the "
                               "assistant does; sudo chown \"$(id -un)\" " +
                               folder.string();
  EXPECT_EQ(messageOf(checkTrusted(folder)), expected);
  EXPECT_EQ(way(folder / "below"), expected);
}

TEST_F(TrustedPlaceTest, MayNotBeALinkOfAnotherUser) {
  if (::geteuid() != 0) GTEST_SKIP() << "only an administrator can give files away";
  makeFolder("folder", 0700);
  fs::create_symlink("folder", at("link"));
  ASSERT_EQ(::lchown(at("link").c_str(), kSomebody, kSomebody), 0);
  EXPECT_THAT(way(at("link") / "below"), HasSubstr("link: it belongs to another user"));
}

}  // namespace
}  // namespace nidus
