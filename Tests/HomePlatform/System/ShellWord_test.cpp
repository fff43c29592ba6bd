#include "HomePlatform/System/ShellWord.h"

#include <gtest/gtest.h>

namespace nidus {
namespace {

TEST(ShellWordTest, QuotesWhereItIsNeeded) {
  EXPECT_EQ(shellWord("Kitchen"), "Kitchen");
  EXPECT_EQ(shellWord("/data/home.db"), "/data/home.db");
  EXPECT_EQ(shellWord("Living Room"), "'Living Room'");
  EXPECT_EQ(shellWord("Chloé's"), R"('Chloé'\''s')");
  EXPECT_EQ(shellWord("$(reboot)"), "'$(reboot)'");
  EXPECT_EQ(shellWord(""), "''");
}

}  // namespace
}  // namespace nidus
